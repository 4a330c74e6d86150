#pragma once

#include "platform/SupportDefs.h"

#include <QScrollArea>

#include <functional>

class BWindow;

/// The desktop's side of a window: its content in full size, behind scroll bars where the screen is too small.
class WindowWidget final : public QScrollArea {
public:
    explicit WindowWidget(BWindow& window);

    /// Gives the window the size `content` at `place`, or what of it fits on the screen, moved up and left until it
    /// does. One that is resizable takes its content along, which needs no scroll bars.
    void fitTo(QPoint place, QSize content);
    void setResizable(bool isResizable) { isResizable_ = isResizable; }
    /// Asks the window to make do with the room that the screen has, if that is too little for it.
    void giveWay();
    /// To be called before the window shows. It stays in front of `below`, which may be null.
    void makeModal(const QWidget* below);
    /// Calls `action` when the key is pressed with `modifiers` of InterfaceDefs.h, once however long it is held, after
    /// the field that is being typed in has sent its text.
    void addShortcut(int key, uint32 modifiers, const std::function<void()>& action);

protected:
    void showEvent(QShowEvent* event) override;
    bool eventFilter(QObject* watched, QEvent* event) override;
    void closeEvent(QCloseEvent* event) override;
    void resizeEvent(QResizeEvent* event) override;
    void moveEvent(QMoveEvent* event) override;

private:
    /// What the desktop puts around the window.
    QMargins border() const;
    void tellPainted();

    BWindow& window_;
    bool isResizable_ = true;
    bool wasShown_ = false;
};
