// Any bytes as a statement of a bank: it is read or refused, what it plans can be booked and written, and the same
// statement then has nothing new.

#include "exchange/OperationPlan.h"
#include "tests/fuzz/FuzzedPortfolio.h"
#include "tests/fuzz/MemoryTable.h"
#include "tests/support/Bytes.h"

#include <cstdint>
#include <stdexcept>

namespace {

void check(const StatementTable& table, const StatementProfile& profile)
{
    FuzzedPortfolio p;
    addAccount(p.wallet, "Main", p.euro);
    const std::vector<OperationPlan::NewAccount> accounts{{"Side", "USD"}};
    OperationPlan plan(table, profile, accounts, p.wallet, p.catalogue);
    require(plan.operations().size() + plan.refused().size() == table.rows().size(), "each row is planned or refused");
    plan.book(p.wallet);
    const OperationPlan again(table, profile, accounts, p.wallet, p.catalogue);
    require(again.isEmpty() && again.booked().size() == plan.operations().size(), "what is booked is found again");
    require(again.refused().size() == plan.refused().size(), "a booking refuses no line");
    const auto bytesOf = [](const Wallet& wallet) {
        return written([&](FILE* file) { require(wallet.wrt(file, kStart) == 0, "what is booked can be written"); });
    };
    Wallet read;
    read.setCatalogue(p.catalogue);
    require(read.rd(BytesFile(bytesOf(p.wallet)), nullptr) == 0, "what is booked can be read");
    require(bytesOf(read) == bytesOf(p.wallet), "what is booked is read as it was written");
}

} // namespace

extern "C" int LLVMFuzzerTestOneInput(const std::uint8_t* data, std::size_t size)
{
    const MemoryTable file({reinterpret_cast<const char*>(data), size});
    StatementProfile profile;
    profile.setAccount("Main");
    try {
        check(StatementTable(file.path(), profile), profile);
    } catch (const std::runtime_error&) {
        // No statement: told in one line.
    }
    return 0;
}
