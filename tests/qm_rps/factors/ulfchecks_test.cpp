// Rules of constraints, static items, items of construction stages, and load combinations.
#include "numbers.h"
#include "twotrusses.h"
#include "ulfdocument.h"

#include "qm_rps/factors/checks/ulfcombinationchecks.h"
#include "qm_rps/factors/checks/ulfconstraintchecks.h"
#include "qm_rps/factors/checks/ulfitemchecks.h"
#include "qm_rps/factors/checks/ulfstagechecks.h"

#include <algorithm>
#include <cmath>
#include <gtest/gtest.h>

namespace {

using FOUND = std::vector<T_FINDING>;

/// The first finding is of that rule, at that field; no rule: nothing is found.
void Judge(const FOUND& found, const std::string& rule, const std::string& field)
{
    ASSERT_EQ(rule.empty(), found.empty()) << (found.empty() ? rule : found[0].ruleText);
    if (rule.empty()) return;
    EXPECT_EQ(rule, found[0].ruleText);
    EXPECT_EQ(field, found[0].field);
    EXPECT_FALSE(found[0].text.empty());
    EXPECT_EQ(std::string::npos, found[0].text.find_first_of("{}")) << found[0].text;
}

} // namespace

TEST(UlfChecks, ConstraintsAreJudgedRuleByRule)
{
    CDBDoc doc;
    five::Fill(doc); // nodes 1 to 6, beams 1 to 5, truss 6
    using C = T_ULFC_D;
    const C node = five::Equal("N", ULFC_TYPE::Displacement, 3, 0);
    const C beam = five::Equal("B", ULFC_TYPE::Beam, 3, 0);
    C force = node, truss = five::Equal("S", ULFC_TYPE::Truss, 6, 0);
    force.type = ULFC_TYPE::Reaction;
    truss.component = 0;
    const auto other = [](C c, int id) {
        c.compareWithValue = false;
        c.otherId = id;
        return c;
    };
    const auto bounds = [&](std::optional<double> upper, std::optional<double> lower) {
        return five::Between(node, upper, lower);
    };
    const double above1 = std::nextafter(1.0, 2.0);
    struct T_CASE {
        C constraint;
        const char *rule, *field;
        void (*spoil)(C&) = [](C&) {};
    };
    // clang-format off
    const T_CASE cases[] = {
        {node, "", ""}, {force, "", ""}, {beam, "", ""}, {truss, "", ""},
        {other(node, 4), "", ""}, {other(beam, 1), "", ""},
        {node, "IDS_RPS_No_Constraint_Name_", "name", [](C& c) { c.name = ""; c.id = 9; }},
        {node, "IDS_QM_ULFC_NAME_EXISTS", "name", [](C& c) { c.name = "D2"; c.id = 9; }},
        {node, "IDS_QM_ULFC_TYPE", "type", [](C& c) { c.type = static_cast<ULFC_TYPE>(4); }},
        {node, "IDS_RPS_the_Node_Id_doesn_t_exist", "id", [](C& c) { c.id = 7; c.component = 6; }},
        {beam, "IDS_RPS_the_Elem_Id_doesn_t_exist", "id", [](C& c) { c.id = 7; }},
        {truss, "IDS_RPS_Elem_Id_is_not_of_Truss_", "id", [](C& c) { c.id = 5; }},
        {beam, "IDS_RPS_Elem_Id_is_not_of_Beam_", "id", [](C& c) { c.id = 6; }},
        {beam, "IDS_QM_ULFC_POSITION", "position", [](C& c) { c.position = -1; }},
        {beam, "IDS_QM_ULFC_POSITION", "position", [](C& c) { c.position = 5; }},
        {node, "IDS_QM_ULFC_COMPONENT", "component", [](C& c) { c.component = -1; }},
        {truss, "IDS_QM_ULFC_COMPONENT", "component", [](C& c) { c.component = 1; }},
        {other(node, 7), "IDS_RPS_the_Other_Node_Id_doesn_t_exist", "otherId"},
        {other(beam, 7), "IDS_RPS_the_Other_Elem_Id_doesn_t_exist", "otherId"},
        {other(truss, 1), "IDS_RPS_the_Other_Elem_Id_is_not_of_Truss_", "otherId"},
        {other(beam, 6), "IDS_RPS_the_Other_Elem_Id_is_not_of_Beam_", "otherId"},
        {other(node, 3), "IDS_QM_ULFC_COMPARED_WITH_ITSELF", "otherId"},
        {node, "IDS_QM_ULFC_VALUE", "value", [](C& c) { c.value = kNan; }},
        {other(node, 4), "", "", [](C& c) { c.value = kNan; }}, // not read
        {bounds({}, {}), "IDS_QM_ULFC_NO_BOUND", "upper"},
        {bounds(1.0, -kInf), "IDS_QM_ULFC_VALUE", "lower"},
        {bounds(1.0, above1), "IDS_QM_ULFC_BOUNDS_CROSS", "lower"},
        {bounds(1.0, 1.0), "", ""},
        {bounds({}, 1.0), "", ""},
    };
    // clang-format on
    for (const T_CASE& row : cases) {
        C constraint = row.constraint;
        row.spoil(constraint);
        SCOPED_TRACE(&row - cases);
        Judge(CheckUlfConstraint(constraint, 0, doc.Data().Model()), row.rule, row.field);
    }
    const T_MODEL& model = doc.Data().Model(); // its own name is free
    EXPECT_TRUE(CheckUlfConstraint(model.ulfConstraints.at(1), 1, model).empty());
}

