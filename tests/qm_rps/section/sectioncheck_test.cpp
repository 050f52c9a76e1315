// Sections under given forces by every way, against hand calculation and a textbook.
#include "qm_rps/section/sectionchecktable.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <limits>
#include <numbers>

namespace {

constexpr T_UNITS kSi{FORCE_UNIT::N, LENGTH_UNIT::m};
constexpr double kPi = std::numbers::pi;

T_MATL_D Steel()
{
    T_MATL_D m;
    m.name = "S";
    m.E = 210e9, m.Fy = 275e6;
    return m;
}

/// Welded, A 0.01044 m2, Wpl,y 1.5657e-3 and Wpl,z 3.1332e-4 m3; class 2 and compact.
T_SECT_D PlatedI()
{
    T_SECT_D s;
    s.name = "I";
    s.shape = SECT_SHAPE::IShape;
    s.size = {0.4, 0.2, 0.012, 0.015};
    return s;
}

T_MATL_D Concrete()
{
    T_MATL_D m;
    m.name = "C";
    m.type = MATL_CLASS::Concrete;
    m.fck = 25e6, m.fyk = 450e6, m.Es = 200e9;
    return m;
}

/// 300 x 500, 8 bars of 20 mm, clear cover 30, stirrups of 8 mm each 100 with 3 legs either way.
T_SECT_D Column()
{
    T_SECT_D s;
    s.name = "column";
    s.shape = SECT_SHAPE::Rectangle;
    s.size = {0.5, 0.3, 0.0, 0.0};
    for (const double y : {-0.102, 0.0, 0.102})
        for (const double z : {-0.202, 0.0, 0.202})
            if (y != 0.0 || z != 0.0) s.bars.push_back({y, z, kPi / 4.0 * 0.02 * 0.02});
    s.detailing = T_SECT_DETAIL{0.03, 0.008, 0.1, 3, 3};
    return s;
}

T_SECTION_CHECK Checked(const T_SECT_D& s, const T_MATL_D& m,
                        const T_SECTION_CHECK_REQUEST& request)
{
    T_SECTION_CHECK check;
    std::string reason;
    EXPECT_EQ(1, CheckSection(s, m, request, kSi, check, reason)) << reason;
    EXPECT_FALSE(check.sets.empty());
    return check;
}

/// "" is the section calculator.
const T_SECTION_WAY* WayOf(const T_SECTION_CHECK& check, SECTION_CHECKED what,
                           const std::string& by)
{
    const auto& ways = check.sets.front().ways;
    const auto found = std::ranges::find_if(
        ways, [&](const T_SECTION_WAY& w) { return w.what == what && w.by == by; });
    return found == ways.end() ? nullptr : &*found;
}

double Ratio(const T_SECTION_CHECK& check, SECTION_CHECKED what, const std::string& by)
{
    const T_SECTION_WAY* way = WayOf(check, what, by);
    EXPECT_TRUE(way && way->ratio) << by << (way ? ": " + way->reason : "");
    return way ? way->ratio.value_or(-1.0) : -1.0;
}

using enum SECTION_CHECKED;

} // namespace

