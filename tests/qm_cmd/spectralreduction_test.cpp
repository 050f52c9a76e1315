#include "qm_cmd/spectralreduction.h"

#include <gtest/gtest.h>

TEST(SpectralReduction, FollowsEquations8_9And8_10WithoutLowerBounds)
{
    struct T_CASE {
        double betaPct, SRa, SRv;
    };
    // clang-format off
    const T_CASE cases[] = { // pocket calculator, from ATC-40 (8-9) and (8-10)
        {  1.0, 1.514151, 1.400000 }, // ln 1 = 0: the constants alone
        {  5.0, 0.997916, 1.000079 }, // about 1 at 5 %, as the guide says
        { 10.0, 0.775586, 0.827842 },
        { 20.0, 0.553256, 0.655606 },
    };
    // clang-format on
    for (const T_CASE& c : cases) {
        T_SPEC_REDUCTION f;
        ASSERT_EQ(1, CalcSpectralReduction(c.betaPct, f)) << c.betaPct;
        EXPECT_NEAR(c.SRa, f.SRa, 5e-7) << c.betaPct;
        EXPECT_NEAR(c.SRv, f.SRv, 5e-7) << c.betaPct;
    }
}
