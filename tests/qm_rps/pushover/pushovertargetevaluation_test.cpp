// By hand; examples/verification holds the published N2 cases.
#include "qm_rps/pushover/pushovertargetevaluation.h"

#include <algorithm>
#include <cmath>
#include <gtest/gtest.h>
#include <numbers>

namespace {

constexpr double kPi = std::numbers::pi;

/// Initial stiffness 10 g per length; peak 0.2 at step 2. With the masonry rule (0.14 at 0.014,
/// k = 10; falls to 0.16 at 0.048; area 0.002 + 0.004 + 0.00144) and with the ntc rule (falls to
/// 0.17 at 0.046; area 0.002 + 0.004 + 0.00111). g = 10, so T* = 2 pi 0.1 s and det = Se / 10.
const T_ADRS_CURVE kCurve{{0.001, 0.01, 0.02, 0.04, 0.048, 0.06, 0.08},
                          {0.01, 0.1, 0.2, 0.2, 0.16, 0.1, 0.05}};
const double kAyMasonry = 10 * (0.048 - std::sqrt(0.048 * 0.048 - 2 * 0.00744 / 10));
const double kAyNtc = 10 * (0.046 - std::sqrt(0.046 * 0.046 - 2 * 0.00711 / 10));
constexpr double kGamma = 1.5;

T_TARGET_SPECTRUM Constant(double Se, double Tc)
{
    return {[Se](double) { return Se; }, Tc};
}

T_TARGET_INPUT Input(BILINEAR_RULE rule, const std::vector<double>& drifts)
{
    T_TARGET_INPUT in;
    in.capacity = kCurve;
    in.gravity = 10.0;
    in.gamma = kGamma;
    in.mStar = 3.0;
    in.options = BilinearDefaults(rule);
    in.drift = [drifts](int step) { return std::optional(drifts[std::size_t(step)]); };
    return in;
}

const std::vector<double> kSmallDrifts{0, 0.001, 0.003, 0.004, 0.01, 0.02, 0.03};
const std::vector<double> kLargeDrifts{0, 0.0026, 0.008, 0.009, 0.01, 0.02, 0.03};

struct T_MASONRY_CASE {
    const char* label;
    double Se, Tc; // det = Se / 10
    std::vector<double> drifts;
    double dl, dq; // SDOF capacities
    int dlStep, dqStep;
    const char *remarkDL, *remarkSD;
};

const double kDy = kAyMasonry / 10.0;

// Strength: 0.8 ay = 0.155474 lies between 0.16 (at 0.048 = du) and 0.1 (at 0.06).
const double kSdCap = 0.048 + 0.012 * (0.8 * kAyMasonry - 0.16) / (0.1 - 0.16);

// clang-format off
const T_MASONRY_CASE kMasonryCases[] = {
    // SD demand 0.049 is above 0.0489
    // drift at the peak is at the limit: the peak step (0.02); q* = 3 at 3 dy = 0.0583
    { "passes",        0.30, 0.1, kSmallDrifts, 0.02, 3 * kDy, 2, 5, "OK",  "OK" },
    { "DL by drift",   0.30, 0.1, kLargeDrifts, 0.01, 3 * kDy, 1, 5, "N/A", "OK" },
    { "SD strength",   0.49, 0.1, kSmallDrifts, 0.02, 3 * kDy, 2, 5, "OK", "N/A" },
    // short period, Tc = 2 T*: dq = 5 dy = 0.0972, beyond the curve: the last step
    { "short period",  0.10, 0.4 * kPi, kSmallDrifts, 0.02, 5 * kDy, 2, 6, "OK", "OK" },
};
// clang-format on

} // namespace

