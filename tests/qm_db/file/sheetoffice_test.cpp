// A written sheet lives in an office program: formulas are formulas and texts stay texts.
#include "office.h"
#include "tempfolder.h"

#include "qm_db/sheetfile.h"

#include <gtest/gtest.h>

namespace {

/// Two factors in B, a 2 x 2 matrix in C and D, its product with the factors in row 1.
T_SHEET Product(double stored)
{
    T_SHEET sheet;
    const double factors[] = {0.1, -2.5}, matrix[2][2] = {{3.0, 1e-3}, {4.0, 2e6}};
    for (std::size_t i = 0; i < 2; ++i) {
        sheet.cells[{i + 1, 1}] = {factors[i], {.input = true, .numberFormat = "0.00"}};
        for (std::size_t j = 0; j < 2; ++j)
            sheet.cells[{i + 1, j + 2}].value = matrix[i][j];
    }
    sheet.cells[{0, 2}].value = T_SHEET_FORMULA{"=SUMPRODUCT(B2:B3,C2:C3)+0.5", stored};
    sheet.cells[{0, 3}].value = T_SHEET_FORMULA{"=SUMPRODUCT(B2:B3,D2:D3)", -4999999.9999};
    const char* kTexts[] = {"=1+1", "+A1", "-2", "@SUM(1)"};
    for (std::size_t i = 0; i < 4; ++i)
        sheet.cells[{4, i}].value = std::string(kTexts[i]);
    FrameBlock(sheet, {0, 0, 4, 3}, SHEET_EDGE::Thin);
    return sheet;
}

TEST(SheetOffice, FormulasAreCalculatedAnewAndTextsStayTexts)
{
    if (!COffice::IsThere()) GTEST_SKIP() << "soffice or python3 is not installed";
    const COffice office;
    const CTempFolder folder;
    const std::string path = folder / "product.xlsx";
    T_FILE_ERROR error;
    ASSERT_TRUE(WriteSheet(path, Product(999.0), error)) << error.text;
    const OFFICE_CELLS cells = office.Recalculated(path);
    ASSERT_EQ(5U, cells.size());
    // By hand: 0.1 * 3 - 2.5 * 4 + 0.5 = -9.2. The stored 999 is wrong on purpose: it must go.
    EXPECT_DOUBLE_EQ(-9.2, std::stod(cells[0][2]));
    EXPECT_DOUBLE_EQ(-4999999.9999, std::stod(cells[0][3])) << "0.1 * 1e-3 - 2.5 * 2e6";
    EXPECT_EQ((std::vector<std::string>{"=1+1", "+A1", "-2", "@SUM(1)"}), cells[4]);
    EXPECT_EQ("=SUMPRODUCT(B2:B3,C2:C3)+0.5", office.Formulas(path)[0][2]);

    ASSERT_TRUE(COffice::PutNumber(path, "B3", 1.5));
    EXPECT_DOUBLE_EQ(0.1 * 3 + 1.5 * 4 + 0.5, std::stod(office.Recalculated(path)[0][2]));
    EXPECT_FALSE(COffice::PutNumber(path, "B9", 1.5)) << "no such cell";
}

} // namespace
