#include "numbers.h"
#include "qm_db/sectionproperties.h"

#include <cmath>
#include <gtest/gtest.h>
#include <numbers>

namespace {

using std::numbers::pi;

T_SECT_D Shape(SECT_SHAPE shape, std::array<double, 4> size)
{
    T_SECT_D s;
    s.shape = shape;
    s.size = size;
    return s;
}
const T_SECT_D kI = Shape(SECT_SHAPE::IShape, {300, 150, 7.1, 10.7});

} // namespace

TEST(SectionProperties, AreTheHandValuesOfEachShape)
{
    struct T_CASE {
        const char* label;
        T_SECT_D section;
        double A, Asy, Asz, J, Iyy, Izz, Zy, Zz;
    };
    // Rectangle torsion: 0.1406 a4 and 0.229 * 2 b4 (Timoshenko and Goodier, section 109, table).
    // Box: J = 2 (290 * 192)^2 / (290 / 8 + 192 / 10).
    const T_CASE cases[] = {
        {"rectangle", Shape(SECT_SHAPE::Rectangle, {200, 100}), 2e4, 16666.667, 16666.667, 0.458e8,
         66666667, 16666667, 1e6, 5e5},
        {"circle", Shape(SECT_SHAPE::Circle, {200}), 31415.927, 28274.334, 28274.334, 157079633,
         78539816, 78539816, 1333333.3, 1333333.3},
        {"pipe", Shape(SECT_SHAPE::Pipe, {200, 10}), 5969.026, 2984.513, 2984.513, 54019686,
         27009843, 27009843, 361333.33, 361333.33},
        {"box", Shape(SECT_SHAPE::Box, {300, 200, 8, 10}), 8480, 4000, 4800, 111821908, 113402666.7,
         54644906.7, 893600, 630080},
        {"I", kI, 5188.06, 2675, 2130, 155742.3, 79989869.5, 6027059.5, 602098.38, 123886.06},
    };
    for (const T_CASE& c : cases) {
        T_SECT_D r;
        SECT_FAULT fault;
        ASSERT_EQ(1, CSectionProperties::Calc(c.section, r, fault)) << c.label;
        const double got[] = {r.area, r.Asy, r.Asz, r.Iyy, r.Izz, r.Zy, r.Zz};
        const double want[] = {c.A, c.Asy, c.Asz, c.Iyy, c.Izz, c.Zy, c.Zz};
        for (int i = 0; i < 7; ++i)
            EXPECT_NEAR(want[i], got[i], 1e-6 * want[i]) << c.label << ' ' << i;
        EXPECT_NEAR(c.J, r.J, 2e-3 * c.J) << c.label; // the table prints three or four digits
    }
}

TEST(SectionProperties, KeepEnteredValuesAndRefuseImpossibleDimensions)
{
    T_SECT_D value, out;
    value.area = 7, value.J = 5, value.Zz = 3;
    SECT_FAULT fault;
    EXPECT_EQ(1, CSectionProperties::Calc(value, out, fault));
    EXPECT_EQ(value, out);
    value.Iyy = -1;
    EXPECT_EQ(0, CSectionProperties::Calc(value, out, fault));
    EXPECT_EQ(SECT_FAULT::Values, fault);
    const T_SECT_D before = out;
    using S = SECT_SHAPE;
    for (const T_SECT_D& s :
         {Shape(S::Rectangle, {0, 10}), Shape(S::Rectangle, {10, kNan}), Shape(S::Circle, {-1}),
          Shape(S::Pipe, {20, 10}), Shape(S::Box, {30, 20, 10, 1}), Shape(S::Box, {30, 20, 1, 15}),
          Shape(S::IShape, {30, 20, 21, 1}), Shape(S::IShape, {30, 20, 1, 15})}) {
        EXPECT_EQ(0, CSectionProperties::Calc(s, out, fault)) << s.size[0] << ' ' << s.size[1];
        EXPECT_EQ(SECT_FAULT::Dimensions, fault);
        EXPECT_EQ(before, out);
    }
}

// EN 1993-1-1 6.2.6(3) d, e, g by hand; solid sections by first yield, 6.2.6(4).
TEST(SectionProperties, ShearAreasOfStrengthAreThoseOfTheCode)
{
    using S = SECT_SHAPE;
    T_SECT_D value;
    value.Asy = 11, value.Asz = 12;
    const struct {
        T_SECT_D section;
        double y, z;
    } cases[] = {{kI, 3210, 1978.06}, // 2 * 150 * 10.7; 278.6 * 7.1
                 {Shape(S::Box, {300, 200, 8, 10}), 4000, 4480},
                 {Shape(S::Pipe, {200, 10}), 3800, 3800}, // 2 (190 * 10)
                 {Shape(S::Rectangle, {200, 90}), 12000, 12000},
                 {Shape(S::Circle, {200}), 7500 * pi, 7500 * pi},
                 {value, 11, 12}};
    for (const auto& c : cases) {
        T_SECT_D s;
        SECT_FAULT fault{};
        ASSERT_EQ(1, CSectionProperties::Calc(c.section, s, fault));
        EXPECT_NEAR(c.y, CSectionProperties::StrengthShearAreas(s).y, 1e-9 * c.y);
        EXPECT_NEAR(c.z, CSectionProperties::StrengthShearAreas(s).z, 1e-9 * c.z);
    }
}
