// Sections of the records by every kind of strengths, against hand calculation.
#include "qm_rps/section/sectionexport.h"

#include "qm_db/sectionproperties.h"
#include "qm_rps/outline/sectionoutline.h"

#include <gtest/gtest.h>

#include <cmath>
#include <numbers>

namespace {

using std::numbers::pi;
constexpr T_UNITS kSi{FORCE_UNIT::N, LENGTH_UNIT::m};

T_MATL_D Concrete()
{
    T_MATL_D m;
    m.name = "C";
    m.type = MATL_CLASS::Concrete;
    m.fck = 25e6, m.fyk = 450e6, m.Es = 200e9;
    m.mean = {33e6, 500e6, 0.0};
    m.knowledge = MATL_KNOWLEDGE::KL2;
    return m;
}

T_MATL_D Steel()
{
    T_MATL_D m;
    m.name = "S";
    m.E = 210e9, m.Fy = 275e6;
    m.mean = {0.0, 300e6, 0.0};
    m.confidence = 1.25;
    return m;
}

/// 0.30 x 0.50 with one row of 1200 mm2 at 0.45 from the compressed edge.
T_SECT_D Beam()
{
    T_SECT_D s;
    s.name = "beam";
    s.shape = SECT_SHAPE::Rectangle;
    s.size = {0.5, 0.3, 0.0, 0.0};
    s.bars = {{0.0, -0.2, 1200e-6}};
    return s;
}

T_SECT_D Plate()
{
    T_SECT_D s = Beam();
    s.name = "plate";
    s.bars.clear();
    return s;
}

/// 300 x 500, 8 bars of 20 mm, clear cover 30, stirrups of 8 mm each 100 with 3 legs either way.
T_SECT_D Column()
{
    T_SECT_D s = Beam();
    s.bars.clear();
    for (const double y : {-0.102, 0.0, 0.102})
        for (const double z : {-0.202, 0.0, 0.202})
            if (y != 0.0 || z != 0.0) s.bars.push_back({y, z, pi / 4.0 * 0.02 * 0.02});
    s.detailing = T_SECT_DETAIL{0.03, 0.008, 0.1, 3, 3};
    return s;
}

T_SECTION_ANSWER Answer(const T_SECT_D& s, const T_MATL_D& m, const T_SECTION_REQUEST& request)
{
    T_SECTION_ANSWER answer;
    std::string reason;
    EXPECT_EQ(1, CalcSection(s, m, request, kSi, answer, reason)) << reason;
    return answer;
}

std::string Refusal(const T_SECT_D& s, const T_MATL_D& m, const T_SECTION_REQUEST& request)
{
    T_SECTION_ANSWER answer;
    answer.section = "as it was";
    std::string reason;
    EXPECT_EQ(0, CalcSection(s, m, request, kSi, answer, reason));
    EXPECT_EQ("as it was", answer.section);
    return reason;
}

T_SECTION_REQUEST Of(SECTION_VALUES values, SECTION_TASK task = SECTION_TASK::Capacity)
{
    T_SECTION_REQUEST r;
    r.task = task;
    r.options.values = values;
    return r;
}

} // namespace

