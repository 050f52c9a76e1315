// Moment-curvature against closed forms.
#include "sections.h"

#include <algorithm>
#include <cmath>
#include <numbers>

using namespace solver;

namespace {

T_MOMENT_CURVATURE Curvature(const T_SECTION_MODEL& m, const T_CURVATURE_REQUEST& request)
{
    T_MOMENT_CURVATURE out;
    T_SECTION_ERROR error;
    EXPECT_EQ(1, Prepared(m).MomentCurvature(request, out, error))
        << static_cast<int>(error.fault) << ' ' << error.axialMax;
    return out;
}

double Uniform(const T_SECTION_MODEL& m, double strain)
{
    T_SECTION_RESPONSE out;
    T_SECTION_ERROR error;
    EXPECT_EQ(1, Prepared(m).Respond({strain, 0.0, 0.0}, out, error));
    return out.axial;
}

} // namespace

// Steel rectangle b x h, elastic-plastic: M = E I k up to k1 = 2 ey / h, then f b h2 / 4 (1 - (k1 /
// k)2 / 3), to the limit ku = 2 eu / h. Area beyond yield above M1 = f b h2 / 6: M1 (k (3/2 - 1) +
// (1 / k - 1) / 2) with k = ku / k1; the level M1 (1 + m) has m (k - 1) - m2 / 2 of it.
TEST(SectionCurvature, SteelRectangleFollowsItsClosedForm)
{
    const double b = 40, h = 100, f = 300, M1 = f * b * h * h / 6, k1 = 2 * 0.0015 / h;
    T_CURVATURE_REQUEST request;
    request.points = 4000;
    const T_MOMENT_CURVATURE r =
        Curvature(SectionOf(RectangleRing(b, h), SteelOf(f, 2e5, 0, 0.015)), request);
    ASSERT_EQ(CURVATURE_END::StrainLimit, r.end);
    EXPECT_EQ(FIBRE_KIND::Steel, r.governs.kind);
    EXPECT_NEAR(10 * k1, r.points.back().curvature, 1e-9 * k1);
    EXPECT_NEAR(k1, r.points[r.yield].curvature, 1e-9 * k1);
    for (const T_CURVATURE_POINT& p : r.points) {
        const double k = p.curvature / k1;
        EXPECT_NEAR(k < 1 ? k * M1 : 1.5 * M1 * (1 - 1 / (3 * k * k)), p.moment, 1e-9 * M1) << k;
    }
    ASSERT_TRUE(r.idealised);
    const double area = 0.5 * 9 + 0.5 * (0.1 - 1), m = 9 - std::sqrt(81 - 2 * area);
    EXPECT_NEAR(M1 * (1 + m), r.idealMoment, 1e-6 * M1); // trapezoids between 4000 points
    EXPECT_NEAR(k1 * (1 + m), r.idealCurvature, 1e-6 * k1);
    // With half of its axial strength the section yields first at k1 / 2; a limit may be asked for.
    request.axial = -0.5 * f * b * h;
    request.maxCurvature = 2 * k1;
    const T_MOMENT_CURVATURE pulled =
        Curvature(SectionOf(RectangleRing(b, h), SteelOf(f)), request);
    EXPECT_EQ(CURVATURE_END::MaxCurvature, pulled.end);
    EXPECT_EQ((T_FIBRE{FIBRE_KIND::Steel, 0, true}), pulled.yields);
    EXPECT_NEAR(0.5 * k1, pulled.points[pulled.yield].curvature, 1e-9 * k1);
}

// Steel 400 x 200 towards a moment at 30 degrees while elastic: the curvatures are My / (E Iy) and
// Mz / (E Iz), so that the axis turns to tan = tan 30 * Iy / Iz; moment along over curvature along.
TEST(SectionCurvature, TheAxisTurnsToKeepTheMomentInItsDirection)
{
    const double b = 200, h = 400, Iy = b * h * h * h / 12, Iz = h * b * b * b / 12;
    T_CURVATURE_REQUEST request;
    request.direction = std::numbers::pi / 6;
    request.ofMoment = true;
    const double c = std::cos(request.direction), s = std::sin(request.direction);
    T_SECTION_MODEL m = SectionOf(RectangleRing(b, h), SteelOf(300, 2e5, 0, 0.02));
    const T_MOMENT_CURVATURE r = Curvature(m, request);
    const T_CURVATURE_POINT& p = r.points[r.yield];
    EXPECT_NEAR(s / Iz / (c / Iy), p.plane.overY / p.plane.overZ, 1e-8);
    EXPECT_NEAR(2e5 / (c * c / Iy + s * s / Iz), p.moment / p.curvature, 1e-7 * 2e5 * Iz);
    for (const T_CURVATURE_POINT& at : r.points)
        EXPECT_NEAR(0.0, at.Mz * c - at.My * s, 1e-9 * r.points.back().moment);
    // Fully plastic in the end: no more than what the plastic section carries that way.
    m.plastic = true;
    T_CAPACITY full;
    T_SECTION_ERROR error;
    ASSERT_EQ(1, Prepared(m).TowardsMoment(request.direction, 0.0, full, error));
    const double plastic = std::hypot(full.My, full.Mz);
    EXPECT_LT(r.points.back().moment, plastic);
    EXPECT_GT(r.points.back().moment, 0.98 * plastic);
}

