#pragma once

#include "LogGenerator/Osprey/Base.h"

#include <exception>

namespace pelorus {

/// What the telephony server tells of the SIM's elementary files, code 0xFF0000: after the header a property
/// list, a dictionary keyed by SIM-file names.
struct LogCode_0xFF0000 {
    /// The payload is no property list. Nothing catches it: it ends the program.
    class UnknownDataException : public std::exception {
    public:
        const char* what() const noexcept override { return "LogCode_0xFF0000::UnknownDataException"; }
    };

    /// Throws UnknownDataException.
    static const Value& files(const LogPacket& data);
};

/// The SIM's elementary files, each as the telephony server sends it. Rows stay until their file is sent
/// again.
class SimInfo : public Base {
public:
    std::string getSectionName() const override { return "SIM Info"; }
    std::vector<LogCode> getLogCodeArray() const override { return {kSimFiles}; }
    void updateWithData(const LogPacket& data, LogCode logCode) override;
};

} // namespace pelorus
