#include "chart/ChartPainter.h"
#include "platform/qt/WindowWidget.h"
#include "tests/gui/WindowFixture.h"
#include "views/Look.h"

#include <QAbstractButton>
#include <QAbstractItemView>
#include <QApplication>
#include <QLabel>
#include <QLineEdit>
#include <QPalette>
#include <QScrollArea>
#include <QScrollBar>
#include <QTabBar>

#include <algorithm>
#include <cmath>

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

TEST_F(ScreenTest, WhatADesktopSetsForAllProgramsDoesNotStay)
{
    const QFont font = QApplication::font();
    const QPalette colors = QApplication::palette();
    QApplication::setFont(QFont(font.family(), 14));
    QApplication::setPalette(QPalette(Qt::black));
    settle();
    EXPECT_EQ(QApplication::font().pixelSize(), font.pixelSize());
    EXPECT_EQ(QApplication::palette().color(QPalette::Base), colors.color(QPalette::Base));
    EXPECT_EQ(window().FindView("btnUndo")->widget()->font().pixelSize(), font.pixelSize());
}

/// How bright a colour is to the eye, as the guidelines for readable pages reckon it.
double luminance(rgb_color color)
{
    const auto linear = [](std::uint8_t component) {
        const double part = component / 255.0;
        return part <= 0.04045 ? part / 12.92 : std::pow((part + 0.055) / 1.055, 2.4);
    };
    return 0.2126 * linear(color.red) + 0.7152 * linear(color.green) + 0.0722 * linear(color.blue);
}

rgb_color colorOf(QPalette::ColorRole role, QPalette::ColorGroup group = QPalette::Active)
{
    const QColor color = QApplication::palette().color(group, role);
    // What shines through stands on white here.
    const auto over = [&](int c) { return static_cast<std::uint8_t>(255 - (255 - c) * color.alpha() / 255); };
    return {over(color.red()), over(color.green()), over(color.blue()), 255};
}

TEST(ColourTest, EveryTextIsReadableOnItsGround)
{
    const rgb_color white = {255, 255, 255, 255};
    const rgb_color panel = colorOf(QPalette::Window);
    const std::vector<rgb_color> rows = {colorOf(QPalette::Base), colorOf(QPalette::AlternateBase), kPaleSelection,
                                         look::kGenerated, look::kNew};
    const auto disabled = QPalette::Disabled;
    const struct {
        const char* what;
        std::vector<rgb_color> texts, grounds;
    } cases[] = {
        {"lists", {look::kText, look::kFaint, look::kWarning, look::kGain, look::kLoss}, rows},
        {"the selection", {colorOf(QPalette::HighlightedText)}, {colorOf(QPalette::Highlight)}},
        {"headings", {look::kText}, {look::kHeading}},
        {"pages", {look::kText, look::kFaint, look::kWarning, kBoxTitle, colorOf(QPalette::WindowText)}, {panel}},
        {"what is disabled",
         {colorOf(QPalette::WindowText, disabled), colorOf(QPalette::Text, disabled),
          colorOf(QPalette::ButtonText, disabled)},
         {panel, colorOf(QPalette::Button, disabled), colorOf(QPalette::Base)}},
        {"buttons", {colorOf(QPalette::ButtonText)}, {colorOf(QPalette::Button)}},
        {"fields",
         {colorOf(QPalette::Text), colorOf(QPalette::PlaceholderText)},
         {colorOf(QPalette::Base), kReadOnlyField, kWrongField}},
        {"calendars", {kWarningRed}, {colorOf(QPalette::Base)}},
        {"tool tips", {colorOf(QPalette::ToolTipText)}, {colorOf(QPalette::ToolTipBase)}},
        {"notices", {look::kText}, {look::kNotice, look::kGenerated}},
        {"charts",
         {ChartPainter::ink(white, ChartPainter::kTextInk), ChartPainter::ink(white, ChartPainter::kLabelInk)},
         {white}},
    };
    for (const auto& c : cases) {
        for (const rgb_color& text : c.texts) {
            for (const rgb_color& ground : c.grounds) {
                const auto [dark, light] = std::minmax({luminance(text), luminance(ground)});
                EXPECT_GE((light + 0.05) / (dark + 0.05), 4.5)
                    << c.what << ": " << +text.red << ' ' << +text.green << ' ' << +text.blue << " on " << +ground.red
                    << ' ' << +ground.green << ' ' << +ground.blue;
            }
        }
    }
}

} // namespace
