#include "ulfdocument.h"

#include "qm_base/messagehistory.h"
#include "qm_base/msgfunction.h"
#include "qm_rps/unknownloadfactorconstraintdlg.h"
#include "qm_rps/unknownloadfactordlg.h"
#include "qm_rps/unknownloadfactoritemdlg.h"
#include "qm_rps/unknownloadfactorresultdlg.h"
#include "qm_rps/unknowntabletabgrid1.h"

#include <cmath>
#include <filesystem>
#include <gtest/gtest.h>
#include <limits>

namespace {

using zql::lib::MMSGFunction;
constexpr double kNan = std::numeric_limits<double>::quiet_NaN();
constexpr const char* kItemError = "IDS_RPS_UNKNOWN_LOAD_FACTOR_INPUT_ERROR";
constexpr const char* kConstraintError = "IDS_RPS_UNKNOWN_LOAD_FACTOR_CONSTRAINT_INPUT_ERROR";

struct UnknownLoadFactor : testing::Test {
    UnknownLoadFactor()
    {
        five::Fill(m_doc);
        (void)TakeMessageHistory();
    }
    const T_MODEL& Model() const { return m_doc.Data().Model(); }

    CDBDoc m_doc;
};

/// Accepts each child dialog after changing it.
class CScriptedView : public zql::frx::IDialogView {
public:
    std::function<void(zql::frx::MDialog&)> m_edit;
    void ShowMessage(const std::string&, const std::string&) override {}
    bool AskYesNo(const std::string&, const std::string&) override { return false; }
    int RunModal(zql::frx::MDialog& child) override
    {
        m_edit(child);
        return child.OnOK();
    }
};

} // namespace

