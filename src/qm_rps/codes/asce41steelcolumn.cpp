#include "qm_rps/codes/asce41steel.h"

#include <algorithm>
#include <cmath>

namespace {

constexpr auto S2 = CODE_MARK::SightedTwice;
constexpr auto S1 = CODE_MARK::SightedOnce;
constexpr auto R = CODE_MARK::Recalled;
constexpr const char* kTable17 = "ASCE 41-17 Table 9-7.1";
constexpr const char* kTable13 = "ASCE 41-13 Table 9-6";
constexpr const char* kAisc = "AISC 342-22 C3.6";
constexpr double kLowAxial = 0.2, kForceControlled13 = 0.5; // P/P_CL
constexpr double kForceControlled17 = 0.6;                  // P/Pye
constexpr T_CODE_PLASTIC kNone{};

T_STEEL_PLASTIC ForceControlled(double yield, const char* clause, CCodeSheet& sheet)
{
    sheet.Warn("IDS_QM_CODE_WARN_FORCE", {clause});
    return {yield, kNone, true};
}

/// Slenderness of flange and web over sqrt(E/Fye).
struct T_PLATES {
    double flange = 0.0, web = 0.0;
};
T_PLATES Plates(const T_STEEL_MEMBER& m, const char* clause, CCodeSheet& sheet)
{
    const double root = std::sqrt(m.E / m.Fye);
    return {sheet.Put("bf/2tf / sqrt(E/Fye)", m.bf / (2.0 * m.tf) / root, clause,
                      "compact <= 0.30, slender >= 0.38", S2),
            sheet.Put("h/tw / sqrt(E/Fye)", m.h / m.tw / root, clause, "", CODE_MARK::Computed)};
}

/// Share of the slender values: the worse of flange and web.
double SlenderShare(const T_PLATES& plates, double compactWeb, double slenderWeb)
{
    const double flange = LinearClamped(plates.flange, 0.30, 0.0, 0.38, 1.0);
    const double web = slenderWeb > compactWeb
                           ? LinearClamped(plates.web, compactWeb, 0.0, slenderWeb, 1.0)
                           : (plates.web > compactWeb ? 1.0 : 0.0);
    return std::max(flange, web);
}

// ---- ASCE 41-17 --------------------------------------------------------------------------------

/// Web limits over sqrt(E/Fye) at p = P/Pye.
double CompactWeb(double p)
{
    return p < kLowAxial ? 2.45 * (1.0 - 0.71 * p) : std::max(1.49, 0.77 * (2.93 - p));
}
double SlenderWeb(double p)
{
    return p < kLowAxial ? 3.76 * (1.0 - 1.83 * p) : std::max(1.49, 1.12 * (2.33 - p));
}

/// Acceptance of the rows that are formulas: 0.5 a, 0.75 b, b.
void Accept(T_CODE_PLASTIC& p)
{
    p.b = std::max(p.a, p.b);
    p.IO = 0.5 * p.a;
    p.LS = 0.75 * p.b;
    p.CP = p.b;
}

T_CODE_PLASTIC Compact17(double p, double length, double web, CCodeSheet& sheet)
{
    T_CODE_PLASTIC v;
    v.a = 0.8 * std::pow(1.0 - p, 2.2) / (0.1 * length + 0.8 * web) - 0.0035;
    v.b = 7.4 * std::pow(1.0 - p, 2.3) / (0.5 * length + 2.9 * web) - 0.006;
    v.a = sheet.Put("a (compact)", std::max(0.0, v.a), kTable17,
                    "0.8 (1 - p)^2.2/(0.1 L/ry + 0.8 h/tw) - 0.0035 >= 0", S1);
    v.b = sheet.Put("b (compact)", std::max(0.0, v.b), kTable17,
                    "7.4 (1 - p)^2.3/(0.5 L/ry + 2.9 h/tw) - 0.006 >= 0", S1);
    v.c = sheet.Put("c (compact)", 0.9 - 0.9 * p, kTable17, "0.9 - 0.9 p", S1);
    Accept(v);
    return v;
}

T_CODE_PLASTIC Slender17(double p, double length, double web, double flange, CCodeSheet& sheet)
{
    T_CODE_PLASTIC v;
    v.a = 1.2 * std::pow(1.0 - p, 1.2) / (1.4 * length + 0.1 * web + 0.9 * flange) - 0.0023;
    v.b = 2.5 * std::pow(1.0 - p, 1.8) / (0.1 * length + 0.2 * web + 2.7 * flange) - 0.0097;
    v.a = sheet.Put("a (slender)", std::max(0.0, v.a), kTable17,
                    "1.2 (1 - p)^1.2/(1.4 L/ry + 0.1 h/tw + 0.9 bf/2tf) - 0.0023 >= 0", S1);
    v.b = sheet.Put("b (slender)", std::max(0.0, v.b), kTable17,
                    "2.5 (1 - p)^1.8/(0.1 L/ry + 0.2 h/tw + 2.7 bf/2tf) - 0.0097 >= 0", S1);
    v.c = sheet.Put("c (slender)", 0.5 - 0.5 * p, kTable17, "0.5 - 0.5 p", S1);
    Accept(v);
    return v;
}

std::optional<T_STEEL_PLASTIC> Column17(const T_STEEL_MEMBER& m, double yield, CCodeSheet& sheet)
{
    if (!sheet.Positive({{"ry", m.ry}})) return {};
    const double p = std::max(0.0, m.axial) / (m.A * m.Fye);
    const double length = sheet.Put("L/ry", m.length / m.ry, kTable17, "", CODE_MARK::Computed);
    const double web = m.h / m.tw, flange = m.bf / (2.0 * m.tf);
    sheet.Put("p", p, kTable17, "PG/Pye; p > 0.6: force-controlled", R);
    if (p > kForceControlled17) return ForceControlled(yield, kTable17, sheet);
    const T_PLATES plates = Plates(m, kTable17, sheet);
    const double compact = sheet.Put("compact web", CompactWeb(p), kTable17,
                                     "2.45 (1 - 0.71 p), p < 0.2; 0.77 (2.93 - p) >= 1.49", S1);
    const double slender = sheet.Put("slender web", SlenderWeb(p), kTable17,
                                     "3.76 (1 - 1.83 p), p < 0.2; 1.12 (2.33 - p) >= 1.49", S1);
    if (p >= kLowAxial)
        sheet.WarnConflict(kTable17, "slender web: max(1.12 (2.33 - p); 1.49)",
                           "min(1.12 (2.33 - p); 1.49)");
    const double share = SlenderShare(plates, compact, slender);
    const T_CODE_PLASTIC v =
        Between(Compact17(p, length, web, sheet), Slender17(p, length, web, flange, sheet), share);
    PutPlastic(v, kTable17,
               CodeNumber(1.0 - share) + " compact + " + CodeNumber(share) +
                   " slender; IO 0.5 a, LS 0.75 b, CP b",
               R, sheet);
    if (!sheet.Sound()) return {};
    return T_STEEL_PLASTIC{yield, v, false};
}

// ---- ASCE 41-13 and FEMA 356 -------------------------------------------------------------------

/// Between P/P_CL of 0.2 and 0.5, in multiples of theta_y: compact at u = 1 - 5/3 P/P_CL.
T_CODE_PLASTIC Medium13(double p, double share, ASCE_EDITION edition, CCodeSheet& sheet)
{
    const double u = sheet.Put("u", 1.0 - 5.0 / 3.0 * p, kTable13, "1 - 5/3 P/P_CL", R);
    const bool primary = edition == ASCE_EDITION::Fema356Primary;
    const bool secondary = edition == ASCE_EDITION::Fema356Secondary;
    const T_CODE_PLASTIC compact{
        11.0 * u, 17.0 * u, 0.2, 0.25, (primary ? 8.0 : 14.0) * u, (primary ? 11.0 : 17.0) * u};
    const T_CODE_PLASTIC slender{1.0, 1.5, 0.2, 0.25, secondary ? 1.2 : 0.5, secondary ? 1.2 : 0.8};
    if (share > 0.0 && edition == ASCE_EDITION::Asce13)
        sheet.WarnConflict(kTable13, "slender: LS 0.5, CP 0.8", "LS 0.5 ... 1.2, CP 0.8 ... 1.2");
    const T_CODE_PLASTIC v = Between(compact, slender, share);
    PutPlastic(v, kTable13,
               CodeNumber(1.0 - share) + " compact + " + CodeNumber(share) + " slender (theta_y)",
               R, sheet);
    return v;
}

std::optional<T_STEEL_PLASTIC> Column13(const T_STEEL_MEMBER& m, double yield, ASCE_EDITION edition,
                                        CCodeSheet& sheet)
{
    if (!sheet.Positive({{"axialStrength", m.axialStrength}})) return {};
    const double p = sheet.Put("P/P_CL", std::max(0.0, m.axial) / m.axialStrength, kTable13,
                               "< 0.2; 0.2 ... 0.5; > 0.5: force-controlled", R);
    if (p > kForceControlled13) return ForceControlled(yield, kTable13, sheet);
    const T_PLATES plates = Plates(m, kTable13, sheet);
    T_CODE_PLASTIC v;
    if (p < kLowAxial) {
        v = SteelBeamLadder(SlenderShare(plates, 2.45, 3.76), edition, kTable13, sheet);
    } else {
        // 260 and 400 over sqrt(Fye in ksi), E = 29000 ksi.
        const double ksi = std::sqrt(29000.0);
        v = Medium13(p, SlenderShare(plates, 260.0 / ksi, 400.0 / ksi), edition, sheet);
    }
    if (!sheet.Sound()) return {};
    return T_STEEL_PLASTIC{yield, InYields(v, yield, kTable13, "theta_y", sheet), false};
}

/// AISC 341 Table D1.1: the plates of a highly ductile I under a compression of p = P/Pye.
bool HighlyDuctile(const T_STEEL_MEMBER& m, double p, CCodeSheet& sheet)
{
    constexpr const char* kClause = "AISC 341 Table D1.1";
    constexpr double kPhi = 0.9; // of Ca = P/(phi Pye)
    const double root = std::sqrt(m.E / m.Fye), Ca = p / kPhi;
    const double low = 2.57 * (1.0 - 1.04 * Ca), high = std::max(1.57, 0.88 * (2.68 - Ca));
    const double flange = root * sheet.Put("bf/2tf limit / sqrt(E/Fye)", 0.32, kClause, "", R);
    const double web =
        root * sheet.Put("h/tw limit / sqrt(E/Fye)", Ca <= 0.114 ? low : high, kClause,
                         "Ca <= 0.114: 2.57 (1 - 1.04 Ca); 0.88 (2.68 - Ca) >= 1.57,"
                         " Ca = P/(0.9 Pye)",
                         R);
    return sheet.Within("bf/2tf", m.bf / (2.0 * m.tf), 0.0, flange) &&
           sheet.Within("h/tw", m.h / m.tw, 0.0, web);
}

} // namespace

