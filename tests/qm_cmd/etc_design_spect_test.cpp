#include "qm_cmd/etc_design_spect.h"

#include <cmath>
#include <gtest/gtest.h>

namespace {

using DOUBLES = std::vector<double>;

std::unique_ptr<CETC_DESIGN_SPECT> Make(decltype(T_SPFC_D::data) data, int behavior = 0,
                                        LIMIT_STATE state = LIMIT_STATE::SLV)
{
    return MakeDesignSpectrum({"D", std::move(data)}, behavior, state);
}

/// Ordinate of an array pair at a period that it holds.
double At(const DOUBLES& T, const DOUBLES& Sa, double period)
{
    for (std::size_t i = 0; i < T.size(); ++i) {
        if (std::fabs(T[i] - period) < 1e-9) return Sa[i];
    }
    ADD_FAILURE() << "no period " << period;
    return NAN;
}

const T_SPFC_USER kTable{{0.0, 0.5, 1.0, 1.5, 2.0}, {0.2, 0.8, 0.8, 0.5, 0.2}, {}};

} // namespace

TEST(DesignSpectrum, Atc40HasRampPlateauAndHyperbola)
{
    const auto s = Make(T_SPFC_ATC40{0.4, 0.4, {}}); // Ts = 0.4, T0 = 0.08, plateau 1
    EXPECT_DOUBLE_EQ(0.4, s->CornerPeriod());
    const double worked[][2] = {{0.0, 0.4}, {0.04, 0.7}, {0.08, 1.0}, {0.25, 1.0}, {0.4, 1.0},
                                {0.5, 0.8}, {1.0, 0.4},  {2.5, 0.16}, {10.0, 0.04}};
    DOUBLES T, Sa;
    s->CalcPOSpectrumSRaSRv(1.0, 1.0, T, Sa);
    for (const auto& [period, g] : worked) {
        EXPECT_NEAR(g, s->CalcSaAt(period), 1e-12) << period;
        EXPECT_NEAR(g, At(T, Sa, period), 1e-12) << period;
    }
    EXPECT_NEAR(0.4 / 0.777, s->CalcSaAt(0.777), 1e-12) << "between grid points: the formula";
}

TEST(DesignSpectrum, ReductionActsOnTheTwoBranchesSeparately)
{
    const auto s = Make(T_SPFC_ATC40{0.4, 0.4, false});
    DOUBLES T, Sa;
    s->CalcPOSpectrumSRaSRv(0.5, 0.6, T, Sa); // the branches now meet at 0.24 / 0.5 = 0.48 s
    const double worked[][2] = {{0.0, 0.2},  {0.04, 0.35}, {0.2, 0.5}, {0.45, 0.5},
                                {0.48, 0.5}, {0.6, 0.4},   {1.0, 0.24}};
    for (const auto& [period, g] : worked)
        EXPECT_NEAR(g, At(T, Sa, period), 1e-12) << period;
    s->CalcPOSpectrumSRaSRv(1.0, 0.5, T, Sa); // ... at 0.2 s, on the former plateau
    EXPECT_NEAR(1.0, At(T, Sa, 0.2), 1e-12);
    EXPECT_NEAR(0.8, At(T, Sa, 0.25), 1e-12);
}

TEST(DesignSpectrum, FloorsFollowTheBehaviourTypeAndTheFlagAndServeAtc40Only)
{
    struct T_CASE {
        int type;
        std::optional<bool> floors;
        double at02, at1; // reduced by 0.1 or by the floors of ATC-40 Table 8-2
    };
    const T_CASE cases[] = {{0, {}, 0.33, 0.200},   {1, {}, 0.44, 0.224},   {2, {}, 0.56, 0.268},
                            {3, {}, 0.10, 0.040},   {0, true, 0.33, 0.200}, {0, false, 0.10, 0.040},
                            {2, false, 0.10, 0.040}};
    DOUBLES T, Sa;
    for (const T_CASE& c : cases) {
        Make(T_SPFC_ATC40{0.4, 0.4, c.floors}, c.type)->CalcPOSpectrumSRaSRv(0.1, 0.1, T, Sa);
        EXPECT_NEAR(c.at02, At(T, Sa, 0.2), 1e-12) << c.type;
        EXPECT_NEAR(c.at1, At(T, Sa, 1.0), 1e-12) << c.type;
    }
    Make(T_SPFC_EURO2003{1, 'A', 1.0, {}, {}, {}, {}, {}})->CalcPOSpectrumSRaSRv(0.1, 0.1, T, Sa);
    EXPECT_NEAR(0.25, At(T, Sa, 0.2), 1e-12);
    Make(kTable)->CalcPOSpectrumSRaSRv(0.1, 0.1, T, Sa);
    EXPECT_NEAR(0.08, At(T, Sa, 1.0), 1e-12);
}

