#include "LogGenerator/Osprey/Base.h"

#include "LogGenerator/Osprey/ArrayLock.h"
#include "platform/SystemLog.h"

#include <array>
#include <stdexcept>

namespace pelorus {

namespace {

struct EnergyBand {
    std::uint32_t above;
    std::int16_t decibels;
};

// From the top; a value that is above none of them is shown as 0.
constexpr std::array<EnergyBand, 33> kEnergyBands{{
    {524287, 0},  {417647, -1}, {331808, -2}, {263624, -3}, {209463, -4}, {166441, -5}, {132268, -6},
    {105123, -7}, {83562, -8},  {66435, -9},  {52830, -10}, {42023, -11}, {33440, -12}, {26621, -13},
    {21205, -14}, {16903, -15}, {13486, -16}, {10771, -17}, {8615, -18},  {6902, -19},  {5542, -20},
    {4461, -21},  {3603, -22},  {2921, -23},  {2240, -24},  {1949, -25},  {1607, -26},  {1336, -27},
    {1120, -28},  {949, -29},   {813, -30},   {756, -31},   {705, -31},
}};

} // namespace

void Base::initWithDict(ClassDictionary& classDict, CodeDictionary& codeDict)
{
    classDict[getSectionName()] = this;
    updateLogCodeDict(codeDict);
}

std::string Base::getSectionName() const
{
    throw std::logic_error("Base has no section name");
}

std::vector<LogCode> Base::getLogCodeArray() const
{
    throw std::logic_error("Base has no log codes");
}

void Base::updateWithData(const LogPacket&, LogCode)
{
    throw std::logic_error("Base decodes nothing");
}

void Base::updateSectionRef(const Value& entry)
{
    sectionRef.keyed.bind(entry.sharedDictionary());
    sectionRef.list.bind(entry.sharedArray());
    systemLog(kLogWarning, "%s", getSectionName());
}

void Base::updateLogCodeDict(CodeDictionary& codeDict)
{
    const std::vector<LogCode> codes = getLogCodeArray();
    systemLog(kLogWarning, "Array Count: %d", static_cast<int>(codes.size()));
    for (const LogCode code : codes)
        codeDict[std::to_string(code)].push_back(this);
}

void Base::clearElementsInArray(Array& array)
{
    ArrayLock::lockArray();
    array.elements.clear();
    ArrayLock::unlockArray();
}

void Base::clearElementsInArray(Array& array, std::vector<Value>& removed)
{
    removed.clear();
    ArrayLock::lockArray();
    array.elements.swap(removed);
    ArrayLock::unlockArray();
}

void Base::replaceArray(Array& array, std::vector<Value>& elements)
{
    ArrayLock::lockArray();
    array.elements.swap(elements);
    ArrayLock::unlockArray();
    elements.clear();
}

std::int16_t Base::lookUpECNO(std::uint32_t value)
{
    for (const EnergyBand& band : kEnergyBands)
        if (value > band.above)
            return band.decibels;
    return 0;
}

} // namespace pelorus
