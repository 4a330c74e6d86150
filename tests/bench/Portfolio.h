#pragma once

#include "market/Catalogue.h"
#include "market/Currency.h"
#include "market/Market.h"
#include "portfolio/Account.h"
#include "portfolio/Share.h"
#include "portfolio/Wallet.h"

#include <filesystem>

/// A wallet on its market data.
struct Portfolio {
    Catalogue catalogue;
    Wallet wallet; // destroyed first

    /// The last day with quotes, on which the portfolio is valued.
    static Date lastDay() { return {20, 11, 2026}; }

    /// @return true when the file was read whole; likewise below.
    bool loadMarket(const std::filesystem::path& path)
    {
        return load(path, [&](FILE* file) { return catalogue.rd(file); });
    }
    bool loadWallet(const std::filesystem::path& path)
    {
        wallet.setCatalogue(catalogue);
        return load(path, [&](FILE* file) { return wallet.rd(file, nullptr); });
    }

private:
    template <class Read>
    static bool load(const std::filesystem::path& path, Read read)
    {
        FILE* file = std::fopen(path.c_str(), "rb");
        if (file == nullptr)
            return false;
        const int result = read(file);
        std::fclose(file);
        return result == 0;
    }
};
