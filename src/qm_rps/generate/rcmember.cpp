#include "qm_rps/generate/rcmember.h"

#include "qm_rps/codes/asce41strength.h"
#include "qm_rps/codes/en1998rotation.h"

#include <algorithm>
#include <cmath>
#include <numbers>

namespace {

constexpr auto K = CODE_MARK::Computed;
constexpr double kSameRow = 0.1;   // of the depth
constexpr double kRounding = 1e-6; // of the depth: a bar there lies on the edge of its row

/// Bars of one row: area and first moment of their depths.
struct T_ROW_SUM {
    double area = 0.0, moment = 0.0, largest = 0.0;
    void Add(double bar, double depth, double share = 1.0)
    {
        area += share * bar;
        moment += share * bar * depth;
        largest = std::max(largest, bar);
    }
};

/// The mean of the material, or its characteristic strength times the factor of the code.
double Expected(double mean, double characteristic, ASCE_MATERIAL kind, const char* symbol,
                const char* member, CCodeSheet& sheet)
{
    if (mean > 0.0) return sheet.Put(symbol, mean, kDimStress, "", "mean", K);
    if (!(characteristic > 0.0)) {
        sheet.Refuse(CODE_REASON::Missing, member, "mean");
        return 0.0;
    }
    const double factor = AsceExpectedFactor(kind, sheet);
    return sheet.Put(symbol, factor * characteristic, kDimStress, "ASCE 41-17 Table 10-1",
                     std::string(member) + " x " + CodeNumber(factor), CODE_MARK::Recalled);
}

T_RC_MATERIAL Divided(const T_MATL_MEAN& mean, double factor, CCodeSheet& sheet)
{
    const auto put = [&](const char* symbol, double value, const char* text) {
        return sheet.Put(symbol, value / factor, kDimStress, "EN 1998-3 Annex A", text,
                         CODE_MARK::SightedOnce);
    };
    T_RC_MATERIAL r;
    r.fc = put("fc", mean.fc, "mean.fc/CF");
    r.fy = put("fy", mean.fy, "mean.fy/CF");
    r.fyw =
        mean.fyw > 0.0 ? put("fyw", mean.fyw, "mean.fyw/CF") : put("fyw", mean.fy, "mean.fy/CF");
    r.Ec = sheet.Put("Ec", ConcreteModulus(mean.fc), kDimStress, "EN 1992-1-1 Table 3.1",
                     "22 (mean.fc/10)^0.3 GPa", CODE_MARK::SightedTwice);
    return r;
}

/// Tension and compression steel and their depths. Of a circle the bars of either half count; one
/// on the axis of bending counts half to each.
bool PutBars(const T_SECT_D& s, bool aboutY, bool positive, T_RC_BENDING& r, CCodeSheet& sheet)
{
    std::vector<double> depths; // from the compressed edge
    for (const T_REBAR& bar : s.bars)
        depths.push_back(0.5 * r.h - (positive ? 1.0 : -1.0) * (aboutY ? bar.z : bar.y));
    const auto [first, last] = std::ranges::minmax(depths);
    const double rounding = kRounding * r.h;
    const double least = r.round ? 0.5 * r.h : last - kSameRow * r.h;
    const double most = r.round ? 0.5 * r.h : first + kSameRow * r.h;
    T_ROW_SUM tension, compression;
    for (std::size_t i = 0; i < depths.size(); ++i) {
        const double area = s.bars[i].area, depth = depths[i];
        if (r.round && std::fabs(depth - 0.5 * r.h) <= rounding) {
            tension.Add(area, depth, 0.5);
            compression.Add(area, depth, 0.5);
        } else if (depth >= least - rounding) {
            tension.Add(area, depth);
        } else if (depth <= most + rounding) {
            compression.Add(area, depth);
        } else {
            r.AsWeb += area;
        }
    }
    if (!sheet.Positive({{"As", tension.area}, {"AsPrime", compression.area}})) return false;
    r.As = sheet.Put("As", tension.area, T_DIM{0, 2}, "", r.round ? "half of the bars" : "", K);
    r.AsPrime = sheet.Put("As'", compression.area, T_DIM{0, 2}, "", "", K);
    r.d = r.round ? sheet.Put("d", 0.8 * r.h, kDimLength, "ACI 318 22.5.2.2", "0.8 D",
                              CODE_MARK::Recalled)
                  : sheet.Put("d", tension.moment / tension.area, kDimLength, "", "", K);
    r.dPrime = sheet.Put("d'", compression.moment / compression.area, kDimLength, "", "", K);
    r.barDiameter = 2.0 * std::sqrt(tension.largest / std::numbers::pi);
    return true;
}

} // namespace

