#include "portfolio/WalletDiagnosis.h"
#include "tests/support/Bytes.h"
#include "tests/support/Links.h"

namespace {

const Date kStamp(5, 3, 1999);

// 29.95, 29.95, 0.0017, 0.0017; 90 days; 2, 1.1, 0.8, 0.8, 0.9
const char* const kDefaults = "9A99EF41 9A99EF41 89D2DE3A 89D2DE3A 5A00 00000040 CDCC8C3F CDCC4C3F CDCC4C3F 6666663F";

std::string bytesWritten(const Wallet& wallet, int expected = 0)
{
    return written([&](FILE* file) { EXPECT_EQ(wallet.wrt(file, kStamp), expected); });
}

/// What is whole in the file after each of its pieces.
struct Piece {
    const char* bytes;
    unsigned shares, accounts, operations;
};

// An account with a purchase, a deposit and a transfer of one day and a sale, and the account that the transfer goes
// to.
const std::vector<Piece> kPieces = {
    {"0500 0300 CF070000  01000000  05000000 'Paris' 02000000 'AC'", 1, 0, 0},
    {"02000000  04000000 'Euro' 04000000 'Main' 'Y' 04000000"
     "'B' 'Y' 05000000 'Paris' 02000000 'AC' 0A000000 0000C03F 0100 0100 CF070000 00000040",
     1, 1, 1},
    {"'T'  'D' 00007A44 0200 0100 CF070000", 1, 1, 2},
    {"'S' 'N' 05000000 'Paris' 02000000 'AC' FDFFFFFF 00000040 0400 0100 CF070000 0000003F", 1, 1, 3},
    {"06000000 'Dollar' 04000000 'Side' 'N' 00000000", 1, 2, 3},
    {"01000000  04000000 'Side' 00004843 0000803E 0000A040 0000C03F 00000040 0200 0100 CF070000", 1, 2, 4},
    {"00000000  0000803F 00000040 00004040 00008040 A6FF 0000A040 0000C040 0000E040 00000041 00001041", 1, 2, 4},
};

std::string bytesOfPieces()
{
    std::string bytes;
    for (const Piece& piece : kPieces)
        bytes += bytesOf(piece.bytes);
    return bytes;
}

/// The portfolio of the pieces.
void fill(SmallPortfolio& p)
{
    auto* share = new Share(&p.wallet, p.alpha);
    Account* main = addAccount(p.wallet, "Main", p.euro);
    Account* side = addAccount(p.wallet, "Side", p.dollar);
    main->setDefaultTransferAccount(true);
    withTerms(transfer(main, side, 1, 200), 0.25F, 5, 1.5F, 2);
    deposit(main, 1, 1000);
    trade(share, main, 3, -1, 2, 0.5F)->setQuantity(-3);
    trade(share, main, 0, 10, 1.5F, 2);
    float value = 0;
    for (const auto set : {&Wallet::setBuyCost, &Wallet::setSellCost, &Wallet::setBuyRateCost, &Wallet::setSellRateCost,
                           &Wallet::setBeginProfitSellRate, &Wallet::setEndProfitSellRate,
                           &Wallet::setBeginLoseSellRate, &Wallet::setEndLoseSellRate, &Wallet::setReinvestRate})
        (p.wallet.*set)(++value);
    p.wallet.setInvestementPeriod(-90);
}

std::string diagnosisOf(const BytesFile& file, const Catalogue& catalogue)
{
    const auto shown = [](std::string_view name) { return std::string(name); };
    return WalletDiagnosis(file, catalogue, shown).text("Mine", "the market file Sample");
}

std::string replaced(std::string bytes, const char* what, const char* with)
{
    const std::string old = bytesOf(what);
    EXPECT_NE(bytes.find(old), std::string::npos) << what;
    return bytes.replace(bytes.find(old), old.size(), bytesOf(with));
}

} // namespace

