#pragma once

class Account;
class Operation;
class ShareOperation;
class TransferAccountOperation;
class Wallet;

/// What each operation does to the cash of an account, evaluated in double as every replay does it.

/// The move on the account that lists the operation: what a deposit adds, minus what a transfer takes, which is the
/// larger of its amount and its fixed cost. 0 for purchases and sales, which move cash through the holding's replay.
double ownCashMove(const Operation& operation);

/// What a transfer gives to its recipient: (from quote / to quote) * (amount * (1 - rate cost) - cost).
double receivedCash(const TransferAccountOperation& transfer);

/// What a purchase takes from its account, and what a sale gives to it, at the wallet's present rate costs.
float purchaseCost(const ShareOperation& purchase, const Wallet& wallet);
float saleProceeds(const ShareOperation& sale, const Wallet& wallet);

/// Everything that the operation adds to the cash of `account`, costs and rate costs included, in its currency: both
/// ends of a transfer within the account, one end of any other; 0 when the operation does not concern the account.
double cashMove(const Operation& operation, const Account& account);
