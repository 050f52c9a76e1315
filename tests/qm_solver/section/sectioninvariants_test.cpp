// What may not change a section: units, mirrors, turns; and derivatives against differences.
#include "sections.h"

#include <algorithm>
#include <cmath>
#include <functional>
#include <numbers>

using namespace solver;
using std::numbers::pi;

namespace {

/// An L with a hole and a fillet, and four bars.
T_SECTION_MODEL Ell(const T_STRESS_LAW& law)
{
    T_SECTION_MODEL m = SectionOf({{0, 0},
                                   {500, 0},
                                   {500, 200},
                                   {260, 200, -0.414213562373095},
                                   {200, 260},
                                   {200, 600},
                                   {0, 600}},
                                  law, SteelOf(450),
                                  {{50, 50, 500}, {450, 60, 300}, {60, 540, 400}, {150, 540, 200}});
    m.regions[0].rings.push_back(CircleRing(40, 110, 110));
    m.momentY = 170, m.momentZ = 210;
    return m;
}

/// The section with its corners elsewhere; a mirror turns the rings, and so the bulges, round.
T_SECTION_MODEL Moved(T_SECTION_MODEL m, const std::function<void(double&, double&)>& move,
                      bool mirror)
{
    move(m.momentY, m.momentZ);
    for (T_SECTION_BAR& b : m.bars)
        move(b.y, b.z);
    for (T_RING& ring : m.regions[0].rings)
        for (T_CORNER& c : ring) {
            move(c.y, c.z);
            if (mirror) c.bulge = -c.bulge;
        }
    return m;
}

T_CAPACITY AtAxial(const T_SECTION_MODEL& m, double direction, double axial)
{
    return CapacityAtAxial(Prepared(m), direction, axial);
}

} // namespace

TEST(SectionInvariants, MirrorsTurnsAndUnitsChangeNothing)
{
    for (const T_STRESS_LAW& law :
         {ConcreteOf(30), ConcreteOf(70, 0.0024, 0.0027, 1.44), BlockOf(30, 0.84)})
        for (const double direction : {0.0, 0.7, 2.3, 4.0}) {
            const T_SECTION_MODEL m = Ell(law);
            const T_CAPACITY p = AtAxial(m, direction, 1.5e6);
            const double tol = 1e-9 * std::hypot(p.My, p.Mz);
            const T_CAPACITY mirrored = AtAxial(Moved(
                                                    m, [](double& y, double&) { y = -y; }, true),
                                                -direction, 1.5e6);
            EXPECT_NEAR(p.My, mirrored.My, tol);
            EXPECT_NEAR(-p.Mz, mirrored.Mz, tol);
            const auto turn = [](double& y, double& z) {
                const double c = std::cos(0.4), s = std::sin(0.4), y0 = y;
                y = c * y + s * z, z = c * z - s * y0; // +z towards +y, as directions turn
            };
            const T_CAPACITY turned = AtAxial(Moved(m, turn, false), direction + 0.4, 1.5e6);
            EXPECT_NEAR(std::cos(0.4) * p.My - std::sin(0.4) * p.Mz, turned.My, tol);
            EXPECT_NEAR(std::sin(0.4) * p.My + std::cos(0.4) * p.Mz, turned.Mz, tol);
            T_SECTION_MODEL metres = Moved(
                m, [](double& y, double& z) { y /= 1e3, z /= 1e3; }, false);
            for (T_SECTION_BAR& b : metres.bars)
                b.area /= 1e6;
            for (T_STRESS_LAW& l : metres.laws)
                l.strength *= 1e3, l.modulus *= 1e3;
            EXPECT_NEAR(p.My, 1e6 * AtAxial(metres, direction, 1.5e3).My, tol);
            // Outline and hole may run either way, and begin anywhere.
            T_SECTION_MODEL other = m;
            std::ranges::rotate(other.regions[0].rings[0], other.regions[0].rings[0].begin() + 3);
            other.regions[0].rings[1] = {{150, 110, -1.0}, {70, 110, -1.0}};
            EXPECT_NEAR(p.My, AtAxial(other, direction, 1.5e6).My, tol);
        }
}

