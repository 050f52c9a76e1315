// Construction stages in the case file, in the model file and in a document.
#include "casetext.h"
#include "qm_db/dbdoc.h"

#include <cmath>
#include <gtest/gtest.h>

namespace {

std::string AllText()
{
    return CaseText("stage_all_members.json");
}

} // namespace

TEST(StageCase, ReadsEveryMemberIntoItsField)
{
    const T_MODEL m = ParseGood(AllText()).model;
    EXPECT_EQ((T_STCT_D{STAGE_BIRTH::ToDesign, true, true}), m.styp.stageControl);
    EXPECT_EQ((T_STAG_D{"S1", {{1}, {1}, {{1, 1}}}, {}, 1, 0.0}), m.stages.at(1));
    EXPECT_EQ((T_STAG_D{"S2", {{2}, {}, {{2, -1}}}, {}, 3, 7.5}), m.stages.at(2));
    EXPECT_EQ((T_STAG_D{"S3", {{3}, {4}, {{3, 2}}}, {{2}, {}, {{2, 1}}}, 2, 0.0}), m.stages.at(5));
    EXPECT_EQ(0, m.loadCases.at(1).group);
    EXPECT_EQ(1, m.loadCases.at(2).group);
    EXPECT_EQ(2, m.loadCases.at(3).group);
    EXPECT_EQ(5, m.ulfConstraints.at(1).stage);
    EXPECT_EQ(-1, m.ulfConstraints.at(1).step);
    EXPECT_EQ(2, m.ulfConstraints.at(2).step);
    EXPECT_EQ(0, m.ulfConstraints.at(3).stage);
    const std::vector<T_ULSI_ROW> rows{{5, 2, 3, true, 1.0, 2.0, true, 2},
                                       {1, 1, 1, true, 1.0, 1.0, false, 0},
                                       {2, -1, 2, false, 1.5, 1.0, false, 1}};
    EXPECT_EQ((T_ULSI_D{"tune", rows, 1, 2, true, {"tip"}, true}), m.ulfStageItems.at(1));
}

TEST(StageCase, CaseFileAndModelFileGiveTheSameModelBack)
{
    ExpectRoundTrips(ParseGood(AllText()), "stages");
}

TEST(StageCase, BadInputNamesThePlace)
{
    ExpectRefused(AllText(), "stage_refusals.txt");
}

TEST(StageCase, StepsHaveNamesAndARunningNumber)
{
    CDBDoc doc;
    doc.Data().Assign(ParseGood(AllText()));
    const char* const expected[] = {"S1/First Step", "S2/First Step", "S2/User Step: 2",
                                    "S2/Last Step",  "S3/First Step", "S3/Last Step"};
    T_STAG_STEP_INFO info;
    for (int i = 0; i < 6; ++i) {
        ASSERT_EQ(1, doc.Attr().GetStagStepInfo(i + 1, info)) << i;
        EXPECT_EQ(expected[i], info.Text());
    }
    EXPECT_EQ(5, info.stage);
    EXPECT_EQ(-1, info.step);
    EXPECT_EQ(0, doc.Attr().GetStagStepInfo(7, info));
    EXPECT_EQ(0, doc.Attr().GetStagStepInfo(0, info));
    ASSERT_EQ(1, doc.Attr().GetStagStepInfo(2, 3, info)); // the last one by its number
    EXPECT_EQ("Last Step", info.stepName);
    EXPECT_EQ(0, doc.Attr().GetStagStepInfo(2, 4, info));
    EXPECT_EQ(0, doc.Attr().GetStagStepInfo(3, 1, info));
}

TEST(StageCase, NamesOfStageLoadsGiveTheirKeys)
{
    CDBDoc doc;
    doc.Data().Assign(ParseGood(AllText()));
    const std::pair<const char*, int> rows[] = {{"Sum of the stage loads", kStageLoadSum},
                                                {"Dead load of the stages", kStageLoadDead},
                                                {"Erection load of the stages", kStageLoadErection},
                                                {"T", 3}};
    int key = 0;
    for (const auto& [name, expected] : rows) {
        ASSERT_EQ(1, doc.Attr().GetSgldKey(name, key)) << name;
        EXPECT_EQ(expected, key) << name;
    }
    EXPECT_EQ(0, doc.Attr().GetSgldKey("U", key));
}

