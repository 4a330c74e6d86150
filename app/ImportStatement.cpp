#include "app/ImportStatement.h"

#include "exchange/TextForms.h"
#include "foundation/DateText.h"
#include "foundation/NumberText.h"
#include "history/WalletImage.h"
#include "market/Company.h"
#include "portfolio/Account.h"
#include "portfolio/Wallet.h"
#include "valuation/Evolution.h"
#include "valuation/State.h"
#include "views/Look.h"

#include <algorithm>
#include <filesystem>
#include <set>
#include <stdexcept>
#include <unordered_map>

namespace {

constexpr const char* kNone = "(none)";

// The places of the list's columns that are needed by themselves.
constexpr std::size_t kAccountColumn = 4;

const std::vector<ListColumn> kListColumns = {{"Becomes", 90},
                                              {"Line", 36, B_ALIGN_RIGHT},
                                              {"Date", 78},
                                              {"Type", 76},
                                              {"Account", 70},
                                              {"What", 72},
                                              {"Quantity", 62, B_ALIGN_RIGHT},
                                              {"Quote/Sum", 78, B_ALIGN_RIGHT},
                                              {"Cost", 46, B_ALIGN_RIGHT},
                                              {"Note", kRemainingWidth}};

std::string capitalised(std::string text)
{
    if (!text.empty() && text[0] >= 'a' && text[0] <= 'z')
        text[0] = static_cast<char>(text[0] - 'a' + 'A');
    return text;
}

Cell lineCell(unsigned long line, rgb_color color)
{
    return {std::to_string(line), color, static_cast<double>(line)};
}

Cell numberCell(const std::string& text, double number, rgb_color color)
{
    return {text, color, number};
}

std::vector<Cell> rowOf(const PlannedOperation& operation, bool isNew)
{
    const rgb_color color = isNew ? look::kText : look::kFaint;
    const auto& recipient = operation.recipient;
    std::vector<Cell> row = {{isNew ? "New" : "Already there", color},
                             lineCell(operation.line, color),
                             {dateText(operation.date), color, dayOrder(operation.date)},
                             {nameOf(operation.kind), color},
                             {operation.account->name, color}};
    if (operation.isTrade()) {
        row.push_back({textOf(operation.company->getAbbreviation()), color});
        row.push_back(numberCell(countText(operation.quantity), operation.quantity, color));
        row.push_back(numberCell(exactText(operation.quote), operation.quote, color));
    } else {
        row.push_back({recipient != nullptr ? "to " + recipient->name : "", color});
        row.push_back({});
        row.push_back(numberCell(amountText(operation.amount), operation.amount, color));
    }
    row.push_back(operation.cost != 0 ? numberCell(amountText(operation.cost), operation.cost, color) : Cell{});
    row.push_back(operation.otherAmount != 0 ? Cell{"its amount is " + amountText(operation.otherAmount) +
                                                        ", which is not quantity times quote and cost",
                                                    look::kWarning}
                                             : Cell{});
    return row;
}

/// What the line says, word for word.
std::vector<Cell> rowOf(const StatementTable& table, const StatementTable::Row& row, const std::string& reason)
{
    const auto cellOf = [&](StatementColumn column) { return std::string(table.cell(row, column)); };
    const auto firstOf = [&](std::initializer_list<StatementColumn> columns) {
        for (const StatementColumn column : columns)
            if (std::string text = cellOf(column); !text.empty())
                return text;
        return std::string();
    };
    using enum StatementColumn;
    return {{"Refused", look::kWarning},
            lineCell(row.line, look::kText),
            {cellOf(kDate)},
            {cellOf(kType)},
            {cellOf(kAccount)},
            {firstOf({kTicker, kName, kToAccount})},
            {cellOf(kQuantity)},
            {firstOf({kQuote, kAmount, kDebit, kCredit})},
            {cellOf(kCost)},
            {reason, look::kWarning}};
}

std::vector<Cell> rowOf(const StatementTable::PassedOver& line)
{
    std::vector<Cell> row(kListColumns.size());
    row[0] = {"Passed over", look::kFaint};
    row[1] = lineCell(line.line, look::kFaint);
    row.back() = {std::string(line.reason) + ": " + line.text, look::kFaint};
    return row;
}

/// The cash of all accounts after all operations, in the order of the wallet.
std::vector<float> cashOf(Wallet& wallet)
{
    std::vector<float> cash;
    for (const AccountState* state :
         refreshStates(wallet, State::afterAllOperations(), false, nullptr)->accountStates())
        cash.push_back(state->getCash());
    return cash;
}

/// The number of the item that is `text`, counted from 1; 0 when there is none.
int itemOf(const std::vector<std::string>& items, const std::string& text)
{
    const auto found = std::ranges::find(items, text);
    return found != items.end() ? static_cast<int>(found - items.begin()) + 1 : 0;
}

} // namespace

