#pragma once

#include "platform/GraphicsDefs.h"
#include "platform/InterfaceDefs.h"

#include <memory>
#include <string>
#include <vector>

class BView;
class PaperPages;

enum class PaperSize { kA4, kLetter };

/// The size that the user's country writes on.
PaperSize usualPaperSize();

struct PaperCell {
    std::string text;
    rgb_color color = {0, 0, 0, 255};
};

/// What stands at the left may be wrapped; what stands at the right, figures, never is.
struct PaperColumn {
    std::string title;
    alignment align = B_ALIGN_LEFT;
};

struct PaperRow {
    std::vector<PaperCell> cells; ///< one for each column
    bool isSum = false;           ///< of the rows above it: bold, below a rule, and never parted from them
    bool goesOn = false;          ///< belongs to the row above it, and stays on its page
};

/// A table with its heading. A column in which nothing stands is left out. Heading and columns' titles are repeated
/// where it goes on on another page.
struct PaperTable {
    std::string title;
    std::vector<PaperColumn> columns;
    std::vector<PaperRow> rows;
    std::string note = {}; ///< below the table, small
};

/// A figure with its name.
struct PaperFact {
    std::string name;
    PaperCell value;
};

/// What is printed on pages of paper, put together from above to below.
///
/// Nothing is cut: a column that has too little room is wrapped, a table that is too wide is set smaller. Every page
/// has its number, the number of pages, and the two texts that say what it is a page of. What is drawn stays text and
/// lines, so that it can be selected and looks the same in any size.
class PaperDocument {
public:
    /// `name` is what the document is of, `day` which version of it; both stand on each page.
    PaperDocument(PaperSize size, const std::string& name, const std::string& day);
    ~PaperDocument();

    void addTitle(const std::string& title, const std::string& subtitle);
    /// Begins a new page, unless nothing is on the present one.
    void addPart(const std::string& title, const std::string& subtitle);
    void addFacts(const std::vector<PaperFact>& facts);
    void addText(const std::string& text);
    /// One without rows is left out.
    void addTable(const PaperTable& table);
    /// Drawn as wide as the page's text, with what the view draws in its bounds. Owns it from now on.
    void addPicture(const std::string& title, std::unique_ptr<BView> view);

    int CountPages() const;
    /// The page on which the last part begins, counted from 0; the first one without parts.
    int LastPart() const { return lastPart_; }
    /// The whole document as the bytes of a PDF file, with its fonts.
    std::string pdf() const;

    /// For the platform's own use.
    const PaperPages& pages() const { return *pages_; }

private:
    std::string name_;
    std::unique_ptr<PaperPages> pages_;
    int lastPart_ = 0;
};
