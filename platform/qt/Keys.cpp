#include "platform/qt/Keys.h"

#include "platform/InterfaceDefs.h"

#include <QGuiApplication>
#include <QKeyEvent>

uint32 modifiers()
{
    const Qt::KeyboardModifiers held = QGuiApplication::keyboardModifiers();
    uint32 keys = held.testFlag(Qt::ShiftModifier) ? B_SHIFT_KEY : 0U;
    keys |= held.testFlag(Qt::AltModifier) ? B_COMMAND_KEY : 0U;
    keys |= held.testFlag(Qt::ControlModifier) ? B_CONTROL_KEY : 0U;
    return keys;
}

std::string keyBytes(const QKeyEvent& event)
{
    static const struct {
        int key;
        char byte;
    } kControls[] = {
        {Qt::Key_Left, B_LEFT_ARROW}, {Qt::Key_Right, B_RIGHT_ARROW},  {Qt::Key_Up, B_UP_ARROW},
        {Qt::Key_Down, B_DOWN_ARROW}, {Qt::Key_Home, B_HOME},          {Qt::Key_End, B_END},
        {Qt::Key_PageUp, B_PAGE_UP},  {Qt::Key_PageDown, B_PAGE_DOWN},
    };
    for (const auto& control : kControls) {
        if (event.key() == control.key)
            return {control.byte};
    }
    // Keys like Shift alone have no text, and so give nothing.
    return event.text().toStdString();
}

bool isForWindow(QEvent& event, bool isModified, bool hasRedo)
{
    if (event.type() != QEvent::ShortcutOverride)
        return false;
    const auto& key = static_cast<const QKeyEvent&>(event);
    const bool isFree =
        (key.matches(QKeySequence::Undo) && !isModified) || (key.matches(QKeySequence::Redo) && !hasRedo);
    if (isFree)
        event.ignore();
    return isFree;
}