ImportStatement::ImportStatement(PLWindow& window, const DataFolder& folder, const std::string& path)
    : PendingImport(window), path_(path), folder_(folder), profiles_(folder.path() + DataFolder::kProfiles)
{
    if (auto kept = profiles_.find(path)) {
        knownAs_ = kept->name;
        profile_ = std::move(kept->profile);
    }
    read();
    if (headings_.empty())
        throw std::runtime_error(path + ": has no line that may be the headings of a statement");
}

StatementProfile ImportStatement::profile() const
{
    StatementProfile profile = profile_;
    const auto tell = [&profile](StatementColumn column, const std::string& heading) {
        profile.addColumn(std::string(nameOf(column)) + '=' + heading);
    };
    const auto told = headingsTold(columnsTold_);
    // What the profile has for another column, that column has no more.
    for (const auto& [column, heading] : told)
        for (std::size_t i = 0; i < kStatementColumns && !heading.empty(); ++i)
            if (profile.headingOf(static_cast<StatementColumn>(i)) == heading)
                tell(static_cast<StatementColumn>(i), "");
    for (const auto& [column, heading] : told)
        tell(column, heading);
    return profile;
}

/// Reads the table anew; what it means depends on what was told.
void ImportStatement::read()
{
    tellProgress("Reading " + importedName(path_) + " ...");
    plan_.reset();
    table_.reset();
    problem_.clear();
    try {
        table_ = std::make_unique<StatementTable>(path_, profile());
        headings_ = table_->headings();
        for (std::size_t i = 0; i < kStatementColumns; ++i)
            columns_[i] = table_->headingOf(static_cast<StatementColumn>(i));
    } catch (const UnfitStatement& unfit) {
        problem_ = capitalised(unfit.reason) + ": choose below what is meant.";
        headings_ = unfit.headings;
        columns_ = unfit.columns;
    }
    for (std::string& heading : headings_)
        heading = withoutBlanks(std::string(heading));
    std::erase(headings_, "");
    makePlan();
}

/// The file may be gone by now.
void ImportStatement::readAgain()
{
    try {
        read();
    } catch (const std::runtime_error& error) {
        problem_ = capitalised(error.what());
    }
}

void ImportStatement::makePlan()
{
    plan_.reset();
    if (table_ == nullptr)
        return;
    problem_.clear();
    try {
        plan_ = std::make_unique<OperationPlan>(*table_, profile_, newAccounts_, *window().getWallet(),
                                                window().catalogue());
    } catch (const std::runtime_error& error) {
        problem_ = capitalised(error.what());
    }
}

ImportSheet ImportStatement::sheet()
{
    ImportSheet sheet;
    sheet.title = "Operations in " + importedName(path_);
    sheet.columns = kListColumns;
    sheet.problem = problem();
    sheet.headline = importedName(path_);
    if (isStale())
        return sheet;
    sheet.note = note();
    askForColumns(sheet);
    askForWords(sheet);
    askForMissing(sheet);
    askForAccount(sheet);
    askForDates(sheet);
    if (plan_ == nullptr)
        return sheet;
    sheet.headline += ":  " + importedCount(plan_->operations().size(), "new operation") + ", " +
                      countText(static_cast<int>(plan_->booked().size())) + " already there, " +
                      countText(static_cast<int>(plan_->refused().size())) + " refused";
    sheet.hasRefused = sheet.asksToSkip = !plan_->refused().empty();
    sheet.skips = skips_;
    fillRows(sheet);
    fillCash(sheet);
    return sheet;
}

std::string ImportStatement::problem() const
{
    if (isStale())
        return kStale;
    if (plan_ == nullptr)
        return problem_;
    if (!plan_->refused().empty() && !skips_) {
        const bool isOpen =
            std::ranges::any_of(plan_->refused(), [](const auto& line) { return line.untold.has_value(); });
        return std::string("Nothing is imported while lines are refused: ") +
               (isOpen ? "choose what they leave open, or tick the box below."
                       : "mend the table, or tick the box below.");
    }
    return plan_->isEmpty() ? "There is nothing new in it." : "";
}

std::string ImportStatement::note() const
{
    if (isTold_)
        return "What you have chosen is kept for the next table of these headings.";
    return knownAs_.empty() ? "" : "Columns, words and account are taken as for " + knownAs_ + '.';
}

