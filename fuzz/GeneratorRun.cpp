#include "fuzz/GeneratorRun.h"

#include "LogGenerator/Osprey/ArrayOutOfBoundsException.h"
#include "LogGenerator/Osprey/GSM/SimInfo.h"
#include "model/SnapshotFile.h"
#include "platform/SystemLog.h"

#include <algorithm>

namespace pelorus::fuzz {

namespace {

/// Has every line formatted.
class Listener : public SystemLogSink {
public:
    explicit Listener(bool listens) : previous(setSystemLogSink(listens ? this : nullptr)) {}
    ~Listener() override { setSystemLogSink(previous); }
    Listener(const Listener&) = delete;
    Listener& operator=(const Listener&) = delete;
    void write(int, std::string_view text) override { length += text.size(); }

private:
    SystemLogSink* previous;
    std::size_t length = 0;
};

bool isSameNode(const PelorusModelNode& a, const PelorusModelNode& b)
{
    return a.displayName() == b.displayName() && (a.value() == nullptr) == (b.value() == nullptr) &&
           (!a.value() || *a.value() == *b.value());
}

bool isSameTree(const PelorusModelNode& a, const PelorusModelNode& b)
{
    if (!isSameNode(a, b))
        return false;
    const PelorusModelNodes* left = a.childNodes();
    const PelorusModelNodes* right = b.childNodes();
    if (!left || !right)
        return left == right;
    return std::equal(left->begin(), left->end(), right->begin(), right->end(),
                      [](const auto& one, const auto& other) { return isSameTree(*one, *other); });
}

} // namespace

GeneratorRun::GeneratorRun(Platform& system, std::string_view identifier, const State& templates,
                           bool listens)
    : platform(system), technology(identifier), logs(listens)
{
    for (const std::string_view key : {"DisplayMaker", "Template"})
        if (const Value* value = templates.find(key))
            state.set(key, *value);
    restart();
}

AcceptedEnd GeneratorRun::receive(std::span<const std::byte> message)
{
    const Listener listener(logs);
    try {
        generator->updateState(state, message);
    } catch (const ArrayOutOfBoundsException&) {
        if (acceptedEnd(technology, message) != AcceptedEnd::arrayOutOfBounds)
            throw;
        return AcceptedEnd::arrayOutOfBounds;
    } catch (const LogCode_0xFF0000::UnknownDataException&) {
        if (acceptedEnd(technology, message) != AcceptedEnd::unknownData)
            throw;
        return AcceptedEnd::unknownData;
    }
    return AcceptedEnd::none;
}

Shown GeneratorRun::refresh()
{
    const Listener listener(logs);
    Shown shown;
    shown.root = PelorusModelNode::makeTreeFromObject(generator->generateLogUsingState(state), shown.paths);
    return shown;
}

void GeneratorRun::restart()
{
    const Listener listener(logs);
    generator = LogGenerator::generatorFromTechnology(platform, technology);
}

Value GeneratorRun::snapshot() const
{
    return snapshotFileContent("2012-05-04 09:30:00 +0000", generator->getSaveContentsFromState(state),
                               "fuzzed");
}

bool isSame(const Shown& a, const Shown& b)
{
    return isSameTree(*a.root, *b.root) && a.paths.size() == b.paths.size() &&
           std::all_of(a.paths.begin(), a.paths.end(), [&b](const auto& entry) {
               const auto other = b.paths.find(entry.first);
               return other != b.paths.end() && isSameNode(*entry.second, *other->second);
           });
}

} // namespace pelorus::fuzz
