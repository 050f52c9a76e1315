// Linear analysis from the records of a document to its results.
#include "casetext.h"

#include "qm_db/analysis/analysismodel.h"
#include "qm_db/dbdoc.h"

#include <cmath>
#include <gtest/gtest.h>

namespace {

/// A cantilever of 2 m along X in the plane XZ with a hanger under its tip, in kN and m.
constexpr const char* kCantilever = R"({
 "format": "qm-rps case 1", "units": {"force": "kN", "length": "m"}, "plane": "XZ",
 "nodes": [{"id": 10, "xyz": [0, 0, 0], "restraint": [1, 1, 1, 1, 1, 1]},
           {"id": 20, "xyz": [2, 0, 0], "mass": [3, 3, 3]}],
 "materials": [{"name": "S", "E": 2e8, "nu": 0.25, "density": 8, "alpha": 1e-5}],
 "sections": [{"name": "B", "A": 0.01, "J": 1e-4, "Iy": 5e-5, "Iz": 1e-5}],
 "elements": [{"id": 7, "nodes": [10, 20], "material": "S", "section": "B"}],
 "load_cases": [
  {"name": "tip", "nodal": [{"node": 20, "load": [0, 0, -12, 0, 0, 0]}]},
  {"name": "hot", "temperature": [{"element": 7, "change": 30}]},
  {"name": "own", "self_weight": [0, 0, -1]}],
 "combinations": [{"name": "C", "items": [{"case": "tip", "factor": 2}, {"case": "hot",
  "factor": 1}]}]
})";

/// A document with the cantilever.
class AnalysisRun : public testing::Test {
protected:
    AnalysisRun() { m_doc.Data().Assign(ParseGood(kCantilever)); }
    void Run(const T_ANALYSIS_OPTIONS& options)
    {
        ASSERT_EQ(1, m_doc.RunAnalysis(options, m_error)) << m_error.text;
    }

    CDBDoc m_doc;
    T_ANALYSIS_ERROR m_error;
};

} // namespace

// Deflection P L3 / (3 E I), moment P L, stretch alpha dT L, weight 8 t/m3 * 9.80665 * 0.01 m2 * 2
// m.
TEST_F(AnalysisRun, GivesTheTextbookCantilever)
{
    Run({});
    CPostCtrl& post = m_doc.Post();
    T_DOF6 v{};
    ASSERT_EQ(1, post.SelectLoadCombNew(1));
    ASSERT_EQ(1, post.GetDispNew(20, v)) << post.Error();
    EXPECT_NEAR(-2 * 12.0 * 8 / (3 * 2e8 * 5e-5), v[2], 1e-12);
    EXPECT_NEAR(1e-5 * 30 * 2, v[0], 1e-14);
    ASSERT_EQ(1, post.GetReacNew(10, v));
    EXPECT_NEAR(24.0, v[2], 1e-9);
    EXPECT_NEAR(-48.0, v[4], 1e-9); // about Y, holding a force that turns about +Y
    ASSERT_EQ(1, post.GetStrbNew(7, 2, v));
    EXPECT_NEAR(24.0, std::fabs(v[4]), 1e-9); // half of the moment at the support
    ASSERT_EQ(1, post.SelectLoadCombNew(CPostCtrl::MakeLoadComb(3)));
    ASSERT_EQ(1, post.GetReacNew(10, v));
    EXPECT_NEAR(8 * 9.80665 * 0.01 * 2, v[2], 1e-9);

    // Old as soon as the model changes.
    ASSERT_EQ(1, m_doc.Edit().Begin("node"));
    ASSERT_EQ(1, m_doc.Edit().Put(20, T_NODE_D{20, {2.5, 0, 0}, {}, {}}));
    ASSERT_EQ(1, m_doc.Edit().Commit());
    EXPECT_EQ(0, post.GetReacNew(10, v));
    Run({});
    EXPECT_EQ(1, post.GetReacNew(10, v)) << post.Error();
}

