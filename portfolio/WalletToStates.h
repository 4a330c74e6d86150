#pragma once

#include "foundation/OneToManyAssociation.h"

class Wallet;
class State;

/// The states computed for a wallet. States live a floor higher: the members are defined beside `State`.
class WalletToStates final : public OneToManyAssociation<WalletToStates, Wallet, State> {
public:
    using OneToManyAssociation::OneToManyAssociation;
    /// Destroys every state.
    void deleteAll();
    static auto& link(auto& state) { return state.wallet_; }
};

/// The state's link to its wallet.
class StatesToWallet final : public ManyToOneAssociation<StatesToWallet, State, Wallet> {
public:
    static auto& list(auto& wallet) { return wallet.states_; }
};
