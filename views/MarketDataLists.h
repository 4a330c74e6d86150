#pragma once

#include "market/Company.h"
#include "market/CompanyEvent.h"
#include "market/Currency.h"
#include "market/Market.h"
#include "views/DatedListView.h"

// The lists of what the market data file holds. Their columns are in the source.

template <>
const std::vector<ColumnOf<Currency>> ObjectItem<Currency>::kColumns;
template <>
const std::vector<ColumnOf<Market>> ObjectItem<Market>::kColumns;
template <>
const std::vector<ColumnOf<Company>> ObjectItem<Company>::kColumns;
template <>
const std::vector<ColumnOf<CompanyEvent>> ObjectItem<CompanyEvent>::kColumns;
template <>
const std::vector<ColumnOf<Quote>> ObjectItem<Quote>::kColumns;

/// The currencies with their latest rates, in the order of the catalogue.
using CurrencyListView = ObjectListView<Currency>;

/// Markets with their currency and the number of their companies, in the order of the catalogue.
using MarketListView = ObjectListView<Market>;

/// The companies of a market, in its order.
using CompanyListView = ObjectListView<Company>;

/// The events of a company: notes and splits.
using CompanyEventListView = DatedListView<CompanyEvent>;

/// The quotes of a company or the rates of a currency.
using QuoteListView = DatedListView<Quote>;
