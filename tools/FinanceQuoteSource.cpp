#include "tools/FinanceQuoteSource.h"

#include "foundation/PrintableText.h"

#include <stdexcept>

namespace {

/// Prints a line "name,date,close,currency" for each name, or "name,,reason". What the library or its modules print
/// themselves goes to standard error.
///
/// A share has its latest price as `last`, a fund as `nav`. `close` is of the day before as a rule and is not taken.
/// Of rates the library tells no day; they are the latest.
constexpr const char* kScript = R"PERL(
use strict;
use warnings;
open(my $answer, '>&', \*STDOUT) or die "standard output cannot be used: $!\n";
open(STDOUT, '>&', \*STDERR) or die "standard error cannot be used: $!\n";
$answer->autoflush(1);
eval { require Finance::Quote; 1 }
    or die "the Perl library Finance::Quote is missing; Debian has it as libfinance-quote-perl\n";
my ($limit, $what, $how, @names) = @ARGV;
my (undef, undef, undef, $day, $month, $year) = localtime;
my $today = sprintf '%04d-%02d-%02d', $year + 1900, $month + 1, $day;
my @order = ($ENV{ALPHAVANTAGE_API_KEY} ? 'AlphaVantage' : (), 'ECB');
my $quoter = Finance::Quote->new($what eq 'rates' ? (currency_rates => {order => \@order}) : ())
    or die "Finance::Quote does not begin\n";
die "Finance::Quote has no method $how\n"
    if $what eq 'quotes' and not grep { $_ eq $how } $quoter->get_methods;

sub rate {
    my $rate = $quoter->currency($_[0], $how) or die "has no rate\n";
    return ($today, $rate, $how);
}
sub quote {
    my $name = shift;
    my %of = $quoter->fetch($how, $name);
    die(($of{$name, 'errormsg'} || 'has no quote') . "\n") unless $of{$name, 'success'};
    my ($price) = grep { defined and length } map { $of{$name, $_} } qw(last nav price);
    die "has no price\n" unless defined $price;
    return ($of{$name, 'isodate'} || $today, $price, $of{$name, 'currency'} || '');
}
for my $name (@names) {
    local $SIG{ALRM} = sub { die "has not answered within $limit seconds\n" };
    my @line = eval {
        alarm $limit;
        my @told = $what eq 'rates' ? rate($name) : quote($name);
        alarm 0;
        @told;
    };
    alarm 0; # of one that has failed
    @line = ('', $@) if $@;
    s/\s+/ /g, s/ $// for @line;
    print $answer join(',', $name, @line), "\n";
}
)PERL";

} // namespace

FinanceQuoteSource::FinanceQuoteSource(const std::string& method, std::chrono::seconds limit)
    : method_(method), limit_(limit)
{
    if (method.empty() || method.find_first_not_of("abcdefghijklmnopqrstuvwxyz0123456789_") != method.npos)
        throw std::runtime_error("is no method of Finance::Quote: " + printable(method));
}

QuoteSource::Run FinanceQuoteSource::quotesOf(const std::vector<std::string>& tickers) const
{
    return run("quotes", method_, tickers);
}

QuoteSource::Run FinanceQuoteSource::ratesOf(const std::vector<std::string>& currencies,
                                             const std::string& reference) const
{
    return run("rates", reference, currencies);
}

QuoteSource::Run FinanceQuoteSource::run(const char* what, const std::string& how,
                                         const std::vector<std::string>& names) const
{
    Run run{names, {"perl", "-e", kScript, "--", std::to_string(limit_.count()), what, how}, true};
    run.arguments.insert(run.arguments.end(), names.begin(), names.end());
    return run;
}
