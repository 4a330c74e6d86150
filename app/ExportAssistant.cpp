#include "app/ExportAssistant.h"

#include "app/DataFiles.h"
#include "app/PLWindow.h"
#include "app/ReportAssistant.h"
#include "platform/MenuItem.h"
#include "platform/Path.h"
#include "platform/PopUpMenu.h"
#include "platform/TabView.h"
#include "storage/Folders.h"
#include "storage/Writing.h"

#include <algorithm>
#include <filesystem>
#include <stdexcept>
#include <utility>

namespace {

constexpr const char* kNotice = "export";
constexpr const char* kOffer = "offer";

BFilePanel makePanel(PLWindow& window)
{
    // Modal: what was chosen stays what it is until the panel is left.
    const BMessenger target(&window);
    return BFilePanel(B_SAVE_PANEL, &target, nullptr, B_FILE_NODE, new BMessage(ExportAssistant::kPlaced), true);
}

/// A name that nothing in the folder has: tables of a former export are replaced only where a person has named them.
std::string freeName(const std::string& folder, const std::string& wanted)
{
    std::error_code error; // of a place that cannot be looked at; the export tells it
    std::string name = wanted;
    for (int n = 2; std::filesystem::exists(folder + '/' + name, error); ++n)
        name = wanted + " (" + std::to_string(n) + ')';
    return name;
}

} // namespace

ExportAssistant::ExportAssistant(PLWindow& window, const BTabView& tabs, const DataFiles& files,
                                 const DataFolder& folder, const ExportOffers& offers)
    : window_(window), tabs_(tabs), files_(files), offers_(offers), panel_(makePanel(window))
{
    if (const std::string first = firstFolder(folder); !first.empty())
        panel_.SetPanelDirectory(first.c_str());
}

std::string ExportAssistant::firstFolder(const DataFolder& folder)
{
    std::error_code error;
    const std::string documents = folder.path().empty() ? "" : folderOf(folder.path());
    return std::filesystem::is_directory(documents, error) ? documents : "";
}

std::string ExportAssistant::nameOf(const std::string& path)
{
    return std::filesystem::path(path).filename();
}

std::string ExportAssistant::failureText(const std::string& path, const std::string& reason)
{
    return "Not written: " + (reason.starts_with(path) ? nameOf(path) + reason.substr(path.size()) : reason);
}

void ExportAssistant::open(const BView& button) const
{
    BPopUpMenu menu("exportMenu");
    bool wasWhole = false;
    for (const ExportOffer& offer : offers_.of(tabs_.Selection())) {
        if (offer.isWhole && !std::exchange(wasWhole, true))
            menu.AddItem(new BSeparatorItem);
        auto* message = new BMessage(kChosen);
        message->AddString(kOffer, offer.label.c_str());
        auto* item = new BMenuItem((offer.label + "...").c_str(), message);
        item->SetEnabled(offer.isPossible);
        item->SetTarget(&window_);
        menu.AddItem(item);
    }
    if (tabs_.Selection() == PLWindow::kPortoFolioTab || tabs_.Selection() == PLWindow::kOperationTab) {
        menu.AddItem(new BSeparatorItem);
        auto* report = new BMenuItem("Report on paper...", new BMessage(ReportAssistant::kAsked));
        report->SetEnabled(window_.getState() != nullptr);
        report->SetTarget(&window_);
        menu.AddItem(report);
    }
    menu.Open(button.ConvertToScreen({0, button.Bounds().Height() + 1}));
}

std::optional<ExportOffer> ExportAssistant::find(const std::string& label) const
{
    for (ExportOffer& offer : offers_.of(tabs_.Selection()))
        if (offer.label == label && offer.isPossible)
            return std::move(offer);
    return std::nullopt;
}

void ExportAssistant::ask(const BMessage* message)
{
    const char* label = nullptr;
    if (message->FindString(kOffer, &label) != B_OK)
        return;
    const std::optional<ExportOffer> offer = find(label);
    if (!offer)
        return;
    asked_ = label;
    const bool isFolder = offer->ending.empty();
    const std::string name =
        isFolder ? freeName(panel_.PanelDirectory(), offer->name) : offer->name + '.' + offer->ending;
    panel_.SetNodeFlavors(isFolder ? B_FILE_NODE | B_DIRECTORY_NODE : B_FILE_NODE);
    panel_.SetTitle(("Export: " + offer->label).c_str());
    panel_.SetSaveText(name.c_str(), offer->ending.c_str());
    panel_.Show();
}

void ExportAssistant::write(const BMessage* message)
{
    BPath chosen;
    if (DataFiles::chosenPath(*message, &chosen) != B_OK)
        return;
    const std::string path = chosen.Path();
    panel_.SetPanelDirectory(folderOf(path).c_str()); // for the next time
    const std::optional<ExportOffer> offer = find(std::exchange(asked_, {}));
    if (!offer)
        return tellFailure(failureText(path, "what was chosen is no longer shown"));
    if (files_.isOpen(path))
        return tellFailure(failureText(path, path + " is a file that is open here"));
    try {
        const SizeSignalIgnored ignored; // a limit on the size of files is a reason like any other
        const std::string text = written(*offer, path);
        window_.dropNotice(kNotice); // of a failure before
        window_.showNotice({kNotice, text, {}, true});
    } catch (const std::runtime_error& error) {
        tellFailure(failureText(path, error.what()));
    }
}

std::string ExportAssistant::written(const ExportOffer& offer, const std::string& path) const
{
    const auto [what, remarks] = offer.write(path);
    std::string text = what + " written to " + nameOf(path);
    if (!remarks.empty())
        text += "; " + remarks.front();
    if (remarks.size() > 1)
        text += ", and " + std::to_string(remarks.size() - 1) + " more of this kind";
    return text;
}

void ExportAssistant::tellFailure(const std::string& text)
{
    // It stays until it is seen.
    window_.showNotice({kNotice, text, {}, false, false, true});
}
