// Analysis in construction stages from the records of a document to its results.
#include "modelstoresample.h"
#include "qm_db/casefile.h"
#include "qm_db/dbdoc.h"

#include <cmath>
#include <gtest/gtest.h>

namespace {

// A cantilever of 2 m that grows to 4 m in its second stage and hangs on a stay at 2 m in its
// third; E I = 1e4 kNm2. First order, elements born on the deformed structure.
constexpr double kEI = 2e8 * 5e-5;
constexpr double kG = 12.0, kE = 6.0;                    // kN: at 2 m in stage 1, at the tip in 2
constexpr double kDownG = kG * 8 / (3 * kEI);            // P L3 / (3 E I)
constexpr double kDownE = kE * 4 * (12 - 2) / (6 * kEI); // P x2 (3 L - x) / (6 E I) at x = 2, L = 4
constexpr double kTipE = kE * 64 / (3 * kEI);
constexpr double kStay = 10.0 / (1 + 8 / (3 * kEI) * 2e8 * 0.001 / 3); // T / (1 + f E A / L)

T_MODEL_CONTENT Grown()
{
    T_MODEL_CONTENT c;
    T_FILE_ERROR error;
    EXPECT_EQ(1, CCaseFile::Read(QM_TEST_DATA "/cases/stage_all_members.json", c, error));
    c.model.styp.stageControl = {};
    c.model.stages.at(5).deactivate = {};
    return c;
}

T_ANALYSIS_OPTIONS StagesOnly()
{
    T_ANALYSIS_OPTIONS options;
    options.allCases = false;
    return options;
}

double Down(CDBDoc& doc, int stage, int step, int load, int node)
{
    T_DOF6 v{};
    doc.Post().SelectStage(stage, step, load);
    EXPECT_EQ(1, doc.Post().GetDspcNew(node, v)) << doc.Post().Error();
    return -v[2];
}

} // namespace

TEST(StagedAnalysis, GivesTheHandCalculatedBeamByStageStepAndLoad)
{
    CDBDoc doc;
    doc.Data().Assign(Grown());
    T_ANALYSIS_ERROR error;
    EXPECT_FALSE(doc.IsPostMode());
    ASSERT_EQ(1, doc.RunAnalysis(StagesOnly(), error)) << error.text;
    EXPECT_FALSE(doc.IsExcuted());
    EXPECT_TRUE(doc.IsPostMode());
    struct T_ROW {
        int stage, step, load, node;
        double down; // m
    };
    const T_ROW rows[] = {
        {1, 1, kStageLoadSum, 2, kDownG},
        {1, kStageLastStep, kStageLoadSum, 3, 0.0}, // not there
        {2, 2, kStageLoadSum, 2, kDownG},           // the load of this stage comes at its last step
        {2, 2, kStageLoadSum, 3, 0.0},              // born at its design position
        {2, kStageLastStep, kStageLoadSum, 2, kDownG + kDownE},
        {2, 3, kStageLoadDead, 2, kDownG},
        {2, 3, kStageLoadErection, 2, kDownE},
        {2, 3, 2, 3, kTipE},
        {2, 3, 3, 2, 0.0},
        {5, 1, kStageLoadSum, 2, kDownG + kDownE},
        {5, 2, 3, 2, -kStay * 8 / (3 * kEI)},
        {5, 2, kStageLoadSum, 2, kDownG + kDownE - kStay * 8 / (3 * kEI)},
    };
    for (const T_ROW& row : rows)
        EXPECT_NEAR(row.down, Down(doc, row.stage, row.step, row.load, row.node), 1e-12)
            << row.stage << ' ' << row.step << ' ' << row.load << ' ' << row.node;
}

