#pragma once

#include <QProcess>
#include <QTemporaryDir>

namespace pelorus::test {

/// A message bus of the test's own.
class PrivateBus {
public:
    PrivateBus() = default;
    ~PrivateBus();

    void start();
    void stop();
    /// The same before, between and after.
    QString address() const { return "unix:path=" + directory.filePath("bus"); }

private:
    QTemporaryDir directory;
    QProcess daemon;
};

} // namespace pelorus::test
