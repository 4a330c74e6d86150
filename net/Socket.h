#pragma once

#include "foundation/String.h"
#include "net/Wait.h"

#include <netinet/in.h>
#include <optional>

/// A TCP socket over IPv4: a client, a server, or a server's end of a connection.
///
/// Results are 0 for success and -1 for failure; nothing is retried, and a peer that has gone is a failure like any
/// other, without a signal. An object serves one connection only; see `closeConnection`.
class Socket {
public:
    using Clock = std::chrono::steady_clock;

    /// The result of reading a line that did not end in time, and of a `receive` to which nothing came.
    static constexpr int kTimedOut = ::kTimedOut;
    /// The reason of a connect that found no such host.
    static constexpr int kNoHost = 10;
    static constexpr std::chrono::milliseconds kLineLimit{5000};

    Socket() = default;
    /// Takes over an open descriptor, whose peer has this address.
    Socket(int descriptor, sockaddr_in address) : descriptor_(descriptor), address_(address) {}
    ~Socket();
    Socket(const Socket&) = delete;
    Socket& operator=(const Socket&) = delete;

    /// The longest wait of each connect, the search for the host included, of each receive and each send from now on;
    /// what exceeds it fails. 0, as it is at first, stands for ever.
    void setTimeLimit(std::chrono::milliseconds limit);
    /// Lets `stop` end the waits of connects that have a time limit, and those of `receive`.
    void setStopCheck(const StopCheck& stop) { stop_ = stop; }
    /// The longest wait for a whole line, from the call on; at first `kLineLimit`.
    void setLineLimit(std::chrono::milliseconds limit) { lineLimit_ = limit; }

    /// Connects to a dotted address, or to a host's first IPv4 address. On an object that was connected before, the
    /// program ends with "Error closing previous connection.", since `closeConnection` fails.
    int connectTo(const String& address, unsigned short port);
    int connectToName(const String& host, unsigned short port);
    /// Why the last connect failed: `kNoHost`, `kTimedOut`, `kStopped`, otherwise -1; 0 when it did not.
    int connectFailure() const { return connectFailure_; }

    /// Listens on all local addresses, or on one. Port 0 lets the system choose; `getLocalPort` tells the choice.
    int serverOn(unsigned short port);
    int serverOn(unsigned short port, in_addr local);
    /// Waits for a client. The caller owns `*connection`.
    int acceptConnection(Socket** connection);

    /// Closes the descriptor, which keeps its number: the object counts as open, so that it cannot be connected again.
    /// @return -1 as a rule, after a good close too.
    int closeConnection();

    /// Reads up to and including a line feed, or up to a zero byte, which is dropped.
    /// @return 0; `kTimedOut` or -1, with `*line` as it was and what had come so far lost.
    int readLine(String* line);
    /// Reads a line of which only the last byte is kept, in `buffer[0]`: it is "\n" afterwards. `size` is at least 2.
    int readLine(char* buffer, int size);
    /// Sends a line with CR LF at its end, whatever line end the text has; "null" for a String without text.
    int writeLine(const String& line);
    int writeLine(const char* text) { return writeLine(String(text)); }
    /// The same; a CR or LF at the end of `text` is overwritten by a zero.
    int writeLine(char* text);

    /// One send, one receive of up to `count` bytes. A receive at the end of the connection succeeds without touching
    /// `bytes`; nobody learns how many came.
    int putCharacterArray(const char* bytes, int count);
    int getCharacterArray(char* bytes, int count);
    /// Receives what comes first, up to `count` bytes; `*received` is their number, and 0 at the end of the connection.
    /// A signal does not end the wait.
    /// @return 0; `kTimedOut` when nothing has come until the deadline, `kStopped`, and -1.
    int receive(char* bytes, std::size_t count, Clock::time_point deadline, std::size_t* received);
    int putChar(char c);
    int getChar(char* c);

    // Numbers, in the byte order of this machine. A read that gets too few bytes fills up with those of an earlier
    // transfer, and succeeds. All sockets share the buffer: one transfer at a time.

    int readDouble(double* value) { return readValue(value, sizeof *value); }
    int readFloat(float* value) { return readValue(value, sizeof *value); }
    int readInt(int* value) { return readValue(value, sizeof *value); }
    int readUInt(unsigned* value) { return readValue(value, sizeof *value); }
    int readShort(short* value) { return readValue(value, sizeof *value); }
    int readUShort(unsigned short* value) { return readValue(value, sizeof *value); }
    int writeDouble(double value) { return writeValue(&value, sizeof value); }
    int writeFloat(float value) { return writeValue(&value, sizeof value); }
    int writeInt(int value) { return writeValue(&value, sizeof value); }
    int writeUInt(unsigned value) { return writeValue(&value, sizeof value); }
    int writeShort(short value) { return writeValue(&value, sizeof value); }
    int writeUShort(unsigned short value) { return writeValue(&value, sizeof value); }

    /// @return -1 when there is none, leaving `*descriptor` alone.
    int getDescriptor(int* descriptor) const;
    int getLocalPort(unsigned short* port) const;

private:
    void closePrevious();
    int open();
    std::optional<Clock::time_point> connectDeadline() const;
    int connectToAddress(unsigned short port, std::optional<Clock::time_point> deadline);
    int connectBefore(Clock::time_point deadline) const;
    void applyTimeLimit(std::chrono::milliseconds limit) const;
    bool canTransferLines() const { return descriptor_ >= 0 && !isServer_; }
    int readBefore(Clock::time_point deadline, char* c) const;
    int send(const char* bytes, std::size_t count) const;
    int readValue(void* value, short size);
    int writeValue(const void* value, short size);

    static char SOCKETString[8];
    static short SOCKETCounter;

    int descriptor_ = -1;
    bool isServer_ = false;
    sockaddr_in address_{}; // of the peer; of this end for a server
    std::chrono::milliseconds timeLimit_{0};
    std::chrono::milliseconds lineLimit_ = kLineLimit;
    StopCheck stop_;
    int connectFailure_ = 0;
};