// Hand calculation: V 500 kN of Vpl 704.945 loses rho 0.175185 of the web: NV 2657.1 kN, n 0.30108,
// a 0.421 (hw tw / A), MN,y by MV,y (1 - n)/(1 - 0.5 a), MN,z full. H1-1: p + 8/9 m. Surface: the
// root of its polynomial along the ray. Exact about y: the web strip N/(fy tw) carries N.
TEST(SectionCheck, SteelByEveryWay)
{
    const T_SECTION_FORCES all{800e3, 200e3, 30e3, 50e3, 500e3, 0.0};
    const T_SECTION_CHECK check = Checked(PlatedI(), Steel(), {{}, {}, 1.0, {all}});
    const struct {
        SECTION_CHECKED what;
        const char* by;
        double ratio;
    } kRows[] = {
        {Axial, "", 0.2786485545},
        {Axial, "EN 1993-1-1 6.2.3, 6.2.4", 0.2786485545},
        {Bending, "EN 1993-1-1 6.2.9", 0.5051132752},
        {Bending, "AISC 360 H1-1", 1.0010312520},
        {Bending, "McGuire, Gallagher, Ziemian", 0.7251657102},
        {ShearZ, "EN 1993-1-1 6.2.6", 0.7092755150},
        {ShearZ, "AISC 360 G", 0.6313131313},
        {ShearY, "EN 1993-1-1 6.2.6", 0.0524863881},
        {ShearY, "AISC 360 G", 0.0505050505},
    };
    for (const auto& row : kRows)
        EXPECT_NEAR(row.ratio, Ratio(check, row.what, row.by), 1e-8) << row.by;
    EXPECT_EQ(std::size(kRows) + 1, check.sets.front().ways.size()); // and exact bending
    const auto tellsSideways = [](const T_SECTION_CHECK& c) {
        const T_CODE_WARNING warning{"IDS_QM_WARN_SIDEWAYS", {}};
        return std::ranges::count(c.warnings, warning) > 0;
    };
    EXPECT_TRUE(tellsSideways(check));
    const T_SECTION_CHECK weak = Checked(PlatedI(), Steel(), {{}, {}, 1.0, {{0, 0, 30e3}}});
    EXPECT_FALSE(tellsSideways(weak)); // about the weak axis
    const T_SECTION_CHECK one =
        Checked(PlatedI(), Steel(), {{}, {}, 1.0, {{800e3, 200e3, 0.0, 0.0, 0.0, 0.0}}});
    EXPECT_NEAR(0.5234469537, Ratio(one, Bending, ""), 1e-8);
    const T_TEXT_TABLE table = SectionCheckTable(check, kSi);
    const auto aisc =
        std::ranges::find(table.rows, "AISC 360 H1-1", [](const auto& r) { return r[8]; });
    ASSERT_NE(table.rows.end(), aisc);
    EXPECT_EQ("1.001", (*aisc)[9]);
    EXPECT_EQ("EXCEEDED", (*aisc)[10]);
}

// k 1.66519, rho_l 0.0069504, d 0.452 m: VRd,c 145.952 kN above VRd,s 276.048 (cot 1); design with
// alpha_cc 0.85 and cot 2: VRd,max 426.164 below VRd,s 480.083. ACI: Vc 157.795, Vs 306.720 kN.
TEST(SectionCheck, ShearOfConcreteByBothCodes)
{
    T_SECTION_CHECK_REQUEST request{{}, {}, 1.0, {{300e3, 50e3, 0.0, 0.0, 100e3, 0.0}}};
    T_SECTION_CHECK check = Checked(Column(), Concrete(), request);
    EXPECT_NEAR(100e3 / 276047.97656, Ratio(check, ShearZ, "EN 1992-1-1 6.2"), 1e-8);
    EXPECT_NEAR(100e3 / 464514.99359, Ratio(check, ShearZ, "ACI 318 22.5"), 1e-8);
    request.options.values = SECTION_VALUES::Design;
    request.options.alphaCc = 0.85;
    request.cotTheta = 2.0;
    request.codes = {SECTION_CHECK_CODE::En};
    check = Checked(Column(), Concrete(), request);
    EXPECT_NEAR(100e3 / 426163.68, Ratio(check, ShearZ, "EN 1992-1-1 6.2"), 1e-8);
    EXPECT_EQ(nullptr, WayOf(check, ShearZ, "ACI 318 22.5"));
    T_SECT_D wide = Column();
    wide.detailing->stirrupSpacing = 0.3; // VRd,s 92 kN: less than concrete alone
    check = Checked(wide, Concrete(), {{}, {}, 1.0, {{300e3, 50e3, 0.0, 0.0, 100e3, 0.0}}});
    EXPECT_NEAR(100e3 / 145952.07058, Ratio(check, ShearZ, "EN 1992-1-1 6.2"), 1e-8);
}

