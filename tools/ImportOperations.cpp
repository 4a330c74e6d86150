#include "exchange/OperationPlan.h"
#include "exchange/StatementTable.h"
#include "foundation/DateText.h"
#include "foundation/NumberText.h"
#include "foundation/PrintableText.h"
#include "foundation/Today.h"
#include "market/Company.h"
#include "market/Currency.h"
#include "storage/AtomicFile.h"
#include "storage/DurableSave.h"
#include "tools/ImportMode.h"
#include "tools/TextTable.h"
#include "tools/Valuation.h"
#include "valuation/State.h"

#include <algorithm>
#include <filesystem>
#include <iostream>
#include <stdexcept>
#include <vector>

namespace {

const char* const kGroup = "Operations from a statement";

std::string plain(const String& text)
{
    return printable(text.bytes());
}

/// "12/01/2026 Buy 20 QLN (NYSE) at 112.35, cost 4.95, Broker"
std::string textOf(const PlannedOperation& operation)
{
    std::string text = dateText(operation.date) + ' ' + nameOf(operation.kind) + ' ';
    if (operation.isTrade())
        text += countText(operation.quantity) + ' ' + plain(operation.company->getAbbreviation()) + " (" +
                plain(operation.company->market()->getName()) + ") at " + exactText(operation.quote);
    else
        text += exactText(operation.amount);
    if (operation.cost != 0)
        text += ", cost " + exactText(operation.cost);
    text += ", " + printable(operation.account->name);
    return operation.recipient != nullptr ? text + " to " + printable(operation.recipient->name) : text;
}

/// The cash of all accounts after all operations, in the order of the wallet.
std::vector<float> cashOf(Valuation& valuation)
{
    valuation.compute(State::afterAllOperations(), false, false);
    std::vector<float> cash;
    for (const AccountState* state : valuation.state().accountStates())
        cash.push_back(state->getCash());
    return cash;
}

/// What a validator of the options says of a text that `take` throws for.
template <class Take>
Program::Option::Check checkedBy(const Take& take)
{
    return [take](const std::string& text) {
        try {
            take(text);
            return std::string();
        } catch (const std::runtime_error& error) {
            return std::string(error.what());
        }
    };
}

/// The option that tells what a line leaves open, to go on from the reason.
std::string remedyFor(const OperationPlan::Refusal& refusal)
{
    if (!refusal.untold)
        return {};
    switch (*refusal.untold) {
    case UntoldRow::About::kType:
        return ": --type WORD=TYPE says what it means";
    case UntoldRow::About::kAccount:
        return ": --account NAME says which is meant";
    case UntoldRow::About::kNewAccount:
        return ": --new-account NAME=SYMBOL makes one";
    }
    return {};
}

OperationPlan::NewAccount newAccountOf(const std::string& text)
{
    const std::size_t mark = text.rfind('=');
    if (mark == text.npos || mark == 0 || mark + 1 == text.size())
        throw std::runtime_error('"' + printable(text) + "\" is no NAME=SYMBOL");
    return {text.substr(0, mark), text.substr(mark + 1)};
}

class ImportOperations : public ImportMode {
public:
    void describe(Program& program) override;
    bool isMeant(const Program& program) const override { return program.isGiven("--operations"); }
    void run(const Program& program, const ImportArguments& arguments) override;

private:
    static void check(const Program& program, const ImportArguments& arguments);
    StatementProfile profile();
    void tellLines(const StatementTable& table, const OperationPlan& plan, bool withNew) const;
    void refuse(const OperationPlan& plan) const;
    void save(const ImportArguments& arguments, const Wallet& wallet) const;
    void keepProfile(const StatementProfile& profile) const;
    static void report(const OperationPlan& plan, const Valuation& valuation, const std::vector<float>& before,
                       const std::vector<float>& after);

