// What the view shows of an analysed model, against statics by hand.
#include "qm_rps/view/parts.h"
#include "qm_rps/view/resulttable.h"
#include "qm_rps/view/resultview.h"

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>

namespace {

constexpr double kRho = 2500.0, kG = 10.0; // kg/m3, m/s2
constexpr double kWeight = kRho * kG * 0.2 * 0.4 / 1000.0;

/// Two spans of 6 m on supports along X, hinged over the middle one, in kN, mm: loads by statics
/// alone. Element 1 stands, 2 is a tie above it.
T_MODEL_CONTENT Beams()
{
    T_MODEL_CONTENT content;
    T_MODEL& m = content.model;
    m.styp.units = {FORCE_UNIT::kN, LENGTH_UNIT::mm};
    m.styp.gravity = kG;
    m.styp.plane = MODEL_PLANE::XZ;
    T_MATL_D concrete;
    concrete.name = "C";
    concrete.type = MATL_CLASS::Concrete;
    concrete.E = 3e10;
    concrete.density = kRho;
    m.materials[1] = concrete;
    T_SECT_D section;
    section.name = "20x40";
    section.shape = SECT_SHAPE::Rectangle;
    section.size = {0.4, 0.2, 0, 0};
    m.sections[1] = section;
    section.name = "values";
    section.shape = SECT_SHAPE::Value;
    section.area = 0.08;
    section.J = section.Iyy = section.Izz = 1e-3;
    m.sections[2] = section;
    for (int n = 1; n <= 3; ++n) {
        m.nodes[n].id = n;
        m.nodes[n].xyz = {6.0 * (n - 1), 0.0, 0.0};
        m.nodes[n].restraint = {n == 1, 0, 1, 0, 0, 0};
    }
    for (int e = 1; e <= 2; ++e) {
        T_ELEM_D& beam = m.elements[e];
        beam.id = e;
        beam.nodeI = e;
        beam.nodeJ = e + 1;
        beam.section = e;
        beam.material = 1;
    }
    m.elements[2].release.I[4] = true;
    T_STLD_D dead{};
    dead.name = "DL";
    dead.selfWeight = {0, 0, -1};
    m.loadCases[1] = dead;
    T_STLD_D live{};
    live.name = "LL";
    T_BEAM_LOAD point;
    point.element = 1;
    point.axes = BEAM_LOAD_AXES::Global;
    point.direction = 2;
    point.type = BEAM_LOAD_TYPE::Point;
    point.w = {-12e3, 0};
    point.at = {1.0 / 3, 1.0};
    live.beam.push_back(point);
    live.nodal.push_back({3, {5e3, 0, 0, 0, 0, 0}});
    m.loadCases[2] = live;
    m.combinations[1] = {"C", {{false, 1, 2.0}, {false, 2, 1.0}}};
    return content;
}

using KIND = T_SHAPE_SOURCE::KIND;

class ResultView : public testing::Test {
protected:
    ResultView()
    {
        doc.Data().Assign(Beams());
        T_ANALYSIS_ERROR error;
        EXPECT_TRUE(doc.RunAnalysis({}, error)) << error.text;
    }
    void Show(KIND kind, int key, VIEW_WHAT what)
    {
        view.Refresh();
        const auto& all = view.Sources();
        const auto it = std::ranges::find_if(
            all, [&](const auto& s) { return s.kind == kind && s.key == key; });
        ASSERT_NE(all.end(), it);
        view.OnSource(static_cast<std::size_t>(it - all.begin()));
        T_VIEW_CHOICE choice = view.Choice();
        choice.what = what;
        view.OnChoice(choice);
    }
    /// The value of the diagram with the largest magnitude, with its place.
    T_DIAGRAM_POINT Extreme(std::size_t member)
    {
        const T_DIAGRAM& d = *view.Diagram();
        const T_MEMBER_DIAGRAM& m = d.members.at(member);
        const std::size_t at =
            std::fabs(d.Value(m.largest)) > std::fabs(d.Value(m.smallest)) ? m.largest : m.smallest;
        return d.points[at];
    }
    CDBDoc doc;
    CFrameScene scene{doc};
    CSelection selection;
    CResultView view{doc, scene, selection};
};

} // namespace

