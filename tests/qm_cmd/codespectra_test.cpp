#include "qm_cmd/etc_design_spect.h"

#include <array>
#include <cmath>
#include <gtest/gtest.h>

namespace {

using DOUBLES = std::vector<double>;

std::unique_ptr<CETC_DESIGN_SPECT> Make(decltype(T_SPFC_D::data) data,
                                        LIMIT_STATE state = LIMIT_STATE::SLV)
{
    return MakeDesignSpectrum({"D", std::move(data)}, 0, state);
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

// EN 1998-1:2004 Tables 3.2 and 3.3, Se / ag at 5 %: ordinates worked out apart from this program.
TEST(Euro2003Spectrum, HasTheOrdinatesOfEverySoilAndType)
{
    constexpr std::array<double, 11> kT{0, 0.05, 0.1, 0.2, 0.3, 0.5, 0.8, 1.5, 2.0, 3.0, 4.0};
    struct T_ROW {
        int type;
        char soil;
        std::array<double, 11> Se;
    };
    // clang-format off
    const T_ROW rows[] = {
    {1, 'A', {1.0, 1.5, 2.0, 2.5, 2.5, 2.0, 1.25, .666667, .5, .222222, .125}},
    {1, 'B', {1.2, 1.8, 2.4, 3.0, 3.0, 3.0, 1.875, 1.0, .75, .333333, .1875}},
    {1, 'C', {1.15, 1.58125, 2.0125, 2.875, 2.875, 2.875, 2.15625, 1.15, .8625, .383333, .215625}},
    {1, 'D', {1.35, 1.85625, 2.3625, 3.375, 3.375, 3.375, 3.375, 1.8, 1.35, .6, .3375}},
    {1, 'E', {1.4, 2.1, 2.8, 3.5, 3.5, 3.5, 2.1875, 1.166667, .875, .388889, .21875}},
    {2, 'A', {1.0, 2.5, 2.5, 2.5, 2.083333, 1.25, .78125, .333333, .1875, .083333, .046875}},
    {2, 'B', {1.35, 3.375, 3.375, 3.375, 2.8125, 1.6875, 1.054688, .45, .253125, .1125, .063281}},
    {2, 'C', {1.5, 2.625, 3.75, 3.75, 3.125, 1.875, 1.171875, .5, .28125, .125, .070312}},
    {2, 'D', {1.8, 3.15, 4.5, 4.5, 4.5, 2.7, 1.6875, .72, .405, .18, .10125}},
    {2, 'E', {1.6, 4.0, 4.0, 4.0, 3.333333, 2.0, 1.25, .533333, .3, .133333, .075}},
    };
    // clang-format on
    for (const T_ROW& row : rows) {
        const auto s = Make(Euro(row.type, row.soil, 1.0));
        for (std::size_t i = 0; i < kT.size(); ++i) {
            EXPECT_NEAR(row.Se[i], s->CalcSaAt(kT[i]), 6e-7) << row.type << row.soil << kT[i];
            EXPECT_NEAR(row.Se[i], ByDamping(*s, 5.0, kT[i]), 6e-7) << row.type << row.soil;
        }
    }
    // A published notebook's spot value: ag 0.24 g, type 1, soil B, Se(0.5 s) = 0.72 g.
    EXPECT_NEAR(0.72, Make(Euro(1, 'B', 0.24))->CalcSaAt(0.5), 1e-12);
}

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

// A published output page of a spectrum tool (NTC 2018 3.2.3.2.1, soil C, T1, four limit states):
// ag, F0, TC*, SS, CC, TB, TC, TD as printed, good to 1e-4 since its inputs are rounded.
TEST(NtcSpectrum, ReproducesThePrintedTableOfFourLimitStates)
{
    constexpr double kPrinted[4][8] = {
        {0.0301, 2.5003, 0.2001, 1.5000, 1.7855, 0.1191, 0.3573, 1.7203},
        {0.0452, 2.5508, 0.2203, 1.5000, 1.7298, 0.1270, 0.3811, 1.7809},
        {0.2179, 2.7200, 0.3200, 1.3444, 1.5293, 0.1631, 0.4894, 2.4716},
        {0.2970, 2.7400, 0.3400, 1.2118, 1.4990, 0.1699, 0.5097, 2.7879}};
    T_SPFC_NTC r{'C', 1, {}, {}};
    for (std::size_t i = 0; i < 4; ++i)
        r.states[i] = T_SPFC_NTC_STATE{kPrinted[i][0], kPrinted[i][1], kPrinted[i][2]};
    for (std::size_t i = 0; i < 4; ++i) {
        const auto& [ag, F0, TCstar, SS, CC, TB, TC, TD] = kPrinted[i];
        const auto s = Make(r, static_cast<LIMIT_STATE>(i));
        EXPECT_NEAR(SS, s->CalcSaAt(0.0) / ag, 1e-4 * SS) << i;
        EXPECT_NEAR(CC, s->CornerPeriod() / TCstar, 1e-4 * CC) << i;
        EXPECT_NEAR(TC, s->CornerPeriod(), 1e-4) << i;
        const double plateau = s->CalcSaAt(TC - 0.01);
        EXPECT_NEAR(ag * SS * F0, plateau, 1e-4 * plateau) << i;
        EXPECT_GT(plateau - 1e-3 * plateau, s->CalcSaAt(TB - 0.001)) << i << ": still rising";
        EXPECT_NEAR(plateau * TC * TD / 16.0, s->CalcSaAt(4.0), 2e-4 * s->CalcSaAt(4.0)) << i;
    }
}

TEST(NtcSpectrum, ReproducesThePrintedOrdinatesOfSlv)
{
    const auto s = Make(Ntc('C', 1, {0.21789, 2.71996, 0.32}));
    constexpr double kPrinted[][2] = {{0, 0.29293},   {0.1, 0.60181}, {0.2, 0.79676},
                                      {0.3, 0.79676}, {0.4, 0.79676}, {0.5, 0.77979},
                                      {1, 0.38989},   {2, 0.19495},   {2.4, 0.16246},
                                      {2.5, 0.15418}, {3, 0.10707},   {4, 0.06023}};
    for (const auto& [T, g] : kPrinted)
        EXPECT_NEAR(g, s->CalcSaAt(T), 1e-4 * g) << T;
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

TEST(NtcSpectrum, AStateThatIsNotEnabledHasNoSpectrum)
{
    EXPECT_EQ(nullptr, Make(Ntc('A', 1, {0.1, 2.5, 0.3}), LIMIT_STATE::SLD));
    EXPECT_NE(nullptr, Make(Euro(1, 'A', 0.1), LIMIT_STATE::SLD)) << "one for all states";
}