// A section given by its dimensions: I = b h3 / 12, whatever values stand beside them; shear areas
// of a rectangle are 5/6 of its area.
TEST_F(AnalysisRun, CalculatesSectionsFromTheirDimensions)
{
    T_SECT_D& section = m_doc.Data().ModelForEdit().sections.at(1);
    section.shape = SECT_SHAPE::Rectangle;
    section.size = {0.3, 0.2, 0, 0};
    Run({false, {1}, 0, {}});
    T_DOF6 v{};
    ASSERT_EQ(1, m_doc.Post().SelectLoadCombNew(CPostCtrl::MakeLoadComb(1)));
    ASSERT_EQ(1, m_doc.Post().GetDispNew(20, v));
    const double bending = 12.0 * 8 / (3 * 2e8 * 0.2 * 0.027 / 12);
    const double shear = 12.0 * 2 / (8e7 * 0.06 * 5 / 6); // G = E / 2.5
    EXPECT_NEAR(-(bending + shear), v[2], 1e-12);
}

TEST_F(AnalysisRun, RunsTheCasesThatAreAskedFor)
{
    Run({false, {2}, 0, {}});
    EXPECT_EQ(0, m_doc.Post().CheckStaticResult(1));
    EXPECT_EQ(1, m_doc.Post().CheckStaticResult(2));
    EXPECT_EQ(0, m_doc.RunAnalysis({false, {5}, 0, {}}, m_error));
    EXPECT_EQ("there is no load case 5", m_error.text);
    EXPECT_EQ(5, m_error.loadCase);
}

// A mass of 3 t at the tip: omega2 = 3 E I / (L3 m), half of the beam's 0.16 t goes with it.
TEST_F(AnalysisRun, KeepsModesOnRequestAsAStepThatCanBeUndone)
{
    const T_MODEL before = m_doc.Data().Model();
    Run({});
    EXPECT_EQ(before, m_doc.Data().Model());
    Run({false, {}, 1, {}});
    ASSERT_EQ(1, m_doc.Post().GetNumEigvPost());
    const double omega = std::sqrt(3 * 2e8 * 5e-5 / (8 * (3.0 + 0.08)));
    EXPECT_NEAR(2 * M_PI / omega, m_doc.Data().Model().modes.at(1).period, 1e-9);
    ASSERT_EQ(1, m_doc.Undo().Undo());
    EXPECT_EQ(before, m_doc.Data().Model());
}

TEST_F(AnalysisRun, RefusalsNameIdsAndChangeNothing)
{
    struct T_ROW {
        void (*spoil)(T_MODEL& m);
        int node, element, loadCase;
        const char* text; // its beginning
        ANALYSIS_FAULT fault = ANALYSIS_FAULT::BadModel;
        int direction = -1;
    };
    constexpr auto kFree = ANALYSIS_FAULT::Mechanism;
    const T_ROW rows[] = {
        {[](T_MODEL& m) { m.elements.at(7).material = 0; }, 0, 7, 0,
         "beam 7: the material is missing"},
        {[](T_MODEL& m) { m.elements.at(7).section = 5; }, 0, 7, 0,
         "beam 7: the section is missing"},
        {[](T_MODEL& m) { m.elements.at(7).nodeJ = 30; }, 0, 7, 0, "beam 7: there is no node 30"},
        {[](T_MODEL& m) { m.sections.at(1).area = -1; }, 0, 7, 0, "beam 7: section \"B\": "},
        {[](T_MODEL& m) { m.sections.at(1).area = 0; }, 0, 7, 0,
         "beam 7: the area A of its section is not positive"},
        {[](T_MODEL& m) { (m.elements[9] = m.elements.at(7)).id = 9; }, 0, 9, 0,
         "beam 9: another element of the same kind"},
        {[](T_MODEL& m) { m.nodes.at(10).restraint = {1, 1, 1, 0, 0, 0}; }, 10, 0, 0,
         "part of 2 nodes at node 10: the part is free to turn about Y", kFree, 4},
        {[](T_MODEL& m) { m.elements.at(7).release.I[4] = true; }, 20, 0, 0, "node 20", kFree, 2},
        {[](T_MODEL& m) {
             m.diaphragms[2] = {{20, 21}, 2};
         },
         21, 0, 0, "diaphragm 2: there is no node 21"},
        {[](T_MODEL& m) { m.loadCases.at(1).nodal[0].node = 21; }, 21, 0, 1,
         "load case \"tip\": there is no node 21"},
        {[](T_MODEL& m) { m.loadCases.at(2).temperature[0].element = 8; }, 0, 8, 2,
         "load case \"hot\": there is no element 8"},
        {[](T_MODEL& m) {
             m.loadCases.at(3).settlement = {{20, {0, 0, 1, 0, 0, 0}}};
         },
         20, 0, 3, "load case \"own\", node 20"},
    };
    for (const T_ROW& row : rows) {
        T_MODEL_CONTENT content = ParseGood(kCantilever);
        row.spoil(content.model);
        m_doc.Data().Assign(content);
        EXPECT_EQ(0, m_doc.RunAnalysis({}, m_error)) << row.text;
        EXPECT_EQ(row.fault, m_error.fault) << m_error.text;
        EXPECT_TRUE(m_error.text.starts_with(row.text)) << m_error.text << " / " << row.text;
        EXPECT_EQ((std::array{row.node, row.element, row.loadCase}),
                  (std::array{m_error.node, m_error.element, m_error.loadCase}))
            << m_error.text;
        EXPECT_TRUE(row.direction < 0 || row.direction == m_error.direction) << m_error.text;
        EXPECT_TRUE(m_doc.Data().Content().staticResults.empty()) << row.text;
        EXPECT_FALSE(m_doc.Data().IsModified());
    }
}

