#pragma once

#include "platform/PaperDocument.h"
#include "platform/View.h"

#include <QColor>
#include <QFont>
#include <QPageSize>
#include <QRectF>
#include <QString>
#include <QStringList>

#include <memory>
#include <vector>

class QPainter;

/// The pages of a document with what stands on them, and the place where the next thing goes.
///
/// Lengths are in twentieths of a point, small enough for whole numbers: fonts have whole sizes, and no letter is moved
/// to the grid of a screen.
class PaperPages {
public:
    static constexpr qreal kPoint = 20;
    static constexpr QColor kText{0, 0, 0};
    static constexpr QColor kFaint{96, 96, 96};

    struct Type {
        qreal points;
        bool isBold = false;
        QColor color = kText;

        QFont font() const;
        qreal width(const QString& text) const;
        /// `text` in lines of that width; of more than `most` the last one ends in an ellipsis.
        QStringList lines(const QString& text, qreal width, int most) const;
        qreal lineHeight() const { return points * kPoint * 1.35; }
    };

    PaperPages(PaperSize size, const std::string& name, const std::string& day);

    /// As one line that can be drawn, whatever bytes it has.
    static QString textOf(const std::string& text);

    QPageSize size() const { return size_; }
    const QString& name() const { return name_; }
    /// Where things may stand on a page.
    const QRectF& area() const { return area_; }
    qreal y() const { return y_; }
    qreal room() const { return area_.bottom() - y_; }
    bool isAtTop() const { return y_ == area_.top(); }
    void moveDown(qreal length) { y_ += length; }
    void beginPage();

    // On the present page.
    void addText(QPointF base, const QString& text, const Type& type);
    /// Text in a line of the type's height below `top`; `x` is the end that it is aligned to.
    void addLine(qreal x, qreal top, const QString& text, const Type& type, alignment align = B_ALIGN_LEFT);
    void addRule(qreal left, qreal right, qreal y, qreal points, const QColor& color);
    void addView(std::unique_ptr<BView> view, const QRectF& place);

    int count() const { return static_cast<int>(pages_.size()); }
    /// Of a page, counted from 0, to a painter whose units are points.
    void draw(int page, QPainter& painter) const;

private:
    struct Text {
        QPointF base;
        QString text;
        Type type;
    };
    struct Rule {
        QRectF place;
        QColor color;
    };
    struct Picture {
        std::unique_ptr<BView> view;
        QRectF place;
    };
    struct Page {
        std::vector<Text> texts;
        std::vector<Rule> rules;
        std::vector<Picture> pictures;
    };

    void drawEdges(int page, QPainter& painter) const;

    QPageSize size_;
    QRectF paper_;
    QRectF area_;
    QString name_;
    QString day_;
    std::vector<Page> pages_; // at least one
    qreal y_;
};
