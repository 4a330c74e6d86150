#pragma once

class Catalogue;

/// Fills an empty catalogue with the market data that the fuzzed portfolios refer to: three currencies, three markets
/// and five companies, among them some without quotes. Names have one letter, so that a mutation easily hits another.
void fillSmallCatalogue(Catalogue& catalogue);