TEST(WalletFileTest, AnEmptyWalletIsItsStampTwoCountsAndTheDefaultParameters)
{
    const std::string bytes = bytesOf(std::string("0500 0300 CF070000  00000000  00000000") + kDefaults);
    EXPECT_EQ(bytesWritten(Wallet()), bytes);
    Wallet wallet;
    Date stamp;
    EXPECT_EQ(wallet.rd(BytesFile(bytes), &stamp), 0);
    EXPECT_EQ(stamp, kStamp);
    EXPECT_EQ(wallet.wrt(stdout) + wallet.rd(BytesFile(bytes)), -2) << "only the dated forms work";
}

TEST(WalletFileTest, EveryFieldStandsInItsPlace)
{
    SmallPortfolio p;
    fill(p);
    EXPECT_EQ(bytesWritten(p.wallet), bytesOfPieces());

    SmallPortfolio again;
    fill(again); // reading replaces what is there
    new State(&again.wallet, kStart, false);
    EXPECT_EQ(again.wallet.rd(BytesFile(bytesOfPieces()), nullptr), 0);
    EXPECT_EQ(again.wallet.getNbrStates(), 0U);
    EXPECT_EQ(bytesWritten(again.wallet), bytesOfPieces());
    const Account* side = again.wallet.getAccountByName("Side");
    ASSERT_NE(side, nullptr);
    ASSERT_EQ(side->getNbrTransferOperations(), 1U) << "though it comes later in the file than the transfer";
    EXPECT_EQ(side->getTransferOperation(0), again.wallet.getAccount(0)->getOperation(1));
    Links({again.euro, again.dollar}, {&again.wallet}).expectConsistent();

    const std::string others = replaced(replaced(bytesOfPieces(), "'B' 'Y'", "'?' 'N'"), "'Main' 'Y'", "'Main' 'y'");
    ASSERT_EQ(again.wallet.rd(BytesFile(others), nullptr), 0) << "only the flags tell purchase and default account";
    ASSERT_EQ(again.wallet.getNbrAccounts(), 2U);
    ASSERT_GT(again.wallet.getAccount(0)->getNbrOperations(), 0U);
    EXPECT_EQ(again.wallet.getAccount(0)->getOperation(0)->getType(), Operation::kSell);
    EXPECT_FALSE(again.wallet.getAccount(0)->isDefaultTransferAccount());
}

TEST(WalletFileTest, WhatIsWholeStaysWhereverTheFileIsCut)
{
    const std::string bytes = bytesOfPieces();
    for (std::size_t cut = 0; cut < bytes.size(); ++cut) {
        Piece expected{"", 0, 0, 0};
        std::size_t end = 0;
        for (const Piece& piece : kPieces)
            if ((end += bytesOf(piece.bytes).size()) <= cut)
                expected = piece;
        SmallPortfolio p;
        EXPECT_EQ(p.wallet.rd(BytesFile(bytes.substr(0, cut)), nullptr), -1) << cut;
        const Links links({p.euro, p.dollar}, {&p.wallet});
        links.expectConsistent();
        ASSERT_EQ(p.wallet.getNbrShares(), expected.shares) << cut;
        ASSERT_EQ(p.wallet.getNbrAccounts(), expected.accounts) << cut;
        ASSERT_EQ(links.operations.size(), expected.operations) << cut;
    }
}

TEST(WalletFileTest, AutomaticTransfersAreWrittenLikeManualOnesAndAutomaticSalesNotAtAll)
{
    SmallPortfolio p;
    Account* account = addAccount(p.wallet, "Main", p.euro);
    transfer(account, account, 1, 2, true);
    new ShareOperation(kStart, new Share(&p.wallet, p.alpha), false, 1, 1, true, 0);
    ASSERT_EQ(p.wallet.rd(BytesFile(bytesWritten(p.wallet)), nullptr), 0);
    ASSERT_EQ(p.wallet.getNbrAccounts() + p.wallet.getNbrShares(), 2U);
    ASSERT_EQ(p.wallet.getAccount(0)->getNbrOperations(), 1U);
    EXPECT_FALSE(p.wallet.getAccount(0)->getOperation(0)->isAutomatic());
    EXPECT_EQ(all(p.wallet, &Wallet::getAllShares).front()->getNbrShareOperations(), 0U);
    p.wallet.getAccount(0)->setCurrency(nullptr);
    bytesWritten(p.wallet, -1); // an account without currency could not be read back
}

