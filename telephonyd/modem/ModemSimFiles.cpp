#include "telephonyd/modem/ModemSimFiles.h"

#include "telephonyd/modem/AccessTechnology.h"
#include "telephonyd/modem/PlainValue.h"

namespace pelorus {

namespace {

std::string ownNumbers(const QVariantMap& modem)
{
    std::string text;
    for (const QVariant& number : listAt(modem, "OwnNumbers"))
        if (!number.toString().isEmpty())
            text += (text.empty() ? "" : ", ") + number.toString().toStdString();
    return text;
}

std::string allowedModes(const QVariantMap& modem)
{
    const QVariantList allowedAndPreferred = listAt(modem, "CurrentModes");
    return allowedAndPreferred.isEmpty() ? std::string() : modesText(allowedAndPreferred.front().toUInt());
}

} // namespace

Value simFilesOf(const QVariantMap& sim, const QVariantMap& modem)
{
    return makeDictionary({
        {"kSimFile_ICCID", textAt(sim, "SimIdentifier")},
        {"kSimFile_MSISDN", ownNumbers(modem)},
        {"kSimFile_AHPLMN", textAt(sim, "OperatorIdentifier")},
        {"kSimFile_RATMODE", allowedModes(modem)},
        {"kSimFile_PNN", textAt(sim, "OperatorName")},
    });
}

} // namespace pelorus
