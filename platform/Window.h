#pragma once

#include "platform/Looper.h"
#include "platform/Rect.h"

#include <memory>

class BView;
class QPoint;
class QSize;
class QWidget;
class WindowWidget;

/// There is one workspace. While a modal window is open, the other ones answer to nothing that a person does; Escape
/// closes it as by hand.
enum window_type { B_TITLED_WINDOW, B_MODAL_WINDOW };

enum : uint32 { B_NOT_RESIZABLE = 2 };

constexpr uint32 B_CURRENT_WORKSPACE = 0;

/// A window on the desktop, and the looper of all that stands in it.
///
/// Owns its views. The window belongs to itself: `Quit` destroys it, closing it by hand does so when `QuitRequested`
/// agrees, and the application destroys those that are left. On a screen that has no room for its frame it is asked to
/// give way; what does not fit even then is scrolled. One that is resizable has its views follow instead.
class BWindow : public BLooper {
public:
    /// `frame` is in screen coordinates, without title bar and borders.
    BWindow(BRect frame, const char* title, window_type type, uint32 flags, uint32 workspaces = B_CURRENT_WORKSPACE);
    ~BWindow() override;

    BRect Bounds() const { return frame_.OffsetToCopy(0, 0); }

    /// Takes ownership of `view`.
    void AddChild(BView* view);
    BView* FindView(const char* name) const;
    /// The view that the keyboard goes to, null when there is none.
    BView* CurrentFocus() const;

    /// Has `message`, which it takes ownership of, sent to `target`, or to itself when that is null, when `key` (a
    /// capital letter, a digit or `B_F1_KEY`) is pressed with `modifiers`. Unlike in the kits, as by a click elsewhere,
    /// a field that is being typed in sends its text before. Ctrl+Q, which closes the window, is there from the start.
    void AddShortcut(uint32 key, uint32 modifiers, BMessage* message, BHandler* target = nullptr);

    /// The text in the field that has the keyboard counts as typed before: Ctrl+Z is the window's from here on. Until
    /// then, and as soon as more is typed, it takes back what was typed in the field. The kits leave it to the window.
    void ForgetTyping();

    void Show();
    void Hide();
    /// The views follow by their resizing modes.
    void ResizeTo(float width, float height);
    /// Hook: the screen has room for no more than `width` and `height`, less than the window has; to be followed by
    /// `ResizeTo` as far as its content can do with less. Before it shows, and again when its borders are known. The
    /// kits leave it to the program to ask for the screen.
    virtual void GiveWay(float /*width*/, float /*height*/) {}
    virtual void FrameResized(float /*width*/, float /*height*/) {}
    /// Hook: the window has come to the screen for the first time. What a person does not see yet can be made now. The
    /// kits have no such hook.
    virtual void Painted() {}
    /// Destroys the window, which has been made with `new`, and its views.
    virtual void Quit() { delete this; }
    /// `B_QUIT_REQUESTED` closes the window as by hand.
    void MessageReceived(BMessage* message) override;

    /// What Qt shows the window with. For the platform's own use.
    WindowWidget& widget() const { return *widget_; }
    /// Gives the content the size of the window, once there is some.
    void fitContent(const QSize& size);
    /// The window is asked to close, by the person or by a message. @return false to stay.
    bool askToClose();
    static void closeAll();
    /// The window that was opened last; null without any.
    static BWindow* newest();
    /// What a dialog comes up before: the window that has the keyboard, otherwise the one opened last; null without
    /// any.
    static QWidget* front();

private:
    void fit(QPoint place);

    BRect frame_;
    std::unique_ptr<WindowWidget> widget_;
    std::unique_ptr<BView> root_; // holds the views
};
