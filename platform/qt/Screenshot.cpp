#include "platform/Screenshot.h"

#include "platform/View.h"
#include "platform/Window.h"
#include "platform/qt/WindowWidget.h"

#include <QApplication>
#include <QElapsedTimer>
#include <QPainter>
#include <QPixmap>
#include <QSaveFile>
#include <QScreen>
#include <QWindow>

status_t save_screenshot(const BWindow& window, BRect part, const char* path)
{
    WindowWidget& shown = window.widget();
    // One that was just shown comes to the screen a moment later.
    constexpr qint64 kPatience = 5000; // milliseconds
    QElapsedTimer waiting;
    for (waiting.start(); !shown.windowHandle()->isExposed() && waiting.elapsed() < kPatience;)
        QApplication::processEvents();
    shown.repaint();
    const QRect place = QRectF(part.left, part.top, part.Width(), part.Height()).toRect();
    QPixmap picture = shown.screen()->grabWindow(shown.winId(), place.x(), place.y(), place.width(), place.height());
    // It is a window of its own, which not every screen has on its picture of another one.
    if (QWidget* menu = QApplication::activePopupWidget())
        QPainter(&picture).drawPixmap(shown.mapFromGlobal(menu->pos()) - place.topLeft(), menu->grab());
    return picture.save(QString::fromUtf8(path), "PNG") ? B_OK : B_ERROR;
}

status_t save_picture(BView& view, const char* path)
{
    // Writes beside the file and takes its place at `commit`: a disk that is full leaves a former picture whole.
    QSaveFile file(QString::fromUtf8(path));
    const bool isWritten = file.open(QIODevice::WriteOnly) && view.picture().save(&file, "PNG") && file.commit();
    return isWritten ? B_OK : B_ERROR;
}

void close_menu()
{
    if (QWidget* menu = QApplication::activePopupWidget())
        menu->close();
}

void handle_pending_messages()
{
    constexpr int kRounds = 10; // a message may post further ones
    for (int i = 0; i < kRounds; ++i)
        QApplication::processEvents();
}
