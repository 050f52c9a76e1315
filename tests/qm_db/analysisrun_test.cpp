// Linear analysis from the records of a document to its results.
#include "qm_db/analysis/analysismodel.h"
#include "qm_db/casefile.h"
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

T_MODEL_CONTENT ContentOf(const char* text)
{
    T_MODEL_CONTENT content;
    T_FILE_ERROR error;
    EXPECT_EQ(1, CCaseFile::Parse(text, "case", "", content, error)) << error.text;
    return content;
}

} // namespace

// Deflection P L3 / (3 E I), moment P L, stretch alpha dT L, weight 8 t/m3 * 9.80665 * 0.01 m2 * 2
// m.
TEST(AnalysisRun, GivesTheTextbookCantilever)
{
    CDBDoc doc;
    doc.Data().Assign(ContentOf(kCantilever));
    T_ANALYSIS_ERROR error;
    ASSERT_EQ(1, doc.RunAnalysis({}, error)) << error.text;
    CPostCtrl& post = doc.Post();
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

    // The same in other units, and old as soon as the model changes.
    ASSERT_EQ(1, doc.Edit().Begin("units"));
    ASSERT_EQ(
        1,
        doc.Edit().PutStyp(
            {"", {FORCE_UNIT::N, LENGTH_UNIT::mm}, {}, {}, false, false, false, MODEL_PLANE::XZ}));
    ASSERT_EQ(1, doc.Edit().Commit());
    ASSERT_EQ(1, post.GetReacNew(10, v)) << post.Error();
    EXPECT_NEAR(8 * 9.80665 * 0.01 * 2 * 1000, v[2], 1e-6);
    ASSERT_EQ(1, doc.Edit().Begin("node"));
    ASSERT_EQ(1, doc.Edit().Put(20, T_NODE_D{20, {2500, 0, 0}, {}, {}}));
    ASSERT_EQ(1, doc.Edit().Commit());
    EXPECT_EQ(0, post.GetReacNew(10, v));
    ASSERT_EQ(1, doc.RunAnalysis({}, error)) << error.text;
    EXPECT_EQ(1, post.GetReacNew(10, v)) << post.Error();
}

// A section given by its dimensions: I = b h3 / 12, whatever values stand beside them; shear areas
// of a rectangle are 5/6 of its area.
TEST(AnalysisRun, CalculatesSectionsFromTheirDimensions)
{
    T_MODEL_CONTENT content = ContentOf(kCantilever);
    content.model.sections.at(1).shape = SECT_SHAPE::Rectangle;
    content.model.sections.at(1).size = {0.3, 0.2, 0, 0};
    CDBDoc doc;
    doc.Data().Assign(content);
    T_ANALYSIS_ERROR error;
    ASSERT_EQ(1, doc.RunAnalysis({false, {1}, 0, {}}, error)) << error.text;
    T_DOF6 v{};
    ASSERT_EQ(1, doc.Post().SelectLoadCombNew(CPostCtrl::MakeLoadComb(1)));
    ASSERT_EQ(1, doc.Post().GetDispNew(20, v));
    const double bending = 12.0 * 8 / (3 * 2e8 * 0.2 * 0.027 / 12);
    const double shear = 12.0 * 2 / (8e7 * 0.06 * 5 / 6); // G = E / 2.5
    EXPECT_NEAR(-(bending + shear), v[2], 1e-12);
}

TEST(AnalysisRun, RunsTheCasesThatAreAskedFor)
{
    CDBDoc doc;
    doc.Data().Assign(ContentOf(kCantilever));
    T_ANALYSIS_ERROR error;
    ASSERT_EQ(1, doc.RunAnalysis({false, {2}, 0, {}}, error)) << error.text;
    EXPECT_EQ(0, doc.Post().CheckStaticResult(1));
    EXPECT_EQ(1, doc.Post().CheckStaticResult(2));
    EXPECT_EQ(0, doc.RunAnalysis({false, {5}, 0, {}}, error));
    EXPECT_EQ("there is no load case 5", error.text);
    EXPECT_EQ(5, error.loadCase);
}

// A mass of 3 t at the tip: omega2 = 3 E I / (L3 m), half of the beam's 0.16 t goes with it.
TEST(AnalysisRun, KeepsModesOnRequestAsAStepThatCanBeUndone)
{
    CDBDoc doc;
    doc.Data().Assign(ContentOf(kCantilever));
    const T_MODEL before = doc.Data().Model();
    T_ANALYSIS_ERROR error;
    ASSERT_EQ(1, doc.RunAnalysis({}, error)) << error.text;
    EXPECT_EQ(before, doc.Data().Model());
    ASSERT_EQ(1, doc.RunAnalysis({false, {}, 1, {}}, error)) << error.text;
    ASSERT_EQ(1, doc.Post().GetNumEigvPost());
    const double mass = 3.0 + 0.08;
    const double omega = std::sqrt(3 * 2e8 * 5e-5 / (8 * mass));
    EXPECT_NEAR(2 * M_PI / omega, doc.Data().Model().modes.at(1).period, 1e-9);
    ASSERT_EQ(1, doc.Undo().Undo());
    EXPECT_EQ(before, doc.Data().Model());
}

