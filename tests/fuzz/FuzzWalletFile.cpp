// Any bytes as a portfolio file: the reader neither crashes nor hangs, the portfolio can be valued whatever is in it,
// the days of its evolution equal full replays, and what is written of it reads back to the same bytes.

#include "market/Catalogue.h"
#include "portfolio/Account.h"
#include "portfolio/Share.h"
#include "portfolio/TransferAccountOperation.h"
#include "portfolio/Wallet.h"
#include "tests/fuzz/Require.h"
#include "tests/fuzz/SmallCatalogue.h"
#include "tests/support/Bytes.h"
#include "valuation/AccountState.h"
#include "valuation/Evolution.h"
#include "valuation/ShareState.h"
#include "valuation/State.h"
#include "valuation/Totals.h"

#include <cmath>
#include <cstdint>
#include <cstring>
#include <vector>

namespace {

const Date kToday(1, 3, 2000);

/// Any two values that are not a number count as the same.
bool areSame(float a, float b)
{
    return std::memcmp(&a, &b, sizeof a) == 0 || (std::isnan(a) && std::isnan(b));
}

void requireSame(const State& a, const State& b, const char* rule)
{
    require(areSame(a.getTotalDeposit(), b.getTotalDeposit()) &&
                a.getFirstOperationDate() == b.getFirstOperationDate() &&
                a.getNbrAccountStates() == b.getNbrAccountStates() && a.getNbrShareStates() == b.getNbrShareStates(),
            rule);
    for (unsigned i = 0; i < a.getNbrAccountStates(); ++i)
        require(areSame(a.getAccountState(i)->getCash(), b.getAccountState(i)->getCash()), rule);
    for (unsigned i = 0; i < a.getNbrShareStates(); ++i) {
        const ShareState& left = *a.getShareState(i);
        const ShareState& right = *b.getShareState(i);
        require(left.getQuantity() == right.getQuantity() && areSame(left.getBuyQuote(), right.getBuyQuote()) &&
                    areSame(left.getQuote(), right.getQuote()) && left.getEndDate() == right.getEndDate(),
                rule);
    }
}

/// Empty when the wallet cannot be written, and when its file would be read otherwise than it was written: that of a
/// transfer without recipient is, by intention.
std::string writtenForReading(const Wallet& wallet)
{
    int result = -1;
    std::string bytes = written([&](FILE* file) { result = wallet.wrt(file, kToday); });
    for (unsigned i = 0; i < wallet.getNbrAccounts(); ++i)
        for (unsigned k = 0; k < wallet.getAccount(i)->getNbrOperations(); ++k) {
            Account* recipient;
            const auto* transfer = dynamic_cast<const TransferAccountOperation*>(wallet.getAccount(i)->getOperation(k));
            if (transfer != nullptr && transfer->getRecepientAccount(&recipient) != 0)
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
    unsigned n;
    State** states = wallet.getAllStates(&n);
    if (n > 0)
        (void)Totals(*states[0], catalogue);
}

void checkEvolution(Wallet& wallet, const Catalogue& catalogue, const Date& end)
{
    EvolutionOutcome outcome;
    State* current = refreshStates(wallet, end, false, &outcome);
    appraise(wallet, catalogue);
    const Date first = current->getFirstOperationDate();
    const bool isLate = first >= end;
    require((outcome == EvolutionOutcome::BadFirstDay) == (!isLate && !first.isValid()), "a bad first day is noticed");
    unsigned n;
    State** all = wallet.getAllStates(&n);
    require(n == (outcome == EvolutionOutcome::Built && !isLate ? static_cast<unsigned>(end - first) + 1 : 1),
            "there is a state for every day");
    const std::vector<State*> states(all, all + n); // the replays below are listed, too
    for (unsigned i = 1; i < n; i += n / 4 + 1)
        requireSame(*states[i], State(&wallet, states[i]->getDate(), false), "a day equals its full replay");
    if (n > 1)
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
    Catalogue catalogue;
    fillSmallCatalogue(catalogue);
    Wallet wallet;
    wallet.setCatalogue(catalogue);
    wallet.rd(BytesFile(std::string(reinterpret_cast<const char*>(data), size)), nullptr);
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
