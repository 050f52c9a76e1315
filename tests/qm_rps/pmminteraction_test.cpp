#include "qm_rps/pushoverpmminteractiondlg.h"
#include "qm_rps/pushoverpmminteractiongrid.h"

#include <functional>
#include <gtest/gtest.h>
#include <limits>

namespace {

constexpr double kNan = std::numeric_limits<double>::quiet_NaN();

T_PMM_TABLE Table()
{
    T_PMM_TABLE t;
    t.Pmax = 100;
    for (auto& curve : t.curves)
        for (std::size_t i = 0; i < 11; ++i)
            curve[i] = {1.0 - 0.1 * static_cast<double>(i), 0.9 - 0.05 * static_cast<double>(i)};
    return t;
}

} // namespace

TEST(PmmInteractionDlg, NoValueRisesAndPmaxIsNotNegative)
{
    constexpr const char* kCurve = "IDS_PUSHOVER_Wrong_Data_in_P_values";
    constexpr const char* kPmax = "IDS_PUSHOVER_PMAX_POS";
    struct T_CASE {
        const char* label;
        std::function<void(T_PMM_TABLE&)> edit;
        const char* key; // null: passes
        const char* field;
    };
    const T_CASE cases[] = {
        {"falling", [](T_PMM_TABLE&) {}, nullptr, ""},
        {"equal P", [](T_PMM_TABLE& t) { t.curves[0][5].p = t.curves[0][4].p; }, nullptr, ""},
        {"P rises", [](T_PMM_TABLE& t) { t.curves[0][5].p = t.curves[0][4].p + 1e-9; }, kCurve,
         "curves[0][5].p"},
        {"M rises", [](T_PMM_TABLE& t) { t.curves[1][10].m = t.curves[1][9].m + 1e-9; }, kCurve,
         "curves[1][10].m"},
        {"first P NaN", [](T_PMM_TABLE& t) { t.curves[1][0].p = kNan; }, kCurve, "curves[1][0].p"},
        {"Pmax 0", [](T_PMM_TABLE& t) { t.Pmax = 0; }, nullptr, ""},
        {"Pmax negative", [](T_PMM_TABLE& t) { t.Pmax = -1e-9; }, kPmax, "Pmax"},
        {"curve first", [](T_PMM_TABLE& t) { t.Pmax = -1, t.curves[1][3].m = 2; }, kCurve,
         "curves[1][3].m"},
    };
    for (const T_CASE& c : cases) {
        SCOPED_TRACE(c.label);
        T_PMM_TABLE record;
        CPushOverPMMInteractionDlg dlg(record);
        dlg.m_table = Table();
        c.edit(dlg.m_table);
        ASSERT_EQ(c.key ? 0 : 1, dlg.OnOK());
        EXPECT_EQ(c.key ? T_PMM_TABLE{} : dlg.m_table, record);
        if (!c.key) continue;
        ASSERT_EQ(1u, dlg.Messages().size());
        EXPECT_EQ(c.key, dlg.Messages()[0].key);
        EXPECT_EQ(c.field, dlg.Findings().front().field);
    }
    T_PMM_TABLE record = Table();
    record.curves[0][1].p = 2;
    record.curves[1][1].m = 2;
    record.Pmax = -1;
    EXPECT_EQ(3u, CPushOverPMMInteractionDlg(record).Findings().size());
}

TEST(PmmInteractionGrid, PastesABlockThatFitsAndNothingElse)
{
    constexpr const char* kColumn = "IDS_CMD_PASTE_EXCEED_COLUMN";
    constexpr const char* kRow = "IDS_CMD_PASTE_EXCEED_ROW";
    constexpr const char* kRange = "IDS_CMD_PASTE_RANGE_MISMATCH";
    constexpr const char* kNumber = "IDS_QM_PASTE_NOT_A_NUMBER";
    struct T_CASE {
        const char* label;
        const char* text;
        T_GRID_RANGE range;
        const char* key;
    };
    const T_CASE cases[] = {
        {"block", "3\t4\r\n5\t 6 \r\n", {1, 0}, nullptr},
        {"selection of its size", "1\t2\n3\t4", {9, 0, 2, 2}, nullptr},
        {"too wide", "1\t2", {0, 1}, kColumn},
        {"too high", "1\n2", {10, 0}, kRow},
        {"larger selection", "1\t2", {0, 0, 2, 2}, kRange},
        {"selection beyond the grid", "1\n2", {10, 0, 2, 1}, kRow},
        {"ragged", "1\t2\n3", {0, 0}, kRange},
        {"empty", "", {0, 0}, kRange},
        {"text", "1\tx", {0, 0}, kNumber},
        {"decimal comma", "1\t2,5", {0, 0}, kNumber},
        {"not finite", "1\tinf", {0, 0}, kNumber},
    };
    for (const T_CASE& c : cases) {
        SCOPED_TRACE(c.label);
        T_PMM_TABLE t = Table();
        CPushoverPMMInteractionGrid grid(t);
        EXPECT_EQ(c.key ? 0 : 1, grid.Paste(c.text, c.range));
        EXPECT_EQ(c.key ? 1u : 0u, grid.Messages().size());
        if (!c.key) continue;
        EXPECT_EQ(Table(), t);
        EXPECT_EQ(c.key, grid.Messages().at(0).key);
    }
    T_PMM_TABLE t = Table();
    CPushoverPMMInteractionGrid grid(t);
    ASSERT_EQ(1, grid.Paste("3\t4\r\n5\t 6 \r\n", {1, 0}));
    T_PMM_TABLE expected = Table();
    expected.curves[0][1] = {3, 4};
    expected.curves[0][2] = {5, 6};
    EXPECT_EQ(expected, t);
}
