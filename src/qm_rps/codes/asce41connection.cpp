#include "qm_rps/codes/asce41connection.h"

#include <algorithm>
#include <cmath>

namespace {

constexpr auto S2 = CODE_MARK::SightedTwice;
constexpr auto S1 = CODE_MARK::SightedOnce;
constexpr auto R = CODE_MARK::Recalled;
constexpr const char* kTable = "ASCE 41-17 Table 9-7.2";
constexpr const char* kFactors = "ASCE 41-17 9.4.2.4.3";

struct T_ROW {
    FR_CONNECTION kind;
    const char* name;
    double a0, a1, b0, b1; // a = a0 - a1 d, b = b0 - b1 d; d in inches
    double c;
    CODE_MARK mark;
};
// clang-format off
constexpr std::array<T_ROW, 11> kRows{{
    //                                                       a0      a1      b0     b1      c
    {FR_CONNECTION::WeldedFlange,         "WUF",            0.051,  0.0013, 0.043, 0.0006, 0.2, S1},
    {FR_CONNECTION::WeldedFlangeCollapse, "WUF (collapse)", 0.0284, 0.0004, 0.043, 0.0006, 0.2, S1},
    {FR_CONNECTION::ImprovedBoltedWeb,    "WUF-B",          0.021,  0.0003, 0.050, 0.0006, 0.2, S1},
    {FR_CONNECTION::ImprovedWeldedWeb,    "WUF-W",          0.041,  0.0,    0.054, 0.0,    0.2, R},
    {FR_CONNECTION::FreeFlange,           "FF",             0.067,  0.0012, 0.094, 0.0016, 0.2, S1},
    {FR_CONNECTION::ReducedBeamSection,   "RBS",            0.050,  0.0003, 0.070, 0.0003, 0.2, S2},
    {FR_CONNECTION::SidePlate,            "side plate",     0.089,  0.0005, 0.169, 0.0001, 0.6, S1},
    {FR_CONNECTION::TeeBoltShear,         "tee, bolt V",    0.036,  0.0,    0.048, 0.0,    0.2, S1},
    {FR_CONNECTION::TeeBoltTension,       "tee, bolt N",    0.016,  0.0,    0.024, 0.0,    0.8, S1},
    {FR_CONNECTION::TeeStemTension,       "tee, stem N",    0.012,  0.0,    0.018, 0.0,    0.8, S1},
    {FR_CONNECTION::TeeFlexure,           "tee, M",         0.042,  0.0,    0.084, 0.0,    0.2, S1},
}};
// clang-format on
constexpr double kPenalty = 0.8; // of plates, and of the panel zone

/// The column's flange is stiff enough, by itself or with plates.
bool ContinuityServes(const T_FR_CONNECTION& c)
{
    if (c.columnFlange >= c.flangeWidth / 5.2) return true;
    if (c.columnFlange >= c.flangeWidth / 7.0 && c.continuityPlate >= c.flangeThickness / 2.0)
        return true;
    return c.continuityPlate >= c.flangeThickness;
}

double Factor(const T_FR_CONNECTION& c, CCodeSheet& sheet)
{
    const double plates =
        sheet.Put("k_cp", ContinuityServes(c) ? 1.0 : kPenalty, kFactors,
                  "1: tcf >= bf/5.2; tcf >= bf/7 and t >= tf/2; t >= tf; else 0.8", S1);
    const bool balanced = 0.6 <= c.panelRatio && c.panelRatio <= 0.9;
    const double panel = sheet.Put("k_pz", balanced ? 1.0 : kPenalty, kFactors,
                                   "1: 0.6 <= Vpz/Vye <= 0.9; else 0.8", S1);
    const double ratio = c.span / c.depth;
    const double span = sheet.Put("k_L", ratio >= 8.0 ? 1.0 : std::pow(0.5, (8.0 - ratio) / 3.0),
                                  kFactors, "L/d < 8: 0.5^((8 - L/d)/3)", S1);
    const double slender =
        sheet.Put("k_s", 1.0 - 0.5 * c.slenderShare, kFactors, "1 compact, 0.5 slender", S1);
    return plates * panel * span * slender;
}

} // namespace

