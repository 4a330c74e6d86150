#include "views/OperationView.h"

#include "platform/Box.h"
#include "platform/MenuField.h"
#include "platform/MenuItem.h"
#include "platform/Message.h"
#include "platform/MessageRunner.h"
#include "platform/PopUpMenu.h"
#include "portfolio/Account.h"
#include "portfolio/AccountOperation.h"
#include "portfolio/ShareOperation.h"
#include "views/Look.h"
#include "views/ModelText.h"

#include <algorithm>

namespace {

using namespace look;

// Where the groups of the page begin and end.
constexpr float kRight = kPageWidth - kMargin;
constexpr float kEditorEnd = kPageHeight - kMargin;
constexpr float kEditorTop = kEditorEnd - kBoxTop - 3 * kRow - kButtonHeight - kBoxSide;
constexpr float kListEnd = kEditorTop - kMargin;
constexpr float kListTop = kMargin + kFieldHeight + 1; // the list then ends with a whole row

constexpr float kFilterRow = 2 * kListRow; // what the filters take from the list
constexpr const char* kListTitle = "Operations";

constexpr float kDivider = 82;
constexpr float kColumnGap = 16;
constexpr float kColumnWidth = (kRight - kMargin - 2 * kBoxSide - 2 * kColumnGap) / 3;

/// The place of a field in the box, by column and row.
BRect cell(int column, int row)
{
    const float left = kBoxSide + static_cast<float>(column) * (kColumnWidth + kColumnGap);
    const float top = kBoxTop + static_cast<float>(row) * kRow;
    return {left, top, left + kColumnWidth, top + kFieldHeight};
}

struct TypePlan {
    const char* type;
    const char* label;
    uint32 code;
};

// In the order of the menu, by which a type is a bit of the sets below.
constexpr TypePlan kTypes[] = {{"DEPOSIT", "Deposit", 'OPDe'}, {"TRANSFER", "Transfer", 'OPTr'},
                               {"BUY", "Buy", 'OPBu'},         {"SELL", "Sell", 'OPSe'},
                               {"INCOME", "Income", 'OPIn'},   {"CHARGE", "Charge", 'OPCh'}};

// Sets of types, a bit for each.
constexpr unsigned kDeposit = 1;
constexpr unsigned kTransfer = 2;
constexpr unsigned kTrade = 4 + 8;
constexpr unsigned kIncome = 16;
constexpr unsigned kCharge = 32;

constexpr uint32 kFlash = 'OFla';
constexpr bigtime_t kFlashStepTime = 50000;
constexpr int kFlashSteps = 30;
constexpr int kFlashHold = 14; // steps that are left when the light begins to go

/// An account in a menu. Sends nothing when it is chosen, but calls the hook.
class AccountMenuItem final : public BMenuItem {
public:
    AccountMenuItem(const Account* account, const std::function<void()>& hook)
        : BMenuItem(wholeTextOf(account->getName()), nullptr), account_(account), hook_(hook)
    {}

    /// May be gone: only to be compared.
    const Account* account() const { return account_; }

    status_t Invoke(const BMessage*) override
    {
        if (hook_)
            hook_();
        return B_OK;
    }

private:
    const Account* account_;
    const std::function<void()>& hook_; // the page's
};

} // namespace

OperationView::OperationView(BRect frame, const char* name, BWindow*) : PageView(frame, name, B_WILL_DRAW)
{
    prevision_ = addCheckBox(this, {kMargin, kMargin, kMargin + 150, kMargin + kFieldHeight}, "cbxPrevision",
                             "With Previsions", 'OCPr');
    addOpenFile(this, {kMargin + 160, kMargin, kRight - 160, kMargin + kFieldHeight});
    prevision_->SetToolTip("Simulates the sales that the parameters ask for");
    makeList();
    makeFields();
    // All fields show until a type is set.
    SetType(kTypes[0].type);
}

OperationView::~OperationView() = default;

void OperationView::makeList()
{
    listBox_ = addBox(this, {kMargin, kListTop, kRight, kListEnd}, kListTitle);
    makeFilters(listBox_);
    operations_ = new OperationListView("lstOperations");
    operations_->addTo(listBox_,
                       {kBoxSide, kBoxTop + kFilterRow, kRight - kMargin - kBoxSide, kListEnd - kListTop - kBoxSide},
                       kListTitle);
    operations_->SetSelectionMessage(new BMessage('OSel'));
    operations_->setHint(
        "No operation yet. Choose a type below, beginning with a deposit, fill in the fields and press "
        "Add; accounts are added on the page PortoFolio (Alt+3). \"Import...\" brings a bank's statement.");
}

void OperationView::makeFields()
{
    BBox* box = addBox(this, {kMargin, kEditorTop, kRight, kEditorEnd}, "Operation");
    operations_->setEditor(box);
    makeCommonFields(box);
    makeTypedFields(box);
    makeButtons(box);
}

