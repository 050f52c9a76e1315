// The operations that every procedure is built on, through the plainest calculator.
#include "qm_rps/pushovercalcperfptproca.h"

#include "perfptfixture.h"
#include "qm_base/appbase.h"

#include <cmath>
#include <gtest/gtest.h>

namespace {

using CALC = CPushOverCalcPerfPtProcA;

const T_POINTS kTrapezoid{{0.0, 0.0}, {1.0, 1.0}, {2.0, 1.5}, {4.0, 2.0}};

struct T_KIT {
    CTestRecord record;
    CALC calc{record};
    explicit T_KIT(const T_POINTS& capacity, const T_DAMP_PARAM& damping = {},
                   decltype(T_SPFC_D::data) spectrum = Level(3.0))
        : record(capacity, std::move(spectrum), damping, kGravityUnit)
    {
    }
};

std::vector<std::string> TakeSources()
{
    std::vector<std::string> sources;
    for (const T_ASSERTION& a : CAppBase::TakeAssertions_ST())
        sources.push_back(a.source);
    return sources;
}
const std::vector<std::string> kOneAssertion{"src/qm_rps/pushovercalcperfptbase"};

} // namespace

TEST(PerfPtBase, BilinearHasTheAreaOfTheCurveAndItsInitialStiffness)
{
    struct T_CASE {
        const char* label;
        T_POINTS capacity;
        double dpi, api, dy, ay;
    };
    const T_POINTS hump{{0.0, 0.0}, {1.0, 1.0}, {2.0, 4.0}, {3.0, 1.0}};
    const T_CASE cases[] = {
        // by hand: dy = Sd1 (2 area - api dpi) / (Sa1 dpi - Sd1 api)
        {"end of the trapezoid", kTrapezoid, 4.0, 2.0, 1.25, 1.25},
        {"stiffness of 1/2", {{0.0, 0.0}, {2.0, 1.0}, {6.0, 2.0}}, 6.0, 2.0, 2.0, 1.0},
        {"clamped to the trial point", hump, 3.0, 1.0, 3.0, 1.0},
        {"within 0.1 of the stiffness", kTrapezoid, 2.0, 1.91, 2.0, 1.91},
        {"within 1e-12 of it", kTrapezoid, 1.0 + 5e-13, 0.7, 1.0 + 5e-13, 0.7},
    };
    for (const T_CASE& c : cases) {
        T_KIT k(c.capacity);
        double dy = 0.0, ay = 0.0;
        EXPECT_EQ(1, k.calc.BilinearizeAt(c.dpi, c.api, dy, ay)) << c.label;
        EXPECT_NEAR(c.dy, dy, 1e-14) << c.label;
        EXPECT_NEAR(c.ay, ay, 1e-14) << c.label;
    }
}

TEST(PerfPtBase, BilinearRefusesZeroPointsAndCurvesWithTooLittleArea)
{
    double dy = 7.0, ay = 8.0;
    T_KIT dip({{0.0, 0.0}, {1.0, 1.0}, {2.0, 0.0}, {3.0, 0.0}, {4.0, 2.0}}); // area 2: dy = -2
    TakeSources();
    EXPECT_EQ(0, dip.calc.BilinearizeAt(4.0, 2.0, dy, ay));
    EXPECT_TRUE(TakeSources().empty()) << "a property of the curve, not of the program";
    T_KIT k(kTrapezoid), flat({{0.0, 0.0}, {1.0, 0.0}, {2.0, 1.0}}),
        upright({{0.0, 0.0}, {0.0, 1.0}, {2.0, 2.0}});
    EXPECT_EQ(0, k.calc.BilinearizeAt(0.0, 1.0, dy, ay));
    EXPECT_EQ(0, k.calc.BilinearizeAt(1.0, 9e-14, dy, ay));
    EXPECT_EQ(0, flat.calc.BilinearizeAt(2.0, 1.0, dy, ay));
    EXPECT_EQ(0, upright.calc.BilinearizeAt(2.0, 2.0, dy, ay));
    EXPECT_EQ(std::vector(4, kOneAssertion[0]), TakeSources());
    // just outside 0.1: ratio 0.89, dy = (2 * 1.75 - 2 * 1.89) / 0.11 < 0
    EXPECT_EQ(0, k.calc.BilinearizeAt(2.0, 1.89, dy, ay));
    EXPECT_EQ(7.0, dy);
    EXPECT_EQ(8.0, ay);
}

