#pragma once

#include "platform/StringView.h"

class PLWindow;

/// The status line at the bottom of the window: one message, which replaces the one before.
class MessageView final : public BStringView {
public:
    MessageView(BRect frame, const char* name, PLWindow* window);
    ~MessageView() override;

    /// Shows a copy of `text` at once. Null forgets the message; the line goes on showing it until it is next drawn.
    void SetMessage(const char* text);
    /// Null without one.
    const char* Message() const { return message_; }
    void DrawMsg();

    void Draw(BRect updateRect) override;
    void FrameResized(float width, float height) override;

private:
    char* message_ = nullptr; // from malloc, owned
    PLWindow* window_;
};
