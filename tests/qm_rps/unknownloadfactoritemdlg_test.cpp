#include "scriptview.h"
#include "ulfdocument.h"

#include "qm_base/messagehistory.h"
#include "qm_base/msgfunction.h"
#include "qm_rps/unknownloadfactorconstraintdlg.h"
#include "qm_rps/unknownloadfactordlg.h"
#include "qm_rps/unknownloadfactoritemdlg.h"
#include "qm_rps/unknowntabletabgrid1.h"

#include <gtest/gtest.h>

namespace {

using zql::lib::MMSGFunction;

struct UnknownLoadFactor : testing::Test {
    UnknownLoadFactor()
    {
        five::Fill(m_doc);
        (void)TakeMessageHistory();
    }
    const T_MODEL& Model() const { return m_doc.Data().Model(); }
    template <class EDIT>
    void Change(const EDIT& edit)
    {
        T_MODEL_CONTENT content = m_doc.Data().Content();
        edit(content.model);
        m_doc.Data().Assign(std::move(content));
    }

    CDBDoc m_doc;
};

} // namespace

TEST_F(UnknownLoadFactor, FindsThePropsOfAContinuousBeam)
{
    for (const bool byMoments : {false, true}) {
        CUnknownLoadFactorItemDlg dlg(m_doc, 1);
        for (auto& check : dlg.m_checks)
            check.checked = (check.name[0] == 'M') == byMoments;
        ASSERT_EQ(1, dlg.OnCalculate());
        const T_ULF_RESULT& r = *dlg.Result();
        EXPECT_TRUE(r.exact);
        EXPECT_EQ(1.0, r.factors[0]); // W is known
        for (std::size_t i = 0; i < 4; ++i) {
            EXPECT_NEAR(five::kProps[i], r.factors[i + 1], 1e-12);
            EXPECT_NEAR(byMoments ? five::kSupportMoment[i] : 0.0, UlfValue(r, i), 1e-12);
            EXPECT_TRUE(UlfResultRows(r)[i].met && UlfResultRows(r)[i].active);
        }
    }
    EXPECT_EQ(MMSGFunction::GetValue("IDS_RPS_Unknown_CAN_FIND_OPTIMIZED_SOLUTION"),
              TakeMessageHistory().at(0));
    // Exactly these factors have no other sign: the message names the first.
    CUnknownLoadFactorItemDlg dlg(m_doc, 1);
    dlg.m_sign = 0;
    EXPECT_EQ(0, dlg.OnCalculate());
    EXPECT_FALSE(dlg.Result());
    EXPECT_EQ("IDS_RPS_Unknown_Load_Factor_Item_has_an_error", dlg.Messages().at(0).key);
    for (const char* part : {"T1", "load factor 1", "(P1)"})
        EXPECT_NE(std::string::npos, dlg.Messages()[0].text.find(part)) << dlg.Messages()[0].text;
}

TEST_F(UnknownLoadFactor, MinimisesWithinBoundsAndListsATwoBoundConstraintOnce)
{
    // One prop at node 3 alone: its least force that keeps |DZ(3)| <= 1 is (31/4 - 1) / (12/5).
    Change([](T_MODEL& m) {
        m.ulfConstraints[2] = five::Between(m.ulfConstraints[2], 1.0, -1.0);
        m.combinations[1].items = {{false, 1, 1.0}, {false, 3, 1.0}, {false, 2, 0.0}};
        m.ulfItems[1].unknowns = {{3, 1.0}};
        m.ulfItems[1].constraints = {"D3"};
    });
    CUnknownLoadFactorItemDlg dlg(m_doc, 1);
    ASSERT_EQ(1, dlg.OnCalculate());
    const T_ULF_RESULT& r = *dlg.Result();
    EXPECT_FALSE(r.exact);
    EXPECT_NEAR(6.75 / 2.4, r.factors[1], 1e-10);
    EXPECT_EQ(0.0, r.factors[2]); // a known case without effect keeps its 0 and its influence
    ASSERT_EQ(1u, r.influence.size());
    EXPECT_EQ((std::vector<double>{-31. / 4, 12. / 5, 3. / 2}), r.influence[0]);
    const std::vector<T_ULF_RESULT_ROW> rows = UlfResultRows(r);
    ASSERT_EQ(1u, rows.size());
    EXPECT_NEAR(-1.0, rows[0].value, 1e-10);
    EXPECT_TRUE(rows[0].active && rows[0].met);
}

