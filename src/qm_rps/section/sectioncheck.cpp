#include "qm_rps/section/sectioncheck.h"

#include "qm_base/say.h"
#include "qm_db/sectionproperties.h"
#include "qm_rps/generate/steelmember.h"
#include "qm_rps/section/sectionmodelof.h"
#include "qm_rps/section/sectiontexts.h"
#include "qm_rps/section/sectionways.h"

#include <algorithm>

namespace {

using namespace solver;
constexpr auto K = CODE_MARK::Computed;

std::optional<double> ExactAxial(const T_CHECK_JOB& job, const T_SECTION_FORCES& f,
                                 CCodeSheet& sheet, std::string&)
{
    const double strength = f.N > 0.0 ? job.compression : job.tension;
    if (!sheet.Positive({{"NR", strength}})) return {};
    sheet.Put("NR", strength, kDimForce, "", "uniform strain", K);
    return sheet.Put("ratio", std::fabs(f.N) / strength, "", "N/NR", K);
}

std::optional<double> ExactBending(const T_CHECK_JOB& job, const T_SECTION_FORCES& f,
                                   CCodeSheet& sheet, std::string& reason)
{
    const auto strength = job.Moment(std::atan2(f.Mz, f.My), f.N, reason);
    if (!strength || !sheet.Positive({{"MR", *strength}})) return {};
    const double moment =
        sheet.Put("M", std::hypot(f.My, f.Mz), kDimMoment, "", "sqrt(My^2 + Mz^2)", K);
    sheet.Put("MR", *strength, kDimMoment, "", "in the direction of M, at N", K);
    return sheet.Put("ratio", moment / *strength, "", "M/MR", K);
}

/// Neither EN 1992-1-1 6.3 nor EN 1993-1-1 6.2.7 nor AISC 360 H3 are in this program.
std::optional<double> Torsion(const T_CHECK_JOB&, const T_SECTION_FORCES&, CCodeSheet&,
                              std::string& reason)
{
    reason = Say("IDS_QM_SECK_NO_TORSION");
    return {};
}

constexpr std::array<T_CHECK_WAY, 2> kExact{{
    {SECTION_CHECKED::Axial, "", {}, HasAxial, ExactAxial},
    {SECTION_CHECKED::Bending, "", {}, HasMoment, ExactBending},
}};
constexpr std::array<T_CHECK_WAY, 1> kTorsion{{
    {SECTION_CHECKED::Torsion,
     "-",
     {},
     [](const T_SECTION_FORCES& f) { return f.T != 0.0; },
     Torsion},
}};

T_SECTION_WAY Tried(const T_CHECK_WAY& way, const T_CHECK_JOB& job, const T_SECTION_FORCES& forces)
{
    CCodeSheet sheet;
    T_SECTION_WAY out;
    out.what = way.what;
    out.by = way.by;
    const std::optional<double> ratio = way.rule(job, forces, sheet, out.reason);
    if (ratio && sheet.Sound() && out.reason.empty()) {
        out.ratio = ratio;
        out.trace = sheet.Trace();
        out.warnings = sheet.Warnings();
    } else if (out.reason.empty()) {
        out.reason = sheet.Fault() ? FaultText(*sheet.Fault()) : Say("IDS_QM_GEN_NO_ANSWER");
    }
    return out;
}

T_SECTION_CHECKS Checked(const T_CHECK_JOB& job, bool concrete, const T_SECTION_FORCES& forces)
{
    const std::vector<SECTION_CHECK_CODE>& codes = job.request.codes;
    T_SECTION_CHECKS set;
    set.forces = forces;
    for (const std::span<const T_CHECK_WAY> ways :
         {std::span<const T_CHECK_WAY>(kExact), concrete ? ConcreteWays() : SteelWays(),
          std::span<const T_CHECK_WAY>(kTorsion)})
        for (const T_CHECK_WAY& way : ways) {
            const bool wanted =
                !way.code || codes.empty() || std::ranges::count(codes, *way.code) > 0;
            if (wanted && way.asked(forces)) set.ways.push_back(Tried(way, job, forces));
        }
    return set;
}

std::string RequestFault(const T_SECTION_CHECK_REQUEST& request)
{
    bool any = false;
    for (const T_SECTION_FORCES& f : request.forces)
        for (const T_SECTION_FORCE& force : kSectionForces) {
            if (!std::isfinite(f.*force.value)) return Say("IDS_QM_SECK_NOT_FINITE");
            any = any || f.*force.value != 0.0;
        }
    return any ? std::string() : Say("IDS_QM_SECK_NO_FORCES");
}

/// Without moments.
void PureStrengths(T_CHECK_JOB& job)
{
    T_CAPACITY pure;
    T_SECTION_ERROR none; // steel that hardens without end has no such strength
    if (job.solver.Capacity(0.0, 2.0, pure, none)) job.compression = pure.axial;
    if (job.solver.Capacity(0.0, -2.0, pure, none)) job.tension = -pure.axial;
}

} // namespace

std::optional<double> T_CHECK_JOB::Moment(double direction, double axial, std::string& reason) const
{
    T_CAPACITY at;
    T_SECTION_ERROR error;
    if (solver.TowardsMoment(direction, axial, at, error)) return std::hypot(at.My, at.Mz);
    reason = SectionErrorText(error, units);
    return {};
}

void SortByRatio(T_SECTION_CHECK& check)
{
    const auto worst = [](const T_SECTION_CHECKS& set) {
        double largest = -1.0;
        for (const T_SECTION_WAY& way : set.ways)
            largest = std::max(largest, way.ratio.value_or(-1.0));
        return -largest;
    };
    std::ranges::stable_sort(check.sets, {}, worst);
}

int CheckSection(const T_SECT_D& section, const T_MATL_D& material,
                 const T_SECTION_CHECK_REQUEST& request, const T_UNITS& units, T_SECTION_CHECK& out,
                 std::string& reason)
{
    reason = RequestFault(request);
    if (!reason.empty()) return 0;
    T_SECT_D s;
    SECT_FAULT fault = SECT_FAULT::None;
    if (!CSectionProperties::Calc(section, s, fault)) {
        reason = Say(MessageKeyOf(fault));
        return 0;
    }
    CCodeSheet sheet, again;
    const auto model = SectionModelOf(s, material, request.options, false, sheet);
    const auto strengths = SectionStrengths(material, request.options, again);
    if (!model || !strengths) {
        reason = FaultText(*sheet.Fault());
        return 0;
    }
    CSectionSolver solver;
    T_SECTION_ERROR error;
    if (!solver.Prepare(*model, error)) {
        reason = SectionErrorText(error, units);
        return 0;
    }
    T_CHECK_JOB job{s, request, *strengths, solver, 0.0, 0.0, units};
    PureStrengths(job);
    T_SECTION_CHECK check;
    check.section = section.name, check.material = material.name;
    check.options = request.options;
    check.ofConcrete = material.type == MATL_CLASS::Concrete;
    check.trace = sheet.Trace(), check.warnings = sheet.Warnings();
    const bool bentAboutY =
        std::ranges::any_of(request.forces, [](const T_SECTION_FORCES& f) { return f.My != 0.0; });
    if (!check.ofConcrete && bentAboutY && BucklesSideways(section))
        check.warnings.push_back({kNoSidewaysKey, {}});
    for (const T_SECTION_FORCES& forces : request.forces)
        check.sets.push_back(Checked(job, check.ofConcrete, forces));
    out = std::move(check);
    return 1;
}
