#include "exchange/StatementWords.h"

#include "exchange/TextForms.h"

#include <algorithm>
#include <array>
#include <vector>

namespace {

struct ColumnWords {
    const char* name;
    std::vector<std::string_view> headings;
};

/// By number of the column. A heading stands for one column only.
const std::array<ColumnWords, kStatementColumns>& columnWords()
{
    static const std::array<ColumnWords, kStatementColumns> words = {{
        {"date",
         {"date",          "tradedate",      "transactiondate", "bookingdate",   "postingdate",   "operationdate",
          "datetime",      "datum",          "handelstag",      "handelsdatum",  "buchungstag",   "buchungsdatum",
          "buchung",       "buchungam",      "datedoperation",  "dateoperation", "datecomptable", "datedetransaction",
          "dateexecution", "settlementdate", "valuedate",       "valuta",        "valutadatum",   "wertstellung",
          "datedevaleur",  "datevaleur"}},
        {"type",
         {"type",
          "transactiontype",
          "action",
          "transaction",
          "activity",
          "activitytype",
          "operation",
          "operationtype",
          "kind",
          "typ",
          "art",
          "umsatzart",
          "buchungsart",
          "transaktion",
          "transaktionsart",
          "transaktionstyp",
          "vorgang",
          "geschaftsart",
          "auftragsart",
          "nature",
          "natureoperation",
          "naturedeloperation",
          "typedoperation",
          "typeoperation",
          "sens",
          "mouvement"}},
        {"account",
         {"account", "accountname", "fromaccount", "konto", "kontoname", "vonkonto", "depot", "compte", "ducompte",
          "comptedebiteur"}},
        {"to account",
         {"toaccount", "targetaccount", "transferaccount", "counteraccount", "recipient", "zielkonto", "gegenkonto",
          "aufkonto", "ankonto", "empfangerkonto", "verscompte", "verslecompte", "comptecrediteur",
          "comptedestinataire", "comptebeneficiaire"}},
        {"market",
         {"market", "exchange", "stockexchange", "markt", "borse", "boerse", "borsenplatz", "handelsplatz", "marche",
          "place", "bourse", "placedecotation"}},
        {"ticker",
         {"ticker", "symbol", "tickersymbol", "code", "kurzel", "kuerzel", "tickerkurzel", "symbole", "mnemo",
          "mnemonique", "codemnemonique"}},
        {"name",
         {"name",
          "security",
          "securityname",
          "company",
          "companyname",
          "stock",
          "instrument",
          "bezeichnung",
          "wertpapier",
          "wertpapiername",
          "wertpapierbezeichnung",
          "aktie",
          "unternehmen",
          "firma",
          "titel",
          "titre",
          "valeur",
          "nom",
          "nomdutitre",
          "libelledutitre",
          "societe"}},
        {"quantity",
         {"quantity", "shares", "noofshares", "numberofshares", "units", "qty", "number", "stuck", "stueck",
          "stuckzahl", "stueckzahl", "anzahl", "menge", "nominale", "quantite", "qte", "nombre", "nombredetitres",
          "nbdetitres"}},
        {"quote",
         {"quote", "price", "shareprice", "unitprice", "priceperunit", "pricepershare", "tradeprice", "kurs",
          "ausfuhrungskurs", "ausfuehrungskurs", "stuckpreis", "preis", "cours", "coursdexecution", "prix",
          "prixunitaire"}},
        {"amount",
         {"netamount", "totalamount", "total", "amount", "net", "value", "nettobetrag", "endbetrag", "gesamtbetrag",
          "gesamt", "summe", "ausmachenderbetrag", "betrag", "umsatz", "wert", "montantnet", "montanttotal", "montant",
          "somme"}},
        {"debit", {"debit", "moneyout", "paidout", "withdrawals", "soll", "belastung", "ausgang", "debits"}},
        {"credit", {"credit", "moneyin", "paidin", "deposits", "haben", "gutschrift", "eingang", "credits"}},
        {"cost", {"cost",     "costs",   "operationcost", "fee",      "fees",     "commission",     "commissions",
                  "feescomm", "charges", "gebuhr",        "gebuhren", "gebuehr",  "gebuehren",      "provision",
                  "kosten",   "spesen",  "entgelt",       "frais",    "courtage", "fraisdecourtage"}},
        {"rate cost", {"ratecost", "costrate"}},
        {"from quote", {"fromquote"}},
        {"to quote", {"toquote"}},
        {"currency", {"currency", "ccy", "wahrung", "waehrung", "whg", "devise", "monnaie"}},
    }};
    return words;
}

struct TypeWords {
    const char* name;
    std::vector<std::string_view> words;
};

/// By number of the type.
const std::vector<TypeWords>& typeWords()
{
    static const std::vector<TypeWords> words = {
        {"deposit",
         {"deposit", "cashdeposit", "cashin", "depositreceived", "moneyin", "contribution", "payin", "paidin",
          "einzahlung", "geldeingang", "zahlungseingang", "bareinzahlung", "versement", "depot", "apport",
          "depotdespeces", "virementrecu"}},
        {"withdrawal",
         {"withdrawal", "withdraw", "cashwithdrawal", "cashout", "moneyout", "payout", "paidout", "auszahlung",
          "geldausgang", "zahlungsausgang", "barauszahlung", "retrait", "retraitdespeces", "virementemis"}},
        {"transfer",
         {"transfer", "internaltransfer", "cashtransfer", "umbuchung", "ubertrag", "uebertrag", "kontoubertrag",
          "virement", "virementinterne", "transfert"}},
        {"buy",
         {"buy", "bought", "purchase", "youbought", "buytrade", "kauf", "gekauft", "wertpapierkauf", "aktienkauf",
          "ankauf", "achat", "achatcomptant", "achatdetitres", "acquisition"}},
        {"sell",
         {"sell", "sold", "sale", "yousold", "selltrade", "verkauf", "verkauft", "wertpapierverkauf", "aktienverkauf",
          "vente", "ventecomptant", "ventedetitres", "cession"}},
        {"income",
         {"income",
          "dividend",
          "dividends",
          "cashdividend",
          "dividendreceived",
          "interest",
          "interestreceived",
          "interestincome",
          "creditinterest",
          "coupon",
          "distribution",
          "dividende",
          "dividenden",
          "dividendengutschrift",
          "ausschuttung",
          "ausschuettung",
          "ertrag",
          "ertrage",
          "ertragsgutschrift",
          "zins",
          "zinsen",
          "habenzinsen",
          "zinsgutschrift",
          "zinsertrag",
          "dividendes",
          "interet",
          "interets",
          "interetscrediteurs",
          "revenu",
          "revenus",
          "coupons"}},
        {"charge", {"charge",        "charges",
                    "fee",           "fees",
                    "accountfee",    "custodyfee",
                    "managementfee", "servicefee",
                    "commission",    "tax",
                    "taxes",         "withholdingtax",
                    "debitinterest", "interestcharged",
                    "interestpaid",  "gebuhr",
                    "gebuhren",      "gebuehr",
                    "gebuehren",     "entgelt",
                    "kosten",        "spesen",
                    "kontofuhrung",  "kontofuhrungsgebuhr",
                    "steuer",        "steuern",
                    "quellensteuer", "kapitalertragsteuer",
                    "sollzinsen",    "frais",
                    "fraisdecompte", "fraisdegestion",
                    "droitsdegarde", "fraisdetenuedecompte",
                    "impot",         "impots",
                    "taxe",          "interetsdebiteurs",
                    "agios"}},
    };
    return words;
}

const TypeWords& wordsOf(StatementType type)
{
    return typeWords()[static_cast<std::size_t>(type)];
}

} // namespace

std::span<const std::string_view> headingsOf(StatementColumn column)
{
    return columnWords()[static_cast<std::size_t>(column)].headings;
}

const char* nameOf(StatementColumn column)
{
    return columnWords()[static_cast<std::size_t>(column)].name;
}

std::optional<StatementColumn> columnNamed(std::string_view name)
{
    for (std::size_t i = 0; i < kStatementColumns; ++i)
        if (const auto column = static_cast<StatementColumn>(i); wordKey(nameOf(column)) == wordKey(name))
            return column;
    return std::nullopt;
}

std::optional<StatementType> typeOfWord(std::string_view key)
{
    for (std::size_t i = 0; i < typeWords().size(); ++i)
        if (std::ranges::find(typeWords()[i].words, key) != typeWords()[i].words.end())
            return static_cast<StatementType>(i);
    return std::nullopt;
}

const char* nameOf(StatementType type)
{
    return wordsOf(type).name;
}

std::optional<StatementType> typeNamed(std::string_view name)
{
    for (std::size_t i = 0; i < typeWords().size(); ++i)
        if (wordKey(name) == typeWords()[i].name)
            return static_cast<StatementType>(i);
    return std::nullopt;
}
