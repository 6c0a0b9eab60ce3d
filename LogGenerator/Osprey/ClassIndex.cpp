#include "LogGenerator/Osprey/ClassIndex.h"

#include "platform/Console.h"
#include "platform/SystemLog.h"

namespace pelorus {

ClassIndex::~ClassIndex()
{
    consoleLine("Deallocing ClassIndex");
}

Base* ClassIndex::getClass(const std::string& sectionName) const
{
    const auto found = classDict.find(sectionName);
    return found == classDict.end() ? nullptr : found->second;
}

void ClassIndex::settle()
{
    for (Base* section : sections)
        section->settle();
}

void ClassIndex::status() const
{
    // The class dictionary is a dictionary and no string, always: only the lines themselves tell something.
    systemLog(kLogWarning, "Dictionary = %d", 1);
    systemLog(kLogWarning, "String = %d", 0);
}

} // namespace pelorus
