#include "platform/qt/HeldKey.h"

#include <QCoreApplication>
#include <QKeyEvent>

HeldKey::HeldKey()
{
    // On the application, so that it sees every key before its receiver does.
    QCoreApplication::instance()->installEventFilter(this);
}

HeldKey& HeldKey::instance()
{
    static HeldKey watcher; // the application object outlives all windows, and is never destroyed
    return watcher;
}

bool HeldKey::eventFilter(QObject*, QEvent* event)
{
    // What a shortcut takes is seen as an override, and not as a press.
    if (event->type() == QEvent::KeyRelease)
        released_ = static_cast<QKeyEvent*>(event)->timestamp();
    if (event->type() == QEvent::ShortcutOverride) {
        const auto* key = static_cast<QKeyEvent*>(event);
        isRepeating_ = key->isAutoRepeat() || (released_ != 0 && key->timestamp() == released_);
    }
    // Only watched: the receiver gets all events.
    return false;
}