BMenuField* OperationView::addMenu(BView* parent, BRect frame, const char* name, const char* label)
{
    auto* field = new BMenuField(frame, name, label, new BPopUpMenu(name));
    field->SetDivider(kDivider);
    field->SetAlignment(B_ALIGN_RIGHT);
    parent->AddChild(field);
    return field;
}

void OperationView::makeCommonFields(BBox* box)
{
    type_ = addMenu(box, cell(0, 0), "operationType", "Type");
    for (const TypePlan& plan : kTypes)
        type_->Menu()->AddItem(new BMenuItem(plan.label, new BMessage(plan.code)));
    baseAccount_ = addMenu(box, cell(1, 0), "baseAccount", "Account");
    date_ = addFieldOf<OfferField<DateControl>>(box, cell(2, 0), "txtDate", "Date", 'OTDa', kDivider, B_ALIGN_LEFT);
}

void OperationView::makeTypedFields(BBox* box)
{
    // Fields of different types stand in the same place; `SetType` shows those of one type and hides the others.
    const auto of = [this](unsigned types, auto* field) {
        typedFields_.push_back({field, types});
        return field;
    };
    const auto number = [&](int column, int row, const char* name, const char* label, uint32 code) {
        return addFieldOf<OfferNumber>(box, cell(column, row), name, label, code, kDivider, B_ALIGN_RIGHT);
    };
    const auto word = [&](int column, int row, const char* name, const char* label) {
        return addFieldOf<OfferField<BTextControl>>(box, cell(column, row), name, label, 'OTAb', kDivider,
                                                    B_ALIGN_LEFT);
    };

    // Only a transfer has more than the amount; the company of an income is below.
    amount_ = of(kDeposit | kTransfer | kIncome | kCharge, number(0, 1, "txtAmount", "Amount", 'OTAm'));
    transferAccount_ = of(kTransfer, addMenu(box, cell(1, 1), "transferAccount", "To Account"));
    transferCost_ = of(kTransfer, number(2, 1, "txtTransferCost", "Cost", 'OTTc'));
    transferFromQuote_ = of(kTransfer, number(0, 2, "txtTransferFromQuote", "From Quote", 'OTFq'));
    transferToQuote_ = of(kTransfer, number(1, 2, "txtTransferToQuote", "To Quote", 'OTTq'));
    transferRateCost_ = of(kTransfer, number(2, 2, "txtTransferRateCost", "Rate Cost", 'OTTr'));
    transferFromQuote_->SetToolTip("Rate of the sending account's currency");
    transferToQuote_->SetToolTip("Rate of the receiving account's currency");
    transferRateCost_->SetToolTip("Cost in proportion to the amount, as a fraction: 0.01 for one percent");

    // Purchase and sale, and who pays an income: `SetType` moves these. Whatever is typed into market or ticker sends
    // the same code.
    marketName_ = of(kTrade | kIncome, word(0, 1, "txtMarketName", "Market"));
    companyAbbreviation_ = of(kTrade | kIncome, word(1, 1, "txtCompanyAbbreviation", "Ticker"));
    quantity_ = of(kTrade, number(2, 1, "txtQuantity", "Quantity", 'OTQy'));
    quantity_->askForCount();
    quote_ = of(kTrade, number(0, 2, "txtQuote", "Quote", 'OTQo'));
    shareCost_ = of(kTrade, number(1, 2, "txtShareCost", "Cost", 'OTSc'));
    total_ = of(kTrade, addNumber(box, cell(2, 2), "txtTotal", "Total", 'OTTo', kDivider));
    total_->SetEditable(false);
    total_->SetToolTip("Quantity times quote, before costs");
}

void OperationView::makeButtons(BBox* box)
{
    const float bottom = kEditorEnd - kEditorTop - kBoxSide;
    const float top = bottom - kButtonHeight;
    constexpr float kAutomaticWidth = 90;
    automatic_ =
        addCheckBox(box, {kBoxSide, top, kBoxSide + kAutomaticWidth, bottom}, "cbAutomatic", "Automatic", 'OCAu');
    automatic_->SetToolTip("As if a valuation had made it up: the next one takes it away");
    const float left = cell(2, 0).left + kColumnGap;
    // A transfer has two ends to tell of.
    charged_ = addField(box, {kBoxSide + kAutomaticWidth, top + 1, left - kColumnGap, bottom - 1}, "txtCharged",
                        "Charged", 'OTCh', kChargedDivider);
    charged_->SetEditable(false);
    charged_->SetToolTip(kChargedTip);
    addButtons(box, {left, top, kRight - kMargin - kBoxSide, bottom},
               {{"btnAddOperation", "Add", 'OBAd'},
                {"btnUpdateOperation", "Update", 'OBUp'},
                {"btnRemoveOperation", "Remove", 'OBRe'}});
}

