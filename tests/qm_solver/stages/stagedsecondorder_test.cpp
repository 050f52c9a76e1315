// Axial forces and cable sag, against closed forms and equations solved by bisection.
#include "staged.h"

#include "qm_solver/element/cablesag.h"

#include <cmath>
#include <functional>

namespace {

using namespace sample;

constexpr auto kBeam = ELEMENT_KIND::Beam;
constexpr auto kTruss = ELEMENT_KIND::Truss;
constexpr double kE = 2.1e8, kA = 5.4e-3, kIy = 3.7e-5, kEA = kE * kA, kEI = kE * kIy;

double Root(const std::function<double(double)>& f, double low, double high)
{
    for (int k = 0; k < 200; ++k) {
        const double middle = 0.5 * (low + high);
        ((f(middle) > 0) == (f(high) > 0) ? high : low) = middle;
    }
    return 0.5 * (low + high);
}

// ---- geometric stiffness ------------------------------------------------------------------------

constexpr double kHeight = 6.0;

/// Column along Z in equal pieces, free in the plane X-Z, clamped at the foot.
T_STAGED_MODEL Column(std::size_t pieces)
{
    T_FRAME frame = Empty();
    for (std::size_t i = 0; i <= pieces; ++i) {
        AddNode(frame, {0, 0, kHeight * double(i) / double(pieces)});
        Fix(frame, i, {1, 3, 5});
        if (i > 0) Join(frame, kBeam, i - 1, i);
    }
    FixAll(frame, 0);
    T_STAGED_MODEL model = OneStage(frame, 2);
    model.options.geometricStiffness = true;
    for (T_ELEMENT& e : model.frame.elements)
        e.zAxis = {0, 1, 0}; // bends about local z, whose inertia is Iz
    model.frame.sections[0].Iz = kIy;
    return model;
}

std::vector<T_LOAD_CASE> Push(std::size_t top, double p, double h)
{
    std::vector<T_LOAD_CASE> cases(2);
    cases[0].nodal.push_back({top, {0, 0, -p, 0, 0, 0}});
    cases[1].nodal.push_back({top, {h, 0, 0, 0, 0, 0}});
    return cases;
}

TEST(StagedSecondOrder, ACantileverColumnFollowsTheTangent)
{
    // delta = H / P (tan kL / k - L), moment at x: H sin k(L - x) / (k cos kL), k2 = P / EI.
    const std::size_t pieces = 16;
    const double h = 3.0, critical = kEI * std::pow(std::acos(-1.0) / (2 * kHeight), 2);
    for (const double share : {0.2, 0.5, 0.8}) {
        const double p = share * critical, k = std::sqrt(p / kEI), kl = k * kHeight;
        CStagedSolver staged;
        Build(staged, Column(pieces), Push(pieces, p, h));
        T_RESULT r;
        ASSERT_TRUE(staged.ReadSum(0, kLastStep, STAGE_SUM::All, r));
        const double tip = h / p * (std::tan(kl) / k - kHeight);
        EXPECT_NEAR(tip, r.displacement[pieces][0], 1e-6 * tip) << share;
        const double foot = h * std::tan(kl) / k;
        EXPECT_NEAR(foot, std::fabs(r.reaction[0][4]), 1e-6 * foot);
        EXPECT_NEAR(-h, r.reaction[0][0], 1e-9 * h);
        for (const std::size_t piece : {0, 7})
            for (std::size_t at = 0; at < kBeamPositions; ++at) {
                const double x = kHeight * (double(piece) + 0.25 * double(at)) / double(pieces);
                EXPECT_NEAR(h * std::sin(k * (kHeight - x)) / (k * std::cos(kl)),
                            std::fabs(r.force[piece][at][5]), 2e-5 * foot)
                    << share << " " << piece << " " << at;
            }
        // The push gives all the bending, the load alone none: given N the cases superpose.
        EXPECT_NEAR(tip, Case(staged, 0, 1).displacement[pieces][0], 1e-6 * tip);
        EXPECT_NEAR(0, Case(staged, 0, 0).displacement[pieces][0], 1e-12);
    }
}

TEST(StagedSecondOrder, OnePieceBalancesWithAHingeAndShearDeformation)
{
    // Base moment = H L + P delta whatever the shape, also where the column is one flexible piece.
    T_STAGED_MODEL model = Column(1);
    model.frame.sections[0].Asy = 1e-3;
    model.frame.elements[0].releaseJ[5] = true;
    model.stages[0].activateSupports[1] = {1, {false, true, false, true, true, true}};
    CStagedSolver staged;
    Build(staged, model, Push(1, 100.0, 3.0));
    T_RESULT r;
    ASSERT_TRUE(staged.ReadSum(0, kLastStep, STAGE_SUM::All, r));
    const double delta = r.displacement[1][0];
    EXPECT_GT(delta, 3.0 * 216 / (3 * kEI));
    EXPECT_NEAR(3.0 * kHeight + 100.0 * delta, std::fabs(r.force[0][0][5]), 1e-9);
    EXPECT_NEAR(0, r.force[0][4][5], 1e-9); // at the hinge, summed up from the foot
}

TEST(StagedSecondOrder, AColumnBeyondItsLoadBuckles)
{
    // Euler's load PE of the cantilever; with shear deformation PE / (1 + PE / G As) (Engesser).
    const double euler = kEI * std::pow(std::acos(-1.0) / (2 * kHeight), 2);
    const double shearArea = 2 * euler / 8.1e7;
    for (const bool shear : {false, true})
        for (const bool above : {false, true}) {
            T_STAGED_MODEL model = Column(8);
            if (shear) model.frame.sections[0].Asy = shearArea;
            CStagedSolver staged;
            T_SOLVER_ERROR error;
            ASSERT_TRUE(staged.Prepare(model, error));
            const double critical = shear ? euler / 1.5 : euler;
            const int done = staged.Run(Push(8, (above ? 1.01 : 0.99) * critical, 0.0), error);
            EXPECT_EQ(above ? 0 : 1, done) << shear;
            if (!above) continue;
            EXPECT_EQ(SOLVER_FAULT::Mechanism, error.fault);
            EXPECT_EQ(0, error.stage);
            EXPECT_NE(std::string::npos, error.reason.Text().find("buckles"));
        }
}

TEST(StagedSecondOrder, ATightStringStiffensAcrossItself)
{
    // Two strings of 5 with tension T: a load across gives P L / 2T; without T it is a mechanism.
    T_FRAME frame = Empty();
    for (const double x : {0.0, 5.0, 10.0})
        AddNode(frame, {x, 0, 0});
    for (const std::size_t n : {0, 1, 2})
        Fix(frame, n, {1});
    Fix(frame, 0, {0, 2});
    Fix(frame, 2, {0, 2});
    Join(frame, kTruss, 0, 1);
    Join(frame, kTruss, 1, 2);
    T_STAGED_MODEL model = OneStage(frame, 1);
    model.options.geometricStiffness = true;
    T_LOAD_CASE load;
    CStagedSolver staged;
    for (const double tension : {50.0, 1e-4}) { // also one of no weight beside the stiffness
        load.pretension = {{0, tension}, {1, tension}};
        load.nodal = {{1, {0, 0, -tension / 25, 0, 0, 0}}};
        Build(staged, model, {load});
        const T_RESULT r = Case(staged, 0, 0);
        EXPECT_NEAR(-0.1, r.displacement[1][2], 1e-12) << tension;
        EXPECT_NEAR(tension / 50, r.reaction[0][2], 1e-12 * tension);
        EXPECT_NEAR(-tension, r.reaction[0][0], 1e-9 * tension);
    }
    load.pretension.clear();
    T_SOLVER_ERROR error;
    EXPECT_FALSE(staged.Run(std::vector<T_LOAD_CASE>{load}, error));
    EXPECT_EQ(SOLVER_FAULT::Mechanism, error.fault);
    EXPECT_EQ(1, error.node);
}

// ---- sag ----------------------------------------------------------------------------------------

TEST(StagedSecondOrder, ErnstsModulusFollowsTheParabola)
{
    // Derivative of the chord of a shallow parabola: N L / EA - (w a)^2 L / (24 N^2), inclined.
    T_FRAME frame = Empty();
    frame.materials[0].density = 7.85;
    AddNode(frame, {0, 0, 0});
    AddNode(frame, {60, 30, 40});
    Join(frame, kTruss, 0, 1);
    const double w = 7.85 * kA * frame.gravity, plan = std::hypot(60.0, 30.0),
                 length = std::sqrt(3600 + 900 + 1600.0);
    const auto chord = [&](double n) {
        return n * length / kEA - std::pow(w * plan / n, 2) * length / 24;
    };
    for (const double n : {50.0, 100.0, 1000.0}) {
        const double step = 1e-4 * n, slope = (chord(n + step) - chord(n - step)) / (2 * step);
        EXPECT_NEAR(length / kEA / slope, SagFactor(frame, frame.elements[0], n), 1e-7);
    }
    EXPECT_EQ(1e-3, SagFactor(frame, frame.elements[0], -5.0));
    EXPECT_EQ(1e-3, SagFactor(frame, frame.elements[0], 1e-3));
    frame.nodes[1].xyz = {0, 0, 40};
    EXPECT_EQ(1.0, SagFactor(frame, frame.elements[0], -5.0));
}

constexpr double kBelow = 500.0; // spring below the node

/// Two cables from (-+40, 0, 30) to a node at the origin, which stands on a spring.
T_STAGED_MODEL Hanger(bool geometric)
{
    T_FRAME frame = Empty();
    frame.materials[0].density = 7.85;
    AddNode(frame, {0, 0, 0});
    Fix(frame, 0, {0, 1});
    for (const double x : {-40.0, 40.0}) {
        const std::size_t anchor = AddNode(frame, {x, 0, 30});
        Fix(frame, anchor, {0, 1, 2});
        Join(frame, kTruss, 0, anchor);
    }
    Join(frame, ELEMENT_KIND::Spring, 0, 0, {0, 0, kBelow, 0, 0, 0});
    T_STAGED_MODEL model = OneStage(frame, 2);
    model.options = {BIRTH::OnDeformed, geometric, true};
    model.stages[0].steps = 2;
    model.stages[0].activateLoads = {{0, 1}, {1, 2}};
    return model;
}

TEST(StagedSecondOrder, CablesWithSagBalanceTheirLoad)
{
    const double tension = 80.0, load = 90.0, length = 50.0, rise = 0.6;
    const double across = 7.85 * kA * 9.80665 * 40.0;
    for (const bool geometric : {false, true}) {
        std::vector<T_LOAD_CASE> cases(2);
        cases[0].pretension = {{0, tension}, {1, tension}};
        cases[1].nodal.push_back({0, {0, 0, -load, 0, 0, 0}});
        CStagedSolver staged;
        Build(staged, Hanger(geometric), cases);
        for (int step = 1; step <= 2; ++step) {
            // v down stretches by rise v: N = T + k(N) rise v. The cables and the spring carry P:
            // 2 N rise + 2 N / L v (1 - rise2) + spring v = P.
            const auto force = [&](double v) {
                return Root(
                    [&](double n) {
                        const double stiffness =
                            kEA / length / (1 + across * across * kEA / (12 * n * n * n));
                        return n - tension - stiffness * rise * v;
                    },
                    20.0, 400.0);
            };
            const double p = step == 2 ? load : 0.0;
            const double v = Root(
                [&](double at) {
                    const double n = force(at), leaning = geometric ? n / length * at * 0.64 : 0.0;
                    return 2 * n * rise + 2 * leaning + kBelow * at - p;
                },
                -0.2, 0.2);
            T_RESULT r;
            ASSERT_TRUE(staged.ReadSum(0, step, STAGE_SUM::All, r));
            EXPECT_NEAR(-v, r.displacement[0][2], 1e-10) << step << geometric;
            EXPECT_NEAR(force(v), r.force[0][0][0], 1e-7);
            EXPECT_NEAR(p, 2 * r.reaction[1][2] + r.reaction[0][2], 1e-7);
            const T_RESULT sum = Sum(Case(staged, 0, 0, step), Case(staged, 0, 1, step));
            ExpectSame(sum, r, 1e-10);
        }
        EXPECT_GT(staged.Cost().iterations, 2u);
        EXPECT_LT(staged.Cost().iterations, 50u);
    }
}

} // namespace
