// What the section calculator refuses, and where it says the fault is.
#include "numbers.h"
#include "sections.h"

#include <functional>

using namespace solver;

namespace {

T_SECTION_MODEL Good()
{
    T_SECTION_MODEL m = SectionOf(RectangleRing(300, 500), ConcreteOf(30), SteelOf(450),
                                  {{100, 200, 400}, {-100, 200, 400}, {0, -200, 700}});
    m.regions[0].rings.push_back(CircleRing(40));
    return m;
}

} // namespace

TEST(SectionRefusals, NameTheFaultAndItsPlace)
{
    using M = T_SECTION_MODEL;
    using F = SECTION_FAULT;
    const struct {
        const char* label;
        std::function<void(M&)> spoil;
        F fault;
        long law, region, ring, bar, otherBar;
    } cases[] = {
        {"none", [](M& m) { m.regions.clear(); }, F::NoRegion, -1, -1, -1, -1, -1},
        {"nan", [](M& m) { m.regions[0].rings[1][0].z = kNan; }, F::NotFinite, -1, 0, 1, -1, -1},
        {"no law", [](M& m) { m.bars[1].law = 2; }, F::NoSuchLaw, -1, -1, -1, 1, -1},
        {"strength", [](M& m) { m.laws[1].strength = 0; }, F::LawStrength, 1, -1, -1, -1, -1},
        {"modulus", [](M& m) { m.laws[1].modulus = -1; }, F::LawStrength, 1, -1, -1, -1, -1},
        {"peak", [](M& m) { m.laws[0].peakStrain = 0.004; }, F::LawStrains, 0, -1, -1, -1, -1},
        {"exponent", [](M& m) { m.laws[0].exponent = 0.9; }, F::LawStrains, 0, -1, -1, -1, -1},
        {"softening", [](M& m) { m.laws[1].hardening = -5; }, F::LawStrains, 1, -1, -1, -1, -1},
        {"concrete bar", [](M& m) { m.bars[2].law = 0; }, F::WrongLaw, -1, -1, -1, 2, -1},
        {"a line",
         [](M& m) {
             m.regions[0].rings[0] = {{0, 0}, {1, 1}, {3, 3}};
         },
         F::RingArea, -1, 0, 0, -1, -1},
        {"crossed", [](M& m) { std::swap(m.regions[0].rings[0][1], m.regions[0].rings[0][2]); },
         F::RingCrossed, -1, 0, 0, -1, -1},
        {"hole across", [](M& m) { m.regions[0].rings[1] = CircleRing(160); }, F::RingCrossed, -1,
         0, 1, -1, -1},
        {"hole beside", [](M& m) { m.regions[0].rings[1] = CircleRing(40, 300); }, F::HoleOutside,
         -1, 0, 1, -1, -1},
        {"bar area", [](M& m) { m.bars[0].area = 0; }, F::BarArea, -1, -1, -1, 0, -1},
        {"bar outside", [](M& m) { m.bars[0].y = 151; }, F::BarOutside, -1, -1, -1, 0, -1},
        {"bar in hole", [](M& m) { m.bars[2].z = -39; }, F::BarOutside, -1, -1, -1, 2, -1},
        {"overlap", [](M& m) { m.bars[1].y = 77.5; }, F::BarsOverlap, -1, -1, -1, 1, 0},
        {"plastic concrete", [](M& m) { m.plastic = true; }, F::ConcretePlastic, -1, 0, -1, -1, -1},
    };
    for (const auto& c : cases) {
        T_SECTION_MODEL m = Good();
        c.spoil(m);
        CSectionSolver s;
        T_SECTION_ERROR e;
        EXPECT_EQ(0, s.Prepare(m, e)) << c.label;
        EXPECT_EQ(c.fault, e.fault) << c.label;
        EXPECT_EQ((std::array{c.law, c.region, c.ring, c.bar, c.otherBar}),
                  (std::array{e.law, e.region, e.ring, e.bar, e.otherBar}))
            << c.label;
        T_CAPACITY out;
        EXPECT_EQ(0, s.AtAxial(0.0, 0.0, out, e)) << c.label;
    }
    // A region within another, the same again, one that cuts across; its neighbours may touch.
    for (const auto& [ring, fault] : {std::pair{RectangleRing(60, 60, 100, 0), F::RegionsOverlap},
                                      std::pair{RectangleRing(300, 500), F::RegionsOverlap},
                                      std::pair{RectangleRing(400, 100, 0, 280), F::RegionsOverlap},
                                      std::pair{RectangleRing(300, 100, 0, 300), F::None},
                                      std::pair{T_RING{{0, 40, 1.0}, {0, -40, 1.0}}, F::None}}) {
        T_SECTION_MODEL m = Good();
        m.regions.push_back({{ring}, 1});
        CSectionSolver s;
        T_SECTION_ERROR e;
        EXPECT_EQ(fault == F::None, s.Prepare(m, e) == 1);
        EXPECT_EQ(fault, e.fault);
        EXPECT_EQ(fault == F::None ? -1 : 0, e.otherRegion);
    }
    // Bars that touch: 400 mm2 is 22.568 across.
    T_SECTION_MODEL touching = Good();
    touching.bars[1] = {100 - 22.5676, 200, 400, 1};
    Prepared(touching);
}

