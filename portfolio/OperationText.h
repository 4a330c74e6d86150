#pragma once

#include <string>

class Account;
class Operation;
class Wallet;

/// What operations are told as. Names stand in it whole, of whatever length they are.

/// What an operation does to the cash: "4,036.75 EUR from Main", "1,000.00 EUR to Main"; of a transfer both ends.
/// `operation` need not be linked to the accounts yet; `recipient` is null for all but transfers.
std::string moveText(const Operation& operation, const Account& account, const Account* recipient,
                     const Wallet& wallet);
/// The same for an operation that is on an account and, a trade, of a holding; empty without an account.
std::string moveText(const Operation& operation);
/// What was done, with what it does to the cash: "Bought 100 ALP, 4,036.75 EUR from Main".
std::string deedText(const Operation& operation);
