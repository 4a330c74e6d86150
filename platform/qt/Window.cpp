#include "platform/Window.h"

#include "platform/Message.h"
#include "platform/Messenger.h"
#include "platform/View.h"
#include "platform/qt/WindowWidget.h"

#include <QApplication>
#include <QLineEdit>
#include <QPlainTextEdit>
#include <QPoint>
#include <QSize>

#include <vector>

namespace {

/// The windows that are there, in the order of their opening.
std::vector<BWindow*>& windows()
{
    static std::vector<BWindow*> all;
    return all;
}

/// The view around a window's views, of the window's size.
class RootView final : public BView {
public:
    explicit RootView(BRect frame) : BView(frame, "", B_FOLLOW_ALL, 0) { SetViewColor(kPanelGrey); }
};

} // namespace

BWindow::BWindow(BRect frame, const char* title, window_type type, uint32 flags, uint32)
    : BLooper(title), frame_(frame), widget_(std::make_unique<WindowWidget>(*this)),
      root_(std::make_unique<RootView>(frame.OffsetToCopy(0, 0)))
{
    if (type == B_MODAL_WINDOW)
        widget_->makeModal(front());
    widget_->setWindowTitle(QString::fromUtf8(title));
    widget_->setResizable((flags & B_NOT_RESIZABLE) == 0);
    fit({static_cast<int>(frame.left), static_cast<int>(frame.top)});
    // Before there are views, so that each hears of the window when it is added.
    root_->setWindow(this);
    widget_->setWidget(root_->widget());
    windows().push_back(this);
}

BWindow::~BWindow()
{
    beginClosing();
    widget_->hide();
    // No dialog comes up before this window any more. Then the views go while the widget is there to be told.
    std::erase(windows(), this);
    widget_->takeWidget(); // the view owns it
    root_.reset();
}

void BWindow::AddChild(BView* view)
{
    root_->AddChild(view);
}

void BWindow::fitContent(const QSize& size)
{
    const auto width = static_cast<float>(size.width()), height = static_cast<float>(size.height());
    frame_.right = frame_.left + width;
    frame_.bottom = frame_.top + height;
    root_->ResizeTo(width, height);
}

BView* BWindow::FindView(const char* name) const
{
    return root_->FindView(name);
}

BView* BWindow::CurrentFocus() const
{
    const QWidget* focus = widget_->focusWidget();
    return focus != nullptr ? root_->viewAround(*focus) : nullptr;
}

void BWindow::AddShortcut(uint32 key, uint32 modifiers, BMessage* message, BHandler* target)
{
    // Kept by the shortcut, which lives as long as the window; `target` may go before.
    const std::shared_ptr<const BMessage> sent(message);
    const BMessenger messenger(target != nullptr ? target : this);
    const int pressed = key == B_F1_KEY ? static_cast<int>(Qt::Key_F1) : static_cast<int>(key);
    widget_->addShortcut(pressed, modifiers, [messenger, sent] { messenger.SendMessage(sent.get()); });
}

void BWindow::ForgetTyping()
{
    if (auto* field = qobject_cast<QLineEdit*>(widget_->focusWidget())) {
        const int cursor = field->cursorPosition();
        field->setText(field->text()); // which is what empties the field's own history
        field->setCursorPosition(cursor);
    }
    if (auto* field = qobject_cast<QPlainTextEdit*>(widget_->focusWidget())) {
        field->document()->clearUndoRedoStacks();
        field->document()->setModified(false);
    }
}

void BWindow::fit(QPoint place)
{
    widget_->fitTo(place, {static_cast<int>(frame_.Width()), static_cast<int>(frame_.Height())});
}

void BWindow::ResizeTo(float width, float height)
{
    root_->ResizeTo(width, height);
    frame_.right = frame_.left + width;
    frame_.bottom = frame_.top + height;
    fit(widget_->pos());
    FrameResized(width, height);
}

void BWindow::Show()
{
    widget_->giveWay();
    widget_->show();
}

void BWindow::Hide()
{
    widget_->hide();
}

void BWindow::MessageReceived(BMessage* message)
{
    if (message->what == B_QUIT_REQUESTED)
        askToClose();
    else
        BLooper::MessageReceived(message);
}

bool BWindow::askToClose()
{
    // Asked twice, as by two clicks: it closes already.
    if (isClosing())
        return true;
    if (!QuitRequested())
        return false;
    // No command begins from here on. Those whose messages wait find no lock.
    beginClosing();
    // The desktop's side is still at work on this very window.
    QMetaObject::invokeMethod(
        qApp,
        [self = token()] {
            if (auto* window = dynamic_cast<BWindow*>(BHandler::withToken(self)))
                window->Quit();
        },
        Qt::QueuedConnection);
    return true;
}

QWidget* BWindow::front()
{
    // Over a dialog that is open, where there is one.
    if (QWidget* active = QApplication::activeWindow())
        return active;
    BWindow* last = newest();
    return last != nullptr ? &last->widget() : nullptr;
}

BWindow* BWindow::newest()
{
    return windows().empty() ? nullptr : windows().back();
}

void BWindow::closeAll()
{
    // `Quit` destroys the window, which then takes itself out.
    while (!windows().empty())
        windows().back()->Quit();
}