void OperationView::Draw(BRect)
{
    // What the ground of some rows means, at the right above the list.
    constexpr const char* kLegend = "Automatic operations";
    constexpr float kPadding = 8;
    const float left = kRight - StringWidth(kLegend) - 2 * kPadding;
    const float top = prevision_->Frame().top;
    SetHighColor(kGenerated);
    FillRect({left, top + 2, kRight, top + kFieldHeight - 2});
    SetHighColor(kText);
    DrawString(kLegend, {left + kPadding, top + kFieldHeight - kPadding + 1});
}

void OperationView::RecallSelection()
{
    fillYearFilter();
    operations_->recall();
    tellFiltered();
}

void OperationView::ClearAllOperations()
{
    // In this order: what is selected is known only while the rows are there.
    operations_->remember();
    operations_->clear();
}

void OperationView::ShowOperation(const Operation* operation)
{
    if (!operations_->has(operation))
        return; // while the page has no date to value at, the list is not filled

    // What was just made is to be seen.
    if (operations_->indexOf(operation) < 0)
        ShowAllOperations();
    // The window does not hear of it: the fields already show the operation and must stay.
    operations_->SetQuiet(true);
    operations_->select(operation);
    operations_->SetQuiet(false);
}

void OperationView::FlashOperation(const Operation* operation)
{
    flashed_ = operation;
    flashStep_ = kFlashSteps;
    const BMessage step(kFlash);
    flashTimer_ = std::make_unique<BMessageRunner>(BMessenger(this), &step, kFlashStepTime);
}

void OperationView::MessageReceived(BMessage* message)
{
    if (message->what != kFlash)
        return PageView::MessageReceived(message);
    if (flashStep_ == 0)
        return flashTimer_.reset();
    --flashStep_;
    lightFlashed(std::min(static_cast<float>(flashStep_) / kFlashHold, 1.0F));
}

void OperationView::lightFlashed(float light)
{
    // The row may have been made anew since the last step, or be gone.
    const int32 index = operations_->indexOf(flashed_);
    if (index < 0)
        return;
    static_cast<OperationItem*>(operations_->ItemAt(index))->setLight(light);
    operations_->InvalidateItem(index);
}

void OperationView::endFlash()
{
    lightFlashed(0);
    flashed_ = nullptr;
    flashTimer_.reset();
}

AccountOperation* OperationView::GetSelectedAccountOperation() const
{
    return dynamic_cast<AccountOperation*>(operations_->selected());
}

ShareOperation* OperationView::GetSelectedShareOperation() const
{
    return dynamic_cast<ShareOperation*>(operations_->selected());
}

void OperationView::SetAccountsList(Account** accounts, int count)
{
    fillAccounts(*baseAccount_->Menu(), accounts, count);
    fillAccounts(*transferAccount_->Menu(), accounts, count);
    fillAccountFilter(accounts, count);
}

void OperationView::fillAccounts(BMenu& menu, Account** accounts, int count)
{
    const auto* chosen = static_cast<const AccountMenuItem*>(menu.FindMarked());
    // The account may be gone already: its address is only compared with those of the others.
    const Account* former = chosen != nullptr ? chosen->account() : nullptr;
    std::vector<BMenuItem*> items;
    BMenuItem* next = nullptr;
    for (int i = 0; i < count; ++i) {
        items.push_back(new AccountMenuItem(accounts[i], typingHook_));
        if (accounts[i] == former)
            next = items.back();
    }
    // The menu owns the new items and destroys the former ones, `chosen` among them.
    menu.ReplaceItems(items);
    if (next != nullptr)
        next->SetMarked(true);
}

String OperationView::getType() const
{
    // One type is always marked, from the constructor on.
    return kTypes[type_->Menu()->IndexOf(type_->Menu()->FindMarked())].type;
}

void OperationView::setType(const String& type)
{
    for (const TypePlan& plan : kTypes) {
        if (type == plan.type)
            type_->Menu()->FindItem(plan.label)->SetMarked(true);
    }
}

void OperationView::SetType(const String& type)
{
    // The menu marks the type first; the fields follow what is marked, also for a text that is no type.
    setType(type);
    const int index = type_->Menu()->IndexOf(type_->Menu()->FindMarked());
    for (const TypedField& field : typedFields_) {
        if ((field.types >> index & 1U) != 0)
            field.view->Show();
        else
            field.view->Hide();
    }
    // Below the amount, where a trade has its quote and cost.
    const float top = ((kIncome >> index & 1U) != 0 ? quote_ : quantity_)->Frame().top;
    marketName_->MoveTo(marketName_->Frame().left, top);
    companyAbbreviation_->MoveTo(companyAbbreviation_->Frame().left, top);
}
