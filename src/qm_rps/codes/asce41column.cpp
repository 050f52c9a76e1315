#include "qm_rps/codes/asce41concrete.h"

#include <algorithm>

namespace {

constexpr auto S2 = CODE_MARK::SightedTwice;
constexpr auto S1 = CODE_MARK::SightedOnce;
constexpr auto R = CODE_MARK::Recalled;
constexpr auto K = CODE_MARK::Computed;

constexpr const char* kFrom = "ASCE 41-17 Table 10-8";
constexpr const char* kRound = "ASCE 41-17 Table 10-9";

// ---- 41-13: rows ----------------------------------------------------------------------------

enum GROUP { Flexure, FlexureShear, Shear, Splice };
constexpr std::array<const char*, 4> kNames{"i", "ii", "iii", "iv"};
constexpr std::array<const char*, 3> kVariables{"P/(Ag f'c)", "Av/(bw s)",
                                                "V/(bw d sqrt(f'c)) (psi)"};
// clang-format off
// ASCE 41-13 Table 10-8.
constexpr T_CODE_ROW kAsce13[] = {
    //                                          a      b      c    IO     LS     CP
    {Flexure,      {0.1, 0.006,  kAnyValue}, {0.035, 0.060, 0.2, 0.005, 0.045, 0.060}, S2},
    {Flexure,      {0.6, 0.006,  kAnyValue}, {0.010, 0.010, 0.0, 0.003, 0.009, 0.010}, S2},
    {Flexure,      {0.1, 0.002,  kAnyValue}, {0.027, 0.034, 0.2, 0.005, 0.027, 0.034}, S2},
    {Flexure,      {0.6, 0.002,  kAnyValue}, {0.005, 0.005, 0.0, 0.002, 0.004, 0.005}, S2},
    {FlexureShear, {0.1, 0.006,  3.0},       {0.032, 0.060, 0.2, 0.005, 0.045, 0.060}, S2},
    {FlexureShear, {0.1, 0.006,  6.0},       {0.025, 0.060, 0.2, 0.005, 0.045, 0.060}, S2},
    {FlexureShear, {0.6, 0.006,  3.0},       {0.010, 0.010, 0.0, 0.003, 0.009, 0.010}, S2},
    {FlexureShear, {0.6, 0.006,  6.0},       {0.008, 0.008, 0.0, 0.003, 0.007, 0.008}, S2},
    {FlexureShear, {0.1, 0.0005, 3.0},       {0.012, 0.012, 0.2, 0.005, 0.010, 0.012}, S2},
    {FlexureShear, {0.1, 0.0005, 6.0},       {0.006, 0.006, 0.2, 0.004, 0.005, 0.006}, S2},
    {FlexureShear, {0.6, 0.0005, 3.0},       {0.004, 0.004, 0.0, 0.002, 0.003, 0.004}, S2},
    {FlexureShear, {0.6, 0.0005, 6.0},       {0.0,   0.0,   0.0, 0.0,   0.0,   0.0},   S2},
    {Shear,        {0.1, 0.006,  kAnyValue}, {0.0,   0.060, 0.0, 0.0,   0.045, 0.060}, S2},
    {Shear,        {0.6, 0.006,  kAnyValue}, {0.0,   0.008, 0.0, 0.0,   0.007, 0.008}, S2},
    {Shear,        {0.1, 0.0005, kAnyValue}, {0.0,   0.006, 0.0, 0.0,   0.005, 0.006}, S2},
    {Shear,        {0.6, 0.0005, kAnyValue}, {0.0,   0.0,   0.0, 0.0,   0.0,   0.0},   S2},
    {Splice,       {0.1, 0.006,  kAnyValue}, {0.0,   0.060, 0.4, 0.0,   0.045, 0.060}, S2},
    {Splice,       {0.6, 0.006,  kAnyValue}, {0.0,   0.008, 0.4, 0.0,   0.007, 0.008}, S2},
    {Splice,       {0.1, 0.0005, kAnyValue}, {0.0,   0.006, 0.2, 0.0,   0.005, 0.006}, S2},
    {Splice,       {0.6, 0.0005, kAnyValue}, {0.0,   0.0,   0.0, 0.0,   0.0,   0.0},   S2},
};
constexpr double kLeastTies13 = 0.002; // of condition i: a row, not a limit

// ---- FEMA 356: P/(Ag f'c), V/(bw d sqrt(f'c)) ------------------------------------------------

enum FEMA_GROUP { FemaC, FemaNC, FemaSpliceClose, FemaSpliceWide };
constexpr std::array<const char*, 4> kFemaNames{"i, C", "i, NC", "iii, s <= d/2", "iii, s > d/2"};
constexpr std::array<const char*, 3> kFemaVariables{"P/(Ag f'c)", "V/(bw d sqrt(f'c)) (psi)", ""};
constexpr double kN = kAnyValue;
// FEMA 356 Table 6-8, primary components.
constexpr T_CODE_ROW kFemaPrimary[] = {
    {FemaC,  {0.1, 3.0, kN}, {0.02,  0.03,  0.2, 0.005, 0.015, 0.02},  R},
    {FemaC,  {0.1, 6.0, kN}, {0.016, 0.024, 0.2, 0.005, 0.012, 0.016}, R},
    {FemaC,  {0.4, 3.0, kN}, {0.015, 0.025, 0.2, 0.003, 0.012, 0.015}, R},
    {FemaC,  {0.4, 6.0, kN}, {0.012, 0.02,  0.2, 0.003, 0.01,  0.012}, R},
    {FemaNC, {0.1, 3.0, kN}, {0.006, 0.015, 0.2, 0.005, 0.005, 0.006}, R},
    {FemaNC, {0.1, 6.0, kN}, {0.005, 0.012, 0.2, 0.005, 0.004, 0.005}, R},
    {FemaNC, {0.4, 3.0, kN}, {0.003, 0.01,  0.2, 0.002, 0.002, 0.003}, R},
    {FemaNC, {0.4, 6.0, kN}, {0.002, 0.008, 0.2, 0.002, 0.002, 0.002}, R},
    {FemaSpliceClose, {kN, kN, kN}, {0.01, 0.02, 0.4, 0.005, 0.005, 0.01}, S1},
    {FemaSpliceWide,  {kN, kN, kN}, {0.0,  0.01, 0.2, 0.0,   0.0,   0.0},  S1},
};
// The same, secondary components.
constexpr T_CODE_ROW kFemaSecondary[] = {
    {FemaC,  {0.1, 3.0, kN}, {0.02,  0.03,  0.2, 0.005, 0.02,  0.03},  R},
    {FemaC,  {0.1, 6.0, kN}, {0.016, 0.024, 0.2, 0.005, 0.016, 0.024}, R},
    {FemaC,  {0.4, 3.0, kN}, {0.015, 0.025, 0.2, 0.003, 0.018, 0.025}, R},
    {FemaC,  {0.4, 6.0, kN}, {0.012, 0.02,  0.2, 0.003, 0.013, 0.02},  R},
    {FemaNC, {0.1, 3.0, kN}, {0.006, 0.015, 0.2, 0.005, 0.01,  0.015}, R},
    {FemaNC, {0.1, 6.0, kN}, {0.005, 0.012, 0.2, 0.005, 0.008, 0.012}, R},
    {FemaNC, {0.4, 3.0, kN}, {0.003, 0.01,  0.2, 0.002, 0.006, 0.01},  R},
    {FemaNC, {0.4, 6.0, kN}, {0.002, 0.008, 0.2, 0.002, 0.005, 0.008}, R},
    {FemaSpliceClose, {kN, kN, kN}, {0.01, 0.02, 0.4, 0.005, 0.01,  0.02}, S1},
    {FemaSpliceWide,  {kN, kN, kN}, {0.0,  0.01, 0.2, 0.0,   0.005, 0.01}, S1},
};
// clang-format on
const T_CODE_TABLE kTable13{"ASCE 41-13 Table 10-8", kVariables, kAsce13};
const T_CODE_TABLE kTablesFema[] = {{"FEMA 356 Table 6-8", kFemaVariables, kFemaPrimary},
                                    {"FEMA 356 Table 6-8", kFemaVariables, kFemaSecondary}};

bool Sound(const T_ASCE_COLUMN& c, CCodeSheet& sheet)
{
    sheet.Positive({{"bw", c.bw}, {"d", c.d}, {"Ag", c.Ag}, {"fc", c.fc}, {"fyt", c.fyt}});
    sheet.Positive({{"spacing", c.spacing}, {"tieRatio", c.tieRatio}});
    sheet.Positive({{"shearStrength", c.shearStrength}});
    if (c.poorSplice) sheet.Positive({{"longRatio", c.longRatio}, {"fyl", c.fyl}});
    sheet.Finite({{"axial", c.axial}});
    return sheet.NotNegative({{"shear", c.shear}, {"hoopShear", c.hoopShear}});
}

double AxialRatio(const T_ASCE_COLUMN& c)
{
    return std::max(0.0, c.axial) / (c.Ag * c.fc);
}

// ---- 41-17: equations --------------------------------------------------------------------------

struct T_EQUATION {
    const char* clause;
    double a0, aNu, aRho, aV; // a = a0 - aNu nu + aRho rho_t - aV v
    double b0;                // numerator of b
    const char *textA, *textB;
};
constexpr T_EQUATION kRectangle{kFrom,
                                0.042,
                                0.043,
                                0.63,
                                0.023,
                                0.5,
                                "0.042 - 0.043 nu + 0.63 rho_t - 0.023 v >= 0",
                                "0.5/(5 + nu/0.8 1/rho_t f'cE/fytE) - 0.01 >= a; nu > 0.5: linear"
                                " to 0 at 0.7"};
constexpr T_EQUATION kCircle{kRound,
                             0.06,
                             0.06,
                             1.3,
                             0.037,
                             0.65,
                             "0.06 - 0.06 nu + 1.3 rho_t - 0.037 v >= 0",
                             "0.65/(5 + nu/0.8 1/rho_t f'cE/fytE) - 0.01 >= a; nu > 0.5: linear"
                             " to 0 at 0.7"};
constexpr double kLeastNu = 0.1; // of LS and CP

struct T_ARGUMENTS {
    double nu = 0.0, rho = 0.0, v = 0.0;
};

/// The equations' variables, each held within its limits.
T_ARGUMENTS Arguments(const T_ASCE_COLUMN& c, const char* clause, CCodeSheet& sheet)
{
    constexpr double kLeastTies = 0.0005;
    const double most = c.poorSplice || !c.tiesAnchored ? 0.0075 : 0.0175;
    if (c.tieRatio < kLeastTies) sheet.WarnOutside(clause, "rho_t", c.tieRatio, kLeastTies);
    T_ARGUMENTS arg;
    arg.nu = sheet.Put("nu", AxialRatio(c), clause, "N_UD/(Ag f'cE) >= 0", S2);
    arg.rho = sheet.Put("rho_t", std::clamp(c.tieRatio, kLeastTies, most), clause,
                        "0.0005 <= Av/(bw s) <= " + CodeNumber(most), S2);
    arg.v =
        sheet.Put("v", std::max(0.2, c.shear / c.shearStrength), clause, "V_yE/V_ColOE >= 0.2", S2);
    return arg;
}

double Rotation(const T_EQUATION& e, double nu, const T_ARGUMENTS& arg)
{
    return std::max(0.0, e.a0 - e.aNu * nu + e.aRho * arg.rho - e.aV * arg.v);
}

double LossRotation(const T_EQUATION& e, double nu, const T_ARGUMENTS& arg, double fcOverFyt)
{
    const double held = std::min(nu, 0.5);
    const double b = e.b0 / (5.0 + held / 0.8 / arg.rho * fcOverFyt) - 0.01;
    return std::max(LinearClamped(nu, 0.5, b, 0.7, 0.0), Rotation(e, nu, arg));
}

T_CODE_PLASTIC FromEquations(const T_ASCE_COLUMN& c, CCodeSheet& sheet)
{
    const T_EQUATION& e = c.circular ? kCircle : kRectangle;
    const T_ARGUMENTS arg = Arguments(c, e.clause, sheet);
    const double fcOverFyt = c.fc / c.fyt;
    T_CODE_PLASTIC p;
    p.a = sheet.Put("a", Rotation(e, arg.nu, arg), e.clause, e.textA, S2);
    p.b = sheet.Put("b", LossRotation(e, arg.nu, arg, fcOverFyt), e.clause, e.textB, S2);
    p.c = sheet.Put("c", std::max(0.0, 0.24 - 0.4 * arg.nu), e.clause, "0.24 - 0.4 nu >= 0", S2);
    const double b = LossRotation(e, std::max(kLeastNu, arg.nu), arg, fcOverFyt);
    if (arg.nu < kLeastNu)
        sheet.WarnConflict(e.clause, "nu >= 0.1: LS, CP", "nu >= 0.1: a, b, c, LS, CP");
    p.IO = sheet.Put("IO", std::min(0.15 * p.a, 0.005), e.clause, "0.15 a <= 0.005", S2);
    p.LS = sheet.Put("LS", 0.5 * b, e.clause, "0.5 b, nu >= 0.1", S2);
    p.CP = sheet.Put("CP", 0.7 * b, e.clause, "0.7 b, nu >= 0.1", S2);
    return p;
}

T_CODE_PLASTIC SplicedFromEquations(const T_ASCE_COLUMN& c, CCodeSheet& sheet)
{
    const T_ARGUMENTS arg = Arguments(c, kFrom, sheet);
    const double grip =
        c.tieRatio <= 0.0 || !c.twoTiesInLap ? 0.0 : arg.rho * c.fyt / (8.0 * c.longRatio * c.fyl);
    T_CODE_PLASTIC p;
    p.a = sheet.Put("a", std::clamp(grip, 0.0, 0.025), kFrom,
                    "0 <= rho_t fytE/(8 rho_l fylE) <= 0.025", S2);
    const auto loss = [&](double nu) {
        return std::max(p.a, std::clamp(0.012 - 0.085 * nu + 12.0 * arg.rho, 0.0, 0.06));
    };
    p.b = sheet.Put("b", loss(arg.nu), kFrom, "a <= 0.012 - 0.085 nu + 12 rho_t <= 0.06", S2);
    p.c = sheet.Put("c", std::min(0.4, 0.15 + 36.0 * arg.rho), kFrom, "0.15 + 36 rho_t <= 0.4", S2);
    p.IO = sheet.Put("IO", 0.0, kFrom, "0", R);
    sheet.WarnConflict(kFrom, "IO = 0", "IO = 0.1 b");
    if (arg.nu < kLeastNu)
        sheet.WarnConflict(kFrom, "nu >= 0.1: LS, CP", "nu >= 0.1: a, b, c, LS, CP");
    const double b = loss(std::max(kLeastNu, arg.nu));
    p.LS = sheet.Put("LS", 0.5 * b, kFrom, "0.5 b, nu >= 0.1", S2);
    p.CP = sheet.Put("CP", 0.7 * b, kFrom, "0.7 b, nu >= 0.1", S2);
    return p;
}

// ---- earlier editions --------------------------------------------------------------------------

/// Condition by V_p / V_n and by the hooks of the ties.
GROUP Condition13(const T_ASCE_COLUMN& c, CCodeSheet& sheet)
{
    if (c.poorSplice) return Splice;
    const double ratio = sheet.Put("Vp/Vn", c.shear / c.shearStrength, kTable13.clause,
                                   "i: <= 0.6, 135; ii: <= 1.0; iii: > 1.0", R);
    const GROUP byShear = ratio <= 0.6 ? Flexure : ratio <= 1.0 ? FlexureShear : Shear;
    if (c.hooks == TIE_HOOKS::Hooks135) return byShear;
    return byShear == Flexure ? FlexureShear : c.hooks == TIE_HOOKS::Other ? Shear : byShear;
}

double ShearLevel(const T_ASCE_COLUMN& c)
{
    return c.shear / (c.bw * c.d * RootPsi(c.fc));
}

std::optional<T_CODE_PLASTIC> Column13(const T_ASCE_COLUMN& c, CCodeSheet& sheet)
{
    const GROUP group = Condition13(c, sheet);
    if (group == Flexure && c.tieRatio < kLeastTies13)
        sheet.WarnOutside(kTable13.clause, "Av/(bw s)", c.tieRatio, kLeastTies13);
    return Interpolate(kTable13, group, kNames[group], {AxialRatio(c), c.tieRatio, ShearLevel(c)},
                       sheet);
}

std::optional<T_CODE_PLASTIC> ColumnFema(const T_ASCE_COLUMN& c, bool primary, CCodeSheet& sheet)
{
    const T_CODE_TABLE& table = kTablesFema[primary ? 0 : 1];
    if (!c.poorSplice && c.shear > c.shearStrength) { // condition ii has no backbone
        sheet.Refuse(CODE_REASON::NoRow, "shear", table.clause);
        return {};
    }
    const bool conforms = c.spacing <= c.d / 3.0 && c.hoopShear >= 0.75 * c.shear;
    FEMA_GROUP group = conforms ? FemaC : FemaNC;
    if (c.poorSplice) group = c.spacing > c.d / 2.0 ? FemaSpliceWide : FemaSpliceClose;
    sheet.Put("s/d", c.spacing / c.d, table.clause, "C: s <= d/3, Vs >= 3/4 V", K);
    return Interpolate(table, group, kFemaNames[group], {AxialRatio(c), ShearLevel(c), 0.0}, sheet);
}

} // namespace

std::optional<T_CODE_PLASTIC> AsceColumn(const T_ASCE_COLUMN& column, ASCE_EDITION edition,
                                         CCodeSheet& sheet)
{
    if (!Sound(column, sheet)) return {};
    std::optional<T_CODE_PLASTIC> p;
    if (edition == ASCE_EDITION::Asce17) {
        if (column.circular && column.poorSplice) {
            sheet.Refuse(CODE_REASON::NoRow, "poorSplice", kRound);
            return {};
        }
        p = column.poorSplice ? SplicedFromEquations(column, sheet) : FromEquations(column, sheet);
    } else if (edition == ASCE_EDITION::Asce13) {
        p = Column13(column, sheet);
    } else {
        p = ColumnFema(column, edition == ASCE_EDITION::Fema356Primary, sheet);
    }
    return sheet.Sound() ? p : std::nullopt;
}
