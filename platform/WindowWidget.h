#pragma once

#include <QScrollArea>

class BWindow;

/// The desktop's side of a window: its content in full size, behind scroll bars where the screen is too small.
class WindowWidget final : public QScrollArea {
public:
    explicit WindowWidget(BWindow& window) : window_(window) {}

    /// Gives the window the size `content` at `place`, or what of it fits on the screen, moved up and left until it
    /// does.
    void fitTo(QPoint place, QSize content, bool resizable);

protected:
    void closeEvent(QCloseEvent* event) override;

private:
    BWindow& window_;
};