TEST_F(UnknownLoadFactor, SolvesAComparedConstraint)
{
    // Props at nodes 2 and 5 alone; DZ(2) = DZ(5) asks for equal props, DZ(2) = 0 for their size:
    // f (16/15 + 23/30) = 29/6.
    Change([](T_MODEL& m) {
        T_ULFC_D& c = m.ulfConstraints[2];
        c = five::Equal("D3", ULFC_TYPE::Displacement, 2, 0.0);
        c.compareWithValue = false;
        c.otherId = 5;
        m.combinations[1].items = {{false, 2, 1.0}, {false, 5, 1.0}, {false, 1, 1.0}};
        m.ulfItems[1].unknowns = {{2, 1.0}, {5, 1.0}};
        m.ulfItems[1].constraints = {"D2", "D3"};
    });
    CUnknownLoadFactorItemDlg dlg(m_doc, 1);
    ASSERT_EQ(1, dlg.OnCalculate());
    const double f = (29. / 6) / (16. / 15 + 23. / 30);
    EXPECT_NEAR(f, dlg.Result()->factors[0], 1e-12);
    EXPECT_NEAR(f, dlg.Result()->factors[1], 1e-12);
}

TEST_F(UnknownLoadFactor, MarksEquationsThatCannotBeMet)
{
    Change([](T_MODEL& m) { // D3 wants 0
        m.ulfConstraints[3] = five::Equal("D4", ULFC_TYPE::Displacement, 3, 1.0);
    });
    CUnknownLoadFactorItemDlg dlg(m_doc, 1);
    ASSERT_EQ(1, dlg.OnCalculate());
    ASSERT_EQ(1u, dlg.Messages().size());
    EXPECT_EQ("IDS_QM_ULF_NOT_MET", dlg.Messages()[0].key);
    EXPECT_NE(std::string::npos, dlg.Messages()[0].text.find("D3, D4")) << dlg.Messages()[0].text;
    for (const T_ULF_RESULT_ROW& row : UlfResultRows(*dlg.Result()))
        EXPECT_EQ(row.name == "D2" || row.name == "D5", row.met) << row.name;
}

TEST_F(UnknownLoadFactor, SolvesAgainAfterOtherBoundsAndAfterOtherResults)
{
    CUnknownLoadFactorItemDlg dlg(m_doc, 1);
    ASSERT_EQ(1, dlg.OnCalculate());
    CUnknownLoadFactorConstraintDlg lift(m_doc, 1);
    lift.m_constraint.value = 0.1;
    ASSERT_EQ(1, lift.OnOK());
    const std::uint64_t before = m_doc.Post().StaticRevision();
    ASSERT_EQ(1, dlg.OnCalculate());
    EXPECT_NEAR(0.1, UlfValue(*dlg.Result(), 0), 1e-12);
    EXPECT_EQ(before, m_doc.Post().StaticRevision()); // the cache lives on

    Change([](T_MODEL& m) { m.styp.units.length = LENGTH_UNIT::mm; });
    EXPECT_NE(before, m_doc.Post().StaticRevision());
    ASSERT_EQ(1, dlg.OnCalculate());
    EXPECT_NEAR(100.0, UlfValue(*dlg.Result(), 0), 1e-9); // in mm
    Change([](T_MODEL& m) { m.loadCases[3].selfWeight[2] = 99; });
    EXPECT_EQ(0, dlg.OnCalculate()); // results older than the model
    EXPECT_NE(std::string::npos, dlg.Messages().at(0).text.find("P2")) << dlg.Messages()[0].text;
}

