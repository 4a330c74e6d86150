// Loading, saving, and starting the portfolio anew. The tab that is shown decides which kind of file a command is
// about.

#include "app/DurableSave.h"
#include "app/MessageView.h"
#include "app/PLWindow.h"
#include "app/WindowLock.h"
#include "foundation/InputFile.h"
#include "foundation/Today.h"
#include "market/Currency.h"
#include "platform/Entry.h"
#include "platform/Message.h"
#include "platform/Path.h"
#include "platform/TabView.h"
#include "portfolio/Account.h"
#include "portfolio/Wallet.h"
#include "valuation/Evolution.h"
#include "views/CompanyView.h"
#include "views/CurrencyView.h"
#include "views/OperationView.h"
#include "views/WalletView.h"

#include <optional>
#include <stdexcept>

namespace {

enum class Kind { kMarkets, kWallet };

/// The kind of file that belongs to a tab; the operation and the parameter page have none.
std::optional<Kind> kindOf(int32 tab)
{
    switch (tab) {
    case 0:
    case 1:
        return Kind::kMarkets;
    case 2:
        return Kind::kWallet;
    default:
        return std::nullopt;
    }
}

std::unique_ptr<InputFile> openFile(const char* path)
{
    try {
        return std::make_unique<InputFile>(path);
    } catch (const std::runtime_error&) {
        return nullptr; // the caller's message names the path
    }
}

} // namespace

void PLWindow::showFolder(BFilePanel& panel, bool isMarkets)
{
    std::string error;
    panel.SetPanelDirectory((isMarkets ? folder_.companies(&error) : folder_.portoFolios(&error)).c_str());
    if (!error.empty())
        SetMessage(error.c_str());
}

void PLWindow::LoadSomething()
{
    {
        const WindowLock lock(*this);
        if (lock.isHeld()) {
            const auto kind = kindOf(tabView_->Selection());
            if (!kind)
                return;
            const bool isMarkets = kind == Kind::kMarkets;
            const char* question = isMarkets ? "This will delete all unsaved changes to the wallet and the markets..."
                                             : "This will delete all unsaved changes to the wallet...";
            // A portfolio is always asked for, even an empty one.
            if ((!isMarkets || catalogue_.getNbrCurrencies() > 0) && !confirm(question))
                return;
            showFolder(*openPanel_, isMarkets);
        }
    }
    openPanel_->Show();
}

void PLWindow::RefsReceived(BMessage* message)
{
    const auto kind = kindOf(tabView_->Selection());
    if (!kind)
        return;
    entry_ref ref;
    BPath path;
    if (message->FindRef("refs", &ref) != B_OK || BEntry(&ref).GetPath(&path) != B_OK) {
        SetMessage("ERROR GETTING REF");
        return;
    }
    // Nothing is thrown away before there is a file to read.
    const auto file = openFile(path.Path());
    if (file == nullptr) {
        SetMessage((std::string("OPEN FAILED: ") + path.Path()).c_str());
        return;
    }
    const WindowLock lock(*this);
    if (!lock.isHeld())
        return;
    // The portfolio refers to markets and companies by name, so new markets take it along.
    replaceWallet();
    if (kind == Kind::kMarkets)
        loadMarkets(file->stream(), path.Path());
    else
        loadWallet(file->stream(), path.Path());
}

void PLWindow::replaceWallet()
{
    SetState(nullptr);
    walletView_->ClearEvolution();
    walletView_->ForgetSelection();
    operationView_->ForgetSelection();
    wallet_ = std::make_unique<Wallet>();
    releaseStateMemory(); // the next portfolio may be a small one
    refreshWalletCatalogue();
    showAccounts();
}

void PLWindow::loadMarkets(FILE* file, const String& path)
{
    RemoveAllMarkets();
    // The currencies that are here stay, and the file's come behind them. Intended: a file loaded twice has each of its
    // currencies twice.
    const unsigned before = catalogue_.getNbrCurrencies();
    const bool isWhole = catalogue_.rd(file) == 0;
    const auto& currencies = catalogue_.getCurrencies();
    for (unsigned i = before; i < currencies.size(); ++i)
        currencyView_->AddCurrency(currencies[i], false);
    if (getReferenceCurrency() != nullptr)
        currencyView_->setCurrencyRefName(getReferenceCurrency()->getName());
    CurrencySelection();
    companyView_->SetMarketList(catalogue_.getMarkets());
    showParameters();
    UpdateState();
    // A save must not put what could be read in the place of a damaged file, nor in that of the one loaded before.
    isMarketPathAsked_ = !isWhole;
    if (isWhole)
        marketPath_ = path;
    SetMessage(isWhole ? "Markets successfully loaded..." : "Failed to load the markets");
}

void PLWindow::loadWallet(FILE* file, const String& path)
{
    if (wallet_->rd(file, nullptr) != 0) {
        SetMessage("Failed to load the wallet");
        wallet_ = std::make_unique<Wallet>();
    }
    showParameters();
    showAccounts();
    UpdateState();
    walletPath_ = path;
    // Intended: it follows the failure's message, too, and the path is the failed file's. What a save writes over is
    // kept among the versions.
    SetMessage("Wallet successfully loaded...");
}

void PLWindow::SaveSomething()
{
    const auto kind = kindOf(tabView_->Selection());
    if (!kind)
        return;
    const bool isMarkets = kind == Kind::kMarkets;
    const String& path = isMarkets ? marketPath_ : walletPath_;
    if (!path.isUndefined() && !(isMarkets && isMarketPathAsked_)) {
        Save(path);
        return;
    }
    showFolder(*savePanel_, isMarkets);
    savePanel_->Show();
}

status_t PLWindow::Save(BMessage* message)
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
    const auto kind = kindOf(tabView_->Selection());
    if (status != B_OK || !kind)
        return status;
    (kind == Kind::kMarkets ? marketPath_ : walletPath_) = path.Path();
    if (kind == Kind::kMarkets)
        isMarketPathAsked_ = false;
    Save(String(path.Path()));
    return B_OK;
}

void PLWindow::Save(const String& path)
{
    const auto kind = kindOf(tabView_->Selection());
    if (!kind || path.isUndefined())
        return;
    const WindowLock lock(*this);
    if (!lock.isHeld())
        return;
    const bool isWallet = kind == Kind::kWallet;
    const auto write = [&](FILE* file) {
        if (!isWallet)
            return catalogue_.wrt(file, today());
        return wallet_ != nullptr ? wallet_->wrt(file, today()) : 0; // without a wallet the file is left empty
    };
    const auto result = DurableSave(folder_).save(path.getCharacterArray(), write);
    switch (result.outcome) {
    case DurableSave::Outcome::kOpenFailed:
        SetMessage("Failed to open the file.");
        break;
    case DurableSave::Outcome::kWriteFailed:
        SetMessage("Failed to write the file.");
        break;
    case DurableSave::Outcome::kSaved:
        if (!isWallet)
            SetMessage("Currencies successfully saved...");
        else
            SetMessage(wallet_ != nullptr ? "Wallet successfully saved..." : "No wallet to save...");
        break;
    }
    messageView_->SetToolTip(result.reason.c_str());
}

void PLWindow::ReinitWallet()
{
    const WindowLock lock(*this);
    if (!lock.isHeld())
        return;
    replaceWallet();
    showParameters();
    walletPath_ = String(); // the next save asks for a name
    UpdateState();
}

void PLWindow::showAccounts()
{
    unsigned n;
    Account** accounts = wallet_->getAllAccounts(&n);
    operationView_->SetAccountsList(accounts, static_cast<int>(n));
}
