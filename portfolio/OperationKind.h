#pragma once

class Operation;

/// What an operation is to a person. The file has no letters for income and charges: each is a transfer of an account
/// to itself, at both quotes 1, whose values make every replay move exactly the sum that came in or went.
///     income of x: amount 0, rate cost 0, cost -x
///     charge of x: amount x, rate cost 1, cost 0
/// The deposits, and with them the profit, see it as what it is. A transfer of an account to itself with other values
/// is a transfer.
enum class OperationKind : short { kDeposit, kTransfer, kBuy, kSell, kIncome, kCharge };

OperationKind kindOf(const Operation& operation);
/// "Deposit", "Transfer", "Buy", "Sell", "Income", "Charge".
const char* nameOf(OperationKind kind);