TEST(TargetEvaluation, MasonryCapacitiesAndRemarksByHand)
{
    for (const T_MASONRY_CASE& c : kMasonryCases) {
        T_TARGET_INPUT in = Input(BILINEAR_RULE::Masonry, c.drifts);
        in.spectra[0] = Constant(c.Se, c.Tc);
        CPushOverTargetEvaluation e(in);
        ASSERT_EQ(1, e.UpdateTargetDispDataMasonry()) << c.label;
        const auto& rows = e.Rows();
        ASSERT_EQ(4U, rows.size()) << c.label;
        EXPECT_NEAR(kGamma * c.dl, rows[0].capacity.value(), 1e-14) << c.label;
        EXPECT_NEAR(kGamma * kSdCap, rows[1].capacity.value(), 1e-14) << c.label;
        EXPECT_NEAR(kGamma * c.dq, rows[3].capacity.value(), 1e-14) << c.label;
        EXPECT_EQ(c.dlStep, rows[0].capacityStep) << c.label;
        EXPECT_EQ(4, rows[1].capacityStep) << c.label;
        EXPECT_EQ(c.dqStep, rows[3].capacityStep) << c.label;
        EXPECT_EQ(c.remarkDL, rows[0].remark) << c.label;
        EXPECT_EQ(c.remarkSD, rows[1].remark) << c.label;
        EXPECT_FALSE(rows[2].capacity || rows[2].capacityStep || rows[3].demand) << c.label;
        EXPECT_EQ("", rows[2].remark) << c.label;
        EXPECT_FALSE(e.StrengthDropMissing()) << c.label;
    }
}

// Without the steep end the strength never falls to 0.8 ay: the last step, and q* = 3 then governs
// SD (demand 0.06 > 3 dy, with dy = 0.0195 from du = 0.08).
TEST(TargetEvaluation, MasonryWithoutAStrengthDropTakesTheLastStep)
{
    T_TARGET_INPUT in = Input(BILINEAR_RULE::Masonry, kSmallDrifts);
    in.capacity.Sa = {0.01, 0.1, 0.2, 0.2, 0.195, 0.19, 0.18};
    in.spectra[0] = Constant(0.6, 0.1);
    CPushOverTargetEvaluation e(in);
    ASSERT_EQ(1, e.UpdateTargetDispDataMasonry());
    EXPECT_TRUE(e.StrengthDropMissing());
    EXPECT_NEAR(kGamma * 0.08, e.Rows()[1].capacity.value(), 1e-15);
    EXPECT_EQ(6, e.Rows()[1].capacityStep);
    EXPECT_EQ("N/A", e.Rows()[1].remark);
}

// The period of this curve underflows to 0, so q* = 3 is not computed and Gamma comes in twice.
TEST(TargetEvaluation, MasonryWithoutAPeriodHasGammaSquared)
{
    T_TARGET_INPUT in = Input(BILINEAR_RULE::Ec8, kSmallDrifts);
    in.capacity = {{1e-311, 1e-310, 2e-310}, {1e19, 1e20, 1e20}};
    in.gamma = 2.0;
    in.spectra[0] = Constant(0.5, 0.5);
    CPushOverTargetEvaluation e(in);
    EXPECT_EQ(0, e.UpdateTargetDispDataMasonry());
    EXPECT_EQ(PUSH_OUTCOME::NoTarget, e.Outcome().code);
    EXPECT_DOUBLE_EQ(2e-310, e.Rows()[0].capacity.value());
    EXPECT_DOUBLE_EQ(4e-310, e.Rows()[1].capacity.value());
    EXPECT_DOUBLE_EQ(8e-310, e.Rows()[3].capacity.value());
    EXPECT_EQ("", e.Rows()[0].remark);
}

