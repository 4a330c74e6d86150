#pragma once

#include "foundation/Date.h"
#include "foundation/String.h"
#include "platform/CheckBox.h"
#include "portfolio/AccountOperation.h"
#include "portfolio/ShareOperation.h"
#include "views/DateControl.h"
#include "views/NumberControl.h"
#include "views/OfferField.h"
#include "views/OperationListView.h"
#include "views/PageView.h"

#include <array>
#include <functional>
#include <memory>
#include <optional>
#include <vector>

class Account;
class BMenu;
class BMenuField;
class BMessageRunner;
class BSearchControl;

/// The page of the operations on the portfolio's accounts: a list of all of them, and the fields of one.
///
/// The fields of the chosen type show, the others hide. Some fields take offers: values that are likely, put in as long
/// as nobody has typed there.
class OperationView final : public PageView {
public:
    OperationView(BRect frame, const char* name, BWindow* window);
    ~OperationView() override;

    /// Whether automatic sales are searched.
    bool isPrevision() const { return prevision_->Value() == B_CONTROL_ON; }
    void setPrevision(bool isOn) { prevision_->SetValue(isOn); }

    // The list.
    /// Empties the list, keeping in mind what was selected.
    void ClearAllOperations();
    /// Puts rows behind the others.
    void AddOperationList(Operation** operations, int count) { operations_->addAll({operations, operations + count}); }
    /// To be called when the list is filled again: shows what the filters let through, and selects what was selected,
    /// where it still is.
    void RecallSelection();
    /// What was selected belongs to a portfolio that is gone.
    void ForgetSelection()
    {
        operations_->forget();
        endFlash(); // another operation may come to have its address
    }
    /// Shows nothing of the operation any more, in constant time; its row goes with the next refresh.
    void RemoveOperation(const Operation* operation) { operations_->release(operation); }
    void RemoveAccountOperation(AccountOperation* operation) { RemoveOperation(operation); }
    void RemoveShareOperation(ShareOperation* operation) { RemoveOperation(operation); }
    /// What is selected and in view.
    ListPlaces selection() const { return operations_->selection(); }
    /// Sends no message.
    void restoreSelection(const ListPlaces& places) { operations_->restoreSelection(places); }
    /// The operation of the fields shows again, and is the selected one: hidden it would be added a second time.
    void AboutToUpdate() override;
    /// Those that the filters let through, in the order in which they show.
    std::vector<const Operation*> shownOperations() const { return operations_->allShown(); }
    /// Takes the filters away.
    void ShowAllOperations();
    /// Takes the rows of removed operations out of a list that is not filled again.
    void DropRemovedOperations() { operations_->dropReleased(); }
    /// Draws the operation's row again.
    void UpdateShareOperation(ShareOperation* operation) { operations_->modify(operation); }
    /// Selects the operation's row and brings it into view, also when the filters had hidden it; the fields stay as
    /// they are.
    void ShowOperation(const Operation* operation);
    /// Lights up the operation's row for a moment, where there is one.
    void FlashOperation(const Operation* operation);

    /// False also when nothing is selected.
    bool IsSelectedAccountOperation() const { return GetSelectedAccountOperation() != nullptr; }
    /// Null when no such operation is selected.
    AccountOperation* GetSelectedAccountOperation() const;
    ShareOperation* GetSelectedShareOperation() const;

    // The fields.
    /// Fills the account menus; the accounts that were chosen stay so, under a new name, too.
    void SetAccountsList(Account** accounts, int count);
    /// "DEPOSIT", "TRANSFER", "BUY", "SELL", "INCOME" or "CHARGE".
    String getType() const;
    void setType(const String& type);
    /// The same, and shows the fields of that type in place of those of another one.
    void SetType(const String& type);
    /// Undefined while the field holds no date.
    Date getDate() const { return date_->getDate(); }
    void setDate(const Date& date);
    bool getAutomatic() const { return automatic_->Value() == B_CONTROL_ON; }
    void setAutomatic(bool automatic) { automatic_->SetValue(automatic); }
    /// Names; undefined while no account is chosen.
    String getBaseAccount() const { return chosen(*baseAccount_); }
    void setBaseAccount(const String& name) { choose(*baseAccount_, name); }
    String getTransferAccount() const { return chosen(*transferAccount_); }
    void setTransferAccount(const String& name) { choose(*transferAccount_, name); }
    float getAmount() const { return amount_->getNumber(); }
    void setAmount(float amount) { amount_->setNumber(amount); }
    float getTransferCost() const { return transferCost_->getNumber(); }
    void setTransferCost(float cost) { transferCost_->setNumber(cost); }
    /// As a fraction of the amount.
    float getTransferRateCost() const { return transferRateCost_->getNumber(); }
    void setTransferRateCost(float rate) { transferRateCost_->setNumber(rate); }
    float getTransferFromQuote() const { return transferFromQuote_->getNumber(); }
    void setTransferFromQuote(float quote) { show(*transferFromQuote_, quote); }
    float getTransferToQuote() const { return transferToQuote_->getNumber(); }
    void setTransferToQuote(float quote) { show(*transferToQuote_, quote); }
    String getMarketName() const { return marketName_->Text(); }
    void setMarketName(const String& name) { showText(*marketName_, name); }
    String getCompanyAbbreviation() const { return companyAbbreviation_->Text(); }
    void setCompanyAbbreviation(const String& ticker) { showText(*companyAbbreviation_, ticker); }
    int getQuantity() const { return quantity_->getInteger(); }
    void setQuantity(int quantity) { quantity_->setInteger(quantity); }
    float getQuote() const { return quote_->getNumber(); }
    void setQuote(float quote) { show(*quote_, quote); }
    float getShareCost() const { return shareCost_->getNumber(); }
    void setShareCost(float cost) { show(*shareCost_, cost); }
    /// Nothing empties the field.
    void setTotal(std::optional<float> total);
    /// Whether a number that the type has cannot be read.
    bool hasFault() const;
    /// What the account will be charged.
    void setCharged(const std::string& text);

