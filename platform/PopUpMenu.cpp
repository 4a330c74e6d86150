#include "platform/PopUpMenu.h"

#include "platform/Labels.h"
#include "platform/MenuItem.h"
#include "platform/Window.h"

#include <QMenu>

BMenuItem* BPopUpMenu::Go(BPoint where) const
{
    QMenu shown(BWindow::front());
    shown.setObjectName(QString::fromUtf8(Name()));
    for (int32 i = 0; i < CountItems(); ++i)
        shown.addAction(labelText(ItemAt(i)->Label()))->setData(i);
    const QAction* chosen = shown.exec(QPoint(static_cast<int>(where.x), static_cast<int>(where.y)));
    return chosen != nullptr ? ItemAt(chosen->data().toInt()) : nullptr;
}
