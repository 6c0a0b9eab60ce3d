#include "platform/linux/PortListener.h"

#include "tests/linux/EventLoop.h"
#include "tests/linux/PortFixture.h"

#include <QDir>
#include <algorithm>
#include <ctime>
#include <fcntl.h>
#include <sys/resource.h>
#include <sys/socket.h>
#include <sys/stat.h>
#include <sys/un.h>
#include <sys/wait.h>

namespace pelorus {

using namespace test;
using Outcome = PortListener::Outcome;

namespace {

class PortListenerTest : public PortFixture {
protected:
    Outcome listen(PortListener& listener, const std::string& name = "port")
    {
        return listener.listen(*PortDirectory::open(why), name, why);
    }
    Outcome adopt(PortListener& listener, FileDescriptor socket)
    {
        return listener.adopt(std::move(socket), *PortDirectory::open(why), "port", why);
    }
    /// A bound socket, as the service manager makes one.
    FileDescriptor socketAt(const std::string& name) const
    {
        FileDescriptor socket(::socket(AF_UNIX, SOCK_STREAM | SOCK_CLOEXEC, 0));
        sockaddr_un address = {};
        address.sun_family = AF_UNIX;
        path(name).copy(address.sun_path, sizeof address.sun_path - 1);
        EXPECT_EQ(::bind(socket.get(), reinterpret_cast<const sockaddr*>(&address), sizeof address), 0);
        return socket;
    }
    bool exists(const std::string& name) const { return ::access(path(name).c_str(), F_OK) == 0; }