TEST(TargetEvaluation, NtcCapacitiesOfBothCodesByHand)
{
    const std::vector<double> drifts{0, 0.0045, 0.008, 0.009, 0.01, 0.02, 0.03};
    T_TARGET_INPUT in = Input(BILINEAR_RULE::Ntc, drifts); // 0.005 is nearest at step 1, d = 0.01
    in.spectra[0] = Constant(0.1, 0.1);                    // SLO 0.01; SLD is not enabled
    in.spectra[2] = Constant(0.3, 0.1);                    // SLV 0.03, a midpoint
    in.spectra[3] = Constant(1.0, 2.0 * kPi);              // SLC short period, Tc = 10 T*
    const double slc = kAyNtc / 10 * (1 + (1 / kAyNtc - 1) * 10);
    EXPECT_GT(slc, 3 * 0.1); // no limit of 3 det here

    CPushOverTargetEvaluation e(in);
    ASSERT_EQ(1, e.UpdateTargetDispDataNTC(PUSH_METHOD::Ntc2008));
    EXPECT_EQ((std::vector<int>{1, kStepNone, 2, kStepNone}), e.DemandSteps());
    ASSERT_EQ(4U, e.Rows().size());
    EXPECT_NEAR(kGamma * 0.01, e.Rows()[0].demand.value(), 1e-15);
    EXPECT_FALSE(e.Rows()[1].demand);
    EXPECT_NEAR(kGamma * 0.03, e.Rows()[2].demand.value(), 1e-15);
    EXPECT_NEAR(kGamma * slc, e.Rows()[3].demand.value(), 1e-12);
    EXPECT_NEAR(kGamma * 0.0067, e.Rows()[0].capacity.value(), 1e-15);
    EXPECT_NEAR(kGamma * 0.01, e.Rows()[1].capacity.value(), 1e-15);
    EXPECT_FALSE(e.Rows()[2].capacity || e.Rows()[3].capacity);
    EXPECT_EQ("NG", e.Rows()[0].remark);
    EXPECT_EQ("", e.Rows()[1].remark); // nothing to compare with
    EXPECT_EQ(1, e.Rows()[1].capacityStep);
    EXPECT_FALSE(e.Rows()[0].capacityStep || e.Rows()[3].capacityStep);

    // 2018: 0.75 * 0.1 is reached at 0.001 + 0.009 * 0.065/0.09 = 0.0075; no Gamma on it.
    ASSERT_EQ(1, e.UpdateTargetDispDataNTC(PUSH_METHOD::Ntc2018));
    const double capacities[] = {0.67 * 0.0075, 0.0075, 0.75 * kGamma * 0.046, kGamma * 0.046};
    const char* remarks[] = {"NG", "", "OK", "NG"};
    for (std::size_t i = 0; i < 4; ++i) {
        EXPECT_NEAR(capacities[i], e.Rows()[i].capacity.value(), 1e-15) << i;
        EXPECT_EQ(remarks[i], e.Rows()[i].remark) << i;
    }
    EXPECT_EQ(1, e.Rows()[2].capacityStep);
}

// The plateau from step 2 to 3 is flat but for the last digits: the drift at its first step is
// within the limits, so that the capacity is 0.02 there; step 3, within them too, is at 0.04.
TEST(TargetEvaluation, OnAPlateauTheFirstPeakCounts)
{
    for (const double last : {0.2, std::nextafter(0.2, 1.0), 0.2 * (1.0 + 2e-14)}) {
        const std::vector<double> drifts{0, 0.001, 0.0015, 0.0028, 0.01, 0.02, 0.03};
        T_TARGET_INPUT in = Input(BILINEAR_RULE::Masonry, drifts);
        in.capacity.Sa[3] = last;
        in.spectra.fill(Constant(0.1, 0.1));
        CPushOverTargetEvaluation masonry(in);
        ASSERT_EQ(1, masonry.UpdateTargetDispDataMasonry());
        EXPECT_EQ(2, masonry.Rows()[0].capacityStep) << last - 0.2;
        EXPECT_NEAR(kGamma * 0.02, masonry.Rows()[0].capacity.value(), 1e-15) << last - 0.2;
        in.options = BilinearDefaults(BILINEAR_RULE::Ntc);
        CPushOverTargetEvaluation ntc(in);
        ASSERT_EQ(1, ntc.UpdateTargetDispDataNTC(PUSH_METHOD::Ntc2008));
        EXPECT_NEAR(kGamma * 0.02, ntc.Rows()[1].capacity.value(), 1e-15) << last - 0.2;
        EXPECT_NEAR(10 * ntc.Bilinear()->dy, kAyNtc, 1e-12) << last - 0.2;
    }
}

