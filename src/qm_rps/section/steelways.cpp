// How steel sections are checked beside the section calculator.
#include "qm_db/sectionproperties.h"
#include "qm_rps/codes/en1993class.h"
#include "qm_rps/codes/slenderplates.h"
#include "qm_rps/generate/steelmember.h"
#include "qm_rps/section/sectionways.h"

#include <algorithm>

namespace {

constexpr auto K = CODE_MARK::Computed;
constexpr auto R = CODE_MARK::Recalled;

/// Shape and plastic strengths.
struct T_STEEL_CHECK {
    T_STEEL_SHAPE shape;
    T_STEEL_PLASTIC_STRENGTH strength;
    double fy = 0.0, E = 0.0;

    bool IsI() const
    {
        return shape.shape == STEEL_SHAPE::RolledI || shape.shape == STEEL_SHAPE::WeldedI;
    }
};

std::optional<T_STEEL_CHECK> CheckOf(const T_CHECK_JOB& job, CCodeSheet& sheet)
{
    const T_SECT_D& s = job.section;
    const auto shape = SteelShapeOf(s, sheet);
    if (!shape) return {};
    const double fy = job.strengths.fy;
    T_STEEL_CHECK c{*shape, {s.area * fy, s.Zy * fy, s.Zz * fy}, fy, job.strengths.E};
    sheet.Put("Npl", c.strength.Npl, kDimForce, "", "A fy", K);
    sheet.Put("Mpl,y", c.strength.Mply, kDimMoment, "", "Wpl,y fy", K);
    sheet.Put("Mpl,z", c.strength.Mplz, kDimMoment, "", "Wpl,z fy", K);
    return c;
}

bool NotDesign(const T_CHECK_JOB& job, CCodeSheet& sheet)
{
    return !job.IsDesign() || sheet.Refuse(CODE_REASON::NoRow, "design", "AISC 360 (phi)");
}

// ---- EN 1993-1-1 --------------------------------------------------------------------------------

bool AtMost(int number, int worst, const char* clause, CCodeSheet& sheet)
{
    return number <= worst ||
           sheet.Refuse(CODE_REASON::NoRow, "class " + std::to_string(number), clause);
}

std::optional<double> EnAxial(const T_CHECK_JOB& job, const T_SECTION_FORCES& f, CCodeSheet& sheet,
                              std::string&)
{
    constexpr int kWorst = 3; // class 4 has an effective area
    const auto c = CheckOf(job, sheet);
    if (!c) return {};
    if (f.N > 0.0) {
        const auto number = En1993ClassCompressed(c->shape, c->fy, sheet);
        if (!number || !AtMost(*number, kWorst, "EN 1993-1-1 6.2.4", sheet)) return {};
    }
    return sheet.Put("ratio", std::fabs(f.N) / c->strength.Npl, "EN 1993-1-1 6.2.3, 6.2.4", "N/Npl",
                     R);
}

/// Share of fy that the plates along a shear force lose.
std::optional<double> Lost(const T_STEEL_CHECK& c, double shear, bool alongDepth, double& area,
                           CCodeSheet& sheet)
{
    if (shear == 0.0) return 0.0;
    CCodeSheet told; // with the strength
    const auto found = EnShearArea(c.shape, alongDepth, told);
    const auto strength = EnShearStrength(c.shape, alongDepth, c.fy, sheet);
    if (!strength || !found) return {};
    area = *found;
    return EnShearReduction(shear, *strength, sheet);
}

/// The strengths that shear leaves. Of an I under a force along its web by Eq. (6.30); others lose
/// the whole share in both moments, on the safe side.
bool TakeShear(T_STEEL_CHECK& c, const T_SECTION_FORCES& f, CCodeSheet& sheet)
{
    constexpr const char* kClause = "EN 1993-1-1 6.2.8(5), 6.2.10";
    double areaZ = 0.0, areaY = 0.0;
    const auto z = Lost(c, f.Vz, true, areaZ, sheet);
    const auto y = z ? Lost(c, f.Vy, false, areaY, sheet) : std::nullopt;
    if (!y) return false;
    if (*z == 0.0 && *y == 0.0) return true;
    T_STEEL_PLASTIC_STRENGTH& r = c.strength;
    double left = 1.0 - *y;
    if (c.IsI()) {
        const double web = (c.shape.h - 2.0 * c.shape.tf) * c.shape.tw;
        r.Mply -= *z * web * web / (4.0 * c.shape.tw) * c.fy;
    } else {
        left *= 1.0 - *z;
    }
    const double area = *z * areaZ + *y * areaY;
    r.Npl = sheet.Put("NV", r.Npl - area * c.fy, kDimForce, kClause, "Npl - rho Av fy", R);
    const char* const text = "I, V along the web: (Wpl - rho Aw^2/(4 tw)) fy; else (1 - rho) Mpl";
    r.Mply = sheet.Put("MV,y", left * r.Mply, kDimMoment, kClause, text, R);
    r.Mplz = sheet.Put("MV,z", left * r.Mplz, kDimMoment, kClause, text, R);
    return sheet.Positive({{"NV", r.Npl}, {"MV,y", r.Mply}, {"MV,z", r.Mplz}});
}

std::optional<double> EnBending(const T_CHECK_JOB& job, const T_SECTION_FORCES& f,
                                CCodeSheet& sheet, std::string&)
{
    constexpr int kPlastic = 2; // classes that reach their plastic moment
    auto c = CheckOf(job, sheet);
    if (!c) return {};
    for (const bool aboutY : {true, false}) {
        if ((aboutY ? f.My : f.Mz) == 0.0) continue;
        const auto number = En1993Class(c->shape, aboutY, f.N, c->fy, sheet);
        if (!number || !AtMost(*number, kPlastic, "EN 1993-1-1 6.2.9.1", sheet)) return {};
    }
    if (!TakeShear(*c, f, sheet)) return {};
    const auto found = EnAxialBending(c->shape, c->strength, {f.N, f.My, f.Mz}, sheet);
    return found ? std::optional(found->ratio) : std::nullopt;
}

std::optional<double> EnShearAlong(const T_CHECK_JOB& job, double shear, bool alongDepth,
                                   CCodeSheet& sheet)
{
    const auto shape = SteelShapeOf(job.section, sheet);
    const auto strength =
        shape ? EnShearStrength(*shape, alongDepth, job.strengths.fy, sheet) : std::nullopt;
    if (!strength) return {};
    return sheet.Put("ratio", std::fabs(shear) / *strength, "EN 1993-1-1 6.2.6",
                     "V/Vpl, slender webs V/Vbw", R);
}

std::optional<double> EnShearZ(const T_CHECK_JOB& job, const T_SECTION_FORCES& f, CCodeSheet& sheet,
                               std::string&)
{
    return EnShearAlong(job, f.Vz, true, sheet);
}

std::optional<double> EnShearY(const T_CHECK_JOB& job, const T_SECTION_FORCES& f, CCodeSheet& sheet,
                               std::string&)
{
    return EnShearAlong(job, f.Vy, false, sheet);
}

/// AISC 360 F6.1 about the weak axis: that of an I is below the limit by itself.
void LimitWeakAxis(const T_CHECK_JOB& job, T_STEEL_CHECK& c, CCodeSheet& sheet)
{
    if (job.section.shape != SECT_SHAPE::Channel) return;
    const double left = ChannelProperties(job.section).centroid;
    const double elastic = job.section.Izz / std::max(left, job.section.size[1] - left);
    c.strength.Mplz = sheet.Put("Mn,z", std::min(c.strength.Mplz, 1.6 * elastic * c.fy), kDimMoment,
                                "AISC 360 F6.1", "Fy Zy <= 1.6 Fy Sy", R);
}

// ---- AISC 360, surface --------------------------------------------------------------------------

std::optional<double> Aisc(const T_CHECK_JOB& job, const T_SECTION_FORCES& f, CCodeSheet& sheet,
                           std::string&)
{
    if (!NotDesign(job, sheet)) return {};
    auto c = CheckOf(job, sheet);
    if (!c || !AiscPlastic(c->shape, c->fy, c->E, f.N > 0.0, true, sheet)) return {};
    LimitWeakAxis(job, *c, sheet);
    sheet.Warn("IDS_QM_SECK_WARN_NOMINAL", {"AISC 360"});
    return AiscInteraction(c->strength, {f.N, f.My, f.Mz}, sheet);
}

std::optional<double> AiscShearAlong(const T_CHECK_JOB& job, double shear, bool alongDepth,
                                     CCodeSheet& sheet)
{
    if (!NotDesign(job, sheet)) return {};
    const auto shape = SteelShapeOf(job.section, sheet);
    if (!shape) return {};
    const auto strength =
        AiscShapeShear(*shape, alongDepth, job.strengths.fy, job.strengths.E, sheet);
    if (!strength) return {};
    sheet.Warn("IDS_QM_SECK_WARN_NOMINAL", {"AISC 360"});
    return sheet.Put("ratio", std::fabs(shear) / *strength, "AISC 360 G", "V/Vn", R);
}

std::optional<double> AiscShearZ(const T_CHECK_JOB& job, const T_SECTION_FORCES& f,
                                 CCodeSheet& sheet, std::string&)
{
    return AiscShearAlong(job, f.Vz, true, sheet);
}

std::optional<double> AiscShearY(const T_CHECK_JOB& job, const T_SECTION_FORCES& f,
                                 CCodeSheet& sheet, std::string&)
{
    return AiscShearAlong(job, f.Vy, false, sheet);
}

/// The ratio along the ray of all forces: 1 over the factor that brings them onto the surface.
std::optional<double> Surface(const T_CHECK_JOB& job, const T_SECTION_FORCES& f, CCodeSheet& sheet,
                              std::string&)
{
    const auto c = CheckOf(job, sheet);
    if (!c) return {};
    if (!c->IsI()) {
        sheet.Refuse(CODE_REASON::Missing, "shape: I", job.section.name);
        return {};
    }
    const T_STEEL_PLASTIC_STRENGTH& r = c->strength;
    const double p = f.N / r.Npl, my = f.My / r.Mply, mz = f.Mz / r.Mplz;
    // The surface rises along the ray; at the larger factor one term alone is 1 or more.
    double low = 0.0, high = 1.0 / std::max({std::fabs(p), std::fabs(my), std::fabs(mz)});
    constexpr double kDigits = 1e-12;
    while (high - low > kDigits * high) {
        const double factor = 0.5 * (low + high);
        CCodeSheet scratch;
        const auto value = WideFlangeSurface(factor * p, factor * my, factor * mz, scratch);
        if (!value) return {};
        (*value < 1.0 ? low : high) = factor;
    }
    if (!WideFlangeSurface(p, my, mz, sheet)) return {};
    return sheet.Put("ratio", 1.0 / high, "McGuire, Gallagher, Ziemian 10.18",
                     "1/factor of N, My, Mz that reaches surface = 1", K);
}

using enum SECTION_CHECKED;
constexpr auto En = SECTION_CHECK_CODE::En, Us = SECTION_CHECK_CODE::Aisc;
constexpr std::array<T_CHECK_WAY, 8> kWays{{
    {Axial, "EN 1993-1-1 6.2.3, 6.2.4", En, HasAxial, EnAxial},
    {Bending, "EN 1993-1-1 6.2.9", En, HasMoment, EnBending},
    {Bending, "AISC 360 H1-1", Us, HasMoment, Aisc},
    {Bending, "McGuire, Gallagher, Ziemian", {}, HasMoment, Surface},
    {ShearZ, "EN 1993-1-1 6.2.6", En, HasShearZ, EnShearZ},
    {ShearZ, "AISC 360 G", Us, HasShearZ, AiscShearZ},
    {ShearY, "EN 1993-1-1 6.2.6", En, HasShearY, EnShearY},
    {ShearY, "AISC 360 G", Us, HasShearY, AiscShearY},
}};

} // namespace

std::span<const T_CHECK_WAY> SteelWays()
{
    return kWays;
}
