#include "qm_rps/pushover/pushovercurvedata.h"

#include "pushsample.h"

#include <gtest/gtest.h>

namespace {

using P = PLOT_TYPE;
using Numbers = std::vector<double>;

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

void ExpectNear(const Numbers& expected, const Numbers& actual, const std::string& label)
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

} // namespace

TEST(CurveData, FactorsByModeAndByMass)
{
    for (const T_FACTOR_CASE& k : kFactorCases) {
        CDBDoc doc;
        T_MODEL_CONTENT c = Sample();
        c.model.pushovers[1].patternKind = k.pattern;
        c.model.pushovers[1].modes = k.modes;
        doc.Data().Assign(c);
        CPushOverCurveData curve(doc);
        ASSERT_EQ(1, curve.Calc(Settings(k.type, k.eigen))) << k.label << curve.Error();
        const T_PUSH_FACTORS& f = curve.Factors();
        ExpectNear({k.gamma, k.alpha}, {f.gamma, f.alpha}, k.label);
        EXPECT_DOUBLE_EQ(5.0, f.mass) << k.label; // not the restrained 7, not the unlisted 50
        EXPECT_DOUBLE_EQ(50.0, f.weight) << k.label;
        EXPECT_EQ(k.mode, f.mode) << k.label;
        EXPECT_EQ(k.eigenBased, f.eigenBased) << k.label;
        EXPECT_EQ(k.eigenError, curve.EigenError()) << k.label;
        EXPECT_EQ(k.conversionError, curve.ConversionError()) << k.label;
        EXPECT_EQ(k.massError, curve.MassError()) << k.label;
    }
}

TEST(CurveData, RecordedParticipationIsUsedAsItStands)
{
    CDBDoc doc;
    T_MODEL_CONTENT c = Sample();
    c.model.modes[3].participation = T_DOF6{-0.5, 9}; // the largest in X by amount
    c.model.modes[3].massPercent = T_DOF6{80.0};
    doc.Data().Assign(c);
    CPushOverCurveData curve(doc);
    ASSERT_EQ(1, curve.Calc(Settings(P::Atc40)));
    EXPECT_EQ(3, curve.Factors().mode);
    EXPECT_DOUBLE_EQ(1.5, curve.Factors().gamma); // |3 * -0.5|
    EXPECT_DOUBLE_EQ(0.8, curve.Factors().alpha);
}

// Shape -2, -1, 1 in X: S1 = -4 - 2 + 1, S2 = 8 + 2 + 1; the curve itself stays positive.
TEST(CurveData, MassBasedGammaKeepsItsSignAndAVanishingOneIsAnError)
{
    CDBDoc doc;
    T_MODEL_CONTENT c = Sample();
    c.model.modes[2].shape = {{1, {-2}}, {2, {-1}}, {3, {1}}};
    c.model.pushovers[1].patternKind = 2;
    c.model.pushovers[1].modes = {2};
    doc.Data().Assign(c);
    CPushOverCurveData curve(doc);
    ASSERT_EQ(1, curve.Calc(Settings(P::Atc40, false)));
    EXPECT_DOUBLE_EQ(-5.0 / 11.0, curve.Factors().gamma);
    EXPECT_DOUBLE_EQ(25.0 / 55.0, curve.Factors().alpha);
    EXPECT_FALSE(curve.ConversionError());
    EXPECT_DOUBLE_EQ(0.03 * 11.0 / 5.0, curve.Displacement()[1]);
    ASSERT_EQ(1, curve.Calc(Settings(P::Atc40, true)));
    EXPECT_DOUBLE_EQ(5.0 / 11.0, curve.Factors().gamma); // by the mode: its amount

    c.model.modes[2].shape = {{1, {-0.7}}, {2, {0.6}}, {3, {0.2}}}; // -1.4 + 1.2 + 0.2, rounding
    doc.Data().Assign(c);
    ASSERT_EQ(1, curve.Calc(Settings(P::Atc40, false)));
    EXPECT_TRUE(curve.ConversionError());
}

TEST(CurveData, StartsAtATenthOfTheFirstStepAndTransformsByPlotType)
{
    struct T_ROW {
        P type;
        double dx; // factor on 0.03, 0.09, 0.06 m
        Numbers y;
    };
    const T_ROW rows[] = {
        {P::BaseReaction, 1.0, {1.0, 10.0, 18.0, 20.0}},
        {P::ShearCoeff, 1.0, {0.02, 0.2, 0.36, 0.4}}, // W = 5 * 10 kN
        {P::Drift, 1.0 / 9, {0.02, 0.2, 0.36, 0.4}},  // control node 9 m from the ground
        {P::LoadFactor, 1.0, {0.05, 0.5, 1.0, 1.5}},
    };
    CDBDoc doc;
    doc.Data().Assign(Sample());
    CPushOverCurveData curve(doc);
    for (const T_ROW& r : rows) {
        ASSERT_EQ(1, curve.Calc(Settings(r.type)));
        const std::string label = std::to_string(static_cast<int>(r.type));
        ExpectNear({0.003 * r.dx, 0.03 * r.dx, 0.09 * r.dx, 0.06 * r.dx}, curve.Displacement(),
                   label);
        ExpectNear(r.y, curve.Force(), label);
        EXPECT_DOUBLE_EQ(0.09 * r.dx, curve.MaxDisplacement()) << label;
        EXPECT_DOUBLE_EQ(r.y[3], curve.MaxForce()) << label;
        EXPECT_EQ(3, curve.FirstDecreasingStep());
    }
    double x = -2.0, y = -3.0;
    curve.TransformByPlotType(P::BaseReaction, x, y); // not even made absolute
    EXPECT_EQ(-5.0, x + y);
}

