#include "net/Socket.h"

#include "foundation/Error.h"
#include "foundation/FieldIO.h"
#include "net/HostLookup.h"

#include <arpa/inet.h>
#include <cerrno>
#include <cstring>
#include <fcntl.h>
#include <poll.h>
#include <string>
#include <sys/socket.h>
#include <unistd.h>

char Socket::SOCKETString[8];
short Socket::SOCKETCounter;

Socket::~Socket()
{
    if (descriptor_ >= 0)
        closeConnection();
}

void Socket::setTimeLimit(std::chrono::milliseconds limit)
{
    timeLimit_ = limit;
    if (descriptor_ >= 0)
        applyTimeLimit(timeLimit_);
}

int Socket::connectTo(const String& address, unsigned short port)
{
    // From here on nothing of a former connection is left, though its descriptor may be lost where closing failed.
    closePrevious();
    address_ = {};
    address_.sin_addr.s_addr = inet_addr(address.getCharacterArray());
    return connectToAddress(port, connectDeadline());
}

int Socket::connectToName(const String& host, unsigned short port)
{
    closePrevious();
    const auto deadline = connectDeadline();
    connectFailure_ = lookUpHost(host.getCharacterArray(), deadline, stop_, &address_.sin_addr);
    if (connectFailure_ == -1)
        connectFailure_ = kNoHost;
    return connectFailure_ == 0 ? connectToAddress(port, deadline) : -1;
}

int Socket::serverOn(unsigned short port)
{
    return serverOn(port, in_addr{INADDR_ANY});
}

int Socket::serverOn(unsigned short port, in_addr local)
{
    // Greater than zero, where connecting asks for not negative. Intended: descriptor 0 stays open.
    if (descriptor_ > 0 && closeConnection() != 0)
        return -1;
    if (open() != 0)
        return -1;
    // Else a server that is started again would have to wait until the connections of the former one are forgotten.
    const int yes = 1;
    setsockopt(descriptor_, SOL_SOCKET, SO_REUSEADDR, &yes, sizeof yes);
    address_ = {};
    address_.sin_family = AF_INET;
    address_.sin_addr = local;
    address_.sin_port = htons(port);
    constexpr int kBacklog = 5;
    if (bind(descriptor_, reinterpret_cast<const sockaddr*>(&address_), sizeof address_) != 0 ||
        listen(descriptor_, kBacklog) != 0)
        return -1;
    // Only now may connections be accepted.
    isServer_ = true;
    return 0;
}

int Socket::acceptConnection(Socket** connection)
{
    if (!isServer_)
        return -1;
    sockaddr_in peer{};
    socklen_t size = sizeof peer;
    const int accepted = accept(descriptor_, reinterpret_cast<sockaddr*>(&peer), &size);
    if (accepted < 0)
        return -1;
    *connection = new Socket(accepted, peer); // owned by the caller
    return 0;
}

int Socket::closeConnection()
{
    // In any case: a socket that could not be closed is no server either.
    isServer_ = false;
    if (descriptor_ < 0)
        return 0;
    if (close(descriptor_) != 0)
        return -1;
    // A local socket's address is the path of a file, which goes with it. That of a network connection rarely names a
    // file, so that closing one fails. Intended: connecting an object again relies on that to be refused.
    char path[sizeof address_ + 1] = {};
    std::memcpy(path, &address_, sizeof address_);
    return unlink(path) == 0 ? 0 : -1;
}

int Socket::readLine(String* line)
{
    if (!canTransferLines())
        return -1;
    const Clock::time_point deadline = Clock::now() + lineLimit_;
    // `line` changes only when the whole line has come.
    std::string text;
    char c = '\0';
    do {
        if (const int result = readBefore(deadline, &c))
            return result;
        if (c != '\0')
            text += c;
    } while (c != '\0' && c != '\n');
    *line = String(text.c_str());
    return 0;
}

int Socket::readLine(char* buffer, int size)
{
    if (!canTransferLines() || size - 1 <= 0)
        return -1;
    const Clock::time_point deadline = Clock::now() + lineLimit_;
    // Every byte goes to the same place. Intended: callers are told that a line has come, not which.
    do
        if (const int result = readBefore(deadline, buffer))
            return result;
    while (buffer[0] != '\0' && buffer[0] != '\n');
    if (buffer[0] == '\n')
        buffer[1] = '\0';
    return 0;
}

int Socket::writeLine(const String& line)
{
    std::string text(line.hasText() ? line.bytes() : std::string_view("null\n"));
    return writeLine(text.data());
}

int Socket::writeLine(char* text)
{
    if (!canTransferLines())
        return -1;
    std::size_t n = std::strlen(text);
    if (n > 0 && text[n - 1] == '\r')
        text[--n] = '\0';
    if (n > 0 && text[n - 1] == '\n' && (n == 1 || text[n - 2] != '\r'))
        text[--n] = '\0';
    if (n > 0 && send(text, n) != 0)
        return -1;
    return n > 0 && text[n - 1] == '\n' ? 0 : send("\r\n", 2);
}

int Socket::putCharacterArray(const char* bytes, int count)
{
    return send(bytes, static_cast<std::size_t>(count));
}

int Socket::getCharacterArray(char* bytes, int count)
{
    return recv(descriptor_, bytes, static_cast<std::size_t>(count), 0) < 0 ? -1 : 0;
}

