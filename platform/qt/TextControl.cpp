#include "platform/TextControl.h"

#include "platform/qt/CalendarPopup.h"
#include "platform/qt/Canvas.h"
#include "platform/qt/FieldText.h"
#include "platform/qt/Labels.h"
#include "platform/qt/TextField.h"

#include <QFont>
#include <QLabel>

#include <cmath>

namespace {

constexpr std::size_t kLongestShown = 4096; // bytes; no name is as long

Qt::Alignment toQt(alignment side)
{
    const Qt::Alignment level = side == B_ALIGN_LEFT    ? Qt::AlignLeft
                                : side == B_ALIGN_RIGHT ? Qt::AlignRight
                                                        : Qt::AlignHCenter;
    return level | Qt::AlignVCenter;
}

} // namespace

BTextControl::BTextControl(BRect frame, const char* name, const char* label, const char* text, BMessage* message)
    : BControl(frame, name, label, message, new QWidget, B_WILL_DRAW | B_FRAME_EVENTS),
      field_(new TextField(*this, *widget())), caption_(new QLabel(labelText(label), widget())),
      divider_(*Label() == '\0' ? 0 : std::floor(frame.Width() / 2)), text_(std::make_unique<FieldText>(kLongestShown))
{
    // The field is what the keyboard reaches, so the field bears the names.
    widget()->setObjectName({});
    widget()->setAccessibleName({});
    field_->setObjectName(QString::fromUtf8(Name()));
    field_->setAccessibleName(QString::fromUtf8(Label()));
    show(text);
    caption_->setBuddy(field_);
    layOut();
    // Enter sends the text in any case, changed or not; leaving the field sends it only when it was changed since it
    // was set or sent last. Qt reports Enter as both, in this order, and the second then finds nothing to send.
    QObject::connect(field_, &QLineEdit::returnPressed, [this] {
        TextFinished();
        committed_ = shown();
        Invoke();
    });
    QObject::connect(field_, &QLineEdit::editingFinished, [this] { commit(); });
    // Changes by hand only: a text that is set is nothing that a person typed.
    QObject::connect(field_, &QLineEdit::textEdited, [this] { TextModified(); });
}

BTextControl::~BTextControl() = default;

void BTextControl::AttachedToWindow()
{
    widget()->setFocusProxy(field_);
}

void BTextControl::layOut()
{
    constexpr int kGap = 4; // between label and field
    const int width = static_cast<int>(Bounds().Width());
    const int height = static_cast<int>(Bounds().Height());
    const int divider = static_cast<int>(divider_);
    // Label and field share the control's frame; a divider at 0 leaves it all to the field.
    caption_->setGeometry(0, 0, std::max(divider - kGap, 0), height);
    field_->setGeometry(divider, 0, width - divider, height);
}

void BTextControl::commit()
{
    if (committed_ == shown())
        return;
    TextFinished();
    // Before the message, which may put another text into the field.
    committed_ = shown();
    Invoke();
}

void BTextControl::SetCompletions(const std::function<std::vector<Completion>(const std::string&)>& find)
{
    field_->setCompletions(find, [this](const Completion& chosen) { complete(chosen); });
}

void BTextControl::complete(const Completion& chosen)
{
    show(chosen.text.c_str());
    if (chosen.take)
        chosen.take();
    // As after typing and Enter.
    TextModified();
    Invoke();
}

void BTextControl::SetCalendar(const std::function<CalendarDay()>& shown,
                               const std::function<void(const CalendarDay&)>& choose)
{
    field_->setCalendar([this, shown, choose] {
        field_->setFocus(Qt::OtherFocusReason);
        CalendarPopup::open(*field_, shown(), choose);
    });
}

const char* BTextControl::Text() const
{
    return text_->of(shown());
}

std::string BTextControl::shown() const
{
    return field_->text().toStdString();
}

void BTextControl::show(const char* text)
{
    field_->setText(QString::fromStdString(text_->take(text)));
    committed_ = shown();
    // What the field shows now and `text_` stand for the same bytes, and nothing waits to be sent.
    text_->noteShown(committed_);
}

void BTextControl::SetText(const char* text)
{
    show(text);
    // A long text shows its beginning.
    field_->setCursorPosition(0);
}

void BTextControl::SetDivider(float x)
{
    divider_ = x;
    layOut();
}

void BTextControl::SetFont(const BFont* font, uint32 mask)
{
    BControl::SetFont(font, mask);
    BFont used;
    GetFont(&used);
    caption_->setFont(used.toQt());
    field_->setFont(used.toQt());
}

void BTextControl::SetAlignment(alignment label, alignment text)
{
    caption_->setAlignment(toQt(label));
    field_->setAlignment(toQt(text));
}

void BTextControl::SetEditable(bool editable)
{
    // Such a field still takes the keyboard, so that its text can be copied. The colours are those of the label, which
    // nothing changes.
    field_->setReadOnly(!editable);
    QPalette colors = caption_->palette();
    if (!editable)
        colors.setColor(QPalette::Base, toQt(kReadOnlyField));
    field_->setPalette(colors);
}

bool BTextControl::IsEditable() const
{
    return !field_->isReadOnly();
}

void BTextControl::MarkAsInvalid(const char* reason)
{
    // From the label's colours again, so that a former mark leaves nothing behind. Without a reason there is no tool
    // tip, either.
    QPalette colors = caption_->palette();
    if (reason != nullptr)
        colors.setColor(QPalette::Base, toQt(kWrongField));
    field_->setPalette(colors);
    field_->setToolTip(QString::fromUtf8(reason));
}
