#pragma once

#include <QPoint>
#include <QProcess>
#include <string>

/// The built program in a real window: on an X server of its own without a screen, driven by real mouse and key events.
///
/// What goes wrong throws std::runtime_error.
class RealProgram {
public:
    /// Starts an X server, and `program` on it with `home` as home folder.
    RealProgram(const std::string& program, const std::string& home);

    /// Clicks at a place of the main window.
    void click(QPoint place);
    void key(const std::string& keys) { run("xdotool key " + keys); }
    void type(const std::string& text) { run("xdotool type --delay 5 '" + text + "'"); }
    /// Waits for a window of that title, and gives it the keyboard, which is a desktop's task otherwise.
    void awaitWindow(const std::string& title);
    void awaitNoWindow(const std::string& title);
    /// The text of the field at a place of the main window, by way of the clipboard.
    std::string textAt(QPoint place);
    /// Reads the field until its text is not `other`.
    std::string textOtherThan(const std::string& other, QPoint place);
    /// Closes the window by its key. @return the program's exit status.
    int quit();
    /// Ends the program from outside: by a signal or, if that is 0, by taking its display away.
    void end(int signal);
    /// Runs a shell command on the program's display, and pauses. @return what it writes.
    std::string run(const std::string& command) const;

private:
    /// A process that ends with this object, or with the test, however that comes about.
    class Child : public QProcess {
    public:
        Child();
        ~Child() override;
        void startIt(const std::string& program, const QStringList& arguments);
    };

    std::string startServer();
    std::string findWindow(const std::string& title) const;

    Child server_;
    const std::string display_;
    Child program_;
};
