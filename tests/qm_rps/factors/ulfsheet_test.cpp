#include "qm_rps/factors/ulfcombination.h"
#include "qm_rps/factors/ulfsheet.h"

#include <gtest/gtest.h>

namespace {

T_ULF_RESULT Result(std::size_t cases, std::size_t constraints)
{
    T_ULF_RESULT r;
    for (std::size_t j = 0; j < cases; ++j) {
        r.cases.push_back({static_cast<int>(j) + 1, "L" + std::to_string(j + 1), 1.0});
        r.factors.push_back(0.5 * static_cast<double>(j + 1));
    }
    for (std::size_t i = 0; i < constraints; ++i) {
        r.constraints.push_back({"C" + std::to_string(i + 1), "", {}, {}});
        r.influence.emplace_back(cases, 1.0 + static_cast<double>(i));
    }
    return r;
}

const T_SHEET_CELL& At(const T_SHEET& sheet, const std::string& address)
{
    static const T_SHEET_CELL none;
    for (const auto& [at, cell] : sheet.cells)
        if (SheetAddress(at.first, at.second) == address) return cell;
    return none;
}

} // namespace

TEST(UlfSheet, HoldsEveryCellInItsFrame)
{
    T_ULF_RESULT r = Result(2, 2); // factors 0.5, 1; influence 1 1 and 2 2
    r.constraints[0].upper = 3;
    r.constraints[0].lower = -3;
    r.constraints[1].lower = 1;
    r.influence[1] = {2, -4};
    T_SHEET s;
    ASSERT_EQ(1, MakeUlfSheet(r, {16, 2024, 2, 9, "frame.qmdb"}, s));
    using V = SHEET_VALUE;
    const std::vector<V> block[] = {
        // from row 8, columns A to D
        {V{}, "Constraint", "C1", "C2"},
        {"Factor", "Upper Bound", 3.0, V{}},
        {V{}, "Lower Bound", -3.0, 1.0},
        {V{}, "Value", T_SHEET_FORMULA{"=SUMPRODUCT(B12:B13,C12:C13)", 1.5},
         T_SHEET_FORMULA{"=SUMPRODUCT(B12:B13,D12:D13)", -3.0}},
        {"L1", 0.5, 1.0, 2.0},
        {"L2", 1.0, 1.0, -4.0},
    };
    for (std::size_t row = 0; row < 6; ++row)
        for (std::size_t column = 0; column < 4; ++column) {
            const std::string address = SheetAddress(row + 7, column);
            EXPECT_EQ(block[row][column], At(s, address).value) << address;
        }
    for (const auto& [address, value] : {std::pair{"A4", "File Name : "},
                                         {"B4", "frame.qmdb"},
                                         {"D4", "Date : 2024/2/9"},
                                         {"A5", "Number of Constraints : 2"},
                                         {"D5", "Number of Load Cases : 2"}})
        EXPECT_EQ(V(value), At(s, address).value) << address;
    EXPECT_TRUE(At(s, "C8").style.centred && At(s, "A12").style.centred);
    EXPECT_FALSE(At(s, "A2").style.centred || At(s, "C12").style.centred);
    using E = SHEET_EDGE;
    const struct {
        const char* address;
        E left, right, top, bottom;
    } kEdges[] = {
        {"A8", E::Thin, E::None, E::Thin, E::None},    {"D13", E::None, E::Thin, E::None, E::Thin},
        {"A11", E::Thin, E::None, E::None, E::Double}, {"B8", E::None, E::Double, E::Thin, E::None},
        {"C12", E::None, E::None, E::None, E::None},
    };
    for (const auto& c : kEdges) {
        const T_SHEET_STYLE& style = At(s, c.address).style;
        EXPECT_TRUE(style.left == c.left && style.right == c.right && style.top == c.top &&
                    style.bottom == c.bottom)
            << c.address;
    }
}

