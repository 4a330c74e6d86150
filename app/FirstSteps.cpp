#include "app/FirstSteps.h"

#include "app/DataFiles.h"
#include "app/PLWindow.h"
#include "foundation/Today.h"
#include "market/MarketDiagnosis.h"
#include "platform/TabView.h"
#include "sample/SampleFiles.h"
#include "storage/InputFile.h"

#include <filesystem>
#include <stdexcept>
#include <utility>

namespace {

namespace fs = std::filesystem;

constexpr const char* kNotice = "first steps";

/// Whether the file begins like one of that kind.
bool isOfKind(const fs::path& path, FileKind kind)
{
    try {
        const InputFile file(path);
        if (kind == FileKind::kMarkets)
            return looksLikeMarketFile(file.stream());
        Date head; // that of the save
        return head.rd(file.stream()) == 0 && head.isValid();
    } catch (const std::runtime_error&) {
        return false; // it cannot be opened
    }
}

/// The file of that kind in `folder` that was written last, leaving out hidden ones; empty when there is none.
std::string lastFileIn(const fs::path& folder, FileKind kind)
{
    std::error_code error; // of a folder that is not there, or a file that is just going
    std::string last;
    fs::file_time_type time;
    for (auto entry = fs::directory_iterator(folder, error); !error && entry != fs::end(entry);
         entry.increment(error)) {
        std::error_code isGone;
        const fs::file_time_type written = entry->last_write_time(isGone);
        if (isGone || !entry->is_regular_file(isGone) || entry->path().filename().string().starts_with('.'))
            continue;
        if ((last.empty() || written > time) && isOfKind(entry->path(), kind)) {
            last = entry->path();
            time = written;
        }
    }
    return last;
}

} // namespace

FirstSteps::FirstSteps(PLWindow& window, BTabView& tabs, DataFiles& files, const DataFolder& folder)
    : window_(window), tabs_(tabs), files_(files), folder_(folder)
{
    update();
}

FirstSteps::Files FirstSteps::lastFiles() const
{
    // The whole machine's "/Companies" would be meant otherwise.
    if (folder_.path().empty())
        return {};
    Files last{lastFileIn(folder_.path() + DataFolder::kCompanies, FileKind::kMarkets),
               lastFileIn(folder_.path() + DataFolder::kPortoFolios, FileKind::kWallet)};
    // The sample's portfolio fits no market file of one's own.
    if (fs::path(last.wallet).filename() == SampleFiles::kName &&
        fs::path(last.markets).filename() != SampleFiles::kName)
        last.wallet.clear();
    return last;
}

bool FirstSteps::isWindowEmpty() const
{
    return window_.catalogue().getNbrCurrencies() == 0 && files_.isWalletEmpty();
}

void FirstSteps::update()
{
    const bool isEmpty = isWindowEmpty();
    if (isEmpty == std::exchange(wasEmpty_, isEmpty))
        return;
    if (!isEmpty)
        return window_.dropNotice(kNotice);
    const auto offer = [this](const char* label, uint32 code) {
        return Notice::Button{label, [this, code] { window_.PostMessage(code); }};
    };
    Notice notice{kNotice, "Nothing is open yet.", {}};
    if (const Files last = lastFiles(); !last.markets.empty()) {
        notice.text = "Saved last: " + fs::path(last.markets).filename().string();
        if (!last.wallet.empty())
            notice.text += " and " + fs::path(last.wallet).filename().string();
        notice.buttons.push_back(offer("Open last files", kOpenLast));
    }
    notice.buttons.push_back(offer("Open the sample", kOpenSample));
    notice.buttons.push_back({"Guide", [this] { window_.OpenGuide(Guide::kStart); }});
    notice.isOffer = true;
    window_.showNotice(std::move(notice));
}

void FirstSteps::openLast()
{
    const Files last = lastFiles();
    if (last.markets.empty())
        return window_.showNotice(
            {kNotice, "There is no market file in " + folder_.path() + DataFolder::kCompanies, {}, true});
    open(last);
}

void FirstSteps::open(const Files& files)
{
    if (!files_.mayReplaceAll())
        return;
    files_.loadBoth(files.markets, files.wallet);
    tabs_.Select(PLWindow::kPortoFolioTab); // what a person wants to see of them
}

void FirstSteps::openSample()
{
    try {
        if (folder_.path().empty())
            throw std::runtime_error("there is no home folder to keep it in");
        const SampleFiles sample = SampleFiles::make(folder_.path(), today());
        open({sample.markets, sample.portfolio});
    } catch (const std::runtime_error& error) {
        window_.showNotice({"sample", std::string("The sample was not made: ") + error.what(), {}, false, false, true});
    }
}
