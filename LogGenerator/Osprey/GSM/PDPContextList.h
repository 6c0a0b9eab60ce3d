#pragma once

#include "LogGenerator/Osprey/Base.h"

namespace pelorus {

/// The packet data contexts, code 0xFF0002: after the header a property list, an array whose elements are the
/// rows of one context each and are shown as the telephony server sends them.
class PDPContextList : public Base {
public:
    std::string getSectionName() const override { return "PDP Context Info"; }
    std::vector<LogCode> getLogCodeArray() const override { return {kPDPContexts}; }
    void updateWithData(const LogPacket& data, LogCode logCode) override;
};

} // namespace pelorus