/// The engine's preparation is used again; what it was prepared for must still be told apart.
TEST(StagedAnalysis, AnotherRunTakesChangedLoadsAndChangedStages)
{
    CDBDoc doc;
    doc.Data().Assign(Grown());
    T_ANALYSIS_ERROR error;
    ASSERT_EQ(1, doc.RunAnalysis(StagesOnly(), error)) << error.text;
    const std::shared_ptr<IStagedResult> first = doc.Data().StagedResult();
    T_STLD_D load;
    T_STAG_D stage;
    ASSERT_EQ(1, doc.Edit().Begin("loads"));
    ASSERT_EQ(1, doc.Attr().GetStld(1, load));
    load.nodal[0].load[2] *= 3.0;
    ASSERT_EQ(1, doc.Edit().Put(1, load));
    ASSERT_EQ(1, doc.Edit().Commit());
    ASSERT_EQ(1, doc.RunAnalysis(StagesOnly(), error)) << error.text;
    EXPECT_NEAR(3 * kDownG, Down(doc, 1, 1, kStageLoadSum, 2), 1e-12);
    std::vector<std::shared_ptr<IStaticResult>> kept;
    ASSERT_EQ(1, first->Open({1, 1, 1}, kept)); // those before stay as they were
    T_DOF6 u{};
    ASSERT_EQ(1, kept.at(0)->ReadDisplacement(2, u));
    EXPECT_NEAR(-kDownG, u[2], 1e-12);

    ASSERT_EQ(1, doc.Edit().Begin("stages"));
    ASSERT_EQ(1, doc.Attr().GetStag(2, stage));
    stage.activate.loads.clear(); // E does not come any more
    ASSERT_EQ(1, doc.Edit().Put(2, stage));
    ASSERT_EQ(1, doc.Attr().GetStag(5, stage));
    stage.deactivate.loads.clear();
    ASSERT_EQ(1, doc.Edit().Put(5, stage));
    ASSERT_EQ(1, doc.Edit().Commit());
    ASSERT_EQ(1, doc.RunAnalysis(StagesOnly(), error)) << error.text;
    EXPECT_NEAR(3 * kDownG, Down(doc, 2, 3, kStageLoadSum, 2), 1e-12);
}

TEST(StagedAnalysis, GivesReactionsAndForcesInCurrentUnits)
{
    CDBDoc doc;
    doc.Data().Assign(Grown());
    T_ANALYSIS_ERROR error;
    ASSERT_EQ(1, doc.RunAnalysis({}, error)) << error.text; // with the static load cases
    EXPECT_EQ(1, doc.Post().CheckStaticResult(1)) << doc.Post().Error();
    CPostCtrl& post = doc.Post();
    T_DOF6 v{};
    double axial = 0.0;
    post.SelectStage(2, kStageLastStep, kStageLoadSum);
    ASSERT_EQ(1, post.GetReccNew(1, v)) << post.Error();
    EXPECT_NEAR(kG + kE, v[2], 1e-9);
    EXPECT_NEAR(-(kG * 2 + kE * 4), v[4], 1e-9);
    ASSERT_EQ(1, post.GetStrbcNew(1, 0, v));
    EXPECT_NEAR(kG * 2 + kE * 4, std::fabs(v[4]), 1e-9);
    ASSERT_EQ(1, post.GetStrbcNew(2, 2, v)); // a metre from the tip
    EXPECT_NEAR(kE, std::fabs(v[4]), 1e-9);

    T_STYP_D styp = doc.Data().Model().styp;
    styp.units = {FORCE_UNIT::N, LENGTH_UNIT::mm};
    ASSERT_EQ(1, doc.Edit().Begin("units"));
    ASSERT_EQ(1, doc.Edit().PutStyp(styp));
    ASSERT_EQ(1, doc.Edit().Commit());
    EXPECT_NEAR((kDownG + kDownE) * 1000, Down(doc, 2, 3, kStageLoadSum, 2), 1e-9);
    post.SelectStage(5, kStageLastStep, kStageLoadSum);
    ASSERT_EQ(1, post.GetStrtcNew(3, axial)) << post.Error();
    EXPECT_NEAR(kStay * 1000, axial, 1e-6);
    ASSERT_EQ(1, post.GetReccNew(4, v));
    EXPECT_NEAR(kStay * 1000, v[2], 1e-6); // holds the stay up
    ASSERT_EQ(1, post.GetReccNew(1, v));
    EXPECT_NEAR((kG + kE - kStay) * 1000, v[2], 1e-6);
    EXPECT_EQ(0, post.GetStrtcNew(1, axial));
    EXPECT_EQ("There is no truss element 1.", post.Error());
    EXPECT_EQ(0, post.GetStrbcNew(1, 5, v));
}