TEST(SectionInvariants, SquareRepeatsAtAQuarterTurnAndCircleAtAnyAngle)
{
    std::vector<std::array<double, 3>> bars{
        {150, 150, 500}, {-150, 150, 500}, {150, -150, 500}, {-150, -150, 500}};
    T_SECTION_ERROR error;
    std::vector<T_CAPACITY> surface;
    ASSERT_EQ(1, Prepared(SectionOf(RectangleRing(400, 400), ConcreteOf(30), SteelOf(500), bars))
                     .Surface(36, 40, surface, error));
    ASSERT_EQ(36u * 40u, surface.size());
    for (std::size_t i = 0; i + 9 * 40 < surface.size(); ++i) {
        EXPECT_NEAR(surface[i].axial, surface[i + 360].axial, 1e-5);
        EXPECT_NEAR(surface[i].My, surface[i + 360].Mz, 1.0);
        EXPECT_NEAR(-surface[i].Mz, surface[i + 360].My, 1.0);
    }
    const T_SECTION_MODEL circle = SectionOf(CircleRing(200), ConcreteOf(60, 0.0023, 0.0029, 1.6));
    const double M = AtAxial(circle, 0.0, 2e6).My;
    for (const double direction : {0.3, 1.9, 3.2, 5.5}) {
        const T_CAPACITY p = AtAxial(circle, direction, 2e6);
        EXPECT_NEAR(M * std::cos(direction), p.My, 1e-9 * M);
        EXPECT_NEAR(M * std::sin(direction), p.Mz, 1e-9 * M);
    }
}

// Also where a bar passes the edge of a block while the axis turns.
TEST(SectionInvariants, TheMomentPointsWhereItIsAskedFor)
{
    T_SECTION_MODEL m = Ell(BlockOf(30, 0.84));
    T_SECTION_ERROR error;
    T_CAPACITY out;
    for (int i = 0; i < 120; ++i) {
        const double direction = 2 * pi * i / 120;
        ASSERT_EQ(1, Prepared(m).TowardsMoment(direction, 1.5e6, out, error)) << i;
        const double moment = std::hypot(out.My, out.Mz);
        EXPECT_NEAR(moment * std::cos(direction), out.My, 1e-9 * moment) << i;
        EXPECT_NEAR(moment * std::sin(direction), out.Mz, 1e-9 * moment) << i;
    }
    m.momentZ = 2000; // above all: compression below it can't bend upwards
    EXPECT_EQ(0, Prepared(m).TowardsMoment(0.0, 1.5e6, out, error));
    EXPECT_EQ(SECTION_FAULT::NoSuchMoment, error.fault);
}

TEST(SectionInvariants, TangentIsTheDerivative)
{
    T_STRESS_LAW mander = ConcreteOf(35, 0.004, 0.02);
    mander.kind = STRESS_LAW::Mander, mander.modulus = 28000;
    for (const T_STRESS_LAW& law : {ConcreteOf(30), ConcreteOf(70, 0.0024, 0.0027, 1.44), mander}) {
        const CSectionSolver s = Prepared(Ell(law));
        const T_STRAIN_PLANE plane{0.0008, 4e-6, -2.3e-6};
        const auto at = [&](std::size_t i, double step) {
            T_STRAIN_PLANE p = plane;
            (i == 0 ? p.axial : i == 1 ? p.overZ : p.overY) += step;
            T_SECTION_RESPONSE r;
            T_SECTION_ERROR error;
            EXPECT_EQ(1, s.Respond(p, r, error));
            return r;
        };
        const T_SECTION_RESPONSE mid = at(0, 0.0);
        for (std::size_t i = 0; i < 3; ++i) {
            const double h = i == 0 ? 1e-6 : 4e-9;
            const T_SECTION_RESPONSE up = at(i, h), down = at(i, -h);
            const double by[] = {up.axial - down.axial, up.My - down.My, up.Mz - down.Mz};
            for (std::size_t k = 0; k < 3; ++k)
                EXPECT_NEAR(by[k] / (2 * h), mid.tangent[k][i],
                            1e-5 * std::sqrt(mid.tangent[k][k] * mid.tangent[i][i]))
                    << k << i;
        }
    }
}
