#include "LogGenerator/Osprey/GSM/OSP_GSMClassIndex.h"

#include <gmock/gmock.h>

namespace pelorus::test {
namespace {

using testing::ElementsAre;
using testing::UnorderedElementsAre;

std::vector<std::string> subscribers(const OSP_GSMClassIndex& index, LogCode code)
{
    std::vector<std::string> names;
    if (const auto* sections = index.getSubscribers(code))
        for (const Base* section : *sections)
            names.push_back(section->getSectionName());
    return names;
}

struct Subscription {
    const char* section;
    std::vector<LogCode> codes;

    friend std::ostream& operator<<(std::ostream& out, const Subscription& subscription)
    {
        return out << subscription.section;
    }
};

class SubscriptionOf : public testing::TestWithParam<Subscription> {};

TEST_P(SubscriptionOf, IsRegisteredUnderItsNameInOrder)
{
    const OSP_GSMClassIndex index;
    const Base* section = index.getClass(GetParam().section);
    ASSERT_TRUE(section);
    EXPECT_EQ(section->getSectionName(), GetParam().section);
    EXPECT_EQ(section->getLogCodeArray(), GetParam().codes);
}

INSTANTIATE_TEST_SUITE_P(
    EverySection, SubscriptionOf,
    testing::Values(
        Subscription{"Active Set", {0x417A}}, Subscription{"Coding Scheme", {}},
        Subscription{"GPRS Information", {0x51F5, 0x7135, 0x51F6, 0x51FB, 0x51FD, 0x51F4, 0x5137}},
        Subscription{"GSM Serving Cell", {0x5134, 0x5137, 0x5076, 0xFF0001}},
        Subscription{"Mobile Allocation", {0x51F8}},
        Subscription{"Neighboring Cells", {0x5137, 0x51FF, 0xFF0001}},
        Subscription{"PDP Context Info", {0xFF0002}}, Subscription{"Process PS", {0x7130, 0x7132}},
        Subscription{"UMTS RR Measurement", {}}, Subscription{"Cell Change Counters", {}},
        Subscription{"Detected Set", {0x417A}}, Subscription{"GSM Set", {0x4005}},
        Subscription{"Non-Ranked GSM Set", {}}, Subscription{"Process CO", {0x7131, 0x7132}},
        Subscription{"Serving PLMN", {0x7135, 0x7132, 0xFF0001}},
        Subscription{"UMTS Set", {0x4005, 0xFF0001}}, Subscription{"Equivalent PLMN List", {0x7150}},
        Subscription{"GSM RR Info", {0x512C, 0x5137, 0x5072, 0x51F6}},
        Subscription{"Monitored Set", {0x417A}}, Subscription{"Non-Ranked UMTS Set", {}},
        Subscription{"Process CS", {0x7131, 0x7132}},
        Subscription{"UMTS RR Info", {0x4125, 0x4031, 0x4127, 0x4157, 0xFF0001}},
        Subscription{"BLER", {0x4116}}, Subscription{"Virtual Active Set", {0x417A}},
        Subscription{"SIM Info", {0xFF0000}}, Subscription{"HSDPA Info", {0x4221}}));

TEST(OSP_GSMClassIndex, CallsTheSubscribersOfACodeInCreationOrder)
{
    const OSP_GSMClassIndex index;
    EXPECT_THAT(subscribers(index, 0x5137),
                ElementsAre("GPRS Information", "GSM Serving Cell", "Neighboring Cells", "GSM RR Info"));
    EXPECT_THAT(subscribers(index, 0xFF0001), ElementsAre("GSM Serving Cell", "Neighboring Cells",
                                                          "Serving PLMN", "UMTS Set", "UMTS RR Info"));
    EXPECT_THAT(subscribers(index, 0x417A),
                ElementsAre("Active Set", "Detected Set", "Monitored Set", "Virtual Active Set"));
    EXPECT_THAT(subscribers(index, 0x7132),
                ElementsAre("Process PS", "Process CO", "Serving PLMN", "Process CS"));
    EXPECT_THAT(subscribers(index, 0x7135), ElementsAre("GPRS Information", "Serving PLMN"));
    EXPECT_THAT(subscribers(index, 0x7131), ElementsAre("Process CO", "Process CS"));
    EXPECT_THAT(subscribers(index, 0x51F6), ElementsAre("GPRS Information", "GSM RR Info"));
    EXPECT_THAT(subscribers(index, 0x4005), ElementsAre("GSM Set", "UMTS Set"));
}

TEST(OSP_GSMClassIndex, HasNobodyForAForeignCode)
{
    const OSP_GSMClassIndex index;
    EXPECT_EQ(index.getSubscribers(0xB179), nullptr);
    EXPECT_EQ(index.getSubscribers(0x10137), nullptr);
    EXPECT_EQ(index.getClass("Serving Cell Info"), nullptr);
    EXPECT_EQ(index.getClass("active set"), nullptr);
}

TEST(OSP_GSMClassIndex, AsksForEveryCodeOnce)
{
    const OSP_GSMClassIndex index;
    EXPECT_THAT(index.getAllLogCodes(),
                UnorderedElementsAre("16389",    // 0x4005
                                     "16433",    // 0x4031
                                     "16662",    // 0x4116
                                     "16677",    // 0x4125
                                     "16679",    // 0x4127
                                     "16727",    // 0x4157
                                     "16762",    // 0x417A
                                     "16929",    // 0x4221
                                     "20594",    // 0x5072
                                     "20598",    // 0x5076
                                     "20780",    // 0x512C
                                     "20788",    // 0x5134
                                     "20791",    // 0x5137
                                     "20980",    // 0x51F4
                                     "20981",    // 0x51F5
                                     "20982",    // 0x51F6
                                     "20984",    // 0x51F8
                                     "20987",    // 0x51FB
                                     "20989",    // 0x51FD
                                     "20991",    // 0x51FF
                                     "28976",    // 0x7130
                                     "28977",    // 0x7131
                                     "28978",    // 0x7132
                                     "28981",    // 0x7135
                                     "29008",    // 0x7150
                                     "16711680", // 0xFF0000
                                     "16711681", "16711682"));
}

} // namespace
} // namespace pelorus::test
