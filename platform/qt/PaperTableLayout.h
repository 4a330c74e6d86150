#pragma once

#include "platform/PaperDocument.h"
#include "platform/qt/PaperPages.h"

#include <QStringList>

#include <vector>

/// Puts one table onto the pages: finds the widths of its columns, wraps what is too wide, and goes on on a new page
/// with heading and titles where one ends.
class PaperTableLayout {
public:
    /// The table outlives this.
    PaperTableLayout(const PaperTable& table, PaperPages& pages);

    void lay();

private:
    struct Column {
        alignment align;
        qreal natural = 0; ///< as wide as its widest text
        qreal left = 0;
        qreal width = 0;
    };
    struct Row {
        std::vector<QStringList> cells; ///< of each the lines
        qreal height = 0;
        const PaperRow* shown = nullptr;
    };

    PaperPages::Type type(bool isBold) const { return {kPoints * scale_, isBold}; }
    PaperPages::Type headType() const { return {6.6 * scale_, false, PaperPages::kFaint}; }
    PaperPages::Type noteType() const { return {6.6, false, PaperPages::kFaint}; }
    void measure();
    bool fit(qreal narrowest);
    void placeColumns(qreal spare);
    Row rowOf(const std::vector<QString>& cells, const PaperPages::Type& type) const;
    void makeRows();
    qreal headHeight() const;
    bool isBound(std::size_t row) const { return rows_[row].shown->isSum || rows_[row].shown->goesOn; }
    std::size_t nextOf(std::size_t row) const;
    qreal heightFrom(std::size_t row) const;
    qreal neededFor(std::size_t row) const;
    void addHead(bool isAgain);
    void addCells(const Row& row, const PaperPages::Type& type);
    void addRow(std::size_t row);

    static constexpr qreal kPoints = 7.6;

    const PaperTable& table_;
    PaperPages& pages_;
    qreal scale_ = 1; // of everything but the heading
    std::vector<Column> columns_;
    Row head_;
    std::vector<Row> rows_;
    QStringList note_;
};
