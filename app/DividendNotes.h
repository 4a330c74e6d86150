#pragma once

#include <string>

class Company;
class CompanyView;
class NoteCompanyEvent;
class Operation;
class PLWindow;

/// The notes that tell, among a company's events, of income that it paid.
///
/// The portfolio has no link to a note. One belongs to an operation when its day and its text say so. Of several
/// incomes that look alike each has one of as many notes, in their order; when there are more or fewer, none can be
/// told to be its own. A note that was changed by hand since, or whose account has another name now, is a person's own
/// and stays.
class DividendNotes {
public:
    /// Both outlive this.
    DividendNotes(PLWindow& window, CompanyView& page) : window_(window), page_(page) {}

    void add(Company& payer, const Operation& income);
    /// What a company is called where it may be gone; see `of`.
    static std::string nameOf(const Company& payer);
    /// The note of an operation; null when it is no income, or none can be told to be its own. Where `payer`, which may
    /// be empty, has one that fits, it is that.
    NoteCompanyEvent* of(const Operation& operation, const std::string& payer) const;
    /// Destroys the note; null is none.
    void remove(NoteCompanyEvent* note);

private:
    PLWindow& window_;
    CompanyView& page_;
};
