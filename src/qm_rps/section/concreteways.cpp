// How concrete sections are checked beside the section calculator.
#include "qm_base/say.h"
#include "qm_rps/codes/biaxial.h"
#include "qm_rps/codes/concreteshear.h"
#include "qm_rps/generate/rcend.h"
#include "qm_rps/section/sectionways.h"

#include <algorithm>
#include <numbers>

namespace {

constexpr auto K = CODE_MARK::Computed;
constexpr auto R = CODE_MARK::Recalled;
constexpr double kQuarter = std::numbers::pi / 2.0;
constexpr double kAlongY = 0.0, kAlongZ = kQuarter; // directions of My and Mz
constexpr double kGammaC = 1.5, kGammaS = 1.15;     // EN 1992-1-1 Table 2.1N

/// The direction of a moment about one axis.
double SideOf(double axis, double moment)
{
    return moment < 0.0 ? axis + std::numbers::pi : axis;
}

// ---- bending about both axes --------------------------------------------------------------------

std::optional<double> Contour(const T_CHECK_JOB& job, const T_SECTION_FORCES& f, CCodeSheet& sheet,
                              std::string& reason)
{
    constexpr const char* kClause = "EN 1992-1-1 5.8.9(4)";
    const T_SECT_D& s = job.section;
    const bool circle = s.shape == SECT_SHAPE::Circle;
    if (!circle && s.shape != SECT_SHAPE::Rectangle) {
        sheet.Refuse(CODE_REASON::Missing, "shape", "rectangle, circle");
        return {};
    }
    double bars = 0.0;
    for (const T_REBAR& bar : s.bars)
        bars += bar.area;
    const T_SECTION_STRENGTHS& strengths = job.strengths;
    const double squash = sheet.Put("NRd", s.area * strengths.fc + bars * strengths.fy, kDimForce,
                                    kClause, "Ac fcd + As fyd", R);
    const auto y = job.Moment(SideOf(kAlongY, f.My), f.N, reason);
    const auto z = y ? job.Moment(SideOf(kAlongZ, f.Mz), f.N, reason) : std::nullopt;
    if (!z || !sheet.Positive({{"MRdy", *y}, {"MRdz", *z}})) return {};
    sheet.Put("MRdy", *y, kDimMoment, "", "at N, without Mz", K);
    sheet.Put("MRdz", *z, kDimMoment, "", "at N, without My", K);
    return EnBiaxialRatio(f.N / squash, std::fabs(f.My) / *y, std::fabs(f.Mz) / *z, circle, sheet);
}

/// Where the moment in a direction is eccentricity times axial force. Between no axial force and
/// the pure strength there is one such place: the strengths lie on a convex curve.
std::optional<double> AxialAt(const T_CHECK_JOB& job, double direction, double eccentricity,
                              std::string& reason)
{
    constexpr double kDigits = 1e-9;
    double low = 0.0, high = job.compression;
    while (high - low > kDigits * job.compression) {
        const double middle = 0.5 * (low + high);
        const auto moment = job.Moment(direction, middle, reason);
        if (!moment) return {};
        (*moment > eccentricity * middle ? low : high) = middle;
    }
    return 0.5 * (low + high);
}

std::optional<double> Bresler(const T_CHECK_JOB& job, const T_SECTION_FORCES& f, CCodeSheet& sheet,
                              std::string& reason)
{
    constexpr const char* kClause = "Bresler 1960";
    constexpr double kLeast = 0.1; // of P0: below, bending governs and the reciprocal is not meant
    const double pure = job.compression;
    if (!sheet.Positive({{"N", f.N}, {"P0", pure}})) return {};
    const auto y = AxialAt(job, SideOf(kAlongY, f.My), std::fabs(f.My) / f.N, reason);
    const auto z =
        y ? AxialAt(job, SideOf(kAlongZ, f.Mz), std::fabs(f.Mz) / f.N, reason) : std::nullopt;
    if (!z) return {};
    sheet.Put("P0", pure, kDimForce, "", "uniform strain", K);
    sheet.Put("Pn (My)", *y, kDimForce, "", "at My/N alone", K);
    sheet.Put("Pn (Mz)", *z, kDimForce, "", "at Mz/N alone", K);
    const auto both = BreslerAxial(*y, *z, pure, sheet);
    if (!both) return {};
    const double share = sheet.Put("Pn/P0", *both / pure, kClause, "at least 0.1", R);
    if (!sheet.Within("Pn/P0", share, kLeast, 1.0)) return {};
    return sheet.Put("ratio", f.N / *both, kClause, "N/Pn", K);
}

// ---- shear --------------------------------------------------------------------------------------

using SHEAR_RULE = std::optional<double> (*)(const T_CHECK_JOB&, const T_RC_BENDING&, double axial,
                                             CCodeSheet&);

std::optional<double> EnStrength(const T_CHECK_JOB& job, const T_RC_BENDING& b, double axial,
                                 CCodeSheet& sheet)
{
    T_EN_SHEAR_OPTIONS o{1.0, 1.0, job.request.cotTheta};
    const T_SECTION_STRENGTHS& f = job.strengths;
    double fc = f.fc;
    if (job.IsDesign()) {
        o.gammaC = kGammaC, o.gammaS = kGammaS;
        o.alphaCc = job.request.options.alphaCc;
        fc = f.fcClass;
    }
    const auto v = EnShear(ShearSectionOf(b, fc, f.fyw, axial), o, sheet);
    if (!v) return {};
    return sheet.Put("VR", std::max(v->concrete, v->VRd), kDimForce, "EN 1992-1-1 6.2.1(3)",
                     "VRd,c where it is above VRd", R);
}

std::optional<double> AciStrength(const T_CHECK_JOB& job, const T_RC_BENDING& b, double axial,
                                  CCodeSheet& sheet)
{
    if (job.IsDesign()) {
        sheet.Refuse(CODE_REASON::NoRow, "design", "ACI 318 (phi, 21.2)");
        return {};
    }
    const T_SECTION_STRENGTHS& f = job.strengths;
    const auto v = AciShear(ShearSectionOf(b, f.fc, f.fyw, axial), 1.0, sheet);
    return v ? std::optional(v->Vn) : std::nullopt;
}

/// The side that the moment compresses; without a moment the weaker one.
std::optional<double> ShearRatio(const T_CHECK_JOB& job, bool aboutY, double shear, double moment,
                                 double axial, SHEAR_RULE strength, CCodeSheet& sheet)
{
    std::optional<double> least;
    CCodeSheet kept;
    for (const bool positive : {true, false}) {
        if (positive ? moment < 0.0 : moment > 0.0) continue;
        CCodeSheet own;
        const auto bending = RcBending(job.section, aboutY, positive, own);
        const auto v = bending ? strength(job, *bending, axial, own) : std::nullopt;
        if (!v || !own.Positive({{"VR", *v}})) {
            sheet = own;
            return {};
        }
        if (least && *least <= *v) continue;
        least = v;
        kept = own;
    }
    sheet = kept;
    return sheet.Put("ratio", std::fabs(shear) / *least, "", "V/VR", K);
}

template <SHEAR_RULE STRENGTH>
std::optional<double> AlongZ(const T_CHECK_JOB& job, const T_SECTION_FORCES& f, CCodeSheet& sheet,
                             std::string&)
{
    return ShearRatio(job, true, f.Vz, f.My, f.N, STRENGTH, sheet);
}
template <SHEAR_RULE STRENGTH>
std::optional<double> AlongY(const T_CHECK_JOB& job, const T_SECTION_FORCES& f, CCodeSheet& sheet,
                             std::string&)
{
    return ShearRatio(job, false, f.Vy, f.Mz, f.N, STRENGTH, sheet);
}

using enum SECTION_CHECKED;
constexpr auto En = SECTION_CHECK_CODE::En, Aci = SECTION_CHECK_CODE::Aci;
constexpr std::array<T_CHECK_WAY, 6> kWays{{
    {Bending, "EN 1992-1-1 5.8.9(4)", En, HasBothMoments, Contour},
    {Bending, "Bresler 1960", {}, HasBothMoments, Bresler},
    {ShearZ, "EN 1992-1-1 6.2", En, HasShearZ, AlongZ<EnStrength>},
    {ShearZ, "ACI 318 22.5", Aci, HasShearZ, AlongZ<AciStrength>},
    {ShearY, "EN 1992-1-1 6.2", En, HasShearY, AlongY<EnStrength>},
    {ShearY, "ACI 318 22.5", Aci, HasShearY, AlongY<AciStrength>},
}};

} // namespace

std::span<const T_CHECK_WAY> ConcreteWays()
{
    return kWays;
}
