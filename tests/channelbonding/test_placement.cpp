#include "Qvz_MGTRCBPlacement.h"

#include <gtest/gtest.h>

#include <set>
#include <utility>

namespace {
const char* const kOneHop = "SLAVE_1_HOP";
const char* const kTwoHops = "SLAVE_2_HOPS";
} // namespace

TEST(Placement, TwentyOnTopAndBottom) {
    const int primary[] = {4, 6, 3, 7, 2, 8, 1, 9, 0};     // positions 2..10
    const int opposite[] = {5, 4, 6, 3, 7, 2, 8, 1, 9, 0}; // positions 11..20
    for (int bottom : {0, 1}) {
        const Qvz_MGTRCBPlacement p(Qvz_Family::GT, 20, bottom);
        const int primaryRow = bottom ? 0 : 1;
        EXPECT_EQ(p.LocString(p.LocX(0), p.LocY(0)), bottom ? "GT_X5Y0" : "GT_X5Y1");
        for (int i = 2; i <= 10; ++i) {
            EXPECT_EQ(p.LocX(i), primary[i - 2]) << i;
            EXPECT_EQ(p.LocY(i), primaryRow) << i;
        }
        for (int i = 11; i <= 20; ++i) {
            EXPECT_EQ(p.LocX(i), opposite[i - 11]) << i;
            EXPECT_EQ(p.LocY(i), 1 - primaryRow) << i;
        }
    }
}

TEST(Placement, RolesAndFeedersForTwenty) {
    const Qvz_MGTRCBPlacement p(Qvz_Family::GT10, 20, 0);
    EXPECT_EQ(p.BondMode(0), "MASTER");
    // Within two columns of the master: one hop.
    for (int i = 2; i <= 5; ++i)
        EXPECT_EQ(p.BondMode(i), kOneHop) << i;
    for (int i = 6; i <= 10; ++i)
        EXPECT_EQ(p.BondMode(i), kTwoHops) << i;
    EXPECT_EQ(p.BondMode(11), kOneHop);
    for (int i = 12; i <= 20; ++i) {
        EXPECT_EQ(p.BondMode(i), kTwoHops) << i;
        EXPECT_EQ(p.Feeder(i), 11) << i;
    }
    // Close two-hop slaves are fed from two columns nearer; far ones from 4 or 5.
    const std::pair<int, int> feeders[] = {{6, 2}, {7, 3}, {8, 4}, {9, 5}, {10, 4}};
    for (const auto& [i, k] : feeders)
        EXPECT_EQ(p.Feeder(i), k) << i;
    EXPECT_EQ(p.LocString(p.LocX(0), p.LocY(0)), "GT10_X5Y1");
}

TEST(Placement, Gt11SwapsTheAxes) {
    const Qvz_MGTRCBPlacement top(Qvz_Family::GT11, 24, 0);
    EXPECT_EQ(top.LocString(top.LocX(0), top.LocY(0)), "GT11_X1Y6");
    EXPECT_EQ(top.LocString(top.LocX(2), top.LocY(2)), "GT11_X1Y5");
    EXPECT_EQ(top.LocString(top.LocX(13), top.LocY(13)), "GT11_X0Y6");
    const Qvz_MGTRCBPlacement left(Qvz_Family::GT11, 24, 1);
    EXPECT_EQ(left.LocString(left.LocX(0), left.LocY(0)), "GT11_X0Y6");
    EXPECT_EQ(left.BondMode(13), kOneHop);
    EXPECT_EQ(left.BondMode(14), kTwoHops);
}

TEST(Placement, NegativeMaximumCountsAsZero) {
    const Qvz_MGTRCBPlacement p(Qvz_Family::GT, -6, 0);
    EXPECT_EQ(p.MaxBond(), 0);
    EXPECT_EQ(p.LocX(0), 0);
    EXPECT_EQ(p.LocY(0), 1);
}

// Independent of the column formulas: every maximum, family and primary row
// puts positions 0, 2..M on distinct, non-negative sites, one row holding at
// most one site more than the other, and every two-hop slave is fed by an
// earlier one-hop slave.
TEST(Placement, NoTwoPositionsShareASite) {
    for (Qvz_Family f : {Qvz_Family::GT, Qvz_Family::GT10, Qvz_Family::GT11}) {
        for (int m = 0; m <= 40; ++m) {
            for (int bottom : {0, 1}) {
                const Qvz_MGTRCBPlacement p(f, m, bottom);
                std::set<std::pair<int, int>> sites;
                for (int i = 0; i <= m; ++i) {
                    if (i == 1)
                        continue;
                    const int x = p.LocX(i);
                    const int y = p.LocY(i);
                    EXPECT_GE(x, 0);
                    EXPECT_GE(y, 0);
                    EXPECT_TRUE(sites.insert({x, y}).second)
                        << "M=" << m << " position " << i << " at X" << x << "Y" << y;
                    if (i >= 2 && p.BondMode(i) == kTwoHops) {
                        const int k = p.Feeder(i);
                        EXPECT_TRUE(k >= 2 && k < i) << "M=" << m << " i=" << i << " k=" << k;
                        EXPECT_EQ(p.BondMode(k), kOneHop) << "M=" << m << " i=" << i;
                    }
                }
                if (m >= 2) {
                    EXPECT_EQ(p.BondMode(m / 2 + 1), kOneHop) << m;
                }
            }
        }
    }
}
