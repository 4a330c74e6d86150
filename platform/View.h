#pragma once

#include "platform/Font.h"
#include "platform/GraphicsDefs.h"
#include "platform/Handler.h"
#include "platform/InterfaceDefs.h"
#include "platform/Rect.h"

#include <memory>
#include <string>
#include <vector>

class BWindow;
class Canvas;
class QPainter;
class QPixmap;
class QWidget;

/// What a view draws with.
struct DrawingState {
    rgb_color high{0, 0, 0, 255};
    rgb_color low{255, 255, 255, 255};
    rgb_color view{255, 255, 255, 255}; // the ground
    float penSize = 1;
    drawing_mode mode = B_OP_COPY;
    BFont font;
};

/// A rectangular part of a window that draws itself and answers to mouse and keyboard.
///
/// What a view draws goes into a picture of its own, so drawing is allowed at any time and stays until the next `Draw`;
/// `Sync` puts it on the screen at once. Two kinds of views have none, and only what `Draw` draws shows: those of the
/// colour `B_TRANSPARENT_COLOR`, whose `Draw` is called whenever they are looked at, and those without `B_WILL_DRAW`,
/// which are their ground and nothing else. Coordinates are the view's own: (0, 0) is its left top corner.
///
/// Owns its children, and the widget that shows it. A view that stands in a window or in another view is owned by that.
class BView : public BHandler {
public:
    /// `frame` is in the coordinates of the parent to come. `name` is what tests and assistive tools find it by:
    /// the widget that has the keyboard bears it as object name, and what `SetAccessibleName` sets beside it.
    BView(BRect frame, const char* name, uint32 resizingMode, uint32 flags);
    ~BView() override;

    // The tree of views.
    /// Takes ownership of `child`, which belongs to no other parent.
    void AddChild(BView* child);
    /// @return null out of range.
    BView* ChildAt(int32 index) const;
    int32 CountChildren() const { return static_cast<int32>(children_.size()); }
    /// Null at the top.
    BView* Parent() const { return parent_; }
    /// The window the view stands in, null while it stands in none.
    BWindow* Window() const { return window_; }
    BLooper* Looper() const override;
    /// This view or the first one within it of that name; null when there is none.
    BView* FindView(const char* name);

    // Place and size.
    BRect Bounds() const { return frame_.OffsetToCopy(0, 0); }
    /// Where it stands in its parent.
    BRect Frame() const { return frame_; }
    BPoint ConvertToScreen(BPoint where) const;
    void MoveTo(float x, float y);
    /// The children follow by their resizing modes.
    void ResizeTo(float width, float height);
    void Hide();
    void Show();
    /// Whether it was hidden itself; what it stands in may be hidden, too. In the kits both count.
    bool IsHidden() const { return hidden_; }

    // Keyboard focus and what assistive tools say.
    bool IsFocus() const;
    /// Gives the view the keyboard, as the Tab key does.
    void MakeFocus();
    void SetAccessibleName(const char* text);
    void SetToolTip(const char* text);
    /// Whether the pointer shows that something can be moved to the left and to the right here.
    void SetMovesSideways(bool movesSideways);

    // Hooks.
    virtual void AttachedToWindow() {}
    virtual void Draw(BRect /*updateRect*/) {}
    /// Draws on the screen, over the picture and not into it: for what comes and goes. `RefreshOver` has it called. The
    /// kits have neither.
    virtual void DrawOver(BRect /*updateRect*/) {}
    virtual void FrameResized(float /*width*/, float /*height*/) {}
    /// Also while no button is held. `inside` is false once, when the pointer has left. Nothing is dragged and dropped.
    virtual void MouseMoved(BPoint /*where*/, bool /*inside*/) {}
    /// The left button was pressed. The views around this one are not told.
    virtual void MouseDown(BPoint /*where*/) {}
    /// The second press of a double click. The kits tell the number of clicks with the message.
    virtual void DoubleClicked(BPoint where) { MouseDown(where); }
    /// The left button was released, which was pressed in this view; that may be outside of it by now, as `MouseMoved`
    /// has told.
    virtual void MouseUp(BPoint /*where*/) {}
    /// The wheel was turned by so many notches: downwards, and to the right, when above 0; fine ones turn by parts of
    /// one. @return whether that was of use; otherwise the view around this one is asked. The kits have no such hook
    /// but a message.
    virtual bool WheelTurned(BPoint /*where*/, float /*right*/, float /*down*/) { return false; }
    /// `bytes` is the UTF-8 text of the key, or one of the control characters of InterfaceDefs.h.
    virtual void KeyDown(const char* /*bytes*/, int32 /*numBytes*/) {}
    /// The right mouse button was pressed, or the key for menus. The kits have no such hook.
    virtual void MenuRequested(BPoint /*where*/) {}