double AscePanelStrength(const T_STEEL_JOINT& j, CCodeSheet& sheet)
{
    return sheet.Put("Vye", 0.55 * j.columnFye * j.columnDepth * j.columnWeb, kDimForce, kFactors,
                     "0.55 Fye dc tcw", R);
}

double AscePanelShear(double moment, double depth, double columnShear, CCodeSheet& sheet)
{
    constexpr double kLever = 0.95; // of the beam's depth, between its flanges
    sheet.Put("sum M", std::fabs(moment), kDimMoment, kFactors, "of the beams' ends", R);
    sheet.Put("Vc", std::fabs(columnShear), kDimForce, kFactors, "of the column above", R);
    return sheet.Put("Vpz", std::fabs(moment / (kLever * depth) - columnShear), kDimForce, kFactors,
                     "sum M/(0.95 d) - Vc", R);
}

std::optional<double> AscePanelRatio(const T_STEEL_JOINT& j, double depth, CCodeSheet& sheet)
{
    sheet.Positive({{"columnDepth", j.columnDepth}, {"columnWeb", j.columnWeb}});
    sheet.Positive({{"columnFye", j.columnFye}, {"beams", j.beams}, {"depth", depth}});
    if (!sheet.Within("depth", depth, 0.0, j.storey)) return {};
    sheet.Put("sum M", j.beams, kDimMoment, kFactors, "Z Fye L/(L - dc) of the beams", R);
    const double shear = sheet.Put("Vpz", j.beams / depth * (j.storey - depth) / j.storey,
                                   kDimForce, kFactors, "sum M/d (h - d)/h", R);
    return sheet.Put("Vpz/Vye", shear / AscePanelStrength(j, sheet), kFactors, "",
                     CODE_MARK::Computed);
}

std::optional<T_CODE_PLASTIC> AsceConnection(const T_FR_CONNECTION& c, CCodeSheet& sheet)
{
    if (!sheet.Positive({{"depth", c.depth}})) return {};
    const auto row =
        std::find_if(kRows.begin(), kRows.end(), [&](const T_ROW& r) { return r.kind == c.kind; });
    if (row == kRows.end()) {
        sheet.Refuse(CODE_REASON::NoRow, "kind", kTable);
        return {};
    }
    double factor = 1.0;
    if (c.applyFactors) {
        sheet.Positive({{"span", c.span}, {"flangeWidth", c.flangeWidth}});
        sheet.Positive({{"flangeThickness", c.flangeThickness}, {"columnFlange", c.columnFlange}});
        sheet.NotNegative({{"continuityPlate", c.continuityPlate}, {"panelRatio", c.panelRatio}});
        if (!sheet.Within("slenderShare", c.slenderShare, 0.0, 1.0)) return {};
        factor = Factor(c, sheet);
    }
    const double inches = c.depth / kMetresPerInch;
    const double a = row->a0 - row->a1 * inches, b = row->b0 - row->b1 * inches;
    if (!(a > 0.0)) sheet.WarnOutside(kTable, "d (in)", inches, row->a0 / row->a1);
    const std::string text = std::string(row->name) + ": " + CodeNumber(row->a0) + " - " +
                             CodeNumber(row->a1) + " d; " + CodeNumber(row->b0) + " - " +
                             CodeNumber(row->b1) + " d (in)";
    T_CODE_PLASTIC p;
    p.a = sheet.Put("a", factor * std::max(0.0, a), kTable, text, row->mark);
    p.b = sheet.Put("b", factor * std::max({0.0, a, b}), kTable, text, row->mark);
    p.c = sheet.Put("c", row->c, kTable, row->name, row->mark);
    return sheet.Sound() ? std::optional(p) : std::nullopt;
}