TEST(UlfChecks, StaticItemsAreJudgedRuleByRule)
{
    using M = T_MODEL;
    using I = T_ULFI_D;
    struct T_CASE {
        const char *rule, *field;
        void (*spoil)(M&, I&);
    };
    // clang-format off
    const T_CASE cases[] = {
        {"", "", [](M&, I&) {}},
        {"IDS_RPS_No_Item_Name_", "name", [](M&, I& i) { i.name = ""; i.unknowns.clear(); }},
        {"IDS_QM_ULFI_NAME_EXISTS", "name", [](M& m, I& i) { m.ulfItems[2] = i; }},
        {"IDS_QM_ULFI_NAME_EXISTS", "name", [](M& m, I& i) { m.ulfStageItems[1].name = i.name; }},
        {"IDS_RPS_No_General_Load_Combination_exist_", "combination",
         [](M& m, I&) { m.combinations.clear(); }},
        {"IDS_QM_ULFI_COMBINATION", "combination", [](M&, I& i) { i.combination = 7; }},
        {"IDS_QM_ULFI_COMBINATION", "combination", // contains itself
         [](M& m, I&) { m.combinations[1].items.push_back({true, 1, 1.0}); }},
        {"IDS_QM_ULFI_OBJECTIVE", "objective", [](M&, I& i) { i.objective = 3; }},
        {"IDS_QM_ULFI_SIGN", "sign", [](M&, I& i) { i.sign = 3; }},
        {"IDS_RPS_No_Unknown_Load_Factor_defined_", "unknowns",
         [](M&, I& i) { i.unknowns.clear(); i.constraints.clear(); }},
        {"IDS_QM_ULFI_NOT_IN_COMBINATION", "unknowns",
         [](M&, I& i) { i.unknowns[0].loadCase = 9; }},
        {"IDS_QM_ULFI_TWICE", "unknowns", [](M&, I& i) { i.unknowns[0].loadCase = 3; }},
        {"IDS_QM_ULFI_WEIGHT", "unknowns", [](M&, I& i) { i.unknowns[1].weight = -1e-300; }},
        {"IDS_QM_ULFI_WEIGHT", "unknowns", [](M&, I& i) { i.unknowns[1].weight = kNan; }},
        {"", "", [](M&, I& i) { i.unknowns[1].weight = 0; }},
        {"IDS_RPS_No_constraint_defined_for_the_unknowns_", "constraints",
         [](M&, I& i) { i.constraints.clear(); }},
        {"IDS_QM_ULFI_NO_SUCH_CONSTRAINT", "constraints",
         [](M&, I& i) { i.constraints[0] = "gone"; }},
        {"IDS_QM_ULFI_TWICE", "constraints", [](M&, I& i) { i.constraints.push_back("D2"); }},
        {"IDS_QM_ULFI_STAGE_CONSTRAINT", "constraints[D2].stage",
         [](M& m, I&) { m.ulfConstraints[1].stage = 1; }},
        {"IDS_RPS_the_Node_Id_doesn_t_exist", "constraints[D3].id",
         [](M& m, I&) { m.nodes.erase(3); }},
    };
    // clang-format on
    for (const T_CASE& row : cases) {
        CDBDoc doc;
        five::Fill(doc);
        T_MODEL_CONTENT content = doc.Data().Content();
        I item = content.model.ulfItems[1];
        row.spoil(content.model, item);
        doc.Data().Assign(std::move(content));
        SCOPED_TRACE(&row - cases);
        Judge(CheckUlfItem(item, 1, doc.Data()), row.rule, row.field);
    }
}