TEST(WalletFileTest, UnknownNamesAndImpossibleCountsEndTheReading)
{
    const std::string message = "Error getting a company -> the portofolio doesn't match the company descriptions...\n";
    const struct {
        const char *what, *with;
        unsigned shares, operations;
        std::string output;
        const char* why;
    } cases[] = {
        {"01000000 05000000 'Paris' 02000000 'AC'",
         "03000000 05000000 'Paris' 02000000 'AC' 05000000 'Paris' 02000000 'XX' 05000000 'Paris' 02000000 'AC'", 1, 0,
         message, "the known share behind is not read"},
        {"04000000 'Euro'", "04000000 'Yuan'", 1, 0, "", "unknown currency of the first account"},
        {"06000000 'Dollar'", "06000000 'dollar'", 1, 3, "", "unknown currency of the second account"},
        {"'S' 'N' 05000000 'Paris'", "'S' 'N' 05000000 'Lyons'", 1, 2, "", "a holding that was not read"},
        {"'Main' 'Y' 04000000", "'Main' 'Y' FFFFFFFF", 1, 3, "", "negative count: the rest is no operation"},
        {"'Side' 'N' 00000000 01000000", "'Side' 'N' 00000000 FFFFFFFF", 1, 5, "",
         "negative count: the next goes to nobody"},
        {"CF070000 01000000", "CF070000 FFFFFFFF", 1, 0, "", "negative count: the next is no share"},
        {"'AC' 02000000", "'AC' FFFFFFFF", 1, 3, "", "negative count: the next is no account"},
    };
    for (const auto& c : cases) {
        SmallPortfolio p;
        testing::internal::CaptureStdout();
        const int result = p.wallet.rd(BytesFile(replaced(bytesOfPieces(), c.what, c.with)), nullptr);
        EXPECT_EQ(testing::internal::GetCapturedStdout(), c.output) << c.why;
        EXPECT_EQ(result, -1) << c.why;
        EXPECT_EQ(p.wallet.getNbrShares(), c.shares) << c.why;
        const Links links({p.euro, p.dollar}, {&p.wallet});
        EXPECT_EQ(links.operations.size(), c.operations) << c.why;
        links.expectConsistent();
    }
}

TEST(WalletFileTest, ATransferToNobodyStaysAndWhatFollowsIsReadOutOfPlace)
{
    const std::string bytes = bytesOf("0500 0300 CF070000  00000000  01000000  04000000 'Euro' 04000000 'Main' 'N'"
                                      "02000000 'T' 'D' 0000803F 0200 0100 CF070000  01000000 06000000 'Nobody'"
                                      "00004843 0000803E 0000A040 0000C03F 00000040 0200 0100 CF070000") +
                              bytesOf(kDefaults);
    SmallPortfolio p;
    EXPECT_EQ(p.wallet.rd(BytesFile(bytes), nullptr), 0);
    ASSERT_EQ(p.wallet.getNbrAccounts(), 1U);
    ASSERT_EQ(p.wallet.getAccount(0)->getNbrOperations(), 2U);
    const auto* failed = dynamic_cast<TransferAccountOperation*>(p.wallet.getAccount(0)->getOperation(0));
    ASSERT_NE(failed, nullptr);
    Account* recipient;
    EXPECT_EQ(failed->getRecepientAccount(&recipient), -1);
    EXPECT_TRUE(failed->getDate().isUndefined());
    EXPECT_EQ(failed->getAmount() + failed->getRateCost() + failed->getCost(), 0);
    EXPECT_EQ(failed->getFromCurrencyQuote() + failed->getToCurrencyQuote(), 2);
    EXPECT_EQ(p.wallet.getBuyCost(), 200) << "the rest of its body stands where the parameters are looked for";
    EXPECT_EQ(p.wallet.getSellRateCost(), 1.5F);
    EXPECT_EQ(p.wallet.getInvestementPeriod(), 0);
    EXPECT_TRUE(p.wallet.hasLostRecipient());

    SmallPortfolio again;
    const BytesFile file(replaced(bytesOfPieces(), "01000000 04000000 'Side' 0000", "01000000 04000000 'Sude' 0000"));
    EXPECT_EQ(again.wallet.rd(file, nullptr), 0) << "no failure, though what is read out of place meets the end";
    ASSERT_EQ(again.wallet.getNbrAccounts(), 2U);
    EXPECT_EQ(again.wallet.getAccount(0)->getNbrOperations(), 4U);
    EXPECT_EQ(again.wallet.getBuyCost(), Wallet().getBuyCost()) << "a parameter that the end has cost it";
    EXPECT_EQ(diagnosisOf(file, again.catalogue),
              "the transfer of 200.00 from Main to Sude on 02/01/1999 lost its "
              "recipient, which is no account of the file; what stands behind is read "
              "out of place");
    EXPECT_EQ(again.wallet.rd(BytesFile(bytesOfPieces()), nullptr), 0);
    EXPECT_FALSE(again.wallet.hasLostRecipient());
}