TEST(AnalysisRun, RefusalsNameIdsAndChangeNothing)
{
    struct T_ROW {
        void (*spoil)(T_MODEL& m);
        ANALYSIS_FAULT fault;
        int node, element, loadCase, direction;
        const char* text; // its beginning
    };
    using A = ANALYSIS_FAULT;
    // clang-format off
    const T_ROW rows[] = {
        {[](T_MODEL& m) { m.elements.at(7).material = 0; }, A::BadModel, 0, 7, 0, -1,
         "beam 7: the material is missing"},
        {[](T_MODEL& m) { m.elements.at(7).section = 5; }, A::BadModel, 0, 7, 0, -1,
         "beam 7: the section is missing"},
        {[](T_MODEL& m) { m.elements.at(7).nodeJ = 30; }, A::BadModel, 0, 7, 0, -1,
         "beam 7: there is no node 30"},
        {[](T_MODEL& m) { m.nodes.at(20).xyz = {}; }, A::BadModel, 0, 7, 0, -1,
         "beam 7: zero length"},
        {[](T_MODEL& m) { m.sections.at(1).area = -1; }, A::BadModel, 0, 7, 0, -1,
         "beam 7: section \"B\": "},
        {[](T_MODEL& m) { m.sections.at(1).area = 0; }, A::BadModel, 0, 7, 0, -1,
         "beam 7: the area A of its section is not positive"},
        {[](T_MODEL& m) { m.sections.at(1).shape = SECT_SHAPE::Circle; }, A::BadModel, 0, 7, 0, -1,
         "beam 7: section \"B\": "},
        {[](T_MODEL& m) { m.elements[9] = m.elements.at(7); m.elements[9].id = 9; }, A::BadModel,
         0, 9, 0, -1, "beam 9: another element of the same kind"},
        {[](T_MODEL& m) { m.nodes.at(10).restraint = {1, 1, 1, 0, 0, 0}; }, A::Mechanism, 10, 0, 0,
         4, "part of 2 nodes at node 10: the part is free to turn about Y"},
        {[](T_MODEL& m) { m.elements.at(7).release.I[4] = true; }, A::Mechanism, 20, 0, 0, 2,
         "node 20"},
        {[](T_MODEL& m) { m.diaphragms[2] = {{20, 21}, 2}; }, A::BadModel, 21, 0, 0, -1,
         "diaphragm 2: there is no node 21"},
        {[](T_MODEL& m) { m.loadCases.at(1).nodal[0].node = 21; }, A::BadModel, 21, 0, 1, -1,
         "load case \"tip\": there is no node 21"},
        {[](T_MODEL& m) { m.loadCases.at(2).temperature[0].element = 8; }, A::BadModel, 0, 8, 2,
         -1, "load case \"hot\": there is no element 8"},
        {[](T_MODEL& m) { m.loadCases.at(3).settlement = {{20, {0, 0, 1, 0, 0, 0}}}; },
         A::BadModel, 20, 0, 3, -1, "load case \"own\", node 20"},
    };
    // clang-format on
    for (const T_ROW& row : rows) {
        T_MODEL_CONTENT content = ContentOf(kCantilever);
        row.spoil(content.model);
        CDBDoc doc;
        doc.Data().Assign(content);
        T_ANALYSIS_ERROR error;
        EXPECT_EQ(0, doc.RunAnalysis({}, error)) << row.text;
        EXPECT_EQ(row.fault, error.fault) << error.text;
        EXPECT_EQ(0U, error.text.find(row.text)) << error.text << " / " << row.text;
        EXPECT_EQ(row.node, error.node) << error.text;
        EXPECT_EQ(row.element, error.element) << error.text;
        EXPECT_EQ(row.loadCase, error.loadCase) << error.text;
        if (row.direction >= 0) {
            EXPECT_EQ(row.direction, error.direction) << error.text;
        }
        EXPECT_TRUE(doc.Data().Content().staticResults.empty()) << row.text;
        EXPECT_FALSE(doc.Data().IsModified());
    }
}

TEST(AnalysisRun, CanBeCancelledAndThenKeepsNothing)
{
    CDBDoc doc;
    doc.Data().Assign(ContentOf(kCantilever));
    T_ANALYSIS_OPTIONS options;
    std::size_t largest = 0, total = 0;
    T_ANALYSIS_ERROR error;
    options.progress = [&](std::size_t done, std::size_t of) {
        largest = std::max(largest, done);
        total = of;
        return true;
    };
    ASSERT_EQ(1, doc.RunAnalysis(options, error)) << error.text;
    EXPECT_EQ(3U, total);
    EXPECT_EQ(3U, largest);

    CDBDoc other;
    other.Data().Assign(ContentOf(kCantilever));
    options.progress = [](std::size_t, std::size_t) { return false; };
    EXPECT_EQ(0, other.RunAnalysis(options, error));
    EXPECT_EQ(ANALYSIS_FAULT::Cancelled, error.fault);
    EXPECT_TRUE(other.Data().Content().staticResults.empty());
}

// What the engine gets: every field of every record in its place, SI.
TEST(AnalysisModel, TranslatesRecordsByTheirNumbers)
{
    T_MODEL_CONTENT content;
    T_FILE_ERROR fault;
    ASSERT_EQ(1, CCaseFile::Read(QM_TEST_DATA "/cases/struct_all_members.json", content, fault))
        << fault.text;
    T_MODEL& m = content.model;
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
