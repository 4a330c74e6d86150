#include "platform/Label.h"

#include "platform/qt/Labels.h"

#include <QLabel>

BLabel::BLabel(BRect frame, const char* text, const BView& labelled)
    : BView(frame, "", B_FOLLOW_LEFT | B_FOLLOW_TOP, B_WILL_DRAW, new QLabel(labelText(text)))
{
    auto* label = static_cast<QLabel*>(widget());
    label->setAlignment(Qt::AlignRight | Qt::AlignVCenter);
    label->setBuddy(labelled.widget());
}