    std::string table_;
    std::vector<std::string> columns_;
    std::vector<std::string> types_;
    std::string account_;
    std::vector<std::string> newAccounts_;
    std::string dates_;
    std::string profilePath_;
    bool isProfileNew_ = false;
    bool skipBad_ = false;
    std::optional<FileStamp> stamp_; // of the portfolio file when it was read
};

void ImportOperations::describe(Program& program)
{
    const Program::Option operations =
        program.add("--operations", table_, "Statement of which the portfolio gets the operations")
            .type("TABLE")
            .group(kGroup);
    const auto list = [&](const char* name, std::vector<std::string>& values, const char* type, const char* purpose) {
        return program.add(name, values, purpose).type(type).oneEach();
    };
    const auto text = [&](const char* name, std::string& value, const char* type, const char* purpose) {
        return program.addText(name, value, type, purpose);
    };
    Program::Option options[] = {
        list("--column", columns_, "COLUMN=HEADING", "Heading of a column that is not known")
            .check(checkedBy([](const std::string& value) { StatementProfile().addColumn(value); })),
        list("--type", types_, "WORD=TYPE", "What a word means: deposit, withdrawal, transfer, buy, sell, ...")
            .check(checkedBy([](const std::string& value) { StatementProfile().addType(value); })),
        text("--account", account_, "NAME", "Account of the lines that name none"),
        list("--new-account", newAccounts_, "NAME=SYMBOL", "Makes an account in the currency of that symbol")
            .check(checkedBy(newAccountOf)),
        text("--dates", dates_, "dmy|mdy", "Whether the day or the month comes first").oneOf({"dmy", "mdy"}),
        text("--profile", profilePath_, "FILE",
             "Reads --column, --type, --account and --dates from FILE, or writes them there when there is none"),
        program.addFlag("--skip-bad", skipBad_, "Books the other lines when some are refused"),
    };
    for (Program::Option& option : options)
        option.needs(operations).group(kGroup);
}

void ImportOperations::check(const Program& program, const ImportArguments& arguments)
{
    if (arguments.portfolio.empty() || arguments.market.empty())
        throw BadArguments::missing("--portfolio and --market");
    for (const char* other : {"OUTPUT", "--quotes", "--rates", "--listing", "--reference", "--rates-are", "--currency",
                              "--ticker-from-name", "--force", "--into", "--from"})
        if (program.isGiven(other))
            throw BadArguments::apart("--operations", other);
}

void ImportOperations::run(const Program& program, const ImportArguments& arguments)
{
    check(program, arguments);
    const StatementProfile profile = this->profile();
    stamp_ = FileStamp::of(arguments.portfolio);
    Valuation valuation(arguments.market, arguments.portfolio);
    // What was read out of place must not be written over the file that may still be saved by hand.
    if (!valuation.doubt().empty())
        throw std::runtime_error(valuation.doubt() + "; nothing is booked");
    const StatementTable table(table_, profile);
    std::vector<OperationPlan::NewAccount> newAccounts;
    for (const std::string& text : newAccounts_)
        newAccounts.push_back(newAccountOf(text));
    OperationPlan plan(table, profile, newAccounts, valuation.wallet(), valuation.catalogue());
    tellLines(table, plan, arguments.dryRun);
    if (!plan.refused().empty() && !skipBad_)
        refuse(plan);
    const std::vector<float> before = cashOf(valuation);
    plan.book(valuation.wallet());
    const std::vector<float> after = cashOf(valuation);
    // Nothing was written so far.
    if (!arguments.dryRun) {
        if (!plan.isEmpty())
            save(arguments, valuation.wallet());
        keepProfile(profile);
    }
    report(plan, valuation, before, after);
}

/// What the options say, and the profile file where they say nothing.
StatementProfile ImportOperations::profile()
{
    StatementProfile profile;
    for (const std::string& text : columns_)
        profile.addColumn(text);
    for (const std::string& text : types_)
        profile.addType(text);
    profile.setAccount(account_);
    if (!dates_.empty())
        profile.setDates(dates_);
    if (profilePath_.empty())
        return profile;
    isProfileNew_ = !std::filesystem::exists(profilePath_);
    if (isProfileNew_)
        AtomicFile::check(profilePath_, AtomicFile::Existing::kKeep); // before anything is booked
    else
        profile.fillFrom(StatementProfile::fromFile(profilePath_));
    return profile;
}

void ImportOperations::tellLines(const StatementTable& table, const OperationPlan& plan, bool withNew) const
{
    const auto tell = [](const std::string& text, unsigned long line) {
        std::cout << "line " << line << ": " << text << '\n';
    };
    for (const StatementTable::PassedOver& line : table.passedOver())
        tell(std::string("passed over, ") + line.reason + ": " + printable(line.text), line.line);
    for (const PlannedOperation& operation : plan.booked())
        tell("booked already: " + textOf(operation), operation.line);
    if (withNew)
        for (const PlannedOperation& operation : plan.operations())
            tell("new: " + textOf(operation), operation.line);
    for (const PlannedOperation& operation : plan.operations())
        if (operation.otherAmount != 0)
            tell("its amount " + amountText(operation.otherAmount) +
                     " is not what quantity, quote and cost make: " + textOf(operation),
                 operation.line);
    std::cout << "operations: " << plan.operations().size() << " new, " << plan.booked().size() << " booked already\n"
              << "refused: " << plan.refused().size() << std::endl; // before what goes to the other stream
    for (const OperationPlan::Refusal& refusal : plan.refused())
        std::cerr << table_ << ", line " << refusal.line << ": " << refusal.reason << remedyFor(refusal) << '\n';
}

void ImportOperations::refuse(const OperationPlan& plan) const
{
    const std::size_t n = plan.refused().size();
    throw std::runtime_error(table_ + ": nothing is booked, since " + std::to_string(n) +
                             (n == 1 ? " line is" : " lines are") + " refused; --skip-bad books the others");
}

void ImportOperations::save(const ImportArguments& arguments, const Wallet& wallet) const
{
    const auto write = [&](FILE* file) { return wallet.wrt(file, today()); };
    const auto result = DurableSave(DataFolder()).save(arguments.portfolio, write, stamp_);
    if (result.outcome != DurableSave::Outcome::kSaved)
        throw std::runtime_error(result.reason);
}

void ImportOperations::keepProfile(const StatementProfile& profile) const
{
    if (!isProfileNew_)
        return;
    AtomicFile file(profilePath_, AtomicFile::Existing::kKeep);
    if (std::fputs(profile.toText().c_str(), file.stream()) < 0)
        file.fail("cannot be written");
    file.commit();
}

void ImportOperations::report(const OperationPlan& plan, const Valuation& valuation, const std::vector<float>& before,
                              const std::vector<float>& after)
{
    const Wallet& wallet = valuation.wallet();
    const bool hasTrades = std::ranges::any_of(plan.operations(), &PlannedOperation::isTrade);
    if (hasTrades && (wallet.getBuyRateCost() != 0 || wallet.getSellRateCost() != 0))
        std::cout << "besides the costs of the lines, the portfolio's rate costs count: "
                  << finePercentText(wallet.getBuyRateCost()) << " of purchases, "
                  << finePercentText(wallet.getSellRateCost()) << " of sales\n";
    for (const PlannedAccount* account : plan.newAccounts())
        std::cout << "new account: " << printable(account->name) << '\n';
    using enum TextTable::Align;
    TextTable table({{"Account", kLeft}, {"Currency", kLeft}, {"Before", kRight}, {"After", kRight}});
    const auto accounts = wallet.accounts();
    for (std::size_t i = 0; i < accounts.size(); ++i)
        table.addRow({plain(accounts[i]->getName()), plain(accounts[i]->getCurrencyRepresentation()),
                      amountText(i < before.size() ? before[i] : 0), amountText(after[i])});
    std::cout << table.toString() << std::flush;
    if (!std::cout)
        throw std::runtime_error("standard output: the report could not be written");
}

} // namespace

std::unique_ptr<ImportMode> importOperations()
{
    return std::make_unique<ImportOperations>();
}
