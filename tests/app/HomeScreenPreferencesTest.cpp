#include "app/HomeScreenPreferences.h"

#include <QSettings>
#include <gtest/gtest.h>

namespace pelorus::test {
namespace {

TEST(HomeScreenPreferences, AreKeptWithoutASessionBus)
{
    LinuxHomeScreenPreferences preferences;
    preferences.setBoolean("HBShowGSMRSSI", true);
    EXPECT_EQ(QSettings("io.pelorus", "HomeScreen").value("HBShowGSMRSSI").toString(), "true");
    preferences.setBoolean("HBShowGSMRSSI", false);
    EXPECT_EQ(QSettings("io.pelorus", "HomeScreen").value("HBShowGSMRSSI").toString(), "false");
}

} // namespace
} // namespace pelorus::test
