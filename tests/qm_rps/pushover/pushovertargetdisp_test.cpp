#include "qm_rps/pushover/pushovertargetdisp.h"

#include <cmath>
#include <gtest/gtest.h>
#include <numbers>

namespace {

// dy = 0.05 and ay = 0.2 g with g = 10: T* = 2 pi sqrt(0.025), and det = Se dy/ay = qu dy.
constexpr T_BILINEAR kYield{0.05, 0.2, 1.0, 0.2};
constexpr double kG = 10.0;
const double kT = 2.0 * std::numbers::pi * std::sqrt(0.025);

struct T_CASE {
    const char* label;
    double Se, TcOverT;
    bool cap;
    double det, dt;
    std::optional<double> qu;
    bool capped;
};

// clang-format off
const T_CASE kCases[] = {
    { "long",               0.40, 0.5,    true,  0.10,  0.10,  {},     false },
    { "qu below 1",         0.10, 2.0,    true,  0.025, 0.025, 0.5,    false },
    { "qu = 1",             0.20, 2.0,    true,  0.05,  0.05,  1.0,    false },
    { "qu = 2",             0.40, 2.0,    true,  0.10,  0.15,  2.0,    false }, // 0.05 (1 + 1*2)
    { "capped",             0.60, 10.0,   true,  0.15,  0.45,  3.0,    true },  // 0.05 * 21 > 0.45
    { "NTC is not capped",  0.60, 10.0,   false, 0.15,  1.05,  3.0,    false },
};
// clang-format on

struct T_STEP_CASE {
    const char* label;
    std::vector<double> d;
    double demand;
    int step;
};

// clang-format off
const T_STEP_CASE kSteps[] = {
    { "before the first",   {0.1, 1, 2, 4}, 0.05, kStepNone },
    { "midpoint",           {0.1, 1, 2, 4}, 1.5,  1 },
    { "midpoint, rounding", {0.1, 1, 2, 4}, 1.5 + 2e-11, 1 },
    { "upper, just past",   {0.1, 1, 2, 4}, 1.5 + 1e-9, 2 },
    { "equal to the last",  {0.1, 1, 2, 4}, 4.0,  3 },
    { "nearly the last",    {0.1, 1, 2, 4}, 4.0 - 5e-11, kStepNone }, // tolerance, then plain ==
    { "turns back",         {0, 2, 1, 3},   1.2,  2 }, // 1 first, then overwritten
    { "no point",           {},             1.0,  kStepNone },
};
// clang-format on

struct T_DROP_CASE {
    const char* label;
    std::vector<double> V;
    int peak;
    double level, dMin, d;
    int step; // kStepNone: no crossing
};

// Displacements 0, 1, 2, 3, 4.
// clang-format off
const T_DROP_CASE kDrops[] = {
    { "falls",             {0, 10, 8, 4, 9}, 1, 7.0,  0.0, 2.25,    2 },
    { "midpoint",          {0, 10, 8, 4, 9}, 1, 6.0,  0.0, 2.5,     2 },
    { "rises",             {0, 10, 8, 4, 9}, 1, 7.0,  3.0, 3.6,     4 },
    { "du within 1e-10",   {0, 10, 8, 4, 9}, 1, 7.0,  2.0 + 5e-11, 2.25, 2 },
    { "before du",         {0, 10, 8, 4, 9}, 1, 7.0,  2.0 + 5e-9, 3.6, 4 },
    { "before the peak",   {0, 10, 8, 4, 9}, 3, 7.0,  0.0, 3.6,     4 },
    { "equal ordinates",   {0, 10, 5, 5, 5}, 1, 5.0,  2.0, 2.0,     2 },
    { "nowhere",           {0, 10, 8, 4, 9}, 1, 3.0,  0.0, 0.0,     kStepNone },
};
// clang-format on

} // namespace

TEST(TargetDisp, BranchesByHand)
{
    for (const T_CASE& c : kCases) {
        const T_TARGET_DISP t = CalcTargetDisp(kYield, kG, c.Se, c.TcOverT * kT, c.cap);
        EXPECT_TRUE(t.found) << c.label;
        EXPECT_EQ(PUSH_OUTCOME::TargetFound, t.outcome.code) << c.label;
        EXPECT_NEAR(kT, t.Tstar, 1e-15) << c.label;
        EXPECT_NEAR(c.det, t.det, 1e-15) << c.label;
        EXPECT_NEAR(c.dt, t.dt, 1e-8 * c.dt) << c.label;
        ASSERT_EQ(c.qu.has_value(), t.qu.has_value()) << c.label;
        EXPECT_NEAR(c.qu.value_or(0.0), t.qu.value_or(0.0), 1e-14) << c.label;
        EXPECT_EQ(c.capped, t.capped) << c.label;
    }
}