// x = As fy / (17/21 b fc), M = As fy (d - 99/238 x): the areas of the parabola-rectangle of C50
// and below; steel yields. Expected: ASCE 41-17 Tables 10-1 (without means) and 9-3.
TEST(SectionCurves, EachKindOfValuesHasItsStrengths)
{
    T_MATL_D noMean = Concrete(), plain = Steel();
    noMean.mean.reset(), plain.mean.reset();
    const struct {
        SECTION_VALUES values;
        T_MATL_D concrete;
        double fc, fy;
        T_MATL_D steel;
        double Fy;
    } kRows[] = {
        {SECTION_VALUES::Characteristic, Concrete(), 25e6, 450e6, Steel(), 275e6},
        {SECTION_VALUES::Mean, Concrete(), 33e6, 500e6, Steel(), 300e6},
        {SECTION_VALUES::Expected, Concrete(), 33e6, 500e6, Steel(), 300e6},
        {SECTION_VALUES::Expected, noMean, 37.5e6, 562.5e6, plain, 1.1 * 275e6},
        {SECTION_VALUES::LowerBound, Concrete(), 25e6, 450e6, Steel(), 275e6},
        {SECTION_VALUES::Design, Concrete(), 25e6 / 1.5, 450e6 / 1.15, Steel(), 275e6},
        {SECTION_VALUES::Assessed, Concrete(), 33e6 / 1.2, 500e6 / 1.2, Steel(), 240e6},
    };
    for (const auto& row : kRows) {
        SCOPED_TRACE(kSectionValueNames[static_cast<std::size_t>(row.values)]);
        const double force = 1200e-6 * row.fy, x = force / (17.0 / 21.0 * 0.3 * row.fc);
        const T_SECTION_STATE at = Answer(Beam(), row.concrete, Of(row.values)).capacities.at(0).at;
        EXPECT_NEAR(force * (0.45 - 99.0 / 238.0 * x), at.My, 1e-6 * at.My);
        EXPECT_NEAR(x, at.depth, 1e-6 * x);
        EXPECT_NEAR(0.0035, at.top, 1e-12);
        EXPECT_LT(at.residual.value_or(1.0), 1e-9);
        const T_SECTION_STATE steel = Answer(Plate(), row.steel, Of(row.values)).capacities[0].at;
        EXPECT_NEAR(row.Fy * 0.3 * 0.5 * 0.5 / 4.0, steel.My, 1e-9 * steel.My);
        EXPECT_FALSE(steel.residual.has_value());
    }
    T_SECTION_REQUEST request = Of(SECTION_VALUES::Design);
    request.options.alphaCc = 0.85;
    const double force = 1200e-6 * 450e6 / 1.15;
    const double x = force / (17.0 / 21.0 * 0.3 * 0.85 * 25e6 / 1.5);
    EXPECT_NEAR(x, Answer(Beam(), Concrete(), request).capacities.at(0).at.depth, 1e-6 * x);
}

// Elastic-plastic rectangle: M = Z fy (1 - (phi_y / phi)^2 / 3), phi_y = 2 eps_y / h, up to 15
// eps_y at the edge; with hardening k its elastic part adds k E I phi and takes k off the rest.
TEST(SectionCurves, ABarOfSteelBendsAsByHandUpToItsStrain)
{
    const double fy = 275e6, E = 210e9, h = 0.5, Z = 0.3 * h * h / 4.0, I = 0.3 * h * h * h / 12.0;
    for (const double k : {0.0, 0.02}) {
        T_SECTION_REQUEST request = Of(SECTION_VALUES::Characteristic, SECTION_TASK::Curvature);
        request.options.hardening = k;
        const T_SECTION_CURVATURE c = Answer(Plate(), Steel(), request).curvatures.at(0);
        const double yield = 2.0 * fy / E / h;
        EXPECT_NEAR(yield, c.curve.points[c.curve.yield].curvature, 1e-9 * yield);
        EXPECT_NEAR(15.0 * yield, c.curve.points.back().curvature, 1e-8 * yield);
        for (const solver::T_CURVATURE_POINT& p : c.curve.points) {
            if (p.curvature < yield) continue;
            const double plastic = Z * fy * (1.0 - std::pow(yield / p.curvature, 2) / 3.0);
            EXPECT_NEAR((1.0 - k) * plastic + k * E * I * p.curvature, p.moment, 1e-8 * p.moment);
        }
    }
}

// The core of the published calculation for NTC 2018 [4.1.8] to [4.1.12], bars at even places.
TEST(SectionCurves, TheEurocodeCoreIsThatOfTheStirrupsAndTheCoverSpalls)
{
    T_SECTION_OPTIONS options;
    options.core = SECTION_CORE::Eurocode;
    CCodeSheet sheet;
    const auto model = SectionModelOf(Column(), Concrete(), options, true, sheet);
    ASSERT_TRUE(model);
    const solver::T_STRESS_LAW &cover = model->laws.at(0), &core = model->laws.at(2);
    EXPECT_TRUE(cover.spalls);
    EXPECT_FALSE(core.spalls);
    EXPECT_NEAR(29.4618e6, core.strength, 1e2);
    EXPECT_NEAR(0.00277759, core.peakStrain, 1e-8);
    EXPECT_NEAR(0.0106389, core.limitStrain, 1e-7);
    EXPECT_NEAR(0.116, model->regions.at(1).rings[0][1].y, 1e-12);
    EXPECT_NEAR(0.216, model->regions[1].rings[0][2].z, 1e-12);
    options.values = SECTION_VALUES::Design; // the gain is that of fck
    CCodeSheet design;
    EXPECT_NEAR(29.4618e6 / 1.5,
                SectionModelOf(Column(), Concrete(), options, true, design)->laws.at(2).strength,
                1e2);
    // EN 1998-3: alpha 0.416315, rho of the longer side 3 legs/(0.5 0.1), fyw/fc = 18.
    options.values = SECTION_VALUES::Characteristic;
    options.core = SECTION_CORE::En1998;
    CCodeSheet annex;
    const auto confined = SectionModelOf(Column(), Concrete(), options, true, annex);
    ASSERT_TRUE(confined);
    EXPECT_NEAR(28553703.98, confined->laws.at(2).strength, 1.0);
    EXPECT_NEAR(0.00342148159, confined->laws.at(2).peakStrain, 1e-9);
    EXPECT_NEAR(0.01389380341, confined->laws.at(2).limitStrain, 1e-9);
}

