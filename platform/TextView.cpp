#include "platform/TextView.h"

#include <QPlainTextEdit>

BTextView::BTextView(BRect frame, const char* name, uint32 resizingMode, uint32 flags)
    : BView(frame, name, resizingMode, flags, new QPlainTextEdit)
{
    field().setTabChangesFocus(true);
    SetAccessibleName(name);
}

QPlainTextEdit& BTextView::field() const
{
    return *static_cast<QPlainTextEdit*>(widget());
}

const char* BTextView::Text() const
{
    return text_.of(field().toPlainText().toStdString());
}

void BTextView::SetText(const char* text)
{
    field().setPlainText(QString::fromUtf8(text));
    text_.set(text, field().toPlainText().toStdString());
}
