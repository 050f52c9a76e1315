// Analysis in construction stages from the records of a document to its results.
#include "casetext.h"

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
    T_MODEL_CONTENT c = ParseGood(CaseText("stage_all_members.json"));
    c.model.styp.stageControl = {};
    c.model.stages.at(5).deactivate = {};
    return c;
}

double Down(CDBDoc& doc, int stage, int step, int load, int node)
{
    T_DOF6 v{};
    doc.Post().SelectStage(stage, step, load);
    EXPECT_EQ(1, doc.Post().GetDspcNew(node, v)) << doc.Post().Error();
    return -v[2];
}

/// A document, and analyses of its stages alone.
class StagedAnalysis : public testing::Test {
protected:
    StagedAnalysis() { m_options.allCases = false; }
    void Run()
    {
        T_ANALYSIS_ERROR error;
        ASSERT_EQ(1, m_doc.RunAnalysis(m_options, error)) << error.text;
    }
    void Run(T_MODEL_CONTENT content)
    {
        m_doc.Data().Assign(std::move(content));
        Run();
    }
    /// One record as a step of its own.
    template <class T>
    void Put(int key, const T& record)
    {
        ASSERT_EQ(1, m_doc.Edit().Begin("edit"));
        ASSERT_EQ(1, m_doc.Edit().Put(key, record));
        ASSERT_EQ(1, m_doc.Edit().Commit());
    }

    T_ANALYSIS_OPTIONS m_options;
    CDBDoc m_doc;
};

} // namespace

TEST_F(StagedAnalysis, GivesTheHandCalculatedBeamByStageStepAndLoad)
{
    EXPECT_FALSE(m_doc.IsPostMode());
    Run(Grown());
    EXPECT_FALSE(m_doc.IsExcuted());
    EXPECT_TRUE(m_doc.IsPostMode());
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
        EXPECT_NEAR(row.down, Down(m_doc, row.stage, row.step, row.load, row.node), 1e-12)
            << row.stage << ' ' << row.step << ' ' << row.load << ' ' << row.node;
}

/// The engine's preparation is used again; what it was prepared for must still be told apart.
TEST_F(StagedAnalysis, AnotherRunTakesChangedLoadsAndChangedStages)
{
    Run(Grown());
    const std::shared_ptr<IStagedResult> first = m_doc.Data().StagedResult();
    T_STLD_D load;
    ASSERT_EQ(1, m_doc.Attr().GetStld(1, load));
    load.nodal[0].load[2] *= 3.0;
    Put(1, load);
    Run();
    EXPECT_NEAR(3 * kDownG, Down(m_doc, 1, 1, kStageLoadSum, 2), 1e-12);
    std::vector<std::shared_ptr<IStaticResult>> kept;
    ASSERT_EQ(1, first->Open({1, 1, 1}, kept)); // those before stay as they were
    T_DOF6 u{};
    ASSERT_EQ(1, kept.at(0)->ReadDisplacement(2, u));
    EXPECT_NEAR(-kDownG, u[2], 1e-12);

    T_STAG_D stage = m_doc.Data().Model().stages.at(5);
    stage.deactivate.loads.clear();
    Put(5, stage);
    stage = m_doc.Data().Model().stages.at(2);
    stage.activate.loads.clear(); // E does not come any more
    Put(2, stage);
    Run();
    EXPECT_NEAR(3 * kDownG, Down(m_doc, 2, 3, kStageLoadSum, 2), 1e-12);
}

