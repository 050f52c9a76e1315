// Named shapes and grades, against printed tables.
#include "casetext.h"
#include "qm_db/sectionproperties.h"

namespace {

T_SECT_D Properties(const std::string& name)
{
    const std::optional<T_SECT_D> shape = NamedShape(name);
    EXPECT_TRUE(shape) << name;
    T_SECT_D s;
    SECT_FAULT fault = SECT_FAULT::None;
    EXPECT_EQ(1, CSectionProperties::Calc(shape.value_or(s), s, fault)) << name;
    return s;
}

std::string Model(const std::string& section, const std::string& material)
{
    return R"({"format": "qm-rps case 1", "units": {"force": "kN", "length": "mm"}, "nodes": [],)"
           R"("materials": [{"name": "M", )" +
           material + R"(}], "sections": [{"name": "S", )" + section + "}]}";
}

std::string Fault(const std::string& section, const std::string& material)
{
    T_MODEL_CONTENT content;
    T_FILE_ERROR error;
    EXPECT_EQ(0, CCaseFile::Parse(Model(section, material), "c.json", "", content, error));
    return error.text;
}

} // namespace

// A, Iy, Iz (cm) of public tables of EN 10365, EN 10210-2 and EN 10219-2, and Wpl,y; half a unit of
// their last digit.
TEST(SteelShapes, HaveThePropertiesOfPrintedTables)
{
    const struct {
        const char* name;
        double A, dA, Iy, dIy, Iz, dIz, Wy, dWy;
    } kRows[] = {
        {"IPE 80", 7.64, 0.005, 80.1, 0.05, 8.49, 0.005, 23.2, 0.05},
        {"IPE 300", 53.8, 0.05, 8360, 5, 604, 0.5, 628, 0.5},
        {"ipe600", 156, 0.5, 92080, 5, 3390, 5, 3510, 5},
        {"HEA 200", 53.8, 0.05, 3690, 5, 1340, 5, 430, 0.6},
        {"HEA 500", 197.5, 0.05, 86970, 5, 10370, 5, 3949, 0.6},
        {"HEB 300", 149, 0.5, 25170, 5, 8560, 5, 1870, 5},
        {"HEB 1000", 400, 0.5, 644700, 50, 16280, 5, 14860, 6},
        {"HEM 300", 303, 0.5, 59200, 50, 19400, 50, 4080, 5},
        {"SHS 100x5", 18.7, 0.05, 0, 0, 0, 0, 0, 0},
        {"SHS 120x120x5", 22.7, 0.05, 0, 0, 0, 0, 0, 0},
        {"CFSHS 80x4", 11.7, 0.05, 0, 0, 0, 0, 0, 0},
        {"CFRHS 200x100x8", 43.2, 0.05, 0, 0, 0, 0, 0, 0},
        {"CHS 168.3x8", 40.3, 0.05, 0, 0, 0, 0, 0, 0},
    };
    for (const auto& row : kRows) {
        const T_SECT_D s = Properties(row.name);
        EXPECT_NEAR(row.A, 1e4 * s.area, row.dA) << row.name;
        if (row.Iy == 0) continue;
        EXPECT_NEAR(row.Iy, 1e8 * s.Iyy, row.dIy) << row.name;
        EXPECT_NEAR(row.Iz, 1e8 * s.Izz, row.dIz) << row.name;
        EXPECT_NEAR(row.Wy, 1e6 * s.Zy, row.dWy) << row.name;
    }
}

TEST(SteelShapes, NamesThatNoTableHasAreNone)
{
    for (const char* name : {"", "IPE", "IPE 310", "HEM 600", "CHS", "CHS 100", "CHS 100x60",
                             "SHS 100x80x5", "RHS 100x5", "RHS 200x100x40", "CFRHS 200x100x12.5",
                             "SHS 100x-5", "RHS 200x100xnan", "SHS 100x5x", "W14X91", "UPN 210"})
        EXPECT_FALSE(NamedShape(name)) << name;
}

TEST(SteelShapes, ACaseFileNamesThemAndHoldsTheirDimensions)
{
    const T_MODEL_CONTENT content = ParseGood(Model(
        R"("shape": "RHS 200x100x8")", R"("type": "concrete", "E": 20, "grade": "C25/30 B450C")"));
    const T_SECT_D& s = content.model.sections.begin()->second;
    EXPECT_EQ(SECT_SHAPE::Box, s.shape);
    EXPECT_NEAR(0.012, s.fillet, 1e-15);
    const T_MATL_D& m = content.model.materials.begin()->second;
    EXPECT_NEAR(25e6, m.fck, 1);
    EXPECT_NEAR(450e6, m.fyk, 1);
    EXPECT_NEAR(20e9, m.E, 1); // as given
    EXPECT_EQ(content.model.sections.begin()->second,
              ParseGood(PrintGood(content)).model.sections.begin()->second);
    const T_MODEL_CONTENT channel = ParseGood(Model(R"("shape": "upn200")", R"("E": 1)"));
    EXPECT_EQ(0.08, channel.model.sections.begin()->second.taper);
    EXPECT_EQ(channel.model.sections.begin()->second,
              ParseGood(PrintGood(channel)).model.sections.begin()->second);
    EXPECT_NE(std::string::npos, Fault(R"("shape": "W14X91")", R"("E": 1)").find("W14X90"));
    const T_MATL_D steel =
        ParseGood(Model(R"("A": 1)", R"("grade": "S275/40")")).model.materials.begin()->second;
    EXPECT_EQ(MATL_CLASS::Steel, steel.type);
    EXPECT_NEAR(265e6, steel.Fy, 1);
    // EN 1992-1-1 Table 3.1, GPa; without a class the material is of concrete.
    const T_MATL_D concrete =
        ParseGood(Model(R"("A": 1)", R"("grade": "C50/60")")).model.materials.begin()->second;
    EXPECT_EQ(MATL_CLASS::Concrete, concrete.type);
    EXPECT_NEAR(37e9, concrete.E, 0.5e9);
}

TEST(SteelShapes, WhatCannotBeMeantIsRefusedWithItsPlace)
{
    const struct {
        const char *section, *material, *place;
    } kRows[] = {
        {R"("shape": "IPE 301")", R"("E": 1)", "shape"},
        {R"("shape": "IPE 300", "size": [300, 150, 7, 10])", R"("E": 1)", "size"},
        {R"("shape": "I", "size": [300, 150, 7, 10], "fillet": 80)", R"("E": 1)", "fillet"},
        {R"("shape": "rectangle", "size": [300, 150], "fillet": 8)", R"("E": 1)", "fillet"},
        {R"("shape": "I", "size": [300, 150, 7, 10], "taper": 0.08)", R"("E": 1)", "taper"},
        {R"("shape": "UPN 200", "taper": 0.05)", R"("E": 1)", "taper"},
        {R"("A": 1)", R"("grade": "S360")", "grade"},
        {R"("A": 1)", R"("type": "steel", "grade": "C25/30")", "grade"},
        {R"("A": 1)", R"("grade": "B500B")", "grade"},
        {R"("A": 1)", R"("grade": "C25/30 C30/37")", "grade"},
        {R"("A": 1)", R"("grade": 355)", "grade"},
    };
    for (const auto& row : kRows)
        EXPECT_NE(std::string::npos, Fault(row.section, row.material).find(row.place))
            << row.section << row.material;
}