int Socket::receive(char* bytes, std::size_t count, Clock::time_point deadline, std::size_t* received)
{
    for (;;) {
        if (const int result = waitFor(descriptor_, POLLIN, deadline, stop_))
            return result;
        const ssize_t n = recv(descriptor_, bytes, count, MSG_DONTWAIT);
        if (n >= 0) {
            *received = static_cast<std::size_t>(n);
            return 0;
        }
        // A signal, or data that others have taken: the wait goes on until the same deadline.
        if (errno != EINTR && errno != EAGAIN)
            return -1;
    }
}

int Socket::putChar(char c)
{
    return send(&c, 1);
}

int Socket::getChar(char* c)
{
    return sgetc(c, descriptor_) < 0 ? -1 : 0;
}

int Socket::getDescriptor(int* descriptor) const
{
    if (descriptor_ < 0)
        return -1;
    *descriptor = descriptor_;
    return 0;
}

int Socket::getLocalPort(unsigned short* port) const
{
    sockaddr_in local{};
    socklen_t size = sizeof local;
    if (getsockname(descriptor_, reinterpret_cast<sockaddr*>(&local), &size) != 0)
        return -1;
    *port = ntohs(local.sin_port);
    return 0;
}

void Socket::closePrevious()
{
    if (descriptor_ >= 0 && closeConnection() != 0)
        xError("Error closing previous connection.");
}

/// Makes the descriptor, with the time limit.
int Socket::open()
{
    descriptor_ = socket(AF_INET, SOCK_STREAM, 0);
    if (descriptor_ < 0)
        return -1;
    applyTimeLimit(timeLimit_);
    return 0;
}

/// None when there is no limit.
std::optional<Socket::Clock::time_point> Socket::connectDeadline() const
{
    return timeLimit_.count() > 0 ? std::optional(Clock::now() + timeLimit_) : std::nullopt;
}

/// A failed attempt leaves the descriptor open.
int Socket::connectToAddress(unsigned short port, std::optional<Clock::time_point> deadline)
{
    address_.sin_family = AF_INET;
    address_.sin_port = htons(port);
    connectFailure_ = -1;
    if (open() == 0)
        connectFailure_ = deadline
                              ? connectBefore(*deadline)
                              : connect(descriptor_, reinterpret_cast<const sockaddr*>(&address_), sizeof address_);
    return connectFailure_ == 0 ? 0 : -1;
}

/// Begins to connect, and waits. Whatever comes of it, later transfers block again.
/// @return 0, -1, `kTimedOut` or `kStopped`.
int Socket::connectBefore(Clock::time_point deadline) const
{
    const int flags = fcntl(descriptor_, F_GETFL);
    if (flags < 0 || fcntl(descriptor_, F_SETFL, flags | O_NONBLOCK) != 0)
        return -1;
    int result = connect(descriptor_, reinterpret_cast<const sockaddr*>(&address_), sizeof address_);
    if (result != 0 && errno == EINPROGRESS)
        result = waitFor(descriptor_, POLLOUT, deadline, stop_);
    int error = 0;
    socklen_t size = sizeof error;
    if (result == 0 && (getsockopt(descriptor_, SOL_SOCKET, SO_ERROR, &error, &size) != 0 || error != 0))
        result = -1;
    if (fcntl(descriptor_, F_SETFL, flags) != 0)
        return -1;
    return result;
}

void Socket::applyTimeLimit(std::chrono::milliseconds limit) const
{
    constexpr int kThousand = 1000; // milliseconds a second, microseconds a millisecond
    const timeval value{limit.count() / kThousand, limit.count() % kThousand * kThousand};
    setsockopt(descriptor_, SOL_SOCKET, SO_RCVTIMEO, &value, sizeof value);
    setsockopt(descriptor_, SOL_SOCKET, SO_SNDTIMEO, &value, sizeof value);
}

/// Receives a byte of a line. A signal ends the wait as the deadline does.
/// @return 0; `kTimedOut`, or -1 at the end of the connection and on an error.
int Socket::readBefore(Clock::time_point deadline, char* c) const
{
    const int ready = pollUntil(descriptor_, POLLIN, deadline);
    if (ready == 0)
        return kTimedOut;
    const int received = ready > 0 ? sgetc(c, descriptor_) : ready;
    if (received < 0 && errno == EINTR)
        return kTimedOut;
    return received == 1 ? 0 : -1;
}

int Socket::send(const char* bytes, std::size_t count) const
{
    return ::send(descriptor_, bytes, count, MSG_NOSIGNAL) < 0 ? -1 : 0;
}

int Socket::readValue(void* value, short size)
{
    if (recv(descriptor_, SOCKETString, static_cast<std::size_t>(size), 0) < 0)
        return -1;
    auto* bytes = static_cast<char*>(value);
    for (SOCKETCounter = 0; SOCKETCounter < size; ++SOCKETCounter)
        bytes[SOCKETCounter] = SOCKETString[SOCKETCounter];
    return 0;
}

int Socket::writeValue(const void* value, short size)
{
    const auto* bytes = static_cast<const char*>(value);
    for (SOCKETCounter = 0; SOCKETCounter < size; ++SOCKETCounter)
        SOCKETString[SOCKETCounter] = bytes[SOCKETCounter];
    return send(SOCKETString, static_cast<std::size_t>(size));
}
