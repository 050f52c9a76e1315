#include "qm_rps/factors/ulfanalysed.h"

#include "qm_base/msgfunction.h"
#include "qm_rps/factors/optrows.h"
#include "qm_rps/factors/ulfstageplace.h"
#include "qm_rps/factors/ulfstageproblem.h"
#include "qm_rps/factors/ulfstanding.h"
#include "qm_rps/factors/ulftexts.h"

#include <cmath>

namespace {

constexpr double kRoundingTol = 1e-6; // of the row's scale, as of a constraint that is met
constexpr int kTrussKind = 3, kBeamKind = 4;

std::string SumOfAll()
{
    return zql::lib::MMSGFunction::GetValue("IDS_DB_SGLD_SUM");
}

/// Value of a constrained quantity in the results that are selected.
int ReadValue(const T_ULFC_D& c, IUlfStageResults& results, double& out)
{
    const std::vector<T_OPT_RECORD> records = UlfConstraintRecords(c);
    const auto reading = records.empty() ? std::nullopt : ReadRecord(records.front());
    double first = 0.0, second = 0.0;
    if (!reading || !results.ReadOne(reading->first, first)) return 0;
    if (reading->second && !results.ReadOne(*reading->second, second)) return 0;
    out = first - second;
    return 1;
}

/// Length of the influences of the unknowns that an iteration scales.
double ScaledLength(const T_ULSI_D& item, const std::vector<double>& influence)
{
    double sum = 0.0;
    for (std::size_t j = 0; j < item.rows.size(); ++j)
        if (item.rows[j].unknown && item.rows[j].pretension) sum += influence[j] * influence[j];
    return std::sqrt(sum);
}

/// Axial force of an element in the results that are selected.
std::optional<double> AxialForce(const T_ELEM_D& element, IUlfStageResults& results)
{
    const bool beam = element.kind == ELEM_KIND::Beam;
    const T_OPT_QUANTITY axial{beam ? kBeamKind : kTrussKind, element.id, beam ? 1 : 0, 1};
    double force = 0.0;
    return results.ReadOne(axial, force) ? std::optional(force) : std::nullopt;
}

} // namespace

bool T_ULF_ANALYSED::Agrees() const
{
    return std::fabs(analysed - forecast) <= allowed;
}

int CompareWithAnalysis(const T_ULF_RUN& run, const T_ULF_RESULT& result, const T_ULSI_D& item,
                        const CDataCtrl& data, IUlfStageResults& results, double tolerance,
                        std::vector<T_ULF_ANALYSED>& out)
{
    std::vector<T_ULF_ANALYSED> made;
    for (std::size_t i = 0; i < run.constraints.size(); ++i) {
        const T_ULFC_D& c = run.constraints[i];
        const auto place = ReadingPlace(data.Model(), item, c);
        if (!place) return 0;
        T_ULF_ANALYSED a;
        a.name = c.name;
        a.place = c.stage != 0 ? UlfPlaceText(data, c.stage, c.step)
                               : UlfPlaceText(data, place->first, place->second);
        a.unit = UlfUnitText(c.type, c.component, data.Units());
        a.forecast = UlfValue(result, i);
        if (!results.SelectSum(SumOfAll(), place->first, place->second) ||
            !ReadValue(c, results, a.analysed))
            return 0;
        a.scale = UlfScale(result, i);
        a.allowed = tolerance * ScaledLength(item, result.influence[i]) + kRoundingTol * a.scale;
        made.push_back(std::move(a));
    }
    out = std::move(made);
    return 1;
}

std::optional<double> T_ULF_STAY::Factor() const
{
    return start != 0.0 ? std::optional(now / start) : std::nullopt; // 0 as it was entered
}

std::map<int, double> PretensionByElement(const T_STLD_D& load)
{
    std::map<int, double> sums;
    for (const T_PTNS_D& p : load.pretension)
        sums[p.element] += p.force;
    return sums;
}

ULF_PRETENSION PretensionOf(const T_ULSI_D& item, const CDataCtrl& data)
{
    ULF_PRETENSION all;
    for (const T_ULSI_ROW& row : item.rows)
        for (const int loadCase : LoadsScaledBy(data.Model(), row)) {
            T_STLD_D load;
            if (!CAttrCtrl(data).GetStld(loadCase, load)) continue;
            for (const auto& [element, force] : PretensionByElement(load))
                all[{loadCase, element}] = force;
        }
    return all;
}

std::vector<T_ULF_STAY> StaysOf(const ULF_PRETENSION& start, const CDataCtrl& data,
                                IUlfStageResults& results)
{
    const T_MODEL& model = data.Model();
    const bool hasStages =
        !model.stages.empty() &&
        results.SelectSum(SumOfAll(), model.stages.rbegin()->first, kStageLastStep);
    std::vector<T_ULF_STAY> stays;
    for (const auto& [at, force] : start) {
        const auto load = model.loadCases.find(at.first);
        const auto element = model.elements.find(at.second);
        T_PTNS_D now;
        if (load == model.loadCases.end() || element == model.elements.end() ||
            !CAttrCtrl(data).GetPtns(at.first, at.second, now))
            continue;
        stays.push_back({at.second, load->second.name, force, now.force});
        if (hasStages) stays.back().force = AxialForce(element->second, results);
    }
    return stays;
}
