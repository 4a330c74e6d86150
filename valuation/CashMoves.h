#pragma once

class Currency;
class Operation;
class ShareOperation;
class TransferAccountOperation;
class Wallet;

/// What each operation does to the cash of an account. Everything is evaluated in double; a balance is rounded to float
/// after every move, so a replay gives the same bits however it is organised, as long as the order is the same.

/// `balance` after a move of `amount`.
inline float addRounded(float balance, double amount)
{
    return static_cast<float>(balance + amount);
}

/// The move on the account that lists the operation: what a deposit adds, minus what a transfer takes, which is the
/// larger of its amount and its fixed cost. 0 for purchases and sales, which move cash through the holding's replay.
double ownCashMove(const Operation& operation);

/// What a transfer gives to its recipient: (from quote / to quote) * (amount * (1 - rate cost) - cost).
double receivedCash(const TransferAccountOperation& transfer);

/// A deposit in the reference currency, at the rate of its own day. `currency` is the account's.
double depositInReference(const Operation& deposit, const Currency& currency);

/// What a purchase takes from its account, and what a sale gives to it, at the wallet's present rate costs.
float purchaseCost(const ShareOperation& purchase, const Wallet& wallet);
float saleProceeds(const ShareOperation& sale, const Wallet& wallet);
