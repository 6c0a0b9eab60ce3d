#pragma once

#include "LogGenerator/Osprey/OSPLogGenerator2.h"

#include <fmt/format.h>

namespace pelorus::test {

/// A section that keeps what it receives, and shows the code of the last packet in its row "Code".
class Probe : public Base {
public:
    void updateWithData(const LogPacket& data, LogCode logCode) override
    {
        const auto bytes = data.from(0);
        packets.push_back({logCode, {bytes.begin(), bytes.end()}});
        keyedEntry()->set(Label("Code"), fmt::format("{:#x}", logCode));
        if (throws)
            throw ArrayOutOfBoundsException();
    }

    struct Packet {
        LogCode code;
        Bytes bytes;
    };
    std::vector<Packet> packets;
    bool throws = false;
};

class FirstProbe : public Probe {
public:
    std::string getSectionName() const override { return "First"; }
    std::vector<LogCode> getLogCodeArray() const override { return {0x1234, 0xFF0001, 0x0001}; }
};

class SecondProbe : public Probe {
public:
    std::string getSectionName() const override { return "Second"; }
    std::vector<LogCode> getLogCodeArray() const override { return {0x1234}; }
};

class ProbeIndex : public ClassIndex {
public:
    std::unique_ptr<FirstProbe> first = create<FirstProbe>();
    std::unique_ptr<SecondProbe> second = create<SecondProbe>();
};

/// Subscribes to what the telephony server itself sends, and to nothing else.
class InternalProbe : public Probe {
public:
    std::string getSectionName() const override { return "Internal"; }
    std::vector<LogCode> getLogCodeArray() const override { return {0xFF0002}; }
};

class InternalIndex : public ClassIndex {
    std::unique_ptr<InternalProbe> internal = create<InternalProbe>();
};

/// A generator whose sections are probes; its template is the resource "Probe".
class ProbeGenerator : public OSPLogGenerator2 {
public:
    explicit ProbeGenerator(Platform& system, std::shared_ptr<ClassIndex> index) : OSPLogGenerator2(system)
    {
        initWithPListName("Probe", std::move(index));
    }
};

/// A generator that was never given an index.
class UninitialisedGenerator : public OSPLogGenerator2 {
public:
    explicit UninitialisedGenerator(Platform& system) : OSPLogGenerator2(system) {}
};

} // namespace pelorus::test