std::optional<T_STEEL_PLASTIC> AsceSteelColumn(const T_STEEL_MEMBER& m, ASCE_EDITION edition,
                                               CCodeSheet& sheet)
{
    const std::optional<double> yield = AsceSteelYieldRotation(m, true, edition, sheet);
    if (!yield) return {};
    return edition == ASCE_EDITION::Asce17 ? Column17(m, *yield, sheet)
                                           : Column13(m, *yield, edition, sheet);
}

std::optional<T_STEEL_PLASTIC> Aisc342Column(const T_STEEL_MEMBER& m, CCodeSheet& sheet)
{
    const auto yield = AsceSteelYieldRotation(m, true, ASCE_EDITION::Asce17, sheet);
    if (!yield || !sheet.Positive({{"ry", m.ry}})) return {};
    const double p = std::max(0.0, m.axial) / (m.A * m.Fye);
    if (!HighlyDuctile(m, p, sheet)) return {};
    if (p > kForceControlled17) return ForceControlled(*yield, kAisc, sheet);
    const double web = m.h / m.tw, length = m.length / m.ry;
    T_CODE_PLASTIC v;
    v.a = sheet.Put("a",
                    std::min(0.07, 5.5 * std::pow(web, -0.95) * std::pow(length, -0.5) *
                                       std::pow(1.0 - p, 2.4)),
                    kAisc, "5.5 (h/tw)^-0.95 (L/ry)^-0.5 (1 - p)^2.4 <= 0.07", S2);
    v.b = sheet.Put("b",
                    std::min(0.07, 20.0 * std::pow(web, -0.9) * std::pow(length, -0.5) *
                                       std::pow(1.0 - p, 3.4)),
                    kAisc, "20 (h/tw)^-0.9 (L/ry)^-0.5 (1 - p)^3.4 <= 0.07", S1);
    v.c = sheet.Put("c", 0.4 - 0.4 * p, kAisc, "0.4 - 0.4 p", S1);
    Accept(v);
    sheet.Put("IO", v.IO, kAisc, "0.5 a", R);
    sheet.Put("LS", v.LS, kAisc, "0.75 b", R);
    sheet.Put("CP", v.CP, kAisc, "b", R);
    if (!sheet.Sound()) return {};
    return T_STEEL_PLASTIC{*yield, v, false};
}

std::optional<double> AsceSteelMoment(const T_STEEL_MEMBER& m, ASCE_EDITION edition,
                                      CCodeSheet& sheet)
{
    if (!SoundSteel(m, sheet)) return {};
    const double full = m.Z * m.Fye, p = std::fabs(m.axial) / (m.A * m.Fye);
    if (!sheet.Within("axial", p, 0.0, 1.0)) return {};
    if (edition != ASCE_EDITION::Asce17)
        return sheet.Put("M_CE", std::min(full, 1.18 * full * (1.0 - p)), kDimMoment,
                         "ASCE 41-13 Eq. (9-4)", "1.18 Z Fye (1 - P/Pye) <= Z Fye", R);
    constexpr const char* kClause = "ASCE 41-17 9.4.2.3";
    sheet.WarnConflict(kClause, "P/Pye < 0.2: Z Fye (1 - P/(2 Pye))", "Z Fye (1 - P/Pye)");
    return sheet.Put("M_CE", full * (p < 0.2 ? 1.0 - p / 2.0 : 9.0 / 8.0 * (1.0 - p)), kDimMoment,
                     kClause, "Z Fye (1 - P/(2 Pye)), P/Pye < 0.2; 9/8 Z Fye (1 - P/Pye)", R);
}
