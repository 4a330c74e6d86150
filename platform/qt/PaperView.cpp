#include "platform/PaperView.h"

#include "platform/PaperDocument.h"
#include "platform/qt/PaperPages.h"

#include <QPaintEvent>
#include <QPainter>
#include <QPointer>
#include <QPrintDialog>
#include <QPrinter>
#include <QPrinterInfo>
#include <QScrollArea>
#include <QScrollBar>

#include <algorithm>

namespace {

constexpr int kGap = 12; // around each page, in pixels

/// All pages below each other.
class Sheets final : public QWidget {
public:
    std::unique_ptr<PaperDocument> document;

    void fit(int width)
    {
        if (document == nullptr)
            return;
        const QSizeF size = document->pages().size().size(QPageSize::Point);
        scale_ = std::max(1, width - 2 * kGap) / size.width();
        page_ = (size * scale_).toSize();
        resize(width, topOf(document->CountPages()));
        update();
    }
    int topOf(int page) const { return kGap + page * (page_.height() + kGap); }

protected:
    void paintEvent(QPaintEvent* event) override
    {
        QPainter painter(this);
        for (int page = 0; document != nullptr && page < document->CountPages(); ++page) {
            const QRect place(QPoint(kGap, topOf(page)), page_);
            if (!place.adjusted(-1, -1, 1, 1).intersects(event->rect()))
                continue;
            painter.fillRect(place.adjusted(-1, -1, 1, 1), QColor(150, 150, 150));
            painter.fillRect(place, Qt::white);
            painter.save();
            painter.translate(place.topLeft());
            painter.scale(scale_, scale_);
            document->pages().draw(page, painter);
            painter.restore();
        }
    }

private:
    qreal scale_ = 1; // pixels of a point
    QSize page_;
};

class Desk final : public QScrollArea {
public:
    Desk()
    {
        setWidget(new Sheets); // which it owns
        setFocusPolicy(Qt::StrongFocus);
        // Whether it is there would change the width of the pages, and with that whether it is needed.
        setVerticalScrollBarPolicy(Qt::ScrollBarAlwaysOn);
        setHorizontalScrollBarPolicy(Qt::ScrollBarAlwaysOff);
    }

    Sheets& sheets() const { return *static_cast<Sheets*>(widget()); }
    void fit() { sheets().fit(viewport()->width()); }

protected:
    void resizeEvent(QResizeEvent* event) override
    {
        QScrollArea::resizeEvent(event);
        fit();
    }
};

Desk& deskOf(const BView& view)
{
    return *static_cast<Desk*>(view.widget());
}

/// Puts the pages that were asked for on paper. Where that has another size, they are made smaller, never cut.
bool printPages(const PaperPages& pages, QPrinter& printer)
{
    QPainter painter;
    if (!painter.begin(&printer))
        return false;
    const QSizeF size = pages.size().size(QPageSize::Point);
    const QSizeF paper = printer.pageLayout().fullRectPoints().size();
    const qreal fit = std::min({1.0, paper.width() / size.width(), paper.height() / size.height()});
    const int last = printer.toPage() > 0 ? std::min(printer.toPage(), pages.count()) : pages.count();
    const int first = std::max(printer.fromPage(), 1);
    for (int page = first; page <= last; ++page) {
        if (page > first && !printer.newPage())
            return false;
        painter.save();
        painter.scale(printer.resolution() / 72.0 * fit, printer.resolution() / 72.0 * fit);
        pages.draw(page - 1, painter);
        painter.restore();
    }
    return painter.end() && printer.printerState() != QPrinter::Error;
}

} // namespace

PaperView::PaperView(BRect frame, const char* name, uint32 resizingMode)
    : BView(frame, name, resizingMode, B_WILL_DRAW | B_NAVIGABLE, new Desk)
{
    SetAccessibleName("Preview");
}

void PaperView::SetDocument(std::unique_ptr<PaperDocument> document)
{
    Desk& desk = deskOf(*this);
    desk.sheets().document = std::move(document);
    desk.setAccessibleDescription(QString("%1 pages").arg(Document()->CountPages()));
    desk.fit();
}

void PaperView::ShowPage(int page)
{
    const Desk& desk = deskOf(*this);
    desk.verticalScrollBar()->setValue(desk.sheets().topOf(page) - kGap);
}

const PaperDocument* PaperView::Document() const
{
    return deskOf(*this).sheets().document.get();
}

PaperView::Outcome PaperView::Print()
{
    if (QPrinterInfo::availablePrinterNames().isEmpty())
        return Outcome::kNoPrinter;
    const PaperPages& pages = Document()->pages();
    QPrinter printer(QPrinter::HighResolution);
    printer.setDocName(pages.name());
    printer.setPageSize(pages.size());
    printer.setFullPage(true); // the pages have their own margins
    // While the dialog waits, the window may close and take it along.
    const QPointer<QPrintDialog> dialog = new QPrintDialog(&printer, &deskOf(*this));
    dialog->setMinMax(1, pages.count());
    dialog->setOption(QAbstractPrintDialog::PrintPageRange);
    // It would write over a file part by part. `pdf` is what a file is made of.
    dialog->setOption(QAbstractPrintDialog::PrintToFile, false);
    const bool isAccepted = dialog->exec() == QDialog::Accepted;
    if (dialog == nullptr)
        return Outcome::kLeft;
    delete dialog;
    if (!isAccepted)
        return Outcome::kLeft;
    return printPages(pages, printer) ? Outcome::kPrinted : Outcome::kFailed;
}
