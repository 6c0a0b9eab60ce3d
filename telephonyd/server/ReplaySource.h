#pragma once

#include "platform/recording/Recording.h"
#include "telephonyd/server/MessageSource.h"
#include "telephonyd/server/Report.h"

namespace pelorus {

/// The messages of a recording. Of a broken one those before the break, then a line that says so.
class ReplaySource : public MessageSource {
public:
    static SourceFactory factory(std::string path, Report report);

    ReplaySource(std::string path, std::unique_ptr<RecordingReader> opened, Report report);

    bool next(SourceMessage& message) override;
    /// Reads the file anew: recordings may be large, and are never held whole here.
    bool rewind() override;

private:
    std::string path;
    std::unique_ptr<RecordingReader> reader;
    Report report;
    bool brokenReported = false;
};

} // namespace pelorus
