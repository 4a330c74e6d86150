// Writes a small valid file and page of each kind for the fuzzers to start from: fuzz_seeds FOLDER makes FOLDER/market,
// FOLDER/wallet, FOLDER/latest, FOLDER/history, FOLDER/table and FOLDER/statement.

#include "market/NoteCompanyEvent.h"
#include "market/SplitCompanyEvent.h"
#include "tests/fuzz/FuzzedPortfolio.h"
#include "tests/support/Bytes.h"

#include <filesystem>
#include <fstream>

namespace {

bool save(const std::string& bytes, const std::filesystem::path& folder, const char* name = "seed")
{
    std::filesystem::create_directories(folder);
    return static_cast<bool>(std::ofstream(folder / name, std::ios::binary) << bytes << std::flush);
}

/// An event of each kind, two accounts, a holding and an operation of each kind.
void fill(FuzzedPortfolio& p)
{
    new NoteCompanyEvent(p.alpha, daysAfterStart(122), "Title", "Text");
    new SplitCompanyEvent(p.alpha, daysAfterStart(122), 2, 1);
    Account* main = addAccount(p.wallet, "Main", p.euro);
    Account* side = addAccount(p.wallet, "Side", p.dollar);
    side->setDefaultTransferAccount(true);
    deposit(main, 122, 1000);
    transfer(main, side, 122, 100);
    auto* share = new Share(&p.wallet, p.alpha);
    // Ten of the last are still held on the day of valuation: previsions sell them.
    for (const auto& [day, quantity] : {std::pair(122, 10), {157, -10}, {425, 10}})
        trade(share, main, day, quantity, 40, 29.95F);
}

/// The first byte of each says what kind of table it is.
bool saveTables(const std::filesystem::path& folder)
{
    const char* quotes =
        "2date,ticker,close,market,currency,name\n2005-01-03,F,1.5,,,\n3/5/1999,\"N\"\"\",2,York,USD,Nu\n";
    const char* listing = "0ticker;market;currency;name\nAC;Paris;;\nB;New;USD;Nu\n";
    const char* rates = "1date,currency,rate\n2005-01-03,USD,1.5\n2005-01-04,JPY,100\n";
    const char* wide = "1Date,USD,JPY,\n2005-01-04,1.25,N/A,\n2005-01-03,-,100,\n";
    return save(quotes, folder, "quotes") && save(listing, folder, "listing") && save(rates, folder, "rates") &&
           save(wide, folder, "wide");
}

} // namespace

int main(int argc, char** argv)
{
    const std::filesystem::path folder = argc == 2 ? argv[1] : "";
    FuzzedPortfolio p;
    fill(p);
    const char* latest = "<html><td nowrap><b>112 <sup>3</sup>/<sub>8</sub></b></td><td nowrap><b>45</b></td>";
    const char* history = "<pre><b>Date Close Volume (00s)</b>\n5/3/1999 45.5 46 100\n05/04/1999\t46\t47\t9\n</pre>";
    const char* statement =
        "Bank\n\nDatum;Art;Zielkonto;Titel;Menge;Kurs;Betrag;Kosten\n01.02.1999;Kauf;;Alpha;5;7,25;;1\n"
        "02.02.1999;Transfer;Side;;;;1.000,50;\n13.02.1999;Zinsen;;;;;0,05;\nSumme;;;;;;1;\n";
    if (argc == 2 && save(bytesWritten(p.catalogue, kStart), folder / "market") &&
        save(bytesWritten(p.wallet, kStart), folder / "wallet") && save(latest, folder / "latest") &&
        save(history, folder / "history") && saveTables(folder / "table") && save(statement, folder / "statement"))
        return 0;
    std::fputs("usage: fuzz_seeds FOLDER, one that can be written into\n", stderr);
    return 1;
}