TEST(DesignSpectrum, ByDampingReducesWhereTheCodeHasNoRuleOfItsOwn)
{
    DOUBLES T, Sa;
    ASSERT_EQ(1, Make(T_SPFC_ATC40{0.4, 0.4, {}}, 2)->CalcPOSpectrumByDamping(45.0, T, Sa));
    EXPECT_NEAR(0.56, At(T, Sa, 0.2), 1e-12) << "on the floor";
    ASSERT_EQ(1, Make(kTable)->CalcPOSpectrumByDamping(10.0, T, Sa));
    EXPECT_NEAR(0.8 * 0.775586, At(T, Sa, 0.5), 5e-7); // SRA at 10 %
    EXPECT_NEAR(0.2 * 0.827842, At(T, Sa, 2.0), 5e-7); // SRV at 10 %
    const DOUBLES before = Sa;
    for (const double beta : {0.0, -3.0, std::nan("")}) {
        EXPECT_EQ(0, Make(kTable)->CalcPOSpectrumByDamping(beta, T, Sa));
        EXPECT_EQ(0, Make(T_SPFC_EURO1996{'A', 1.0, {}})->CalcPOSpectrumByDamping(beta, T, Sa));
        EXPECT_EQ(before, Sa) << beta;
    }
}

TEST(DesignSpectrum, CodeGridHoldsItsCornersAscendingEachOnce)
{
    const auto euro = [](std::optional<double> TB, std::optional<double> TC, double TD) {
        return T_SPFC_EURO2003{1, 'B', 0.3, {}, {}, TB, TC, TD};
    };
    struct T_CASE {
        const char* name;
        decltype(T_SPFC_D::data) data;
        std::size_t points;
        DOUBLES corners;
    };
    const T_CASE cases[] = {
        {"corners beside it", T_SPFC_ATC40{0.44, 0.64, {}}, 1003, {0.64 / 1.1, 0.128 / 1.1}},
        {"beyond the grid", euro({}, {}, 12.0), 1002, {12.0}},
        {"a hair beside it", euro(0.15 + 2e-10, 0.5, 0.5 + 2e-10), 1001, {0.15, 0.5}},
    };
    for (const T_CASE& c : cases) {
        DOUBLES T, Sa;
        Make(c.data)->CalcPOSpectrumSRaSRv(1.0, 1.0, T, Sa);
        EXPECT_EQ(c.points, T.size()) << c.name;
        EXPECT_EQ(T.size(), Sa.size()) << c.name;
        for (std::size_t i = 1; i < T.size(); ++i)
            EXPECT_GT(T[i], T[i - 1] + 1e-9) << c.name;
        EXPECT_EQ(0.0, T.front()) << c.name;
        for (const double corner : c.corners)
            (void)At(T, Sa, corner);
    }
}

TEST(DesignSpectrum, UserTableIsUsedAsGivenAndHeldAtItsEnds)
{
    const auto s = Make(kTable);
    DOUBLES T, Sa;
    s->CalcPOSpectrumSRaSRv(1.0, 1.0, T, Sa);
    EXPECT_EQ(kTable.T, T);
    EXPECT_EQ(kTable.Sa, Sa);
    const double worked[][2] = {{0.0, 0.2}, {0.25, 0.5}, {0.5, 0.8}, {0.75, 0.8},
                                {1.0, 0.8}, {1.2, 0.68}, {2.0, 0.2}, {9.0, 0.2}};
    for (const auto& [period, g] : worked)
        EXPECT_NEAR(g, s->CalcSaAt(period), 1e-12) << period;
    const auto late = Make(T_SPFC_USER{{0.3, 1.0}, {0.6, 0.1}, 9.81});
    EXPECT_EQ(0.6, late->CalcSaAt(0.1)) << "held left of the table";
    EXPECT_EQ(9.81, late->GravitySi());
    EXPECT_FALSE(s->GravitySi());
    EXPECT_FALSE(Make(T_SPFC_ATC40{0.4, 0.4, {}})->GravitySi());
}

TEST(DesignSpectrum, UserTableTurnsAtTheLastPeriodWithTheLargestOrdinate)
{
    const auto s = Make(kTable);
    EXPECT_EQ(1.0, s->CornerPeriod());
    DOUBLES T, Sa;
    s->CalcPOSpectrumSRaSRv(0.5, 1.0, T, Sa); // acceleration branch goes on at 0.4
    EXPECT_EQ(DOUBLES({0.1, 0.4, 0.4, 0.4, 0.2}), Sa);
    s->CalcPOSpectrumSRaSRv(1.0, 0.5, T, Sa); // velocity branch 0.4 / T to the left
    EXPECT_EQ(DOUBLES({0.2, 0.8, 0.4, 0.25, 0.1}), Sa);
    s->CalcPOSpectrumSRaSRv(1.0, 0.25, T, Sa);
    EXPECT_EQ(DOUBLES({0.2, 0.4, 0.2, 0.125, 0.05}), Sa);
    EXPECT_EQ(0.0, Make(T_SPFC_USER{{0.0, 1.0}, {1.0, 0.5}, {}})->CornerPeriod());
}