TEST(UlfChecks, StageItemsAreJudgedRuleByRuleAndRowByRow)
{
    using I = T_ULSI_D;
    struct T_CASE {
        const char *rule, *field;
        const char* says; // in the text
        void (*spoil)(T_MODEL&, I&);
    };
    using M = T_MODEL;
    // clang-format off
    const T_CASE cases[] = {
        {"", "", "", [](M&, I&) {}},
        {"IDS_RPS_No_Item_Name_", "name", "", [](M&, I& i) { i.name.clear(); }},
        {"IDS_QM_ULFI_NAME_EXISTS", "name", "", [](M& m, I& i) { m.ulfStageItems[2] = i; }},
        {"IDS_QM_ULFI_NAME_EXISTS", "name", "", [](M& m, I& i) { m.ulfItems[1].name = i.name; }},
        {"IDS_QM_ULSI_PLACE", "rows[1].step", "STAY: row 1 (T): ",
         [](M&, I& i) { i.rows[0].step = 2; }},
        {"IDS_QM_ULSI_PLACE", "rows[2].step", "row 2 (G): ", [](M&, I& i) { i.rows[1].stage = 9; }},
        {"IDS_QM_ULSI_CASE", "rows[2].case", "row 2 (S1/First Step): ",
         [](M&, I& i) { i.rows[1].loadCase = 9; }},
        {"IDS_QM_ULSI_GROUP", "rows[1].load_group", "row 1 (S1/First Step T): ",
         [](M&, I& i) { i.rows[0].loadGroup = 3; }},
        {"IDS_QM_ULSI_NUMBER", "rows[1].factor", "row 1 ", [](M&, I& i) { i.rows[0].weight = -1; }},
        {"IDS_QM_ULSI_NUMBER", "rows[2].factor", "row 2 (S1/First Step G): ",
         [](M&, I& i) { i.rows[1].factor = kNan; }},
        {"IDS_QM_ULSI_TWICE", "rows[3].case", "row 3 (S1/Last Step G): ", // its only step
         [](M&, I& i) { i.rows.push_back(i.rows[1]); i.rows[2].step = kStageLastStep; }},
        {"IDS_QM_ULSI_NO_PRETENSION", "rows[1].pretension", "row 1 ",
         [](M&, I& i) { i.rows.pop_back(); i.rows[0].loadCase = 1; }},
        {"IDS_QM_ULSI_SCALED_TWICE", "rows[2].pretension", "row 2 (S1/First Step G): ",
         [](M&, I& i) { i.rows[1] = {1, 1, 1, true, 1, 1, true, 0}; }},
        {"IDS_QM_ULSI_NOT_IN_SUM", "rows[1].load_group", "row 1 (S1/First Step T): ",
         [](M&, I& i) { i.rows[0].loadGroup = kLoadGroupErection; }},
        {"IDS_QM_ULSI_COUNTED_TWICE", "rows[3].load_group", "row 3 (S1/First Step G): ",
         [](M& m, I& i) { // two rows that read the dead load
             m.loadCases[3] = m.loadCases[1];
             i.rows.push_back({1, 1, 3, false, 1, 1, false, kLoadGroupErection});
         }},
        {"IDS_QM_ULSI_COUNTED_TWICE", "rows[1].load_group", "row 1 ",
         [](M& m, I&) { m.loadCases[2].group = kLoadGroupDead; }},
        {"IDS_QM_ULSI_COUNTED_TWICE", "rows[1].load_group", "row 1 ",
         [](M&, I& i) { i.sumStageLoads = true; }},
        {"", "", "", [](M&, I& i) { i.sumStageLoads = true; i.rows[0].pretension = false; }},
        {"", "", "", [](M&, I& i) { i.rows[1].loadGroup = kLoadGroupErection; }},
        {"IDS_QM_ULFI_SIGN", "sign", "", [](M&, I& i) { i.sign = 3; }},
        {"IDS_RPS_No_Unknown_Load_Factor_defined_", "rows", "",
         [](M&, I& i) { i.rows.erase(i.rows.begin()); }},
        {"IDS_RPS_No_constraint_defined_for_the_unknowns_", "constraints", "",
         [](M&, I& i) { i.constraints.clear(); }},
        {"IDS_QM_ULFI_NO_SUCH_CONSTRAINT", "constraints", "",
         [](M&, I& i) { i.constraints = {"GONE"}; }},
        {"IDS_QM_ULSI_CONSTRAINT_PLACE", "constraints[HOLD].stage", "constraint HOLD: ",
         [](M& m, I&) { m.ulfConstraints[1].stage = 9; }},
        {"IDS_QM_ULSI_NO_PLACE", "constraints[HOLD].stage", "",
         [](M& m, I& i) { m.stages[2] = {"S2", {}, {}}; i.rows[1].stage = 2; }},
        {"", "", "", // read at the end of the second stage, whatever the rows' places
         [](M& m, I& i) {
             m.stages[2] = {"S2", {}, {}};
             i.rows[1].stage = m.ulfConstraints[1].stage = 2;
         }},
        {"IDS_QM_ULSI_NOT_STANDING", "constraints[HOLD].id", "", // gone at the second stage
         [](M& m, I&) {
             m.stages[2] = {"S2", {}, {{1, 2}, {}, {}}};
             m.ulfConstraints[1].stage = 2;
         }},
        {"IDS_QM_ULSI_NOT_STANDING", "constraints[HOLD].id", "", // no support
         [](M& m, I&) {
             m.ulfConstraints[1].type = ULFC_TYPE::Reaction;
             m.stages[1].activate.supports = {1, 3};
         }},
        {"IDS_QM_ULSI_NOT_STANDING", "constraints[HOLD].otherId", "",
         [](M& m, I&) {
             m.ulfConstraints[1].compareWithValue = false;
             m.ulfConstraints[1].otherId = 3;
             m.stages[1].activate.elements = {1};
         }},
        {"IDS_RPS_the_Node_Id_doesn_t_exist", "constraints[HOLD].id", "",
         [](M& m, I&) { m.ulfConstraints[1].id = 9; }},
    };
    // clang-format on
    for (const T_CASE& row : cases) {
        T_MODEL_CONTENT content = two::Content();
        I item = content.model.ulfStageItems[1];
        row.spoil(content.model, item);
        CDBDoc doc;
        doc.Data().Assign(std::move(content));
        const FOUND found = CheckUlfStageItem(item, 1, doc.Data());
        SCOPED_TRACE(&row - cases);
        Judge(found, row.rule, row.field);
        if (*row.says) {
            EXPECT_NE(std::string::npos, found.at(0).text.find(row.says)) << found[0].text;
        }
    }
}

