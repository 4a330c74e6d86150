#include "net/Socket.h"
#include "tests/support/Peer.h"

#include <cstring>
#include <gmock/gmock.h>
#include <memory>
#include <net/if.h>
#include <optional>
#include <sched.h>
#include <sys/ioctl.h>
#include <sys/mount.h>
#include <sys/wait.h>
#include <vector>

using namespace std::chrono_literals;
using testing::ElementsAre;

namespace {

/// A socket whose other end the test holds.
struct Connected {
    explicit Connected(int type = SOCK_STREAM)
    {
        int ends[2];
        socketpair(AF_UNIX, type, 0, ends);
        socket.emplace(ends[0], sockaddr_in{});
        peer = ends[1];
    }
    ~Connected() { hangUp(); }
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
    std::optional<Socket> socket;
};

TEST(SocketTest, ALineLeavesWithCrLfWhateverItsEnd)
{
    const std::vector<std::string> twoSends = {"abc", "\r\n"};
    const std::pair<const char*, std::vector<std::string>> cases[] = {
        {"abc", twoSends},     {"abc\n", twoSends}, {"abc\r", twoSends}, {"abc\r\n", {"abc\r\n"}},
        {"abc\n\r", twoSends}, {"", {"\r\n"}},      {"\n", {"\r\n"}},    {"a\nb", {"a\nb", "\r\n"}},
    };
    Connected by(SOCK_SEQPACKET);
    for (const auto& [text, sends] : cases) {
        EXPECT_EQ(by.socket->writeLine(text), 0);
        EXPECT_EQ(by.sends(), sends) << text;
        char own[8];
        std::strcpy(own, text);
        EXPECT_EQ(by.socket->writeLine(own), 0);
        EXPECT_EQ(by.sends(), sends) << text;
        EXPECT_STREQ(own, sends.front() == "\r\n" ? "" : sends.front().c_str()) << "stripped in place";
    }
    EXPECT_EQ(by.socket->writeLine(String()), 0);
    EXPECT_THAT(by.sends(), ElementsAre("null", "\r\n"));
}

TEST(SocketTest, ALineEndsWithItsLineFeedOrBeforeAZero)
{
    const struct {
        std::string_view bytes;
        int result;
        const char* line;
        char next;
    } cases[] = {
        {"GET\r\nX", 0, "GET\r\n", 'X'},
        {{"ab\0cd", 5}, 0, "ab", 'c'},
        {"\n", 0, "\n", '-'},
        {"ab", -1, "before", '-'},
    };
    for (const auto& c : cases) {
        Connected by;
        Peer::send(by.peer, c.bytes);
        by.hangUp();
        String line("before");
        char next = '-';
        EXPECT_EQ(by.socket->readLine(&line), c.result) << c.bytes;
        EXPECT_EQ(line, c.line) << c.bytes;
        EXPECT_EQ(by.socket->getChar(&next), 0) << c.bytes;
        EXPECT_EQ(next, c.next) << c.bytes << ": what follows stays";
    }
}

TEST(SocketTest, ALineThatDoesNotEndInTimeGivesEight)
{
    for (const bool trickles : {false, true}) {
        Peer peer([trickles](int client) {
            for (Peer::send(client, "ab"); trickles && Peer::send(client, "c");)
                std::this_thread::sleep_for(10ms);
            Peer::waitForEnd(client);
        });
        Socket socket;
        socket.setLineLimit(100ms);
        ASSERT_EQ(socket.connectTo("127.0.0.1", peer.port()), 0);
        String line("before");
        char buffer[4];
        const auto start = std::chrono::steady_clock::now();
        EXPECT_EQ(socket.readLine(&line), 8) << trickles;
        EXPECT_EQ(line, "before");
        EXPECT_EQ(socket.readLine(buffer, sizeof buffer), 8) << trickles;
        EXPECT_GE(std::chrono::steady_clock::now() - start, 200ms);
    }
}

TEST(SocketTest, APeerThatHasGoneIsAFailureWithoutASignal)
{
    Connected by;
    by.hangUp();
    char bytes[] = "kept";
    EXPECT_EQ(by.socket->getCharacterArray(bytes, 4), 0) << "the end is no failure";
    EXPECT_STREQ(bytes, "kept");
    EXPECT_EQ(by.socket->writeLine(bytes), -1);
    EXPECT_EQ(by.socket->putCharacterArray(bytes, 4), -1);
    EXPECT_EQ(by.socket->putChar('c'), -1);
}

TEST(SocketTest, AServerTalksToItsClient)
{
    Socket server, rival, client;
    Socket* accepted = nullptr;
    unsigned short port = 0;
    EXPECT_EQ(server.acceptConnection(&accepted), -1) << "it does not listen yet";
    ASSERT_EQ(server.serverOn(0) + server.getLocalPort(&port), 0);
    EXPECT_EQ(rival.serverOn(port), -1) << "the port is taken";
    ASSERT_EQ(client.connectToName("localhost", port) + server.acceptConnection(&accepted), 0);
    const std::unique_ptr<Socket> owned(accepted);
    String line;
    EXPECT_EQ(client.writeLine("hello") + accepted->readLine(&line), 0);
    EXPECT_EQ(line, "hello\r\n");
    EXPECT_EQ(server.readLine(&line), -1) << "a server has no lines";
    EXPECT_EQ(server.writeLine("x"), -1);
    EXPECT_EQ(server.serverOn(0), -1) << "closing it fails, as ever";
    EXPECT_EQ(server.acceptConnection(&accepted), -1) << "and ends the listening";
}

/// Gives this process a network of its own with a name server that never answers. @return false when that is refused.
bool enterSilentNetwork()
{
    char servers[] = "/tmp/pelorin-servers-XXXXXX";
    const int file = mkstemp(servers);
    const bool isWritten = write(file, "nameserver 127.0.0.1\n", 21) == 21;
    const bool isAlone = isWritten && unshare(CLONE_NEWUSER | CLONE_NEWNS | CLONE_NEWNET) == 0 &&
                         mount(servers, "/etc/resolv.conf", nullptr, MS_BIND, nullptr) == 0;
    unlink(servers);
    ifreq loopback{};
    std::strcpy(loopback.ifr_name, "lo");
    loopback.ifr_flags = IFF_UP;
    const int silent = socket(AF_INET, SOCK_DGRAM, 0);
    sockaddr_in address{};
    address.sin_family = AF_INET;
    address.sin_port = htons(53);
    return isAlone && ioctl(silent, SIOCSIFFLAGS, &loopback) == 0 &&
           bind(silent, reinterpret_cast<const sockaddr*>(&address), sizeof address) == 0;
}

TEST(SocketDeathTest, ASilentNameServerHoldsAConnectNoLongerThanTheLimit)
{
    const auto connect = [] {
        if (!enterSilentNetwork())
            std::exit(2);
        Socket socket;
        socket.setTimeLimit(200ms);
        const auto start = std::chrono::steady_clock::now();
        const int result = socket.connectToName("quotes.example", 80);
        const auto waited = std::chrono::steady_clock::now() - start;
        std::exit(result == -1 && waited >= 200ms && waited < 4s ? 0 : 1); // while the search goes on
    };
    int status = -1;
    if (const pid_t child = fork(); child == 0)
        connect();
    else
        waitpid(child, &status, 0);
    ASSERT_TRUE(WIFEXITED(status));
    if (WEXITSTATUS(status) == 2)
        GTEST_SKIP() << "a network of its own is not permitted here";
    EXPECT_EQ(WEXITSTATUS(status), 0);
}

TEST(SocketDeathTest, AnObjectIsConnectedOnce)
{
    Connected by;
    by.socket->closeConnection(); // it keeps its number
    EXPECT_EXIT(by.socket->connectTo("127.0.0.1", 9), testing::ExitedWithCode(255),
                "^Error closing previous connection\\.\n$");
}

} // namespace
