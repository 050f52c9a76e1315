// Forces and deflections along a member against formulas of statics.
#include "qm_rps/view/memberline.h"

#include <gtest/gtest.h>

#include <cmath>

namespace {

constexpr double kL = 6.0;
constexpr std::size_t kVz = 2, kMy = 4, kMz = 5;
constexpr T_LINE_STIFFNESS kStiff{2.0e4, 5.0e3, 0.0, 0.0};

T_LINE_LOAD Spread(double w0, double w1, double a = 0.0, double b = kL)
{
    return {solver::BEAM_LOAD::Distributed, {0.0, 0.0, w0}, {0.0, 0.0, w1}, a, b};
}
T_LINE_LOAD At(double a, double value, bool moment = false)
{
    if (moment) return {solver::BEAM_LOAD::Moment, {0.0, value, 0.0}, {}, a, 0.0};
    return {solver::BEAM_LOAD::Point, {0.0, 0.0, value}, {}, a, 0.0};
}

/// A beam on two supports along x, z up: forces of the cut at I, and what its span then has.
struct T_SPAN_CASE {
    const char* label;
    T_LINE_LOAD load;
    double shearI;        // Vz
    double at;            // a place
    double shear, behind; // there, before and behind
    double moment, momentBehind;
    double shearJ;
};

// Worked by hand: reactions by the lever rule; moments negative with tension below.
constexpr double kPeak = 3.4641016151377544; // L / sqrt 3
const T_SPAN_CASE kSpans[] = {
    {"w L^2 / 8", Spread(-10, -10), -30, 3, 0, 0, -45, -45, 30},
    {"P a b / L", At(2, -12), -8, 2, -8, 4, -16, -16, 4},
    {"moment", At(3, 5, true), 5.0 / 6, 3, 5.0 / 6, 5.0 / 6, 2.5, -2.5, 5.0 / 6},
    {"triangle, w L^2 / (9 sqrt 3)", Spread(0, -12), -12, kPeak, 0, 0, -27.712812921102035,
     -27.712812921102035, 24},
    // Antisymmetric, w L^2 / 6 s (1 - s) (1 - 2 s): its slope vanishes at s = 1/2 -+ sqrt 3 / 6.
    {"turning, w L^2 / (36 sqrt 3)", Spread(-10, 10), -10, 3 - 1.7320508075688772, 0, 0,
     -5.773502691896258, -5.773502691896258, -10},
    {"its other extreme", Spread(-10, 10), -10, 3 + 1.7320508075688772, 0, 0, 5.773502691896258,
     5.773502691896258, -10},
    // 9 on the middle third, from 2 to 4: 9 each side; at 3 9 * 3 - 9 * 0.5.
    {"part", Spread(-9, -9, 2, 4), -9, 3, 0, 0, -22.5, -22.5, 9}};

} // namespace

TEST(MemberLine, ForcesOfASpanAreThoseOfStatics)
{
    for (const T_SPAN_CASE& c : kSpans) {
        const CMemberLine line(kL, {0, 0, c.shearI, 0, 0, 0}, std::span(&c.load, 1));
        EXPECT_NEAR(c.shear, line.Force(kVz, c.at), 1e-12) << c.label;
        EXPECT_NEAR(c.behind, line.Force(kVz, c.at, true), 1e-12) << c.label;
        EXPECT_NEAR(c.moment, line.Force(kMy, c.at), 1e-12) << c.label;
        EXPECT_NEAR(c.momentBehind, line.Force(kMy, c.at, true), 1e-12) << c.label;
        EXPECT_NEAR(c.shearJ, line.Force(kVz, kL), 1e-12) << c.label;
        EXPECT_NEAR(0.0, line.Force(kMy, kL), 1e-12) << c.label; // equilibrium of the whole
        EXPECT_EQ(0.0, line.Force(kMz, c.at)) << c.label;
        bool has = false; // the extreme, or the leap, is a station
        for (const double x : line.Stations(kMy, 1))
            has = has || std::fabs(x - c.at) < 1e-6;
        EXPECT_TRUE(has) << c.label;
    }
}

TEST(MemberLine, AMomentAboutZFallsWithTheShearAlongY)
{
    // A cantilever from I, 4 along +y at its tip: 4 * 6 at I, tension on the side of -y.
    const T_LINE_LOAD tip{solver::BEAM_LOAD::Point, {0.0, 4.0, 0.0}, {}, kL, 0.0};
    const CMemberLine line(kL, {0, 4, 0, 0, 0, 24}, std::span(&tip, 1));
    EXPECT_NEAR(12.0, line.Force(kMz, 3.0), 1e-12);
    EXPECT_NEAR(0.0, line.Force(kMz, kL), 1e-12);
    EXPECT_NEAR(4.0, line.Force(1, kL * 0.999), 1e-12);
    EXPECT_NEAR(0.0, line.Force(1, kL), 1e-12); // all loads lie before the cut at J
}

