#include "tests/gui/RealProgram.h"

#include <chrono>
#include <csignal>
#include <stdexcept>
#include <sys/prctl.h>
#include <thread>
#include <unistd.h>

namespace {

constexpr QPoint kWindowPlace(50, 50); // where the program puts its window; without a desktop it has no border
constexpr std::chrono::milliseconds kPause(20);
constexpr std::chrono::milliseconds kPatience(60000); // for a busy machine

template <class Condition>
void await(const std::string& what, Condition isMet)
{
    const auto end = std::chrono::steady_clock::now() + kPatience;
    while (!isMet()) {
        if (std::chrono::steady_clock::now() > end)
            throw std::runtime_error("waited in vain for " + what);
        std::this_thread::sleep_for(kPause);
    }
}

} // namespace

RealProgram::Child::Child()
{
    setProcessChannelMode(ForwardedErrorChannel);
    setChildProcessModifier([] { prctl(PR_SET_PDEATHSIG, SIGKILL); });
}

RealProgram::Child::~Child()
{
    terminate(); // an X server that is killed leaves its lock behind
    if (!waitForFinished())
        kill();
}

void RealProgram::Child::startIt(const std::string& program, const QStringList& arguments)
{
    start(QString::fromStdString(program), arguments);
    if (!waitForStarted(kPatience.count()))
        throw std::runtime_error(program + " does not start");
}

RealProgram::RealProgram(const std::string& program, const std::string& home) : display_(startServer())
{
    QProcessEnvironment environment = QProcessEnvironment::systemEnvironment();
    // The X keyboard library copies parts of texts that have no end, which a strict check takes for a mistake.
    environment.insert("ASAN_OPTIONS", environment.value("ASAN_OPTIONS") + ":strict_string_checks=0");
    environment.insert("DISPLAY", QString::fromStdString(display_));
    environment.insert("QT_QPA_PLATFORM", "xcb");
    environment.insert("HOME", QString::fromStdString(home));
    environment.remove("XDG_CONFIG_HOME");
    program_.setProcessEnvironment(environment);
    program_.startIt(program, {});
    awaitWindow("Pelorin");
}

/// @return the name of its display.
std::string RealProgram::startServer()
{
    // Servers that look for a free number at the same time take each other's socket away.
    const QString own = QString(":%1").arg(100 + getpid() % 50000);
    // Without -noreset it would begin anew, and refuse the program, whenever a tool was its only client and leaves.
    server_.startIt("Xvfb", {own, "-displayfd", "1", "-screen", "0", "1000x900x24", "-nolisten", "tcp", "-noreset"});
    if (!server_.waitForReadyRead(kPatience.count())) // it tells its number when it is ready
        throw std::runtime_error("Xvfb does not start");
    return own.toStdString();
}

std::string RealProgram::run(const std::string& command) const
{
    QProcess shell;
    shell.start("sh", {"-c", QString::fromStdString("export DISPLAY=" + display_ + "; " + command)});
    if (!shell.waitForFinished(kPatience.count()))
        throw std::runtime_error("waited in vain for " + command);
    std::this_thread::sleep_for(kPause);
    return shell.readAllStandardOutput().toStdString();
}

std::string RealProgram::findWindow(const std::string& title) const
{
    const std::string found = run("xdotool search --onlyvisible --name '^" + title + "$'");
    return found.substr(0, found.find('\n'));
}

void RealProgram::awaitWindow(const std::string& title)
{
    std::string window;
    await("the window " + title, [&] { return !(window = findWindow(title)).empty(); });
    run("xdotool windowraise " + window);
    // The server refuses the keyboard to a window that is not quite there yet.
    await("the keyboard of " + title,
          [&] { return run("xdotool windowfocus " + window + " getwindowfocus").starts_with(window + '\n'); });
}

void RealProgram::awaitNoWindow(const std::string& title)
{
    await("the end of the window " + title, [&] { return findWindow(title).empty(); });
    awaitWindow("Pelorin");
}

void RealProgram::click(QPoint place)
{
    const QPoint p = place + kWindowPlace;
    run("xdotool mousemove " + std::to_string(p.x()) + ' ' + std::to_string(p.y()) + " click 1");
}

std::string RealProgram::textAt(QPoint place)
{
    // Stays behind to hand the emptiness out, so it must not hold on to this call's output.
    run("xclip -selection clipboard -in </dev/null >/dev/null 2>&1");
    click(place);
    key("ctrl+a ctrl+c");
    return run("xclip -selection clipboard -out");
}

std::string RealProgram::textOtherThan(const std::string& other, QPoint place)
{
    std::string text;
    await("a text other than '" + other + "'", [&] { return (text = textAt(place)) != other; });
    return text;
}

int RealProgram::quit()
{
    key("ctrl+q");
    if (!program_.waitForFinished(kPatience.count()))
        throw std::runtime_error("waited in vain for the end of the program");
    return program_.exitStatus() == QProcess::NormalExit ? program_.exitCode() : -1;
}

void RealProgram::end(int signal)
{
    if (signal != 0)
        kill(static_cast<pid_t>(program_.processId()), signal);
    else
        server_.terminate();
    if (!program_.waitForFinished(kPatience.count()))
        throw std::runtime_error("waited in vain for the end of the program");
}
