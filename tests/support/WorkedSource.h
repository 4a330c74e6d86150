#pragma once

#include "tests/support/ToolRun.h"

#include <cstdlib>

/// Has the Perl library Finance::Quote, in all programs that are started from here on, find in `folder` a source of the
/// test's own, "worked", and rates in the place of its own ones. Neither asks a network. The source knows all tickers,
/// at 12.5 on 02/01/2026, but some that its code tells.
inline void installWorkedSource(const TemporaryFolder& folder)
{
    setenv("PERL5LIB", (folder / "lib").c_str(), 1);
    setenv("FQ_LOAD_QUOTELET", "Worked", 1);
    unsetenv("ALPHAVANTAGE_API_KEY");
    // What the library loads by itself, in front of its own; neither asks a network.
    folder.write("lib/Finance/Quote/Worked.pm", R"(package Finance::Quote::Worked;
sub methods { return (worked => \&worked, yahoo_json => \&worked) }
sub labels { return (worked => ['last', 'isodate', 'currency']) }
sub worked {
    my ($quoter, @tickers) = @_;
    my %of;
    for my $ticker (@tickers) {
        print "a module that chatters,1,2\n";
        die "a module that breaks\n" if $ticker eq 'DIES';
        sleep 60 if $ticker eq 'HANGS';
        $of{$ticker, 'success'} = $ticker ne 'NONE';
        $of{$ticker, 'errormsg'} = 'unknown, there: which takes more than a few words to tell to the end';
        $of{$ticker, $ticker eq 'FUND' ? 'nav' : 'last'} = $ticker eq 'LIES' ? 'free' : 12.5;
        $of{$ticker, 'close'} = 1;
        $of{$ticker, 'currency'} = $ticker eq 'POUND' ? 'GBP' : 'USD';
        $quoter->store_date(\%of, $ticker, {isodate => '2026-01-02'});
    }
    return wantarray() ? %of : \%of;
}
1;
)");
    folder.write("lib/Finance/Quote/CurrencyRates/ECB.pm", R"(package Finance::Quote::CurrencyRates::ECB;
my %units = (EUR => 1, USD => 1.25);
sub new { return bless {}, shift }
sub multipliers { return @units{@_[2, 3]} }
1;
)");
}
