#include "net/Socket.h"
#include "tests/support/Bytes.h"
#include "tests/support/Peer.h"
#include "tests/support/ToolRun.h"

#include <cstring>
#include <fcntl.h>
#include <functional>
#include <gmock/gmock.h>
#include <thread>
#include <vector>

using namespace std::chrono_literals;
using testing::ElementsAreArray;

namespace {

/// A socket whose other end the test holds.
struct Connected {
    explicit Connected(int type = SOCK_STREAM) : Connected(pairOf(type)) {}
    ~Connected() { hangUp(); }

    void send(std::string_view bytes) const { Peer::send(peer, bytes); }
    void hangUp()
    {
        if (peer >= 0)
            close(peer);
        peer = -1;
    }
    /// What each send of the socket has brought.
    std::vector<std::string> sends() const
    {
        std::vector<std::string> all;
        char bytes[64];
        for (ssize_t n; (n = recv(peer, bytes, sizeof bytes, MSG_DONTWAIT)) > 0;)
            all.emplace_back(bytes, static_cast<std::size_t>(n));
        return all;
    }

    int peer;
    Socket socket;

private:
    struct Ends {
        int of[2];
    };
    explicit Connected(Ends ends) : peer(ends.of[1]), socket(ends.of[0], sockaddr_in{}) {}
    static Ends pairOf(int type)
    {
        Ends ends{};
        socketpair(AF_UNIX, type, 0, ends.of);
        return ends;
    }
};

TEST(SocketTest, ALineLeavesWithCrLfWhateverItsEnd)
{
    const struct {
        const char* text;
        std::vector<std::string> sends;
    } cases[] = {
        {"abc", {"abc", "\r\n"}},
        {"abc\n", {"abc", "\r\n"}},
        {"abc\r", {"abc", "\r\n"}},
        {"abc\r\n", {"abc\r\n"}},
        {"abc\n\r", {"abc", "\r\n"}},
        {"a\nb\n", {"a\nb", "\r\n"}},
        {"", {"\r\n"}},
        {"\n", {"\r\n"}},
    };
    for (const auto& c : cases) {
        Connected by(SOCK_SEQPACKET);
        EXPECT_EQ(by.socket.writeLine(String(c.text)), 0);
        EXPECT_THAT(by.sends(), ElementsAreArray(c.sends)) << c.text;
        char text[16];
        std::strcpy(text, c.text);
        EXPECT_EQ(by.socket.writeLine(text), 0);
        EXPECT_THAT(by.sends(), ElementsAreArray(c.sends)) << c.text;
        EXPECT_STREQ(text, c.sends.size() == 1 && c.sends[0] == "\r\n" ? "" : c.sends[0].c_str())
            << "stripped in place";
    }
    Connected by(SOCK_SEQPACKET);
    EXPECT_EQ(by.socket.writeLine(String()), 0);
    EXPECT_THAT(by.sends(), testing::ElementsAre("null", "\r\n"));
}

TEST(SocketTest, ALineEndsWithItsLineFeedOrBeforeAZero)
{
    const struct {
        std::string_view bytes;
        int result;
        const char* line;
        const char* kept; // of a buffer
        const char* why;
    } cases[] = {
        {"GET\r\nX", 0, "GET\r\n", "\n", "what follows stays"},
        {{"ab\0cd", 5}, 0, "ab", "", "a zero is not stored"},
        {"\n", 0, "\n", "\n", "an empty line"},
        {"ab", -1, "as before", "b", "the connection ends first"},
        {"", -1, "as before", "?", "nothing at all"},
    };
    for (const auto& c : cases) {
        Connected first, second;
        String line("as before");
        char buffer[3] = "?";
        for (Connected* by : {&first, &second}) {
            by->send(c.bytes);
            by->hangUp();
        }
        EXPECT_EQ(first.socket.readLine(&line), c.result) << c.why;
        EXPECT_EQ(line.bytes(), c.line) << c.why;
        EXPECT_EQ(second.socket.readLine(buffer, sizeof buffer), c.result) << c.why;
        EXPECT_STREQ(buffer, c.kept) << c.why;
        char next = '-';
        EXPECT_EQ(first.socket.getChar(&next), 0) << c.why;
        EXPECT_EQ(next, c.bytes.ends_with('X') ? 'X' : c.bytes.ends_with("cd") ? 'c' : '-') << c.why;
    }
    Connected by;
    by.send("\n");
    char one[1];
    EXPECT_EQ(by.socket.readLine(one, 1), -1) << "no room for the zero";
}

TEST(SocketTest, ALineThatDoesNotEndInTimeGivesEight)
{
    EXPECT_EQ(Socket::kLineLimit, 5s);
    EXPECT_EQ(Socket::kTimedOut, 8);
    for (const bool trickles : {false, true}) {
        Peer peer([trickles](int client) {
            for (Peer::send(client, "ab"); trickles && Peer::send(client, "c");)
                std::this_thread::sleep_for(10ms);
            Peer::waitForEnd(client);
        });
        Socket socket;
        socket.setLineLimit(100ms);
        ASSERT_EQ(socket.connectTo("127.0.0.1", peer.port()), 0);
        String line("as before");
        char buffer[4];
        const auto start = std::chrono::steady_clock::now();
        EXPECT_EQ(socket.readLine(&line), 8) << trickles;
        EXPECT_EQ(line, "as before");
        EXPECT_EQ(socket.readLine(buffer, sizeof buffer), 8) << trickles;
        EXPECT_GE(std::chrono::steady_clock::now() - start, 200ms);
    }
}

TEST(SocketTest, NumbersTravelInTheOrderOfThisMachine)
{
    Connected by(SOCK_SEQPACKET);
    by.socket.writeDouble(1.5);
    by.socket.writeFloat(-1.5F);
    by.socket.writeInt(-2);
    by.socket.writeUInt(0x89ABCDEF);
    by.socket.writeShort(-2);
    by.socket.writeUShort(0x1234);
    by.socket.putChar('c');
    by.socket.putCharacterArray("xyz", 2);
    const char* wire[] = {"000000000000F83F", "0000C0BF", "FEFFFFFF", "EFCDAB89", "FEFF", "3412", "'c'", "'xy'"};
    const std::vector<std::string> sends = by.sends();
    ASSERT_EQ(sends.size(), std::size(wire));
    for (std::size_t i = 0; i < std::size(wire); ++i) {
        EXPECT_EQ(sends[i], bytesOf(wire[i]));
        if (i < 6)
            by.send(sends[i]);
    }
    double d;
    float f;
    int i;
    unsigned u;
    short s;
    unsigned short us;
    EXPECT_EQ(by.socket.readDouble(&d) + by.socket.readFloat(&f) + by.socket.readInt(&i), 0);
    EXPECT_EQ(by.socket.readUInt(&u) + by.socket.readShort(&s) + by.socket.readUShort(&us), 0);
    EXPECT_EQ(d, 1.5);
    EXPECT_EQ(f, -1.5F);
    EXPECT_EQ(i, -2);
    EXPECT_EQ(u, 0x89ABCDEF);
    EXPECT_EQ(s, -2);
    EXPECT_EQ(us, 0x1234);

    by.socket.writeInt(0x01020304);
    by.send("\xFF");
    EXPECT_EQ(by.socket.readInt(&i), 0);
    EXPECT_EQ(i, 0x010203FF) << "a short read is filled up from the shared buffer";
}

TEST(SocketTest, APeerThatHasGoneIsAFailureWithoutASignal)
{
    Connected by;
    by.hangUp();
    char bytes[] = "kept";
    EXPECT_EQ(by.socket.getCharacterArray(bytes, 4), 0) << "the end is no failure";
    EXPECT_EQ(by.socket.getChar(bytes), 0);
    EXPECT_STREQ(bytes, "kept");
    EXPECT_EQ(by.socket.writeLine(bytes), -1);
    EXPECT_EQ(by.socket.putCharacterArray(bytes, 4), -1);
    EXPECT_EQ(by.socket.putChar('c'), -1);
    EXPECT_EQ(by.socket.writeDouble(1), -1);

    Socket none;
    String line;
    double value = 1;
    int descriptor = 7;
    for (const int result :
         {none.readLine(&line), none.readLine(bytes, 4), none.writeLine(bytes), none.readDouble(&value),
          none.getCharacterArray(bytes, 4), none.getChar(bytes), none.getDescriptor(&descriptor)})
        EXPECT_EQ(result, -1);
    EXPECT_EQ(descriptor, 7);
    EXPECT_EQ(none.closeConnection(), 0) << "nothing to close";
}

TEST(SocketTest, AServerTalksToItsClient)
{
    Socket server, client;
    Socket* accepted = nullptr;
    unsigned short port = 0;
    EXPECT_EQ(server.acceptConnection(&accepted), -1) << "it does not listen yet";
    ASSERT_EQ(server.serverOn(0), 0);
    ASSERT_EQ(server.getLocalPort(&port), 0);
    Socket rival;
    EXPECT_EQ(rival.serverOn(port), -1) << "the port is taken";
    EXPECT_EQ(rival.acceptConnection(&accepted), -1);
    ASSERT_EQ(client.connectToName("localhost", port), 0);
    ASSERT_EQ(server.acceptConnection(&accepted), 0);
    const std::unique_ptr<Socket> owned(accepted);
    String line;
    EXPECT_EQ(client.writeLine("hello"), 0);
    EXPECT_EQ(accepted->readLine(&line), 0);
    EXPECT_EQ(line, "hello\r\n");
    EXPECT_EQ(server.readLine(&line), -1) << "a server has no lines";
    EXPECT_EQ(server.writeLine("x"), -1);
    EXPECT_EQ(server.serverOn(0), -1) << "closing it fails, as ever";
    EXPECT_EQ(server.acceptConnection(&accepted), -1) << "and ends the listening";
}

TEST(SocketTest, AServerLeavesDescriptorZeroOpen)
{
    while (fcntl(0, F_GETFD) < 0)
        ASSERT_EQ(open("/dev/null", O_RDONLY), 0);
    Socket server(0, sockaddr_in{});
    EXPECT_EQ(server.serverOn(0), 0);
    EXPECT_GE(fcntl(0, F_GETFD), 0);
}

TEST(SocketTest, ClosingAlsoRemovesTheFileThatTheAddressNames)
{
    TemporaryFolder folder("pelorin-socket-test");
    const std::filesystem::path before = std::filesystem::current_path();
    std::filesystem::current_path(folder.path);
    std::ofstream("named") << "x";
    sockaddr_in address{};
    std::memcpy(&address, "named", sizeof "named");
    int ends[2];
    ASSERT_EQ(pipe(ends), 0);
    {
        Socket socket(ends[0], address);
        EXPECT_EQ(socket.closeConnection(), 0);
        EXPECT_FALSE(std::filesystem::exists("named"));
        EXPECT_EQ(socket.closeConnection(), -1) << "it is closed already, but keeps its number";
        EXPECT_EQ(fcntl(ends[0], F_GETFD), -1);
    }
    EXPECT_EQ(Socket(ends[1], sockaddr_in{}).closeConnection(), -1) << "there is no file";
    std::filesystem::current_path(before);
}

TEST(SocketDeathTest, AnObjectIsConnectedOnce)
{
    const std::function<void(Socket&)> uses[] = {[](Socket&) {}, [](Socket& s) { s.closeConnection(); }};
    for (const auto& use : uses) {
        const auto connectAgain = [&](bool byName) {
            Connected by;
            use(by.socket);
            byName ? by.socket.connectToName("localhost", 9) : by.socket.connectTo("127.0.0.1", 9);
        };
        for (const bool byName : {false, true})
            EXPECT_EXIT(connectAgain(byName), testing::ExitedWithCode(255), "^Error closing previous connection\\.\n$");
    }
}

TEST(SocketTest, NoWaitIsLongerThanTheTimeLimit)
{
    Socket server;
    unsigned short port = 0;
    ASSERT_EQ(server.serverOn(0, in_addr{htonl(INADDR_LOOPBACK)}), 0);
    ASSERT_EQ(server.getLocalPort(&port), 0);
    std::vector<std::unique_ptr<Socket>> clients;
    int result = 0;
    const auto start = std::chrono::steady_clock::now();
    // Those that nobody accepts fill the queue; the next one gets no answer.
    while (result == 0 && clients.size() < 20) {
        clients.push_back(std::make_unique<Socket>());
        clients.back()->setTimeLimit(100ms);
        result = clients.back()->connectTo("127.0.0.1", port);
    }
    EXPECT_EQ(result, -1);
    char c;
    EXPECT_EQ(clients.front()->getChar(&c), -1) << "connected, but silent";
    EXPECT_GE(std::chrono::steady_clock::now() - start, 200ms);
    EXPECT_LT(std::chrono::steady_clock::now() - start, 5s);
}

TEST(SocketTest, AHostThatCannotBeReachedFails)
{
    unsigned short unused = 0;
    {
        Socket server;
        ASSERT_EQ(server.serverOn(0), 0);
        ASSERT_EQ(server.getLocalPort(&unused), 0);
    }
    int descriptor = -1;
    Socket refused, nameless, named;
    EXPECT_EQ(refused.connectTo("127.0.0.1", unused), -1);
    EXPECT_EQ(refused.getDescriptor(&descriptor), 0) << "it stays open";
    EXPECT_EQ(nameless.connectToName("no-such-host.invalid", unused), -1);
    EXPECT_EQ(nameless.getDescriptor(&descriptor), -1) << "it was not opened";
    EXPECT_EQ(named.connectTo("localhost", unused), -1) << "not a dotted address";
}

} // namespace
