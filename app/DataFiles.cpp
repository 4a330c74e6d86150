#include "app/DataFiles.h"

#include "app/Holds.h"
#include "foundation/Today.h"
#include "platform/Entry.h"
#include "platform/Message.h"
#include "platform/Path.h"
#include "platform/ShortText.h"
#include "platform/TabView.h"
#include "portfolio/Wallet.h"
#include "portfolio/WalletDiagnosis.h"
#include "storage/DurableSave.h"
#include "storage/Folders.h"
#include "storage/InputFile.h"

#include <algorithm>
#include <filesystem>
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

/// A name for a line of the window, whatever bytes a file has in it.
std::string shownName(std::string_view name)
{
    constexpr std::size_t kLongest = 60;
    std::string text = shortened(name, kLongest);
    std::ranges::replace_if(
        text, [](char c) { return c >= 0 && c < ' '; }, ' ');
    return text;
}

std::string fileName(const String& path)
{
    return std::filesystem::path(path.getCharacterArray()).filename();
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
    switch (tabs_.Selection()) {
    case PLWindow::kCompanyTab:
    case PLWindow::kCurrencyTab:
        return FileKind::kMarkets;
    case PLWindow::kPortoFolioTab:
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
            // A portfolio is always asked for, even an empty one.
            if (isMarkets ? !mayReplaceAll()
                          : !PLWindow::confirm("This will delete all unsaved changes to the wallet..."))
                return;
            showFolder(openPanel_, *kind);
        }
    }
    openPanel_.Show();
}

bool DataFiles::mayReplaceAll() const
{
    return window_.catalogue().getNbrCurrencies() == 0 ||
           PLWindow::confirm("This will delete all unsaved changes to the wallet and the markets...");
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
    const auto file = openOrTell(path.Path());
    if (file == nullptr)
        return;
    const WindowLock lock(window_);
    if (!lock.isHeld())
        return;
    // The portfolio refers to markets and companies by name, so new markets take it along.
    const bool wasEmpty = isWalletEmpty();
    window_.replaceWallet();
    if (kind == FileKind::kMarkets) {
        names_.wallet.isEmptied = names_.wallet.isEmptied || !wasEmpty;
        tell(FileKind::kWallet, "");
    }
    if (kind == FileKind::kWallet ? readWallet(*file) : readMarkets(*file))
        window_.noteFile(*kind);
}

void DataFiles::loadBoth(const std::string& markets, const std::string& wallet)
{
    // Nothing is thrown away before there is all that is to be read.
    const auto marketFile = openOrTell(markets);
    const auto walletFile = marketFile == nullptr || wallet.empty() ? nullptr : openOrTell(wallet);
    if (marketFile == nullptr || (walletFile == nullptr && !wallet.empty()))
        return;
    window_.replaceWallet();
    window_.RemoveAllCurrencies();
    forgetWallet();
    // Both are one step: only then is it said which of them is as its file has it.
    const bool areMarketsWhole = readMarkets(*marketFile);
    const bool isWalletWhole = walletFile != nullptr && readWallet(*walletFile);
    if (areMarketsWhole)
        window_.noteFile(FileKind::kMarkets);
    if (isWalletWhole)
        window_.noteFile(FileKind::kWallet);
}

std::unique_ptr<InputFile> DataFiles::openOrTell(const std::string& path)
{
    auto file = openFile(path.c_str());
    if (file == nullptr)
        window_.SetMessage(("OPEN FAILED: " + path).c_str());
    return file;
}

bool DataFiles::readMarkets(const InputFile& file)
{
    names_.markets = {file.path().c_str(), FileStamp::of(fileno(file.stream()))};
    window_.RemoveAllMarkets();
    // The currencies that are here stay, and the file's come behind them. Intended: a file loaded twice has each of its
    // currencies twice.
    const unsigned before = window_.catalogue().getNbrCurrencies();
    const bool isWhole = window_.catalogue().rd(file.stream()) == 0;
    window_.showCatalogue(before);
    window_.SetMessage(isWhole ? "Markets successfully loaded..." : "Failed to load the markets");
    if (!isWhole) {
        const bool isPartHere = window_.catalogue().getNbrCurrencies() > before;
        names_.markets.failure = shownName(fileName(names_.markets.path)) +
                                 (isPartHere ? " was loaded only in part: " : " was not loaded: ") +
                                 faultOfMarketFile(file.stream(), shownName);
    }
    tell(FileKind::kMarkets, names_.markets.failure);
    return isWhole;
}

bool DataFiles::readWallet(const InputFile& file)
{
    names_.wallet = {file.path().c_str(), FileStamp::of(fileno(file.stream()))};
    const bool isRead = window_.getWallet()->rd(file.stream(), nullptr) == 0;
    const std::string report = reportOn(file, isRead);
    if (!isRead) {
        window_.SetMessage("Failed to load the wallet");
        window_.replaceWallet(); // a part of a portfolio would pass for the whole
    }
    window_.showWallet();
    // Intended: it follows the failure's message, too, and the path is the failed file's. The notice tells what has
    // happened, and the next save asks for a name.
    window_.SetMessage("Wallet successfully loaded...");
    tell(FileKind::kWallet, report);
    return isRead;
}

