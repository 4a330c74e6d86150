// The filters of the operation page: which operations the list shows.

#include "foundation/NumberText.h"
#include "platform/MenuField.h"
#include "platform/MenuItem.h"
#include "platform/PopUpMenu.h"
#include "platform/SearchControl.h"
#include "portfolio/Account.h"
#include "views/Look.h"
#include "views/OperationView.h"

#include <algorithm>
#include <utility>

using namespace look;

namespace {

/// Calls a function when it is chosen, and sends nothing.
class ChoiceItem final : public BMenuItem {
public:
    ChoiceItem(const char* label, std::function<void()> chosen) : BMenuItem(label, nullptr), chosen_(std::move(chosen))
    {}

    status_t Invoke(const BMessage*) override
    {
        chosen_();
        return B_OK;
    }

private:
    std::function<void()> chosen_;
};

} // namespace

void OperationView::makeFilters(BBox* box)
{
    constexpr float kTop = kBoxTop + 4;
    constexpr float kBottom = kTop + kFieldHeight;
    const float right = box->Bounds().Width() - kBoxSide;
    constexpr float kYears = 170;
    constexpr float kAccounts = 230;
    filter_ = new BSearchControl({kBoxSide, kTop, right - kYears - kAccounts - 2 * kMargin, kBottom}, "txtFilter",
                                 "Filter", "any words or amounts");
    filter_->SetDivider(40);
    filter_->SetAlignment(B_ALIGN_RIGHT, B_ALIGN_LEFT);
    filter_->SetToolTip("Shows operations with all of these words.  Ctrl+F; Escape shows all again");
    filter_->SetHooks([this] { filter(); }, [this] { operations_->MakeFocus(); });
    box->AddChild(filter_);
    const auto add = [&](float end, float width, const char* name, const char* label) {
        auto* field = new BMenuField({end - width, kTop, end, kBottom}, name, label, new BPopUpMenu(name));
        field->SetDivider(54);
        field->SetAlignment(B_ALIGN_RIGHT);
        box->AddChild(field);
        return field;
    };
    filterAccount_ = add(right - kYears - kMargin, kAccounts, "filterAccount", "Account");
    filterYear_ = add(right, kYears, "filterYear", "Year");
    fillAccountFilter(nullptr, 0);
    fillYearFilter();
}

void OperationView::fillAccountFilter(Account** accounts, int count)
{
    const auto choose = [this](const Account* account) {
        chosenAccount_ = account;
        chosenAccountName_ = account != nullptr ? account->getName() : String();
        filter();
    };
    // The one that was chosen may be gone: its address is only compared.
    const auto isChosen = [&](const Account* account) { return account == chosenAccount_; };
    if (chosenAccountName_.hasText() && std::none_of(accounts, accounts + count, isChosen)) {
        const auto* same =
            std::find_if(accounts, accounts + count, [&](Account* a) { return a->getName() == chosenAccountName_; });
        chosenAccount_ = same != accounts + count ? *same : nullptr;
    }
    std::vector<BMenuItem*> items{new ChoiceItem("All accounts", [choose] { choose(nullptr); })};
    std::size_t marked = 0;
    for (int i = 0; i < count; ++i) {
        const Account* account = accounts[i];
        items.push_back(new ChoiceItem(wholeTextOf(account->getName()), [choose, account] { choose(account); }));
        if (isChosen(account)) {
            marked = items.size() - 1;
            chosenAccountName_ = account->getName(); // it may have another one since it was chosen
        }
    }
    // Of the only account there is a balance, too.
    onlyAccount_ = count == 1 ? accounts[0] : nullptr;
    filterAccount_->Menu()->ReplaceItems(items);
    items[marked]->SetMarked(true);
    if (operations_ != nullptr)
        operations_->setAccount(marked > 0 ? chosenAccount_ : onlyAccount_);
}

void OperationView::fillYearFilter()
{
    const auto choose = [this](std::optional<int> year) {
        chosenYear_ = year;
        filter();
    };
    std::vector<int> years = operations_ != nullptr ? operations_->years() : std::vector<int>();
    // A year that nothing is left of stays chosen, and shows that.
    if (chosenYear_ && std::ranges::find(years, *chosenYear_) == years.end())
        years.insert(std::ranges::find_if(years, [this](int year) { return year < *chosenYear_; }), *chosenYear_);
    std::vector<BMenuItem*> items{new ChoiceItem("All years", [choose] { choose(std::nullopt); })};
    std::size_t marked = 0;
    for (const int year : years) {
        items.push_back(new ChoiceItem(std::to_string(year).c_str(), [choose, year] { choose(year); }));
        if (chosenYear_ == year)
            marked = items.size() - 1;
    }
    filterYear_->Menu()->ReplaceItems(items);
    items[marked]->SetMarked(true);
}

void OperationView::filter()
{
    endFlash(); // a row that goes from view with a light would come back with it
    operations_->setAccount(chosenAccount_ != nullptr ? chosenAccount_ : onlyAccount_);
    operations_->setYear(chosenYear_);
    operations_->setFilter(filter_->Text());
    tellFiltered();
}

void OperationView::AboutToUpdate()
{
    if (operations_->isSelectionHidden())
        ShowAllOperations();
}

void OperationView::ShowAllOperations()
{
    filter_->SetText("");
    chosenAccount_ = nullptr;
    chosenAccountName_ = String();
    chosenYear_.reset();
    for (const BMenuField* menu : {filterAccount_, filterYear_})
        menu->Menu()->ItemAt(0)->SetMarked(true);
    filter();
}

void OperationView::tellFiltered()
{
    const int shown = operations_->CountItems();
    const int all = operations_->CountRows();
    // A column that would be empty is not worth its room.
    bool isAnyAutomatic = false;
    for (int i = 0; i < shown && !isAnyAutomatic; ++i)
        isAnyAutomatic = operations_->objectAt(i) != nullptr && operations_->objectAt(i)->isAutomatic();
    constexpr std::size_t kAutomaticColumn = 10;
    operations_->showColumn(kAutomaticColumn, isAnyAutomatic);
    std::string title = "Operations";
    if (shown < all)
        title += " - " + countText(shown) + " of " + countText(all) + " shown";
    listBox_->SetLabel(title.c_str());
}