TEST_F(UnknownLoadFactor, GridShowsAndTakesTexts)
{
    using D = CUnknownLoadFactorItemDlg;
    D dlg(m_doc, 1);
    const char* second[] = {"P1", "1", "0", "1.000", "1.000000"};
    for (int column = D::LoadCase; column <= D::Weight; ++column)
        EXPECT_EQ(second[column], dlg.CellText(1, static_cast<D::COLUMN>(column)));
    EXPECT_EQ("W0", dlg.CellText(0, D::LoadCase) + dlg.CellText(0, D::Unknown));
    EXPECT_EQ(1, dlg.SetCell(1, D::Weight, "0.123456789"));
    EXPECT_EQ("0.123457", dlg.CellText(1, D::Weight));
    EXPECT_EQ(1, dlg.SetCell(1, D::Weight, "0.123457")); // the shown text back
    EXPECT_EQ(0.123456789, dlg.Record().unknowns[0].weight);
    for (const char* bad : {"", "1,5", "nan"})
        EXPECT_EQ(0, dlg.SetCell(1, D::Weight, bad)) << bad;
    EXPECT_EQ(0, dlg.SetCell(1, D::Factor, "2") + dlg.SetCell(1, D::Unknown, "2") +
                     dlg.SetCell(5, D::Unknown, "1"));
    EXPECT_EQ(1, dlg.SetCell(1, D::Unknown, "0"));
    EXPECT_EQ(3u, dlg.Record().unknowns.size());
    // What is edited comes back as the record, strangers to the combination too.
    T_ULFI_D record = Model().ulfItems.at(1);
    record.unknowns.push_back({9, 2.0});
    record.constraints.push_back("gone");
    dlg.Data2Dlg(record);
    EXPECT_EQ(record, dlg.Record());
    const T_MODEL before = Model();
    EXPECT_EQ(0, dlg.OnOK()); // refused: nothing is stored
    EXPECT_EQ("IDS_QM_ULFI_NOT_IN_COMBINATION", dlg.Findings().at(0).ruleText);
    EXPECT_EQ(before, Model());
}

TEST_F(UnknownLoadFactor, StoresEachDialogAsOneUndoableEdit)
{
    CUnknownLoadFactorDlg list(m_doc);
    CScriptView view;
    list.SetView(&view);
    view.m_run = [](zql::frx::MDialog& child) {
        auto& item = dynamic_cast<CUnknownLoadFactorItemDlg&>(child);
        item.m_name = "T2";
        EXPECT_EQ(1, item.SetCell(1, CUnknownLoadFactorItemDlg::Unknown, "1"));
        item.m_checks[0].checked = true;
        return item.OnOK();
    };
    ASSERT_EQ(1, list.OnAdd());
    EXPECT_EQ(2, list.m_selected);
    EXPECT_EQ((CUnknownLoadFactorDlg::T_ROW{2, "T2", "C1"}), list.Rows().at(1));
    ASSERT_EQ(1, list.OnDelete());
    EXPECT_EQ(0, list.OnModify());
    EXPECT_EQ("IDS_RPS_ULFD_MODIFY_DATA_NON_EXIST", list.Messages().back().key);
    EXPECT_EQ(2, m_doc.Undo().Undo() + m_doc.Undo().Undo());
    EXPECT_FALSE(m_doc.Undo().CanUndo());

    CDBDoc empty;
    CUnknownLoadFactorDlg none(empty);
    EXPECT_EQ(0, none.OnAdd());
    EXPECT_EQ("IDS_RPS_No_General_Load_Combination_exist_", none.Messages().back().key);
}

TEST_F(UnknownLoadFactor, RenamedConstraintStaysInItsItems)
{
    CUnknownTableTabGrid1 grid(m_doc);
    CScriptView view;
    grid.SetView(&view);
    view.m_run = [](zql::frx::MDialog& child) {
        dynamic_cast<CUnknownLoadFactorConstraintDlg&>(child).m_constraint.name = "mid";
        return child.OnOK();
    };
    grid.m_selected = 2;
    ASSERT_EQ(1, grid.OnModify());
    EXPECT_EQ((CUnknownTableTabGrid1::T_ROW{2, "mid", "DZ of node 3 =      0.0000"}),
              grid.Rows()[1]);
    EXPECT_EQ((std::vector<std::string>{"D2", "mid", "D4", "D5"}),
              Model().ulfItems.at(1).constraints);
    EXPECT_EQ(1, m_doc.Undo().Undo()); // one edit
    EXPECT_EQ("D3", Model().ulfItems.at(1).constraints[1]);
    EXPECT_EQ("D3", Model().ulfConstraints.at(2).name);
    grid.m_selected = 8; // M4 is used by none
    EXPECT_EQ(1, grid.OnDelete());
    grid.m_selected = 8;
    EXPECT_EQ(0, grid.OnDelete());
    EXPECT_EQ("IDS_QM_ULFC_GONE", grid.Messages().back().key);
}