TEST(StagedAnalysis, ResultsGoOldWithTheModelAndComeBackWithUndo)
{
    CDBDoc doc;
    doc.Data().Assign(Grown());
    T_ANALYSIS_ERROR error;
    ASSERT_EQ(1, doc.RunAnalysis(StagesOnly(), error)) << error.text;
    using EDIT = void (*)(CDBDoc&);
    // clang-format off
    const EDIT edits[] = {
        [](CDBDoc& d) { EXPECT_EQ(1, d.Edit().AddPtns(3, {3, 11.0})); },
        [](CDBDoc& d) { T_STAG_D s = d.Data().Model().stages.at(2); s.activate.loads[0].step = 1; EXPECT_EQ(1, d.Edit().Put(2, s)); },
        [](CDBDoc& d) { T_STYP_D s; EXPECT_EQ(1, d.Attr().GetStyp(s)); s.stageControl.geometricStiffness = true; EXPECT_EQ(1, d.Edit().PutStyp(s)); },
        [](CDBDoc& d) { T_STLD_D s; EXPECT_EQ(1, d.Attr().GetStld(1, s)); s.group = 1; EXPECT_EQ(1, d.Edit().Put(1, s)); },
        [](CDBDoc& d) { T_NODE_D n; EXPECT_EQ(1, d.Attr().GetNode(3, n)); n.xyz[0] = 5; EXPECT_EQ(1, d.Edit().Put(3, n)); },
    };
    // clang-format on
    T_DOF6 v{};
    for (const EDIT edit : edits) {
        ASSERT_EQ(1, doc.Undo().StartEditDB("edit"));
        edit(doc);
        ASSERT_EQ(1, doc.Undo().CloseEditDB());
        EXPECT_FALSE(doc.IsPostMode()) << &edit - edits;
        doc.Post().SelectStage(1, 1, kStageLoadSum);
        EXPECT_EQ(0, doc.Post().GetDspcNew(2, v));
        EXPECT_EQ("The results of the construction stages are older than the model: run the "
                  "analysis again.",
                  doc.Post().Error());
        ASSERT_EQ(1, doc.Undo().Undo());
        EXPECT_TRUE(doc.IsPostMode());
        EXPECT_NEAR(kDownG, Down(doc, 1, 1, kStageLoadSum, 2), 1e-12);
    }
    // A load case that no stage names does not count.
    ASSERT_EQ(1, doc.Edit().Begin("idle"));
    T_STLD_D idle;
    idle.name = "idle";
    ASSERT_EQ(1, doc.Edit().Put(4, idle));
    ASSERT_EQ(1, doc.Edit().Commit());
    EXPECT_TRUE(doc.IsPostMode());
}

