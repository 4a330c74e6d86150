#pragma once

#include "foundation/OneToManyAssociation.h"

class Wallet;
class State;

/// The states computed for a wallet. States live a floor higher: the members are defined beside `State`.
class WalletToStates final : public OneToManyAssociation<Wallet, State> {
public:
    explicit WalletToStates(Wallet* owner) : OneToManyAssociation(owner) {}

    /// Destroys every state.
    void deleteAll();

private:
    ManyToOneAssociation<State, Wallet>& backLink(State& e) const override;
};

/// The state's link to its wallet.
class StatesToWallet final : public ManyToOneAssociation<State, Wallet> {
public:
    using ManyToOneAssociation::ManyToOneAssociation;

private:
    int xAdd(Wallet* partner) override;
    int xRemove(Wallet* partner) override;
};