TEST(MemberLine, ForcesOfAnAnalysisThatLoadsDoNotExplainAreKept)
{
    const T_LINE_LOAD load = Spread(-10, -10);
    T_ELEM_FORCES analysed{};
    for (std::size_t p = 0; p < analysed.size(); ++p) {
        const double x = kL * static_cast<double>(p) / 4.0;
        analysed[p][kVz] = -30 + 10 * x;
        analysed[p][kMy] = -30 * x + 5 * x * x;
    }
    CMemberLine same(kL, analysed[0], std::span(&load, 1));
    EXPECT_TRUE(same.FitTo(analysed));
    analysed[2][kMy] -= 3.0; // second order
    CMemberLine other(kL, analysed[0], std::span(&load, 1));
    EXPECT_FALSE(other.FitTo(analysed));
    for (std::size_t p = 0; p < analysed.size(); ++p)
        EXPECT_NEAR(analysed[p][kMy], other.Force(kMy, kL * static_cast<double>(p) / 4.0), 1e-10);
}

namespace {

struct T_BENT_CASE {
    const char* label;
    T_DOF6 atI; // forces of the cut
    T_LINE_LOAD load;
    T_LINE_ENDS ends;
    T_LINE_STIFFNESS stiffness;
    double at, deflection; // along z
};

T_LINE_ENDS Ends(T_DOF6 i, T_DOF6 j, bool freeI = false, bool freeJ = false)
{
    T_LINE_ENDS ends{{i, j}, {}};
    ends.release.I[4] = freeI;
    ends.release.J[4] = freeJ;
    return ends;
}

} // namespace

TEST(DeflectedLine, FollowsTheClosedFormulas)
{
    const double q = 10.0, EI = kStiff.EIy, P = 7.0;
    T_LINE_STIFFNESS soft = kStiff;
    soft.GAz = 400.0;
    const T_LINE_LOAD spread = Spread(-q, -q), none = Spread(0, 0);
    const double tip = -P * kL * kL * kL / (3 * EI);
    const T_BENT_CASE cases[] = {{"clamped: q L^4 / 384 EI",
                                  {0, 0, -q * kL / 2, 0, q * kL * kL / 12, 0},
                                  spread,
                                  Ends({}, {}),
                                  kStiff,
                                  kL / 2,
                                  -q * std::pow(kL, 4) / (384 * EI)},
                                 {"clamped, with shear: and q L^2 / 8 GA",
                                  {0, 0, -q * kL / 2, 0, q * kL * kL / 12, 0},
                                  spread,
                                  Ends({}, {}),
                                  soft,
                                  kL / 2,
                                  -q * std::pow(kL, 4) / (384 * EI) - q * kL * kL / (8 * 400.0)},
                                 {"on two supports: 5 q L^4 / 384 EI",
                                  {0, 0, -q * kL / 2, 0, 0, 0},
                                  spread,
                                  Ends({}, {}, true, true),
                                  kStiff,
                                  kL / 2,
                                  -5 * q * std::pow(kL, 4) / (384 * EI)},
                                 // P L^3 / 3 EI at the tip, 5/16 of it at the middle.
                                 {"cantilever",
                                  {0, 0, -P, 0, P * kL, 0},
                                  none,
                                  Ends({}, {0, 0, tip, 0, P * kL * kL / (2 * EI), 0}),
                                  kStiff,
                                  kL / 2,
                                  tip * 5 / 16}};
    for (const T_BENT_CASE& c : cases) {
        const CMemberLine line(kL, c.atI, std::span(&c.load, 1));
        const CDeflectedLine bent(line, c.ends, c.stiffness);
        EXPECT_NEAR(c.deflection, bent.At(c.at)[2], 1e-12 + 1e-12 * std::fabs(c.deflection))
            << c.label;
        EXPECT_NEAR(c.ends.moved.J[2], bent.At(kL)[2], 1e-14) << c.label;
    }
}

TEST(DeflectedLine, WithoutForcesItIsTheCubicOfTheEnds)
{
    // A turn of I about +y by 1 / 1000 moves the beam towards -z: -L r s (1 - s)^2; with J pinned
    // -L r (s - 3/2 s^2 + s^3 / 2). Przemieniecki (1968) chapter 5; beam tables.
    const double r = 1e-3, s = 0.25;
    const auto at = [&](bool freeJ) {
        const T_LINE_ENDS ends = Ends({0, 0, 0, 0, r, 0}, {}, false, freeJ);
        return CDeflectedLine(CMemberLine(kL, ends, kStiff), ends, kStiff).At(s * kL)[2];
    };
    EXPECT_NEAR(-kL * r * s * (1 - s) * (1 - s), at(false), 1e-15);
    EXPECT_NEAR(-kL * r * (s - 1.5 * s * s + 0.5 * s * s * s), at(true), 1e-15);
    // In the other plane: J moves by 1 along +y without turning, 3 s^2 - 2 s^3.
    const T_LINE_ENDS moved = Ends({}, {0, 1, 0, 0, 0, 0});
    const CDeflectedLine bent(CMemberLine(kL, moved, kStiff), moved, kStiff);
    EXPECT_NEAR(3 * s * s - 2 * s * s * s, bent.At(s * kL)[1], 1e-14);
}