TEST(WalletFileTest, AFailedReadIsToldAllThatIsMissingOrWhereTheFileEnds)
{
    const std::string place = "the file ends in the middle of ";
    const std::string sample = "; the market file Sample ";
    const std::string lyons =
        replaced(replaced(replaced(bytesOfPieces(), "'Paris'", "'Lyons'"), "'Paris'", "'Lyons'"), "'Paris'", "'Lyons'");
    const std::string yuan = replaced(lyons, "04000000 'Euro'", "04000000 'Yuan'");
    const auto upTo = [](std::size_t piece, std::size_t more) {
        std::size_t size = more;
        for (std::size_t i = 0; i < piece; ++i)
            size += bytesOf(kPieces[i].bytes).size();
        return bytesOfPieces().substr(0, size);
    };
    const std::pair<std::string, std::string> cases[] = {
        {lyons, "Mine needs Lyons / AC (2 operations)" + sample + "does not have it"},
        {yuan, "Mine needs Lyons / AC (2 operations) and the currency Yuan" + sample + "has neither"},
        {replaced(yuan, "'Dollar'", "'dollar'"),
         "Mine needs Lyons / AC (2 operations), the currency Yuan and the currency dollar" + sample +
             "has none of them"},
        {yuan.substr(0, 60),
         "Mine needs Lyons / AC (0 operations) and the currency Yuan" + sample + "has neither; " + place + "account 1"},
        {replaced(bytesOfPieces(), "'S' 'N' 05000000 'Paris'", "'S' 'N' 05000000 'Lyons'"),
         "the file has operations on what it does not list as a holding: Lyons / AC (1 operation)"},
        {replaced(bytesOfPieces(), "'Paris'", "'Lyons'"), "Mine needs Lyons / AC (0 operations)" + sample +
                                                              "does not have it; the file has operations on what it "
                                                              "does not list as a holding: Paris / AC (2 operations)"},
        {"", "the file is empty"},
        {upTo(0, 9), place + "its head"},
        {upTo(0, 15), place + "holding 1"},
        {upTo(2, 1), place + "account 1"},
        {upTo(4, 0), place + "account 2"},
        {upTo(5, 9), place + "the transfers of account 1"},
        {upTo(6, 0), place + "the transfers of account 2"},
        {upTo(7, 0).substr(0, bytesOfPieces().size() - 1), place + "its parameters"},
        {bytesOf("03000000 'EUR' 01000000 0100 0200 D3070000 04000000"), "this is a market file"},
        {"no portfolio", "this is no portfolio file"},
    };
    for (const auto& [bytes, text] : cases) {
        SmallPortfolio p;
        const BytesFile file(bytes);
        testing::internal::CaptureStdout();
        EXPECT_EQ(p.wallet.rd(file, nullptr), -1) << text;
        testing::internal::GetCapturedStdout();
        EXPECT_EQ(diagnosisOf(file, p.catalogue), text);
    }
    const auto shown = [](std::string_view name) { return std::string(name); };
    EXPECT_EQ(WalletDiagnosis(BytesFile(lyons), Catalogue(), shown).text("Mine", ""),
              "no market file is loaded, and Mine needs Lyons / AC (2 operations), the currency Euro and the currency "
              "Dollar");
}
