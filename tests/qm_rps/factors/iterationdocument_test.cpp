// The iterative analysis of a real document.
#include "iterationperson.h"
#include "qm_rps/ulfiterationdochost.h"
#include "tempfolder.h"
#include "twotrusses.h"

#include <filesystem>

namespace {

class UlfIterationDocument : public testing::Test {
protected:
    /// The two trusses, saved and analysed.
    void Open(CDBDoc& doc)
    {
        doc.Data().Assign(two::Content());
        ASSERT_EQ(1, doc.SaveAs(m_folder / "frame.qmdb", m_error)) << m_error.text;
        T_ANALYSIS_OPTIONS options;
        options.allCases = false;
        T_ANALYSIS_ERROR fault;
        ASSERT_EQ(1, doc.RunAnalysis(options, fault)) << fault.text;
    }
    static double Tension(const CDBDoc& doc)
    {
        return doc.Data().Model().loadCases.at(2).pretension.at(0).force;
    }
    static double MoveOfNode2(CDBDoc& doc)
    {
        T_DOF6 u{};
        doc.Post().SelectStage(1, kStageFirstStep, kStageLoadSum);
        EXPECT_EQ(1, doc.Post().GetDspcNew(2, u)) << doc.Post().Error();
        return u[0];
    }

    CTempFolder m_folder;
    T_FILE_ERROR m_error;
    CPerson m_person;
};

} // namespace

TEST_F(UlfIterationDocument, LeavesTheLoadsWhenOneOfThemCannotBeChanged)
{
    T_MODEL_CONTENT content = two::Content();
    content.model.loadCases[2].pretension.push_back({9, 1.0}); // there is no such element
    CDBDoc doc;
    doc.Data().Assign(std::move(content));
    CUlfIterationDocHost host(doc, doc.Data().Model().ulfStageItems.at(1));
    std::vector<T_ULF_ITER_ROW> rows;
    std::optional<T_FINDING> said;
    EXPECT_EQ(0, host.Solve(rows, said)); // forms the problem; without results there are no factors
    ASSERT_EQ(1, host.StartEdit("scale"));
    EXPECT_EQ(0, host.ScalePretension(0, 2.0));
    EXPECT_NE(std::string::npos, host.Error().find('9'));
    host.CancelEdit();
    EXPECT_EQ(1.0, Tension(doc));
    EXPECT_FALSE(doc.Undo().CanUndo());
}

TEST_F(UlfIterationDocument, BringsATwoTrussFrameToItsTensionInOneIteration)
{
    CDBDoc doc;
    Open(doc);
    CUlfIterationDocHost host(doc, doc.Data().Model().ulfStageItems.at(1));
    CUlfIteration run(host, m_person, {});
    ASSERT_EQ(1, run.Run()) << host.Error();
    EXPECT_EQ(ULF_ITER_END::Converged, run.End());
    ASSERT_EQ(2U, run.History().size());
    EXPECT_EQ("S1/First Step", run.History()[0].rows.at(0).place);
    EXPECT_NEAR(4.0, run.History()[0].rows.at(0).factor, 1e-12); // T = 4 holds G
    EXPECT_NEAR(1.0, run.History()[1].rows.at(0).factor, 1e-12);
    EXPECT_NEAR(0.0, MoveOfNode2(doc), 1e-12);
    // The copy on disk has the new tension with its results, the model itself the old one.
    for (const auto& [name, force] :
         {std::pair{"frame.qmdb", 1.0}, std::pair{"frame_01.qmdb", 4.0}}) {
        CDBDoc other;
        ASSERT_EQ(1, other.OpenModel(m_folder / name, OPEN_MODE::ReadOnly, m_error))
            << m_error.text;
        EXPECT_NEAR(force, Tension(other), 1e-12);
        EXPECT_EQ(force > 1, other.IsPostMode()) << name;
    }
    // One command of the person takes the change back.
    EXPECT_EQ("Change load values for iterative analysis", doc.Undo().UndoTitle());
    ASSERT_EQ(1, doc.Undo().Undo());
    EXPECT_EQ(1.0, Tension(doc));
}

// The two trusses of twotrusses.h with the tension that they had, whatever ends the analysis.
TEST_F(UlfIterationDocument, LeavesTheDocumentAsAfterTheLastIterationWhenAnAnalysisEndsEarly)
{
    for (const bool cancel : {true, false}) {
        CDBDoc doc;
        Open(doc);
        CUlfIterationDocHost host(doc, doc.Data().Model().ulfStageItems.at(1));
        CUlfIteration run(host, m_person, {});
        m_person.m_overwrite = true;
        double whileRunning = 0.0;
        m_person.m_goesOn = [&](int, int) {
            if (!doc.IsExcuted()) return true; // before the iteration
            EXPECT_FALSE(doc.Edit().Begin("meanwhile"));
            EXPECT_EQ(0, doc.Undo().Undo());
            whileRunning = Tension(doc);
            if (!cancel) std::filesystem::remove_all(m_folder.Path()); // its results can't be saved
            return !cancel;
        };
        EXPECT_EQ(0, run.Run());
        EXPECT_EQ(cancel ? ULF_ITER_END::Cancelled : ULF_ITER_END::NotAnalysed, run.End());
        EXPECT_NEAR(4.0, whileRunning, 1e-12);
        EXPECT_EQ(1.0, Tension(doc));
        EXPECT_EQ(1U, run.History().size());
        EXPECT_FALSE(doc.IsExcuted());
        EXPECT_TRUE(doc.IsPostMode()) << doc.Post().Error(); // with the results of that tension
        EXPECT_NEAR(3.0 / 20, MoveOfNode2(doc), 1e-12);
        EXPECT_FALSE(doc.Undo().CanUndo());
        if (!cancel) continue;
        EXPECT_EQ("", host.Error());
        CDBDoc other; // the file has them too
        ASSERT_EQ(1, other.OpenModel(doc.Path(), OPEN_MODE::ReadOnly, m_error)) << m_error.text;
        EXPECT_EQ(doc.Data().Model(), other.Data().Model());
        EXPECT_TRUE(other.IsPostMode()) << other.Post().Error();
        EXPECT_FALSE(doc.Data().IsModified());
    }
}
