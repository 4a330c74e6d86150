#include "platform/TabView.h"

#include "platform/qt/Labels.h"

#include <QScrollArea>
#include <QShortcut>
#include <QTabBar>
#include <QTabWidget>
#include <QVBoxLayout>

#include <utility>

BTabView::BTabView(BRect frame, const char* name, button_width, uint32 resizingMode, uint32 flags)
    : BView(frame, name, resizingMode, flags, new QTabWidget)
{
    tabWidget().setDocumentMode(true);
    tabWidget().setFocusPolicy(Qt::NoFocus); // the bar has the keyboard, see below
    tabWidget().tabBar()->setObjectName(QString::fromUtf8(Name()) + "Bar");
    tabWidget().tabBar()->setAccessibleName(QString::fromUtf8(Name()));
    tabWidget().tabBar()->setExpanding(false);
    tabWidget().tabBar()->setFocusPolicy(Qt::TabFocus);
    // From the last tab on to the first, and back.
    const auto step = [this](const QKeySequence& keys, int direction) {
        auto* shortcut = new QShortcut(keys, widget()); // the widget owns it
        QObject::connect(shortcut, &QShortcut::activated, [this, direction] {
            if (CountTabs() > 0)
                Select((Selection() + direction + CountTabs()) % CountTabs());
        });
    };
    step(QKeySequence(Qt::CTRL | Qt::Key_PageDown), 1);
    step(QKeySequence(Qt::CTRL | Qt::Key_PageUp), -1);
}

BTabView::~BTabView()
{
    // The pages of the tab widget are the parents of the views' widgets and die with it, so the views go before.
    while (CountChildren() > 0)
        delete ChildAt(CountChildren() - 1);
}

QTabWidget& BTabView::tabWidget() const
{
    return *static_cast<QTabWidget*>(widget());
}

void BTabView::AddTab(BView* target, BTab* tab)
{
    tabs_.emplace_back(tab);
    const int index = tabWidget().addTab(new QWidget, labelText(tab->Label()));
    tabWidget().setTabToolTip(index, QString::fromUtf8(tab->ToolTip()));
    if (target != nullptr)
        FillTab(index, target);
}

void BTabView::FillTab(int32 index, BView* target)
{
    TabAt(index)->SetView(target);
    // `AddChild` puts the view into that page. The others keep what they have.
    host_ = tabWidget().widget(index);
    AddChild(target);
    if (areScrolled_)
        scroll(*target);
    putFirst();
}

void BTabView::putFirst()
{
    QWidget* last = tabWidget().tabBar();
    QWidgetList beside;
    for (QWidget* next = last->nextInFocusChain(); next != tabWidget().tabBar(); next = next->nextInFocusChain()) {
        if (next->focusPolicy() == Qt::NoFocus)
            continue;
        if (tabWidget().isAncestorOf(next))
            last = next;
        else
            beside.append(next);
    }
    for (QWidget* widget : beside) {
        QWidget::setTabOrder(last, widget);
        last = widget;
    }
}

BTab* BTabView::TabAt(int32 index) const
{
    return index >= 0 && index < CountTabs() ? tabs_[static_cast<std::size_t>(index)].get() : nullptr;
}

void BTabView::Select(int32 index)
{
    tabWidget().setCurrentIndex(index);
}

void BTabView::SetSelectionHook(const std::function<void()>& hook)
{
    QObject::connect(&tabWidget(), &QTabWidget::currentChanged, widget(), [hook] { hook(); });
}

void BTabView::ScrollTabs()
{
    if (std::exchange(areScrolled_, true))
        return;
    for (const auto& tab : tabs_) {
        if (tab->View() != nullptr)
            scroll(*tab->View());
    }
}

void BTabView::scroll(BView& view)
{
    auto* area = new QScrollArea;
    area->setFrameShape(QFrame::NoFrame);
    area->setFocusPolicy(Qt::NoFocus); // what is in it has the keyboard, and is scrolled into sight
    auto* room = new QVBoxLayout(view.widget()->parentWidget()); // which owns both
    room->setContentsMargins(0, 0, 0, 0);
    room->addWidget(area);
    area->setWidget(view.widget());
    view.widget()->show();
}

float BTabView::TabHeight() const
{
    return static_cast<float>(tabWidget().tabBar()->sizeHint().height());
}

int32 BTabView::Selection() const
{
    return tabWidget().currentIndex();
}
