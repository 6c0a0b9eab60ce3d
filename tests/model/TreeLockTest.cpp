#include "LogGenerator/Osprey/ArrayLock.h"
#include "model/PelorusModelNode.h"

#include <gtest/gtest.h>
#include <thread>

namespace pelorus::test {
namespace {

/// Builds a tree in a thread of its own and tells whether the section lock was free afterwards. What is still
/// held is then given back: the depth counter is 8 bits wide, so 256 calls release one more level.
bool lockIsFreeAfter(const Value& display, int levelsKept)
{
    bool isFree = false;
    std::thread([&] {
        PathDictionary paths;
        PelorusModelNode::makeTreeFromObject(display, paths);
        isFree = ArrayLock::isFreeForOthers();
        for (int call = 0; call < 256 * levelsKept; ++call)
            ArrayLock::unlockArray();
    }).join();
    EXPECT_TRUE(ArrayLock::isFreeForOthers());
    return isFree;
}

Value nestedArrays(int depth)
{
    Value display = "x";
    for (int level = 0; level < depth; ++level)
        display = makeArray({display});
    return display;
}

TEST(TreeLock, IsFreeAfterArraysSideBySide)
{
    EXPECT_TRUE(lockIsFreeAfter(makeDictionary({{"a", nestedArrays(1)}, {"b", nestedArrays(1)}}), 0));
}

TEST(TreeLock, IsNotTakenWithoutAnArray)
{
    EXPECT_TRUE(lockIsFreeAfter(makeDictionary({{"a", makeDictionary()}}), 0));
}

// Only the outermost unlock releases the lock, and only once: meant.
TEST(TreeLock, StaysHeldAfterNestedArrays)
{
    EXPECT_FALSE(lockIsFreeAfter(nestedArrays(2), 1));
    EXPECT_FALSE(lockIsFreeAfter(makeArray({makeDictionary({{"in", nestedArrays(2)}})}), 2));
}

TEST(TreeLock, CounterThatWrapsDoesNoHarm)
{
    EXPECT_FALSE(lockIsFreeAfter(nestedArrays(256), 255));
}

} // namespace
} // namespace pelorus::test
