#pragma once

class Company;
class CompanyView;

/// Fetches the company's price of today from the quote server and stores it. `view`, which may be null, is told of a
/// quote that is new or has changed. Blocks until the server has answered.
/// @return 0; -1 when there is no price to be had, and nothing has changed then.
int fetchLatestQuote(Company* company, CompanyView* view);
