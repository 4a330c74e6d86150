#include "platform/qt/WindowWidget.h"
#include "tests/gui/WindowFixture.h"

#include <QAbstractButton>
#include <QAbstractItemView>
#include <QLabel>
#include <QLineEdit>
#include <QScrollArea>
#include <QScrollBar>
#include <QTabBar>

namespace {

/// The window in the room that a screen leaves it.
class ScreenTest : public WindowTest {
protected:
    /// What a person reads and works with on the page that is shown.
    std::vector<QWidget*> controls()
    {
        std::vector<QWidget*> found;
        for (QWidget* widget : window().widget().findChildren<QWidget*>()) {
            const bool isRead = qobject_cast<QLabel*>(widget) != nullptr || widget->inherits("QComboBox") ||
                                widget->objectName() == "MessageView" || widget->objectName().startsWith("grv");
            const bool isUsed = (widget->focusPolicy() & Qt::TabFocus) != 0 || qobject_cast<QAbstractButton*>(widget);
            // What is made up of others, or stands in a field of its own right, is not asked once more.
            const bool isPart = widget->inherits("QTabBar") || widget->parentWidget()->inherits("QTabBar") ||
                                qobject_cast<QLineEdit*>(widget->parentWidget()) != nullptr;
            if (widget->isVisible() && !isPart && (isRead || isUsed) && !widget->rect().isEmpty())
                found.push_back(widget);
        }
        return found;
    }

    static std::string nameOf(const QWidget& widget)
    {
        const auto* label = qobject_cast<const QLabel*>(&widget);
        return (label != nullptr ? label->text() : widget.objectName()).toStdString();
    }

    QRect placeOf(const QWidget& widget) { return {widget.mapTo(&window().widget(), QPoint(0, 0)), widget.size()}; }

    void expectInSight(QWidget& widget)
    {
        QSize whole = widget.size();
        for (QWidget* around = widget.parentWidget(); around != nullptr; around = around->parentWidget()) {
            auto* area = qobject_cast<QScrollArea*>(around);
            if (area == nullptr)
                continue;
            const QPoint place = widget.mapTo(area->widget(), QPoint(0, 0));
            area->horizontalScrollBar()->setValue(place.x());
            area->verticalScrollBar()->setValue(place.y());
            whole = whole.boundedTo(area->viewport()->size()); // a list may be wider than what is left
        }
        settle();
        // Whatever is in front of it, or ends before it, takes a part away.
        const QRect seen = widget.visibleRegion().boundingRect();
        EXPECT_TRUE(seen.size() == whole) << nameOf(widget) << " shows " << seen.width() << " x " << seen.height()
                                          << " of " << whole.width() << " x " << whole.height();
        const auto* button = qobject_cast<const QAbstractButton*>(&widget);
        const auto* label = qobject_cast<const QLabel*>(&widget);
        if (button != nullptr || label != nullptr) {
            const int text = widget.fontMetrics().horizontalAdvance(button ? button->text() : label->text());
            EXPECT_LE(text, widget.width()) << nameOf(widget);
        }
        if (const auto* rows = qobject_cast<const QAbstractItemView*>(&widget)) {
            EXPECT_GE(rows->viewport()->height(), 3 * 18) << nameOf(widget);
        }
        if (widget.objectName().startsWith("grv")) {
            EXPECT_GE(widget.height(), 90);
        }
    }
};

TEST_F(ScreenTest, EveryControlIsInSightOnEveryPage)
{
    constexpr float kBorder = 8, kTitle = 28; // of the window, on the screen
    const struct {
        float width, height;
        bool scrolls;
    } screens[] = {{1920, 1080, false}, {1366, 768, false}, {1280, 720, false},
                   {1024, 600, false},  {960, 540, true},   {683, 384, true}}; // the last two at twice the size
    dismissOffer();
    show(kPortoFolioPage);
    click("cbxComputeEvolution"); // its chart takes room
    dismissOffer();
    for (const auto& screen : screens) {
        SCOPED_TRACE(std::to_string(static_cast<int>(screen.width)));
        if (screen.height - kTitle < window().Bounds().Height())
            window().GiveWay(screen.width - kBorder, screen.height - kTitle);
        settle();
        EXPECT_LE(window().widget().width(), screen.width);
        EXPECT_LE(window().widget().height(), screen.height);
        const auto& tabs = *window().widget().findChild<QTabBar*>(); // it goes on behind the buttons
        const QRect firstButton = placeOf(*window().FindView("btnImportTable")->widget());
        EXPECT_FALSE(firstButton.intersects(tabs.tabRect(tabs.count() - 1)));
        bool scrolls = false;
        for (const Page page : {kCompanyPage, kCurrencyPage, kPortoFolioPage, kOperationPage, kParameterPage}) {
            SCOPED_TRACE(page);
            show(page);
            const std::vector<QWidget*> all = controls();
            ASSERT_GT(all.size(), 10U);
            for (QWidget* widget : all) {
                expectInSight(*widget);
                for (const QWidget* other : all) {
                    EXPECT_TRUE(other == widget || other->parentWidget() != widget->parentWidget() ||
                                !other->geometry().intersects(widget->geometry()))
                        << nameOf(*widget) << " and " << nameOf(*other);
                }
            }
            for (const auto* area : window().widget().findChildren<QScrollArea*>())
                scrolls = scrolls || (area->isVisible() && area->verticalScrollBar()->maximum() > 0);
        }
        EXPECT_EQ(scrolls, screen.scrolls);
    }
}

} // namespace