// ATC-40 (1996) Table 8-1. The fraction is held at 0.5, so that each knee shows as a jump. The
// user's factor is 0.9 at beta1 and 0.5 at beta2, which limits the damping itself.
TEST(PerfPtBase, KappaFollowsTheBehaviourTypeOrTheUsersPoints)
{
    struct T_CASE {
        int type;
        double beta0, kappa, limited, beta1 = 0.0, beta2 = 0.0;
    };
    // clang-format off
    const T_CASE cases[] = {
        {0, 0.0, 1.0,  0.0},  {0, 16.25, 1.0, 16.25}, {0, 16.26, 0.875, 16.26}, // 1.13 - 0.255
        {1, 0.0, 0.67, 0.0},  {1, 25.0, 0.67, 25.0},  {1, 25.01, 0.622, 25.01}, // .845 - .223
        {2, 0.0, 0.33, 0.0},  {2, 45.0, 0.33, 45.0},  {4, 10.0, 0.0, 10.0}, {-1, 10.0, 0.0, 10.0},
        {3,  5.0, 0.9,  5.0, 10, 30}, {3, 15.0, 0.8, 15.0, 10, 30}, {3, 31.0, 0.5, 30.0, 10, 30},
        {3, 20.0, 0.9, 20.0, 20, 20}, {3, 21.0, 0.5, 20.0, 20, 20},
    };
    // clang-format on
    for (const T_CASE& c : cases) {
        T_KIT k(kTrapezoid, {c.type, 5.0, c.beta1, 0.9, c.beta2, 0.5});
        double beta0 = c.beta0;
        EXPECT_NEAR(c.kappa, k.calc.GetDampingModificationFactor(c.type, beta0, 0.5), 1e-14)
            << c.type << " " << c.beta0;
        EXPECT_EQ(c.limited, beta0) << c.type << " " << c.beta0;
    }
}

TEST(PerfPtBase, EffectiveDampingAndReductionOfABilinearSystem)
{
    struct T_CASE {
        const char* label;
        T_DAMP_PARAM damping;
        double dpi, beta, SRa, SRv;
    };
    // Yield at (1, 1), plateau: the fraction is (mu - 1) / mu. Pocket calculator.
    const T_CASE cases[] = {
        {"A, 31.85 %", {0}, 2.0, 32.86875, 0.393908, 0.532161},
        {"A, cut to 45 %", {0}, 10.0, 39.637284, 0.333847, 0.485633},
        {"C, cut to 45 %", {2}, 10.0, 19.85, 0.555670, 0.657477},
        {"other elastic damping", {2, 2.0}, 10.0, 16.85, 0.608227, 0.698192},
        {"user, beta0 limited to 30", {3, 5.0, 10, 0.9, 30, 0.5}, 2.0, 20.0, 0.553256, 0.655606},
    };
    for (const T_CASE& c : cases) {
        T_KIT k(kTrapezoid, c.damping);
        double SRa = 0.0, SRv = 0.0, beta = 0.0;
        EXPECT_EQ(1, k.calc.CalcSpectralReductionFactors(1.0, 1.0, c.dpi, 1.0, SRa, SRv, beta));
        EXPECT_NEAR(c.beta, beta, 5e-7) << c.label;
        EXPECT_NEAR(c.SRa, SRa, 5e-7) << c.label;
        EXPECT_NEAR(c.SRv, SRv, 5e-7) << c.label;
    }
}

