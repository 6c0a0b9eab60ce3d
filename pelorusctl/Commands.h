#pragma once

#include <optional>
#include <string>

namespace pelorus {

struct DecodeOptions {
    std::string technology;
    std::string recording;
    bool json = false;
    std::optional<double> everySeconds; // above zero
    std::string resources;              // empty: the program's own
    std::string systemLog;              // empty: nowhere
    std::string save;                   // empty: not saved
    std::string description;
};

struct SnapshotOptions {
    std::string snapshot;
    bool json = false;
    std::string extractDlf; // empty: not extracted
};

struct StartCommandOptions {
    std::string technology;
    std::string resources;
};

struct LiveOptions {
    bool json = false;
    std::optional<int> count; // above zero
};

// The commands; each returns the program's exit status. They need a QCoreApplication.
int decode(const DecodeOptions& options);
int snapshot(const SnapshotOptions& options);
int startCommand(const StartCommandOptions& options);
int live(const LiveOptions& options);

} // namespace pelorus
