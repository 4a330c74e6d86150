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
        address_.sin_family = AF_INET;
        address_.sin_addr.s_addr = htonl(INADDR_LOOPBACK);
        socklen_t size = sizeof address_;
        bind(listener_, reinterpret_cast<sockaddr*>(&address_), size);
        listen(listener_, 0);
        getsockname(listener_, reinterpret_cast<sockaddr*>(&address_), &size);
        thread_ = std::thread([listener = listener_, talk = std::move(talk)] {
            if (const int client = accept(listener, nullptr, nullptr); client >= 0) {
                talk(client);
                close(client);
            }
        });
    }
    ~Peer()
    {
        shutdown(listener_, SHUT_RDWR); // ends an accept that nobody has answered
        thread_.join();
        close(listener_);
    }
    Peer(const Peer&) = delete;
    Peer& operator=(const Peer&) = delete;

    unsigned short port() const { return ntohs(address_.sin_port); }

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
    static void waitForEnd(int client)
    {
        for (char c; recv(client, &c, 1, 0) == 1;)
            ;
    }

private:
    int listener_;
    sockaddr_in address_{};
    std::thread thread_;
};
