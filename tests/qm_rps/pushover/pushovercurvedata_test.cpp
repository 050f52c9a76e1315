#include "qm_rps/pushover/pushovercurvedata.h"

#include "pushsample.h"

#include <gtest/gtest.h>

namespace {

using P = PLOT_TYPE;
using T_NUMBERS = std::vector<double>;

T_MODEL_CONTENT Sample()
{
    return ThreeMasses({0.03, -0.09, 0.06}, {-10, -18, 20});
}

T_PUSH_CURVE_SETTINGS Settings(PLOT_TYPE type, bool eigenFactors = true)
{
    T_PUSH_CURVE_SETTINGS s;
    s.pushover = 1;
    s.plotType = type;
    s.eigenFactors = eigenFactors;
    s.gravity = 10.0;
    return s;
}

void ExpectNear(const T_NUMBERS& expected, const T_NUMBERS& actual, const std::string& label)
{
    ASSERT_EQ(expected.size(), actual.size()) << label;
    for (std::size_t i = 0; i < expected.size(); ++i)
        EXPECT_NEAR(expected[i], actual[i], 1e-14 * std::fabs(expected[i])) << label << ' ' << i;
}

struct T_FACTOR_CASE {
    const char* label;
    int pattern;
    std::vector<int> modes;
    PLOT_TYPE type;
    bool eigen;
    double gamma, alpha;
    int mode;
    bool eigenBased, eigenError, conversionError, massError;
};

constexpr bool Y = true, n = false;
using enum PLOT_TYPE;
// clang-format off
const T_FACTOR_CASE kFactorCases[] = {
    // largest participation; the third mode is equal, not larger
    { "eigen",             0, {},     Atc40,   Y, kGamma, kAlpha, 2, Y, n, n, Y },
    { "mass",              0, {},     Atc40,   n, kGamma, kAlpha, 2, n, n, n, n },
    { "named",             2, {3, 1}, Ec8Opcm, Y, kGamma, kAlpha, 3, Y, n, n, Y },
    { "named, other way",  2, {1},    Ec8Opcm, Y, 0.0,    0.0,    1, Y, Y, Y, Y },
    { "named, no such",    2, {9},    Atc40,   Y, 0.0,    0.0,    0, Y, Y, Y, Y },
    { "uniform, target",   1, {},     Ec8Opcm, Y, 1.0,    1.0,    2, n, n, n, n },
    { "uniform, ATC-40",   1, {},     Atc40,   Y, kGamma, kAlpha, 2, Y, n, n, Y },
    { "uniform, FEMA 440", 1, {},     Fema440, n, 1.0,    1.0,    2, n, n, n, n },
    { "not spectral",      0, {},     Drift,   n, 0.0,    0.0,    2, n, n, n, Y },
};
// clang-format on

class CurveData : public testing::Test {
protected:
    /// The curve of what the content holds now.
    int Calc(const T_PUSH_CURVE_SETTINGS& settings)
    {
        m_doc.Data().Assign(m_content);
        return m_curve.Calc(settings);
    }
    T_MODEL_CONTENT m_content = Sample();
    T_POLC_D& m_push = m_content.model.pushovers[1];
    CDBDoc m_doc;
    CPushOverCurveData m_curve{m_doc};
};

} // namespace

TEST_F(CurveData, FactorsByModeAndByMass)
{
    for (const T_FACTOR_CASE& k : kFactorCases) {
        m_push.patternKind = k.pattern;
        m_push.modes = k.modes;
        ASSERT_EQ(1, Calc(Settings(k.type, k.eigen))) << k.label << m_curve.Error();
        const T_PUSH_FACTORS& f = m_curve.Factors();
        ExpectNear({k.gamma, k.alpha}, {f.gamma, f.alpha}, k.label);
        EXPECT_DOUBLE_EQ(5.0, f.mass) << k.label; // not the restrained 7, not the unlisted 50
        EXPECT_DOUBLE_EQ(50.0, f.weight) << k.label;
        EXPECT_EQ(k.mode, f.mode) << k.label;
        EXPECT_EQ(k.eigenBased, f.eigenBased) << k.label;
        EXPECT_EQ(k.eigenError, m_curve.EigenError()) << k.label;
        EXPECT_EQ(k.conversionError, m_curve.ConversionError()) << k.label;
        EXPECT_EQ(k.massError, m_curve.MassError()) << k.label;
    }
}

TEST_F(CurveData, RecordedParticipationIsUsedAsItStands)
{
    m_content.model.modes[3].participation = T_DOF6{-0.5, 9}; // the largest in X by amount
    m_content.model.modes[3].massPercent = T_DOF6{80.0};
    ASSERT_EQ(1, Calc(Settings(P::Atc40)));
    EXPECT_EQ(3, m_curve.Factors().mode);
    EXPECT_DOUBLE_EQ(1.5, m_curve.Factors().gamma); // |3 * -0.5|
    EXPECT_DOUBLE_EQ(0.8, m_curve.Factors().alpha);
}