bool IsWallSection(const T_SECT_D& section)
{
    constexpr double kWall = 4.0;
    const auto [thin, wide] = std::minmax(section.size[0], section.size[1]);
    return section.shape == SECT_SHAPE::Rectangle && wide > kWall * thin;
}

std::optional<T_RC_BENDING> RcBending(const T_SECT_D& s, bool aboutY, bool positive,
                                      CCodeSheet& sheet)
{
    const bool round = s.shape == SECT_SHAPE::Circle;
    if ((!round && s.shape != SECT_SHAPE::Rectangle) || !s.detailing || s.bars.empty()) {
        sheet.Refuse(CODE_REASON::Missing,
                     s.bars.empty() ? "bars"
                     : s.detailing  ? "shape: rectangle, circle"
                                    : "detailing",
                     s.name);
        return {};
    }
    const T_SECT_DETAIL& detail = *s.detailing;
    T_RC_BENDING r;
    r.round = round;
    r.h = s.size[aboutY || round ? 0 : 1];
    r.b = round ? r.h : s.size[aboutY ? 1 : 0];
    r.area = round ? std::numbers::pi / 4.0 * r.h * r.h : r.b * r.h;
    sheet.Positive({{"stirrup_spacing", detail.stirrupSpacing}});
    if (!sheet.Positive({{"stirrup_diameter", detail.stirrupDiameter}})) return {};
    if (!PutBars(s, aboutY, positive, r, sheet)) return {};
    const double edge = 2.0 * detail.cover + detail.stirrupDiameter;
    r.coreB = r.b - edge;
    r.coreH = r.h - edge;
    if (!sheet.Positive({{"cover", r.coreB}, {"cover", r.coreH}})) return {};
    r.legs = round ? 2 : aboutY ? detail.legsZ : detail.legsY;
    r.across = round ? 2 : aboutY ? detail.legsY : detail.legsZ;
    r.legArea = std::numbers::pi / 4.0 * detail.stirrupDiameter * detail.stirrupDiameter;
    r.shear = sheet.Put("Av", r.legs * r.legArea, T_DIM{0, 2}, "", "", K);
    r.spacing = detail.stirrupSpacing;
    return r;
}

std::optional<double> ConfidenceOf(const T_MATL_D& m, CCodeSheet& sheet)
{
    if (m.confidence) return sheet.Put("CF", *m.confidence, "", "confidence_factor", K);
    if (m.knowledge) return ConfidenceFactor(static_cast<int>(*m.knowledge) + 1, sheet);
    sheet.Refuse(CODE_REASON::Missing, "knowledge", "KL1, KL2, KL3, confidence_factor");
    return {};
}

std::optional<T_RC_MATERIAL> RcMaterial(const T_MATL_D& m, HINGE_CODE code, CCodeSheet& sheet)
{
    if (m.type != MATL_CLASS::Concrete) {
        sheet.Refuse(CODE_REASON::Missing, "type: concrete", m.name);
        return {};
    }
    if (code == HINGE_CODE::Aisc342) {
        sheet.Refuse(CODE_REASON::NoRow, "type: concrete",
                     kHingeCodeNames[static_cast<std::size_t>(code)]);
        return {};
    }
    const T_MATL_MEAN mean = m.mean.value_or(T_MATL_MEAN{});
    T_RC_MATERIAL r;
    if (IsChordCode(code)) {
        if (!(mean.fc > 0.0)) sheet.Refuse(CODE_REASON::Missing, "mean.fc", m.name);
        if (!(mean.fy > 0.0)) sheet.Refuse(CODE_REASON::Missing, "mean.fy", m.name);
        const std::optional<double> factor = sheet.Sound() ? ConfidenceOf(m, sheet) : std::nullopt;
        if (!factor || !sheet.Positive({{"confidence_factor", *factor}})) return {};
        r = Divided(mean, *factor, sheet);
    } else {
        r.fc = Expected(mean.fc, m.fck, ASCE_MATERIAL::Concrete, "f'cE", "fck", sheet);
        r.fy = Expected(mean.fy, m.fyk, ASCE_MATERIAL::Rebar, "fyE", "fyk", sheet);
        const double stirrups = mean.fyw > 0.0 ? mean.fyw : mean.fy;
        r.fyw = Expected(stirrups, m.fyk, ASCE_MATERIAL::Rebar, "fytE", "fyk", sheet);
    }
    r.Es = m.Es;
    if (!sheet.Positive({{"Es", r.Es}})) return {};
    return r;
}
