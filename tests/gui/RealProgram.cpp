#include "tests/gui/RealProgram.h"

#include <cerrno>
#include <csignal>
#include <cstdio>
#include <cstdlib>
#include <fcntl.h>
#include <stdexcept>
#include <sys/prctl.h>
#include <sys/wait.h>
#include <thread>
#include <unistd.h>

// Last, because it names everyday words as macros.
#include <X11/Xlib.h>

namespace {

using std::chrono::milliseconds;

constexpr QPoint kWindowPlace(50, 50); // where the program puts its window; without a desktop it has no border
constexpr milliseconds kPause(20);
constexpr int kPatience = 1500; // pauses until something that does not come is given up: 30 s, for a busy machine

void breathe()
{
    std::this_thread::sleep_for(kPause);
}

template <class Condition>
void await(const std::string& what, Condition isMet)
{
    for (int i = 0; i < kPatience; ++i) {
        if (isMet())
            return;
        breathe();
    }
    throw std::runtime_error("waited in vain for " + what);
}

/// Asks a window to close, as a desktop's close button does.
void closeWindow(const std::string& displayName, unsigned long window)
{
    Display* display = XOpenDisplay(displayName.c_str());
    if (display == nullptr)
        throw std::runtime_error("no connection to " + displayName);
    XEvent event = {};
    event.xclient.type = ClientMessage;
    event.xclient.window = window;
    event.xclient.message_type = XInternAtom(display, "WM_PROTOCOLS", False);
    event.xclient.format = 32;
    event.xclient.data.l[0] = static_cast<long>(XInternAtom(display, "WM_DELETE_WINDOW", False));
    XSendEvent(display, window, False, NoEventMask, &event);
    XCloseDisplay(display);
}

/// Has this child process end when the test does, however that comes about.
void endWithTest()
{
    prctl(PR_SET_PDEATHSIG, SIGKILL);
}

void stop(pid_t process, int signal)
{
    if (process <= 0)
        return;
    kill(process, signal);
    waitpid(process, nullptr, 0);
}

} // namespace

RealProgram::RealProgram(const std::string& program, const std::string& home)
{
    startServer();
    startProgram(program, home);
    awaitWindow("Pelorin");
}

RealProgram::~RealProgram()
{
    stop(program_, SIGKILL);
    stop(server_, SIGTERM);
}

void RealProgram::startServer()
{
    int ends[2];
    if (pipe(ends) != 0)
        throw std::runtime_error("no pipe");
    // Servers that look for a free number at the same time take each other's socket away.
    const std::string own = ":" + std::to_string(100 + getpid() % 50000);
    server_ = fork();
    if (server_ == 0) {
        endWithTest();
        const std::string end = std::to_string(ends[1]);
        execlp("Xvfb", "Xvfb", own.c_str(), "-displayfd", end.c_str(), "-screen", "0", "1000x900x24", "-nolisten",
               "tcp", static_cast<char*>(nullptr));
        _exit(127);
    }
    close(ends[1]);
    // It tells its number when it is ready.
    char number[16] = {};
    const auto length = read(ends[0], number, sizeof number - 1);
    close(ends[0]);
    if (length <= 0)
        throw std::runtime_error("Xvfb does not start");
    display_ = ":" + std::to_string(std::atoi(number));
}

void RealProgram::startProgram(const std::string& program, const std::string& home)
{
    program_ = fork();
    if (program_ != 0)
        return;
    endWithTest();
    // The X keyboard library copies parts of texts that have no end, which a strict check takes for a mistake.
    const char* options = getenv("ASAN_OPTIONS");
    setenv("ASAN_OPTIONS", ((options != nullptr ? options : "") + std::string(":strict_string_checks=0")).c_str(), 1);
    setenv("DISPLAY", display_.c_str(), 1);
    setenv("QT_QPA_PLATFORM", "xcb", 1);
    setenv("HOME", home.c_str(), 1);
    unsetenv("XDG_CONFIG_HOME");
    execl(program.c_str(), program.c_str(), static_cast<char*>(nullptr));
    _exit(127);
}

std::string RealProgram::run(const std::string& command)
{
    FILE* pipe = popen((command + " 2>/dev/null").c_str(), "r");
    if (pipe == nullptr)
        throw std::runtime_error("cannot run " + command);
    std::string output;
    char block[256];
    while (const auto n = fread(block, 1, sizeof block, pipe))
        output.append(block, n);
    pclose(pipe);
    return output;
}

std::string RealProgram::runOnDisplay(const std::string& command) const
{
    return run("DISPLAY=" + display_ + " " + command);
}

std::string RealProgram::findWindow(const std::string& title) const
{
    const std::string found = runOnDisplay("xdotool search --onlyvisible --name '^" + title + "$'");
    return found.substr(0, found.find('\n'));
}

void RealProgram::awaitWindow(const std::string& title)
{
    std::string window;
    await("the window " + title, [&] { return !(window = findWindow(title)).empty(); });
    runOnDisplay("xdotool windowraise " + window);
    // The server refuses the keyboard to a window that is not quite there yet.
    await("the keyboard of " + title, [&] {
        runOnDisplay("xdotool windowfocus " + window);
        const std::string holder = runOnDisplay("xdotool getwindowfocus");
        return holder.substr(0, holder.find('\n')) == window;
    });
    breathe();
}

void RealProgram::awaitNoWindow(const std::string& title)
{
    await("the end of the window " + title, [&] { return findWindow(title).empty(); });
    awaitWindow("Pelorin");
}

void RealProgram::click(QPoint place)
{
    const QPoint p = place + kWindowPlace;
    runOnDisplay("xdotool mousemove " + std::to_string(p.x()) + ' ' + std::to_string(p.y()) + " click 1");
    breathe();
}

void RealProgram::key(const std::string& keys)
{
    runOnDisplay("xdotool key " + keys);
    breathe();
}

void RealProgram::type(const std::string& text)
{
    runOnDisplay("xdotool type --delay 5 '" + text + "'");
    breathe();
}

std::string RealProgram::textAt(QPoint place)
{
    // Stays behind to hand the emptiness out, so it must not hold on to this call's output.
    runOnDisplay("xclip -selection clipboard -in </dev/null >/dev/null 2>&1");
    click(place);
    key("ctrl+a");
    key("ctrl+c");
    return runOnDisplay("xclip -selection clipboard -out");
}

std::string RealProgram::textOtherThan(const std::string& other, QPoint place)
{
    std::string text;
    await("a text other than '" + other + "'", [&] { return (text = textAt(place)) != other; });
    return text;
}

int RealProgram::quit()
{
    closeWindow(display_, std::stoul(findWindow("Pelorin")));
    int status = -1;
    await("the end of the program", [&] { return waitpid(program_, &status, WNOHANG) == program_; });
    program_ = -1;
    return WIFEXITED(status) ? WEXITSTATUS(status) : -1;
}
