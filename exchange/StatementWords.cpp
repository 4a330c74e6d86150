#include "exchange/StatementWords.h"

#include "exchange/TextForms.h"
#include "foundation/FoldedText.h"

#include <algorithm>
#include <array>
#include <map>
#include <vector>

namespace {

/// A column or type, and the headings or words that mean it, with blanks between; of headings the preferred first.
struct Meaning {
    const char* name;
    std::string_view words;
};

/// By number of the column. A heading stands for one column only.
constexpr std::array<Meaning, kStatementColumns> kColumns = {{
    {"date", "date tradedate datedeloperation transactiondate bookingdate postingdate operationdate datetime datum "
             "handelstag handelsdatum buchungstag buchungsdatum buchung buchungam datedoperation dateoperation "
             "datecomptable datedetransaction dateexecution dealdate dealingdate executiondate executed tradedon "
             "transactiondatetime bookedon postdate rundate ausfuhrungsdatum ausfuehrungsdatum ausfuhrungstag "
             "schlusstag abschlusstag transaktionsdatum auftragsdatum geschaftstag jour dateoper datetransaction "
             "datedebourse datenegociation datedenegociation datecompta datedecomptabilisation dateducompte "
             "effectivedate settlementdate settleddate settlement valuedate valuta valutadatum valutatag "
             "wertstellung wertstellungstag datedevaleur datevaleur datedexecution datedelordre orderdate "
             "settledate completeddate activitydate processdate entrydate abrechnungstag abrechnungsdatum "
             "datumzeit dateheure ausfuhrung time zeit"},
    {"type", "type transactiontype typedeloperation action transaction activity activitytype operation "
             "operationtype kind typ art umsatzart buchungsart transaktion transaktionsart transaktionstyp vorgang "
             "geschaftsart auftragsart nature natureoperation naturedeloperation typedoperation typeoperation sens "
             "mouvement trantype tradetype transactionkind activitycode entrytype movement event buysell side "
             "vorgangsart buchungstyp geschaeftsart geschaftsvorfall geschaeftsvorfall umsatztyp ereignis bewegung "
             "typedetransaction typetransaction typedemouvement typemouvement categorie evenement libelleoperation "
             "libelledeloperation transtype transcode transactioncode typeoftransaction bs kaufverkauf achatvente "
             "aktion orderart geschaft geschaeft artdesumsatzes artderbuchung kategorie category buchungstext"},
    {"account",
     "account accountname fromaccount konto kontoname vonkonto depot compte ducompte comptedebiteur accountno "
     "accountnumber depotkonto verrechnungskonto kontobezeichnung auftraggeberkonto comptetitres "
     "numerodecompte compteemetteur decompte from"},
    {"to account",
     "toaccount targetaccount transferaccount counteraccount recipient zielkonto gegenkonto aufkonto "
     "ankonto empfangerkonto verscompte verslecompte comptecrediteur comptedestinataire comptebeneficiaire "
     "destination destinationaccount toacct transferto totheaccount counterpartyaccount receivingaccount "
     "otheraccount nachkonto empfangskonto empfaengerkonto zielkontoname gegenkontoname kontogegenseite "
     "compteverse vers comptecible comptedecontrepartie to comptecredite comptededestination zumkonto"},
    {"market", "market exchange stockexchange markt borse boerse borsenplatz handelsplatz marche place bourse "
               "placedecotation listing venue listedon tradingvenue stockmarket boersenplatz ausfuhrungsplatz "
               "handelsort placeboursiere marcheboursier ausfuhrungsort lieudexecution primaryexchange"},
    {"ticker", "ticker symbol tickersymbol code kurzel kuerzel tickerkurzel symbole mnemo mnemonique codemnemonique "
               "epic stocksymbol stockcode tickercode securitycode instrumentcode borsenkurzel boersenkuerzel "
               "wertpapierkurzel codetitre codevaleur securitysymbol instrumentsymbol tidm codemnemo"},
    {"name", "name security securityname company companyname stock instrument bezeichnung wertpapier "
             "wertpapiername wertpapierbezeichnung aktie unternehmen firma titel titre valeur nom nomdutitre "
             "libelledutitre societe stockname share instrumentname investment holding asset securitydescription "
             "gattung gattungsbezeichnung papier aktienname gesellschaft emittent nomdelavaleur libellevaleur "
             "libelletitre designation entreprise intitule produkt product produit titelbezeichnung "
             "namedeswertpapiers actif support fund fonds anlage description"},
    {"quantity", "quantity shares noofshares numberofshares units qty number stuck stueck stuckzahl stueckzahl anzahl "
                 "menge nominale quantite qte nombre nombredetitres nbdetitres noofunits numberofunits sharecount "
                 "sharequantity volume pieces nominal stucke stuecke stk anzahlstucke anzahlaktien aktienzahl "
                 "stucknominale nbtitres nbredetitres nombredactions nbactions parts nombredeparts stucknom "
                 "nominalstuck sharesunits nb nbr quantiteexecutee filledquantity"},
    {"quote", "quote price shareprice unitprice priceperunit pricepershare tradeprice kurs ausfuhrungskurs "
              "ausfuehrungskurs stuckpreis preis cours coursdexecution prix prixunitaire executionprice dealprice "
              "dealingprice unitcost costpershare averageprice avgprice pricepaid handelskurs kaufkurs "
              "abrechnungskurs kurspreis einzelpreis stuckkurs preisprostuck preisjestuck coursunitaire "
              "coursdexecutionmoyen prixparaction prixdexecution coursexecution priceshare coursexecute preisstuck "
              "kursjestuck handelspreis coursmoyen tprice pu"},
    {"amount", "netamount totalamount total amount net value nettobetrag endbetrag gesamtbetrag gesamt summe "
               "ausmachenderbetrag betrag umsatz wert montantnet montanttotal montant somme amountnet nettotal "
               "netvalue settlementamount cashamount cashmovement cash totalvalue proceeds consideration "
               "transactionamount transactionvalue betragnetto netto gesamtwert abrechnungsbetrag endsumme "
               "buchungsbetrag umsatzbetrag zahlungsbetrag gutschriftlastschrift gegenwert montantdeloperation "
               "montantoperation montantglobal montanttotalnet montantregle netproceeds netcash netconsideration"},
    {"debit",
     "debit moneyout paidout withdrawals soll belastung ausgang debits debitamount amountdebited amountout out "
     "cashout betragsoll sollbetrag lastschrift abgang ausgabe ausgaben montantdebit sortie sorties "
     "decaissement depense"},
    {"credit",
     "credit moneyin paidin deposits haben gutschrift eingang credits creditamount amountcredited amountin in "
     "cashin betraghaben habenbetrag zugang einnahme einnahmen montantcredit entree entrees encaissement "
     "recette"},
    {"cost", "cost costs totalcosts totalfees gesamtkosten fraistotaux totalfrais operationcost fee fees "
             "commission commissions feescomm charges gebuhr gebuhren gebuehr gebuehren provision kosten spesen "
             "entgelt frais courtage fraisdecourtage dealingcharge dealingcharges dealingfee brokerage "
             "brokeragefee charge transactioncost transactioncosts transactionfee tradingfee bankspesen "
             "ordergebuhr ordergebuhren orderkosten nebenkosten transaktionskosten transaktionsgebuhr maklergebuhr "
             "provisionen fraisdetransaction fraisetcommissions commissionfrais couts entgelte commfee "
             "commissionfee commissionfees commissionsfees commissionandfees commissionsandfees feescommission "
             "feescommissions feesandcommissions commissionsetfrais orderentgelt orderentgelte handelsgebuhr "
             "handelsgebuhren gebuhrenprovision provisionspesen fraisettaxes gebuhrenundsteuern totalcharges "
             "commissionamount tradingfees brokerfee brokerfees"},
    {"rate cost", "ratecost costrate"},
    {"from quote", "fromquote"},
    {"to quote", "toquote"},
    {"currency", "currency ccy wahrung waehrung whg devise monnaie currencycode accountcurrency kontowahrung "
                 "codedevise curr cur wahr"},
}};

constexpr auto kStatementTypes = static_cast<std::size_t>(StatementType::kCharge) + 1;

/// By number of the type. A word means one type only.
constexpr std::array<Meaning, kStatementTypes> kTypes = {{
    {"deposit", "deposit cashdeposit cashin depositreceived moneyin contribution payin paidin einzahlung geldeingang "
                "zahlungseingang bareinzahlung versement depot apport depotdespeces virementrecu dep "
                "cashdepositreceived deposited fundsin fundsreceived paymentin paymentreceived cashreceived "
                "cashtransferin topup funding bankdeposit directdeposit einlage kapitaleinlage einzahlungen "
                "geldzufluss uberweisungseingang ueberweisungseingang zufluss versements versementespeces "
                "versementdespeces approvisionnement alimentation depots depotespeces virementenfaveur "
                "virementrecudelexterieur viremententrant virementenvotrefaveur versementlibre uberweisungsgutschrift "
                "achdeposit achin achcredit wirein wirereceived electronicfundstransferreceived banktransferin "
                "cashreceipt personalcontribution lodgement"},
    {"withdrawal",
     "withdrawal withdraw cashwithdrawal cashout moneyout payout paidout auszahlung geldausgang "
     "zahlungsausgang barauszahlung retrait retraitdespeces virementemis wd wdl withdrawals withdrawn "
     "fundsout paymentout cashpaid cashtransferout disbursement bankwithdrawal auszahlungen entnahme "
     "kapitalentnahme geldabfluss abfluss uberweisungsausgang ueberweisungsausgang abhebung retraits "
     "retraitespeces virementsortant virementversexterieur achwithdrawal achout achdebit wireout wiresent "
     "electronicfundstransferpaid banktransferout cashpayment"},
    {"transfer",
     "transfer internaltransfer cashtransfer umbuchung ubertrag uebertrag kontoubertrag virement "
     "virementinterne transfert tfr trf xfer transferred accounttransfer transferbetweenaccounts "
     "internalcashtransfer interaccounttransfer transfers umbuchungen kontoubertragung ubertragung "
     "uebertragung interneuberweisung internerubertrag internaluberweisung virements virementdecompteacompte "
     "virementcompteacompte transfertinterne transfertentrecomptes"},
    {"buy", "buy bought purchase youbought buytrade kauf gekauft wertpapierkauf aktienkauf ankauf achat "
            "achatcomptant achatdetitres acquisition b purchased purchases buyorder marketbuy stockpurchase "
            "sharepurchase acquired kaufe kaeufe kauforder erwerb zukauf wertpapierkaufe kaufvonwertpapieren "
            "aktienerwerb achats achatdactions achatactions achattitres souscription kaufwertpapiere "
            "wertpapierabrechnungkauf abrechnungkauf sparplankauf sparplanausfuhrung sparplanausfuehrung limitbuy "
            "stopbuy achataucomptant achatbourse subscription zeichnung"},
    {"sell", "sell sold sale yousold selltrade verkauf verkauft wertpapierverkauf aktienverkauf vente "
             "ventecomptant ventedetitres cession s sells sales sellorder marketsell stocksale sharesale disposal "
             "verkaufe verkaeufe verkauforder verausserung veraeusserung abverkauf ventes ventedactions "
             "ventesactions ventetitres verkaufwertpapiere wertpapierabrechnungverkauf abrechnungverkauf limitsell "
             "stopsell venteaucomptant ventebourse redemption rachat"},
    {"income", "income dividend dividends cashdividend dividendreceived interest interestreceived interestincome "
               "creditinterest coupon distribution dividende dividenden dividendengutschrift ausschuttung "
               "ausschuettung ertrag ertrage ertragsgutschrift zins zinsen habenzinsen zinsgutschrift zinsertrag "
               "dividendes interet interets interetscrediteurs revenu revenus coupons div dividendpayment "
               "dividendpaid dividendincome orddividend ordinarydividend qualifieddividend int interestcredit "
               "grossinterest interestearned bankinterest couponpayment yield distributions dividendenzahlung "
               "dividendenertrag dividendenertrage bardividende zinszahlung zinsertrage zinsertraege guthabenzinsen "
               "ertraege ertragnis ertragnisse ertragsausschuttung couponzahlung kuponzahlung paiementdedividende "
               "dividendeverse versementdividende versementdedividende paiementdecoupon encaissementcoupon "
               "detachementcoupon interetscredit interetsrecus interetscrediteur dividendenabrechnung "
               "ertragnisgutschrift ertraegnisgutschrift habenzins interestoncash interestpayment dividendordinary "
               "qualifieddiv nonqualifieddiv nonqualifieddividend dividenderecu encaissementdividende "
               "encaissementdividendes encaissementcoupons zinsabschluss loyaltybonus cashinlieu longtermcapgain "
               "shorttermcapgain"},
    {"charge", "charge charges fee fees accountfee custodyfee managementfee servicefee commission tax taxes "
               "withholdingtax debitinterest interestcharged interestpaid gebuhr gebuhren gebuehr gebuehren entgelt "
               "kosten spesen kontofuhrung kontofuhrungsgebuhr steuer steuern quellensteuer kapitalertragsteuer "
               "sollzinsen frais fraisdecompte fraisdegestion droitsdegarde fraisdetenuedecompte impot impots taxe "
               "interetsdebiteurs agios accountcharge accountfees accountcharges custodycharge custodyfees "
               "custodianfee platformfee platformcharge administrationfee adminfee annualfee monthlyfee quarterlyfee "
               "managementcharge servicecharge maintenancefee inactivityfee bankcharge bankcharges bankfee "
               "overdraftinterest interestcharge stampduty taxwithheld kontogebuhr kontofuhrungsentgelt "
               "kontofuhrungsgebuhren kontogebuhren verwaltungsgebuhr verwahrgebuhr servicegebuhr bankgebuhr "
               "bankspesen jahresgebuhr abgeltungsteuer abgeltungssteuer steuerabzug zinsbelastung verzugszinsen "
               "fraisbancaires fraisdecourtage fraisfixes fraisdedossier commissiondecompte commissions "
               "commissiondetenuedecompte cotisation abonnement prelevementsociaux prelevementssociaux "
               "prelevementfiscal retenuealasource interetsdebit interetspayes depotentgelt ordergebuhr "
               "ordergebuhren kapitalertragssteuer solidaritatszuschlag solidaritaetszuschlag kirchensteuer "
               "transaktionssteuer finanztransaktionssteuer stempelsteuer verwaltungsentgelt transaktionskosten "
               "uberziehungszinsen ueberziehungszinsen fraisdegarde courtage taxesurlestransactionsfinancieres "
               "prelevementliberatoire foreigntaxpaid foreigntaxwithheld nratax nrawithholding adrfee adrmgmtfee "
               "ptmlevy margininterest"},
}};

/// Codes that may stand beside an amount; a file need not have the currency. "GBX" is a hundredth of "GBP".
constexpr std::string_view kCurrencyCodes =
    "AED ARS AUD BGN BRL CAD CHF CLP CNY COP CZK DKK EGP EUR GBP GBX HKD HUF IDR ILS INR ISK JPY KRW KWD MAD MXN MYR "
    "NOK "
    "NZD PEN PHP PKR PLN QAR RON RSD RUB SAR SEK SGD THB TND TRY TWD UAH USD VND ZAR";

/// Codes, and the signs and words for them, in small letters.
constexpr std::array<Meaning, 12> kCurrencies = {{
    {"EUR", "\u20AC euro euros"},
    {"GBP", "\u00A3 pound pounds"},
    {"USD", "us$"},
    {"AUD", "a$ au$"},
    {"CAD", "c$ ca$"},
    {"HKD", "hk$"},
    {"NZD", "nz$"},
    {"SGD", "s$"},
    {"CHF", "fr sfr franken"},
    {"USD AUD CAD HKD NZD SGD MXN TWD", "$ dollar dollars"},
    {"JPY CNY", "\u00A5 yen"},
    {"SEK NOK DKK ISK CZK", "kr kronen"},
}};

/// The number of the one that is called `name`.
template <std::size_t n>
std::optional<std::size_t> indexOf(const std::array<Meaning, n>& meanings, std::string_view name)
{
    const auto isNamed = [key = wordKey(name)](const Meaning& meaning) { return wordKey(meaning.name) == key; };
    const auto found = std::ranges::find_if(meanings, isNamed);
    return found != meanings.end() ? std::optional(static_cast<std::size_t>(found - meanings.begin())) : std::nullopt;
}

} // namespace

