#include "platform/MenuField.h"

#include "platform/Menu.h"
#include "platform/MenuItem.h"
#include "platform/ShortText.h"
#include "platform/Window.h"
#include "platform/qt/Labels.h"

#include <QComboBox>
#include <QLabel>
#include <QSignalBlocker>

#include <algorithm>
#include <cmath>

BMenuField::BMenuField(BRect frame, const char* name, const char* label, BMenu* menu)
    : BView(frame, name, B_FOLLOW_LEFT | B_FOLLOW_TOP, B_WILL_DRAW | B_FRAME_EVENTS, new QWidget), menu_(menu),
      field_(new QComboBox(widget())), caption_(new QLabel(labelText(label), widget())),
      divider_(*label == '\0' ? 0 : std::floor(frame.Width() / 2))
{
    // The menu is what the keyboard reaches, so the menu bears the name.
    widget()->setObjectName({});
    field_->setObjectName(QString::fromUtf8(Name()));
    field_->setAccessibleName(QString::fromUtf8(label));
    caption_->setBuddy(field_);
    widget()->setFocusProxy(field_);
    layOut();
    // From here on the field follows the menu, whoever changes it.
    fill();
    menu_->setObserver([this] { fill(); });
    QObject::connect(field_, &QComboBox::activated, [this](int index) { choose(index); });
}

BMenuField::~BMenuField() = default;

void BMenuField::layOut()
{
    constexpr int kGap = 6; // between label and menu
    const int width = static_cast<int>(Bounds().Width());
    const int height = static_cast<int>(Bounds().Height());
    const int divider = static_cast<int>(divider_);
    caption_->setGeometry(0, 0, std::max(divider - kGap, 0), height);
    field_->setGeometry(divider, 0, width - divider, height);
}

void BMenuField::fill()
{
    constexpr std::size_t kLongestShown = 256; // bytes; the items keep their whole labels
    // What a program does to the menu is no choice of a person.
    const QSignalBlocker silence(field_);
    QStringList labels;
    for (int32 i = 0; i < menu_->CountItems(); ++i)
        labels.append(QString::fromStdString(shortened(menu_->ItemAt(i)->Label(), kLongestShown)));
    // A field that is filled anew closes its list and loses its place in it, so this is done only when the labels have
    // changed. A mark alone only moves the current index.
    bool same = field_->count() == labels.size();
    for (int i = 0; same && i < field_->count(); ++i)
        same = field_->itemText(i) == labels[i];
    if (!same) {
        field_->clear();
        field_->addItems(labels);
    }
    // Nothing marked gives -1, and the field is then blank.
    field_->setCurrentIndex(menu_->IndexOf(menu_->FindMarked()));
}

void BMenuField::choose(int index)
{
    BMenuItem* item = menu_->ItemAt(index);
    if (item == nullptr)
        return;
    // Marked first: what the message sets off reads the mark.
    item->SetMarked(true);
    // Items that came after the field was put into its window have no target yet.
    if (!item->HasTarget())
        item->SetTarget(Window());
    item->Invoke();
}

void BMenuField::SetDivider(float x)
{
    divider_ = x;
    layOut();
}

void BMenuField::SetAlignment(alignment label)
{
    caption_->setAlignment(label == B_ALIGN_RIGHT  ? Qt::AlignRight | Qt::AlignVCenter
                           : label == B_ALIGN_LEFT ? Qt::AlignLeft | Qt::AlignVCenter
                                                   : Qt::AlignCenter);
}

void BMenuField::AttachedToWindow()
{
    for (int32 i = 0; i < menu_->CountItems(); ++i) {
        if (!menu_->ItemAt(i)->HasTarget())
            menu_->ItemAt(i)->SetTarget(Window());
    }
}