// EN 1992-1-1 5.8.9(4) with the strengths of either axis alone; NRd 0.15 25e6 + 8 bars 450e6.
TEST(SectionCheck, TwoMomentsFromThoseOfEitherAxis)
{
    const double N = 1500e3, a = 1.0 + 0.5 * (N / 4880973.3553 - 0.1) / 0.6;
    const auto of = [&](double My, double Mz) {
        return Checked(Column(), Concrete(), {{}, {}, 1.0, {{N, My, Mz, 0.0, 0.0, 0.0}}});
    };
    const double y = Ratio(of(-120e3, 0.0), Bending, ""), z = Ratio(of(0.0, 60e3), Bending, "");
    const T_SECTION_CHECK both = of(-120e3, 60e3);
    EXPECT_NEAR(std::pow(y, a) + std::pow(z, a), Ratio(both, Bending, "EN 1992-1-1 5.8.9(4)"),
                1e-8);
    EXPECT_GT(Ratio(both, Bending, ""), std::max(y, z));
}

// J. K. Wight, J. G. MacGregor, Reinforced Concrete, 7th edition, examples 11-5 to 11-7: 16 x 16
// in, 8 No. 8, f'c 4, fy 60 ksi, Pu 250 kip with 55 and 110 kip-ft: 292 kip with phi = 0.65, of 348
// and 553 read from charts and 798 (0.80 phi P0 = 639 is the cap of ACI, 798 is phi P0).
TEST(SectionCheck, BreslerOfTheTextbook)
{
    constexpr double in = kMetresPerInch, kip = 4448.2216152605;
    T_MATL_D m = Concrete();
    m.fck = 4 * kPascalsPerKsi, m.fyk = 60 * kPascalsPerKsi, m.Es = 29000 * kPascalsPerKsi;
    T_SECT_D s;
    s.name = "16x16";
    s.shape = SECT_SHAPE::Rectangle;
    s.size = {16 * in, 16 * in, 0.0, 0.0};
    for (const double y : {-5.6, 0.0, 5.6})
        for (const double z : {-5.6, 0.0, 5.6})
            if (y != 0.0 || z != 0.0) s.bars.push_back({y * in, z * in, 0.79 * in * in});
    T_SECTION_CHECK_REQUEST request;
    request.options.law = SECTION_LAW::Aci;
    request.forces = {{250 * kip, 55 * 12 * in * kip, 110 * 12 * in * kip, 0.0, 0.0, 0.0}};
    const T_SECTION_CHECK check = Checked(s, m, request);
    const double strength = 250.0 / Ratio(check, Bending, "Bresler 1960");
    EXPECT_NEAR(292.0, 0.65 * strength, 0.02 * 292.0); // charts
    EXPECT_NEAR(250.0 / 1228.112, Ratio(check, Axial, ""), 1e-6);
}

// C10X15.3 of 36 ksi, table values: Zx 15.9, Zy 2.34, Sy 1.15 in3, A 4.48 in2, d tw 2.4 in2. AISC
// F6 leaves 1.6 Sy about z; EN (6.2) sums.
TEST(SectionCheck, AChannelByBothCodes)
{
    constexpr double kIn3 = 1.6387064e-5, kIn2 = 6.4516e-4, kFy = 248.21e6;
    T_SECT_D s = *NamedShape("C10X15.3");
    s.name = "C";
    T_MATL_D steel = Steel();
    steel.Fy = kFy;
    const double N = 0.25 * 4.48 * kIn2 * kFy, My = 0.2 * 15.9 * kIn3 * kFy;
    const double Mz = 0.3 * 2.34 * kIn3 * kFy, V = 0.4 * 0.6 * 2.4 * kIn2 * kFy;
    const T_SECTION_CHECK check = Checked(s, steel, {{}, {}, 1.0, {{N, My, Mz, 0, V, 0}}});
    EXPECT_NEAR(0.25 + 0.2 + 0.3, Ratio(check, Bending, "EN 1993-1-1 6.2.9"), 6e-3);
    const double weak = 0.3 * 2.34 / (1.6 * 1.15);
    EXPECT_NEAR(0.25 + 8.0 / 9.0 * (0.2 + weak), Ratio(check, Bending, "AISC 360 H1-1"), 6e-3);
    EXPECT_NEAR(0.4, Ratio(check, ShearZ, "AISC 360 G"), 1e-3);
    ASSERT_EQ(1U, std::ranges::count(check.warnings, std::string("IDS_QM_SECC_WARN_CHANNEL"),
                                     &T_CODE_WARNING::key));
    // The surface of W shapes is not asked.
    const T_SECTION_WAY* way = WayOf(check, Bending, "McGuire, Gallagher, Ziemian");
    EXPECT_TRUE(way && !way->ratio);
}