// What the engine gets: every field of every record in its place, SI.
TEST(AnalysisModel, TranslatesRecordsByTheirNumbers)
{
    T_MODEL m = ParseGood(CaseText("struct_all_members.json")).model;
    m.elements.at(8).material = 4; // the one without a section
    m.elements.at(8).section = 1;
    CAnalysisModel model(m);
    T_ANALYSIS_ERROR error;
    ASSERT_EQ(1, model.BuildFrame(error)) << error.text;
    const solver::T_FRAME& f = model.Frame();
    EXPECT_EQ((solver::T_DIRS6{false, true, false, true, false, true}), f.nodes[1].fixed);
    EXPECT_EQ(2000.0, f.nodes[2].mass[1]);
    EXPECT_EQ(8.1e10, f.materials[0].G);
    EXPECT_DOUBLE_EQ(3.3e10 / 2.4, f.materials[1].G); // from E and nu = 0.2
    EXPECT_EQ(2.1e-7, f.sections[0].J);
    EXPECT_EQ(1.34e-5, f.sections[0].Iz);
    EXPECT_EQ(9.80665, f.gravity);
    EXPECT_EQ(1U, f.elements[1].material); // key 4 is the second
    EXPECT_TRUE(f.elements[0].releaseI[5] && f.elements[0].releaseJ[4]);
    EXPECT_EQ(-0.2, f.elements[0].offsetJ[2]);
    EXPECT_EQ(solver::ELEMENT_KIND::Link, f.elements[2].kind);
    EXPECT_EQ(3U, f.elements[2].j); // node 9 is the fourth
    EXPECT_EQ(6e4, f.elements[2].stiffness[5]);
    EXPECT_EQ(solver::ELEMENT_KIND::Spring, f.elements[3].kind);
    EXPECT_EQ((std::vector<std::size_t>{1, 2, 3}), f.diaphragms[0].nodes);
    EXPECT_EQ(0, f.diaphragms[1].normal);
    EXPECT_TRUE(f.equalDisplacements[0].directions[0] && f.equalDisplacements[0].directions[5]);

    solver::T_LOAD_CASE loads;
    ASSERT_EQ(1, model.BuildCase(1, loads, error)) << error.text;
    EXPECT_EQ(-1.0, loads.selfWeight[2]);
    EXPECT_EQ(2U, loads.nodal[0].node);
    EXPECT_EQ(3e3, loads.nodal[0].load[5]);
    EXPECT_TRUE(loads.beam[0].local);
    EXPECT_FALSE(loads.beam[1].local);
    EXPECT_EQ((std::array<double, 2>{0.25, 0.75}), loads.beam[1].at);
    EXPECT_EQ(solver::BEAM_LOAD::Moment, loads.beam[3].type);
    EXPECT_EQ(7e3, loads.beam[3].w[0]);
    EXPECT_EQ(0.002, loads.settlement[0].displacement[4]);
    EXPECT_EQ(1U, loads.temperature[0].element);
    EXPECT_EQ(1e5, loads.pretension[0].force);
}