TEST(UlfSheet, NamesQuantityUnitAndWhatIsKnownAndRoundsWhatIsShown)
{
    T_ULF_RESULT r = Result(2, 2);
    r.cases[0].unknown = true;
    r.factors = {5774.5551234, 1.0};
    r.influence = {{0.000123456789, 1e-17}, {250.0, 123456789.0}};
    r.constraints[0].description = "DZ of node 5 <=      0.0200 >=     -0.0200";
    r.constraints[1].description = "DZ of node 5 = node 6";
    r.constraints[0].unit = "m";
    T_SHEET s;
    ASSERT_EQ(1, MakeUlfSheet(r, {}, s));
    using V = SHEET_VALUE;
    for (const auto& [address, value] : {std::pair{"B6", "Quantity"},
                                         {"C6", "DZ of node 5"},
                                         {"D6", "DZ of node 5 = node 6"},
                                         {"C7", "m"},
                                         {"D7", "-"},
                                         {"E8", "Known or unknown"},
                                         {"E12", "unknown"},
                                         {"E13", "known"}})
        EXPECT_EQ(V(value), At(s, address).value) << address;
    EXPECT_EQ(V(0.000123456789), At(s, "C12").value); // stored as it is
    // Six digits of the largest in the column: 5774.56, 0.712892 of row 11, 123...e8.
    for (const auto& [address, format] : {std::pair{"B12", "0.00"},
                                          {"B13", "0.00"},
                                          {"C11", "0.000000"},
                                          {"C13", "0.000000"},
                                          {"D13", "0"}})
        EXPECT_EQ(format, At(s, address).style.numberFormat) << address;
    EXPECT_EQ("", At(s, "A12").style.numberFormat);
    EXPECT_EQ(11U, s.frozenRows);
    EXPECT_EQ(2U, s.frozenColumns);
    EXPECT_TRUE(s.fitsWidth);
}

TEST(UlfSheet, AppendsTheConstantAsItIsShown)
{
    T_ULF_RESULT r = Result(2, 2);
    r.constraints[0].constant = 1.23456789;
    r.constraints[1].constant = -2.0;
    T_SHEET s;
    ASSERT_EQ(1, MakeUlfSheet(r, {}, s));
    const auto first = std::get<T_SHEET_FORMULA>(At(s, "C11").value);
    EXPECT_EQ("=SUMPRODUCT(B12:B13,C12:C13)+1.234568", first.text);
    EXPECT_DOUBLE_EQ(1.5 + 1.234568, first.value);
    EXPECT_EQ((T_SHEET_FORMULA{"=SUMPRODUCT(B12:B13,D12:D13)+-2.000000", 1.0}),
              std::get<T_SHEET_FORMULA>(At(s, "D11").value));
}

TEST(UlfSheet, NamesColumnsBeyondZ)
{
    T_SHEET s;
    ASSERT_EQ(1, MakeUlfSheet(Result(1, 16382), {}, s));
    const std::pair<std::size_t, const char*> kColumns[] = {
        {25, "Z"}, {26, "AA"}, {701, "ZZ"}, {702, "AAA"}, {16383, "XFD"}};
    for (const auto& [column, letters] : kColumns) {
        const std::string x = letters;
        EXPECT_EQ("=SUMPRODUCT(B12:B12," + x + "12:" + x + "12)",
                  std::get<T_SHEET_FORMULA>(s.cells.at({10, column}).value).text);
    }
    EXPECT_EQ(SHEET_EDGE::Thin, At(s, "XFD12").style.right);
}

TEST(UlfSheet, RefusesMoreConstraintsThanColumns)
{
    EXPECT_TRUE(UlfSheetFits(230, 11) && UlfSheetFits(231, 12) && UlfSheetFits(16382, 16));
    EXPECT_FALSE(UlfSheetFits(231, 11) || UlfSheetFits(16385, 12));
    EXPECT_FALSE(UlfSheetFits(16383, 16)); // beyond the last column of the sheet, XFD
    T_SHEET s;
    s.name = "before";
    EXPECT_EQ(0, MakeUlfSheet(Result(1, 231), {11, 0, 0, 0, {}}, s));
    EXPECT_EQ("before", s.name);
    EXPECT_TRUE(s.cells.empty());
}

TEST(UlfCombination, ReplacesInOneAndMultipliesInSeveral)
{
    const struct {
        std::size_t entries;
        std::vector<std::size_t> sizes; // more than one: split
        double second;                  // factor of the second entry: 2 replaced, or 2 * 2
    } kCases[] = {
        {998, {998}, 2.0},
        {999, {999, 0}, 4.0}, // the empty one is meant
        {1998, {999, 999, 0}, 4.0},
    };
    for (const auto& c : kCases) {
        T_LCOM_D flat{"base", {}};
        std::map<int, double> factors;
        for (int key = 1; flat.items.size() < c.entries; ++key) {
            flat.items.push_back({false, key, 2.0});
            factors[key] = key;
        }
        const T_ULF_COMBINATION_PLAN p = PlanUlfCombinations("frame", flat, factors);
        EXPECT_EQ(c.sizes.size() > 1, p.split) << c.entries;
        ASSERT_EQ(c.sizes.size(), p.parts.size()) << c.entries;
        for (std::size_t i = 0; i < c.sizes.size(); ++i)
            EXPECT_EQ(c.sizes[i], p.parts[i].items.size()) << c.entries;
        EXPECT_EQ(p.split ? "frame-1" : "frame", p.parts[0].name);
        EXPECT_EQ((T_LCOM_ITEM{false, 2, c.second}), p.parts[0].items[1]) << c.entries;
    }
}