// Unconfined and confined share fcc / fc = 1 at no pressure only: the ultimate strain grows with
// the hoops' strain by 1.4 rho_s fyh / fcc each (Priestley), rho_s = both directions over their
// sides.
TEST(SectionCurves, ManderCoreEndsWhereItsHoopsDo)
{
    const auto core = [](double hoopStrain) {
        T_SECTION_OPTIONS options;
        options.values = SECTION_VALUES::Mean;
        options.core = SECTION_CORE::Mander;
        options.hoopStrain = hoopStrain;
        CCodeSheet sheet;
        const auto model = SectionModelOf(Column(), Concrete(), options, true, sheet);
        EXPECT_EQ(hoopStrain == 0.0, std::ranges::any_of(sheet.Warnings(), [](const auto& w) {
                      return w.key == "IDS_QM_SECC_WARN_HOOP_STRAIN";
                  }));
        return model->laws.at(2);
    };
    const double legs = 3.0 * pi / 4.0 * 0.008 * 0.008, bx = 0.232, by = 0.432;
    const double ratio = legs / (0.1 * by) + legs / (0.1 * bx);
    const solver::T_STRESS_LAW law = core(0.1);
    EXPECT_NEAR(0.004, core(0.0).limitStrain, 1e-12);
    EXPECT_NEAR(0.004 + 1.4 * ratio * 500e6 * 0.1 / law.strength, law.limitStrain, 1e-9);
    EXPECT_GT(law.strength, 33e6);
    EXPECT_NEAR(5000.0 * std::sqrt(33.0) * 1e6, law.modulus, 1.0);
}

TEST(SectionCurves, WhatHasNoAnswerIsRefusedWithTheMember)
{
    T_MATL_D noMean = Concrete(), noLevel = Concrete(), masonry = Concrete();
    noMean.mean.reset(), noLevel.knowledge.reset(), masonry.type = MATL_CLASS::Masonry;
    T_MATL_D strong = Concrete();
    strong.fck = 95e6;
    T_SECT_D value = Beam(), hooks = Column(), outside = Beam();
    value.shape = SECT_SHAPE::Value;
    hooks.detailing->hooks = STIRRUP_HOOKS::Hooks90;
    outside.bars[0].z = -0.26;
    const auto with = [](auto change) {
        T_SECTION_REQUEST r;
        change(r);
        return r;
    };
    using R = T_SECTION_REQUEST;
    const T_SECTION_REQUEST plain;
    const T_SECTION_REQUEST aci = with([](R& r) {
        r.options.law = SECTION_LAW::Aci;
        r.options.values = SECTION_VALUES::Design;
    });
    const T_SECTION_REQUEST mander = with([](R& r) { r.options.core = SECTION_CORE::Mander; });
    const struct {
        const char* what;
        T_SECT_D section;
        T_MATL_D material;
        T_SECTION_REQUEST request;
    } kRows[] = {
        {"mean.fc", Beam(), noMean, Of(SECTION_VALUES::Mean)},
        {"mean.fc", Beam(), noMean, Of(SECTION_VALUES::Assessed)},
        {"knowledge", Beam(), noLevel, Of(SECTION_VALUES::Assessed)},
        {"type", Beam(), masonry, plain},
        {"fck", Beam(), strong, plain},
        {"shape", value, Concrete(), plain},
        {"bars", Plate(), Concrete(), plain},
        {"detailing", Beam(), Concrete(), mander},
        {"hooks", hooks, Concrete(), mander},
        {"ACI 318", Beam(), Concrete(), aci},
        {"alpha_cc", Beam(), Concrete(), with([](R& r) {
             r.options.values = SECTION_VALUES::Design;
             r.options.alphaCc = std::nan("");
         })},
        {"bar 1", outside, Concrete(), plain},
        {"-540000 to", Beam(), Concrete(), with([](R& r) { r.axial = {-540001.0}; })},
        {"block", Beam(), Concrete(), with([](R& r) {
             r.task = SECTION_TASK::Curvature;
             r.options.law = SECTION_LAW::Aci;
         })},
        {"hardens", Beam(), Concrete(), with([](R& r) { r.options.hardening = 0.01; })},
        {"2000", Beam(), Concrete(), with([](R& r) { r.points = 2001; })},
    };
    for (const auto& row : kRows) {
        const std::string reason = Refusal(row.section, row.material, row.request);
        EXPECT_NE(std::string::npos, reason.find(row.what)) << row.what << ": " << reason;
    }
}

