#include "portfolio/Account.h"

#include "market/RecordList.h"
#include "portfolio/DepositAccountOperation.h"
#include "portfolio/ShareOperation.h"
#include "portfolio/TransferAccountOperation.h"
#include "portfolio/Wallet.h"

#include <memory>

namespace {

constexpr unsigned char kLetters[] = {'?', 'D', 'T', 'B', 'S'}; // by type code

bool isTransfer(const Operation* operation)
{
    return operation->getType() == Operation::kTransfer;
}

} // namespace

Account::Account() : operations_(this), transfers_(this), states_(this) {}

Account::Account(const String& name) : Account()
{
    name_ = name;
}

Account::~Account()
{
    // A transfer is in two lists. Those that the account sent are destroyed with its operations and leave the lists of
    // their recipients; those that it received are destroyed, too, and leave the lists of their senders.
    operations_.deleteAll();
    transfers_.deleteAll();
    states_.deleteAll();
    // Nothing refers to the account any more but wallet and currency, which only list it.
    setWallet(nullptr);
    setCurrency(nullptr);
}

int Account::wrt(FILE* file) const
{
    // The wallet has written the currency's name in front of this: a reader needs it before the account is made.
    name_.wrt(file);
    fwritechar(file, defaultTransfer_ ? 'Y' : 'N');
    fwriteint(file, static_cast<int>(getNbrOperations()));
    for (const Operation* operation : operations()) {
        fwritechar(file, kLetters[operation->getType()]);
        // A transfer names its recipient, which may be an account that comes later: it waits for the transfer block.
        if (!isTransfer(operation) && operation->wrt(file) != 0)
            return -1;
    }
    return 0;
}

int Account::rd(FILE* file)
{
    // From here on the account changes in place: what is read whole stays, whatever comes behind it.
    if (name_.rd(file) != 0)
        return -1;
    defaultTransfer_ = freadchar(file) == 'Y';
    return readRecords(file, [&] { return readOperation(file); });
}

int Account::readOperation(FILE* file)
{
    const unsigned char letter = freadchar(file);
    if (letter == kLetters[Operation::kTransfer]) {
        // Its body comes later; its turn among the operations of its day is kept, so that the next save writes the
        // same order again.
        transferTurns_.push_back(operations_.reserveTurn());
        return 0;
    }
    // Every other letter counts as a trade: "B" and "S" differ in a flag that the record has, too.
    std::unique_ptr<Operation> operation;
    if (letter == kLetters[Operation::kDeposit])
        operation = std::make_unique<DepositAccountOperation>();
    else
        operation = std::make_unique<ShareOperation>();
    // Linked before it is read: a purchase looks up its holding by way of the account's wallet. If the record is cut
    // short, the destructor unlinks it again.
    operation->setAccount(this);
    if (operation->rd(file) != 0)
        return -1;
    operation.release(); // the account owns it
    return 0;
}

int Account::writeTransferOperations(FILE* file) const
{
    // The same order as that of the letters, so that each body finds the turn of its letter again.
    fwriteint(file, static_cast<int>(std::ranges::count_if(operations(), isTransfer)));
    for (const Operation* operation : operations())
        if (isTransfer(operation) && operation->wrt(file) != 0)
            return -1;
    return 0;
}

int Account::readTransferOperations(FILE* file, bool* hasLostRecipient)
{
    // The turns are good for one reading: the account keeps none of them from here on.
    const std::vector<std::uint32_t> turns = std::move(transferTurns_);
    transferTurns_.clear();
    std::size_t next = 0;
    return readRecords(file, [&] {
        auto transfer = std::make_unique<TransferAccountOperation>();
        // It stands behind the operations of its day now, and is given back the place that its letter had.
        transfer->setAccount(this);
        const bool isListed = next < turns.size(); // the account's own record has a letter for it
        if (isListed)
            operations_.setTurn(transfer.get(), turns[next++]);
        const int result = transfer->rd(file);
        if (result != 0 && reachedEnd(file))
            return -1;
        // The account owns it. Intended: a transfer to an unknown account is not dropped either, the person shall see
        // that it is there.
        transfer.release();
        if (result != 0 && isListed && hasLostRecipient != nullptr)
            *hasLostRecipient = true;
        return result;
    });
}

int Account::getShare(const String& market, const String& abbreviation, Share** out) const
{
    // An account that is in no wallet has no holdings to look up.
    *out = nullptr;
    return wallet() != nullptr ? wallet()->getShare(market, abbreviation, out) : -1;
}

Account* Account::getAccountByName(const String& name) const
{
    return wallet() != nullptr ? wallet()->getAccountByName(name) : nullptr;
}

int Account::setWallet(Wallet* wallet)
{
    return wallet_.set(this, wallet);
}

int Currency::addAccount(Account* account)
{
    return accounts_.add(account);
}

int Currency::removeAccount(Account* account)
{
    return accounts_.remove(account);
}

void CurrencyToAccounts::unlinkAll()
{
    OneToManyAssociation::unlinkAll();
}
