#pragma once

#include "views/ColumnListView.h"

#include <functional>
#include <string>
#include <vector>

/// What the window of an import shows.
struct ImportSheet {
    /// Something that the table leaves open, with what is taken for it: a menu, or a field for a text.
    struct Question {
        const char* name; // of the control
        std::string label;
        bool isFirst; // in its row; another one may follow there
        std::vector<std::string> items = {};
        int marked = 0;
        std::string text = {}; // of a field, which has no items
        const char* toolTip = "";
    };
    using Rows = std::vector<std::vector<Cell>>;

    std::string headline; // what will become of how many lines
    std::string problem;  // why nothing can be imported; empty when it can
    std::string note;     // what else is good to know, instead of a problem
    std::vector<Question> questions;
    std::string title; // of the list
    std::vector<ListColumn> columns;
    Rows rows;
    bool hasRefused = false;
    bool asksToSkip = false; // whether to import the others is a person's to say
    bool skips = false;      // and was said
    std::string cashTitle;   // of the list below
    Rows cash;               // account, currency, before, after; none where no cash moves
};

/// A table that may be imported: says what would become of it, and hears what a person says where it leaves something
/// open. Changes nothing of the model.
class ImportPreview {
public:
    virtual ~ImportPreview() = default;

    /// Made anew from what was said until now.
    virtual ImportSheet sheet() = 0;
    /// The answers; questions go by their names.
    virtual void choose(const std::string& question, std::size_t item) = 0;
    virtual void type(const std::string& question, const std::string& text) = 0;
    virtual void setSkips(bool skips) = 0;

    /// Who shows how far the reading of a long table is: is given a line of text now and then. None at first.
    void setProgress(const std::function<void(const std::string&)>& progress) { progress_ = progress; }

protected:
    void tellProgress(const std::string& text) const
    {
        if (progress_)
            progress_(text);
    }

private:
    std::function<void(const std::string&)> progress_;
};
