#include "qm_rps/section/sectionvalues.h"

#include "qm_rps/codes/asce41strength.h"
#include "qm_rps/generate/rcmember.h"

namespace {

constexpr auto K = CODE_MARK::Computed;
constexpr auto R = CODE_MARK::Recalled;

// Recommended values of persistent design situations, EN 1992-1-1 Table 2.1N, EN 1993-1-1 6.1.
constexpr double kGammaC = 1.5, kGammaS = 1.15, kGammaM0 = 1.0;

/// A strength of the record, which must be there.
double Entered(const char* member, double value, const T_MATL_D& m, CCodeSheet& sheet,
               const char* clause = "", CODE_MARK mark = K)
{
    if (!(value > 0.0)) {
        sheet.Refuse(CODE_REASON::Missing, member, m.name);
        return 0.0;
    }
    return sheet.Put(member, value, kDimStress, clause, "", mark);
}

struct T_LOWER {
    const char* clause = "";
    CODE_MARK mark = K;
};
T_LOWER LowerOf(SECTION_VALUES values)
{
    if (values != SECTION_VALUES::LowerBound) return {};
    return {"ASCE 41-17: lower-bound strength, as specified", R};
}

// ---- concrete -----------------------------------------------------------------------------------

T_SECTION_STRENGTHS EnteredConcrete(const T_MATL_D& m, SECTION_VALUES values, CCodeSheet& sheet)
{
    const auto [clause, mark] = LowerOf(values);
    T_SECTION_STRENGTHS s;
    s.fc = s.fcClass = Entered("fck", m.fck, m, sheet, clause, mark);
    s.fy = s.fyw = Entered("fyk", m.fyk, m, sheet, clause, mark);
    return s;
}

T_SECTION_STRENGTHS MeanConcrete(const T_MATL_D& m, CCodeSheet& sheet)
{
    const T_MATL_MEAN mean = m.mean.value_or(T_MATL_MEAN{});
    T_SECTION_STRENGTHS s;
    s.fc = s.fcClass = Entered("mean.fc", mean.fc, m, sheet);
    s.fy = s.fyw = Entered("mean.fy", mean.fy, m, sheet);
    if (mean.fyw > 0.0) s.fyw = Entered("mean.fyw", mean.fyw, m, sheet);
    return s;
}

T_SECTION_STRENGTHS DesignConcrete(const T_MATL_D& m, double alphaCc, CCodeSheet& sheet)
{
    if (!sheet.Within("alpha_cc", alphaCc, 0.5, 1.0)) return {};
    T_SECTION_STRENGTHS s = EnteredConcrete(m, SECTION_VALUES::Characteristic, sheet);
    s.fc = sheet.Put("fcd", alphaCc * s.fc / kGammaC, kDimStress, "EN 1992-1-1 3.1.6, 2.4.2.4",
                     CodeNumber(alphaCc) + " fck/" + CodeNumber(kGammaC), R);
    s.fy = sheet.Put("fyd", s.fy / kGammaS, kDimStress, "EN 1992-1-1 3.2.7, 2.4.2.4",
                     "fyk/" + CodeNumber(kGammaS), R);
    return s;
}

/// Strengths that hinges of a code are made with, too.
T_SECTION_STRENGTHS ByHingeCode(const T_MATL_D& m, HINGE_CODE code, CCodeSheet& sheet)
{
    const std::optional<T_RC_MATERIAL> r = RcMaterial(m, code, sheet);
    return r ? T_SECTION_STRENGTHS{r->fc, r->fc, r->fy, r->fyw, r->Es} : T_SECTION_STRENGTHS{};
}

T_SECTION_STRENGTHS Concrete(const T_MATL_D& m, const T_SECTION_OPTIONS& o, CCodeSheet& sheet)
{
    switch (o.values) {
    case SECTION_VALUES::Mean:
        return MeanConcrete(m, sheet);
    case SECTION_VALUES::Expected:
        return ByHingeCode(m, HINGE_CODE::Asce17, sheet);
    case SECTION_VALUES::Assessed:
        return ByHingeCode(m, HINGE_CODE::En1998, sheet);
    case SECTION_VALUES::Design:
        return DesignConcrete(m, o.alphaCc, sheet);
    case SECTION_VALUES::Characteristic:
    case SECTION_VALUES::LowerBound:
        break;
    }
    return EnteredConcrete(m, o.values, sheet);
}

// ---- steel --------------------------------------------------------------------------------------

double SteelStrength(const T_MATL_D& m, SECTION_VALUES values, CCodeSheet& sheet)
{
    const double mean = m.mean ? m.mean->fy : 0.0;
    switch (values) {
    case SECTION_VALUES::Mean:
        return Entered("mean.fy", mean, m, sheet);
    case SECTION_VALUES::Expected: {
        if (mean > 0.0) return Entered("mean.fy", mean, m, sheet);
        const double fy = Entered("fy", m.Fy, m, sheet);
        const double factor = AsceExpectedFactor(ASCE_MATERIAL::Steel, sheet);
        return sheet.Put("fyE", factor * fy, kDimStress, "ASCE 41-17 Table 9-3",
                         "fy x " + CodeNumber(factor), R);
    }
    case SECTION_VALUES::Assessed: {
        const double fy = Entered("mean.fy", mean, m, sheet);
        const std::optional<double> factor = ConfidenceOf(m, sheet);
        if (!factor || !sheet.Positive({{"confidence_factor", *factor}})) return 0.0;
        return sheet.Put("fy", fy / *factor, kDimStress, "EN 1998-3 Annex B", "mean.fy/CF",
                         CODE_MARK::SightedOnce);
    }
    case SECTION_VALUES::Design:
        return sheet.Put("fyd", Entered("fy", m.Fy, m, sheet) / kGammaM0, kDimStress,
                         "EN 1993-1-1 6.1", "fy/" + CodeNumber(kGammaM0), R);
    case SECTION_VALUES::Characteristic:
    case SECTION_VALUES::LowerBound:
        break;
    }
    const auto [clause, mark] = LowerOf(values);
    return Entered("fy", m.Fy, m, sheet, clause, mark);
}

} // namespace

std::optional<T_SECTION_STRENGTHS> SectionStrengths(const T_MATL_D& m, const T_SECTION_OPTIONS& o,
                                                    CCodeSheet& sheet)
{
    T_SECTION_STRENGTHS s;
    if (m.type == MATL_CLASS::Concrete) {
        if (o.law == SECTION_LAW::Aci && o.values == SECTION_VALUES::Design)
            sheet.Refuse(CODE_REASON::NoRow, "design", "ACI 318 (phi of the section, 21.2)");
        s = Concrete(m, o, sheet);
        s.E = Entered("Es", m.Es, m, sheet);
    } else if (m.type == MATL_CLASS::Steel) {
        s.fy = s.fyw = SteelStrength(m, o.values, sheet);
        s.E = Entered("E", m.E, m, sheet);
    } else {
        sheet.Refuse(CODE_REASON::NoRow, "type", "concrete, steel");
    }
    return sheet.Sound() ? std::optional(s) : std::nullopt;
}
