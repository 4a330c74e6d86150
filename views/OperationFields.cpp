// The fields of the operation page: what they hold, and what is offered in them.

#include "foundation/NumberText.h"
#include "platform/CheckBox.h"
#include "platform/Menu.h"
#include "platform/MenuField.h"
#include "platform/MenuItem.h"
#include "views/DateControl.h"
#include "views/NumberControl.h"
#include "views/OfferField.h"
#include "views/OperationView.h"

namespace {

String chosen(const BMenuField& field)
{
    const BMenuItem* item = field.Menu()->FindMarked();
    return item != nullptr ? String(item->Label()) : String();
}

/// Marks the item of that label, or none.
void choose(BMenuField& field, const String& label)
{
    if (BMenuItem* former = field.Menu()->FindMarked())
        former->SetMarked(false);
    if (BMenuItem* item = label.hasText() ? field.Menu()->FindItem(label.getCharacterArray()) : nullptr)
        item->SetMarked(true);
}

void show(OfferField<NumberControl>& field, float value)
{
    field.setNumber(value);
    field.noteShown();
}

void offer(OfferField<NumberControl>& field, std::optional<float> value)
{
    if (!field.isOpen())
        return;
    if (!value) {
        field.withdrawOffer();
        return;
    }
    field.setNumber(*value);
    field.noteOffer();
}

} // namespace

Date OperationView::getDate() const
{
    return date_->getDate();
}

void OperationView::setDate(const Date& date)
{
    date_->setDate(date);
    date_->noteShown();
}

bool OperationView::getAutomatic() const
{
    return automatic_->Value() == B_CONTROL_ON;
}

void OperationView::setAutomatic(bool automatic)
{
    automatic_->SetValue(automatic ? B_CONTROL_ON : B_CONTROL_OFF);
}

String OperationView::getBaseAccount() const
{
    return chosen(*baseAccount_);
}

void OperationView::setBaseAccount(const String& name)
{
    choose(*baseAccount_, name);
}

String OperationView::getTransferAccount() const
{
    return chosen(*transferAccount_);
}

void OperationView::setTransferAccount(const String& name)
{
    choose(*transferAccount_, name);
}

float OperationView::getAmount() const
{
    return amount_->getNumber();
}

void OperationView::setAmount(float amount)
{
    amount_->setNumber(amount);
}

float OperationView::getTransferCost() const
{
    return transferCost_->getNumber();
}

void OperationView::setTransferCost(float cost)
{
    transferCost_->setNumber(cost);
}

float OperationView::getTransferRateCost() const
{
    return transferRateCost_->getNumber();
}

void OperationView::setTransferRateCost(float rate)
{
    transferRateCost_->setNumber(rate);
}

float OperationView::getTransferFromQuote() const
{
    return transferFromQuote_->getNumber();
}

void OperationView::setTransferFromQuote(float quote)
{
    show(*transferFromQuote_, quote);
}

float OperationView::getTransferToQuote() const
{
    return transferToQuote_->getNumber();
}

void OperationView::setTransferToQuote(float quote)
{
    show(*transferToQuote_, quote);
}

String OperationView::getMarketName() const
{
    return marketName_->Text();
}

void OperationView::setMarketName(const String& name)
{
    showText(*marketName_, name);
}

String OperationView::getCompanyAbbreviation() const
{
    return companyAbbreviation_->Text();
}

void OperationView::setCompanyAbbreviation(const String& ticker)
{
    showText(*companyAbbreviation_, ticker);
}

int OperationView::getQuantity() const
{
    return quantity_->getInteger();
}

void OperationView::setQuantity(int quantity)
{
    quantity_->setInteger(quantity);
}

float OperationView::getQuote() const
{
    return quote_->getNumber();
}

void OperationView::setQuote(float quote)
{
    show(*quote_, quote);
}

float OperationView::getShareCost() const
{
    return shareCost_->getNumber();
}

void OperationView::setShareCost(float cost)
{
    show(*shareCost_, cost);
}

void OperationView::setTotal(float total)
{
    total_->SetText(amountText(total).c_str());
}

// --- Offers.

void OperationView::SetTypingHook(const std::function<void()>& hook)
{
    typingHook_ = hook;
    date_->setTypingHook(hook);
    marketName_->setTypingHook(hook);
    companyAbbreviation_->setTypingHook(hook);
}

void OperationView::offerDate(const Date& date)
{
    if (!date_->isOpen())
        return;
    date_->setDate(date);
    date_->noteOffer();
}

void OperationView::offerShareCost(float cost)
{
    offer(*shareCost_, cost);
}

void OperationView::renewShareCost(float cost)
{
    if (shareCost_->isOffer())
        offerShareCost(cost);
}

void OperationView::offerQuote(std::optional<float> quote)
{
    offer(*quote_, quote);
}

void OperationView::offerTransferQuotes(std::optional<float> from, std::optional<float> to)
{
    offer(*transferFromQuote_, from);
    offer(*transferToQuote_, to);
}
