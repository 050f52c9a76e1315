// Steel members that buckle, whole or in their plates, by hand from the formulas of EN 1993-1-1,
// EN 1993-1-5 and AISC 360.
#include "qm_rps/codes/slenderplates.h"
#include "qm_rps/codes/steelbuckling.h"

#include "codetesting.h"

// lambda_y = 0.5, chi_y = 0.9; 1.2, 0.6; N = 0.3: ny = 1/3, nz = 0.5. kyy = 0.9 (1 + 0.3/3) = 0.99
// in both classes; kzz of an I 0.9 (1 + 1.4 0.5), of a tube 0.9 (1 + 0.8 0.5), class 3 0.9 (1 + 0.6
// 0.5).
TEST(SteelBuckling, BendingAndCompressionOfAMember)
{
    const struct {
        STEEL_SHAPE shape;
        bool plastic;
        double ratio;
    } kCases[] = {{STEEL_SHAPE::WeldedI, true, 0.5 + 0.6 * 0.99 * 0.4 + 1.53 * 0.2},
                  {STEEL_SHAPE::RectangularTube, true, 0.5 + 0.6 * 0.99 * 0.4 + 1.26 * 0.2},
                  {STEEL_SHAPE::WeldedI, false, 0.5 + 0.8 * 0.99 * 0.4 + 1.17 * 0.2}};
    for (const auto& c : kCases) {
        CCodeSheet sheet;
        const T_EN_BEAM_COLUMN member{c.shape, c.plastic,       1.0,
                                      1.0,     {0.5, 0.9, 0.9}, {1.2, 0.6, 0.6}};
        ExpectRel(c.ratio, *EnBeamColumn(member, {0.3, -0.4, 0.2}, sheet), 1e-9, "(6.62)");
    }
    CCodeSheet sheet; // about y alone where z is stiff: (6.61)
    const T_EN_BEAM_COLUMN member{STEEL_SHAPE::WeldedI, true,           1.0, 1.0,
                                  {0.5, 0.9, 0.9},      {0.2, 1.0, 1.0}};
    ExpectRel(1.0 / 3.0 + 0.99 * 0.4, *EnBeamColumn(member, {0.3, 0.4, 0.0}, sheet), 1e-9,
              "(6.61)");
}

// IPE 600 S355: c/t = 514/12 > 42 eps: lambda_p = 42.8333/(56.8 0.813621) = 0.926859, rho =
// 0.822821. Flange plates of 300 x 8 in S355: c/t = 147.5/8 > 14 eps, lambda_p = 18.4375/(28.4
// 0.813621 sqrt(0.43)) = 1.216829, rho = 0.694839.
TEST(SteelBuckling, SlenderPlatesLoseTheirMiddle)
{
    const double web = 150.0 * 5e-6;
    const struct {
        T_STEEL_SHAPE shape;
        double lost;
    } kCases[] = {
        {{STEEL_SHAPE::RolledI, 156e-4, 0.6, 0.22, 0.019, 0.012, 0.024}, 0.177179 * 0.514 * 0.012},
        {{STEEL_SHAPE::WeldedI, 48e-4 + web, 0.166, 0.3, 0.008, 0.005, 0.0},
         0.305161 * 4.0 * 0.1475 * 0.008},
        {{STEEL_SHAPE::RolledI, 28.48e-4, 0.2, 0.1, 8.5e-3, 5.6e-3, 12e-3}, 0.0}};
    for (const auto& c : kCases) {
        CCodeSheet sheet;
        ExpectRel(c.shape.A - c.lost, *EnCompressedArea(c.shape, 355e6, sheet), 1e-6, "Aeff");
    }
    CCodeSheet sheet;
    EXPECT_FALSE(
        EnCompressedArea({STEEL_SHAPE::CircularTube, 0.01, 0.5, 0.5, 4e-3, 4e-3}, 355e6, sheet));
}