// Pushed along (0.6, 0.8): masses 0.36 mx + 0.64 my = 1.04, 1.04, 0.68, together 2.76. Mode 1 (Y):
// L = 3, M = 7; mode 2 (X): L = 9, M = 19, of which the direction has 0.8 and 0.6. From the masses
// with the shape 1/3, 2/3, 1: S1 = 1.72, S2 = 1.04 * 5/9 + 0.68.
TEST_F(CurveData, BetweenTheAxesTakesOfEachItsShare)
{
    T_RUN_DATA run;
    run.head.turn = 1;
    run.head.angle = 53.13;
    run.head.control = {0.6, 0.8};
    run.nodes = {3};
    run.steps.resize(1);
    run.steps[0].baseReaction = 20e3;
    run.displacement = {{{0.06, 0.08}}};
    m_content.turnedResults[{1, 1}] = MakePushRun(run);
    const double S2 = 1.04 * 5.0 / 9.0 + 0.68;
    const struct {
        int pattern;
        bool eigen;
        double gamma, alpha;
    } kRows[] = {{0, true, 0.64 * 9.0 / 7.0, 0.64 * 9.0 / 7.0 / 2.76}, // the larger factor
                 {2, true, 0.36 * 27.0 / 19.0, 0.36 * 81.0 / 19.0 / 2.76},
                 {2, false, 1.72 / S2, 1.72 * 1.72 / S2 / 2.76}};
    m_push.modes = {2};
    for (const auto& row : kRows) {
        m_push.patternKind = row.pattern;
        T_PUSH_CURVE_SETTINGS settings = Settings(P::Atc40, row.eigen);
        settings.turn = 1;
        ASSERT_EQ(1, Calc(settings)) << m_curve.Error();
        EXPECT_NEAR(2.76, m_curve.Factors().mass, 1e-12);
        EXPECT_NEAR(row.gamma, m_curve.Factors().gamma, 1e-12);
        EXPECT_NEAR(row.alpha, m_curve.Factors().alpha, 1e-12);
        EXPECT_NEAR(0.1 / row.gamma, m_curve.Displacement()[1], 1e-12);
        EXPECT_NEAR(20.0 / (2.76 * 10.0 * row.alpha), m_curve.Force()[1], 1e-12);
        EXPECT_EQ("PX@53.13", m_curve.LoadCase().name);
        EXPECT_EQ(2, m_curve.LoadCase().direction);
    }
}

// Shape -2, -1, 1 in X: S1 = -4 - 2 + 1, S2 = 8 + 2 + 1; the curve itself stays positive.
TEST_F(CurveData, MassBasedGammaKeepsItsSignAndAVanishingOneIsAnError)
{
    m_content.model.modes[2].shape = {{1, {-2}}, {2, {-1}}, {3, {1}}};
    m_push.patternKind = 2;
    m_push.modes = {2};
    ASSERT_EQ(1, Calc(Settings(P::Atc40, false)));
    EXPECT_DOUBLE_EQ(-5.0 / 11.0, m_curve.Factors().gamma);
    EXPECT_DOUBLE_EQ(25.0 / 55.0, m_curve.Factors().alpha);
    EXPECT_FALSE(m_curve.ConversionError());
    EXPECT_DOUBLE_EQ(0.03 * 11.0 / 5.0, m_curve.Displacement()[1]);
    ASSERT_EQ(1, Calc(Settings(P::Atc40, true)));
    EXPECT_DOUBLE_EQ(5.0 / 11.0, m_curve.Factors().gamma); // by the mode: its amount

    // -1.4 + 1.2 + 0.2, rounding
    m_content.model.modes[2].shape = {{1, {-0.7}}, {2, {0.6}}, {3, {0.2}}};
    ASSERT_EQ(1, Calc(Settings(P::Atc40, false)));
    EXPECT_TRUE(m_curve.ConversionError());
}

TEST_F(CurveData, StartsAtATenthOfTheFirstStepAndTransformsByPlotType)
{
    struct T_ROW {
        P type;
        double dx; // factor on 0.03, 0.09, 0.06 m
        T_NUMBERS y;
    };
    const T_ROW rows[] = {
        {P::BaseReaction, 1.0, {1.0, 10.0, 18.0, 20.0}},
        {P::ShearCoeff, 1.0, {0.02, 0.2, 0.36, 0.4}}, // W = 5 * 10 kN
        {P::Drift, 1.0 / 9, {0.02, 0.2, 0.36, 0.4}},  // control node 9 m from the ground
        {P::LoadFactor, 1.0, {0.05, 0.5, 1.0, 1.5}},
    };
    for (const T_ROW& r : rows) {
        ASSERT_EQ(1, Calc(Settings(r.type)));
        const std::string label = std::to_string(static_cast<int>(r.type));
        ExpectNear({0.003 * r.dx, 0.03 * r.dx, 0.09 * r.dx, 0.06 * r.dx}, m_curve.Displacement(),
                   label);
        ExpectNear(r.y, m_curve.Force(), label);
        EXPECT_DOUBLE_EQ(0.09 * r.dx, m_curve.MaxDisplacement()) << label;
        EXPECT_DOUBLE_EQ(r.y[3], m_curve.MaxForce()) << label;
        EXPECT_EQ(3, m_curve.FirstDecreasingStep());
    }
    double x = -2.0, y = -3.0;
    m_curve.TransformByPlotType(P::BaseReaction, x, y); // not even made absolute
    EXPECT_EQ(-5.0, x + y);
}

