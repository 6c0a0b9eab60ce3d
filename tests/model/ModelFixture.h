#pragma once

#include "model/PelorusModel.h"
#include "platform/PropertyList.h"
#include "platform/scripted/ScriptedPlatform.h"
#include "tests/support/RecordingLog.h"
#include "tests/support/Texts.h"

#include <gmock/gmock.h>

namespace pelorus::test {

using namespace std::chrono_literals;

/// What the model told the one who shows it.
class CountingObserver : public PelorusModelObserver {
public:
    void updateViewControllerFromModel() override { ++updates; }
    void connectionChanged() override { ++connectionChanges; }

    int updates = 0;
    int connectionChanges = 0;
};

/// A model on a scripted machine whose telephony server answers "Osprey LTE", and whose LTE template has the
/// SIM files and nothing else.
class ModelFixture : public testing::Test {
protected:
    ModelFixture()
    {
        platform.setNow(std::chrono::sys_days{2012y / 5 / 4} + 9h + 30min);
        platform.addResource("LTE", propertyListText("<dict><key>SIM Info</key><dict>"
                                                     "<key>EF-ICCID</key><string>-</string></dict></dict>"));
        platform.answerTechnology("Osprey LTE");
    }

    /// The lines of error priority since the last call, with "%p" in place of addresses.
    std::vector<std::string> errors()
    {
        std::vector<std::string> lines;
        for (const std::string& line : log.take())
            if (line.starts_with("<3>"))
                lines.push_back(withoutAddresses(line.substr(3)));
        return lines;
    }
    void startWith(std::string_view technology)
    {
        platform.answerTechnology(technology);
        model->startMonitor();
        log.take();
    }
    bool started() const { return platform.repeatingTimers() == 1; }
    std::string shownAt(const std::string& path)
    {
        const auto node = model->nodeAtPath(path);
        return node && node->value() ? *node->value() : "(none)";
    }
    /// A message with SIM files: log type 0xFF, code 0.
    static Bytes simFiles(std::string_view iccid)
    {
        Bytes message(13);
        message[0] = std::byte{0xFF};
        const auto list = serializePropertyList(makeDictionary({{"kSimFile_ICCID", iccid}})).value();
        message.insert(message.end(), list.begin(), list.end());
        return message;
    }

    RecordingLog log;
    ScriptedPlatform platform;
    CountingObserver observer;
    std::unique_ptr<PelorusModel> model = std::make_unique<PelorusModel>(platform, observer);
};

} // namespace pelorus::test
