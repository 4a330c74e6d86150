#pragma once

#include <QScrollArea>

class BWindow;

/// The desktop's side of a window: its content in full size, behind scroll bars where the screen is too small.
class WindowWidget final : public QScrollArea {
public:
    explicit WindowWidget(BWindow& window) : window_(window) {}

    /// Gives the window the size `content`, or what of it fits on the screen.
    void fitTo(QSize content, bool resizable);

protected:
    void closeEvent(QCloseEvent* event) override;

private:
    BWindow& window_;
};