TEST(SectionRefusals, LeaveTheResultAlone)
{
    using F = SECTION_FAULT;
    T_SECTION_ERROR e;
    const T_SECTION_MODEL m = Good();
    const CSectionSolver s = Prepared(m);
    T_CAPACITY out;
    out.My = 77;
    // 30 (150000 - 1600 pi - 1500) + 1500 * 400 and - 1500 * 450.
    EXPECT_EQ(0, s.AtAxial(0.0, 4.95e6, out, e));
    EXPECT_EQ(F::AxialBeyond, e.fault);
    EXPECT_NEAR(30 * (148500 - 1600 * 3.141592653589793) + 600000, e.axialMax, 1e-3);
    EXPECT_NEAR(-675000, e.axialMin, 1e-6);
    EXPECT_EQ(0, s.TowardsMoment(0.3, -7e5, out, e));
    EXPECT_EQ(F::AxialBeyond, e.fault);
    EXPECT_EQ(0, s.Capacity(kInf, 1.0, out, e));
    EXPECT_EQ(F::NotFinite, e.fault);
    EXPECT_EQ(77, out.My);
    T_AXIAL_CURVE curve;
    EXPECT_EQ(0, s.Curve(0.0, kFewestPoints - 1, curve, e));
    EXPECT_EQ(F::PointsTooFew, e.fault);
    T_CURVATURE_REQUEST request;
    request.axial = 5e6;
    T_MOMENT_CURVATURE path;
    EXPECT_EQ(0, s.MomentCurvature(request, path, e));
    EXPECT_EQ(F::AxialBeyond, e.fault);
    EXPECT_NEAR(30 * (148500 - 1600 * 3.141592653589793) + 600000, e.axialMax, 1e-3);
    // Nothing ends hardening without a limit, nor steel alone.
    T_SECTION_MODEL hard = m;
    hard.laws[1].hardening = 100;
    EXPECT_EQ(0, Prepared(hard).AtAxial(0.0, 0.0, out, e));
    EXPECT_EQ(F::NoLimit, e.fault);
    EXPECT_EQ(1, e.law);
    const CSectionSolver steel = Prepared(SectionOf(RectangleRing(10, 20), SteelOf(235)));
    EXPECT_EQ(0, steel.AtAxial(0.0, 0.0, out, e));
    EXPECT_EQ(F::NoLimit, e.fault);
    request.axial = 0.0;
    EXPECT_EQ(0, steel.MomentCurvature(request, path, e));
    EXPECT_EQ(F::NoLimit, e.fault);
    T_SECTION_MODEL block = m;
    block.laws[0] = BlockOf(30, 0.84);
    EXPECT_EQ(0, Prepared(block).MomentCurvature(request, path, e));
    EXPECT_EQ(F::BlockCurvature, e.fault);
    EXPECT_TRUE(path.points.empty());
}
