#include "numbers.h"
#include "qm_rps/pushoverpmminteractiondlg.h"
#include "qm_rps/pushoverpmminteractiongrid.h"

#include <gtest/gtest.h>

namespace {

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
    const struct {
        void (*edit)(T_PMM_TABLE&);
        const char *key, *field; // empty: passes
    } kCases[] = {
        {[](T_PMM_TABLE& t) { t.curves[0][5].p = t.curves[0][4].p; }, "", ""},
        {[](T_PMM_TABLE& t) { t.curves[0][5].p += 0.1 + 1e-9; }, kCurve, "curves[0][5].p"},
        {[](T_PMM_TABLE& t) { t.curves[1][10].m += 0.05 + 1e-9; }, kCurve, "curves[1][10].m"},
        {[](T_PMM_TABLE& t) { t.curves[1][0].p = kNan; }, kCurve, "curves[1][0].p"},
        // A balanced point: the moment rises once on the way to it and never again.
        {[](T_PMM_TABLE& t) { t.balanced = true, t.curves[0][0].m = t.curves[0][1].m = 0.1; }, "",
         ""},
        {[](T_PMM_TABLE& t) { t.curves[0][0].m = 0.1; }, kCurve, "curves[0][1].m"},
        {[](T_PMM_TABLE& t) { t.balanced = true, t.curves[0][5].m += 0.2; }, kCurve,
         "curves[0][5].m"},
        {[](T_PMM_TABLE& t) { t.balanced = true, t.curves[0][0].m = kNan; }, kCurve,
         "curves[0][0].m"},
        // (-) on its own is judged on its own.
        {[](T_PMM_TABLE& t) { (t.negative = t.curves)->at(1)[3].p += 0.2; }, kCurve,
         "negative[1][3].p"},
        {[](T_PMM_TABLE& t) { t.Pmax = 0; }, "", ""},
        {[](T_PMM_TABLE& t) { t.Pmax = -1e-9; }, kPmax, "Pmax"},
    };
    for (const auto& c : kCases) {
        SCOPED_TRACE(&c - kCases);
        T_PMM_TABLE record;
        CPushOverPMMInteractionDlg dlg(record);
        dlg.m_table = Table();
        c.edit(dlg.m_table);
        ASSERT_EQ(*c.key ? 0 : 1, dlg.OnOK());
        EXPECT_EQ(*c.key ? T_PMM_TABLE{} : dlg.m_table, record);
        if (!*c.key) continue;
        EXPECT_EQ(c.key, dlg.Messages().at(0).key);
        EXPECT_EQ(c.field, dlg.Findings().front().field);
    }
}

TEST(PmmInteractionGrid, ShowsFourCurvesWhereTheNegativeSideHasItsOwn)
{
    T_PMM_TABLE record = Table();
    CPushOverPMMInteractionDlg dlg(record);
    CPushoverPMMInteractionGrid grid(dlg.m_table);
    ASSERT_EQ(1, grid.SelectCurve(3)); // Pz-Mz(-)
    EXPECT_EQ("curves[1][3].m", grid.CellField(3, 1));
    dlg.OnSameSidesChk(false);
    EXPECT_EQ("negative[1][3].m", grid.CellField(3, 1));
    ASSERT_EQ(1, grid.SetCellText(3, 1, "0.25"));
    EXPECT_EQ(0.25, dlg.m_table.negative.value()[1][3].m);
    EXPECT_EQ(Table().curves, dlg.m_table.curves);
    dlg.OnSameSidesChk(true);
    EXPECT_EQ(Table(), dlg.m_table);
}

TEST(PmmInteractionGrid, PastesABlockThatFitsAndNothingElse)
{
    constexpr const char* kColumn = "IDS_CMD_PASTE_EXCEED_COLUMN";
    constexpr const char* kRow = "IDS_CMD_PASTE_EXCEED_ROW";
    constexpr const char* kRange = "IDS_CMD_PASTE_RANGE_MISMATCH";
    constexpr const char* kNumber = "IDS_QM_PASTE_NOT_A_NUMBER";
    const struct {
        const char* text;
        T_GRID_RANGE range;
        const char* key;
    } kRefused[] = {
        {"1\t2", {0, 1}, kColumn},      {"1\n2", {10, 0}, kRow},
        {"1\t2", {0, 0, 2, 2}, kRange}, // larger selection
        {"1\n2", {10, 0, 2, 1}, kRow},  // that goes beyond the grid
        {"1\t2\n3", {0, 0}, kRange},    {"", {0, 0}, kRange},
        {"1\tx", {0, 0}, kNumber},      {"1\t2,5", {0, 0}, kNumber},
        {"1\tinf", {0, 0}, kNumber},
    };
    for (const auto& c : kRefused) {
        SCOPED_TRACE(&c - kRefused);
        T_PMM_TABLE t = Table();
        CPushoverPMMInteractionGrid grid(t);
        EXPECT_EQ(0, grid.Paste(c.text, c.range));
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
    EXPECT_EQ(1, grid.Paste("1\t2\n3\t4", {9, 0, 2, 2})); // a selection of its size
}
