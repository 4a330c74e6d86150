#include "platform/SearchControl.h"

#include <QKeyEvent>
#include <QLineEdit>

/// Takes from the field the keys that leave it.
class BSearchControl::Keys final : public QObject {
public:
    explicit Keys(BSearchControl& control) : control_(control) {}

protected:
    bool eventFilter(QObject* receiver, QEvent* event) override
    {
        if (event->type() != QEvent::KeyPress)
            return false;
        const auto& key = static_cast<const QKeyEvent&>(*event);
        if ((key.modifiers() & ~Qt::KeypadModifier) != Qt::NoModifier)
            return false;
        if (key.key() == Qt::Key_Escape) {
            static_cast<QLineEdit*>(receiver)->clear();
            control_.TextModified();
        } else if (key.key() != Qt::Key_Return && key.key() != Qt::Key_Enter && key.key() != Qt::Key_Down) {
            return false;
        }
        if (control_.left_)
            control_.left_();
        return true;
    }

private:
    BSearchControl& control_;
};

BSearchControl::BSearchControl(BRect frame, const char* name, const char* label, const char* hint)
    : BTextControl(frame, name, label, "", nullptr), keys_(std::make_unique<Keys>(*this))
{
    auto* field = widget()->findChild<QLineEdit*>();
    field->setPlaceholderText(QString::fromUtf8(hint));
    field->setClearButtonEnabled(true);
    field->installEventFilter(keys_.get());
}

BSearchControl::~BSearchControl() = default;

void BSearchControl::SetHooks(std::function<void()> changed, std::function<void()> left)
{
    changed_ = std::move(changed);
    left_ = std::move(left);
}

void BSearchControl::TextModified()
{
    if (changed_)
        changed_();
}