TEST(StagedAnalysis, RefusesResultsThatAreNotThere)
{
    CDBDoc doc;
    doc.Data().Assign(Grown());
    T_ANALYSIS_ERROR error;
    T_DOF6 v{};
    CPostCtrl& post = doc.Post();
    post.SelectStage(1, 1, kStageLoadSum);
    EXPECT_EQ(0, post.GetDspcNew(2, v));
    EXPECT_EQ("The construction stages have no results: run the analysis.", post.Error());
    ASSERT_EQ(1, doc.RunAnalysis(StagesOnly(), error)) << error.text;
    struct T_ROW {
        int stage, step, load, node;
        const char* text;
    };
    const T_ROW rows[] = {
        {0, 1, kStageLoadSum, 2, "No result of a construction stage is selected."},
        {3, 1, kStageLoadSum, 2, "There is no construction stage 3."},
        {2, 4, kStageLoadSum, 2,
         "Construction stage \"S2\" has no step 4; it has the steps 1 to 3."},
        {2, 0, kStageLoadSum, 2,
         "Construction stage \"S2\" has no step 0; it has the steps 1 to 3."},
        {2, 1, 4, 2, "Load case \"idle\" acts in no construction stage."},
        {2, 1, 7, 2, "There is no static load case \"7\"."},
        {2, 1, -4, 2, "There is no static load case \"-4\"."},
        {2, 1, 1, 9, "Construction stage \"S2\" has no results of node 9."},
    };
    for (const T_ROW& row : rows) {
        post.SelectStage(row.stage, row.step, row.load);
        EXPECT_EQ(0, post.GetDspcNew(row.node, v)) << row.text;
        EXPECT_EQ(row.text, post.Error());
    }

    // A case file takes the stages, not their results.
    const CTempFolder folder;
    T_FILE_ERROR fault;
    CDBDoc text;
    ASSERT_EQ(1, doc.SaveAs(folder.File("a_01.json"), fault)) << fault.text;
    EXPECT_EQ(folder.File("a_01.json"), doc.Path());
    ASSERT_EQ(1, text.ImportCase(folder.File("a_01.json"), fault)) << fault.text;
    EXPECT_EQ(doc.Data().Model().stages, text.Data().Model().stages);
    EXPECT_FALSE(text.IsPostMode());
}

TEST(StagedAnalysis, RefusalsNameStageIdsAndLoadCases)
{
    struct T_ROW {
        void (*spoil)(T_MODEL& m);
        ANALYSIS_FAULT fault;
        int stage, node, element, loadCase;
        const char* text; // its beginning
    };
    using A = ANALYSIS_FAULT;
    // clang-format off
    const T_ROW rows[] = {
        {[](T_MODEL& m) { m.stages.at(2).activate.elements = {9}; }, A::BadModel, 2, 0, 9, 0, "stage \"S2\", there is no element 9"},
        {[](T_MODEL& m) { m.stages.at(5).activate.supports = {9}; }, A::BadModel, 5, 9, 0, 0, "stage \"S3\", there is no node 9"},
        {[](T_MODEL& m) { m.stages.at(5).activate.supports = {3}; }, A::BadModel, 5, 3, 0, 0, "stage \"S3\", node 3: it has no restraint"},
        {[](T_MODEL& m) { m.stages.at(5).activate.supports = {1}; }, A::BadModel, 5, 1, 0, 0, "stage \"S3\", node 1: a support comes that is there already"},
        {[](T_MODEL& m) { m.stages.at(2).deactivate.elements = {3}; }, A::BadModel, 2, 0, 3, 0, "stage \"S2\", truss 3: the element leaves before it is born"},
        {[](T_MODEL& m) { m.stages.at(2).activate.loads[0].step = 4; }, A::BadModel, 2, 0, 0, 2, "stage \"S2\", load case \"E\": step 4 does not exist: the stage has 3"},
        {[](T_MODEL& m) { m.stages.at(2).steps = 0; }, A::BadModel, 2, 0, 0, 0, "stage \"S2\": the stage has no steps"},
        {[](T_MODEL& m) { m.stages.at(1).activate.loads[0].loadCase = 7; }, A::BadModel, 0, 0, 0, 7, "there is no load case 7"},
        {[](T_MODEL& m) { m.stages.at(1).activate.loads[0].loadCase = 2; m.stages.at(2).activate.loads = {}; }, A::BadModel, 1, 3, 0, 2, "stage \"S1\", load case \"E\", node 3: "},
        {[](T_MODEL& m) { m.stages.at(1).activate.supports = {}; }, A::Mechanism, 1, 1, 0, 0, "stage \"S1\", part of 2 nodes at node 1: "},
        {[](T_MODEL& m) { m.elements.at(2).material = 0; }, A::BadModel, 0, 0, 2, 0, "beam 2: the material is missing"},
    };
    // clang-format on
    for (const T_ROW& row : rows) {
        CDBDoc doc;
        T_MODEL_CONTENT content = Grown();
        row.spoil(content.model);
        doc.Data().Assign(content);
        T_ANALYSIS_ERROR error;
        EXPECT_EQ(0, doc.RunAnalysis(StagesOnly(), error)) << row.text;
        EXPECT_EQ(0U, error.text.find(row.text)) << error.text << "\nexpected " << row.text;
        EXPECT_EQ(row.fault, error.fault) << row.text;
        EXPECT_EQ(row.stage, error.stage) << row.text;
        EXPECT_EQ(row.node, error.node) << row.text;
        EXPECT_EQ(row.element, error.element) << row.text;
        EXPECT_EQ(row.loadCase, error.loadCase) << row.text;
        EXPECT_FALSE(doc.IsExcuted());
        EXPECT_FALSE(doc.IsPostMode());
    }
}