// A round section has the same capacity in every direction, its compressed edge at eps_cu2.
TEST(SectionCurves, StrainsAreThoseOfTheEdgeInEveryDirection)
{
    T_SECT_D round = Beam();
    round.shape = SECT_SHAPE::Circle;
    round.bars = {{0.0, 0.0, 1000e-6}};
    T_SECTION_REQUEST request;
    request.directions = {0.0, 0.3, 2.0, 4.0};
    const T_SECTION_ANSWER answer = Answer(round, Concrete(), request);
    for (const T_SECTION_CAPACITY_AT& c : answer.capacities) {
        EXPECT_NEAR(0.0035, c.at.top, 1e-9);
        EXPECT_NEAR(answer.capacities[0].at.depth, c.at.depth, 1e-9);
        EXPECT_NEAR(std::tan(c.direction), c.at.Mz / c.at.My, 1e-6);
    }
    // An arc of a quarter about the origin: from (0.5, 0) to (0, 0.5).
    const solver::T_RING arc{{0.5, 0.0, std::tan(pi / 8.0)}, {0.0, 0.5}, {-0.2, -0.2}};
    EXPECT_NEAR(0.5, ExtentAlong(arc, pi / 4.0).high, 1e-12);
    EXPECT_NEAR(0.5, ExtentAlong(arc, 0.0).high, 1e-12);
    EXPECT_NEAR(-0.4 / std::sqrt(2.0), ExtentAlong(arc, pi / 4.0).low, 1e-12);
}

// The properties add pieces of the shape, the calculator integrates its outline with its arcs.
TEST(SectionCurves, RolledAndHollowShapesHaveTheStrengthOfTheirProperties)
{
    for (const char* name :
         {"IPE 300", "HEM 100", "SHS 100x5", "RHS 200x100x8", "CFRHS 200x100x8"}) {
        T_SECT_D s = *NamedShape(name), properties;
        SECT_FAULT fault = SECT_FAULT::None;
        ASSERT_EQ(1, CSectionProperties::Calc(s, properties, fault));
        T_SECTION_REQUEST request;
        request.directions = {0.0, pi / 2.0};
        const T_SECTION_ANSWER answer = Answer(s, Steel(), request);
        EXPECT_NEAR(properties.area * 275e6, answer.compression, 1e-9 * answer.compression) << name;
        const double My = answer.capacities.at(0).at.My, Mz = answer.capacities.at(1).at.Mz;
        EXPECT_NEAR(properties.Zy * 275e6, My, 1e-9 * My) << name;
        EXPECT_NEAR(properties.Zz * 275e6, Mz, 1e-9 * Mz) << name;
    }
}

TEST(SectionCurves, FilesHaveEveryPointWithItsSection)
{
    T_SECT_D named = Beam();
    named.name = "a,\"b\"";
    T_SECTION_REQUEST request = Of(SECTION_VALUES::Characteristic, SECTION_TASK::Interaction);
    request.points = 7;
    const T_TEXT_TABLE table = SectionExport(
        {Answer(named, Concrete(), request), Answer(Beam(), Concrete(), request)}, kSi);
    EXPECT_EQ(14U, table.rows.size());
    const std::string csv = TableCsv(table);
    EXPECT_NE(std::string::npos, csv.find("\n\"a,\"\"b\"\"\",C,0,"));
    const T_SHEET sheet = TableSheet(table);
    EXPECT_EQ(SHEET_VALUE(std::string("C")), sheet.cells.at({1, 1}).value);
    // Pure tension, the last point: 1200 mm2 of 450 MPa.
    EXPECT_EQ(SHEET_VALUE(-540000.0), sheet.cells.at({7, 3}).value);
}
