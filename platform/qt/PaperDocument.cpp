#include "platform/PaperDocument.h"

#include "platform/qt/PaperPages.h"
#include "platform/qt/PaperTableLayout.h"

#include <QBuffer>
#include <QLocale>
#include <QPainter>
#include <QPdfWriter>

#include <algorithm>

namespace {

constexpr qreal kPoint = PaperPages::kPoint;
constexpr PaperPages::Type kTitleType{19, true};
constexpr PaperPages::Type kPartType{14, true};
constexpr PaperPages::Type kSubtitleType{9, false, PaperPages::kFaint};
constexpr PaperPages::Type kTextType{7.6};
constexpr PaperPages::Type kPictureTitle{10, true};
constexpr PaperPages::Type kFactName{6.6, false, PaperPages::kFaint};
constexpr qreal kFactPoints = 10.5;
constexpr QColor kFactRule{60, 60, 60};

void addWrapped(PaperPages& pages, const std::string& text, const PaperPages::Type& type)
{
    constexpr int kMostLines = 40;
    for (const QString& line : type.lines(PaperPages::textOf(text), pages.area().width(), kMostLines)) {
        if (type.lineHeight() > pages.room())
            pages.beginPage();
        pages.addLine(pages.area().left(), pages.y(), line, type);
        pages.moveDown(type.lineHeight());
    }
}

PaperTable withoutEmptyColumns(const PaperTable& table)
{
    PaperTable kept{table.title, {}, std::vector<PaperRow>(table.rows.size()), table.note};
    for (std::size_t column = 0; column < table.columns.size(); ++column) {
        const auto isEmpty = [&](const PaperRow& row) { return row.cells[column].text.empty(); };
        if (std::ranges::all_of(table.rows, isEmpty))
            continue;
        kept.columns.push_back(table.columns[column]);
        for (std::size_t row = 0; row < table.rows.size(); ++row)
            kept.rows[row].cells.push_back(table.rows[row].cells[column]);
    }
    for (std::size_t row = 0; row < table.rows.size(); ++row) {
        kept.rows[row].isSum = table.rows[row].isSum;
        kept.rows[row].goesOn = table.rows[row].goesOn;
    }
    return kept;
}

} // namespace

PaperSize usualPaperSize()
{
    return QLocale::system().measurementSystem() == QLocale::ImperialUSSystem ? PaperSize::kLetter : PaperSize::kA4;
}

PaperDocument::PaperDocument(PaperSize size, const std::string& name, const std::string& day)
    : name_(name), pages_(std::make_unique<PaperPages>(size, name, day))
{}

PaperDocument::~PaperDocument() = default;

void PaperDocument::addTitle(const std::string& title, const std::string& subtitle)
{
    addWrapped(*pages_, title, kTitleType);
    addWrapped(*pages_, subtitle, kSubtitleType);
    pages_->moveDown(8 * kPoint);
}

void PaperDocument::addPart(const std::string& title, const std::string& subtitle)
{
    if (!pages_->isAtTop())
        pages_->beginPage();
    lastPart_ = pages_->count() - 1;
    addWrapped(*pages_, title, kPartType);
    addWrapped(*pages_, subtitle, kSubtitleType);
}

/// In rows of as many as have room beside each other.
void PaperDocument::addFacts(const std::vector<PaperFact>& facts)
{
    constexpr qreal kGap = 12 * kPoint, kPadding = 5 * kPoint;
    const QRectF& area = pages_->area();
    const PaperPages::Type plain{kFactPoints};
    qreal widest = 0;
    for (const PaperFact& fact : facts)
        widest = std::max(
            {widest, plain.width(PaperPages::textOf(fact.value.text)), kFactName.width(PaperPages::textOf(fact.name))});
    const int beside = std::clamp(static_cast<int>((area.width() + kGap) / (widest + kGap)), 1, 4);
    const qreal step = (area.width() + kGap) / beside;
    const qreal height = 2 * kPadding + kFactName.lineHeight() + plain.lineHeight();
    for (std::size_t i = 0; i < facts.size(); ++i) {
        const auto place = static_cast<int>(i) % beside;
        if (place == 0 && height > pages_->room())
            pages_->beginPage();
        if (place == 0)
            pages_->addRule(area.left(), area.right(), pages_->y(), 0.6, kFactRule);
        const qreal left = area.left() + place * step, top = pages_->y() + kPadding;
        const rgb_color& color = facts[i].value.color;
        pages_->addLine(left, top, PaperPages::textOf(facts[i].name), kFactName);
        pages_->addLine(left, top + kFactName.lineHeight(), PaperPages::textOf(facts[i].value.text),
                        {kFactPoints, false, QColor(color.red, color.green, color.blue)});
        if (place == beside - 1 || i + 1 == facts.size())
            pages_->moveDown(height);
    }
    pages_->addRule(area.left(), area.right(), pages_->y(), 0.6, kFactRule);
}

void PaperDocument::addText(const std::string& text)
{
    pages_->moveDown(5 * kPoint);
    addWrapped(*pages_, text, kTextType);
}

void PaperDocument::addTable(const PaperTable& table)
{
    const PaperTable kept = withoutEmptyColumns(table);
    if (!kept.columns.empty())
        PaperTableLayout(kept, *pages_).lay();
}

void PaperDocument::addPicture(const std::string& title, std::unique_ptr<BView> view)
{
    const QRectF& area = pages_->area();
    const BRect bounds = view->Bounds();
    const qreal height = area.width() * bounds.Height() / bounds.Width();
    const qreal above = 16 * kPoint, below = 4 * kPoint;
    if (!pages_->isAtTop() && above + kPictureTitle.lineHeight() + below + height > pages_->room())
        pages_->beginPage();
    pages_->moveDown(pages_->isAtTop() ? 0 : above);
    pages_->addLine(area.left(), pages_->y(), PaperPages::textOf(title), kPictureTitle);
    pages_->moveDown(kPictureTitle.lineHeight() + below);
    pages_->addView(std::move(view), {area.left(), pages_->y(), area.width(), height});
    pages_->moveDown(height);
}

int PaperDocument::CountPages() const
{
    return pages_->count();
}

std::string PaperDocument::pdf() const
{
    QBuffer bytes;
    bytes.open(QIODevice::WriteOnly);
    QPdfWriter writer(&bytes);
    constexpr int kResolution = 1200;
    writer.setResolution(kResolution);
    writer.setPageSize(pages_->size());
    writer.setPageMargins({});
    writer.setTitle(PaperPages::textOf(name_));
    writer.setCreator("Pelorin");
    QPainter painter(&writer);
    painter.scale(kResolution / 72.0, kResolution / 72.0);
    for (int page = 0; page < pages_->count(); ++page) {
        if (page > 0)
            writer.newPage();
        pages_->draw(page, painter);
    }
    painter.end();
    return bytes.data().toStdString();
}