TEST(UlfChecks, StageItemsWarnOfWhatTheAnalysisDoesNotTakeAsTheyDo)
{
    const struct {
        std::vector<std::string> rules;
        const char* says;
        void (*spoil)(T_MODEL&, T_ULSI_D&);
    } cases[] = {
        {{}, "", [](T_MODEL&, T_ULSI_D&) {}},
        {{"IDS_QM_ULSI_NEVER_APPLIED"},
         "row 1 (S1/First Step T)",
         [](T_MODEL&, T_ULSI_D& i) { i.rows[0].pretension = false; }},
        {{"IDS_QM_ULSI_KNOWN_FACTOR"},
         "row 2 (S1/First Step G)",
         [](T_MODEL&, T_ULSI_D& i) { i.rows[1].factor = 1.35; }},
        {{"IDS_QM_ULSI_FORGOTTEN"}, "G", [](T_MODEL&, T_ULSI_D& i) { i.rows.pop_back(); }},
        {{},
         "",
         [](T_MODEL& m, T_ULSI_D&) { // it comes after the constraint is read
             m.loadCases[3].name = "Q";
             m.stages[2] = {"S2", {{}, {}, {{3, kStageFirstStep}}}, {}};
         }},
    };
    for (const auto& row : cases) {
        T_MODEL_CONTENT content = two::Content();
        T_ULSI_D item = content.model.ulfStageItems[1];
        row.spoil(content.model, item);
        CDBDoc doc;
        doc.Data().Assign(std::move(content));
        std::vector<std::string> rules;
        for (const T_FINDING& f : UlfStageItemWarnings(item, doc.Data())) {
            rules.push_back(f.ruleText);
            EXPECT_NE(std::string::npos, f.text.find(row.says)) << f.text;
        }
        EXPECT_EQ(row.rules, rules);
    }
}

TEST(UlfChecks, CombinationsAreJudgedRuleByRule)
{
    CDBDoc doc;
    five::Fill(doc); // combination 1 "C1"
    const T_LCOM_ITEM own{false, 1, 1.0};
    const struct {
        int key;
        T_LCOM_D combination;
        const char *rule, *field;
    } cases[] = {
        {0, {"C2", {own}}, "", ""},
        {1, {"C1", {own}}, "", ""},
        {0, {"", {own}}, "IDS_RPS_UNKNOWN_LOAD_NAME_NOTENTERED", "name"},
        {0, {"C1", {own}}, "IDS_RPS_UNKNOWN_LOAD_LCOM_EXIST", "name"},
        {0, {"C2", {}}, "IDS_QM_UI_LCOM_EMPTY", "items"},
        {0, {"C2", {{false, 9, 1.0}}}, "IDS_QM_UI_LCOM_EMPTY", "items"},
    };
    for (const auto& row : cases) {
        SCOPED_TRACE(row.combination.name);
        Judge(CheckCombination(row.combination, row.key, doc.Data()), row.rule, row.field);
    }
}
