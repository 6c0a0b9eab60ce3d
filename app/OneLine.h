#pragma once

#include <QString>

namespace pelorus {

/// The text with a blank for every character that would break its line. Names and values come from outside.
QString onOneLine(QString text);

/// For a tool tip, which takes what looks like markup for markup.
QString asPlainToolTip(const QString& text);

} // namespace pelorus