void ImportStatement::askForColumns(ImportSheet& sheet) const
{
    ImportSheet::Question column{"importColumn", "Column", true};
    for (std::size_t i = 0; i < kStatementColumns; ++i)
        column.items.push_back(capitalised(nameOf(static_cast<StatementColumn>(i))) + ": " +
                               (columns_[i].empty() ? kNone : columns_[i]));
    column.marked = static_cast<int>(column_);
    column.toolTip = "A column of operations, with the heading under which it stands in the table";
    ImportSheet::Question heading{"importHeading", "stands under", false, {kNone}};
    heading.items.insert(heading.items.end(), headings_.begin(), headings_.end());
    heading.marked = itemOf(headings_, columns_[column_]);
    heading.toolTip = "The heading of that column in the table";
    sheet.questions.push_back(std::move(column));
    sheet.questions.push_back(std::move(heading));
}

void ImportStatement::askForWords(ImportSheet& sheet) const
{
    const auto words = unknownWords();
    if (words.empty())
        return;
    ImportSheet::Question word{"importWord", "Type", true};
    for (const std::string& text : words) {
        const auto type = profile_.typeOf(text);
        word.items.push_back(text + ": " + (type ? nameOf(*type) : "?"));
    }
    const std::size_t shown = std::min(word_, words.size() - 1);
    word.marked = static_cast<int>(shown);
    word.toolTip = "A word of the table for what an operation is, that is not known";
    ImportSheet::Question type{"importType", "means", false, {"?"}};
    for (int i = 0; i <= static_cast<int>(StatementType::kCharge); ++i)
        type.items.push_back(capitalised(nameOf(static_cast<StatementType>(i))));
    const auto told = profile_.typeOf(words[shown]);
    type.marked = told ? static_cast<int>(*told) + 1 : 0;
    type.toolTip = "What that word means";
    sheet.questions.push_back(std::move(word));
    sheet.questions.push_back(std::move(type));
}

void ImportStatement::askForMissing(ImportSheet& sheet) const
{
    const auto missing = missingAccounts();
    if (missing.empty())
        return;
    const auto symbols = this->symbols();
    const auto currencyOf = [&](const std::string& name) {
        const auto made = std::ranges::find(newAccounts_, name, &OperationPlan::NewAccount::name);
        return made != newAccounts_.end() ? made->symbol : std::string();
    };
    ImportSheet::Question account{"importMissing", "Missing account", true};
    for (const std::string& name : missing)
        account.items.push_back(name + (currencyOf(name).empty() ? ": not made" : ": in " + currencyOf(name)));
    const std::size_t shown = std::min(missing_, missing.size() - 1);
    account.marked = static_cast<int>(shown);
    account.toolTip = "An account that lines of the table name and the portfolio does not have";
    ImportSheet::Question currency{"importCurrency", "make it in", false, {"(do not make it)"}};
    currency.items.insert(currency.items.end(), symbols.begin(), symbols.end());
    currency.marked = itemOf(symbols, currencyOf(missing[shown]));
    currency.toolTip = "The currency of the account that is made";
    sheet.questions.push_back(std::move(account));
    sheet.questions.push_back(std::move(currency));
}

void ImportStatement::askForAccount(ImportSheet& sheet) const
{
    if (!needsAccount())
        return;
    const auto symbols = this->symbols();
    ImportSheet::Question lines{"importAccount", "Lines without account", true, {kNone}};
    std::vector<std::string> names;
    for (const Account* account : window().getWallet()->accounts())
        names.emplace_back(account->getName().comparedBytes());
    lines.items.insert(lines.items.end(), names.begin(), names.end());
    // An account of that name would be taken, and none made.
    const bool isFree = std::ranges::find(names, accountToMake()) == names.end();
    for (const std::string& symbol : isFree ? symbols : std::vector<std::string>())
        lines.items.push_back("a new one, " + accountToMake() + ", in " + symbol);
    lines.marked = profile_.account().empty() ? 0 : itemOf(names, profile_.account());
    const auto made = std::ranges::find(newAccounts_, accountToMake(), &OperationPlan::NewAccount::name);
    if (made != newAccounts_.end() && profile_.account() == made->name)
        lines.marked = static_cast<int>(names.size()) + itemOf(symbols, made->symbol);
    lines.toolTip = "The account of the lines that name none";
    sheet.questions.push_back(std::move(lines));
}