TEST(SectionCheck, WhatHasNoAnswerIsNotCheckedWithItsReason)
{
    T_SECT_D thin = PlatedI();
    thin.size[2] = 0.004; // web 92
    T_SECT_D box = PlatedI();
    box.shape = SECT_SHAPE::Box;
    T_SECTION_OPTIONS design;
    design.values = SECTION_VALUES::Design;
    const struct {
        T_SECT_D section;
        T_MATL_D material;
        T_SECTION_OPTIONS options;
        T_SECTION_FORCES forces;
        SECTION_CHECKED what;
        const char* by;
        const char* reason;
    } kRows[] = {
        {thin, Steel(), {}, {9e5, 0, 0, 0, 0, 0}, Axial, "EN 1993-1-1 6.2.3, 6.2.4", "class 4"},
        {thin, Steel(), {}, {9e5, 1e4, 0, 0, 0, 0}, Bending, "EN 1993-1-1 6.2.9", "class 4"},
        {thin, Steel(), {}, {9e5, 1e4, 0, 0, 0, 0}, Bending, "AISC 360 H1-1", "h/t (web)"},
        {PlatedI(), Steel(), {}, {0, 1e4, 0, 0, 9e5, 0}, Bending, "EN 1993-1-1 6.2.9", "shear"},
        {PlatedI(), Steel(), design, {0, 1e4, 0, 0, 0, 0}, Bending, "AISC 360 H1-1", "phi"},
        {box, Steel(), {}, {0, 0, 0, 0, 1e4, 0}, ShearZ, "AISC 360 G", "shape"},
        {box, Steel(), {}, {0, 1e4, 0, 0, 0, 0}, Bending, "McGuire, Gallagher, Ziemian", "shape"},
        {box, Steel(), {}, {0, 0, 0, 0, 0, 1e3}, Torsion, "-", "torsion"},
        {Column(), Concrete(), {}, {9e6, 1e4, 0, 0, 0, 0}, Bending, "", "axial force"},
        {Column(), Concrete(), {}, {-1e4, 1e4, 1e4, 0, 0, 0}, Bending, "Bresler 1960", "N: "},
        {Column(), Concrete(), {}, {1e4, 1e5, 1e5, 0, 0, 0}, Bending, "Bresler 1960", "Pn/P0"},
        {Column(), Concrete(), design, {0, 0, 0, 1e4, 0, 0}, ShearY, "ACI 318 22.5", "phi"},
    };
    for (const auto& row : kRows) {
        SCOPED_TRACE(std::string(row.by) + ": " + row.reason);
        const T_SECTION_CHECK check =
            Checked(row.section, row.material, {row.options, {}, 1.0, {row.forces}});
        const T_SECTION_WAY* way = WayOf(check, row.what, row.by);
        ASSERT_TRUE(way);
        EXPECT_FALSE(way->ratio);
        EXPECT_NE(std::string::npos, way->reason.find(row.reason)) << way->reason;
        EXPECT_TRUE(way->trace.empty());
    }
    T_SECTION_CHECK kept;
    kept.section = "as it was";
    std::string reason;
    for (const double force : {0.0, std::numeric_limits<double>::infinity()})
        EXPECT_EQ(0, CheckSection(Column(), Concrete(), {{}, {}, 1.0, {{force, 0, 0, 0, 0, 0}}},
                                  kSi, kept, reason));
    EXPECT_EQ("as it was", kept.section);
}
