#pragma once

#include <arpa/inet.h>
#include <functional>
#include <string>
#include <string_view>
#include <sys/socket.h>
#include <thread>
#include <unistd.h>
#include <utility>

/// A TCP server on the loopback, apart from the program's own: it takes one client and talks to it on a thread.
class Peer {
public:
    using Talk = std::function<void(int client)>;

    explicit Peer(Talk talk) : listener_(socket(AF_INET, SOCK_STREAM, 0))
    {
        sockaddr_in address{};
        address.sin_family = AF_INET;
        address.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
        socklen_t size = sizeof address;
        bind(listener_, reinterpret_cast<sockaddr*>(&address), size);
        listen(listener_, 0);
        getsockname(listener_, reinterpret_cast<sockaddr*>(&address), &size);
        port_ = ntohs(address.sin_port);
        thread_ = std::thread([this, talk = std::move(talk)] {
            const int client = accept(listener_, nullptr, nullptr);
            if (client < 0)
                return;
            wasCalled_ = true;
            talk(client);
            close(client);
        });
    }
    ~Peer() { finish(); }
    Peer(const Peer&) = delete;
    Peer& operator=(const Peer&) = delete;

    unsigned short port() const { return port_; }
    /// Waits for the end of the talk. @return whether there was one.
    bool finish()
    {
        if (thread_.joinable()) {
            shutdown(listener_, SHUT_RDWR); // ends an accept that nobody has answered
            thread_.join();
            close(listener_);
        }
        return wasCalled_;
    }

    /// Everything up to a line feed, or to the end.
    static std::string receiveLine(int client)
    {
        std::string line;
        for (char c; !line.ends_with('\n') && recv(client, &c, 1, 0) == 1;)
            line += c;
        return line;
    }
    /// @return false when the client has gone.
    static bool send(int client, std::string_view bytes)
    {
        return ::send(client, bytes.data(), bytes.size(), MSG_NOSIGNAL) == static_cast<ssize_t>(bytes.size());
    }
    /// Waits until the client has gone.
    static void waitForEnd(int client)
    {
        for (char c; recv(client, &c, 1, 0) == 1;)
            ;
    }

private:
    int listener_;
    unsigned short port_ = 0;
    bool wasCalled_ = false; // read after the join
    std::thread thread_;
};
