#pragma once

#include <csignal>
#include <fcntl.h>
#include <filesystem>
#include <gtest/gtest.h>
#include <string>
#include <sys/wait.h>
#include <unistd.h>

/// A running pelorin-quotes.
class ServerRun {
public:
    /// `program` is its path. Port 0 lets the system choose one. `source` goes with a log file for what
    /// it tells, and its time limit in seconds.
    ServerRun(const char* program, const std::filesystem::path& folder, unsigned short port = 0,
              const std::string& source = "", const std::string& log = "", const char* limit = "2")
    {
        const std::string portText = std::to_string(port);
        int ends[2];
        EXPECT_EQ(pipe(ends), 0);
        pid_ = fork();
        if (pid_ == 0) {
            dup2(ends[1], STDOUT_FILENO);
            close(ends[0]);
            if (!log.empty())
                dup2(open(log.c_str(), O_WRONLY | O_CREAT | O_APPEND, 0600), STDERR_FILENO);
            const char* end = source.empty() ? nullptr : "--source";
            execl(program, program, folder.c_str(), "--port", portText.c_str(), end, source.c_str(), "--time-limit",
                  limit, static_cast<char*>(nullptr));
            _exit(127);
        }
        close(ends[1]);
        for (char c; read(ends[0], &c, 1) == 1 && c != '\n';)
            address_ += c;
        close(ends[0]);
    }
    ~ServerRun() { stop(SIGKILL); }
    ServerRun(const ServerRun&) = delete;
    ServerRun& operator=(const ServerRun&) = delete;

    /// "127.0.0.1:8064"; empty when it cannot listen there.
    const std::string& address() const { return address_; }
    unsigned short port() const
    {
        return static_cast<unsigned short>(std::stoi("0" + address_.substr(address_.find(':') + 1)));
    }
    /// @return the exit status; -1 when it did not exit by itself.
    int stop(int signal)
    {
        int status = -1;
        if (pid_ > 0) {
            kill(pid_, signal);
            waitpid(pid_, &status, 0);
        }
        pid_ = 0;
        return WIFEXITED(status) ? WEXITSTATUS(status) : -1;
    }

private:
    pid_t pid_;
    std::string address_;
};
