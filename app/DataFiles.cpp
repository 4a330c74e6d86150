#include "app/DataFiles.h"

#include "app/Holds.h"
#include "foundation/Today.h"
#include "platform/Entry.h"
#include "platform/Message.h"
#include "platform/Path.h"
#include "platform/TabView.h"
#include "portfolio/Wallet.h"
#include "storage/DurableSave.h"
#include "storage/InputFile.h"

#include <stdexcept>

namespace {

std::unique_ptr<InputFile> openFile(const char* path)
{
    try {
        return std::make_unique<InputFile>(path);
    } catch (const std::runtime_error&) {
        return nullptr; // the caller's message names the path
    }
}

BFilePanel makePanel(file_panel_mode mode, PLWindow& window)
{
    const BMessenger target(&window);
    return BFilePanel(mode, &target, nullptr, B_FILE_NODE);
}

} // namespace

DataFiles::DataFiles(PLWindow& window, const BTabView& tabs, const DataFolder& folder)
    : window_(window), tabs_(tabs), folder_(folder), openPanel_(makePanel(B_OPEN_PANEL, window)),
      savePanel_(makePanel(B_SAVE_PANEL, window))
{}

std::optional<FileKind> DataFiles::kindInFront() const
{
    // The order of the tabs is that of `PLWindow::makePages`.
    switch (tabs_.Selection()) {
    case 0:
    case 1:
        return FileKind::kMarkets;
    case 2:
        return FileKind::kWallet;
    default:
        return std::nullopt;
    }
}

void DataFiles::showFolder(BFilePanel& panel, FileKind kind)
{
    std::string error;
    panel.SetPanelDirectory(
        (kind == FileKind::kMarkets ? folder_.companies(&error) : folder_.portoFolios(&error)).c_str());
    if (!error.empty())
        window_.SetMessage(error.c_str());
}

void DataFiles::askForLoad()
{
    {
        const WindowLock lock(window_);
        if (lock.isHeld()) {
            const auto kind = kindInFront();
            if (!kind)
                return;
            const bool isMarkets = kind == FileKind::kMarkets;
            const char* question = isMarkets ? "This will delete all unsaved changes to the wallet and the markets..."
                                             : "This will delete all unsaved changes to the wallet...";
            // A portfolio is always asked for, even an empty one.
            if ((!isMarkets || window_.catalogue().getNbrCurrencies() > 0) && !PLWindow::confirm(question))
                return;
            showFolder(openPanel_, *kind);
        }
    }
    openPanel_.Show();
}

void DataFiles::load(BMessage* message)
{
    const auto kind = kindInFront();
    if (!kind)
        return;
    entry_ref ref;
    BPath path;
    if (message->FindRef("refs", &ref) != B_OK || BEntry(&ref).GetPath(&path) != B_OK)
        return window_.SetMessage("ERROR GETTING REF");
    // Nothing is thrown away before there is a file to read.
    const auto file = openFile(path.Path());
    if (file == nullptr)
        return window_.SetMessage((std::string("OPEN FAILED: ") + path.Path()).c_str());
    const WindowLock lock(window_);
    if (!lock.isHeld())
        return;
    // The portfolio refers to markets and companies by name, so new markets take it along.
    window_.replaceWallet();
    if (kind == FileKind::kMarkets)
        loadMarkets(file->stream(), path.Path());
    else
        loadWallet(file->stream(), path.Path());
}

void DataFiles::loadMarkets(FILE* file, const char* path)
{
    window_.RemoveAllMarkets();
    // The currencies that are here stay, and the file's come behind them. Intended: a file loaded twice has each of its
    // currencies twice.
    const unsigned before = window_.catalogue().getNbrCurrencies();
    const bool isWhole = window_.catalogue().rd(file) == 0;
    window_.showCatalogue(before);
    // A save must not put what could be read in the place of a damaged file, nor in that of the one loaded before.
    names_.markets.isAsked = !isWhole;
    if (isWhole) {
        names_.markets.path = path;
        window_.noteFile(FileKind::kMarkets);
    }
    window_.SetMessage(isWhole ? "Markets successfully loaded..." : "Failed to load the markets");
}

