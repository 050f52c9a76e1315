#include "qm_rps/pushover/fema440coefficients.h"

#include "qm_rps/pushover/fema440workingspectrum.h"

#include <cmath>
#include <gtest/gtest.h>

TEST(Fema440Coefficients, RowFollowsHysteresisModelAndStiffnessRatio)
{
    struct T_CASE {
        int type;
        double alpha;
        int row;
    };
    // clang-format off
    const T_CASE cases[] = {
        {0, -1.0, 0}, {0, 0.0, 0}, {0, 1e-9, 1}, {0, 0.05, 1}, {0, 2.0, 1}, {0, 2.001, 2},
        {0, 5.0, 2}, {0, 5.001, 3}, {0, 10.0, 3}, {0, 10.001, 4}, {0, 1e9, 4},
        {1, -1.0, 5}, {1, 0.0, 5}, {1, 1e-9, 6}, {1, 2.0, 6}, {1, 5.0, 7}, {1, 10.0, 8},
        {1, 10.001, 9}, {2, -3.001, 10}, {2, -3.0, 11}, {2, 0.05, 11}, {2, 99.0, 11},
        {3, -99.0, 12}, {3, 99.0, 12}, {4, 0.0, 12}, {-1, 0.0, 12},
    };
    // clang-format on
    for (const T_CASE& c : cases)
        EXPECT_EQ(c.row, Fema440RowIndex(c.type, c.alpha)) << c.type << " " << c.alpha;
    EXPECT_EQ("stiffness degrading, alpha <= 2", Fema440RowText(6));
    EXPECT_EQ("strength degrading, alpha < -3", Fema440RowText(10));
}

// FEMA 440 (6-1) to (6-9) worked from printed Tables 6-1 and 6-2 by a separate script: T0 = 1 s,
// Teff and damping at mu = 3, 5 and 8; the damping at mu = 8 with Teff = 1.5 s.
TEST(Fema440Coefficients, EveryRowHasItsPeriodAndDampingInEveryRange)
{
    struct T_ROW {
        int row;
        double T3, beta3, T5, beta5, T8, beta8;
    };
    // clang-format off
    const T_ROW rows[] = {
        { 0, 1.304, 12.52, 1.630, 16.48, 1.938078, 11.728777},
        { 1, 1.288, 13.08, 1.650, 18.80, 2.005000, 14.594960},
        { 2, 1.296, 15.16, 1.650, 21.40, 2.016768, 16.364796},
        { 3, 1.344, 16.60, 1.670, 23.40, 1.949736, 17.925170},
        { 4, 1.280, 15.48, 1.546, 21.40, 1.768090, 18.332762},
        { 5, 1.424, 16.60, 1.860, 22.60, 2.398889, 12.979571},
        { 6, 1.448, 16.60, 1.860, 22.40, 2.320000, 14.074218},
        { 7, 1.424, 17.00, 1.790, 22.20, 2.214839, 15.557409},
        { 8, 1.408, 16.60, 1.740, 21.80, 2.058901, 16.199520},
        { 9, 1.304, 15.40, 1.550, 19.80, 1.783765, 17.607690},
        {10, 1.496, 17.00, 1.930, 21.44, 2.535217, 11.609977},
        {11, 1.456, 16.60, 1.890, 21.76, 2.460525, 12.210884},
        {12, 1.496, 15.80, 1.800, 20.28, 2.175225, 12.412408},
    };
    // clang-format on
    for (const T_ROW& r : rows) {
        const T_FEMA440_ROW& c = Fema440Row(r.row);
        const double expected[][3] = {
            {3.0, r.T3, r.beta3}, {5.0, r.T5, r.beta5}, {8.0, r.T8, r.beta8}};
        for (int range = 0; range < 3; ++range) {
            const auto& [mu, period, damping] = expected[range];
            EXPECT_EQ(range, Fema440DuctilityRange(mu));
            double Teff = 0.0, beta = 0.0;
            EXPECT_EQ(1, CalcFema440Period(c, range, 1.0, mu, Teff));
            EXPECT_NEAR(period, Teff, 5e-7) << r.row << " range " << range;
            EXPECT_EQ(1, CalcFema440Damping(c, range, 2.0, 3.0, mu, beta)); // Teff / T0 = 1.5
            EXPECT_NEAR(damping, beta, 5e-7) << r.row << " range " << range;
        }
    }
}

TEST(Fema440Coefficients, RangesMeetAt4And6Point5)
{
    const double above = std::nextafter(6.5, 9.0), below = std::nextafter(4.0, 0.0);
    const std::pair<double, int> cases[] = {{below, 0}, {4.0, 1}, {6.5, 1}, {above, 2}};
    for (const auto& [mu, range] : cases)
        EXPECT_EQ(range, Fema440DuctilityRange(mu)) << mu;
}

TEST(Fema440Coefficients, RefusesWhatHasNoRealValueAndLeavesTheOutputAlone)
{
    double v = 7.0;
    EXPECT_EQ(0, CalcFema440Period(Fema440Row(0), 3, 1.0, 3.0, v));
    EXPECT_EQ(0, CalcFema440Damping(Fema440Row(0), 3, 1.0, 1.0, 3.0, v));
    // Strength degrading: 1 + L (mu - 2) falls below 0 at mu = 35.3 (L = -0.03) and 22 (-0.05).
    EXPECT_EQ(1, CalcFema440Period(Fema440Row(11), 2, 1.0, 35.3, v));
    v = 7.0;
    EXPECT_EQ(0, CalcFema440Period(Fema440Row(11), 2, 1.0, 35.4, v));
    EXPECT_EQ(0, CalcFema440Period(Fema440Row(10), 2, 1.0, 22.1, v));
    EXPECT_EQ(0, CalcFema440Damping(Fema440Row(0), 2, 1.0, 1.0, 1.0, v)) << "mu = 1: 0 / 0";
    EXPECT_EQ(0, CalcFema440B(0.0, v));
    EXPECT_EQ(0, CalcFema440M(1.5, 1.0, 0.1, 0.0, v));
    EXPECT_EQ(0, CalcFema440M(1.5, 0.0, 0.1, 4.0, v));
    EXPECT_EQ(7.0, v);
}

TEST(Fema440Coefficients, ReductionAndMadrsFactors)
{
    const double worked[][2] = {{5.0, 1.002365}, {10.0, 1.213071}, {12.52, 1.301798}}; // (6-17)
    for (const auto& [beta, B] : worked) {
        double v = 0.0;
        EXPECT_EQ(1, CalcFema440B(beta, v));
        EXPECT_NEAR(B, v, 5e-7) << beta;
    }
    double M = 0.0;
    EXPECT_EQ(1, CalcFema440M(3.0, 2.0, 0.1, 4.0, M)); // 2.25 * 1.3 / 4
    EXPECT_NEAR(0.73125, M, 1e-15);
}