// Hardening curve: 0.75 of the peak is reached at 0.0325, after the yield point dy = ay/20 of
// k = 20, du = 0.1, area 0.0235.
TEST(TargetEvaluation, Ntc2018TakesTheSmallerOfRiseAndYield)
{
    T_TARGET_INPUT in = Input(BILINEAR_RULE::Ntc, kSmallDrifts);
    in.capacity = {{0.001, 0.01, 0.1}, {0.02, 0.2, 0.3}};
    in.spectra.fill(Constant(0.05, 0.1));
    CPushOverTargetEvaluation e(in);
    ASSERT_EQ(1, e.UpdateTargetDispDataNTC(PUSH_METHOD::Ntc2018));
    EXPECT_EQ(2, e.Rows()[1].capacityStep);
    const double dy = 0.1 - std::sqrt(0.01 - 0.00235);
    EXPECT_NEAR(dy, e.Rows()[1].capacity.value(), 1e-15);
    EXPECT_EQ("OK", e.Rows()[1].remark); // demand 1.5 * 0.0025
}

TEST(TargetEvaluation, WithoutDriftsNothingThatRestsOnThemIsChecked)
{
    T_TARGET_INPUT in = Input(BILINEAR_RULE::Ntc, kSmallDrifts);
    in.drift = [](int) { return std::nullopt; };
    in.spectra.fill(Constant(0.1, 0.1));
    CPushOverTargetEvaluation ntc(in);
    ASSERT_EQ(1, ntc.UpdateTargetDispDataNTC(PUSH_METHOD::Ntc2018));
    in.options = BilinearDefaults(BILINEAR_RULE::Masonry);
    CPushOverTargetEvaluation masonry(in);
    ASSERT_EQ(1, masonry.UpdateTargetDispDataMasonry());
    for (const T_LIMIT_ROW& row : {ntc.Rows()[0], ntc.Rows()[1], masonry.Rows()[0]}) {
        EXPECT_EQ("not checked", row.remark) << row.name;
        EXPECT_FALSE(row.capacity.has_value() || row.capacityStep.has_value()) << row.name;
    }
    EXPECT_EQ("OK", ntc.Rows()[3].remark); // the end of the bilinear curve
    EXPECT_EQ("OK", masonry.Rows()[1].remark);
}

// Up to 0.01 the curve is soft (T* 0.9 s), up to 0.02 stiff (0.4 s, dy limited to dm). The spectrum
// asks 0.02 of the soft one and 0.01 of the stiff one: each answer asks for the other.
TEST(TargetEvaluation, AnIterationThatDoesNotSettleHasNoTarget)
{
    T_TARGET_INPUT in = Input(BILINEAR_RULE::Ec8, kSmallDrifts);
    in.capacity = {{0.001, 0.01, 0.02}, {0.005, 0.05, 0.5}};
    in.options.iterate = true;
    in.spectra[0] = {
        [](double T) { return (T > 0.6 ? 0.02 : 0.01) * 4 * kPi * kPi / (T * T * 10); }, 0.1};
    CPushOverTargetEvaluation e(in);
    EXPECT_EQ(0, e.UpdateTargetDispDataEC8());
    EXPECT_EQ(PUSH_OUTCOME::TargetCycles, e.Outcome().code);
    const auto [low, high] = std::minmax(e.Outcome().between[0], e.Outcome().between[1]);
    EXPECT_NEAR(0.01, low, 1e-12);
    EXPECT_NEAR(0.02, high, 1e-12);
    EXPECT_FALSE(e.Rows()[1].demand.has_value());
}
