#pragma once

#include "foundation/OneToManyAssociation.h"

class Wallet;
class Share;

/// A wallet's holdings.
class WalletToShares final : public OneToManyAssociation<WalletToShares, Wallet, Share> {
public:
    using OneToManyAssociation::OneToManyAssociation;
    static auto& link(auto& share) { return share.wallet_; }
};

/// The holding's link to its wallet.
class SharesToWallet final : public ManyToOneAssociation<SharesToWallet, Share, Wallet> {
public:
    static auto& list(auto& wallet) { return wallet.shares_; }
};
