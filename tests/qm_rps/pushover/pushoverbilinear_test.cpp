#include "qm_rps/pushover/pushoverbilinear.h"

#include <cmath>
#include <gtest/gtest.h>

namespace {

struct T_FIT {
    const char* label;
    T_ADRS_CURVE curve; // from the origin
    T_BILINEAR_OPTIONS options;
    double dm; // ec8 only
    T_BILINEAR expected;
};

constexpr T_BILINEAR_OPTIONS kEc8{BILINEAR_RULE::Ec8, 0.6, 0.85, false};
constexpr T_BILINEAR_OPTIONS kNtc{BILINEAR_RULE::Ntc, 0.6, 0.85, false};
constexpr T_BILINEAR_OPTIONS kEc8Peak{BILINEAR_RULE::Ec8, 0.6, 0.85, false, true};
constexpr T_BILINEAR_OPTIONS kNtcPeak{BILINEAR_RULE::Ntc, 0.6, 0.85, false, true};
constexpr T_BILINEAR_OPTIONS kSecant8{BILINEAR_RULE::Ntc, 0.8, 0.85, false};
constexpr T_BILINEAR_OPTIONS kMasonry{BILINEAR_RULE::Masonry, 0.7, 0.8, false};

const T_ADRS_CURVE kPlastic{{0, 0.02, 0.1}, {0, 0.4, 0.4}};
const T_ADRS_CURVE kTrilinear{{0, 0.01, 0.03, 0.05}, {0, 0.2, 0.3, 0.3}};
const T_ADRS_CURVE kSoft{{0, 0.01, 0.02, 0.04, 0.05, 0.06}, {0, 0.2, 0.2, 0.1, 0.19, 0.05}};
const T_ADRS_CURVE kBack{{0, 0.02, 0.1, 0.06, 0.14}, {0, 40, 50, 20, 22}}; // steps back
const T_ADRS_CURVE kKnuckle{{0, 0.1, 1.0, 1.1}, {0, 0.5, 0.6, 1.0}};

int Ec8(const T_ADRS_CURVE& curve, double dm, T_BILINEAR& out, bool peak = false)
{
    return CalcBilinearEc8(curve.View(), FirstPlaceAt(curve.View(), dm), peak, out);
}

/// Yield point of the ntc rule from stiffness, ultimate displacement and area done by hand.
constexpr double kLess = 1.0 - 1e-15; // what a push or a change of units leaves of 1

T_BILINEAR Ntc(double k, double du, double E)
{
    const double ay = k * (du - std::sqrt(du * du - 2.0 * E / k));
    return {ay / k, ay, du, ay};
}

// clang-format off
const T_FIT kFits[] = {
    // A curve that is bilinear comes back exactly, wherever the energy is taken.
    { "ec8, plastic, at the knee", kPlastic, kEc8, 0.02, {0.02, 0.4, 0.1, 0.4} },
    { "ntc, plastic",              kPlastic, kNtc, 0.0,  {0.02, 0.4, 0.1, 0.4} },
    // Area to 0.03: 0.001 + 0.005 = 0.006, dy = 2 (0.03 - 0.006/0.3).
    { "ec8, trilinear",            kTrilinear, kEc8, 0.03, {0.02, 0.3, 0.05, 0.3} },
    // To 0.02: Sa = 0.25, area 0.001 + 0.00225, dy = 2 (0.02 - 0.013).
    { "ec8, between points",       kTrilinear, kEc8, 0.02, {0.014, 0.25, 0.05, 0.25} },
    // A curve below its chord (area 0.00705): dy = 2 (0.41 - 0.00705), limited to dm.
    { "ec8, dy at dm", {{0, 0.4, 0.41}, {0, 0.01, 1.0}}, kEc8, 0.41, {0.41, 1.0, 0.41, 1.0} },
    // 0.6 * 0.3 = 0.18 at 0.009: k = 20; area to the end 0.012.
    { "ntc, trilinear",            kTrilinear, kNtc, 0.0, Ntc(20, 0.05, 0.012) },
    // 0.24 on the second branch at 0.018.
    { "ntc, secant 0.8",           kTrilinear, kSecant8, 0.0, Ntc(0.24 / 0.018, 0.05, 0.012) },
    // Falls to 0.17 at 0.026 and again later; area 0.003 + 0.006 (0.2 + 0.17)/2.
    { "ntc, drop",                 kSoft, kNtc, 0.0, Ntc(20, 0.026, 0.00411) },
    // Falls to 0.16 at 0.028; area 0.003 + 0.008 * 0.18.
    { "masonry, drop",             kSoft, kMasonry, 0.0, Ntc(20, 0.028, 0.00444) },
    // 0.18 is first reached at 0.01: k = 18; area 0.0009 + 0.0018 + 0.0024 + 0.006.
    { "ntc, level plateau", {{0, 0.01, 0.02, 0.03, 0.05}, {0, 0.18, 0.18, 0.3, 0.3}}, kNtc, 0.0,
      Ntc(18, 0.05, 0.0111) },
    // A plateau that rounding puts below the level of the stiffness still reaches it, and one above
    // the level of the fall has fallen to it: k = 10, area 0.002 + 0.004 + 0.00185.
    { "ntc, plateau below level",
      {{0, 0.01, 0.02, 0.03, 0.05}, {0, kLess * 0.18, kLess * 0.18, 0.3, 0.3}},
      kNtc, 0.0, Ntc(18, 0.05, 0.0111) },
    { "ntc, plateau above level",
      {{0, 0.02, 0.04, 0.05, 0.08}, {0, 0.2, 0.2, 0.17 / kLess, 0.17 / kLess}},
      kNtc, 0.0, Ntc(10, 0.05, 0.00785) },
    // The energy is that up to the peak, 0.4 + 3.6: what the curve does behind it does not count.
    { "ec8, steps back behind",    kBack, kEc8, 0.1, {0.04, 50, 0.14, 50} },
    // Falls to 42.5 at 0.09, stepping back; area 4 - 0.01 (50 + 42.5)/2; 30 at 0.015.
    { "ntc, steps back",           kBack, kNtc, 0.0, Ntc(2000, 0.09, 3.5375) },
    { "masonry, steps back",       kBack, kMasonry, 0.0, Ntc(2000, 0.26 / 3, 3.4) }, // 40; 35
    // At 0.04 the force has fallen to 0.1: area to there 0.001 + 0.002 + 0.003, peak 0.2.
    { "ec8, largest force",        kSoft, kEc8Peak, 0.04, {0.02, 0.2, 0.06, 0.2} },
    // The peak on the secant of k = 20.
    { "ntc, largest force",        kTrilinear, kNtcPeak, 0.0, {0.015, 0.3, 0.05, 0.3} },
    // k = 0.6, area 0.025 + 0.495 + 0.08 = 0.6 > k du2/2: no real root, the peak is taken.
    { "ntc, no root",              kKnuckle, kNtc, 0.0, {1.0 / 0.6, 1.0, 1.1, 1.0} },
};
// clang-format on

} // namespace