TEST_F(StagedAnalysis, GivesReactionsAndForcesInCurrentUnits)
{
    m_options.allCases = true;
    Run(Grown());
    EXPECT_EQ(1, m_doc.Post().CheckStaticResult(1)) << m_doc.Post().Error();
    CPostCtrl& post = m_doc.Post();
    T_DOF6 v{};
    double axial = 0.0;
    post.SelectStage(2, kStageLastStep, kStageLoadSum);
    ASSERT_EQ(1, post.GetReccNew(1, v)) << post.Error();
    EXPECT_NEAR(kG + kE, v[2], 1e-9);
    EXPECT_NEAR(-(kG * 2 + kE * 4), v[4], 1e-9);
    ASSERT_EQ(1, post.GetStrbcNew(2, 2, v)); // a metre from the tip
    EXPECT_NEAR(kE, std::fabs(v[4]), 1e-9);

    T_STYP_D styp = m_doc.Data().Model().styp;
    styp.units = {FORCE_UNIT::N, LENGTH_UNIT::mm};
    ASSERT_EQ(1, m_doc.Edit().Begin("units"));
    ASSERT_EQ(1, m_doc.Edit().PutStyp(styp));
    ASSERT_EQ(1, m_doc.Edit().Commit());
    EXPECT_NEAR((kDownG + kDownE) * 1000, Down(m_doc, 2, 3, kStageLoadSum, 2), 1e-9);
    post.SelectStage(5, kStageLastStep, kStageLoadSum);
    ASSERT_EQ(1, post.GetStrtcNew(3, axial)) << post.Error();
    EXPECT_NEAR(kStay * 1000, axial, 1e-6);
    ASSERT_EQ(1, post.GetReccNew(1, v));
    EXPECT_NEAR((kG + kE - kStay) * 1000, v[2], 1e-6);
    EXPECT_EQ(0, post.GetStrtcNew(1, axial));
    EXPECT_EQ("There is no truss element 1.", post.Error());
    EXPECT_EQ(0, post.GetStrbcNew(1, 5, v));
}

TEST_F(StagedAnalysis, ResultsGoOldWithTheModelAndComeBackWithUndo)
{
    Run(Grown());
    using EDIT = void (*)(T_MODEL&);
    const EDIT edits[] = {
        [](T_MODEL& m) { m.loadCases.at(3).pretension[0].force = 11e3; },
        [](T_MODEL& m) { m.stages.at(2).activate.loads[0].step = 1; },
        [](T_MODEL& m) { m.styp.stageControl.geometricStiffness = true; },
        [](T_MODEL& m) { m.loadCases.at(1).group = 1; },
        [](T_MODEL& m) { m.nodes.at(3).xyz[0] = 5; },
    };
    T_DOF6 v{};
    for (const EDIT edit : edits) {
        const T_MODEL before = m_doc.Data().Model();
        edit(m_doc.Data().ModelForEdit());
        EXPECT_FALSE(m_doc.IsPostMode()) << &edit - edits;
        m_doc.Post().SelectStage(1, 1, kStageLoadSum);
        EXPECT_EQ(0, m_doc.Post().GetDspcNew(2, v));
        EXPECT_EQ("The results of the construction stages are older than the model: run the "
                  "analysis again.",
                  m_doc.Post().Error());
        m_doc.Data().ModelForEdit() = before;
        EXPECT_TRUE(m_doc.IsPostMode());
        EXPECT_NEAR(kDownG, Down(m_doc, 1, 1, kStageLoadSum, 2), 1e-12);
    }
    Put(4, T_STLD_D{"idle", {}, {}, {}, {}, {}, {}}); // one that no stage names does not count
    EXPECT_TRUE(m_doc.IsPostMode());
}

