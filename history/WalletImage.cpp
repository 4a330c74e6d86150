#include "history/WalletImage.h"

#include "market/Catalogue.h"
#include "market/Company.h"
#include "market/Currency.h"
#include "market/Market.h"
#include "portfolio/Account.h"
#include "portfolio/DepositAccountOperation.h"
#include "portfolio/Share.h"
#include "portfolio/ShareOperation.h"
#include "portfolio/TransferAccountOperation.h"

#include <algorithm>
#include <cstring>
#include <unordered_map>

namespace {

using PlaceOf = std::unordered_map<const void*, std::uint32_t>;

std::uint32_t sizeOf(const auto& list)
{
    return static_cast<std::uint32_t>(list.size());
}

OperationImage imageOf(const Operation& operation)
{
    OperationImage image{operation.getDate(), operation.getType(), operation.isAutomatic(), 0, {}};
    if (image.type == Operation::kDeposit) {
        image.numbers = {static_cast<const AccountOperation&>(operation).getAmount()};
    } else if (image.type == Operation::kTransfer) {
        const auto& transfer = static_cast<const TransferAccountOperation&>(operation);
        image.numbers = {transfer.getAmount(), transfer.getRateCost(), transfer.getCost(),
                         transfer.getFromCurrencyQuote(), transfer.getToCurrencyQuote()};
    } else {
        const auto& trade = static_cast<const ShareOperation&>(operation);
        image.quantity = trade.getQuantity();
        image.numbers = {trade.getQuote(), trade.getOperationCost()};
    }
    return image;
}

/// An operation of that image, linked to `account`, which may be null and otherwise owns it.
Operation* made(const OperationImage& image, Account* account)
{
    const auto& numbers = image.numbers;
    if (image.type == Operation::kDeposit)
        return new DepositAccountOperation(image.date, account, numbers[0], image.isAutomatic);
    if (image.type == Operation::kTransfer) {
        auto* transfer = new TransferAccountOperation(image.date, account, nullptr, numbers[0], image.isAutomatic);
        transfer->setRateCost(numbers[1]);
        transfer->setCost(numbers[2]);
        transfer->setFromCurrencyQuote(numbers[3]);
        transfer->setToCurrencyQuote(numbers[4]);
        return transfer;
    }
    auto* trade = new ShareOperation(image.date, nullptr, image.type == Operation::kBuy, image.quantity, numbers[0],
                                     image.isAutomatic, numbers[1]);
    trade->setAccount(account);
    return trade;
}

/// The places of those of `operations` that are in the image.
WalletImage::Places placesOf(auto operations, const PlaceOf& places)
{
    WalletImage::Places found;
    for (const Operation* operation : operations)
        if (const auto place = places.find(operation); place != places.end())
            found.push_back(place->second);
    return found;
}

/// Every link from a currency's or company's list into the portfolio, in the order of these lists.
void takeLinks(const Catalogue& catalogue, const PlaceOf& places, WalletImage& image)
{
    std::uint32_t c = 0;
    for (const Currency* currency : catalogue.getCurrencies()) {
        for (const Account* account : currency->accounts())
            if (const auto place = places.find(account); place != places.end())
                image.accountLinks.push_back({place->second, c, 0, 0});
        std::uint32_t m = 0;
        for (const Market* market : currency->markets()) {
            std::uint32_t n = 0;
            for (const Company* company : market->companies()) {
                for (const Share* share : company->shares())
                    if (const auto place = places.find(share); place != places.end())
                        image.holdingLinks.push_back({place->second, c, m, n});
                ++n;
            }
            ++m;
        }
        ++c;
    }
}

} // namespace

bool OperationImage::operator==(const OperationImage& other) const
{
    return date == other.date && type == other.type && isAutomatic == other.isAutomatic && quantity == other.quantity &&
           std::memcmp(numbers.data(), other.numbers.data(), sizeof numbers) == 0;
}

bool WalletImage::AccountImage::operator==(const AccountImage& other) const
{
    return name.hasText() == other.name.hasText() && name.bytes() == other.name.bytes() &&
           isDefaultTransferAccount == other.isDefaultTransferAccount && operations == other.operations &&
           received == other.received;
}

bool WalletImage::isSameFile(const WalletImage& other) const
{
    return accounts == other.accounts && holdings == other.holdings && operations == other.operations &&
           fileNames == other.fileNames &&
           std::memcmp(parameters.data(), other.parameters.data(), sizeof parameters) == 0;
}

bool WalletImage::operator==(const WalletImage& other) const
{
    return isSameFile(other) && accountLinks == other.accountLinks && holdingLinks == other.holdingLinks;
}

