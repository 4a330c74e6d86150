#pragma once

#include "foundation/Date.h"
#include "foundation/String.h"
#include "portfolio/Wallet.h"

#include <array>
#include <cstdint>
#include <functional>
#include <memory>
#include <string>
#include <vector>

class Catalogue;
class Operation;

/// An operation by itself, without what it is linked to.
struct OperationImage {
    Date date;
    short type = 0;
    bool isAutomatic = false;
    int quantity = 0;
    // Amount, rate cost, cost and both quotes of a transfer; amount of a deposit; quote and cost of a trade.
    std::array<float, 5> numbers{};

    /// Bit for bit: what is no number is equal to itself here.
    bool operator==(const OperationImage& other) const;
};

/// A portfolio at one moment, with all its lists in their order, and with what a file leaves out: automatic sales, what
/// is automatic, and which of several of one name a link leads to. States are left out; they are computed.
///
/// An image never changes. Links are kept as places in lists.
struct WalletImage {
    using Places = std::vector<std::uint32_t>;
    /// An object of the portfolio that is linked to one of the catalogue.
    struct Link {
        std::uint32_t own; // place of the account or of the holding
        std::uint32_t currency;
        std::uint32_t market; // these two only of a holding
        std::uint32_t company;
        bool operator==(const Link&) const = default;
    };
    struct AccountImage {
        String name;
        bool isDefaultTransferAccount;
        Places operations; // in the order of its list, as below
        Places received;
        bool operator==(const AccountImage& other) const;
    };

    std::vector<AccountImage> accounts;
    std::vector<Places> holdings;           // of each the operations, in the order of its list
    std::vector<OperationImage> operations; // account by account, then those without account, which are automatic
    std::vector<Link> accountLinks;         // in the order of the currencies' lists
    std::vector<Link> holdingLinks;         // and in that of the companies' lists
    // What a file has in the place of the links: of each account the name of its currency, then of each holding market
    // and ticker. Not needed to make a wallet.
    std::vector<std::string> fileNames;
    std::array<float, Wallet::kParameterCount> parameters;

    /// @param isLeftOut says which automatic operations are no part of the image.
    static WalletImage of(const Wallet& wallet, const Catalogue& catalogue,
                          const std::function<bool(const Operation&)>& isLeftOut);
    /// A wallet that looks like this. `catalogue` is as it was when the image was taken.
    std::unique_ptr<Wallet> make(const Catalogue& catalogue) const;
    /// Whether nothing but automatic operations differs.
    bool hasWorkOf(const WalletImage& other) const;
    /// Whether, apart from these, the files of both are the same: what they are linked to may stand elsewhere by now,
    /// under the same names.
    bool hasFileOf(const WalletImage& other) const;
    std::size_t bytes() const;

    bool operator==(const WalletImage& other) const;

private:
    bool hasAutomatic() const;
    WalletImage withoutAutomatic() const;
    bool isSameFile(const WalletImage& other) const;
};
