#pragma once

#include "foundation/Date.h"
#include "foundation/String.h"
#include "views/PageView.h"

#include <functional>
#include <optional>
#include <vector>

class Account;
class AccountOperation;
class BMenu;
class BMenuField;
class Operation;
class OperationListView;
class ShareOperation;
template <class Control>
class OfferField;

/// The page of the operations on the portfolio's accounts: a list of all of them, and the fields of one.
///
/// The fields of the chosen type show, the others hide. Some fields take offers: values that are likely, put in as long
/// as nobody has typed there.
class OperationView final : public PageView {
public:
    OperationView(BRect frame, const char* name, BWindow* window);

    /// Whether automatic sales are searched.
    bool isPrevision() const;

    // The list.
    /// Empties the list, keeping in mind what was selected.
    void ClearAllOperations();
    /// Puts rows behind the others.
    void AddOperationList(Operation** operations, int count);
    /// To be called when the list is filled again: selects what was selected, where it still is.
    void RecallSelection();
    /// What was selected belongs to a portfolio that is gone.
    void ForgetSelection();
    /// Shows nothing of the operation any more, in constant time; its row goes with the next refresh.
    void RemoveOperation(const Operation* operation);
    void RemoveAccountOperation(AccountOperation* operation);
    void RemoveShareOperation(ShareOperation* operation);
    /// Takes the rows of removed operations out of a list that is not filled again.
    void DropRemovedOperations();
    /// Draws the operation's row again.
    void UpdateShareOperation(ShareOperation* operation);
    /// Selects the operation's row and brings it into view; the fields stay as they are.
    void ShowOperation(const Operation* operation);

    /// False also when nothing is selected.
    bool IsSelectedAccountOperation() const;
    /// Null when no such operation is selected.
    AccountOperation* GetSelectedAccountOperation() const;
    ShareOperation* GetSelectedShareOperation() const;

    // The fields.
    /// Fills the account menus; the accounts that were chosen stay so, under a new name, too.
    void SetAccountsList(Account** accounts, int count);
    /// "DEPOSIT", "TRANSFER", "BUY" or "SELL".
    String getType() const;
    void setType(const String& type);
    /// The same, and shows the fields of that type in place of those of another one.
    void SetType(const String& type);
    /// Undefined while the field holds no date.
    Date getDate() const;
    void setDate(const Date& date);
    bool getAutomatic() const;
    void setAutomatic(bool automatic);
    /// Names; undefined while no account is chosen.
    String getBaseAccount() const;
    void setBaseAccount(const String& name);
    String getTransferAccount() const;
    void setTransferAccount(const String& name);
    float getAmount() const;
    void setAmount(float amount);
    float getTransferCost() const;
    void setTransferCost(float cost);
    /// As a fraction of the amount.
    float getTransferRateCost() const;
    void setTransferRateCost(float rate);
    float getTransferFromQuote() const;
    void setTransferFromQuote(float quote);
    float getTransferToQuote() const;
    void setTransferToQuote(float quote);
    String getMarketName() const;
    void setMarketName(const String& name);
    String getCompanyAbbreviation() const;
    void setCompanyAbbreviation(const String& ticker);
    int getQuantity() const;
    void setQuantity(int quantity);
    float getQuote() const;
    void setQuote(float quote);
    float getShareCost() const;
    void setShareCost(float cost);
    void setTotal(float total);

    // Offers.
    /// `hook` is called when a person has changed what offers depend on: the date, an account, the market or the
    /// ticker.
    void SetTypingHook(const std::function<void()>& hook);
    void offerDate(const Date& date);
    void offerShareCost(float cost);
    /// Only where a former offer stands: a field emptied by hand says that there is no cost.
    void renewShareCost(float cost);
    /// Without a value what was offered before is taken back.
    void offerQuote(std::optional<float> quote);
    void offerTransferQuotes(std::optional<float> from, std::optional<float> to);

    void Draw(BRect updateRect) override;

private:
    using OfferNumber = OfferField<NumberControl>;

    void makeList();
    void makeFields();
    void makeCommonFields(BBox* box);
    void makeTypedFields(BBox* box);
    void makeButtons(BBox* box);
    BMenuField* addMenu(BView* parent, BRect frame, const char* name, const char* label);
    void fillAccounts(BMenu& menu, Account** accounts, int count);

    OperationListView* operations_ = nullptr;
    BCheckBox* prevision_ = nullptr;
    BMenuField* type_ = nullptr;
    BMenuField* baseAccount_ = nullptr;
    OfferField<DateControl>* date_ = nullptr;
    BCheckBox* automatic_ = nullptr;
    NumberControl* amount_ = nullptr;
    BMenuField* transferAccount_ = nullptr;
    NumberControl* transferCost_ = nullptr;
    NumberControl* transferRateCost_ = nullptr;
    OfferNumber* transferFromQuote_ = nullptr;
    OfferNumber* transferToQuote_ = nullptr;
    OfferField<BTextControl>* marketName_ = nullptr;
    OfferField<BTextControl>* companyAbbreviation_ = nullptr;
    NumberControl* quantity_ = nullptr;
    OfferNumber* quote_ = nullptr;
    OfferNumber* shareCost_ = nullptr;
    BTextControl* total_ = nullptr;

    /// A field that not all types have.
    struct TypedField {
        BView* view;
        unsigned types; // a bit for each, in the order of the menu
    };
    std::vector<TypedField> typedFields_;
    std::function<void()> typingHook_;
};