TEST(StagedAnalysis, CountsStepsAndKeepsNothingWhenCancelled)
{
    CDBDoc doc;
    doc.Data().Assign(Grown());
    T_ANALYSIS_OPTIONS options = StagesOnly();
    T_ANALYSIS_ERROR error, other;
    std::size_t last = 0, total = 0;
    options.progress = [&](std::size_t done, std::size_t all) {
        last = done;
        total = all;
        EXPECT_TRUE(doc.IsExcuted());
        EXPECT_EQ(0, doc.RunAnalysis({}, other)); // one at a time
        return done < 3;
    };
    EXPECT_EQ(0, doc.RunAnalysis(options, error));
    EXPECT_EQ(ANALYSIS_FAULT::Cancelled, error.fault) << error.text;
    EXPECT_EQ(3U, last);
    EXPECT_EQ(6U, total);
    EXPECT_FALSE(doc.IsPostMode());
    options.stages = false;
    EXPECT_EQ(1, doc.RunAnalysis(options, error)) << error.text;
    EXPECT_FALSE(doc.IsPostMode());
}

// Forced to its design shape the second element follows the first one's slope: what stands is then
// the whole cantilever under the load at 2 m, P x2 (3 L - x) / (6 E I) at the tip by reciprocity.
TEST(StagedAnalysis, ElementsBornToDesignFollowTheSlope)
{
    CDBDoc doc;
    T_MODEL_CONTENT content = Grown();
    content.model.styp.stageControl.birth = STAGE_BIRTH::ToDesign;
    doc.Data().Assign(content);
    T_ANALYSIS_ERROR error;
    ASSERT_EQ(1, doc.RunAnalysis(StagesOnly(), error)) << error.text;
    EXPECT_NEAR(kDownG, Down(doc, 2, 1, kStageLoadSum, 2), 1e-12);
    EXPECT_NEAR(kG * 4 * (12 - 2) / (6 * kEI), Down(doc, 2, 1, kStageLoadSum, 3), 1e-12);
}

// One element with the consistent geometric stiffness of a compression (Przemieniecki, Theory of
// Matrix Structural Analysis, 1968, chapter 15), tip deflection and rotation by Cramer's rule.
TEST(StagedAnalysis, GeometricStiffnessSoftensACompressedColumn)
{
    CDBDoc doc;
    T_MODEL_CONTENT content = Grown();
    content.model.styp.stageControl.geometricStiffness = true;
    content.model.loadCases.at(1).nodal[0].load[0] = -300e3; // N
    content.model.stages.erase(2);
    content.model.stages.erase(5);
    doc.Data().Assign(content);
    T_ANALYSIS_ERROR error;
    ASSERT_EQ(1, doc.RunAnalysis(StagesOnly(), error)) << error.text;
    const double N = -300.0, L = 2.0;
    const double k11 = 12 * kEI / (L * L * L) + 6 * N / (5 * L);
    const double k12 = 6 * kEI / (L * L) + N / 10;
    const double k22 = 4 * kEI / L + 2 * N * L / 15;
    const double down = kG * k22 / (k11 * k22 - k12 * k12);
    EXPECT_GT(down, 1.04 * kDownG);
    EXPECT_NEAR(down, Down(doc, 1, 1, kStageLoadSum, 2), 1e-9 * down);
}

