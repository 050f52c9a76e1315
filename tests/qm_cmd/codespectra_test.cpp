// The ordinates of every soil of EN 1998-1 and the printed ones of NTC 2018 are in
// examples/verification.
#include "qm_cmd/etc_design_spect.h"

#include <cmath>
#include <gtest/gtest.h>

namespace {

using DOUBLES = std::vector<double>;

std::unique_ptr<CETC_DESIGN_SPECT> Make(decltype(T_SPFC_D::data) data)
{
    return MakeDesignSpectrum({"D", std::move(data)}, 0, LIMIT_STATE::SLV);
}

T_SPFC_EURO2003 Euro(int type, char soil, double ag, std::optional<double> damping = {})
{
    return {type, soil, ag, damping, {}, {}, {}, {}};
}

T_SPFC_NTC Ntc(char soil, int topography, T_SPFC_NTC_STATE slv, std::optional<double> damping = {})
{
    T_SPFC_NTC r{soil, topography, damping, {}};
    r.states[2] = slv;
    return r;
}

/// Ordinate at T of the spectrum for a damping.
double ByDamping(const CETC_DESIGN_SPECT& s, double betaPct, double period)
{
    DOUBLES T, Sa;
    EXPECT_EQ(1, s.CalcPOSpectrumByDamping(betaPct, T, Sa));
    for (std::size_t i = 0; i < T.size(); ++i) {
        if (std::fabs(T[i] - period) < 1e-9) return Sa[i];
    }
    return NAN;
}

} // namespace

TEST(Euro2003Spectrum, DampingChangesTheAmplificationDownToItsBound)
{
    const auto s = Make(Euro(1, 'A', 1.0));
    struct T_CASE {
        double damping, plateau, halfRamp;
    };
    const T_CASE cases[] = {{2.0, 2.988072, 1.994036},  // eta = sqrt(10 / 7)
                            {20.0, 1.581139, 1.290569}, // eta = sqrt(0.4)
                            {50.0, 1.375, 1.1875}};     // eta = 0.55
    for (const T_CASE& c : cases) {
        const auto own = Make(Euro(1, 'A', 1.0, c.damping));
        EXPECT_NEAR(c.plateau, own->CalcSaAt(0.3), 5e-7) << c.damping;
        EXPECT_NEAR(c.halfRamp, own->CalcSaAt(0.075), 5e-7) << c.damping;
        EXPECT_NEAR(c.plateau, ByDamping(*s, c.damping, 0.3), 5e-7) << c.damping;
        EXPECT_NEAR(c.plateau * 0.4, ByDamping(*own, c.damping, 1.0), 5e-7) << "not twice";
        EXPECT_NEAR(1.0, ByDamping(*s, c.damping, 0.0), 1e-12) << "the ground itself";
    }
}

TEST(Euro2003Spectrum, TakesOverridesOfEachShapeValue)
{
    T_SPFC_EURO2003 r = Euro(1, 'A', 0.5);
    r.S = 2.0;
    r.TB = 0.2;
    r.TC = 1.0;
    r.TD = 3.0;
    const auto s = Make(r); // plateau 2.5 g
    EXPECT_EQ(1.0, s->CornerPeriod());
    const double worked[][2] = {{0.0, 1.0},  {0.1, 1.75},     {0.2, 2.5},     {1.0, 2.5},
                                {2.0, 1.25}, {3.0, 0.833333}, {6.0, 0.208333}};
    for (const auto& [T, g] : worked)
        EXPECT_NEAR(g, s->CalcSaAt(T), 5e-7) << T;
}