std::span<const std::string_view> headingsOf(StatementColumn column)
{
    static const auto headings = [] {
        std::array<std::vector<std::string_view>, kStatementColumns> lists;
        std::ranges::transform(kColumns, lists.begin(),
                               [](const Meaning& meaning) { return splitAtBlanks(meaning.words); });
        return lists;
    }();
    return headings[static_cast<std::size_t>(column)];
}

const char* nameOf(StatementColumn column)
{
    return kColumns[static_cast<std::size_t>(column)].name;
}

std::optional<StatementColumn> columnNamed(std::string_view name)
{
    const auto index = indexOf(kColumns, name);
    return index ? std::optional(static_cast<StatementColumn>(*index)) : std::nullopt;
}

std::optional<StatementType> typeOfWord(std::string_view key)
{
    static const auto types = [] {
        std::map<std::string_view, StatementType> map;
        for (std::size_t i = 0; i < kStatementTypes; ++i)
            for (const std::string_view word : splitAtBlanks(kTypes[i].words))
                map.emplace(word, static_cast<StatementType>(i));
        return map;
    }();
    const auto found = types.find(key);
    return found != types.end() ? std::optional(found->second) : std::nullopt;
}

const char* nameOf(StatementType type)
{
    return kTypes[static_cast<std::size_t>(type)].name;
}

std::string_view currencyCodesOf(std::string_view text)
{
    if (text == "GBp")
        return "GBX";
    const std::string key = foldedText(text);
    for (const std::string_view code : splitAtBlanks(kCurrencyCodes))
        if (foldedText(code) == key)
            return code;
    for (const auto& [codes, words] : kCurrencies)
        if (std::ranges::count(splitAtBlanks(words), key) > 0)
            return codes;
    return {};
}

std::optional<StatementType> typeNamed(std::string_view name)
{
    const auto index = indexOf(kTypes, name);
    return index ? std::optional(static_cast<StatementType>(*index)) : std::nullopt;
}
