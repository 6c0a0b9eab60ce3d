#include "LogGenerator/Osprey/GSM/SimInfo.h"

#include "platform/SystemLog.h"

namespace pelorus {

namespace {

struct SimFile {
    std::string_view key;
    Label row;
};

constexpr SimFile kSimFileRows[] = {
    {"kSimFile_ICCID", "EF-ICCID"},
    {"kSimFile_MSISDN", "EF-MSISDN"},
    {"kSimFile_MBDN", "EF-3GPP MAIL BOX DIALING NUMBER"},
    {"kSimFile_HPPLMN", "EF-HPPLMN SEARCH PERIOD"},
    {"kSimFile_LOCI", "EF-LOCI"},
    {"kSimFile_PSLOCI", "EF-GPRS/PS-LOCI"},
    {"kSimFile_ACC", "EF-ACCESS CONTROL CLASS"},
    {"kSimFile_AD", "EF-ADMINISTRATIVE DATA"},
    {"kSimFile_FPLMN", "EF-FPLMN"},
    {"kSimFile_AHPLMN", "EF-ACTING HPLMN"},
    {"kSimFile_RATMODE", "EF-RAT MODE"},
    {"kSimFile_PNN", "EF-PLMN NETWORK NAME"},
    {"kSimFile_OPL", "EF-OPERATOR PLMN LIST"},
    {"kSimFile_OPLMNAcT", "EF-OPLMNAcT"},
};

} // namespace

const Value& LogCode_0xFF0000::files(const LogPacket& data)
{
    const Value& files = data.propertyList();
    if (!files) {
        systemLog(kLogError, "SIM File dictionary data could not be constructed");
        throw UnknownDataException();
    }
    return files;
}

void SimInfo::updateWithData(const LogPacket& data, LogCode logCode)
{
    systemLog(kLogWarning, "SimInfo");
    if (logCode != kSimFiles)
        return;
    const Dictionary* files = LogCode_0xFF0000::files(data).dictionary();
    if (!files)
        return;
    Dictionary* const entry = keyedEntry();
    for (const SimFile& file : kSimFileRows)
        if (const Value* value = files->find(file.key))
            entry->set(file.row, *value);
}

} // namespace pelorus