// ENV 1998-1-1:1994 (4.1) to (4.4), Table 4.1, worked by hand for ag = 1 g.
TEST(Euro1996Spectrum, HasTheOrdinatesOfEverySoil)
{
    struct T_ROW {
        char soil;
        double TB, TC, a0, halfRamp, plateau, at1, at3, at6;
    };
    const T_ROW rows[] = {{'A', 0.10, 0.40, 1.0, 1.750, 2.50, 1.0, 0.333333, 0.083333},
                          {'B', 0.15, 0.60, 1.0, 1.750, 2.50, 1.5, 0.5, 0.125},
                          {'C', 0.20, 0.80, 0.9, 1.575, 2.25, 1.8, 0.6, 0.15}};
    for (const T_ROW& r : rows) {
        const auto s = Make(T_SPFC_EURO1996{r.soil, 1.0, {}});
        const double worked[][2] = {{0.0, r.a0},       {r.TB / 2, r.halfRamp}, {r.TB, r.plateau},
                                    {r.TC, r.plateau}, {1.0, r.at1},           {3.0, r.at3},
                                    {6.0, r.at6}};
        for (const auto& [T, g] : worked)
            EXPECT_NEAR(g, s->CalcSaAt(T), 5e-7) << r.soil << T;
        EXPECT_EQ(r.TC, s->CornerPeriod()) << r.soil;
    }
}

TEST(Euro1996Spectrum, DampingChangesTheAmplificationDownToItsBound)
{
    const auto s = Make(T_SPFC_EURO1996{'A', 1.0, {}});
    EXPECT_NEAR(2.5 * std::sqrt(0.5), ByDamping(*s, 12.0, 0.2), 1e-12); // sqrt(7 / 14)
    EXPECT_NEAR(2.5 * 0.7, ByDamping(*s, 30.0, 0.2), 1e-12);
    EXPECT_NEAR(1.75, Make(T_SPFC_EURO1996{'A', 1.0, 30.0})->CalcSaAt(0.2), 1e-12);
}

// NTC 2018 Tables 3.2.IV and 3.2.V by hand: F0 = 2.5, TC* = 0.3.
TEST(NtcSpectrum, SoilFactorFollowsItsLineBetweenItsBounds)
{
    struct T_ROW {
        char soil;
        double weak, middle, strong; // SS at ag = 0.1, 0.3 and 0.6 g
        double TC;
    };
    const T_ROW rows[] = {{'A', 1.0, 1.000, 1.0, 0.300000},
                          {'B', 1.2, 1.100, 1.0, 0.419846},
                          {'C', 1.5, 1.250, 1.0, 0.468663},
                          {'D', 1.8, 1.275, 0.9, 0.684653},
                          {'E', 1.6, 1.175, 1.0, 0.558432}};
    for (const T_ROW& r : rows) {
        EXPECT_NEAR(0.1 * r.weak, Make(Ntc(r.soil, 1, {0.1, 2.5, 0.3}))->CalcSaAt(0.0), 1e-12);
        EXPECT_NEAR(0.3 * r.middle, Make(Ntc(r.soil, 1, {0.3, 2.5, 0.3}))->CalcSaAt(0.0), 1e-12);
        const auto s = Make(Ntc(r.soil, 1, {0.6, 2.5, 0.3}));
        EXPECT_NEAR(0.6 * r.strong, s->CalcSaAt(0.0), 1e-12) << r.soil;
        EXPECT_NEAR(r.TC, s->CornerPeriod(), 5e-7) << r.soil;
    }
}

TEST(NtcSpectrum, TopographyDampingAndLongPeriods)
{
    const double ST[] = {1.0, 1.2, 1.2, 1.4};
    for (int t = 1; t <= 4; ++t)
        EXPECT_NEAR(0.1 * ST[t - 1], Make(Ntc('A', t, {0.1, 2.5, 0.3}))->CalcSaAt(0.0), 1e-12) << t;
    const auto s = Make(Ntc('A', 1, {0.1, 2.5, 0.3})); // TD = 2.0
    EXPECT_NEAR(0.25 * 0.3 / 2.0, s->CalcSaAt(2.0), 1e-12);
    EXPECT_NEAR(0.25 * 0.3 * 2.0 / 16.0, s->CalcSaAt(4.0), 1e-12);
    EXPECT_NEAR(0.25 * std::sqrt(0.4), ByDamping(*s, 20.0, 0.2), 1e-12);
    EXPECT_NEAR(0.25 * 0.55, ByDamping(*s, 60.0, 0.2), 1e-12);
    EXPECT_NEAR(0.25 * 0.55, Make(Ntc('A', 1, {0.1, 2.5, 0.3}, 60.0))->CalcSaAt(0.2), 1e-12);
}