WalletImage WalletImage::of(const Wallet& wallet, const Catalogue& catalogue,
                            const std::function<bool(const Operation&)>& isLeftOut)
{
    WalletImage image;
    PlaceOf places;
    std::size_t count = wallet.getNbrShares() + wallet.getNbrAccounts();
    for (const Account* account : wallet.accounts())
        count += account->getNbrOperations();
    places.reserve(count);
    image.operations.reserve(count);
    const auto take = [&](const Operation* operation) {
        if (operation->isAutomatic() && isLeftOut(*operation))
            return;
        places.emplace(operation, sizeOf(image.operations));
        image.operations.push_back(imageOf(*operation));
    };
    // All operations first: the lists then refer to them by their places. Holdings also list what no account has.
    for (const Account* account : wallet.accounts())
        std::ranges::for_each(account->operations(), take);
    for (const Share* share : wallet.shares())
        for (const ShareOperation* operation : share->shareOperations())
            if (operation->account() == nullptr)
                take(operation);
    for (const Account* account : wallet.accounts()) {
        places[account] = sizeOf(image.accounts);
        image.accounts.push_back({account->getName(), account->isDefaultTransferAccount(),
                                  placesOf(account->operations(), places),
                                  placesOf(account->transferOperations(), places)});
        image.fileNames.emplace_back(account->getCurrencyName().bytes());
    }
    for (const Share* share : wallet.shares()) {
        places[share] = sizeOf(image.holdings);
        image.holdings.push_back(placesOf(share->shareOperations(), places));
        image.fileNames.emplace_back(share->getMarketName().bytes());
        image.fileNames.emplace_back(share->getCompanyAbbreviation().bytes());
    }
    takeLinks(catalogue, places, image);
    for (std::size_t i = 0; i < image.parameters.size(); ++i)
        image.parameters[i] = wallet.getParameter(static_cast<Wallet::Parameter>(i));
    return image;
}

std::unique_ptr<Wallet> WalletImage::make(const Catalogue& catalogue) const
{
    auto wallet = std::make_unique<Wallet>();
    for (std::size_t i = 0; i < parameters.size(); ++i)
        wallet->setParameter(static_cast<Wallet::Parameter>(i), parameters[i]);
    // Each list is filled in its own order. Accounts and holdings stand unlinked in the wallet's first.
    std::vector<Account*> madeAccounts;
    for (const AccountImage& image : accounts) {
        madeAccounts.push_back(new Account(image.name));
        madeAccounts.back()->setDefaultTransferAccount(image.isDefaultTransferAccount);
        madeAccounts.back()->setWallet(wallet.get()); // which owns it
    }
    std::vector<Share*> madeShares;
    for (std::size_t i = 0; i < holdings.size(); ++i)
        madeShares.push_back(new Share(wallet.get(), nullptr));
    const auto& currencies = catalogue.getCurrencies();
    for (const Link& link : accountLinks)
        madeAccounts[link.own]->setCurrency(currencies[link.currency]);
    for (const Link& link : holdingLinks)
        madeShares[link.own]->setCompany(currencies[link.currency]->markets()[link.market]->companies()[link.company]);

    // An operation enters the list of its account when it is made, then the other list that it may be in.
    std::vector<Operation*> madeOperations(operations.size());
    for (std::size_t i = 0; i < accounts.size(); ++i)
        for (const std::uint32_t place : accounts[i].operations)
            madeOperations[place] = made(operations[place], madeAccounts[i]);
    for (std::size_t i = 0; i < accounts.size(); ++i)
        for (const std::uint32_t place : accounts[i].received)
            static_cast<TransferAccountOperation*>(madeOperations[place])->setRecepientAccount(madeAccounts[i]);
    for (std::size_t i = 0; i < holdings.size(); ++i)
        for (const std::uint32_t place : holdings[i]) {
            if (madeOperations[place] == nullptr) // without account: the holding owns it
                madeOperations[place] = made(operations[place], nullptr);
            static_cast<ShareOperation*>(madeOperations[place])->setShare(madeShares[i]);
        }
    return wallet;
}

WalletImage WalletImage::withoutAutomatic() const
{
    WalletImage image = *this;
    std::erase_if(image.operations, [](const OperationImage& operation) { return operation.isAutomatic; });
    // Where each of those that stay has gone.
    Places moved;
    std::uint32_t next = 0;
    for (const OperationImage& operation : operations)
        moved.push_back(operation.isAutomatic ? 0 : next++);
    const auto move = [&](Places& places) {
        std::erase_if(places, [&](std::uint32_t place) { return operations[place].isAutomatic; });
        for (std::uint32_t& place : places)
            place = moved[place];
    };
    for (AccountImage& account : image.accounts) {
        move(account.operations);
        move(account.received);
    }
    for (Places& holding : image.holdings)
        move(holding);
    return image;
}

bool WalletImage::hasAutomatic() const
{
    return std::ranges::any_of(operations, &OperationImage::isAutomatic);
}

bool WalletImage::hasWorkOf(const WalletImage& other) const
{
    const bool mayDiffer = hasAutomatic() || other.hasAutomatic();
    return *this == other || (mayDiffer && withoutAutomatic() == other.withoutAutomatic());
}

bool WalletImage::hasFileOf(const WalletImage& other) const
{
    const bool mayDiffer = hasAutomatic() || other.hasAutomatic();
    return isSameFile(other) || (mayDiffer && withoutAutomatic().isSameFile(other.withoutAutomatic()));
}

std::size_t WalletImage::bytes() const
{
    std::size_t total = sizeof *this + operations.size() * sizeof(OperationImage) +
                        (accountLinks.size() + holdingLinks.size()) * sizeof(Link);
    for (const AccountImage& account : accounts)
        total += sizeof account + static_cast<std::size_t>(account.name.getLength()) +
                 (account.operations.size() + account.received.size()) * sizeof(std::uint32_t);
    for (const std::string& name : fileNames)
        total += sizeof name + name.size();
    for (const Places& holding : holdings)
        total += sizeof holding + holding.size() * sizeof(std::uint32_t);
    return total;
}
