// Modes through CFrameSolver against closed forms.
#include "qm_solver/framesolver.h"

#include "frames.h"

#include <gtest/gtest.h>

#include <cmath>
#include <numbers>

namespace {

using namespace sample;
using std::numbers::pi;

constexpr int X = 0, Y = 1, Z = 2, RX = 3, RY = 4, RZ = 5;

std::vector<T_MODE> Modes(const T_FRAME& frame, std::size_t count)
{
    CFrameSolver solver;
    T_SOLVER_ERROR error;
    std::vector<T_MODE> modes;
    EXPECT_EQ(1, solver.Prepare(frame, error)) << error.reason.Text();
    EXPECT_EQ(1, solver.Modes(count, modes, error)) << error.reason.Text();
    return modes;
}

/// A beam of length 6 along X in `parts` elements that moves along Z alone; its ends as stated.
T_FRAME Beam(std::size_t parts, const std::vector<int>& left, const std::vector<int>& right)
{
    T_FRAME frame = Empty();
    frame.materials[0].density = 7.85;
    for (std::size_t i = 0; i <= parts; ++i)
        Fix(frame, AddNode(frame, {6.0 * double(i) / double(parts), 0, 0}), {X, Y, RX, RZ});
    for (std::size_t i = 0; i < parts; ++i)
        Join(frame, ELEMENT_KIND::Beam, i, i + 1);
    Fix(frame, 0, left);
    Fix(frame, parts, right);
    return frame;
}

/// omega^2 = (beta L)^4 EI / (rho A L^4).
double BeamOmega2(double betaL)
{
    return std::pow(betaL / 6.0, 4) * 2.1e8 * 3.7e-5 / (7.85 * 5.4e-3);
}

TEST(Modes, OfASimpleBeamAreTheClosedFormWithTheErrorOfLumpedMass)
{
    // Lumping the mass replaces the integral over the beam's influence line by the trapezoidal
    // rule. Its Euler-Maclaurin remainder at the kink of the third derivative lowers omega^2 by
    // s^4 / 720 + 10 s^6 / 30240, s = k pi / N; the next term is 35 s^8 / 1209600.
    constexpr double kParts = 40.0;
    const std::vector<T_MODE> modes = Modes(Beam(40, {Z}, {Z}), 6);
    ASSERT_EQ(6u, modes.size());
    for (std::size_t i = 0; i < 6; ++i) {
        const double k = double(i) + 1.0, s = k * pi / kParts;
        const double loss = std::pow(s, 4) / 720.0 + std::pow(s, 6) / 3024.0;
        EXPECT_NEAR(1.0 - loss, modes[i].omega2 / BeamOmega2(k * pi), 1e-9 + std::pow(s, 8) / 2e4);
        EXPECT_NEAR(2.0 * pi / std::sqrt(modes[i].omega2), modes[i].period, 1e-12);
        // The shape is a sampled sine: its sum is cot(s / 2), or 0, and its square sum N / 2.
        const double sum = i % 2 == 0 ? 1.0 / std::tan(s / 2.0) : 0.0;
        EXPECT_NEAR(200.0 * sum * sum / (kParts * (kParts - 1.0)), modes[i].massPercent[Z], 1e-7);
    }
}

/// Storeys of equal mass 2 and stiffness 500 in X, held at the foot.
T_FRAME ShearBuilding(std::size_t storeys)
{
    T_FRAME frame = Empty();
    for (std::size_t i = 0; i <= storeys; ++i) {
        AddNode(frame, {0, 0, 0}); // storeys in one place: a link does not feel the height
        frame.nodes[i].mass = {2.0, 0.0, 0.0};
        if (i > 0) Join(frame, ELEMENT_KIND::Link, i - 1, i, {500.0, 0, 0, 0, 0, 0});
    }
    Fix(frame, 0, {X, Y, Z, RX, RY, RZ});
    return frame;
}

double ShearOmega2(std::size_t storeys, std::size_t mode)
{
    const double angle = (2.0 * double(mode) - 1.0) * pi / (2.0 * (2.0 * double(storeys) + 1.0));
    return 4.0 * 500.0 / 2.0 * std::pow(std::sin(angle), 2);
}

TEST(Modes, OfAShearBuildingAreTheClosedForm)
{
    for (std::size_t storeys : {1u, 2u, 9u, 2500u}) { // the last one by iteration
        const std::size_t count = std::min<std::size_t>(storeys, 12);
        const std::vector<T_MODE> modes = Modes(ShearBuilding(storeys), count);
        ASSERT_EQ(count, modes.size());
        double percent = 0.0;
        for (std::size_t i = 0; i < count; ++i) {
            const double expected = ShearOmega2(storeys, i + 1);
            EXPECT_NEAR(expected, modes[i].omega2, 1e-8 * expected) << storeys << " " << i;
            percent += modes[i].massPercent[X];
            EXPECT_EQ(0.0, modes[i].massPercent[Y]);
        }
        if (count == storeys) {
            EXPECT_NEAR(100.0, percent, 1e-9); // the mass at the foot is not counted
        }
    }
    // Two storeys: the ratio of the storeys is the golden section g, L = m (1 + g) of the shape
    // (1, g), modal mass m (1 + g^2).
    const double g = (1.0 + std::sqrt(5.0)) / 2.0;
    const T_MODE first = Modes(ShearBuilding(2), 1)[0];
    EXPECT_NEAR(g, first.shape[2][X] / first.shape[1][X], 1e-12);
    EXPECT_NEAR(std::sqrt(2.0) * (1.0 + g) / std::sqrt(1.0 + g * g), first.participation[X], 1e-12);
    EXPECT_NEAR(50.0 * (1.0 + g) * (1.0 + g) / (1.0 + g * g), first.massPercent[X], 1e-10);
}

/// A slab on four corner springs of 100 at (+-4, +-4) about (10, 20); four masses of 3 at half of
/// that distance, or one of 12 in the middle.
T_FRAME Slab(bool oneMass)
{
    T_FRAME frame = Empty();
    T_DIAPHRAGM slab;
    const double sides[4][2] = {{1, 1}, {-1, 1}, {-1, -1}, {1, -1}};
    for (const auto& [sx, sy] : sides) {
        const std::size_t n = AddNode(frame, {10.0 + 4.0 * sx, 20.0 + 4.0 * sy, 5.0});
        Join(frame, ELEMENT_KIND::Spring, n, 0, {100.0, 100.0, 50.0, 0, 0, 0});
        slab.nodes.push_back(n);
    }
    for (const auto& [sx, sy] : sides) {
        const double reach = oneMass ? 0.0 : 2.0;
        const std::size_t n = AddNode(frame, {10.0 + reach * sx, 20.0 + reach * sy, 5.0});
        frame.nodes[n].mass = {3.0, 3.0, 0.0};
        slab.nodes.push_back(n);
    }
    frame.diaphragms.push_back(slab);
    return frame;
}

TEST(Modes, OfARigidSlabSwayAndTurn)
{
    const std::vector<T_MODE> modes = Modes(Slab(false), 10);
    ASSERT_EQ(3u, modes.size()); // all there are
    EXPECT_NEAR(400.0 / 12.0, modes[0].omega2, 1e-9);
    EXPECT_NEAR(400.0 / 12.0, modes[1].omega2, 1e-9);
    EXPECT_NEAR(4.0 * 400.0 / 12.0, modes[2].omega2, 1e-9); // springs act at twice the radius
    EXPECT_NEAR(100.0, modes[0].massPercent[X], 1e-9);
    EXPECT_NEAR(100.0, modes[1].massPercent[Y], 1e-9);
    // About the origin the masses have 12 (10^2 + 20^2 + 2^2 + 2^2); turning has the last part.
    EXPECT_NEAR(100.0 * 8.0 / 508.0, modes[2].massPercent[RZ], 1e-9);
    EXPECT_NEAR(100.0 * 400.0 / 508.0, modes[0].massPercent[RZ], 1e-9);
    for (int d : {X, Y, RX, RY, RZ}) {
        double percent = 0.0;
        for (const T_MODE& mode : modes)
            percent += mode.massPercent[static_cast<std::size_t>(d)];
        EXPECT_NEAR(100.0, percent, 1e-9) << d;
    }
    EXPECT_EQ(2u, Modes(Slab(true), 10).size()); // turning has no mass
}

TEST(Modes, NeedMassThatCanMoveAndCanBeCancelled)
{
    T_FRAME frame = Beam(4, {Z, RY}, {});
    frame.materials[0].density = 0.0;
    frame.nodes[0].mass = {5.0, 5.0, 5.0}; // on the support
    CFrameSolver solver;
    T_SOLVER_ERROR error;
    std::vector<T_MODE> modes(3);
    EXPECT_EQ(0, solver.Modes(1, modes, error));
    EXPECT_EQ(SOLVER_FAULT::Failed, error.fault); // nothing prepared
    EXPECT_TRUE(modes.empty());
    ASSERT_EQ(1, solver.Prepare(frame, error));
    EXPECT_EQ(0, solver.Modes(1, modes, error));
    EXPECT_EQ(SOLVER_FAULT::NoMass, error.fault);
    ASSERT_EQ(1, solver.Prepare(ShearBuilding(1000), error));
    std::size_t calls = 0;
    const auto stop = [&](std::size_t done, std::size_t total) {
        EXPECT_LE(done, total);
        return ++calls < 5;
    };
    EXPECT_EQ(0, solver.Modes(3, modes, error, stop));
    EXPECT_EQ(SOLVER_FAULT::Cancelled, error.fault);
    EXPECT_EQ(5u, calls);
    EXPECT_EQ(1, solver.Modes(3, modes, error))
        << error.reason.Text(); // as if nothing had happened
    EXPECT_EQ(3u, modes.size());
}

} // namespace
