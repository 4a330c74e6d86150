#pragma once

#include "platform/Looper.h"

#include <string>

/// The program's connection to the desktop. There is one, made before any window; it destroys the windows that are
/// left.
class BApplication : public BLooper {
public:
    /// Has windows and views be laid out and drawn where nobody sees them, on a machine without a display, too. To be
    /// called before the application is made.
    static void UseNoDisplay();

    /// `signature` is the program's name among all programs, such as "application/x-vnd.Someone".
    explicit BApplication(const char* signature);
    ~BApplication() override;

    /// Handles events until the application is asked to quit (`B_QUIT_REQUESTED`, or SIGTERM, SIGHUP or SIGINT, which
    /// take back what waits for an answer); then closes the windows that are left.
    int Run();
    /// Ends `Run` when the present message is done.
    void Quit();
    void MessageReceived(BMessage* message) override;

private:
    std::string signature_;
};

/// The application, null while there is none.
extern BApplication* be_app;
