#include "qm_rps/section/sectiontexts.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"

namespace {

using namespace solver;

/// By SECTION_FAULT.
constexpr std::array<const char*, 21> kFaults{"",
                                              "IDS_QM_SECC_REFUSED",
                                              "IDS_QM_SECC_REFUSED",
                                              "IDS_QM_SECC_REFUSED",
                                              "IDS_QM_SECC_LAW_STRENGTH",
                                              "IDS_QM_SECC_LAW_STRAINS",
                                              "IDS_QM_SECC_REFUSED",
                                              "IDS_QM_SECC_RING_AREA",
                                              "IDS_QM_SECC_RING_CROSSED",
                                              "IDS_QM_SECC_REFUSED",
                                              "IDS_QM_SECC_REGIONS_OVERLAP",
                                              "IDS_QM_SECC_BAR_AREA",
                                              "IDS_QM_SECC_BAR_OUTSIDE",
                                              "IDS_QM_SECC_BARS_OVERLAP",
                                              "IDS_QM_SECC_REFUSED",
                                              "IDS_QM_SECC_NO_LIMIT",
                                              "IDS_QM_SECC_BLOCK_CURVATURE",
                                              "IDS_QM_SECC_AXIAL_BEYOND",
                                              "IDS_QM_SECC_NO_SUCH_MOMENT",
                                              "IDS_QM_SECC_REFUSED",
                                              "IDS_QM_SECC_NOT_CONVERGED"};
static_assert(static_cast<std::size_t>(SECTION_FAULT::NotConverged) == 20);

std::string Number(double si, const T_UNITS& units, T_DIM dim)
{
    return FormatText("%.6g", FromSi(si, units, dim));
}

} // namespace

std::string SectionErrorText(const T_SECTION_ERROR& error, const T_UNITS& units)
{
    const char* const key = kFaults[static_cast<std::size_t>(error.fault)];
    const std::string unit(NameOf(units.force));
    switch (error.fault) {
    case SECTION_FAULT::AxialBeyond:
        return Say(key, Number(error.axialMin, units, kDimForce),
                   Number(error.axialMax, units, kDimForce), unit);
    case SECTION_FAULT::BarArea:
    case SECTION_FAULT::BarOutside:
        return Say(key, std::to_string(error.bar + 1));
    case SECTION_FAULT::BarsOverlap:
        return Say(key, std::to_string(error.bar + 1), std::to_string(error.otherBar + 1));
    default:
        return Say(key);
    }
}

std::string FibreText(const T_FIBRE& fibre)
{
    switch (fibre.kind) {
    case FIBRE_KIND::None:
        return "-";
    case FIBRE_KIND::Concrete:
        return Say("IDS_QM_SECC_FIBRE_CONCRETE");
    case FIBRE_KIND::Steel:
        return Say(fibre.tension ? "IDS_QM_SECC_FIBRE_STEEL_T" : "IDS_QM_SECC_FIBRE_STEEL_C");
    case FIBRE_KIND::Bar:
        return Say(fibre.tension ? "IDS_QM_SECC_FIBRE_BAR_T" : "IDS_QM_SECC_FIBRE_BAR_C",
                   std::to_string(fibre.index + 1));
    }
    return "-";
}

std::string CurvatureEndText(const T_SECTION_CURVATURE& curvature)
{
    switch (curvature.curve.end) {
    case CURVATURE_END::StrainLimit:
        return FibreText(curvature.curve.governs);
    case CURVATURE_END::MomentLoss:
        return Say("IDS_QM_SECC_END_LOSS");
    case CURVATURE_END::NoEquilibrium:
        return Say("IDS_QM_SECC_END_EQUILIBRIUM");
    case CURVATURE_END::MaxCurvature:
        return Say("IDS_QM_SECC_END_ASKED");
    }
    return {};
}

std::string SectionOptionsText(const T_SECTION_ANSWER& answer)
{
    constexpr std::array<const char*, 6> kValues{
        "IDS_QM_SECC_CHARACTERISTIC", "IDS_QM_SECC_MEAN",   "IDS_QM_SECC_EXPECTED",
        "IDS_QM_SECC_LOWER",          "IDS_QM_SECC_DESIGN", "IDS_QM_SECC_ASSESSED"};
    constexpr std::array<const char*, 5> kCores{"", "IDS_QM_SECC_CORE_MANDER",
                                                "IDS_QM_SECC_CORE_EUROCODE", "IDS_QM_SECC_CORE_NTC",
                                                "IDS_QM_SECC_CORE_EN1998"};
    const T_SECTION_OPTIONS& o = answer.options;
    std::string text = Say(kValues[static_cast<std::size_t>(o.values)]);
    if (answer.ofConcrete)
        text += ", " + (o.core != SECTION_CORE::Plain
                            ? Say(kCores[static_cast<std::size_t>(o.core)])
                            : Say(o.law == SECTION_LAW::Aci ? "IDS_QM_SECC_LAW_ACI"
                                                            : "IDS_QM_SECC_LAW_EUROCODE"));
    else if (answer.task != SECTION_TASK::Curvature)
        text += ", " + Say("IDS_QM_SECC_PLASTIC");
    return text;
}
