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

// S275: eps = 0.924416. Web of 960 x 6: lambda_w = 160/(86.4 eps) = 2.003266, chi_w = 0.414323. Box
// 500 x 200 x 4: 123 along its depth, lambda_w = 1.540011, chi_w = 0.538957; 48 across: Vpl.
TEST(SteelBuckling, SlenderWebsHaveTheirBucklingStrengthInShear)
{
    const double shear = 275e6 / std::sqrt(3.0);
    const T_STEEL_SHAPE deep{STEEL_SHAPE::WeldedI, 0.01776, 1.0, 0.3, 0.02, 0.006, 0.0};
    const T_STEEL_SHAPE box{STEEL_SHAPE::RectangularTube, 0.005536, 0.5, 0.2, 0.004, 0.004, 0.0};
    const T_STEEL_SHAPE ipe{STEEL_SHAPE::RolledI, 28.48e-4, 0.2, 0.1, 8.5e-3, 5.6e-3, 12e-3};
    const struct {
        const T_STEEL_SHAPE& shape;
        bool alongDepth;
        double area;
    } kCases[] = {{deep, true, 0.414323 * 0.96 * 0.006},
                  {deep, false, 0.012},
                  {box, true, 0.538957 * 2.0 * 0.492 * 0.004},
                  {box, false, 0.005536 * 0.2 / 0.7},
                  {ipe, true, 28.48e-4 - 1.7e-3 + 0.0296 * 8.5e-3}};
    for (const auto& c : kCases) {
        CCodeSheet sheet;
        ExpectRel(c.area * shear, *EnShearStrength(c.shape, c.alongDepth, 275e6, sheet), 5e-6, "V");
    }
}

// Fy 303, E 210000: tube 200 x 200 x 3 at Fcr 192: Fel = (1.38 36.8567/64.6667)^2 303 = 187.444,
// be/b = 0.792811; I with flanges of 300 x 8 and a web of 284 x 5 at 250: flange 18.75 against
// 0.378 26.3262 sqrt(303/250): Fel = (1.49 9.95131/18.75)^2 303 = 189.484, be/b = 0.703849;
// web 56.8 against 1.49 26.3262 (43.18 with the root): Fel = (1.31 39.2261/56.8)^2 303 = 247.992,
// be/b = 0.817422. Pipe 300 x 3: 0.038 693.069/100 + 2/3.
TEST(SteelBuckling, EffectiveWidthsOfAisc)
{
    const double E = 210e9, Fy = 303e6;
    const T_STEEL_SHAPE tube{STEEL_SHAPE::RectangularTube, 23.64e-4, 0.2, 0.2, 3e-3, 3e-3, 0.0};
    const T_STEEL_SHAPE i{STEEL_SHAPE::WeldedI, 62.2e-4, 0.3, 0.3, 8e-3, 5e-3, 0.0};
    const T_STEEL_SHAPE pipe{STEEL_SHAPE::CircularTube, 0.0028, 0.3, 0.3, 3e-3, 3e-3, 0.0};
    const T_STEEL_SHAPE thin{STEEL_SHAPE::CircularTube, 0.0028, 0.3, 0.3, 9e-4, 9e-4, 0.0};
    const struct {
        const T_STEEL_SHAPE& shape;
        double Fcr, lost;
    } kCases[] = {
        {tube, 192e6, 0.207189 * 4.0 * 0.194 * 3e-3},
        {i, 250e6, 0.296151 * 4.0 * 0.15 * 8e-3 + 0.182578 * 0.284 * 5e-3},
        {i, 60e6, 0.0},
        {pipe, 192e6, (1.0 - 0.26336634 - 2.0 / 3.0) * 0.0028},
    };
    for (const auto& c : kCases) {
        CCodeSheet sheet;
        ExpectRel(c.shape.A - c.lost, *AiscCompressedArea(c.shape, c.Fcr, Fy, E, sheet), 2e-6,
                  "Ae");
    }
    CCodeSheet sheet;
    EXPECT_FALSE(AiscCompressedArea(thin, 192e6, Fy, E, sheet));
}