TEST_F(StagedAnalysis, RefusesResultsThatAreNotThere)
{
    m_doc.Data().Assign(Grown());
    T_DOF6 v{};
    CPostCtrl& post = m_doc.Post();
    post.SelectStage(1, 1, kStageLoadSum);
    EXPECT_EQ(0, post.GetDspcNew(2, v));
    EXPECT_EQ("The construction stages have no results: run the analysis.", post.Error());
    Run();
    const std::string noStep = "Construction stage \"S2\" has no step ";
    struct T_ROW {
        int stage, step, load, node;
        std::string text;
    };
    const T_ROW rows[] = {
        {0, 1, kStageLoadSum, 2, "No result of a construction stage is selected."},
        {3, 1, kStageLoadSum, 2, "There is no construction stage 3."},
        {2, 4, kStageLoadSum, 2, noStep + "4; it has the steps 1 to 3."},
        {2, 0, kStageLoadSum, 2, noStep + "0; it has the steps 1 to 3."},
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
}

TEST_F(StagedAnalysis, RefusalsNameStageIdsAndLoadCases)
{
    struct T_ROW {
        void (*spoil)(T_MODEL& m);
        int stage, node, element, loadCase;
        const char* text; // its beginning
        ANALYSIS_FAULT fault = ANALYSIS_FAULT::BadModel;
    };
    const T_ROW rows[] = {
        {[](T_MODEL& m) { m.stages.at(2).activate.elements = {9}; }, 2, 0, 9, 0,
         "stage \"S2\", there is no element 9"},
        {[](T_MODEL& m) { m.stages.at(5).activate.supports = {9}; }, 5, 9, 0, 0,
         "stage \"S3\", there is no node 9"},
        {[](T_MODEL& m) { m.stages.at(5).activate.supports = {3}; }, 5, 3, 0, 0,
         "stage \"S3\", node 3: it has no restraint"},
        {[](T_MODEL& m) { m.stages.at(2).deactivate.elements = {3}; }, 2, 0, 3, 0,
         "stage \"S2\", truss 3: the element leaves before it is born"},
        {[](T_MODEL& m) { m.stages.at(2).activate.loads[0].step = 4; }, 2, 0, 0, 2,
         "stage \"S2\", load case \"E\": step 4 does not exist: the stage has 3"},
        {[](T_MODEL& m) { m.stages.at(1).activate.loads[0].loadCase = 7; }, 0, 0, 0, 7,
         "there is no load case 7"},
        {[](T_MODEL& m) {
             m.stages.at(1).activate.loads[0].loadCase = 2;
             m.stages.at(2).activate.loads = {};
         },
         1, 3, 0, 2, "stage \"S1\", load case \"E\", node 3: "},
        {[](T_MODEL& m) { m.stages.at(1).activate.supports = {}; }, 1, 1, 0, 0,
         "stage \"S1\", part of 2 nodes at node 1: ", ANALYSIS_FAULT::Mechanism},
    };
    for (const T_ROW& row : rows) {
        T_MODEL_CONTENT content = Grown();
        row.spoil(content.model);
        m_doc.Data().Assign(content);
        T_ANALYSIS_ERROR error;
        EXPECT_EQ(0, m_doc.RunAnalysis(m_options, error)) << row.text;
        EXPECT_TRUE(error.text.starts_with(row.text)) << error.text << "\nexpected " << row.text;
        EXPECT_EQ(row.fault, error.fault) << row.text;
        EXPECT_EQ((std::array{row.stage, row.node, row.element, row.loadCase}),
                  (std::array{error.stage, error.node, error.element, error.loadCase}))
            << row.text;
        EXPECT_FALSE(m_doc.IsExcuted() || m_doc.IsPostMode());
    }
}

// Forced to its design shape the second element follows the first one's slope: what stands is then
// the whole cantilever under the load at 2 m, P x2 (3 L - x) / (6 E I) at the tip by reciprocity.
TEST_F(StagedAnalysis, ElementsBornToDesignFollowTheSlope)
{
    T_MODEL_CONTENT content = Grown();
    content.model.styp.stageControl.birth = STAGE_BIRTH::ToDesign;
    Run(content);
    EXPECT_NEAR(kDownG, Down(m_doc, 2, 1, kStageLoadSum, 2), 1e-12);
    EXPECT_NEAR(kG * 4 * (12 - 2) / (6 * kEI), Down(m_doc, 2, 1, kStageLoadSum, 3), 1e-12);
}

// One element with the consistent geometric stiffness of a compression (Przemieniecki, Theory of
// Matrix Structural Analysis, 1968, chapter 15), tip deflection and rotation by Cramer's rule.
TEST_F(StagedAnalysis, GeometricStiffnessSoftensACompressedColumn)
{
    T_MODEL_CONTENT content = Grown();
    content.model.styp.stageControl.geometricStiffness = true;
    content.model.loadCases.at(1).nodal[0].load[0] = -300e3; // N
    content.model.stages.erase(2);
    content.model.stages.erase(5);
    Run(content);
    const double N = -300.0, L = 2.0;
    const double k11 = 12 * kEI / (L * L * L) + 6 * N / (5 * L);
    const double k12 = 6 * kEI / (L * L) + N / 10;
    const double k22 = 4 * kEI / L + 2 * N * L / 15;
    const double down = kG * k22 / (k11 * k22 - k12 * k12);
    EXPECT_GT(down, 1.04 * kDownG);
    EXPECT_NEAR(down, Down(m_doc, 1, 1, kStageLoadSum, 2), 1e-9 * down);
}
