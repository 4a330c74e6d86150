#include "app/OperationEditor.h"

#include "app/Holds.h"
#include "market/NoteCompanyEvent.h"
#include "portfolio/OperationKind.h"
#include "portfolio/OperationText.h"
#include "portfolio/Wallet.h"
#include "views/CompanyView.h"
#include "views/OperationView.h"

namespace {

constexpr const char* kNotice = "operation";

} // namespace

OperationEditor::OperationEditor(PLWindow& window, OperationView& page, CompanyView& companies)
    : window_(window), page_(page), maker_(window, page), offers_(window, page, maker_), notes_(window, companies)
{
    // Typing comes from the kits, not by way of a command, so the lock is taken here.
    const auto locked = [this](void (OperationOffers::*follow)()) {
        return [this, follow] {
            const WindowLock lock(window_);
            if (lock.isHeld())
                (offers_.*follow)();
        };
    };
    page_.SetTypingHook(locked(&OperationOffers::renew));
    page_.SetFigureHook(locked(&OperationOffers::noteFigure));
}

OperationEditor::~OperationEditor()
{
    page_.SetTypingHook({}); // the page outlives this
    page_.SetFigureHook({});
}

void OperationEditor::updateTotal()
{
    // For the eye only: no command reads the total.
    const double quote = page_.getQuote();
    page_.setTotal(static_cast<float>(page_.getQuantity() * quote));
}

void OperationEditor::add()
{
    book(nullptr);
}

void OperationEditor::update()
{
    book(selected());
}

void OperationEditor::remove()
{
    Operation* operation = selected();
    const std::string deed = operation != nullptr ? deedText(*operation) : "";
    if (operation != nullptr) {
        notes_.remove(notes_.of(*operation, payer_));
        destroy(operation);
    }
    window_.UpdateState();
    if (!deed.empty())
        tell("Removed: " + deed);
}

void OperationEditor::book(Operation* former)
{
    // Before there is a new one, which may look the same.
    NoteCompanyEvent* formerNote = former != nullptr ? notes_.of(*former, payer_) : nullptr;
    Operation* made = maker_.make();
    if (made == nullptr)
        return;                               // the former one stays, and its note
    const std::string deed = deedText(*made); // which may be gone after the valuation
    offers_.noteUsed(*made->account());
    notes_.remove(formerNote);
    Company* payer = kindOf(*made) == OperationKind::kIncome ? maker_.company() : nullptr;
    if (payer != nullptr && !made->isAutomatic())
        notes_.add(*payer, *made);
    const bool stays = !made->isAutomatic();
    payer_ = payer != nullptr && stays ? DividendNotes::nameOf(*payer) : "";
    showMade(made, former);
    if (!stays)
        return window_.dropNotice(kNotice); // the valuation has taken it away: nothing is done, nor is what was before
    tell(former != nullptr ? "Updated: " + deed : deed);
}

void OperationEditor::tell(const std::string& deed)
{
    window_.showNotice({kNotice, shortened(deed, kLongestShown), {}, true});
}

void OperationEditor::showMade(Operation* made, Operation* former)
{
    // The valuation destroys automatic operations, the made one as well as the one in whose place it comes: after the
    // first `UpdateState` neither is touched unless it stays.
    const bool stays = !made->isAutomatic();
    const bool formerStays = former != nullptr && !former->isAutomatic();
    if (former != nullptr && !formerStays)
        destroy(former);
    window_.UpdateState();
    if (former != nullptr) {
        // Intended: the portfolio is valued with both first. Simulated sales may come of that.
        if (formerStays)
            destroy(former);
        window_.UpdateState();
    }
    if (!stays)
        return;
    page_.ShowOperation(made);
    page_.FlashOperation(made);
    updateTotal();
}

void OperationEditor::destroy(Operation* operation)
{
    page_.RemoveOperation(operation); // the row draws from the operation
    delete operation;
}

Operation* OperationEditor::selected() const
{
    if (page_.IsSelectedAccountOperation())
        return page_.GetSelectedAccountOperation();
    return page_.GetSelectedShareOperation();
}

void OperationEditor::showSelected()
{
    if (const AccountOperation* operation = page_.GetSelectedAccountOperation())
        showCash(*operation);
    else if (const ShareOperation* trade = page_.GetSelectedShareOperation())
        showTrade(*trade);
    offers_.noteShown();
}

void OperationEditor::showCash(const AccountOperation& operation)
{
    page_.setAmount(operation.getAmount());
    switch (kindOf(operation)) {
    case OperationKind::kIncome:
        page_.SetType("INCOME");
        page_.setAmount(-static_cast<const TransferAccountOperation&>(operation).getCost());
        showPayer(operation);
        break;
    case OperationKind::kCharge:
        page_.SetType("CHARGE");
        break;
    case OperationKind::kTransfer: {
        page_.SetType("TRANSFER");
        const auto& transfer = static_cast<const TransferAccountOperation&>(operation);
        const Account* to = transfer.recipient();
        page_.setTransferAccount(to != nullptr ? to->getName() : String());
        page_.setTransferCost(transfer.getCost());
        page_.setTransferRateCost(transfer.getRateCost());
        page_.setTransferFromQuote(transfer.getFromCurrencyQuote());
        page_.setTransferToQuote(transfer.getToCurrencyQuote());
        break;
    }
    default:
        page_.SetType("DEPOSIT");
    }
    showCommonFields(operation);
}

void OperationEditor::showPayer(const Operation& income)
{
    // The file says nothing of it but by the note. What is shown is what an update will note again.
    const NoteCompanyEvent* note = notes_.of(income, {});
    const Company* payer = note != nullptr ? note->company() : nullptr;
    const Market* market = payer != nullptr ? payer->market() : nullptr;
    payer_ = payer != nullptr ? DividendNotes::nameOf(*payer) : "";
    page_.setMarketName(market != nullptr ? market->getName() : String());
    page_.setCompanyAbbreviation(payer != nullptr ? payer->getAbbreviation() : String());
}

void OperationEditor::showTrade(const ShareOperation& trade)
{
    page_.SetType(trade.isBuy() ? "BUY" : "SELL");
    page_.setQuantity(trade.getQuantity());
    page_.setQuote(trade.getQuote());
    page_.setTotal(static_cast<float>(trade.getQuantity() * static_cast<double>(trade.getQuote())));
    page_.setShareCost(trade.getOperationCost());
    const Share* share = trade.share();
    page_.setMarketName(share != nullptr ? share->getMarketName() : "ERROR");
    page_.setCompanyAbbreviation(share != nullptr ? share->getCompanyAbbreviation() : "ERROR");
    showCommonFields(trade);
}

void OperationEditor::showCommonFields(const Operation& operation)
{
    page_.setDate(operation.getDate());
    page_.setAutomatic(operation.isAutomatic());
    const Account* account = operation.account();
    page_.setBaseAccount(account != nullptr ? account->getName() : String());
}

void OperationEditor::changeType(const String& type)
{
    // The fields of that type show with what they held.
    page_.SetType(type);
    offers_.noteType();
    offers_.renew();
}
