#include "platform/qt/PaperPages.h"

#include "platform/qt/Canvas.h"

#include <QFontMetricsF>
#include <QPainter>
#include <QTextLayout>

namespace {

constexpr qreal kSide = 45 * PaperPages::kPoint; // margins
constexpr qreal kTop = 58 * PaperPages::kPoint;
constexpr qreal kBottom = 54 * PaperPages::kPoint;
constexpr PaperPages::Type kEdgeType{7, false, PaperPages::kFaint};
constexpr QColor kEdgeRule{170, 170, 170};

} // namespace

QFont PaperPages::Type::font() const
{
    // By name: a document looks the same from every desktop, and from none.
    QFont font("DejaVu Sans");
    font.setStyleHint(QFont::SansSerif);
    font.setPixelSize(qRound(points * kPoint));
    font.setBold(isBold);
    font.setHintingPreference(QFont::PreferNoHinting);
    // Too little to be seen, and the letters stay apart: "fi" as one sign is not found by who searches for it.
    constexpr qreal kApart = 0.05;
    font.setLetterSpacing(QFont::AbsoluteSpacing, kApart);
    return font;
}

qreal PaperPages::Type::width(const QString& text) const
{
    return QFontMetricsF(font()).horizontalAdvance(text);
}

QStringList PaperPages::Type::lines(const QString& text, qreal width, int most) const
{
    const QFontMetricsF metrics(font());
    if (metrics.horizontalAdvance(text) <= width)
        return {text};
    QTextLayout layout(text, font());
    QTextOption option;
    option.setWrapMode(QTextOption::WrapAtWordBoundaryOrAnywhere);
    layout.setTextOption(option);
    layout.beginLayout();
    QStringList lines;
    for (QTextLine line = layout.createLine(); line.isValid() && lines.size() < most; line = layout.createLine()) {
        line.setLineWidth(width);
        if (lines.size() + 1 == most)
            lines << metrics.elidedText(text.mid(line.textStart()), Qt::ElideRight, width);
        else
            lines << text.mid(line.textStart(), line.textLength()).trimmed();
    }
    layout.endLayout();
    return lines;
}

QString PaperPages::textOf(const std::string& text)
{
    QString line = QString::fromStdString(text);
    for (QChar& c : line)
        if (c.category() == QChar::Other_Control || c == QChar::LineSeparator || c == QChar::ParagraphSeparator)
            c = ' ';
    return line;
}

PaperPages::PaperPages(PaperSize size, const std::string& name, const std::string& day)
    : size_(size == PaperSize::kA4 ? QPageSize::A4 : QPageSize::Letter),
      paper_(QPointF(), size_.size(QPageSize::Point) * kPoint),
      area_(paper_.marginsRemoved(QMarginsF(kSide, kTop, kSide, kBottom))), name_(textOf(name)), day_(textOf(day)),
      pages_(1), y_(area_.top())
{}

void PaperPages::beginPage()
{
    pages_.emplace_back();
    y_ = area_.top();
}

void PaperPages::addText(QPointF base, const QString& text, const Type& type)
{
    if (!text.isEmpty())
        pages_.back().texts.push_back({base, text, type});
}

void PaperPages::addLine(qreal x, qreal top, const QString& text, const Type& type, alignment align)
{
    const QFontMetricsF metrics(type.font());
    const qreal lead = (type.lineHeight() - metrics.height()) / 2;
    const qreal width = align == B_ALIGN_LEFT ? 0 : metrics.horizontalAdvance(text);
    addText({x - (align == B_ALIGN_CENTER ? width / 2 : width), top + lead + metrics.ascent()}, text, type);
}

void PaperPages::addRule(qreal left, qreal right, qreal y, qreal points, const QColor& color)
{
    const qreal height = points * kPoint;
    pages_.back().rules.push_back({QRectF(left, y - height / 2, right - left, height), color});
}

void PaperPages::addView(std::unique_ptr<BView> view, const QRectF& place)
{
    pages_.back().pictures.push_back({std::move(view), place});
}

void PaperPages::draw(int page, QPainter& painter) const
{
    const Page& shown = pages_[static_cast<std::size_t>(page)];
    painter.save();
    painter.scale(1 / kPoint, 1 / kPoint);
    painter.setRenderHints(QPainter::Antialiasing | QPainter::TextAntialiasing);
    for (const Picture& picture : shown.pictures) {
        painter.save();
        painter.translate(picture.place.topLeft());
        const qreal scale = picture.place.width() / picture.view->Bounds().Width();
        painter.scale(scale, scale);
        picture.view->canvas().print(painter, [&] { picture.view->Draw(picture.view->Bounds()); });
        painter.restore();
    }
    for (const Rule& rule : shown.rules)
        painter.fillRect(rule.place, rule.color);
    for (const Text& text : shown.texts) {
        painter.setFont(text.type.font());
        painter.setPen(text.type.color);
        painter.drawText(text.base, text.text);
    }
    drawEdges(page, painter);
    painter.restore();
}

void PaperPages::drawEdges(int page, QPainter& painter) const
{
    const QFont font = kEdgeType.font();
    const QFontMetricsF metrics(font);
    painter.setFont(font);
    painter.setPen(kEdgeType.color);
    const QString number = QString("%1 of %2").arg(page + 1).arg(count());
    const auto drawRight = [&](const QString& text, qreal base) {
        painter.drawText(QPointF(area_.right() - metrics.horizontalAdvance(text), base), text);
    };
    const qreal top = area_.top() - 20 * kPoint, bottom = area_.bottom() + 22 * kPoint;
    const qreal room = area_.width() - metrics.horizontalAdvance(day_) - metrics.averageCharWidth() * 4;
    painter.drawText(QPointF(area_.left(), top), metrics.elidedText(name_, Qt::ElideRight, room));
    drawRight(day_, top);
    painter.fillRect(QRectF(area_.left(), top + 5 * kPoint, area_.width(), kPoint / 4), kEdgeRule);
    painter.drawText(QPointF(area_.left(), bottom), "Pelorin");
    drawRight(number, bottom);
}
