#include "exchange/JournalForm.h"

#include "exchange/TextForms.h"
#include "exchange/UniqueNames.h"

#include <algorithm>

namespace {

bool isUpper(char c)
{
    return c >= 'A' && c <= 'Z';
}

bool isLetterOrDigit(char c)
{
    return isUpper(c) || (c >= 'a' && c <= 'z') || (c >= '0' && c <= '9');
}

std::string upper(std::string text)
{
    for (char& c : text)
        if (c >= 'a' && c <= 'z')
            c = static_cast<char>(c - 'a' + 'A');
    return text;
}

/// Cut after at most `length` bytes, not within a character.
std::string cut(std::string text, std::size_t length)
{
    if (text.size() <= length)
        return text;
    while ((static_cast<unsigned char>(text[length]) & 0xC0) == 0x80)
        --length;
    return text.substr(0, length);
}

/// One line of UTF-8 with the letters of Western Europe without their accents, and blanks of any width as plain ones;
/// of other characters that are not ASCII each is a '-', or stays.
std::string plain(std::string_view name, bool keepsOthers)
{
    constexpr char32_t kFirst = 0xC0;
    constexpr std::string_view kLetters = "AAAAAAACEEEEIIIIDNOOOOO-OUUUUYTsaaaaaaaceeeeiiiidnooooo-ouuuuyty";
    std::string text;
    while (!name.empty()) {
        const std::string_view rest = name;
        const char32_t c = takeCharacter(name);
        if (isBlank(c))
            text += ' ';
        else if (c >= kFirst && c < kFirst + kLetters.size())
            text += kLetters[c - kFirst];
        else if (c < 0x80 || c == kBrokenCharacter || keepsOthers)
            text += rest.substr(0, rest.size() - name.size());
        else
            text += '-';
    }
    return cleanName(text);
}

std::string quoted(const std::string& text)
{
    std::string result = "\"";
    for (const char c : text) {
        if (c == '"' || c == '\\')
            result += '\\';
        result += c;
    }
    return result + '"';
}

class LedgerForm : public JournalForm {
public:
    std::string head() const override { return "; A portfolio of Pelorin, for ledger and hledger."; }
    std::string symbol(std::string_view name) const override
    {
        // It stands between quotes, where these would end it or hide their end.
        return cut(replaced(name, "\";\\"), kLongestSymbol);
    }
    std::string accountPart(std::string_view name) const override { return replaced(name, ":;"); }
    std::vector<std::string> reserved() const override { return {"s", "m", "h", "%"}; } // units of time
    int firstYear() const override { return 1400; }
    int lastYear() const override { return 9999; }
    bool needsDirectPrices() const override { return false; }
    std::string preamble(const std::string&) const override { return {}; }

    std::string commodity(const std::string& symbol, bool isCurrency, const std::string& name) const override
    {
        const std::string line = "commodity " + inAmount(symbol) + "  ; " + replaced(name, "") + '\n';
        return isCurrency ? line + "  format 1000.00 " + inAmount(symbol) + '\n' : line;
    }
    std::string openAccount(const std::string&, const std::string& account) const override
    {
        return "account " + account + '\n';
    }
    std::string price(const std::string& day, const std::string& symbol, const std::string& number,
                      const std::string& in) const override
    {
        return "P " + day + ' ' + inAmount(symbol) + ' ' + number + ' ' + inAmount(in) + '\n';
    }
    std::string transaction(const std::string& day, const std::string& text) const override
    {
        return day + " * " + replaced(text, ";") + '\n';
    }
    std::string inAmount(const std::string& symbol) const override
    {
        return std::ranges::all_of(symbol, isUpper) ? symbol : '"' + symbol + '"';
    }

private:
    /// Each of `characters` as '-'.
    static std::string replaced(std::string_view name, std::string_view characters)
    {
        // Without accents it is read whatever the locale, in which hledger takes a file to be.
        std::string text = plain(name, true);
        std::ranges::replace_if(
            text, [characters](char c) { return characters.find(c) != characters.npos; }, '-');
        return text;
    }
};

class BeancountForm : public JournalForm {
public:
    std::string head() const override { return ";; A portfolio of Pelorin, for beancount."; }
    std::string symbol(std::string_view name) const override
    {
        std::string text = upper(plain(name, false));
        std::ranges::replace_if(
            text, [](char c) { return !isLetterOrDigit(c) && c != '.' && c != '_'; }, '-'); // queries quote with '
        // It begins with a letter, has two characters at least, and ends with a letter or a digit.
        if (!isUpper(text.front()) || text.size() == 1)
            text = 'X' + text;
        text = cut(text, kLongestSymbol - 1);
        return isLetterOrDigit(text.back()) ? text : text + 'X';
    }
    std::string accountPart(std::string_view name) const override
    {
        std::string text = plain(name, false);
        std::ranges::replace_if(
            text, [](char c) { return !isLetterOrDigit(c); }, '-');
        text[0] = upper(text.substr(0, 1))[0];
        return text[0] == '-' ? 'X' + text : text;
    }
    std::vector<std::string> reserved() const override { return {"TRUE", "FALSE", "NULL"}; }
    int firstYear() const override { return 1700; }
    int lastYear() const override { return 2099; }
    bool needsDirectPrices() const override { return true; }
    std::string preamble(const std::string& reference) const override
    {
        const std::string title = "option \"title\" \"Pelorin\"\n";
        return reference.empty() ? title : title + "option \"operating_currency\" " + quoted(reference) + '\n';
    }

    std::string commodity(const std::string& symbol, bool, const std::string& name) const override
    {
        return std::to_string(firstYear()) + "-01-01 commodity " + symbol + "\n  name: " + quoted(name) + '\n';
    }
    std::string openAccount(const std::string& day, const std::string& account) const override
    {
        return day + " open " + account + '\n';
    }
    std::string price(const std::string& day, const std::string& symbol, const std::string& number,
                      const std::string& in) const override
    {
        return day + " price " + symbol + ' ' + number + ' ' + in + '\n';
    }
    std::string transaction(const std::string& day, const std::string& text) const override
    {
        return day + " * " + quoted(text) + '\n';
    }
    std::string inAmount(const std::string& symbol) const override { return symbol; }
};

} // namespace

const JournalForm& ledgerForm()
{
    static const LedgerForm form;
    return form;
}

const JournalForm& beancountForm()
{
    static const BeancountForm form;
    return form;
}
