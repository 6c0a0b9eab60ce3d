#pragma once

#include "platform/linux/FileDescriptor.h"

#include <QTemporaryDir>
#include <cstdint>
#include <cstdlib>
#include <functional>
#include <gtest/gtest.h>
#include <string>
#include <string_view>
#include <thread>

namespace pelorus::test {

/// Sets a variable of the environment, and back.
class EnvironmentVariable {
public:
    EnvironmentVariable(std::string variable, const char* value);
    ~EnvironmentVariable() { set(had ? before.c_str() : nullptr); }

private:
    void set(const char* value) const { value ? ::setenv(name.c_str(), value, 1) : ::unsetenv(name.c_str()); }

    std::string name;
    bool had;
    std::string before;
};

/// A frame as it stands on the wire.
std::string wireFrame(std::uint32_t length, std::int32_t id, std::uint32_t kind, std::uint32_t sequence,
                      std::string_view payload = {});
std::string oneWay(std::string_view payload, std::int32_t id = 0);

/// One end of a connection without any of the code under test. All calls block.
class RawPeer {
public:
    RawPeer() = default;
    explicit RawPeer(int descriptor);
    static RawPeer connectTo(const std::string& path);

    bool isConnected() const { return bool(socket); }
    int descriptor() const { return socket.get(); }
    bool send(std::string_view bytes) const;
    /// What arrives until `length` bytes are there, or the other end closes.
    std::string receive(std::size_t length) const;
    void close() { socket = FileDescriptor(); }

private:
    FileDescriptor socket;
};

/// Listens at a path and gives the first connection to a function, on a thread of its own.
class RawServer {
public:
    RawServer(const std::string& path, std::function<void(RawPeer&)> serve);
    ~RawServer();

private:
    FileDescriptor listening;
    std::thread thread;
};

/// A port directory of its own for each test.
class PortFixture : public testing::Test {
protected:
    PortFixture() : variable("PELORUS_PORT_DIRECTORY", directory.path().toStdString().c_str()) {}
    std::string path(const std::string& name) const { return (directory.path() + '/').toStdString() + name; }

    QTemporaryDir directory;
    EnvironmentVariable variable;
};

} // namespace pelorus::test