    // Drawing state.
    void SetViewColor(rgb_color color);
    void SetHighColor(rgb_color color) { state_.high = color; }
    rgb_color HighColor() const { return state_.high; }
    void SetLowColor(rgb_color color) { state_.low = color; }
    void SetPenSize(float size) { state_.penSize = size; }
    void SetDrawingMode(drawing_mode mode) { state_.mode = mode; }
    virtual void SetFont(const BFont* font, uint32 mask = B_FONT_ALL);
    void SetFontSize(float size);
    void GetFont(BFont* font) const { *font = state_.font; }
    float StringWidth(const char* text) const { return state_.font.StringWidth(text); }

    // Drawing. Upright and level lines are sharp, others smooth, on screens of any resolution.
    void FillRect(BRect rect, pattern p = B_SOLID_HIGH);
    void StrokeRect(BRect rect, pattern p = B_SOLID_HIGH);
    void StrokeLine(BPoint from, BPoint to, pattern p = B_SOLID_HIGH);
    /// Lines that are drawn together, each in its own colour: begin, add them, end. Those of one colour that go on
    /// where the one before has ended are drawn in one stroke.
    void BeginLineArray(int32 count);
    void AddLine(BPoint from, BPoint to, rgb_color color);
    void EndLineArray();
    void FillPolygon(const BPoint* points, int32 count, pattern p = B_SOLID_HIGH);
    /// Angles in degrees, counter-clockwise from the right.
    void FillArc(BPoint center, float xRadius, float yRadius, float startAngle, float arcAngle,
                 pattern p = B_SOLID_HIGH);
    /// `where` is the left end of the base line; `text` is UTF-8.
    void DrawString(const char* text, BPoint where);

    /// Whether what is drawn now goes to paper, where text is text and no picture.
    bool IsPrinting() const;

    /// Has `Draw` called again, later.
    void Invalidate();
    /// Has `DrawOver` called again, later; the picture stays as it is.
    void RefreshOver();
    /// Puts what was drawn on the screen before it returns.
    void Sync();

    /// What the platform shows this view with, and what its children are put into. For the platform's own use.
    QWidget* widget() const { return widget_; }
    virtual QWidget* childHost() const { return widget_; }
    Canvas& canvas() const { return *canvas_; }
    void setWindow(BWindow* window);
    /// The innermost view, this one or within it, that `inner` is a part of; null when there is none.
    BView* viewAround(const QWidget& inner);
    void paintOn(QPainter& screen);
    /// What the view has drawn, up to date.
    const QPixmap& picture();

protected:
    /// A view that is shown by `widget`, which it owns.
    BView(BRect frame, const char* name, uint32 resizingMode, uint32 flags, QWidget* widget);

private:
    void placeWidget();
    void followParent(float dx, float dy);
    void drawAll();
    void flushLines();

    BRect frame_;
    uint32 resizingMode_;
    uint32 flags_;
    BView* parent_ = nullptr;
    BWindow* window_ = nullptr;
    bool hidden_ = false;
    std::vector<BView*> children_; // owned
    QWidget* widget_;              // owned
    DrawingState state_;
    std::unique_ptr<Canvas> canvas_;
};