// 10 kN are 10000 N; the document is switched to N and mm. Other loads keep every digit.
TEST(StageCase, PretensionIsReplacedInCurrentUnitsAsAStepThatCanBeTakenBack)
{
    CDBDoc doc;
    T_MODEL_CONTENT content = ParseGood(AllText());
    content.model.styp.units = {FORCE_UNIT::N, LENGTH_UNIT::mm};
    content.model.loadCases.at(3).pretension = {{3, 4000.0}, {2, 1.0}, {3, 6000.0}};
    content.model.loadCases.at(3).nodal = {{2, {0.1, 0.2, 0.3, 0.4, 0.5, 0.6}}};
    doc.Data().Assign(content);
    const T_MODEL before = doc.Data().Model();
    T_PTNS_D load;
    ASSERT_EQ(1, doc.Attr().GetPtns(3, 3, load));
    EXPECT_EQ((T_PTNS_D{3, 10000.0}), load);
    EXPECT_EQ(0, doc.Attr().GetPtns(3, 1, load));
    EXPECT_EQ(0, doc.Attr().GetPtns(9, 3, load));

    EXPECT_EQ(0, doc.Edit().AddPtns(3, {3, 1.0})); // no step is open
    ASSERT_EQ(1, doc.Undo().StartEditDB("scale"));
    EXPECT_EQ(0, doc.Undo().StartEditDB("again"));
    EXPECT_EQ(0, doc.Edit().AddPtns(9, {3, 1.0}));
    EXPECT_EQ(0, doc.Edit().AddPtns(3, {8, 1.0}));
    EXPECT_EQ(0, doc.Edit().AddPtns(3, {3, std::nan("")}));
    ASSERT_EQ(1, doc.Edit().AddPtns(3, {3, 12500.0}));
    ASSERT_EQ(1, doc.Edit().AddPtns(1, {3, 7.0}));
    ASSERT_EQ(1, doc.Undo().CloseEditDB());
    EXPECT_EQ(0, doc.Undo().CloseEditDB());
    T_MODEL expected = before;
    expected.loadCases.at(3).pretension = {{3, 12500.0}, {2, 1.0}};
    expected.loadCases.at(1).pretension = {{3, 7.0}};
    EXPECT_EQ(expected, doc.Data().Model());
    EXPECT_EQ("scale", doc.Undo().UndoTitle());
    ASSERT_EQ(1, doc.Undo().Undo());
    EXPECT_EQ(before, doc.Data().Model());

    ASSERT_EQ(1, doc.Undo().StartEditDB("cancelled"));
    ASSERT_EQ(1, doc.Edit().AddPtns(3, {3, 1.0}));
    ASSERT_EQ(1, doc.Undo().CancelEditDB());
    EXPECT_EQ(0, doc.Undo().CancelEditDB());
    EXPECT_EQ(before, doc.Data().Model());
}

// The case file has unknown rows before known ones: a record that was put in keeps that order.
TEST(StageCase, RowsThatAreEditedComeBackFromEveryFile)
{
    CDBDoc doc;
    doc.Data().Assign(ParseGood(AllText()));
    T_ULSI_D item;
    ASSERT_EQ(1, doc.Attr().Get(1, item));
    std::swap(item.rows[0], item.rows[2]);
    item.rows[0].weight = 3.0; // of a known row: not used
    item.rows[0].pretension = true;
    item.rows[2].factor = 2.0; // of an unknown one
    ASSERT_EQ(1, doc.Edit().Begin("rows"));
    ASSERT_EQ(1, doc.Edit().Put(1, item));
    ASSERT_EQ(1, doc.Edit().Commit());
    const T_MODEL back = ParseGood(PrintGood(doc.Data().Content())).model;
    EXPECT_EQ(doc.Data().Model().ulfStageItems, back.ulfStageItems);
    const std::vector<T_ULSI_ROW> rows{{1, 1, 1, true, 1.0, 1.0, false, 0},
                                       {5, 2, 3, true, 1.0, 2.0, true, 2},
                                       {2, -1, 2, false, 1.5, 1.0, false, 1}};
    EXPECT_EQ(rows, back.ulfStageItems.at(1).rows);
}