// A core that goes on, a cover that spalls at 0.004: the moment falls as the cover goes. All of the
// section carries until the edge is at 0.004; in the end nothing of a core without a cover is lost.
TEST(SectionCurvature, SpallingEndsByLossOfMoment)
{
    T_STRESS_LAW cover = ConcreteOf(30, 0.002, 0.004);
    cover.spalls = true;
    T_SECTION_MODEL m =
        SectionOf(RectangleRing(200, 200), ConcreteOf(30, 0.002, 0.05), SteelOf(400),
                  {{80, 80, 300}, {-80, 80, 300}, {80, -80, 300}, {-80, -80, 300}});
    m.laws.push_back(cover);
    m.regions.push_back({{RectangleRing(400, 400), RectangleRing(200, 200)}, 2});
    T_CURVATURE_REQUEST request;
    request.axial = 6e5;
    request.points = 400;
    const T_MOMENT_CURVATURE r = Curvature(m, request);
    ASSERT_EQ(CURVATURE_END::MomentLoss, r.end);
    EXPECT_EQ(FIBRE_KIND::None, r.governs.kind);
    const auto top = std::ranges::max_element(r.points, {}, &T_CURVATURE_POINT::moment);
    EXPECT_NEAR(0.8, r.points.back().moment / top->moment, 1e-3);
    EXPECT_NEAR(0.004, top->plane.axial + 200 * top->plane.overZ, 2e-4);
    // Under a uniform 0.01 core and bars alone are left, also of a bar in the cover.
    m.bars.push_back({150, 50, 300, 1});
    EXPECT_NEAR(30 * (40000 - 1200) + 1500 * 400, Uniform(m, 0.01), 1e-6);
    // With 0.05 at z = 100 and 0.004 at the bar in the cover its concrete goes at once: 300 * 30 N.
    const CSectionSolver jumps = Prepared(m);
    const double place = (100 - (50 - 0.08 * 100) / 0.92) / 300;
    const T_CAPACITY before = CapacityAt(jumps, 0.0, place - 1e-12);
    const T_CAPACITY after = CapacityAt(jumps, 0.0, place + 1e-12);
    EXPECT_NEAR(9000, after.axial - before.axial, 1e-3);
    const T_CAPACITY on = CapacityAtAxial(jumps, 0.0, 0.25 * before.axial + 0.75 * after.axial);
    EXPECT_NEAR(0.25 * before.My + 0.75 * after.My, on.My, 1.0);
    // A Mander core is not held back at its peak strain; with the axis free the same loss ends it.
    m.laws[0].kind = STRESS_LAW::Mander, m.laws[0].modulus = 30000;
    EXPECT_NEAR(0.05, CapacityAt(Prepared(m), 0.0, 2.0).plane.axial, 1e-15);
    EXPECT_EQ(FIBRE_KIND::Bar, r.yields.kind);
    EXPECT_NEAR(0.002,
                std::fabs(r.points[r.yield].plane.axial - 80 * r.points[r.yield].plane.overZ),
                1e-10);
}

// Round, with three bars: the tangent does not know how fast the cover goes, and the axis turns.
TEST(SectionCurvature, SpallsWithAFreeAxis)
{
    const auto mander = [](double f, double peak, double limit, double E, bool spalls) {
        T_STRESS_LAW law = ConcreteOf(f, peak, limit);
        law.kind = STRESS_LAW::Mander, law.modulus = E, law.spalls = spalls;
        return law;
    };
    T_SECTION_MODEL m = SectionOf(CircleRing(140), mander(20.4, 0.0029, 0.017, 13100, false),
                                  SteelOf(389, 2e5, 1880, 0.052),
                                  {{109, 12, 154}, {-82, 73, 465}, {-19, -108, 478}});
    m.laws.push_back(mander(25, 0.002, 0.004, 25000, true));
    m.regions.push_back({{CircleRing(205), CircleRing(140)}, 2});
    T_CURVATURE_REQUEST request{1.5e5, 1.32, true};
    const T_MOMENT_CURVATURE r = Curvature(m, request);
    ASSERT_EQ(CURVATURE_END::MomentLoss, r.end);
    for (const T_CURVATURE_POINT& p : r.points) {
        T_SECTION_RESPONSE at;
        T_SECTION_ERROR error;
        ASSERT_EQ(1, Prepared(m).Respond(p.plane, at, error));
        EXPECT_NEAR(1.5e5, at.axial, 1e-2);
        EXPECT_NEAR(0.0, at.Mz * std::cos(1.32) - at.My * std::sin(1.32), 10.0);
    }
}

// A fibre at its limit ends the path where the capacity for the same axial force and axis is:
// pivots A, B and C in turn.
TEST(SectionCurvature, AStrainLimitEndsOnTheInteractionCurve)
{
    const T_SECTION_MODEL m =
        SectionOf(RectangleRing(300, 500), ConcreteOf(30), SteelOf(450, 2e5, 600, 0.02),
                  {{100, 200, 300}, {-100, 200, 300}, {0, -200, 900}});
    for (const double axial : {-2e5, 3e5, 1.5e6, 4.2e6})
        for (const double direction : {0.0, 0.8, 3.0}) {
            T_CURVATURE_REQUEST request{axial, direction};
            const T_MOMENT_CURVATURE r = Curvature(m, request);
            ASSERT_EQ(CURVATURE_END::StrainLimit, r.end) << axial;
            const T_CAPACITY c = CapacityAtAxial(Prepared(m), direction, axial);
            EXPECT_EQ(c.governs, r.governs) << axial;
            EXPECT_NEAR(c.My, r.points.back().My, 1e-7 * std::hypot(c.My, c.Mz)) << axial;
            EXPECT_NEAR(c.Mz, r.points.back().Mz, 1e-7 * std::hypot(c.My, c.Mz)) << axial;
        }
}