void ImportStatement::askForDates(ImportSheet& sheet) const
{
    if (!needsDates())
        return;
    ImportSheet::Question dates{"importDates",
                                "Dates",
                                !needsAccount(),
                                {"as the table shows them", "with the day first", "with the month first"}};
    const auto isMonthFirst = profile_.isMonthFirst();
    dates.marked = !isMonthFirst ? 0 : *isMonthFirst ? 2 : 1;
    dates.toolTip = "Which number of a date is the day; the day is first where no date of the table shows it";
    sheet.questions.push_back(std::move(dates));
}

bool ImportStatement::needsDates() const
{
    if (table_ == nullptr || profile_.isMonthFirst())
        return true;
    return std::ranges::any_of(table_->rows(), [this](const auto& row) {
        const auto date = WrittenDate::read(table_->cell(row, StatementColumn::kDate));
        return date && !date->isOrderKnown;
    });
}

bool ImportStatement::needsAccount() const
{
    return table_ != nullptr && std::ranges::any_of(table_->rows(), [this](const auto& row) {
               return !row.fields.empty() && table_->cell(row, StatementColumn::kAccount).empty();
           });
}

/// Those that are not known by themselves, told or not, in the order of the table.
std::vector<std::string> ImportStatement::unknownWords() const
{
    std::vector<std::string> words;
    std::set<std::string> keys;
    const StatementProfile untold;
    if (table_ != nullptr)
        for (const auto& row : table_->rows()) {
            const std::string word(table_->cell(row, StatementColumn::kType));
            if (!word.empty() && keys.insert(wordKey(word)).second && !untold.typeOf(word))
                words.push_back(word);
        }
    return words;
}

/// Those that lines name and the portfolio does not have, to be made or not.
std::vector<std::string> ImportStatement::missingAccounts() const
{
    std::vector<std::string> names;
    std::set<std::string, std::less<>> known{""};
    for (const Account* account : window().getWallet()->accounts())
        known.emplace(account->getName().comparedBytes());
    const auto take = [&](std::string_view name) {
        if (known.emplace(name).second)
            names.emplace_back(name);
    };
    if (table_ != nullptr)
        for (const auto& row : table_->rows()) {
            take(table_->cell(row, StatementColumn::kAccount));
            if (profile_.typeOf(std::string(table_->cell(row, StatementColumn::kType))) == StatementType::kTransfer)
                take(table_->cell(row, StatementColumn::kToAccount));
        }
    return names;
}

std::vector<std::string> ImportStatement::symbols() const
{
    std::vector<std::string> symbols;
    for (const Currency* currency : window().catalogue().getCurrencies()) {
        const std::string symbol(currency->getRepresentation().comparedBytes());
        if (std::ranges::find(symbols, symbol) == symbols.end())
            symbols.push_back(symbol);
    }
    return symbols;
}

/// Named after the file.
std::string ImportStatement::accountToMake() const
{
    return std::filesystem::path(path_).stem();
}

void ImportStatement::fillRows(ImportSheet& sheet) const
{
    std::unordered_map<unsigned long, const StatementTable::Row*> lines;
    for (const auto& row : table_->rows())
        lines.emplace(row.line, &row);
    // What a person has to do something about comes first.
    for (const auto& refusal : plan_->refused())
        sheet.rows.push_back(rowOf(*table_, *lines.at(refusal.line), refusal.reason));
    for (const auto& operation : plan_->operations())
        sheet.rows.push_back(rowOf(operation, true));
    for (const auto& operation : plan_->booked())
        sheet.rows.push_back(rowOf(operation, false));
    // Where all are on one account, the notes have its room.
    std::set<std::string> accounts;
    for (const auto& row : sheet.rows)
        accounts.insert(row[kAccountColumn].text);
    accounts.erase("");
    sheet.columns[kAccountColumn].isHidden = accounts.size() < 2;
    // So have they that of columns without any text.
    for (std::size_t i = kAccountColumn + 1; i + 1 < sheet.columns.size(); ++i)
        sheet.columns[i].isHidden =
            std::ranges::all_of(sheet.rows, [i](const auto& row) { return row[i].text.empty(); });
    for (const auto& line : table_->passedOver())
        sheet.rows.push_back(rowOf(line));
}