TEST_F(ResultView, DiagramsAreThoseOfStaticsInCurrentUnits)
{
    Show(KIND::Static, 1, VIEW_WHAT::My);
    ASSERT_NE(nullptr, view.Diagram());
    EXPECT_EQ("kN*mm", view.Diagram()->unit);
    for (const std::size_t member : {0U, 1U}) {
        EXPECT_NEAR(-kWeight * 36 / 8 * 1000, Extreme(member).value, 1e-6); // w L^2 / 8
        EXPECT_NEAR(0.5, Extreme(member).at, 1e-6);
    }
    Show(KIND::Combination, 1, VIEW_WHAT::My); // at the load 2 w a b / 2 + P a b / L
    EXPECT_NEAR(-(2 * kWeight * 2 * 4 / 2 + 12.0 * 2 * 4 / 6) * 1000, Extreme(0).value, 1e-6);
    Show(KIND::Static, 2, VIEW_WHAT::Vz); // 8 before the load, 4 behind it: it leaps by 12
    const T_DIAGRAM& d = *view.Diagram();
    EXPECT_NEAR(4.0, d.Value(d.members[0].largest), 1e-9);
    EXPECT_NEAR(-8.0, d.Value(d.members[0].smallest), 1e-9);
    EXPECT_EQ(0U, d.notExact);
    Show(KIND::Static, 2, VIEW_WHAT::N);
    EXPECT_NEAR(5.0, Extreme(1).value, 1e-9);
    EXPECT_EQ((std::array<double, 3>{0, 0, 1}), view.Diagram()->members[0].along);
}

TEST_F(ResultView, MembersBendBetweenTheirNodes)
{
    Show(KIND::Static, 1, VIEW_WHAT::Deformed);
    ASSERT_NE(nullptr, view.Bent());
    // Nodes stay; 5 w L^4 / 384 EI at the middle, and the shear w L^2 / 8 GA with A 5/6.
    const double EI = 3e10 * 0.2 * std::pow(0.4, 3) / 12, w = 1000 * kWeight;
    const double GA = 3e10 / 2 * 0.08 * 5 / 6;
    const auto& middle = view.Bent()->moved.at(kBentParts / 2);
    EXPECT_NEAR(-1000 * (5 * w * std::pow(6.0, 4) / (384 * EI) + w * 36 / (8 * GA)), middle[2],
                1e-9);
    EXPECT_NEAR(0.0, (*view.Moves())[1][2], 1e-12);
}

TEST_F(ResultView, ReactionsAndLoadsAreArrowsWithTheirValues)
{
    Show(KIND::Combination, 1, VIEW_WHAT::Reactions);
    std::map<double, double> up;
    for (const T_ARROW_MARK& a : view.Marks()->arrows)
        if (a.kind == MARK_KIND::Force && a.along[2] > 0.5) up[a.at[0]] = a.value;
    const double span = 2 * kWeight * 6;
    EXPECT_NEAR(span / 2 + 8, up[0], 1e-9);
    EXPECT_NEAR(span + 4, up[6000], 1e-9);
    EXPECT_NEAR(span / 2, up[12000], 1e-9);
    Show(KIND::Combination, 1, VIEW_WHAT::Loads);
    ASSERT_EQ(2U, view.Marks()->arrows.size());
    ASSERT_EQ(1U, view.Marks()->notes.size()); // twice the weight
    EXPECT_NE(std::string::npos, view.Note().find("self weight 2 times along -Z"));
    const T_ARROW_MARK& point = view.Marks()->arrows[1];
    EXPECT_EQ((std::array<double, 3>{0, 0, -1}), point.along);
    EXPECT_NEAR(12.0, point.value, 1e-12);
    EXPECT_NEAR(2000.0, point.at[0], 1e-9);
}

TEST_F(ResultView, StressesNeedASectionWithDimensions)
{
    Show(KIND::Static, 2, VIEW_WHAT::Stress);
    ASSERT_EQ(2U, view.Stress()->lines.size());
    EXPECT_TRUE(view.Stress()->lines[1].value.empty());
    EXPECT_EQ(1U, view.Stress()->unchecked);
    // N / A + M / W at the middle: 5 kN; 12 kNm of 16 at a third; W = b h^2 / 6; kN/mm2.
    EXPECT_NEAR(5.0 / 80e3 + 12e3 / (200.0 * 400 * 400 / 6),
                view.Stress()->lines[0].value.at(kStressPlaces / 2), 1e-9);
}

TEST_F(ResultView, WhatWasNotAnalysedIsSaidAndNotDrawn)
{
    doc.Data().SetStaticResult(2, nullptr);
    Show(KIND::Static, 1, VIEW_WHAT::My);
    EXPECT_NE(nullptr, view.Diagram());
    Show(KIND::Combination, 1, VIEW_WHAT::My);
    EXPECT_FALSE(view.Source().analysed);
    EXPECT_EQ(nullptr, view.Diagram());
    EXPECT_EQ(nullptr, view.Moves());
    EXPECT_NE(std::string::npos, view.Note().find("Not analysed"));
    Show(KIND::Combination, 1, VIEW_WHAT::Loads); // the loads are known
    EXPECT_EQ(2U, view.Marks()->arrows.size());
    EXPECT_EQ("", view.Missing());
}