    // Offers.
    /// `hook` is called when a person has changed what offers depend on: the date, an account, the market or the
    /// ticker.
    void SetTypingHook(const std::function<void()>& hook);
    /// `hook` is called when a person has changed another figure of the operation.
    void SetFigureHook(const std::function<void()>& hook);
    void offerDate(const Date& date);
    void offerShareCost(float cost) { offer(*shareCost_, cost); }
    /// Only where a former offer stands: a field emptied by hand says that there is no cost.
    void renewShareCost(float cost);
    /// Without a value what was offered before is taken back.
    void offerQuote(std::optional<float> quote) { offer(*quote_, quote); }
    /// The same also where a quote was typed: it was that of something else.
    void replaceQuote(std::optional<float> quote);
    /// Whether nothing stands in the field but an offer.
    bool isQuoteOffered() const { return quote_->isOpen(); }
    void offerTransferQuotes(std::optional<float> from, std::optional<float> to);

    void Draw(BRect updateRect) override;
    void MessageReceived(BMessage* message) override;

private:
    using OfferNumber = OfferField<NumberControl>;

    std::array<OfferNumber*, 8> figures() const;
    static String chosen(const BMenuField& field);
    /// Marks the item of that label, or none.
    static void choose(BMenuField& field, const String& label);
    static void show(OfferNumber& field, float value);
    static void offer(OfferNumber& field, std::optional<float> value);

    void lightFlashed(float light);
    void endFlash();
    void makeList();
    void makeFilters(BBox* box);
    void fillAccountFilter(Account** accounts, int count);
    void fillYearFilter();
    /// Shows what the three filters let through.
    void filter();
    void tellFiltered();
    void makeFields();
    void makeCommonFields(BBox* box);
    void makeTypedFields(BBox* box);
    void makeButtons(BBox* box);
    BMenuField* addMenu(BView* parent, BRect frame, const char* name, const char* label);
    void fillAccounts(BMenu& menu, Account** accounts, int count);

    BBox* listBox_ = nullptr;
    static constexpr float kChargedDivider = 64;
    static constexpr const char* kChargedTip = "What the account pays or gets, with all costs";

    OperationListView* operations_ = nullptr;
    BSearchControl* filter_ = nullptr;
    BMenuField* filterAccount_ = nullptr;
    BMenuField* filterYear_ = nullptr;
    // What was chosen last in the two menus. The account is found again by its name when it is another object.
    const Account* onlyAccount_ = nullptr; // where there is one
    const Account* chosenAccount_ = nullptr;
    String chosenAccountName_;
    std::optional<int> chosenYear_;
    BCheckBox* prevision_ = nullptr;
    BMenuField* type_ = nullptr;
    BMenuField* baseAccount_ = nullptr;
    OfferField<DateControl>* date_ = nullptr;
    BCheckBox* automatic_ = nullptr;
    OfferNumber* amount_ = nullptr;
    BMenuField* transferAccount_ = nullptr;
    OfferNumber* transferCost_ = nullptr;
    OfferNumber* transferRateCost_ = nullptr;
    OfferNumber* transferFromQuote_ = nullptr;
    OfferNumber* transferToQuote_ = nullptr;
    OfferField<BTextControl>* marketName_ = nullptr;
    OfferField<BTextControl>* companyAbbreviation_ = nullptr;
    OfferNumber* quantity_ = nullptr;
    OfferNumber* quote_ = nullptr;
    OfferNumber* shareCost_ = nullptr;
    BTextControl* total_ = nullptr;
    BTextControl* charged_ = nullptr;

    /// A field that not all types have.
    struct TypedField {
        BView* view;
        unsigned types; // a bit for each, in the order of the menu
    };
    std::vector<TypedField> typedFields_;
    std::function<void()> typingHook_;

    const Operation* flashed_ = nullptr; // may be gone: only to be compared
    int flashStep_ = 0;                  // how many are left until the row looks as always
    std::unique_ptr<BMessageRunner> flashTimer_;
};
