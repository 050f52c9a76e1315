// The spreadsheet file: what is in it, what is refused, what stays on the disk.
#include "qm_db/sheetfile.h"

#include "numbers.h"
#include "tempfolder.h"

#include "qm_db/filectrl.h"

#include <gtest/gtest.h>
#include <unistd.h>

namespace fs = std::filesystem;

namespace {

class SheetFile : public testing::Test {
protected:
    std::string Path(const std::string& name) const { return m_folder / name; }
    std::string Bytes(const std::string& name) const { return ReadText(Path(name)); }

    CTempFolder m_folder;
};

T_SHEET Small()
{
    T_SHEET sheet;
    sheet.cells[{0, 0}].value = std::string("=1+1");
    sheet.cells[{0, 1}].value = 2.5;
    sheet.cells[{1, 1}].value = T_SHEET_FORMULA{"=B1*2", 5.0};
    return sheet;
}

TEST(SheetName, ColumnsCountInLettersWithoutAZero)
{
    const struct {
        std::size_t column;
        const char* name;
    } kRows[] = {{0, "A"},   {2, "C"},    {25, "Z"},   {26, "AA"},   {51, "AZ"},
                 {52, "BA"}, {255, "IV"}, {701, "ZZ"}, {702, "AAA"}, {16383, "XFD"}};
    for (const auto& row : kRows)
        EXPECT_EQ(row.name, SheetColumn(row.column));
    EXPECT_EQ("C11", SheetAddress(10, 2));
    EXPECT_EQ("XFD1048576", SheetAddress(kSheetRows - 1, kSheetColumns - 1));
}

TEST(SheetEdges, OfOneCellAddUp)
{
    T_SHEET sheet = Small();
    FrameBlock(sheet, {0, 0, 2, 2}, SHEET_EDGE::Thin);
    EdgeBelow(sheet, {0, 0, 1, 2}, SHEET_EDGE::Double);
    EdgeRight(sheet, {0, 0, 2, 1}, SHEET_EDGE::Double);
    const auto edges = [&](SHEET_AT at) {
        const T_SHEET_STYLE& s = sheet.cells.at(at).style;
        return std::array{s.left, s.top, s.right, s.bottom};
    };
    using E = SHEET_EDGE;
    EXPECT_EQ((std::array{E::None, E::None, E::Double, E::Double}), edges({1, 1}));
    EXPECT_EQ((std::array{E::Thin, E::None, E::None, E::Double}), edges({1, 0}));
    EXPECT_EQ(SHEET_EDGE::Thin, sheet.cells.at({2, 2}).style.bottom);
    EXPECT_EQ(SHEET_VALUE{2.5}, sheet.cells.at({0, 1}).value) << "values stay";
}

TEST_F(SheetFile, TheSameSheetGivesTheSameBytesAndLeavesNothingElse)
{
    T_FILE_ERROR error;
    ASSERT_TRUE(WriteSheet(Path("a.xlsx"), Small(), error)) << error.text;
    ::usleep(1100000); // a date in the file would now be another one
    ASSERT_TRUE(WriteSheet(Path("b.xlsx"), Small(), error)) << error.text;
    EXPECT_EQ(Bytes("a.xlsx"), Bytes("b.xlsx"));
    EXPECT_TRUE(Bytes("a.xlsx").starts_with("PK"));
    EXPECT_EQ((std::vector<std::string>{"a.xlsx", "b.xlsx"}), m_folder.Names());
}

TEST_F(SheetFile, BadContentIsRefusedWithItsCellAndTheOldFileStays)
{
    const struct {
        const char* label;
        SHEET_AT at;
        SHEET_VALUE value;
        const char* says;
    } kRows[] = {
        {"nan", {4, 2}, kNan, "C5"},
        {"infinity", {4, 2}, -kInf, "C5"},
        {"formula of nan", {0, 27}, T_SHEET_FORMULA{"=A1", kNan}, "AB1"},
        {"formula without text", {0, 27}, T_SHEET_FORMULA{"=", 0.0}, "AB1"},
        {"row", {kSheetRows, 0}, 1.0, "A1048577"},
        {"column", {0, kSheetColumns}, 1.0, "XFE1"},
        {"long text", {0, 0}, std::string(32768, 'x'), "A1"},
    };
    T_FILE_ERROR error;
    ASSERT_TRUE(WriteSheet(Path("old.xlsx"), Small(), error)) << error.text;
    const std::string before = Bytes("old.xlsx");
    for (const auto& row : kRows) {
        T_SHEET sheet = Small();
        sheet.cells[row.at].value = row.value;
        error = {};
        EXPECT_FALSE(WriteSheet(Path("old.xlsx"), sheet, error)) << row.label;
        EXPECT_EQ(FILE_FAULT::BadInput, error.fault) << row.label;
        EXPECT_NE(std::string::npos, error.text.find(row.says)) << row.label << ": " << error.text;
    }
    T_SHEET named = Small();
    for (const char* name : {"", "a/b", "a name that has more than 31 letters"}) {
        named.name = name;
        EXPECT_FALSE(WriteSheet(Path("old.xlsx"), named, error)) << name;
    }
    EXPECT_EQ(before, Bytes("old.xlsx"));
    EXPECT_EQ(std::vector<std::string>{"old.xlsx"}, m_folder.Names());
}

TEST_F(SheetFile, AFileThatAnOfficeProgramHasOpenIsLeftAlone)
{
    T_FILE_ERROR error;
    ASSERT_TRUE(WriteSheet(Path("a.xlsx"), Small(), error)) << error.text;
    const std::string before = Bytes("a.xlsx");
    T_SHEET other = Small();
    other.cells[{0, 1}].value = 3.0;
    for (const char* mark : {".~lock.a.xlsx#", "~$a.xlsx"}) {
        ASSERT_TRUE(CFileCtrl::WriteWholeFile(Path(mark), "somebody", error));
        EXPECT_FALSE(WriteSheet(Path("a.xlsx"), other, error)) << mark;
        EXPECT_EQ(FILE_FAULT::NoAccess, error.fault);
        EXPECT_NE(std::string::npos, error.text.find(mark)) << error.text;
        fs::remove(Path(mark));
    }
    EXPECT_EQ(before, Bytes("a.xlsx"));
    EXPECT_TRUE(WriteSheet(Path("a.xlsx"), other, error)) << error.text;
    EXPECT_FALSE(WriteSheet(Path("no/such/folder.xlsx"), other, error));
    EXPECT_EQ(FILE_FAULT::NoAccess, error.fault);
    EXPECT_FALSE(WriteSheet(Path("."), other, error)) << "a folder";
}

} // namespace
