#include "platform/TextView.h"

#include "platform/qt/FieldText.h"
#include "platform/qt/Keys.h"

#include <QPlainTextEdit>

namespace {

constexpr std::size_t kLongestShown = 65536; // bytes: some twenty pages

class Note final : public QPlainTextEdit {
public:
    bool event(QEvent* event) override
    {
        return isForWindow(*event, document()->isModified(), document()->isRedoAvailable()) ||
               QPlainTextEdit::event(event);
    }
};

} // namespace

BTextView::BTextView(BRect frame, const char* name, uint32 resizingMode, uint32 flags)
    : BView(frame, name, resizingMode, flags, new Note), text_(std::make_unique<FieldText>(kLongestShown))
{
    field().setTabChangesFocus(true);
    SetAccessibleName(name);
}

BTextView::~BTextView() = default;

QPlainTextEdit& BTextView::field() const
{
    return *static_cast<QPlainTextEdit*>(widget());
}

const char* BTextView::Text() const
{
    return text_->of(field().toPlainText().toStdString());
}

void BTextView::SetText(const char* text)
{
    field().setPlainText(QString::fromStdString(text_->take(text)));
    text_->noteShown(field().toPlainText().toStdString());
}