TEST(TargetDisp, EqualPeriodsAreTheLongBranch)
{
    const double T = CalcTargetDisp(kYield, kG, 0.6, 0.1, true).Tstar;
    const T_TARGET_DISP at = CalcTargetDisp(kYield, kG, 0.6, T, true);
    EXPECT_FALSE(at.qu);
    const T_TARGET_DISP above = CalcTargetDisp(kYield, kG, 0.6, T * (1 + 1e-9), true);
    EXPECT_TRUE(above.qu);
    EXPECT_NEAR(at.dt, above.dt, 1e-8 * at.dt); // no jump between the branches
}

TEST(TargetDisp, NoTargetHasItsReason)
{
    const auto code = [](const T_BILINEAR& b, double Se, double Tc) {
        const T_TARGET_DISP t = CalcTargetDisp(b, kG, Se, Tc, true);
        EXPECT_FALSE(t.found);
        return t.outcome.code;
    };
    EXPECT_EQ(PUSH_OUTCOME::ZeroDemand, code(kYield, 0.0, 2.0));
    EXPECT_EQ(PUSH_OUTCOME::NoTarget, code({0.0, 0.2, 1, 0.2}, 0.4, 0.5)); // T* = 0
    EXPECT_EQ(PUSH_OUTCOME::BilinearTooShort, code({0.05, 0.0, 1, 0}, 0.4, 0.5));
    EXPECT_EQ(PUSH_OUTCOME::NoTarget, code(kYield, std::nan(""), 0.5));
    EXPECT_FALSE(CalcTargetDisp(kYield, kG, 0.4, HUGE_VAL, false).found);
    EXPECT_TRUE(CalcTargetDisp({0.0, 0.2, 1, 0.2}, kG, 0.4, 0.0, true).found); // T* = Tc = 0: long
}

TEST(TargetDisp, NearestSteps)
{
    for (const T_STEP_CASE& c : kSteps)
        EXPECT_EQ(std::vector<int>{c.step}, FindNearestSteps(c.d, std::array{c.demand})) << c.label;
    const std::vector<double> d{0, 1, 2};
    EXPECT_EQ((std::vector<int>{2, kStepNone, 0}), FindNearestSteps(d, std::array{2.0, 9.0, 0.2}));
}

TEST(TargetDisp, DriftStep)
{
    const std::vector<double> drifts{0.5, 0.25, 0.375, 0.75, 0.875, 0.5};
    const auto drift = [&](int step) { return std::optional(drifts[std::size_t(step)]); };
    EXPECT_EQ(2, FindDriftStep(2, 5, 0.375, drift));  // at the peak within the limit
    EXPECT_EQ(2, FindDriftStep(4, 5, 0.5, drift));    // 0.375 is nearest; step 0 does not count
    EXPECT_EQ(1, FindDriftStep(4, 5, 0.3125, drift)); // a tie goes to the first
    const auto large = [](int) { return std::optional(2.5); };
    EXPECT_EQ(5, FindDriftStep(4, 5, 0.5, large)); // none nearer to the limit than 1: the last
    const auto unknown = [&](int step) { return step == 2 ? std::nullopt : drift(step); };
    EXPECT_EQ(std::nullopt, FindDriftStep(2, 5, 0.3, unknown));
}

TEST(TargetDisp, StrengthDrop)
{
    const std::vector<double> d{0, 1, 2, 3, 4};
    for (const T_DROP_CASE& c : kDrops) {
        const auto found = FindStrengthDrop(d, c.V, c.peak, c.level, c.dMin);
        ASSERT_EQ(c.step != kStepNone, found.has_value()) << c.label;
        if (!found) continue;
        EXPECT_NEAR(c.d, found->d, 1e-14) << c.label;
        EXPECT_EQ(c.step, found->step) << c.label;
    }
}

TEST(TargetDisp, FirstRiseThroughALevel)
{
    const std::vector<double> d{0.5, 1, 2, 4}, V{0, 2, 1, 4};
    EXPECT_DOUBLE_EQ(0.75, FindRise(d, V, 1.0));
    EXPECT_DOUBLE_EQ(2.0 + 2.0 / 3.0, FindRise(d, V, 2.0)); // reaching it is not passing it
    EXPECT_DOUBLE_EQ(0.5, FindRise(d, V, 0.0));             // at the first point
    EXPECT_EQ(0.0, FindRise(d, V, 4.0));
    EXPECT_NEAR(2.0, FindRise(d, std::array{1.0, 2.0 + 1e-15, 2.0 - 1e-15, 4.0}, 2.0), 1e-12);
    EXPECT_EQ(0.0, FindRise(d, std::array{3.0, 4.0, 5.0, 6.0}, 1.0)); // starts above
}