TEST(Bilinear, FitsByHand)
{
    for (const T_FIT& f : kFits) {
        T_BILINEAR b;
        const bool ec8 = f.options.rule == BILINEAR_RULE::Ec8;
        ASSERT_EQ(1, ec8 ? Ec8(f.curve, f.dm, b, f.options.peak)
                         : CalcBilinearNtc(f.curve.View(), f.options, b))
            << f.label;
        EXPECT_NEAR(f.expected.dy, b.dy, 1e-14) << f.label;
        EXPECT_NEAR(f.expected.ay, b.ay, 1e-13 * std::max(1.0, b.ay)) << f.label;
        EXPECT_NEAR(f.expected.du, b.du, 1e-15) << f.label;
        EXPECT_EQ(b.ay, b.au) << f.label;
    }
}

TEST(Bilinear, RefusesCurvesWithoutAYieldPoint)
{
    const T_BILINEAR before{1, 2, 3, 4};
    T_BILINEAR b = before;
    const T_ADRS_CURVE flat{{0, 0.1, 0.2}, {0, 0, 0}};
    const T_ADRS_CURVE still{{0, 0, 0}, {0, 0.1, 0.2}};
    const T_ADRS_CURVE brittle{{0, 0.01, 0.1}, {0, 1.0, 0.1}}; // area 0.0545 > 0.1 * 0.1
    EXPECT_EQ(0, Ec8(flat, 0.1, b));
    EXPECT_EQ(0, Ec8(still, 0.0, b));
    EXPECT_EQ(0, CalcBilinearNtc(still.View(), kNtc, b));
    EXPECT_EQ(0, Ec8(brittle, 0.1, b));
    EXPECT_EQ(before, b);
}