TEST_F(ResultView, HiddenElementsAreGoneFromWhatIsShown)
{
    const std::vector<T_MODEL_PART> parts = PartsOf(doc, 1);
    ASSERT_EQ("values", parts.at(1).name);
    selection.Hide(parts[1].elements);
    Show(KIND::Static, 1, VIEW_WHAT::My);
    ASSERT_EQ(1U, view.Diagram()->members.size());
    EXPECT_EQ(1, view.Scene().lines[0].id);
    EXPECT_FALSE(view.Scene().nodes[2].shown);
    Show(KIND::Static, 1, VIEW_WHAT::Reactions);
    for (const T_ARROW_MARK& a : view.Marks()->arrows)
        EXPECT_LT(a.at[0], 7000.0);
}

TEST_F(ResultView, TablesHaveExtremesBetweenPositionsAndTheCasesOfAnEnvelope)
{
    view.Refresh();
    T_RESULT_TABLE_CHOICE choice;
    for (const T_SHAPE_SOURCE& source : view.Sources())
        if (source.kind == KIND::Static) choice.sources.emplace_back(source, 1);
    choice.elements = {1};
    T_RESULT_TABLE table;
    std::string why;
    ASSERT_TRUE(MakeResultTable(doc, scene, choice, table, why)) << why;
    // DL: five positions. LL: these, and both sides of the load at 2 m, where My is P a b / L.
    ASSERT_EQ(12U, table.rows.size());
    EXPECT_EQ("x = 2000-", table.rows[10][2].text);
    EXPECT_NEAR(-8.0, table.rows[10][5].number.value(), 1e-9);
    EXPECT_NEAR(-16000.0, table.rows[10][7].number.value(), 1e-6);
    EXPECT_EQ("x = 2000+", table.rows[11][2].text);
    EXPECT_NEAR(4.0, table.rows[11][5].number.value(), 1e-9);
    choice.envelope = true;
    ASSERT_TRUE(MakeResultTable(doc, scene, choice, table, why)) << why;
    const auto row = std::ranges::find_if(
        table.rows, [](const auto& r) { return r[1].text == "member" && r[2].text == "My"; });
    ASSERT_NE(table.rows.end(), row);
    EXPECT_NEAR(-16000.0, (*row)[4].number.value(), 1e-6); // of DL 9000
    EXPECT_EQ("LL", (*row)[5].text);
    EXPECT_NE(std::string::npos, CsvText(table).find("\n1,member,My,kN*mm,-1"));
    doc.Data().SetStaticResult(2, nullptr);
    view.Refresh();
    choice.sources[1].first = view.Sources()[2];
    EXPECT_FALSE(MakeResultTable(doc, scene, choice, table, why));
    EXPECT_NE(std::string::npos, why.find("LL"));
}

TEST(HingeTurns, BehindThemTheMembersHaveTheMomentsOfTheirHinges)
{
    CDBDoc doc;
    T_FILE_ERROR fileError;
    ASSERT_TRUE(doc.ImportCase(QM_PROJECT "/examples/rc-frame-3-storey/case.json", fileError));
    CPushRun push(doc);
    std::vector<T_PUSH_RUN> runs;
    std::string why;
    int key = 0;
    ASSERT_TRUE(doc.Attr().FindPolc("PX_HINGES", key));
    ASSERT_TRUE(push.Run(key, {}, runs, why)) << why;
    const T_PUSH_RUN& run = runs.at(0);
    CViewFrame frame(doc);
    ASSERT_TRUE(frame.Refresh(why)) << why;
    std::size_t flowed = 0;
    for (const int step : {1, 25, static_cast<int>(run.loadFactor.size())}) {
        const auto at = static_cast<std::size_t>(step - 1);
        const T_HINGE_TURNS turns = HingeTurnsOf(run, step);
        const auto moved = [&](std::size_t node) {
            const int id = frame.NodeId(node);
            return run.data.displacement[at][static_cast<std::size_t>(
                std::ranges::find(run.data.nodes, id) - run.data.nodes.begin())];
        };
        for (std::size_t h = 0; h < run.hinges.size(); ++h) {
            const T_PUSH_HINGE_SERIES& hinge = run.hinges[h];
            const auto e = static_cast<std::size_t>(frame.ElementAt(hinge.place.element));
            // Columns have no loads between their ends.
            if (std::fabs(frame.Axes(e)->x[2]) < 0.5) continue;
            if (hinge.place.component != HINGE_COMPONENT::My) continue;
            T_LINE_ENDS ends = frame.Ends(e, moved(frame.Frame().elements[e].i),
                                          moved(frame.Frame().elements[e].j));
            TakeHinges(turns, hinge.place.element, ends);
            const CMemberLine member(frame.Axes(e)->length, ends, frame.Stiffness(e));
            const double x = run.data.hinges[h].at * member.Length();
            EXPECT_NEAR(hinge.force[at], member.Force(4, x), 1e-6 * std::fabs(hinge.force[at]) + 1)
                << hinge.place.element << hinge.place.end << " step " << step;
            if (hinge.deformation[at] != 0.0) ++flowed;
        }
    }
    EXPECT_GE(flowed, 4U); // the heads of the four columns of the ground storey
}