// A level cable of 10 m under its initial tension of 60 kN is pulled to 100 kN: the stretch by
// Ernst's modulus, the weight being 8 t/m3 * 9.80665 m/s2 * 0.001 m2.
TEST(StagedAnalysis, SagSoftensACableWithInitialTension)
{
    const char* const text = R"({
 "format": "qm-rps case 1", "units": {"force": "kN", "length": "m"}, "plane": "XZ",
 "nodes": [{"id": 1, "xyz": [0, 0, 0], "restraint": [1, 1, 1, 1, 1, 1]},
           {"id": 2, "xyz": [10, 0, 0], "restraint": [0, 1, 1, 1, 1, 1]}],
 "stage_control": {"cable_sag": true},
 "materials": [{"name": "S", "E": 2e8, "nu": 0.25, "density": 8}],
 "sections": [{"name": "H", "A": 0.001}],
 "elements": [{"id": 1, "kind": "truss", "nodes": [1, 2], "material": "S", "section": "H"}],
 "load_cases": [{"name": "T", "pretension": [{"element": 1, "force": 60}]},
                {"name": "P", "nodal": [{"node": 2, "load": [100, 0, 0, 0, 0, 0]}]}],
 "stages": [{"name": "S", "activate": {"elements": [1], "supports": [1, 2],
                                       "loads": [{"case": "T"}, {"case": "P"}]}}]
})";
    CDBDoc doc;
    T_MODEL_CONTENT content;
    T_FILE_ERROR fault;
    ASSERT_EQ(1, CCaseFile::Parse(text, "cable", "", content, fault)) << fault.text;
    doc.Data().Assign(content);
    T_ANALYSIS_ERROR error;
    ASSERT_EQ(1, doc.RunAnalysis(StagesOnly(), error)) << error.text;
    const double weight = 8 * 9.80665 * 0.001 * 10, EA = 2e5, N = 100.0;
    const double stretch = (N - 60) * 10 / EA * (1 + weight * weight * EA / (12 * N * N * N));
    T_DOF6 v{};
    double axial = 0.0;
    doc.Post().SelectStage(1, kStageLastStep, kStageLoadSum);
    ASSERT_EQ(1, doc.Post().GetDspcNew(2, v)) << doc.Post().Error();
    EXPECT_NEAR(stretch, v[0], 1e-9 * stretch);
    ASSERT_EQ(1, doc.Post().GetStrtcNew(1, axial));
    EXPECT_NEAR(N, axial, 1e-7);
}

// The tip's element and load go as the stay comes: what the load leaves behind is held by the stay,
// in parallel with the cantilever.
TEST(StagedAnalysis, WhatGoesLeavesItsTraceInWhatCameWithIt)
{
    CDBDoc doc;
    T_MODEL_CONTENT content = Grown();
    content.model.stages.at(5).deactivate = {{2}, {}, {{2, kStageFirstStep}}};
    doc.Data().Assign(content);
    T_ANALYSIS_ERROR error;
    ASSERT_EQ(1, doc.RunAnalysis(StagesOnly(), error)) << error.text;
    const double cantilever = 3 * kEI / 8, stay = 2e8 * 0.001 / 3; // stiffness at 2 m
    const double left = kDownE * stay / (stay + cantilever);
    EXPECT_NEAR(left, Down(doc, 5, 1, 2, 2), 1e-12);
    EXPECT_NEAR(kDownG + left, Down(doc, 5, 1, kStageLoadSum, 2), 1e-12);
    EXPECT_EQ(0.0, Down(doc, 5, 1, 2, 3)); // gone
    T_DOF6 v{};
    ASSERT_EQ(1, doc.Post().GetStrbcNew(2, 0, v));
    EXPECT_EQ(T_DOF6{}, v);
}
