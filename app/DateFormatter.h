#pragma once

#include <QDateTime>
#include <chrono>
#include <string>

namespace pelorus {

/// Writes moments in local time, by a format of letters in which quoted text stands for itself.
class DateFormatter {
public:
    explicit DateFormatter(QString dateFormat) : format(std::move(dateFormat)) {}
    std::string stringFromDate(std::chrono::system_clock::time_point date) const
    {
        const auto seconds = std::chrono::floor<std::chrono::seconds>(date).time_since_epoch().count();
        return QDateTime::fromSecsSinceEpoch(seconds).toString(format).toStdString();
    }

private:
    QString format;
};

} // namespace pelorus
