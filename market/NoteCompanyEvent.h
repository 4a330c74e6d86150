#pragma once

#include "foundation/String.h"
#include "market/CompanyEvent.h"

/// A note on a company: a title and a text on a day.
class NoteCompanyEvent final : public CompanyEvent {
public:
    static constexpr short kType = 2;

    NoteCompanyEvent() = default;
    NoteCompanyEvent(Company* company, const Date& date, const String& title, const String& text);

    /// File: date, title, text. `rd` returns -1 when the file ends inside the record.
    int wrt(FILE* file) const override;
    int rd(FILE* file) override;
    short getType() const override { return kType; }

    const String& getTitle() const { return title_; }
    void setTitle(const String& title) { title_ = title; }
    const String& getText() const { return text_; }
    void setText(const String& text) { text_ = text; }

private:
    String title_;
    String text_;
};
