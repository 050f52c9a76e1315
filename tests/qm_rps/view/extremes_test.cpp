// The largest values along a member in tables and pictures of stress, by hand.
#include "qm_rps/view/resulttable.h"
#include "qm_rps/view/resultview.h"

#include <gtest/gtest.h>

#include <algorithm>

namespace {

using TYPE = BEAM_LOAD_TYPE;

T_BEAM_LOAD Load(TYPE type, int direction, double w0, double w1, double at)
{
    T_BEAM_LOAD load;
    load.element = 1;
    load.axes = BEAM_LOAD_AXES::Global;
    load.type = type;
    load.direction = direction;
    load.w = {w0, w1};
    load.at = {at, 1.0};
    return load;
}

/// 10 m along X on two supports, 30x50, in kN, m; cases W, M, P and B.
T_MODEL_CONTENT Beam()
{
    T_MODEL_CONTENT content;
    T_MODEL& m = content.model;
    m.styp.units = {FORCE_UNIT::kN, LENGTH_UNIT::m};
    m.materials[1].name = "C";
    m.materials[1].type = MATL_CLASS::Concrete;
    m.materials[1].E = 3e10;
    m.materials[1].nu = 0.2;
    m.sections[1].name = "30x50";
    m.sections[1].shape = SECT_SHAPE::Rectangle;
    m.sections[1].size = {0.5, 0.3, 0, 0};
    for (int n = 1; n <= 2; ++n) {
        m.nodes[n].id = n;
        m.nodes[n].xyz = {10.0 * (n - 1), 0.0, 0.0};
        m.nodes[n].restraint = {n == 1, 1, 1, n == 1, 0, 0};
    }
    T_ELEM_D& beam = m.elements[1];
    beam.id = beam.nodeI = beam.section = beam.material = 1;
    beam.nodeJ = 2;
    const T_BEAM_LOAD point = Load(TYPE::Point, 2, -100e3, 0, 0.3);
    const std::vector<std::pair<const char*, std::vector<T_BEAM_LOAD>>> cases{
        {"W", {Load(TYPE::Distributed, 2, -10e3, 10e3, 0.0)}},
        {"M", {Load(TYPE::Moment, 1, 60e3, 0, 0.3)}},
        {"P", {point}},
        {"B", {point, Load(TYPE::Distributed, 1, 20e3, 20e3, 0.0)}}};
    for (std::size_t c = 0; c < cases.size(); ++c) {
        T_STLD_D& record = m.loadCases[static_cast<int>(c) + 1];
        record.name = cases[c].first;
        record.beam = cases[c].second;
    }
    return content;
}

class MemberExtremes : public testing::Test {
protected:
    MemberExtremes()
    {
        doc.Data().Assign(Beam());
        T_ANALYSIS_ERROR error;
        EXPECT_TRUE(doc.RunAnalysis({}, error)) << error.text;
        view.Refresh();
    }
    T_SHAPE_SOURCE Case(int key)
    {
        const auto it = std::ranges::find_if(view.Sources(), [&](const T_SHAPE_SOURCE& s) {
            return s.kind == T_SHAPE_SOURCE::KIND::Static && s.key == key;
        });
        return *it;
    }
    T_RESULT_TABLE Table(int key, bool envelope)
    {
        T_RESULT_TABLE_CHOICE choice;
        choice.sources.emplace_back(Case(key), 1);
        choice.envelope = envelope;
        T_RESULT_TABLE table;
        std::string why;
        EXPECT_TRUE(MakeResultTable(doc, scene, choice, table, why)) << why;
        return table;
    }
    CDBDoc doc;
    CFrameScene scene{doc};
    CSelection selection;
    CResultView view{doc, scene, selection};
};

struct T_EXTREME_CASE {
    const char* label;
    int key;
    double least, most;                             // My of the envelope of the member
    std::vector<std::pair<std::string, double>> at; // rows between the positions, My
};

} // namespace

TEST_F(MemberExtremes, TablesHaveThoseBetweenThePositions)
{
    // W: w L^2 / (36 sqrt 3) at 5 -+ 5 / sqrt 3. M: 60 / 10 * 3, less 60. P: 100 * 3 * 7 / 10.
    const double turning = 1000 / (36 * 1.7320508075688772);
    const T_EXTREME_CASE cases[] = {
        {"W", 1, -turning, turning, {{"x = 2.11325", -turning}, {"x = 7.88675", turning}}},
        {"M", 2, -42, 18, {{"x = 3-", 18}, {"x = 3+", -42}}},
        {"P", 3, -210, 0, {{"x = 3-", -210}, {"x = 3+", -210}}}};
    for (const T_EXTREME_CASE& c : cases) {
        const T_RESULT_TABLE rows = Table(c.key, false);
        ASSERT_EQ(5 + c.at.size(), rows.rows.size()) << c.label;
        for (std::size_t r = 0; r < c.at.size(); ++r) {
            EXPECT_EQ(c.at[r].first, rows.rows[5 + r][2].text) << c.label;
            EXPECT_NEAR(c.at[r].second, rows.rows[5 + r][7].number.value(), 1e-9) << c.label;
        }
        const T_RESULT_TABLE envelope = Table(c.key, true);
        const auto row = std::ranges::find_if(envelope.rows, [](const auto& r) {
            return r[1].text == "member" && r[2].text == "My";
        });
        ASSERT_NE(envelope.rows.end(), row) << c.label;
        EXPECT_NEAR(c.least, (*row)[4].number.value(), 1e-9) << c.label;
        EXPECT_NEAR(c.most, (*row)[6].number.value(), 1e-9) << c.label;
    }
}

TEST_F(MemberExtremes, StressesHaveThatBetweenTheirPlaces)
{
    // P: 210 / (0.3 * 0.5^2 / 6). B: with 20 * 10^2 / 2 s (1 - s) / (0.5 * 0.3^2 / 6) across, and
    // 24000 (1 - s) of P behind it: the sum is largest at s = 0.41, where neither is.
    const double sum = 24000 * 0.59 + 1000 / 0.0075 * 0.41 * 0.59;
    for (const auto& [key, stress] : {std::pair(3, 16800.0), std::pair(4, sum)}) {
        T_VIEW_CHOICE choice;
        choice.what = VIEW_WHAT::Stress;
        view.OnChoice(choice);
        ASSERT_TRUE(view.OnShow(Case(key), 1));
        EXPECT_NEAR(stress, view.Stress()->largest, 1e-6 * stress) << key;
    }
}
