// The fields of the operation page: what stands in them, and what is offered there.

#include "foundation/NumberText.h"
#include "platform/Menu.h"
#include "platform/MenuField.h"
#include "platform/MenuItem.h"
#include "views/OperationView.h"

#include <algorithm>

namespace {

constexpr float kTextPadding = 6; // from the sides of a field to its text

} // namespace

String OperationView::chosen(const BMenuField& field)
{
    // The commands know an account by its name.
    const BMenuItem* item = field.Menu()->FindMarked();
    return item != nullptr ? String(item->Label()) : String();
}

void OperationView::choose(BMenuField& field, const String& label)
{
    // No item is marked in between, nor after an empty or unknown label.
    if (BMenuItem* former = field.Menu()->FindMarked())
        former->SetMarked(false);
    if (BMenuItem* item = label.hasText() ? field.Menu()->FindItem(label.getCharacterArray()) : nullptr)
        item->SetMarked(true);
}

void OperationView::show(OfferNumber& field, float value)
{
    // Shown, and not offered: later offers leave the number alone.
    field.setNumber(value);
    field.noteShown();
}

/// What a person typed stays; of an earlier offer, the new one takes the place.
void OperationView::offer(OfferNumber& field, std::optional<float> value)
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

void OperationView::setDate(const Date& date)
{
    // Likewise: the date of a shown operation is no offer.
    date_->setDate(date);
    date_->noteShown();
}

void OperationView::setTotal(std::optional<float> total)
{
    // Thousands separators are welcome here: nobody types in this field, and nothing reads it.
    total_->SetText(total ? amountText(*total).c_str() : "");
}

void OperationView::setCharged(const std::string& text)
{
    charged_->SetText(text.c_str());
    // Where the field has no room for it, the whole text is to be read all the same.
    const float room = charged_->Bounds().Width() - kChargedDivider - 2 * kTextPadding;
    const bool isCut = charged_->StringWidth(text.c_str()) > room;
    charged_->SetToolTip(isCut ? text.c_str() : kChargedTip);
}

void OperationView::SetTypingHook(const std::function<void()>& hook)
{
    // Also for the accounts in the menus, whose items look at this very member.
    typingHook_ = hook;
    date_->setTypingHook(hook);
    marketName_->setTypingHook(hook);
    companyAbbreviation_->setTypingHook(hook);
}

std::array<OperationView::OfferNumber*, 8> OperationView::figures() const
{
    return {amount_,   transferCost_, transferRateCost_, transferFromQuote_, transferToQuote_,
            quantity_, quote_,        shareCost_};
}

void OperationView::SetFigureHook(const std::function<void()>& hook)
{
    for (OfferNumber* field : figures())
        field->setTypingHook(hook);
}

bool OperationView::hasFault() const
{
    const auto fields = figures();
    return std::ranges::any_of(fields, [](const OfferNumber* field) { return !field->IsHidden() && field->fault(); });
}

void OperationView::replaceQuote(std::optional<float> quote)
{
    quote_->noteOffer(); // whatever stands there
    offerQuote(quote);
    if (!quote)
        quote_->MarkAsInvalid(nullptr);
}

void OperationView::offerDate(const Date& date)
{
    if (!date_->isOpen())
        return;
    date_->setDate(date);
    // From here on another offer may take its place, until a person types.
    date_->noteOffer();
}

void OperationView::renewShareCost(float cost)
{
    if (shareCost_->isOffer())
        offerShareCost(cost);
}

void OperationView::offerTransferQuotes(std::optional<float> from, std::optional<float> to)
{
    // Each for itself: one of the two may have been typed.
    offer(*transferFromQuote_, from);
    offer(*transferToQuote_, to);
}
