#pragma once

#include <gtest/gtest.h>
#include <map>
#include <set>
#include <utility>

namespace pelorus::test {

/// Which states of a layer follow which.
class StateHistory {
public:
    void enter(int state)
    {
        if (current >= 0)
            changes.insert({current, state});
        else
            first = state;
        current = state;
    }
    bool has(int from, int to) const { return changes.contains({from, to}); }
    /// Every change is one of those allowed.
    void expectOnly(int firstState, const std::map<int, std::set<int>>& allowed) const
    {
        EXPECT_EQ(first, firstState);
        for (const auto& [from, to] : changes)
            EXPECT_TRUE(allowed.contains(from) && allowed.at(from).contains(to))
                << "state " << to << " after " << from;
    }

private:
    int first = -1;
    int current = -1;
    std::set<std::pair<int, int>> changes;
};

} // namespace pelorus::test