void DataFiles::loadWallet(FILE* file, const char* path)
{
    if (window_.getWallet()->rd(file, nullptr) != 0) {
        window_.SetMessage("Failed to load the wallet");
        window_.replaceWallet(); // a part of a portfolio would pass for the whole
    }
    window_.showWallet();
    names_.wallet.path = path;
    window_.noteFile(FileKind::kWallet);
    // Intended: it follows the failure's message, too, and the path is the failed file's. What a save writes over is
    // kept among the versions.
    window_.SetMessage("Wallet successfully loaded...");
}

DataFiles::Restoring DataFiles::restore(const Restored& markets, const Restored& wallet)
{
    std::unique_ptr<InputFile> marketFile, walletFile;
    try {
        // Nothing is thrown away before there is all that is to be read.
        if (!markets.source.empty())
            marketFile = std::make_unique<InputFile>(markets.source);
        if (wallet.isCopy)
            walletFile = std::make_unique<InputFile>(wallet.source);
    } catch (const std::runtime_error& error) {
        return {false, error.what()};
    }
    if (!wallet.isCopy && !wallet.source.empty())
        walletFile = openFile(wallet.source.c_str());
    window_.replaceWallet();
    window_.RemoveAllCurrencies();
    names_ = {markets.name, wallet.name};
    Restoring done{true, ""};
    if (marketFile != nullptr && window_.catalogue().rd(marketFile->stream()) != 0) {
        names_.markets.isAsked = true;
        done = {!markets.isCopy, markets.source + " is damaged"};
    }
    window_.showCatalogue(0);
    const bool isThere = walletFile != nullptr;
    if (isThere ? window_.getWallet()->rd(walletFile->stream(), nullptr) != 0 : !wallet.source.empty()) {
        window_.replaceWallet(); // a part of a portfolio would pass for the whole
        names_.wallet = {};
        done = {done.isComplete && !wallet.isCopy,
                wallet.source + (isThere ? " does not fit the market data" : " cannot be opened")};
    }
    window_.showWallet();
    // What was read from its own file is as that has it.
    for (const auto& [kind, part] : {std::pair(FileKind::kMarkets, &markets), std::pair(FileKind::kWallet, &wallet)})
        if (!part->isCopy && names_.of(kind) == part->name)
            window_.noteFile(kind);
    return done;
}

void DataFiles::saveOrAsk()
{
    const auto kind = kindInFront();
    if (!kind)
        return;
    const Remembered& file = names_.of(*kind);
    if (!file.path.isUndefined() && !file.isAsked) {
        save(file.path);
        return;
    }
    showFolder(savePanel_, *kind);
    savePanel_.Show();
}

status_t DataFiles::save(BMessage* message)
{
    if (message == nullptr)
        return B_ERROR;
    entry_ref folder;
    const char* name = nullptr;
    status_t status = message->FindRef("directory", &folder);
    if (status == B_OK)
        status = message->FindString("name", &name);
    BPath path;
    if (status == B_OK)
        status = BEntry(&folder).GetPath(&path);
    if (status == B_OK)
        status = path.Append(name);
    const auto kind = kindInFront();
    if (status != B_OK || !kind)
        return status;
    // Remembered before it is written: after a save that fails, the next one tries the same file again.
    names_.of(*kind) = {path.Path()};
    save(String(path.Path()));
    return B_OK;
}

void DataFiles::save(const String& path)
{
    const auto kind = kindInFront();
    if (!kind || path.isUndefined())
        return;
    const WindowLock lock(window_);
    if (!lock.isHeld())
        return;
    const Wallet* wallet = window_.getWallet();
    const auto write = [&](FILE* file) {
        if (kind == FileKind::kMarkets)
            return window_.catalogue().wrt(file, today());
        return wallet != nullptr ? wallet->wrt(file, today()) : 0; // without a wallet the file is left empty
    };
    window_.prepareSave(*kind);
    // Whatever fails, the path is that of the old file or of the new one, and never of a part.
    const auto result = DurableSave(folder_).save(path.getCharacterArray(), write);
    if (result.outcome == DurableSave::Outcome::kSaved && path == names_.of(*kind).path)
        window_.noteSaved(*kind);
    const char* text = "Currencies successfully saved...";
    if (result.outcome == DurableSave::Outcome::kOpenFailed)
        text = "Failed to open the file.";
    else if (result.outcome == DurableSave::Outcome::kWriteFailed)
        text = "Failed to write the file.";
    else if (kind == FileKind::kWallet)
        text = wallet != nullptr ? "Wallet successfully saved..." : "No wallet to save...";
    window_.SetMessage(text, result.reason.c_str());
}
