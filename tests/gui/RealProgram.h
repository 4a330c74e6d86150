#pragma once

#include <QPoint>
#include <chrono>
#include <string>
#include <sys/types.h>
#include <vector>

/// The built program in a real window: on an X server of its own without a screen, driven by real mouse and key events.
///
/// What goes wrong throws std::runtime_error.
class RealProgram {
public:
    /// Starts an X server, and `program` on it with `home` as home folder.
    RealProgram(const std::string& program, const std::string& home);
    ~RealProgram();
    RealProgram(const RealProgram&) = delete;
    RealProgram& operator=(const RealProgram&) = delete;

    /// Clicks at a place of the main window.
    void click(QPoint place);
    void key(const std::string& keys);
    void type(const std::string& text);
    /// Waits for a window of that title, and gives it the keyboard, which is a desktop's task otherwise.
    void awaitWindow(const std::string& title);
    void awaitNoWindow(const std::string& title);
    /// The text of the field at a place of the main window, by way of the clipboard.
    std::string textAt(QPoint place);
    /// Reads the field until its text is not `other`.
    std::string textOtherThan(const std::string& other, QPoint place);
    /// Closes the window as a person does. @return the program's exit status.
    int quit();

private:
    static std::string run(const std::string& command);
    std::string runOnDisplay(const std::string& command) const;
    void startServer();
    void startProgram(const std::string& program, const std::string& home);
    std::string findWindow(const std::string& title) const;

    std::string display_;
    pid_t server_ = -1;
    pid_t program_ = -1;
};
