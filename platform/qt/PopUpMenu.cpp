#include "platform/PopUpMenu.h"

#include "platform/MenuItem.h"
#include "platform/Window.h"
#include "platform/qt/Labels.h"

#include <QMenu>
#include <QPointer>

BMenuItem* BPopUpMenu::Go(BPoint where) const
{
    // The window owns it, and may be closed while the menu is up; otherwise it goes here.
    const QPointer<QMenu> shown = new QMenu(BWindow::front());
    shown->setObjectName(QString::fromUtf8(Name()));
    // The menu of the kits stays as it is: this shows its labels once, and the number leads back.
    for (int32 i = 0; i < CountItems(); ++i)
        shown->addAction(labelText(ItemAt(i)->Label()))->setData(i);
    const QAction* chosen = shown->exec(QPoint(static_cast<int>(where.x), static_cast<int>(where.y)));
    // The items are the caller's and outlive the window that shows them.
    BMenuItem* item = chosen != nullptr ? ItemAt(chosen->data().toInt()) : nullptr;
    delete shown;
    return item;
}
