// Any bytes as a portfolio file: the reader neither crashes nor hangs, the portfolio can be valued whatever is in it,
// the days of its evolution equal full replays, what is written of it reads back to the same bytes, and the cause of a
// failed read can be told.

#include "portfolio/WalletDiagnosis.h"
#include "tests/fuzz/FuzzedPortfolio.h"
#include "tests/fuzz/Require.h"
#include "tests/support/Bytes.h"
#include "tests/support/StateText.h"
#include "valuation/Evolution.h"
#include "valuation/Totals.h"

#include <cstdint>

namespace {

const Date kToday(1, 3, 2000);

void requireSame(const State& a, const State& b, const char* rule)
{
    require(textOf(a) == textOf(b), rule);
}

/// Empty when the wallet cannot be written, and when its file would be read otherwise than it was written: that of a
/// transfer without recipient is, by intention.
std::string writtenForReading(const Wallet& wallet)
{
    int result = -1;
    std::string bytes = written([&](FILE* file) { result = wallet.wrt(file, kToday); });
    for (const Account* account : all(wallet, &Wallet::getAllAccounts))
        for (const Operation* operation : all(*account, &Account::getAllOperations)) {
            Account* recipient;
            const auto* sent = dynamic_cast<const TransferAccountOperation*>(operation);
            if (sent != nullptr && sent->getRecepientAccount(&recipient) != 0)
                result = -1;
        }
    return result == 0 ? bytes : std::string();
}

void checkRereading(Wallet& wallet, const Catalogue& catalogue, const std::string& bytes)
{
    Wallet again;
    again.setCatalogue(catalogue);
    require(again.rd(BytesFile(bytes), nullptr) == 0, "a written portfolio is read whole");
    require(writtenForReading(again) == bytes, "writing, reading and writing gives the same bytes");
    requireSame(State(&wallet, kToday, false), State(&again, kToday, false), "a reread portfolio is worth the same");
}

void appraise(const Wallet& wallet, const Catalogue& catalogue)
{
    require(evolutionPoints(wallet, catalogue).size() == wallet.getNbrStates(), "each state is a point of the chart");
    if (wallet.getNbrStates() > 0)
        (void)Totals(*all(wallet, &Wallet::getAllStates).front(), catalogue);
}

void checkEvolution(Wallet& wallet, const Catalogue& catalogue, const Date& end)
{
    EvolutionOutcome outcome;
    State* current = refreshStates(wallet, end, false, &outcome);
    appraise(wallet, catalogue);
    const Date first = current->getFirstOperationDate();
    const bool isLate = first >= end;
    require((outcome == EvolutionOutcome::kBadFirstDay) == (!isLate && !first.isValid()), "a bad first day is noticed");
    const std::vector<State*> states = all(wallet, &Wallet::getAllStates);
    const std::size_t days = outcome == EvolutionOutcome::kBuilt && !isLate ? static_cast<unsigned>(end - first) : 0;
    require(states.size() == days + 1, "there is a state for every day");
    for (std::size_t i = 1; i <= days; i += days / 4 + 1)
        requireSame(*states[i], State(&wallet, states[i]->getDate(), false), "a day equals its full replay");
    if (days > 0)
        requireSame(*states.back(), State(&wallet, states.back()->getDate(), false), "the last day equals its replay");
}

/// Values the portfolio some days after its first operation, which keeps a run short, and today, when that is not far
/// off or so far that the evolution is refused. In between lie only more days of the same kind.
void checkEvolutions(Wallet& wallet, const Catalogue& catalogue)
{
    constexpr int kFewDays = 15;
    constexpr std::int64_t kFewStates = 2000;
    constexpr std::int64_t kManyStates = 100000000;
    const Date first = refreshStates(wallet, kToday, false, nullptr)->getFirstOperationDate();
    const std::int64_t items = 1 + wallet.getNbrShares() + wallet.getNbrAccounts();
    const std::int64_t states = (kToday - first) * items;
    if (!first.isValid() || states < kFewStates || states > kManyStates)
        checkEvolution(wallet, catalogue, kToday);
    Date end = first;
    if (first.isValid() && items * kFewDays < kFewStates && end.moveBy(kFewDays) > first)
        checkEvolution(wallet, catalogue, end);
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    FuzzedPortfolio p;
    Wallet& wallet = p.wallet;
    const Catalogue& catalogue = p.catalogue;
    const BytesFile file(std::string(reinterpret_cast<const char*>(data), size));
    const bool isRead = wallet.rd(file, nullptr) == 0;
    const WalletDiagnosis diagnosis(file, catalogue, [](std::string_view name) { return std::string(name); });
    require(!isRead || !diagnosis.isNameMissing(), "no name is missing in what could be read");
    const std::string bytes = writtenForReading(wallet);
    if (!bytes.empty())
        checkRereading(wallet, catalogue, bytes);
    checkEvolutions(wallet, catalogue);
    refreshStates(wallet, kToday, true, nullptr);
    appraise(wallet, catalogue);
    checkEvolutions(wallet, catalogue); // with the automatic sales, which stay
    require(bytes.empty() || writtenForReading(wallet) == bytes, "a valuation changes nothing that is written");
    return 0;
}
