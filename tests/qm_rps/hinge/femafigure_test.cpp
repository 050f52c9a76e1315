// The figures say what they claim to: areas, peaks and stiffnesses are measured on their curves.
#include "qm_rps/po_femastrlossfigure0dlg.h"
#include "qm_rps/po_femaunloadstifffigureedlg.h"

#include <cmath>
#include <gtest/gtest.h>

namespace {

using POINTS = std::vector<T_FIGURE_POINT>;

/// Area inside a closed line (shoelace).
double AreaOf(const POINTS& line)
{
    double twice = 0.0;
    for (std::size_t i = 1; i < line.size(); ++i)
        twice += line[i - 1].x * line[i].y - line[i].x * line[i - 1].y;
    return std::abs(twice) / 2.0;
}

/// Strengths where the response turns on the positive side, in their order.
std::vector<T_FIGURE_POINT> Peaks(const POINTS& line)
{
    std::vector<T_FIGURE_POINT> peaks;
    for (std::size_t i = 1; i + 1 < line.size(); ++i)
        if (line[i].x > line[i - 1].x && line[i].x > line[i + 1].x) peaks.push_back(line[i]);
    return peaks;
}

} // namespace

TEST(FemaFigure, LoopsOfOneEnergyHaveOneAreaWhateverTheUnloadingFactor)
{
    const double full = AreaOf(DegradedLoop(4.0, 1.0, 0.0));
    EXPECT_DOUBLE_EQ(12.0, full); // 4 Fy Dy (ductility - 1)
    for (const double energy : {0.3, 0.6, 1.0})
        for (const double factor : {-1.0, -0.4, 0.0, 0.7, 1.0}) {
            const POINTS loop = DegradedLoop(4.0, energy, factor);
            EXPECT_NEAR(energy * full, AreaOf(loop), 1e-12) << energy << " " << factor;
            const double slope = (loop[0].y - loop[1].y) / (loop[0].x - loop[1].x);
            EXPECT_NEAR(slope, UnloadingStiffness(4.0, energy, factor), 1e-12);
        }
}

TEST(FemaFigure, TheUnloadingFactorTradesStiffnessForElasticRange)
{
    // -1: initial stiffness, elastic range 2 x 0.6; +1: the whole range, 1 / (4 - 0.6 x 3).
    EXPECT_NEAR(1.0, UnloadingStiffness(4.0, 0.6, -1.0), 1e-12);
    EXPECT_NEAR(1.0 - 1.2, DegradedLoop(4.0, 0.6, -1.0)[1].y, 1e-12);
    EXPECT_NEAR(1.0 / 2.2, UnloadingStiffness(4.0, 0.6, 1.0), 1e-12);
    EXPECT_NEAR(-1.0, DegradedLoop(4.0, 0.6, 1.0)[1].y, 1e-12);
    EXPECT_EQ("Ku = 0.45 K0", CPO_FEMAUnloadStiffFigureEDlg().Points().back().label);
}

TEST(FemaFigure, StrengthLossRepeatsWithoutCyclicDegradationAndFallsWithIt)
{
    const auto plain = Peaks(CyclicResponse(false)), cyclic = Peaks(CyclicResponse(true));
    ASSERT_EQ(6U, plain.size());
    ASSERT_EQ(6U, cyclic.size());
    for (std::size_t i = 0; i < 6; ++i) {
        EXPECT_EQ(FigureAmplitudes()[i], plain[i].x);
        EXPECT_NEAR(FigureStrength(plain[i].x), plain[i].y, 1e-12) << i; // on the backbone
        EXPECT_LE(cyclic[i].y, plain[i].y) << i;
    }
    for (const std::size_t repeated : {1U, 3U, 5U})
        EXPECT_LT(cyclic[repeated].y, cyclic[repeated - 1].y - 1e-3) << repeated;
    EXPECT_NEAR(1.0 + 0.15 * 3.0 / 3.5, plain[2].y, 1e-12); // between B and C
    EXPECT_EQ(0.5, plain[4].y);                             // past D
}

TEST(FemaFigure, TheBackboneIsDrawnOnBothSides)
{
    const auto curves = CPO_FEMAStrLossFigure0Dlg().Curves();
    ASSERT_EQ(2U, curves.size());
    const POINTS& line = curves[0].points;
    ASSERT_EQ(11U, line.size());
    for (std::size_t i = 0; i < line.size(); ++i) {
        EXPECT_EQ(line[i].x, -line[10 - i].x);
        EXPECT_EQ(line[i].y, -line[10 - i].y);
    }
    EXPECT_EQ(0.0, FigureStrength(9.0)); // after E
}
