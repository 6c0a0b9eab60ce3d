#include "app/OneLine.h"

#include <QTextDocument>
#include <algorithm>

namespace pelorus {

namespace {

bool breaksLine(QChar character)
{
    switch (character.unicode()) {
    case u'\n':
    case u'\v':
    case u'\f':
    case u'\r':
    case u'\x85': // next line
    case QChar::LineSeparator:
    case QChar::ParagraphSeparator:
        return true;
    default:
        return false;
    }
}

} // namespace

QString onOneLine(QString text)
{
    if (std::any_of(text.cbegin(), text.cend(), breaksLine))
        std::replace_if(text.begin(), text.end(), breaksLine, u' ');
    return text;
}

QString asPlainToolTip(const QString& text)
{
    return Qt::mightBeRichText(text) ? Qt::convertFromPlainText(text) : text;
}

} // namespace pelorus
