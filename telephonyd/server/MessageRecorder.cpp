#include "telephonyd/server/MessageRecorder.h"

#include <cerrno>
#include <cstring>
#include <fmt/format.h>

namespace pelorus {

namespace {

constexpr std::chrono::milliseconds kFlushInterval{500};

} // namespace

std::unique_ptr<MessageRecorder> MessageRecorder::create(const std::string& path, Report report,
                                                         std::string& why)
{
    auto writer = RecordingWriter::create(path, why);
    if (!writer) {
        why = fmt::format("{}: {}", path, why);
        return nullptr;
    }
    return std::unique_ptr<MessageRecorder>(new MessageRecorder(path, std::move(writer), std::move(report)));
}

MessageRecorder::MessageRecorder(std::string path, std::unique_ptr<RecordingWriter> writer, Report report)
    : path(std::move(path)), writer(std::move(writer)), report(std::move(report))
{
    unflushed = true; // the file's header
    QObject::connect(&flushTimer, &QTimer::timeout, &flushTimer, [this] { flush(); });
    flushTimer.start(kFlushInterval);
}

MessageRecorder::~MessageRecorder()
{
    flush();
}

void MessageRecorder::record(std::span<const std::byte> message)
{
    if (!writer)
        return;
    if (message.size() > RecordingWriter::longestMessage) {
        report(fmt::format("{}: a message of {} bytes is not recorded, {} are the most", path, message.size(),
                           RecordingWriter::longestMessage));
        return;
    }
    unflushed = true;
    if (!writer->write({std::chrono::system_clock::now(), message}))
        giveUp();
}

void MessageRecorder::flush()
{
    if (writer && unflushed && !writer->flush())
        giveUp();
    unflushed = false;
}

bool MessageRecorder::finish()
{
    flush();
    return !gaveUp;
}

void MessageRecorder::giveUp()
{
    report(fmt::format("{}: cannot be written any more, the recording ends here: {}", path,
                       std::strerror(errno)));
    gaveUp = true;
    writer.reset();
    flushTimer.stop();
}

} // namespace pelorus