TEST(CurveData, ExtraNodesKeepTheirZeroAndRaiseTheLargestDisplacement)
{
    CDBDoc doc;
    T_MODEL_CONTENT c = Sample();
    T_PUSH_DATA data;
    data.loadFactor = data.baseReaction = {1, 2};
    data.displacement = {{3, {0.1, 0.2}}, {1, {0.1, -0.7}}};
    c.results[1] = MakePushResult(data);
    doc.Data().Assign(c);
    CPushOverCurveData curve(doc);
    T_PUSH_CURVE_SETTINGS s = Settings(P::Atc40);
    s.extraNodes = {1.9, 5.0, -1.0, 0.0}; // kept as reals; 5 has no results
    ASSERT_EQ(1, curve.Calc(s));
    ExpectNear({0.0, 0.1 / kGamma, 0.7 / kGamma}, curve.ExtraDisplacement(0), "1");
    for (std::size_t i = 1; i < 4; ++i)
        EXPECT_EQ((Numbers{0, 0, 0}), curve.ExtraDisplacement(i));
    EXPECT_DOUBLE_EQ(0.7 / kGamma, curve.MaxDisplacement());
}

TEST(CurveData, WeightAndHeightHaveTheirFallBacks)
{
    CDBDoc doc;
    T_MODEL_CONTENT c = Sample();
    for (auto& entry : c.model.nodes)
        entry.second.mass[2] = 0.0;
    c.model.nodes[3].xyz[2] = 0.0;
    doc.Data().Assign(c);
    CPushOverCurveData curve(doc);
    T_PUSH_CURVE_SETTINGS s = Settings(P::Drift);
    for (const double weight : {40.0, 0.0}) {
        s.userWeight = weight;
        ASSERT_EQ(1, curve.Calc(s));
        EXPECT_DOUBLE_EQ(10.0 / (weight > 0.0 ? weight : 1e-19), curve.Force()[1]);
        EXPECT_DOUBLE_EQ(0.03 / 1e-19, curve.Displacement()[1]);
    }
}

TEST(CurveData, OtherDirections)
{
    CDBDoc doc;
    CPushOverCurveData curve(doc);
    const auto calc = [&](int direction, bool eigen) {
        T_MODEL_CONTENT c = Sample();
        c.model.pushovers[1].direction = direction;
        doc.Data().Assign(c);
        ASSERT_EQ(1, curve.Calc(Settings(P::Atc40, eigen)));
    };
    calc(3, true);
    EXPECT_EQ(P::LoadFactor, curve.PlotType()); // a vertical push has the load factor alone
    EXPECT_DOUBLE_EQ(0.5, curve.Force()[1]);
    calc(2, true); // Y: masses 0.5 each, shape 1, 2, 3
    EXPECT_EQ(1, curve.Factors().mode);
    EXPECT_DOUBLE_EQ(3.0 * 6.0 / 14.0, curve.Factors().gamma);
    EXPECT_DOUBLE_EQ(1.5, curve.Factors().mass);
    calc(5, false); // a rotation has no mass
    EXPECT_TRUE(curve.ConversionError() && curve.MassError());
    EXPECT_EQ((Numbers{0, 0, 0, 0}), curve.Force());
}

TEST(CurveData, TellsWhatIsMissing)
{
    CDBDoc doc;
    T_MODEL_CONTENT c = Sample();
    CPushOverCurveData curve(doc);
    c.model.nodes[2].restraint[0] = 1; // the second storey keeps only restrained masses
    doc.Data().Assign(c);
    ASSERT_EQ(1, curve.Calc(Settings(P::Atc40, false)));
    EXPECT_TRUE(curve.StoreyWithoutMass());
    EXPECT_FALSE(curve.ConversionError() || curve.MassError());
    ASSERT_EQ(1, curve.Calc(Settings(P::Atc40, true))); // asked for with mass-based factors only
    EXPECT_FALSE(curve.StoreyWithoutMass());
}

TEST(CurveData, RefusesWhatCanNotBeRead)
{
    CDBDoc doc;
    CPushOverCurveData curve(doc);
    const auto errorOf = [&](const T_MODEL_CONTENT& c, int pushover) {
        doc.Data().Assign(c);
        T_PUSH_CURVE_SETTINGS s = Settings(P::Atc40);
        s.pushover = pushover;
        EXPECT_EQ(0, curve.Calc(s));
        return curve.Error();
    };
    T_MODEL_CONTENT c = Sample();
    EXPECT_EQ("no such pushover load case", errorOf(c, 2));
    c.model.pushovers[1].controlNode = 5;
    EXPECT_EQ("the control node has no results", errorOf(c, 1));
    c.model.nodes.erase(5);
    EXPECT_EQ("the control node is not in the model", errorOf(c, 1));
    c = Sample();
    c.results.clear();
    EXPECT_EQ("the pushover load case has no results", errorOf(c, 1));
    doc.Data().Assign(ThreeMasses({0.03, 0.03}, {10, 10})); // standing still is not going back
    ASSERT_EQ(1, curve.Calc(Settings(P::BaseReaction)));
    EXPECT_EQ(0, curve.FirstDecreasingStep());
}
