// Undo and redo, and what the window says of them and of what is not saved.

#include "app/PLWindow.h"
#include "app/Rescue.h"
#include "platform/Button.h"
#include "platform/TabView.h"
#include "portfolio/Wallet.h"
#include "views/OperationView.h"
#include "views/WalletView.h"

#include <algorithm>
#include <array>

void PLWindow::makeUndoButtons()
{
    constexpr float kWidth = 60;
    constexpr float kHeight = 22;
    constexpr float kRight = 792;
    const auto add = [this](float left, const char* name, const char* label, uint32 code) {
        auto* button = new BButton({left, 1, left + kWidth, 1 + kHeight}, name, label, new BMessage(code));
        button->SetEnabled(false); // nothing has been done yet
        AddChild(button);          // which the window owns
        return button;
    };
    undoButton_ = add(kRight - 2 * kWidth - 3, "btnUndo", "Undo", 'HUnd');
    redoButton_ = add(kRight - kWidth, "btnRedo", "Redo", 'HRed');
}

Moment PLWindow::moment() const
{
    const bool isFirst = history_ == nullptr;
    // What the shown valuation has made up is no part of the moment: a valuation of the moment makes it up again. In
    // accounts that is all that is automatic, since a valuation begins by removing it.
    const auto isLeftOut = [this](const Operation& operation) {
        return isValued_ && (operation.account() != nullptr || std::ranges::binary_search(simulated_, &operation));
    };
    auto wallet = std::make_shared<const WalletImage>(WalletImage::of(*wallet_, catalogue_, isLeftOut));
    if (!isFirst && *wallet == *history_->now().wallet)
        wallet = history_->now().wallet;
    return {CatalogueImage::of(catalogue_, isFirst ? nullptr : history_->now().catalogue),
            std::move(wallet),
            companyView_->places(catalogue_.getMarkets()),
            currencyView_->places(catalogue_.getCurrencies()),
            walletView_->selections(),
            operationView_->selection()};
}

void PLWindow::noteStep(const std::string& command)
{
    if (history_ == nullptr)
        return;
    const std::uint64_t former = history_->serial();
    history_->note(moment(), files_->names(), command);
    if (history_->serial() != former)
        ForgetTyping(); // what was typed has become a step, and Ctrl+Z takes that back
    showHistory();
}

void PLWindow::noteFile(FileKind kind, bool isSaved)
{
    if (history_ == nullptr)
        return;
    noteStep(command_);
    history_->noteFile(kind, isSaved);
    showHistory();
    if (isSaved)
        rescue_->noteSaved(kind);
}

void PLWindow::prepareSave(FileKind kind)
{
    rescue_->prepareSave(kind);
}

void PLWindow::Undo()
{
    noteStep(command_); // what has changed by no command would be lost
    if (!history_->canUndo())
        return;
    files_->setNames(history_->undo());
    restore(history_->now());
}

void PLWindow::Redo()
{
    noteStep(command_);
    if (!history_->canRedo())
        return;
    files_->setNames(history_->redo());
    restore(history_->now());
}

void PLWindow::restore(const Moment& moment)
{
    repeats_.forget();
    for (const char* key : {kDoneNotice, "operation", "split", "import"})
        dropNotice(key); // they tell of what may no longer be so
    // First no row, no selection and no portfolio refers to anything in the catalogue.
    replaceWallet();
    companyView_->SetMarketList({});
    currencyView_->DeleteAllCurrencies();
    moment.catalogue->restore(catalogue_);
    wallet_ = moment.wallet->make(catalogue_);
    // From here on the model is that of the moment. The valuation makes up again what it made up then.
    const Currency* reference = getReferenceCurrency();
    currencyView_->setCurrencyRefName(reference != nullptr ? reference->getName() : String());
    currencyView_->restore(moment.currencyPage, catalogue_.getCurrencies());
    if (const Currency* currency = currencyView_->GetSelectedCurrency()) {
        currencyView_->setCurrencyName(currency->getName());
        currencyView_->setCurrencyRepresentation(currency->getRepresentation());
    }
    currencyView_->UpdateQuotesChart();
    showWallet();
    companyView_->restore(moment.companyPage, catalogue_.getMarkets());
    if (const Market* market = companyView_->GetSelectedMarket())
        showFields(*market);
    CompanySelection();
    walletView_->restoreSelections(moment.portfolioPage);
    if (walletView_->GetSelectedAccountState() != nullptr)
        AccountSelection();
    operationView_->restoreSelection(moment.operations);
    SelectOperation();
    ForgetTyping();
}

void PLWindow::showHistory()
{
    const auto show = [](BButton& button, bool isThere, const std::string& tip) {
        button.SetEnabled(isThere);
        button.SetToolTip(tip.c_str());
    };
    show(*undoButton_, history_->canUndo(),
         history_->canUndo() ? "Undo: " + history_->undoLabel() + "  Ctrl+Z" : "Nothing to undo");
    show(*redoButton_, history_->canRedo(),
         history_->canRedo() ? "Redo: " + history_->redoLabel() + "  Ctrl+Shift+Z" : "Nothing to redo");
    const std::array unsaved{unsavedChanges(FileKind::kMarkets), unsavedChanges(FileKind::kWallet)};
    for (int32 i = 0; i < tabView_->CountTabs(); ++i) {
        // The first two pages are about the market data; see `makeTabs`.
        const FileKind kind = i < 2 ? FileKind::kMarkets : FileKind::kWallet;
        static_cast<PageView*>(tabView_->TabAt(i)->View())
            ->SetOpenFile(files_->names().of(kind).path, unsaved[static_cast<std::size_t>(kind)]);
    }
}