    std::string why;
};

} // namespace

TEST_F(PortListenerTest, SocketIsTheUsersAloneAndGoesWithTheListener)
{
    const mode_t mask = ::umask(0);
    PortListener listener;
    EXPECT_EQ(listen(listener), Outcome::listening);
    ::umask(mask);
    EXPECT_EQ(listener.path(), path("port"));
    struct stat status = {};
    ASSERT_EQ(::lstat(path("port").c_str(), &status), 0);
    EXPECT_TRUE(S_ISSOCK(status.st_mode));
    EXPECT_EQ(status.st_mode & 07777u, 0600u);
    listener.close();
    EXPECT_FALSE(exists("port"));
    EXPECT_FALSE(listener.isListening());
    EXPECT_TRUE(QDir(directory.path())
                    .isEmpty(QDir::AllEntries | QDir::Hidden | QDir::System | QDir::NoDotAndDotDot));
}

TEST_F(PortListenerTest, LivePortAlreadyExists)
{
    PortListener first;
    PortListener second;
    ASSERT_EQ(listen(first), Outcome::listening);
    EXPECT_EQ(listen(second), Outcome::alreadyExisted);
    EXPECT_EQ(why, path("port") + ": somebody listens there already");
    second.close();
    EXPECT_TRUE(RawPeer::connectTo(path("port")).isConnected()) << "the first is as it was";
}

TEST_F(PortListenerTest, StaleSocketFileIsReplaced)
{
    {
        const FileDescriptor socket(::socket(AF_UNIX, SOCK_STREAM, 0));
        sockaddr_un address = {AF_UNIX, {}};
        path("port").copy(address.sun_path, sizeof address.sun_path - 1);
        ASSERT_EQ(::bind(socket.get(), reinterpret_cast<sockaddr*>(&address), sizeof address), 0);
    }
    ASSERT_TRUE(exists("port"));
    ASSERT_FALSE(RawPeer::connectTo(path("port")).isConnected());
    PortListener listener;
    EXPECT_EQ(listen(listener), Outcome::listening) << why;
    EXPECT_TRUE(RawPeer::connectTo(path("port")).isConnected());
}

TEST_F(PortListenerTest, WhatIsNoSocketIsLeftAlone)
{
    {
        const FileDescriptor file(::open(path("port").c_str(), O_CREAT | O_WRONLY, 0600));
    }
    PortListener listener;
    EXPECT_EQ(listen(listener), Outcome::failed);
    EXPECT_EQ(why, path("port") + ": is in the way and not a socket");
    EXPECT_TRUE(exists("port"));
}

TEST_F(PortListenerTest, RemovesNobodyElsesSocket)
{
    PortListener first;
    ASSERT_EQ(listen(first), Outcome::listening);
    ::unlink(path("port").c_str());
    PortListener second;
    ASSERT_EQ(listen(second), Outcome::listening);
    first.close();
    EXPECT_TRUE(exists("port"));
    EXPECT_TRUE(RawPeer::connectTo(path("port")).isConnected());
}

TEST_F(PortListenerTest, OneOfManyProcessesThatStartAtOnceGetsTheName)
{
    int start[2];
    int outcomes[2];
    int finish[2];
    ASSERT_EQ(::pipe(start) | ::pipe(outcomes) | ::pipe(finish), 0);
    std::vector<pid_t> children;
    for (int count = 0; count < 8; ++count) {
        children.push_back(::fork());
        if (children.back() != 0)
            continue;
        ::close(start[1]);
        ::close(finish[1]);
        char byte = 0;
        bool ok = ::read(start[0], &byte, 1) == 0; // when the parent closes
        PortListener listener;
        const Outcome outcome = listen(listener);
        const char letter = outcome == Outcome::listening        ? 'L'
                            : outcome == Outcome::alreadyExisted ? 'A'
                                                                 : 'F';
        ok = ok && ::write(outcomes[1], &letter, 1) == 1 && ::read(finish[0], &byte, 1) == 0;
        ::_exit(ok ? 0 : 1);
    }
    ::close(start[1]);
    std::string letters(8, ' ');
    for (char& letter : letters)
        ASSERT_EQ(::read(outcomes[0], &letter, 1), 1);
    std::ranges::sort(letters);
    EXPECT_EQ(letters, "AAAAAAAL");
    ::close(finish[1]);
    for (const pid_t child : children)
        ::waitpid(child, nullptr, 0);
    for (const int descriptor : {start[0], outcomes[0], outcomes[1], finish[0]})
        ::close(descriptor);
}

TEST_F(PortListenerTest, ConnectionsThatCameEarlyAreHandedOverToo)
{
    PortListener listener;
    ASSERT_EQ(listen(listener), Outcome::listening);
    const RawPeer early = RawPeer::connectTo(path("port"));
    spinOnce();
    std::vector<std::shared_ptr<PortConnection>> connections;
    listener.acceptConnections([&](auto connection) { connections.push_back(std::move(connection)); });
    EXPECT_TRUE(spinUntil([&] { return connections.size() == 1; }));
    const RawPeer late = RawPeer::connectTo(path("port"));
    EXPECT_TRUE(spinUntil([&] { return connections.size() == 2; }));
}

TEST_F(PortListenerTest, ClosesInsideItsOwnCallback)
{
    PortListener listener;
    ASSERT_EQ(listen(listener), Outcome::listening);
    std::shared_ptr<PortConnection> kept;
    listener.acceptConnections([&](auto connection) {
        kept = std::move(connection);
        listener.close();
    });
    const RawPeer peer = RawPeer::connectTo(path("port"));
    EXPECT_TRUE(spinUntil([&] { return kept != nullptr; }));
    EXPECT_FALSE(listener.isListening());
    spinOnce();
    EXPECT_TRUE(kept->isOpen());
}

TEST_F(PortListenerTest, AdoptsASocketAndLeavesItsFile)
{
    FileDescriptor socket = socketAt("port");
    ASSERT_EQ(::listen(socket.get(), 1), 0);
    const RawPeer early = RawPeer::connectTo(path("port"));
    PortListener listener;
    ASSERT_EQ(adopt(listener, std::move(socket)), Outcome::listening) << why;
    EXPECT_EQ(listener.path(), path("port"));
    std::vector<std::shared_ptr<PortConnection>> connections;
    listener.acceptConnections([&](auto connection) { connections.push_back(std::move(connection)); });
    EXPECT_TRUE(spinUntil([&] { return connections.size() == 1; }));
    listener.close();
    EXPECT_FALSE(listener.isListening());
    EXPECT_TRUE(exists("port")) << "who made it may listen on";
}

TEST_F(PortListenerTest, AdoptsNoSocketThatListensElsewhereOrNotAtAll)
{
    PortListener listener;
    EXPECT_EQ(adopt(listener, socketAt("deaf")), Outcome::failed);
    EXPECT_EQ(why, "the socket that was passed is not a Unix-domain stream socket that listens");
    EXPECT_EQ(adopt(listener, FileDescriptor(::open("/dev/null", O_RDONLY))), Outcome::failed);
    FileDescriptor elsewhere = socketAt("elsewhere");
    ASSERT_EQ(::listen(elsewhere.get(), 1), 0);
    EXPECT_EQ(adopt(listener, std::move(elsewhere)), Outcome::failed);
    EXPECT_EQ(why, path("port") + ": the socket that was passed listens at " + path("elsewhere"));
    EXPECT_FALSE(listener.isListening());
}

TEST_F(PortListenerTest, WaitsWithoutHasteWhenTheProcessHasNoDescriptorsLeft)
{
    PortListener listener;
    ASSERT_EQ(listen(listener), Outcome::listening);
    const RawPeer peer = RawPeer::connectTo(path("port"));
    rlimit limit = {};
    ASSERT_EQ(::getrlimit(RLIMIT_NOFILE, &limit), 0);
    const rlimit none = {.rlim_cur = 3, .rlim_max = limit.rlim_max};
    std::vector<std::shared_ptr<PortConnection>> connections;
    listener.acceptConnections([&](auto connection) { connections.push_back(std::move(connection)); });
    ASSERT_EQ(::setrlimit(RLIMIT_NOFILE, &none), 0);
    const std::clock_t before = std::clock();
    bool over = false;
    QTimer::singleShot(250, QCoreApplication::instance(), [&over] { over = true; });
    while (!over)
        QCoreApplication::processEvents(QEventLoop::WaitForMoreEvents);
    const double busy = static_cast<double>(std::clock() - before) / CLOCKS_PER_SEC;
    ::setrlimit(RLIMIT_NOFILE, &limit);
    EXPECT_LT(busy, 0.1);
    EXPECT_EQ(connections.size(), 0U);
    EXPECT_TRUE(spinUntil([&] { return connections.size() == 1; }));
}

TEST_F(PortListenerTest, PeerOfAnotherUserIsDropped)
{
    if (::geteuid() != 0)
        GTEST_SKIP() << "only root can be somebody else";
    PortListener listener;
    ASSERT_EQ(listen(listener), Outcome::listening);
    int accepted = 0;
    std::shared_ptr<PortConnection> kept;
    listener.acceptConnections([&](auto connection) {
        kept = std::move(connection);
        ++accepted;
    });
    // The modes keep others out already; without them the peer's user still does.
    ::chmod(directory.path().toStdString().c_str(), 0755);
    ::chmod(path("port").c_str(), 0666);
    const pid_t child = ::fork();
    if (child == 0) {
        if (::setuid(65534) != 0)
            ::_exit(1);
        const RawPeer peer = RawPeer::connectTo(path("port"));
        if (!peer.isConnected())
            ::_exit(2);
        ::_exit(peer.receive(1).empty() ? 0 : 3); // returns when the listener drops it
    }
    int status = 0;
    EXPECT_TRUE(spinUntil([&] { return ::waitpid(child, &status, WNOHANG) == child; }));
    EXPECT_EQ(status, 0);
    EXPECT_EQ(accepted, 0);
    const RawPeer own = RawPeer::connectTo(path("port"));
    EXPECT_TRUE(spinUntil([&] { return accepted == 1; }));
}

} // namespace pelorus