std::string DataFiles::reportOn(const InputFile& file, bool isRead)
{
    if (isRead && !window_.getWallet()->hasLostRecipient())
        return {};
    const Catalogue& catalogue = window_.catalogue();
    const WalletDiagnosis diagnosis(file.stream(), catalogue, shownName);
    const std::string self = shownName(fileName(names_.wallet.path));
    std::string markets;
    if (catalogue.getNbrCurrencies() > 0)
        markets = names_.markets.path.isUndefined() ? "the market data here"
                                                    : "the market file " + shownName(fileName(names_.markets.path));
    const std::string text = diagnosis.text(self, markets);
    const std::string whole = self + (isRead ? ": " : " was not loaded: ") + text;
    if (!isRead)
        names_.wallet.failure = whole;
    // A text on missing names speaks for itself.
    return diagnosis.isNameMissing() ? text : whole;
}

void DataFiles::tell(FileKind kind, const std::string& text)
{
    const std::string key = kind == FileKind::kMarkets ? "market file" : "portfolio file";
    if (text.empty())
        window_.dropNotice(key);
    else
        window_.showNotice({key, text, {}, false});
}

void DataFiles::forgetWallet()
{
    names_.wallet = {};
    tell(FileKind::kWallet, "");
}

void DataFiles::setNames(const Names& names)
{
    const Names former = std::exchange(names_, names);
    // What the notices say is about the files of before.
    for (const FileKind kind : {FileKind::kMarkets, FileKind::kWallet})
        if (former.of(kind).failure != names.of(kind).failure)
            tell(kind, names.of(kind).failure);
}

bool DataFiles::isWalletEmpty() const
{
    const Wallet* wallet = window_.getWallet();
    return wallet == nullptr || wallet->getNbrAccounts() + wallet->getNbrShares() == 0;
}

std::string DataFiles::doubtAbout(FileKind kind) const
{
    const Remembered& file = names_.of(kind);
    const auto stamp = FileStamp::of(file.path.getCharacterArray());
    if (!stamp)
        return {}; // it was deleted meanwhile: there is nothing to write over
    const std::string name = shownName(fileName(file.path));
    if (!file.failure.empty())
        return file.failure;
    if (file.isEmptied && isWalletEmpty()) {
        const auto saved = openFile(file.path.getCharacterArray());
        if (saved == nullptr || !isEmptyPortfolioFile(saved->stream()))
            return "the portfolio is empty since a market file was loaded, and " + name + " is not";
    }
    if (file.stamp && file.stamp != stamp && written_[static_cast<std::size_t>(kind)] != stamp)
        return name + " was changed by another program or window since it was loaded or saved here";
    return {};
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
    tell(FileKind::kMarkets, "");
    tell(FileKind::kWallet, "");
    Restoring done{true, ""};
    if (marketFile != nullptr && window_.catalogue().rd(marketFile->stream()) != 0) {
        names_.markets.failure = markets.source + " is damaged";
        done = {!markets.isCopy, names_.markets.failure};
    }
    window_.showCatalogue(0);
    const bool isThere = walletFile != nullptr;
    if (isThere ? window_.getWallet()->rd(walletFile->stream(), nullptr) != 0 : !wallet.source.empty()) {
        window_.replaceWallet(); // a part of a portfolio would pass for the whole
        names_.wallet = {};
        done = {done.isComplete && !wallet.isCopy,
                wallet.source + (isThere ? " does not fit the market data" : " cannot be opened")};
    }
    if (wallet.isCopy)
        names_.wallet.isEmptied = isWalletEmpty();
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
    const String path = names_.of(*kind).path;
    if (path.isUndefined()) {
        showFolder(savePanel_, *kind);
        savePanel_.SetSaveText("");
    } else {
        const std::string doubt = doubtAbout(*kind);
        if (doubt.empty())
            return save(path);
        tell(*kind, "Save asks for a name: " + doubt);
        // The folder, too, is the file's own: Enter and a yes then mean that very file.
        savePanel_.SetPanelDirectory(folderOf(path.getCharacterArray()).c_str());
        savePanel_.SetSaveText(fileName(path).c_str());
    }
    savePanel_.Show();
}

status_t DataFiles::chosenPath(const BMessage& message, BPath* path)
{
    entry_ref folder;
    const char* name = nullptr;
    status_t status = message.FindRef("directory", &folder);
    if (status == B_OK)
        status = message.FindString("name", &name);
    if (status == B_OK)
        status = BEntry(&folder).GetPath(path);
    return status == B_OK ? path->Append(name) : status;
}

status_t DataFiles::save(BMessage* message)
{
    if (message == nullptr)
        return B_ERROR;
    BPath path;
    const status_t status = chosenPath(*message, &path);
    const auto kind = kindInFront();
    if (status != B_OK || !kind)
        return status;
    // Remembered before it is written: after a save that fails, the next one tries the same file again. The name was
    // given by a person, so whatever was in doubt is settled.
    names_.of(*kind) = {path.Path()};
    tell(*kind, "");
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
    const char* text = "Currencies successfully saved...";
    if (result.outcome == DurableSave::Outcome::kOpenFailed)
        text = "Failed to open the file.";
    else if (result.outcome == DurableSave::Outcome::kWriteFailed)
        text = "Failed to write the file.";
    else if (kind == FileKind::kWallet)
        text = wallet != nullptr ? "Wallet successfully saved..." : "No wallet to save...";
    window_.SetMessage(text, result.reason.c_str());
    if (result.outcome != DurableSave::Outcome::kSaved || names_.of(*kind).path != path)
        return;
    names_.of(*kind) = {path, result.stamp};
    written_[static_cast<std::size_t>(*kind)] = result.stamp;
    window_.noteFile(*kind, true);
}

bool DataFiles::isOpen(const std::string& path) const
{
    const auto isSame = [&](const String& other) {
        std::error_code isMissing;
        return other.hasText() && std::filesystem::equivalent(path, other.getCharacterArray(), isMissing);
    };
    return isSame(names_.markets.path) || isSame(names_.wallet.path);
}
