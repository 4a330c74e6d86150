#include "platform/Application.h"

#include "platform/Font.h"
#include "platform/Message.h"
#include "platform/Window.h"

#include <QApplication>
#include <QFont>
#include <QPalette>
#include <QStyleFactory>

#include <clocale>

BApplication* be_app = nullptr;

namespace {

constexpr int kPanelGrey = 216;

// Qt keeps references to these.
int argumentCount = 1;
char programName[] = "pelorin";
char* arguments[] = {programName, nullptr};

QPalette panelColors()
{
    const QColor panel(kPanelGrey, kPanelGrey, kPanelGrey);
    QPalette palette(panel, panel);
    palette.setColor(QPalette::Base, Qt::white);
    palette.setColor(QPalette::AlternateBase, QColor(244, 246, 249));
    palette.setColor(QPalette::Highlight, QColor(38, 94, 158));
    palette.setColor(QPalette::HighlightedText, Qt::white);
    palette.setColor(QPalette::ToolTipBase, QColor(255, 253, 231));
    palette.setColor(QPalette::ToolTipText, Qt::black);
    for (const auto role : {QPalette::WindowText, QPalette::Text, QPalette::ButtonText})
        palette.setColor(QPalette::Disabled, role, QColor(120, 120, 120));
    return palette;
}

} // namespace

BApplication::BApplication(const char* signature) : BLooper(signature), signature_(signature)
{
    // A test program makes the connection to the desktop itself, and several applications on it one after the other.
    if (QCoreApplication::instance() == nullptr) {
        new QApplication(argumentCount, arguments); // lives as long as the process
        // It has taken over the desktop's way to write numbers. The program's own has a point, whatever the desktop's.
        std::setlocale(LC_NUMERIC, "C");
        const std::string name = signature_.substr(signature_.find_last_of("./") + 1);
        QApplication::setApplicationName(QString::fromStdString(name));
        QApplication::setDesktopFileName(QString::fromStdString(name).toLower());
    }
    QApplication::setStyle(QStyleFactory::create("Fusion"));
    QApplication::setPalette(panelColors());
    QApplication::setFont(be_plain_font->toQt());
    QApplication::setQuitOnLastWindowClosed(false);
    be_app = this;
}

BApplication::~BApplication()
{
    BWindow::closeAll();
    be_app = nullptr;
}

int BApplication::Run()
{
    const int status = QApplication::exec();
    BWindow::closeAll();
    return status;
}

void BApplication::Quit()
{
    QCoreApplication::quit();
}

void BApplication::MessageReceived(BMessage* message)
{
    if (message->what == B_QUIT_REQUESTED && QuitRequested())
        Quit();
    else
        BLooper::MessageReceived(message);
}
