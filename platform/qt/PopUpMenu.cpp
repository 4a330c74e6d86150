#include "platform/PopUpMenu.h"

#include "platform/MenuItem.h"
#include "platform/Window.h"
#include "platform/qt/Labels.h"

#include <QMenu>
#include <QPointer>

#include <algorithm>

namespace {

/// The menu of the kits stays as it is: this shows its items once, and the numbers lead back. The window owns it, and
/// may be closed while it is up.
QMenu* shownMenu(const BMenu& menu)
{
    auto* shown = new QMenu(BWindow::front());
    shown->setObjectName(QString::fromUtf8(menu.Name()));
    for (int32 i = 0; i < menu.CountItems(); ++i) {
        const BMenuItem& item = *menu.ItemAt(i);
        if (dynamic_cast<const BSeparatorItem*>(&item) != nullptr) {
            shown->addSeparator();
            continue;
        }
        QAction* action = shown->addAction(labelText(item.Label()));
        action->setData(i);
        action->setEnabled(item.IsEnabled());
    }
    return shown;
}

QPoint placeOf(BPoint where)
{
    return {static_cast<int>(where.x), static_cast<int>(where.y)};
}

} // namespace

BMenuItem* BPopUpMenu::Go(BPoint where) const
{
    const QPointer<QMenu> shown = shownMenu(*this);
    const QAction* chosen = shown->exec(placeOf(where));
    // The items are the caller's and outlive the window that shows them.
    BMenuItem* item = chosen != nullptr ? ItemAt(chosen->data().toInt()) : nullptr;
    delete shown;
    return item;
}

void BPopUpMenu::Open(BPoint where) const
{
    QMenu* shown = shownMenu(*this);
    shown->setAttribute(Qt::WA_DeleteOnClose);
    QAction* first = nullptr;
    for (QAction* action : shown->actions()) {
        if (action->isSeparator() || !action->isEnabled())
            continue;
        first = first != nullptr ? first : action;
        const BMenuItem& item = *ItemAt(action->data().toInt());
        if (item.Message() != nullptr)
            QObject::connect(action, &QAction::triggered,
                             [to = item.Messenger(), message = *item.Message()] { to.SendMessage(&message); });
    }
    QPoint place = placeOf(where);
    // It stays before the window where it can.
    if (const QWidget* window = shown->parentWidget())
        place.rx() -= std::clamp(place.x() + shown->sizeHint().width() - window->geometry().right() - 1, 0,
                                 std::max(place.x() - window->geometry().left(), 0));
    shown->popup(place);
    shown->setActiveAction(first);
}
