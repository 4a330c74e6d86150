#pragma once

class Company;
class CompanyView;
class NoteCompanyEvent;
class Operation;
class PLWindow;

/// The notes that tell, among a company's events, of income that it paid.
///
/// The portfolio has no link to a note. One belongs to an operation when its day and its text say so, and no other note
/// or income could be meant as well; a note that was changed by hand since, or whose account has another name now, is a
/// person's own and stays.
class DividendNotes {
public:
    /// Both outlive this.
    DividendNotes(PLWindow& window, CompanyView& page) : window_(window), page_(page) {}

    void add(Company& payer, const Operation& income);
    /// The note of an operation; null when it is no income, or none can be told to be its own.
    NoteCompanyEvent* of(const Operation& operation) const;
    /// Destroys the note; null is none.
    void remove(NoteCompanyEvent* note);

private:
    PLWindow& window_;
    CompanyView& page_;
};
