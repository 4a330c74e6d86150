#pragma once

#include "foundation/OneToManyAssociation.h"

class Wallet;
class Share;

/// A wallet's holdings.
class WalletToShares final : public OneToManyAssociation<Wallet, Share> {
public:
    explicit WalletToShares(Wallet* owner) : OneToManyAssociation(owner) {}

private:
    ManyToOneAssociation<Share, Wallet>& backLink(Share& e) const override;
};

/// The holding's link to its wallet.
class SharesToWallet final : public ManyToOneAssociation<Share, Wallet> {
public:
    using ManyToOneAssociation::ManyToOneAssociation;

private:
    int xAdd(Wallet* partner) override;
    int xRemove(Wallet* partner) override;
};