TEST(PerfPtBase, NegativeOrUndefinedDampingIsRefused)
{
    T_KIT k(kTrapezoid, {3, 5.0, 10, -2.0, 30, -2.0});
    double SRa = 7.0, SRv = 8.0, beta = 9.0;
    TakeSources();
    EXPECT_EQ(0, k.calc.CalcSpectralReductionFactors(1.0, 1.0, 2.0, 1.0, SRa, SRv, beta)); // -55
    EXPECT_EQ(kOneAssertion, TakeSources());
    EXPECT_EQ(0, k.calc.CalcSpectralReductionFactors(1.0, 1.0, 0.0, 0.0, SRa, SRv, beta)) << "0/0";
    T_KIT none(kTrapezoid, {4, 0.0}); // kappa 0, nothing elastic: no logarithm
    EXPECT_EQ(0, none.calc.CalcSpectralReductionFactors(1.0, 1.0, 2.0, 1.0, SRa, SRv, beta));
    EXPECT_EQ(7.0, SRa);
    EXPECT_EQ(8.0, SRv);
    EXPECT_EQ(9.0, beta);
}

TEST(PerfPtBase, ElasticDampingIsBelowTheSettingOrAtTheConstantFive)
{
    struct T_CASE {
        double setting, beta;
        bool elastic;
    };
    const T_CASE cases[] = {{7.0, 6.99, true},    {7.0, 7.0, false},   {2.0, 1.99, true},
                            {2.0, 2.0, false},    {2.0, 5.0009, true}, {2.0, 4.9991, true},
                            {2.0, 5.0011, false}, {2.0, 4.9989, false}};
    for (const T_CASE& c : cases)
        EXPECT_EQ(c.elastic, T_KIT(kTrapezoid, {0, c.setting}).calc.IsElasticDamping(c.beta))
            << c.setting << " " << c.beta;
}

TEST(PerfPtBase, CapacityAccelerationIsNotFoundAtTheLastPoint)
{
    T_KIT k({{0.5, 0.5}, {1.0, 1.0}, {2.0, 1.5}, {1.5, 2.0}, {3.0, 0.0}}); // turns back
    const double worked[][2] = {{0.5, 0.5}, {0.75, 0.75}, {1.8, 1.4}, {2.0, 4.0 / 3.0}};
    for (const auto& [d, expected] : worked) {
        double a = -1.0;
        EXPECT_EQ(1, k.calc.GetCapacityAccelAt(d, a)) << d;
        EXPECT_NEAR(expected, a, 1e-14) << d;
    }
    double a = 7.0;
    for (const double d : {0.49, 3.0, 3.1, std::nan("")})
        EXPECT_EQ(0, k.calc.GetCapacityAccelAt(d, a)) << d;
    EXPECT_EQ(7.0, a);
}

TEST(PerfPtBase, FirstSlopeChangeIsMeasuredRelativeToThePointBefore)
{
    struct T_CASE {
        T_POINTS capacity;
        int result;
        T_POINT2 point;
        std::size_t assertions;
    };
    const T_CASE cases[] = {
        {{{1, 1}, {2, 2}}, 0, {0, 0}, 0},
        {{{1, 1}, {2, 2}, {3, 2.5}, {4, 4}}, 1, {2, 2}, 0}, // 1 against 0.5
        {{{1, 1}, {2, 2}, {3, 2.91}}, 0, {3, 2.91}, 0},     // 1 against 0.91
        {{{0, 0}, {1, 1}, {2, 1.2}}, 0, {0, 0}, 1},         // from the origin
        {{{1, 1}, {2, 2}, {3, 3}, {4, 0}}, 1, {3, 3}, 0},
    };
    for (const T_CASE& c : cases) {
        T_KIT k(c.capacity);
        TakeSources();
        T_POINT2 p;
        const std::string label = "row " + std::to_string(&c - cases);
        EXPECT_EQ(c.result, k.calc.FindFirstSlopeChange(p.x, p.y)) << label;
        EXPECT_EQ((std::pair{c.point.x, c.point.y}), (std::pair{p.x, p.y})) << label;
        EXPECT_EQ(c.assertions, TakeSources().size()) << label;
    }
}