TEST_F(CurveData, ExtraNodesKeepTheirZeroAndRaiseTheLargestDisplacement)
{
    T_PUSH_DATA data;
    data.loadFactor = data.baseReaction = {1, 2};
    data.displacement = {{3, {0.1, 0.2}}, {1, {0.1, -0.7}}};
    m_content.results[1] = MakePushResult(data);
    T_PUSH_CURVE_SETTINGS s = Settings(P::Atc40);
    s.extraNodes = {1.9, 5.0, -1.0, 0.0}; // kept as reals; 5 has no results
    ASSERT_EQ(1, Calc(s));
    ExpectNear({0.0, 0.1 / kGamma, 0.7 / kGamma}, m_curve.ExtraDisplacement(0), "1");
    for (std::size_t i = 1; i < 4; ++i)
        EXPECT_EQ((T_NUMBERS{0, 0, 0}), m_curve.ExtraDisplacement(i));
    EXPECT_DOUBLE_EQ(0.7 / kGamma, m_curve.MaxDisplacement());
}

// Node 1 goes back to 0.7 at the last step, after 3 has led.
TEST_F(CurveData, AnotherControlOptionTakesTheNodeThatHasMovedMostAtTheEnd)
{
    T_PUSH_DATA data;
    data.loadFactor = data.baseReaction = {1, 2};
    data.displacement = {{2, {0.9, 0.1}}, {3, {0.5, 0.6}}, {1, {0.1, -0.7}}};
    m_content.results[1] = MakePushResult(data);
    for (const int option : {1, 2}) {
        m_push.controlOption = option;
        ASSERT_EQ(1, Calc(Settings(P::BaseReaction)));
        EXPECT_EQ(option == 1 ? 3 : 1, m_curve.LoadCase().controlNode);
        EXPECT_DOUBLE_EQ(option == 1 ? 0.6 : 0.7, m_curve.Displacement().back());
    }
}

TEST_F(CurveData, WeightAndHeightHaveTheirFallBacks)
{
    for (auto& entry : m_content.model.nodes)
        entry.second.mass[2] = 0.0;
    m_content.model.nodes[3].xyz[2] = 0.0;
    T_PUSH_CURVE_SETTINGS s = Settings(P::Drift);
    for (const double weight : {40.0, 0.0}) {
        s.userWeight = weight;
        ASSERT_EQ(1, Calc(s));
        EXPECT_DOUBLE_EQ(10.0 / (weight > 0.0 ? weight : 1e-19), m_curve.Force()[1]);
        EXPECT_DOUBLE_EQ(0.03 / 1e-19, m_curve.Displacement()[1]);
    }
}

TEST_F(CurveData, OtherDirections)
{
    const auto calc = [&](int direction, bool eigen) {
        m_push.direction = direction;
        ASSERT_EQ(1, Calc(Settings(P::Atc40, eigen)));
    };
    calc(3, true);
    EXPECT_EQ(P::LoadFactor, m_curve.PlotType()); // a vertical push has the load factor alone
    EXPECT_DOUBLE_EQ(0.5, m_curve.Force()[1]);
    calc(2, true); // Y: masses 0.5 each, shape 1, 2, 3
    EXPECT_EQ(1, m_curve.Factors().mode);
    EXPECT_DOUBLE_EQ(3.0 * 6.0 / 14.0, m_curve.Factors().gamma);
    EXPECT_DOUBLE_EQ(1.5, m_curve.Factors().mass);
    calc(5, false); // a rotation has no mass
    EXPECT_TRUE(m_curve.ConversionError() && m_curve.MassError());
    EXPECT_EQ((T_NUMBERS{0, 0, 0, 0}), m_curve.Force());
}

TEST_F(CurveData, RefusesWhatCanNotBeRead)
{
    const auto errorOf = [&](int pushover) {
        T_PUSH_CURVE_SETTINGS s = Settings(P::Atc40);
        s.pushover = pushover;
        EXPECT_EQ(0, Calc(s));
        return m_curve.Error();
    };
    EXPECT_EQ("no such pushover load case", errorOf(2));
    m_push.controlNode = 5;
    EXPECT_EQ("the control node has no results", errorOf(1));
    m_content.model.nodes.erase(5);
    EXPECT_EQ("the control node is not in the model", errorOf(1));
    m_content = Sample();
    m_content.results.clear();
    EXPECT_EQ("the pushover load case has no results", errorOf(1));
    m_content = ThreeMasses({0.03, 0.03}, {10, 10}); // standing still is not going back
    ASSERT_EQ(1, Calc(Settings(P::BaseReaction)));
    EXPECT_EQ(0, m_curve.FirstDecreasingStep());
}