/// By booking all of it in a copy of the portfolio: each balance is rounded after every operation.
void ImportStatement::fillCash(ImportSheet& sheet) const
{
    const Catalogue& catalogue = window().catalogue();
    const Wallet& wallet = *window().getWallet();
    const auto copy = WalletImage::of(wallet, catalogue, [](const Operation&) { return true; }).make(catalogue);
    copy->setCatalogue(catalogue);
    const std::vector<float> before = cashOf(*copy);
    OperationPlan(*table_, profile_, newAccounts_, *copy, catalogue).book(*copy);
    const std::vector<float> after = cashOf(*copy);
    const auto accounts = copy->accounts();
    for (std::size_t i = 0; i < accounts.size(); ++i) {
        const float former = i < before.size() ? before[i] : 0;
        sheet.cash.push_back({{textOf(accounts[i]->getName())},
                              {textOf(accounts[i]->getCurrencyRepresentation())},
                              numberCell(amountText(former), former, look::kText),
                              numberCell(amountText(after[i]), after[i], look::kText)});
    }
    // Those that are changed, or made, show without scrolling.
    std::ranges::stable_partition(sheet.cash, [](const auto& row) { return row[2].text != row[3].text; });
    sheet.cashTitle = "Cash after All Operations";
    if (wallet.getBuyRateCost() != 0 || wallet.getSellRateCost() != 0)
        sheet.cashTitle += ", with the portfolio's rate costs of " + finePercentText(wallet.getBuyRateCost()) +
                           " of purchases and " + finePercentText(wallet.getSellRateCost()) + " of sales";
}

void ImportStatement::choose(const std::string& question, std::size_t item)
{
    if (isStale())
        return;
    if (question == "importColumn")
        column_ = item;
    else if (question == "importWord")
        word_ = item;
    else if (question == "importMissing")
        missing_ = item;
    else if (question == "importHeading") {
        tellHeading(columnsTold_, static_cast<StatementColumn>(column_),
                    item > 0 && item <= headings_.size() ? headings_[item - 1] : "");
        isTold_ = true;
        readAgain();
    } else if (question == "importType")
        tellWord(item);
    else if (question == "importCurrency")
        tellMissing(item);
    else if (question == "importAccount")
        tellAccount(item);
    else if (question == "importDates")
        tellDates(item);
}

void ImportStatement::tellWord(std::size_t item)
{
    const auto words = unknownWords();
    if (item == 0 || words.empty())
        return;
    // The menu stays with its word: each key that goes through the types is an answer.
    word_ = std::min(word_, words.size() - 1);
    profile_.addType(words[word_] + '=' + nameOf(static_cast<StatementType>(item - 1)));
    isTold_ = true;
    makePlan();
}

void ImportStatement::tellMissing(std::size_t item)
{
    const auto missing = missingAccounts();
    if (missing.empty())
        return;
    missing_ = std::min(missing_, missing.size() - 1);
    tellCurrency(missing[missing_], item);
}

/// An item of 0 makes no account of that name.
void ImportStatement::tellCurrency(const std::string& account, std::size_t item)
{
    std::erase_if(newAccounts_, [&](const auto& made) { return made.name == account; });
    if (item > 0)
        newAccounts_.push_back({account, symbols().at(item - 1)});
    makePlan();
}

void ImportStatement::tellAccount(std::size_t item)
{
    const auto accounts = window().getWallet()->accounts();
    const bool isNew = item > accounts.size();
    const std::string name = isNew      ? accountToMake()
                             : item > 0 ? std::string(accounts[item - 1]->getName().comparedBytes())
                                        : std::string();
    profile_.setAccount(name);
    isTold_ = true;
    tellCurrency(accountToMake(), isNew ? item - accounts.size() : 0);
}

void ImportStatement::tellDates(std::size_t item)
{
    profile_.forgetDates();
    if (item > 0)
        profile_.setDates(item == 1 ? "dmy" : "mdy");
    isTold_ = true;
    readAgain();
}

std::string ImportStatement::stepName() const
{
    return "Import operations from " + importedName(path_);
}

std::string ImportStatement::carryOut()
{
    if (!problem().empty())
        return {};
    plan_->book(*window().getWallet());
    // From here on the plan is of what was: it is only told from.
    const auto plan = std::move(plan_);
    window().showWallet();
    std::string text =
        "Imported " + importedCount(plan->operations().size(), "operation") + " from " + importedName(path_);
    if (!plan->newAccounts().empty())
        text += ", with " + importedCount(plan->newAccounts().size(), "new account");
    if (!plan->booked().empty())
        text += "; " + importedCount(plan->booked().size(), "line") + " already there";
    if (!plan->refused().empty())
        text += "; " + importedCount(plan->refused().size(), "line") + " refused";
    return text + keepProfile();
}

/// @return why it could not be kept, to go on from what was done; empty when it was.
std::string ImportStatement::keepProfile() const
{
    if (!isTold_)
        return {};
    try {
        std::string error;
        folder_.profiles(&error);
        if (!error.empty())
            throw std::runtime_error(error);
        profiles_.keep(accountToMake(), table_->headings(), profile());
        return {};
    } catch (const std::runtime_error& error) {
        return std::string(". What was chosen could not be kept: ") + error.what();
    }
}
