#include "platform/qt/Access.h"

#include "platform/qt/FieldButton.h"
#include "platform/qt/ViewWidget.h"
#include "platform/qt/WindowWidget.h"

#include <QAccessibleWidget>

namespace {

/// A view that draws itself is a chart when the keyboard reaches it, a text when it only has a name, and otherwise what
/// holds other things.
class ViewAccess final : public QAccessibleWidget {
public:
    using QAccessibleWidget::QAccessibleWidget;

    QAccessible::Role role() const override
    {
        if (widget()->isWindow())
            return QAccessible::Window;
        if (widget()->focusPolicy() != Qt::NoFocus)
            return QAccessible::Chart;
        return widget()->accessibleName().isEmpty() ? QAccessible::Client : QAccessible::StaticText;
    }
};

/// A button in a field, which can be pressed.
class ButtonAccess final : public QAccessibleWidget {
public:
    explicit ButtonAccess(FieldButton& button) : QAccessibleWidget(&button, QAccessible::Button), button_(button) {}

    QStringList actionNames() const override { return {pressAction()}; }
    void doAction(const QString& name) override
    {
        if (name == pressAction())
            button_.press();
    }

private:
    FieldButton& button_; // outlives this
};

QAccessibleInterface* accessTo(const QString&, QObject* object)
{
    if (auto* button = dynamic_cast<FieldButton*>(object))
        return new ButtonAccess(*button);
    const bool isOurs = dynamic_cast<ViewWidget*>(object) != nullptr || dynamic_cast<WindowWidget*>(object) != nullptr;
    return isOurs ? new ViewAccess(static_cast<QWidget*>(object)) : nullptr; // Qt owns it
}

} // namespace

void nameRoles()
{
    [[maybe_unused]] static const bool areNamed = (QAccessible::installFactory(accessTo), true);
}