TEST_F(UnknownLoadFactor, FindsThePropsOfAContinuousBeam)
{
    for (const bool byMoments : {false, true}) {
        for (const int objective : {0, 1, 2}) {
            CUnknownLoadFactorItemDlg dlg(m_doc, 1);
            dlg.m_objective = objective;
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
    }
    const std::vector<std::string> history = TakeMessageHistory();
    ASSERT_EQ(6u, history.size());
    EXPECT_EQ(MMSGFunction::GetValue("IDS_RPS_Unknown_CAN_FIND_OPTIMIZED_SOLUTION"), history[0]);
}

TEST_F(UnknownLoadFactor, FindsThePropsFromAnAnalysisOfTheBeam)
{
    // The same beam analysed: slender in bending (no shear area), so that the closed form holds.
    T_MODEL_CONTENT content = m_doc.Data().Content();
    T_MODEL& m = content.model;
    content.staticResults.clear();
    m.elements.erase(6);
    m.styp.plane = MODEL_PLANE::XZ;
    m.materials[1].name = "unit";
    m.materials[1].E = 1.0;
    m.sections[1].name = "unit";
    m.sections[1].area = m.sections[1].J = m.sections[1].Iyy = m.sections[1].Izz = 1.0;
    for (auto& [id, e] : m.elements)
        e.section = e.material = 1;
    m.nodes[1].restraint = {1, 1, 1, 0, 0, 0};
    m.nodes[6].restraint = {0, 1, 1, 0, 0, 0};
    for (auto& [key, c] : m.loadCases) {
        c.selfWeight = {};
        if (key > 1) c.nodal = {{key, {0, 0, 1, 0, 0, 0}}};
    }
    for (int id = 1; id <= 5; ++id)
        m.loadCases[1].beam.push_back(
            {id, BEAM_LOAD_AXES::Global, 2, BEAM_LOAD_TYPE::Distributed, {-1, -1}, {0, 1}});
    m_doc.Data().Assign(content);
    T_ANALYSIS_ERROR error;
    ASSERT_EQ(1, m_doc.RunAnalysis({}, error)) << error.text;

    CUnknownLoadFactorItemDlg dlg(m_doc, 1);
    ASSERT_EQ(1, dlg.OnCalculate()) << dlg.Messages()[0].text;
    for (std::size_t i = 0; i < 4; ++i) {
        EXPECT_NEAR(five::kProps[i], dlg.Result()->factors[i + 1], 1e-9);
        EXPECT_NEAR(-five::kSag[i], dlg.Result()->influence[i][0], 1e-9);
    }
    // Moments over the props under the combination of the factors; sagging positive or negative
    // by the local axes, so that their size is compared.
    CUnknownLoadFactorResultDlg result(m_doc, *dlg.Result());
    result.m_combinationName = "tuned";
    ASSERT_EQ(1, result.OnMakeCombination());
    ASSERT_EQ(1, m_doc.Post().SelectLoadCombNew(2));
    for (int id = 1; id <= 4; ++id) {
        T_DOF6 f{};
        ASSERT_EQ(1, m_doc.Post().GetStrbNew(id, 4, f));
        EXPECT_NEAR(std::fabs(five::kSupportMoment[id - 1]), std::fabs(f[4]), 1e-9);
    }
}

TEST_F(UnknownLoadFactor, MinimisesWithinBoundsAndListsATwoBoundConstraintOnce)
{
    // One prop at node 3 alone: its least force that keeps |DZ(3)| <= 1 is (31/4 - 1) / (12/5).
    T_MODEL_CONTENT content = m_doc.Data().Content();
    content.model.ulfConstraints[2] = five::Between(content.model.ulfConstraints[2], 1.0, -1.0);
    content.model.combinations[1].items = {{false, 1, 1.0}, {false, 3, 1.0}, {false, 2, 0.0}};
    content.model.ulfItems[1].unknowns = {{3, 1.0}};
    content.model.ulfItems[1].constraints = {"D3"};
    m_doc.Data().Assign(content);
    CUnknownLoadFactorItemDlg dlg(m_doc, 1);
    ASSERT_EQ(1, dlg.OnCalculate());
    const T_ULF_RESULT& r = *dlg.Result();
    EXPECT_FALSE(r.exact);
    EXPECT_EQ(2u, dlg.Calculation().run->formed.problem.constraints.size());
    EXPECT_NEAR(6.75 / 2.4, r.factors[1], 1e-10);
    EXPECT_EQ(0.0, r.factors[2]); // a known case without effect keeps its 0 and its influence
    ASSERT_EQ(1u, r.influence.size());
    EXPECT_EQ((std::vector<double>{-31. / 4, 12. / 5, 3. / 2}), r.influence[0]);
    const std::vector<T_ULF_RESULT_ROW> rows = UlfResultRows(r);
    ASSERT_EQ(1u, rows.size());
    EXPECT_NEAR(-1.0, rows[0].value, 1e-10);
    EXPECT_TRUE(rows[0].active && rows[0].met);
    EXPECT_EQ(1.0, rows[0].upper);
    EXPECT_EQ(-1.0, rows[0].lower);
}

TEST_F(UnknownLoadFactor, SolvesAComparedConstraint)
{
    // Props at nodes 2 and 5 alone; DZ(2) = DZ(5) asks for equal props, DZ(2) = 0 for their size:
    // f (16/15 + 23/30) = 29/6.
    T_MODEL_CONTENT content = m_doc.Data().Content();
    T_ULFC_D& c = content.model.ulfConstraints[2];
    c = five::Equal("D3", ULFC_TYPE::Displacement, 2, 0.0);
    c.compareWithValue = false;
    c.otherId = 5;
    content.model.combinations[1].items = {{false, 2, 1.0}, {false, 5, 1.0}, {false, 1, 1.0}};
    content.model.ulfItems[1].unknowns = {{2, 1.0}, {5, 1.0}};
    content.model.ulfItems[1].constraints = {"D2", "D3"};
    m_doc.Data().Assign(content);
    CUnknownLoadFactorItemDlg dlg(m_doc, 1);
    ASSERT_EQ(1, dlg.OnCalculate());
    const double f = (29. / 6) / (16. / 15 + 23. / 30);
    EXPECT_NEAR(f, dlg.Result()->factors[0], 1e-12);
    EXPECT_NEAR(f, dlg.Result()->factors[1], 1e-12);
    EXPECT_NEAR(16. / 15 - 23. / 30, dlg.Result()->influence[1][0], 1e-15);
    EXPECT_EQ(0.0, *dlg.Result()->constraints[1].upper);
}

TEST_F(UnknownLoadFactor, ReportsWhyThereAreNoFactors)
{
    // Exactly one factor is positive-only impossible: props pushing down.
    CUnknownLoadFactorItemDlg dlg(m_doc, 1);
    dlg.m_sign = 0; // negative
    EXPECT_EQ(0, dlg.OnCalculate());
    EXPECT_FALSE(dlg.Result());
    ASSERT_EQ(1u, dlg.Messages().size());
    EXPECT_EQ("IDS_RPS_Unknown_Load_Factor_Item_has_an_error", dlg.Messages()[0].key);
    const std::string& text = dlg.Messages()[0].text;
    EXPECT_NE(std::string::npos, text.find("T1")) << text;
    EXPECT_NE(std::string::npos, text.find("load factor 1")) << text;
    EXPECT_NE(std::string::npos, text.find("(P1)")) << text;
    EXPECT_EQ(MMSGFunction::GetValue("IDS_RPS_Unknown_CANNOT_FIND_OPTIMIZED_SOLUTION"),
              TakeMessageHistory().back());

    // Results older than the model name their case.
    CEditData& edit = m_doc.Edit();
    T_STLD_D changed = Model().loadCases.at(3);
    changed.selfWeight[2] = 99;
    ASSERT_TRUE(edit.Begin("load") && edit.Put(3, changed) && edit.Commit());
    dlg.ClearMessages();
    EXPECT_EQ(0, dlg.OnCalculate());
    EXPECT_NE(std::string::npos, dlg.Messages().at(0).text.find("P2")) << dlg.Messages()[0].text;
}

TEST_F(UnknownLoadFactor, MarksEquationsThatCannotBeMet)
{
    T_MODEL_CONTENT content = m_doc.Data().Content();
    content.model.ulfConstraints[3] =
        five::Equal("D4", ULFC_TYPE::Displacement, 3, 1.0); // D3 wants 0
    m_doc.Data().Assign(content);
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

    T_MODEL_CONTENT content = m_doc.Data().Content();
    content.model.styp.units.length = LENGTH_UNIT::mm;
    m_doc.Data().Assign(content);
    EXPECT_NE(before, m_doc.Post().StaticRevision());
    ASSERT_EQ(1, dlg.OnCalculate());
    EXPECT_NEAR(100.0, UlfValue(*dlg.Result(), 0), 1e-9); // in mm
}

TEST_F(UnknownLoadFactor, ItemReportsEachRuleInOrder)
{
    using D = CUnknownLoadFactorItemDlg;
    const struct {
        const char* label;
        const char *key, *rule;
        std::function<void(T_MODEL&, T_ULFI_D&)> spoil;
    } kCases[] = {
        {"name", "IDS_RPS_No_Item_Name_", "",
         [](T_MODEL&, T_ULFI_D& i) {
             i.name = "";
             i.unknowns.clear();
         }},
        {"taken", kItemError, "IDS_QM_ULFI_NAME_EXISTS",
         [](T_MODEL& m, T_ULFI_D& i) { m.ulfItems[2] = i; }},
        {"no combination", "IDS_RPS_No_General_Load_Combination_exist_", "",
         [](T_MODEL& m, T_ULFI_D&) { m.combinations.clear(); }},
        {"combination gone", kItemError, "IDS_QM_ULFI_COMBINATION",
         [](T_MODEL&, T_ULFI_D& i) { i.combination = 7; }},
        {"combination of itself", kItemError, "IDS_QM_ULFI_COMBINATION",
         [](T_MODEL& m, T_ULFI_D&) {
             m.combinations[1].items.push_back({true, 1, 1.0});
         }},
        {"objective below", kItemError, "IDS_QM_ULFI_OBJECTIVE",
         [](T_MODEL&, T_ULFI_D& i) { i.objective = -1; }},
        {"objective above", kItemError, "IDS_QM_ULFI_OBJECTIVE",
         [](T_MODEL&, T_ULFI_D& i) { i.objective = 3; }},
        {"sign above", kItemError, "IDS_QM_ULFI_SIGN", [](T_MODEL&, T_ULFI_D& i) { i.sign = 3; }},
        {"no unknown", "IDS_RPS_No_Unknown_Load_Factor_defined_", "",
         [](T_MODEL&, T_ULFI_D& i) {
             i.unknowns.clear();
             i.constraints.clear();
         }},
        {"stranger", kItemError, "IDS_QM_ULFI_NOT_IN_COMBINATION",
         [](T_MODEL&, T_ULFI_D& i) { i.unknowns[0].loadCase = 9; }},
        {"unknown twice", kItemError, "IDS_QM_ULFI_TWICE",
         [](T_MODEL&, T_ULFI_D& i) { i.unknowns[0].loadCase = 3; }},
        {"weight below", kItemError, "IDS_QM_ULFI_WEIGHT",
         [](T_MODEL&, T_ULFI_D& i) { i.unknowns[1].weight = -1e-300; }},
        {"weight nan", kItemError, "IDS_QM_ULFI_WEIGHT",
         [](T_MODEL&, T_ULFI_D& i) { i.unknowns[1].weight = kNan; }},
        {"weight 0", "", "", [](T_MODEL&, T_ULFI_D& i) { i.unknowns[1].weight = 0; }},
        {"no constraint", "IDS_RPS_No_constraint_defined_for_the_unknowns_", "",
         [](T_MODEL&, T_ULFI_D& i) { i.constraints.clear(); }},
        {"constraint gone", kItemError, "IDS_QM_ULFI_NO_SUCH_CONSTRAINT",
         [](T_MODEL&, T_ULFI_D& i) { i.constraints[0] = "gone"; }},
        {"node gone", "IDS_RPS_the_Node_Id_doesn_t_exist", "",
         [](T_MODEL& m, T_ULFI_D&) { m.nodes.erase(3); }},
        {"sound", "", "", [](T_MODEL&, T_ULFI_D&) {}},
    };
    for (const auto& c : kCases) {
        T_MODEL_CONTENT content = m_doc.Data().Content();
        T_ULFI_D item = content.model.ulfItems[1];
        c.spoil(content.model, item);
        CDBDoc doc;
        doc.Data().Assign(content);
        D dlg(doc, 1);
        dlg.Data2Dlg(item);
        const std::string key = c.key;
        EXPECT_EQ(key.empty() ? 1 : 0, dlg.CheckData()) << c.label;
        T_ULFI_D out;
        EXPECT_EQ(key.empty() ? 1 : 0, dlg.Dlg2Data(out)) << c.label;
        EXPECT_EQ(key.empty() ? item : T_ULFI_D(), out) << c.label;
        if (key.empty()) continue;
        const std::vector<T_FINDING> found = dlg.Findings();
        ASSERT_FALSE(found.empty()) << c.label;
        EXPECT_EQ(key, found[0].messageKey) << c.label;
        if (*c.rule) {
            EXPECT_EQ(c.rule, found[0].ruleText) << c.label;
        }
        EXPECT_EQ(found[0].text, dlg.Messages()[0].text) << c.label;
        EXPECT_EQ(std::string::npos, found[0].text.find_first_of("{}")) << found[0].text;
        EXPECT_EQ(0, dlg.OnOK()) << c.label;
        EXPECT_EQ(content.model.ulfItems, doc.Data().Model().ulfItems) << c.label;
    }
}

TEST_F(UnknownLoadFactor, ConstraintReportsEachRuleInOrder)
{
    const T_ULFC_D node = five::Equal("N", ULFC_TYPE::Displacement, 3, 0);
    T_ULFC_D reaction = node, beam = five::Equal("B", ULFC_TYPE::Beam, 3, 0),
             truss = five::Equal("S", ULFC_TYPE::Truss, 6, 0);
    reaction.type = ULFC_TYPE::Reaction;
    truss.component = 0;
    const auto other = [](T_ULFC_D c, int id) {
        c.compareWithValue = false;
        c.otherId = id;
        return c;
    };
    const auto with = [](T_ULFC_D c, auto change) {
        change(c);
        return c;
    };
    const struct {
        const char* label;
        const char *key, *rule;
        T_ULFC_D c;
    } kCases[] = {
        {"node", "", "", node},
        {"reaction", "", "", reaction},
        {"beam", "", "", beam},
        {"truss", "", "", truss},
        {"other node", "", "", other(node, 4)},
        {"other beam", "", "", other(beam, 1)},
        {"no name", "IDS_RPS_No_Constraint_Name_", "",
         with(node,
              [](auto& c) {
                  c.name = "";
                  c.id = 9;
              })},
        {"taken", kConstraintError, "IDS_QM_ULFC_NAME_EXISTS",
         with(node,
              [](auto& c) {
                  c.name = "D2";
                  c.id = 9;
              })},
        {"type", kConstraintError, "IDS_QM_ULFC_TYPE",
         with(node, [](auto& c) { c.type = static_cast<ULFC_TYPE>(4); })},
        {"no node", "IDS_RPS_the_Node_Id_doesn_t_exist", "",
         with(node,
              [](auto& c) {
                  c.id = 7;
                  c.component = 6;
              })},
        {"no node of a reaction", "IDS_RPS_the_Node_Id_doesn_t_exist", "",
         with(reaction, [](auto& c) { c.id = 0; })},
        {"no element", "IDS_RPS_the_Elem_Id_doesn_t_exist", "",
         with(beam, [](auto& c) { c.id = 7; })},
        {"no truss", "IDS_RPS_Elem_Id_is_not_of_Truss_", "",
         with(truss, [](auto& c) { c.id = 5; })},
        {"no beam", "IDS_RPS_Elem_Id_is_not_of_Beam_", "", with(beam, [](auto& c) { c.id = 6; })},
        {"position below", kConstraintError, "IDS_QM_ULFC_POSITION",
         with(beam, [](auto& c) { c.position = -1; })},
        {"position above", kConstraintError, "IDS_QM_ULFC_POSITION",
         with(beam, [](auto& c) { c.position = 5; })},
        {"component below", kConstraintError, "IDS_QM_ULFC_COMPONENT",
         with(node, [](auto& c) { c.component = -1; })},
        {"component above", kConstraintError, "IDS_QM_ULFC_COMPONENT",
         with(beam, [](auto& c) { c.component = 6; })},
        {"component of a truss", kConstraintError, "IDS_QM_ULFC_COMPONENT",
         with(truss, [](auto& c) { c.component = 1; })},
        {"no other node", "IDS_RPS_the_Other_Node_Id_doesn_t_exist", "", other(node, 7)},
        {"no other element", "IDS_RPS_the_Other_Elem_Id_doesn_t_exist", "", other(beam, 7)},
        {"other is no truss", "IDS_RPS_the_Other_Elem_Id_is_not_of_Truss_", "", other(truss, 1)},
        {"other is no beam", "IDS_RPS_the_Other_Elem_Id_is_not_of_Beam_", "", other(beam, 6)},
        {"itself", kConstraintError, "IDS_QM_ULFC_COMPARED_WITH_ITSELF", other(node, 3)},
        {"value", kConstraintError, "IDS_QM_ULFC_VALUE",
         with(node, [](auto& c) { c.value = kNan; })},
        {"value not read", "", "", with(other(node, 4), [](auto& c) { c.value = kNan; })},
        {"no bound", kConstraintError, "IDS_QM_ULFC_NO_BOUND", five::Between(node, {}, {})},
        {"infinite bound", kConstraintError, "IDS_QM_ULFC_VALUE", five::Between(node, -kNan, {})},
        {"infinite lower", kConstraintError, "IDS_QM_ULFC_VALUE",
         five::Between(node, 1.0, -INFINITY)},
        {"crossing", kConstraintError, "IDS_QM_ULFC_BOUNDS_CROSS",
         five::Between(node, 1.0, std::nextafter(1.0, 2.0))},
        {"touching", "", "", five::Between(node, 1.0, 1.0)},
        {"one bound", "", "", five::Between(node, {}, 1.0)},
    };
    for (const auto& c : kCases) {
        CUnknownLoadFactorConstraintDlg dlg(m_doc);
        dlg.Data2Dlg(c.c);
        const std::string key = c.key;
        EXPECT_EQ(key.empty() ? 1 : 0, dlg.CheckData()) << c.label;
        if (key.empty()) continue;
        const std::vector<T_FINDING> found = dlg.Findings();
        ASSERT_FALSE(found.empty()) << c.label;
        EXPECT_EQ(key, found[0].messageKey) << c.label;
        if (*c.rule) {
            EXPECT_EQ(c.rule, found[0].ruleText) << c.label;
        }
        EXPECT_EQ(found[0].text, dlg.Messages()[0].text) << c.label;
        EXPECT_EQ(std::string::npos, found[0].text.find_first_of("{}")) << found[0].text;
        EXPECT_EQ(0, dlg.OnOK()) << c.label;
    }
    EXPECT_EQ(8u, Model().ulfConstraints.size());
    EXPECT_FALSE(m_doc.Undo().CanUndo());
}

TEST_F(UnknownLoadFactor, GridShowsAndTakesTexts)
{
    using D = CUnknownLoadFactorItemDlg;
    D dlg(m_doc, 1);
    ASSERT_EQ(5u, dlg.Cases().size());
    const char* first[] = {"W", "0", "1", "1.000", "1.000000"};
    const char* second[] = {"P1", "1", "0", "1.000", "1.000000"};
    for (int column = D::LoadCase; column <= D::Weight; ++column) {
        EXPECT_EQ(first[column], dlg.CellText(0, static_cast<D::COLUMN>(column)));
        EXPECT_EQ(second[column], dlg.CellText(1, static_cast<D::COLUMN>(column)));
    }
    EXPECT_EQ(1, dlg.SetCell(1, D::Weight, "0.123456789"));
    EXPECT_EQ("0.123457", dlg.CellText(1, D::Weight));
    EXPECT_EQ(1, dlg.SetCell(1, D::Weight, "0.123457")); // the shown text back
    EXPECT_EQ(0.123456789, dlg.Record().unknowns[0].weight);
    for (const char* bad : {"", "1,5", "nan", "x"})
        EXPECT_EQ(0, dlg.SetCell(1, D::Weight, bad)) << bad;
    EXPECT_EQ(0, dlg.SetCell(1, D::Factor, "2"));
    EXPECT_EQ(0, dlg.SetCell(1, D::Unknown, "2"));
    EXPECT_EQ(0, dlg.SetCell(5, D::Unknown, "1"));
    EXPECT_EQ(1, dlg.SetCell(1, D::Unknown, "0"));
    EXPECT_EQ(3u, dlg.Record().unknowns.size());
    EXPECT_EQ("0.123457", dlg.CellText(1, D::Weight));
}

TEST_F(UnknownLoadFactor, StoresEachDialogAsOneUndoableEdit)
{
    CUnknownLoadFactorDlg list(m_doc);
    CScriptedView view;
    list.SetView(&view);
    view.m_edit = [](zql::frx::MDialog& child) {
        auto& item = dynamic_cast<CUnknownLoadFactorItemDlg&>(child);
        item.m_name = "T2";
        EXPECT_EQ(1, item.SetCell(1, CUnknownLoadFactorItemDlg::Unknown, "1"));
        item.m_checks[0].checked = true;
    };
    ASSERT_EQ(1, list.OnAdd());
    EXPECT_EQ(2, list.m_selected);
    ASSERT_EQ(2u, list.Rows().size());
    EXPECT_EQ((CUnknownLoadFactorDlg::T_ROW{2, "T2", "C1"}), list.Rows()[1]);
    view.m_edit = [](zql::frx::MDialog& child) {
        dynamic_cast<CUnknownLoadFactorItemDlg&>(child).m_name = "T3";
    };
    ASSERT_EQ(1, list.OnModify());
    EXPECT_EQ("T3", Model().ulfItems.at(2).name);
    ASSERT_EQ(1, list.OnDelete());
    EXPECT_EQ(0, list.OnModify());
    EXPECT_EQ("IDS_RPS_ULFD_MODIFY_DATA_NON_EXIST", list.Messages().back().key);
    for (int i = 0; i < 3; ++i)
        EXPECT_EQ(1, m_doc.Undo().Undo());
    EXPECT_FALSE(m_doc.Undo().CanUndo());
    EXPECT_EQ(1u, Model().ulfItems.size());

    CDBDoc empty;
    CUnknownLoadFactorDlg none(empty);
    EXPECT_EQ(0, none.OnAdd());
    EXPECT_EQ("IDS_RPS_No_General_Load_Combination_exist_", none.Messages().back().key);
}

TEST_F(UnknownLoadFactor, RenamedConstraintStaysInItsItems)
{
    CUnknownTableTabGrid1 grid(m_doc);
    CScriptedView view;
    grid.SetView(&view);
    view.m_edit = [](zql::frx::MDialog& child) {
        dynamic_cast<CUnknownLoadFactorConstraintDlg&>(child).m_constraint.name = "mid";
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

    EXPECT_EQ(0, grid.OnDelete());
    EXPECT_EQ("IDS_QM_ULFC_USED", grid.Messages().back().key);
    EXPECT_NE(std::string::npos, grid.Messages().back().text.find("T1"));
    grid.m_selected = 8; // M4 is used by none
    EXPECT_EQ(1, grid.OnDelete());
    grid.m_selected = 8;
    EXPECT_EQ(0, grid.OnDelete());
    EXPECT_EQ("IDS_QM_ULFC_GONE", grid.Messages().back().key);
}

TEST_F(UnknownLoadFactor, MakesALoadCombinationFromTheFactors)
{
    CUnknownLoadFactorItemDlg item(m_doc, 1);
    ASSERT_EQ(1, item.OnCalculate());
    CUnknownLoadFactorResultDlg dlg(m_doc, *item.Result());
    (void)TakeMessageHistory();
    const auto refused = [&](const char* name, const char* key) {
        dlg.m_combinationName = name;
        EXPECT_EQ(0, dlg.OnMakeCombination());
        EXPECT_EQ(std::vector<std::string>{MMSGFunction::Format(key, {name})},
                  TakeMessageHistory());
    };
    refused("", "IDS_RPS_UNKNOWN_LOAD_NAME_NOTENTERED");
    refused("C1", "IDS_RPS_UNKNOWN_LOAD_LCOM_EXIST");
    EXPECT_EQ(1u, Model().combinations.size());

    dlg.m_combinationName = "tuned";
    EXPECT_EQ(1, dlg.OnMakeCombination());
    EXPECT_EQ(std::vector<std::string>{MMSGFunction::Format("IDS_RPS_UNKNOWN_LOAD_LCOM_SUCCESS",
                                                            {"tuned"})},
              TakeMessageHistory());
    const T_LCOM_D& made = Model().combinations.at(2);
    EXPECT_EQ("tuned", made.name);
    ASSERT_EQ(5u, made.items.size());
    EXPECT_EQ((T_LCOM_ITEM{false, 2, item.Result()->factors[1]}), made.items[1]);
    // The combination brings the beam where the constraints want it.
    T_DOF6 u{};
    ASSERT_TRUE(m_doc.Post().SelectLoadCombNew(2) && m_doc.Post().GetDispNew(3, u));
    EXPECT_NEAR(0.0, u[2], 1e-12);
    EXPECT_EQ(1, m_doc.Undo().Undo());
    EXPECT_EQ(1u, Model().combinations.size());
}

TEST_F(UnknownLoadFactor, SplitsCombinationsAndGoesOnAfterARefusedOne)
{
    T_MODEL_CONTENT content = m_doc.Data().Content();
    T_LCOM_D& base = content.model.combinations[1];
    base.items.clear();
    T_ULF_RESULT result;
    result.item.combination = 1;
    for (int key = 1; key <= 999; ++key) {
        content.model.loadCases[key].name = "L" + std::to_string(key);
        base.items.push_back({false, key, 2.0});
        result.cases.push_back({key, "", 2.0});
        result.factors.push_back(3.0);
    }
    content.model.combinations[5] = {"taken-2", {{false, 1, 1.0}}};
    m_doc.Data().Assign(content);
    const auto make = [&](const char* name) {
        CUnknownLoadFactorResultDlg dlg(m_doc, result);
        dlg.m_combinationName = name;
        return dlg.OnMakeCombination();
    };
    (void)TakeMessageHistory();
    EXPECT_EQ(1, make("frame"));
    EXPECT_EQ(3u, TakeMessageHistory().size());
    const auto at = [&](const char* name) {
        T_LCOM_D c;
        EXPECT_EQ(1, m_doc.Attr().GetLcom_(name, c)) << name;
        return c.items;
    };
    EXPECT_EQ(999u, at("frame-1").size());
    EXPECT_EQ(6.0, at("frame-1")[998].factor); // multiplied
    EXPECT_TRUE(at("frame-2").empty());
    EXPECT_EQ((std::vector<T_LCOM_ITEM>{{true, 6, 1.0}, {true, 7, 1.0}}), at("frame"));
    EXPECT_EQ(1, m_doc.Undo().Undo()); // all three in one edit
    EXPECT_EQ(2u, Model().combinations.size());

    EXPECT_EQ(0, make("taken"));
    const std::vector<std::string> lines = TakeMessageHistory();
    ASSERT_EQ(3u, lines.size());
    EXPECT_EQ(MMSGFunction::Format("IDS_RPS_UNKNOWN_LOAD_LCOM_FAIL", {"taken-2"}), lines[1]);
    EXPECT_EQ(1u, at("taken").size()); // the part that was added
}

TEST_F(UnknownLoadFactor, ExportsTheSheetOrSaysWhyNot)
{
    CUnknownLoadFactorItemDlg item(m_doc, 1);
    ASSERT_EQ(1, item.OnCalculate());
    CUnknownLoadFactorResultDlg dlg(m_doc, *item.Result());
    const std::string path = testing::TempDir() + "qm_ulf_sheet.xlsx";
    EXPECT_EQ(1, dlg.OnExport(path, {16, 2024, 5, 6, "five"}));
    EXPECT_GT(std::filesystem::file_size(path), 1000u);
    std::filesystem::remove(path);
    EXPECT_EQ(0, dlg.OnExport(testing::TempDir() + "missing/x.xlsx", {}));
    EXPECT_EQ("IDS_QM_ULF_SHEET_NOT_WRITTEN", dlg.Messages().back().key);
    T_ULF_RESULT wide = *item.Result();
    wide.constraints.resize(231);
    CUnknownLoadFactorResultDlg old(m_doc, wide);
    EXPECT_EQ(0, old.OnExport(path, {11, 0, 0, 0, {}}));
    EXPECT_EQ("IDS_RPS_UNKNOWN_LOAD_EXCEED_COLUMN_ERROR", old.Messages().back().key);
    EXPECT_FALSE(std::filesystem::exists(path));
}
