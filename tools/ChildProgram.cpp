#include "tools/ChildProgram.h"

#include "foundation/PrintableText.h"

#include <algorithm>
#include <cerrno>
#include <csignal>
#include <cstring>
#include <fcntl.h>
#include <spawn.h>
#include <stdexcept>
#include <sys/wait.h>

namespace {

constexpr std::size_t kMostComplaint = 4096;

/// Adds what is there to `text`, and drops what is more than `most`. @return false at the end.
bool drain(int descriptor, std::string& text, std::size_t most)
{
    char bytes[1 << 14];
    // So many at a time, that one that prints for ever does not hold up the others.
    for (int blocks = 16; blocks > 0; --blocks) {
        const ssize_t count = read(descriptor, bytes, sizeof bytes);
        if (count <= 0)
            return count < 0 && (errno == EAGAIN || errno == EINTR);
        text.append(bytes, std::min(static_cast<std::size_t>(count), most - std::min(most, text.size())));
    }
    return true;
}

/// What the spawning of a program is told of its descriptors and signals.
struct SpawnTerms {
    SpawnTerms(int output, int complaint)
    {
        posix_spawn_file_actions_init(&actions);
        posix_spawn_file_actions_addopen(&actions, STDIN_FILENO, "/dev/null", O_RDONLY, 0);
        posix_spawn_file_actions_adddup2(&actions, output, STDOUT_FILENO);
        posix_spawn_file_actions_adddup2(&actions, complaint, STDERR_FILENO);
        // A client's connection that lived on in there would not be closed when we close it.
        posix_spawn_file_actions_addclosefrom_np(&actions, STDERR_FILENO + 1);
        posix_spawnattr_init(&attributes);
        posix_spawnattr_setflags(&attributes, POSIX_SPAWN_SETPGROUP | POSIX_SPAWN_SETSIGMASK | POSIX_SPAWN_SETSIGDEF);
        posix_spawnattr_setpgroup(&attributes, 0);
        // What this program ignores or holds back for itself would stay so in the other one.
        sigset_t signals;
        sigemptyset(&signals);
        posix_spawnattr_setsigmask(&attributes, &signals);
        sigaddset(&signals, SIGPIPE);
        sigaddset(&signals, SIGXFSZ);
        posix_spawnattr_setsigdefault(&attributes, &signals);
    }
    ~SpawnTerms()
    {
        posix_spawn_file_actions_destroy(&actions);
        posix_spawnattr_destroy(&attributes);
    }
    SpawnTerms(const SpawnTerms&) = delete;
    SpawnTerms& operator=(const SpawnTerms&) = delete;

    posix_spawn_file_actions_t actions;
    posix_spawnattr_t attributes;
};

/// A pipe that no program inherits but by being given it: the end to read from, without waiting, and that to write to.
struct Pipe {
    Pipe()
    {
        if (pipe2(ends, O_CLOEXEC) != 0)
            throw std::runtime_error(std::string("a pipe cannot be made: ") + std::strerror(errno));
        fcntl(ends[0], F_SETFL, O_NONBLOCK);
    }
    int ends[2];
};

} // namespace

ChildProgram::ChildProgram(const std::vector<std::string>& arguments, std::chrono::milliseconds limit)
    : name_(arguments.front()), limit_(limit), deadline_(Clock::now() + limit)
{
    start(arguments);
}

ChildProgram::~ChildProgram()
{
    killAll();
}

void ChildProgram::start(const std::vector<std::string>& arguments)
{
    // Whoever has started us may ignore it, as scripts do, and then there would be no end to wait for.
    std::signal(SIGCHLD, SIG_DFL);
    const Pipe output;
    printed_.emplace(output.ends[0]);
    const Descriptor outputEnd(output.ends[1]);
    const Pipe complaint;
    complained_.emplace(complaint.ends[0]);
    const Descriptor complaintEnd(complaint.ends[1]);
    const SpawnTerms terms(outputEnd.number, complaintEnd.number);
    std::vector<char*> texts;
    for (const std::string& argument : arguments)
        texts.push_back(const_cast<char*>(argument.c_str())); // which are not written to
    texts.push_back(nullptr);
    const int error = posix_spawnp(&process_, texts.front(), &terms.actions, &terms.attributes, texts.data(), environ);
    if (error == 0)
        return;
    process_ = 0;
    failure_ = printable(name_) + " cannot be run: " + std::strerror(error);
}

void ChildProgram::addWaiting(std::vector<pollfd>& all) const
{
    for (const auto* end : {&printed_, &complained_})
        if (*end)
            all.push_back({(*end)->number, POLLIN, 0});
}

ChildProgram::Clock::time_point ChildProgram::nextLook() const
{
    // One that has closed its outputs ends at once as a rule, which `poll` does not tell.
    constexpr std::chrono::milliseconds kPause{5};
    return printed_ || complained_ ? deadline_ : std::min(deadline_, Clock::now() + kPause);
}

bool ChildProgram::proceed()
{
    if (process_ == 0)
        return false;
    if (printed_ && !drain(printed_->number, output_, kMostOutput + 1))
        printed_.reset();
    if (complained_ && !drain(complained_->number, complaint_, kMostComplaint))
        complained_.reset();
    if (output_.size() > kMostOutput)
        failure_ = "prints more than " + std::to_string(kMostOutput) + " bytes";
    else if (!printed_ && !complained_ && reap())
        return false;
    else if (Clock::now() >= deadline_) {
        hasTimedOut_ = true;
        failure_ = "has not ended within " + std::to_string(limit_.count() / 1000) + " seconds";
    } else
        return true;
    killAll();
    return false;
}

/// @return whether the program has ended. What it has started ends with it.
bool ChildProgram::reap()
{
    siginfo_t ended{};
    const int error = waitid(P_PID, static_cast<id_t>(process_), &ended, WEXITED | WNOHANG | WNOWAIT);
    if (error != 0 || ended.si_pid == 0)
        return false;
    takeStatus(killAll());
    return true;
}

void ChildProgram::takeStatus(int status)
{
    if (WIFEXITED(status) && WEXITSTATUS(status) == 0)
        return;
    failure_ = WIFEXITED(status) ? "has ended with status " + std::to_string(WEXITSTATUS(status))
                                 : "was ended by signal " + std::to_string(WTERMSIG(status));
    const std::size_t first = complaint_.find_first_not_of(" \t\r\n");
    if (first != complaint_.npos)
        failure_ += ": " + toldBy(complaint_.substr(first, complaint_.find_first_of("\r\n", first) - first));
}

/// The number of a process is not given to another one before it is reaped, so that the group is the right one.
/// @return how the program has ended; 0 when there is none any more.
int ChildProgram::killAll()
{
    int status = 0;
    if (process_ == 0)
        return status;
    kill(-process_, SIGKILL);
    waitpid(process_, &status, 0);
    process_ = 0;
    return status;
}

/// Word by word, since an address in it may be long, and what comes behind that tells the reason.
std::string toldBy(std::string_view text)
{
    constexpr std::string_view kBlanks = " \t\r\n";
    constexpr std::size_t kLongest = 300;
    std::string told;
    for (std::size_t at = 0; (at = text.find_first_not_of(kBlanks, at)) != text.npos;) {
        const std::size_t end = std::min(text.find_first_of(kBlanks, at), text.size());
        if (told.size() > kLongest)
            return told + " ...";
        (told += told.empty() ? "" : " ") += printable(text.substr(at, end - at));
        at = end;
    }
    return told;
}
