#pragma once

/// The two kinds of file: market data, and a portfolio.
enum class FileKind { kMarkets, kWallet };
