#include "LogGenerator/Osprey/ArrayLock.h"

#include <gtest/gtest.h>
#include <thread>

namespace pelorus::test {
namespace {

TEST(ArrayLock, IsFreeAfterOneLockAndOneUnlock)
{
    ArrayLock::lockArray();
    EXPECT_FALSE(ArrayLock::isFreeForOthers());
    ArrayLock::unlockArray();
    EXPECT_TRUE(ArrayLock::isFreeForOthers());
}

// Not balanced, and meant so: what the second lock took is not given back.
TEST(ArrayLock, StaysHeldOnceByTheThreadThatNestedIt)
{
    std::thread([] {
        ArrayLock::lockArray();
        ArrayLock::lockArray();
        ArrayLock::unlockArray();
        EXPECT_FALSE(ArrayLock::isFreeForOthers());
        ArrayLock::unlockArray();
        EXPECT_FALSE(ArrayLock::isFreeForOthers());

        ArrayLock::lockArray();
        ArrayLock::unlockArray();
        EXPECT_FALSE(ArrayLock::isFreeForOthers());

        // The depth has 8 bits: only after 256 more it is 0 again, and the one lock that is left goes.
        for (int unlock = 0; unlock < 255; ++unlock)
            ArrayLock::unlockArray();
        EXPECT_FALSE(ArrayLock::isFreeForOthers());
        ArrayLock::unlockArray();
        EXPECT_TRUE(ArrayLock::isFreeForOthers());
    }).join();
}

} // namespace
} // namespace pelorus::test
