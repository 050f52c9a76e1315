#include "qm_rps/factors/ulfstageplace.h"

#include "qm_rps/factors/ulfresult.h"
#include "qm_rps/factors/ulftexts.h"

#include <algorithm>

namespace {

constexpr int kPerStage = kStageStepsMost + 1;

} // namespace

int UlfStageNumber(int stage, int step)
{
    return stage * kPerStage + (step == kStageLastStep ? 0 : step);
}

int StageOfUlfNumber(int number)
{
    return number / kPerStage;
}

int StepOfUlfNumber(int number)
{
    const int step = number % kPerStage;
    return step == 0 ? kStageLastStep : step;
}

int UlfStepNumber(const T_MODEL& model, int stage, int step)
{
    const auto it = model.stages.find(stage);
    if (it == model.stages.end()) return 0;
    const int number = StageStepNumber(it->second, step);
    return number <= kStageStepsMost ? number : 0;
}

std::string UlfPlaceText(const CDataCtrl& data, int stage, int step)
{
    T_STAG_STEP_INFO info;
    return CAttrCtrl(data).GetStagStepInfo(stage, step, info) ? info.Text() : std::string();
}

std::string UlfStageRowText(const CDataCtrl& data, const T_ULSI_ROW& row)
{
    std::string text = UlfPlaceText(data, row.stage, row.step);
    const auto& cases = data.Model().loadCases;
    if (const auto it = cases.find(row.loadCase); it != cases.end())
        text += (text.empty() ? "" : " ") + it->second.name;
    return text;
}

std::vector<std::pair<int, int>> UlfPlaces(const T_MODEL& model)
{
    std::vector<std::pair<int, int>> places;
    for (const auto& [key, stage] : model.stages)
        for (int step = kStageFirstStep; step <= std::min(stage.steps, kStageStepsMost); ++step)
            places.emplace_back(key, step > kStageFirstStep && step == stage.steps ? kStageLastStep
                                                                                   : step);
    return places;
}

std::string UlfConstraintText(const CDataCtrl& data, const T_ULFC_D& c)
{
    return UlfNameAt(UlfDescription(c), UlfPlaceText(data, c.stage, c.step));
}

std::vector<int> LoadsActingAt(const T_MODEL& model, int stage, int step)
{
    std::vector<int> acting;
    const int now = UlfStepNumber(model, stage, step);
    if (now == 0) return acting;
    const T_STAG_D& record = model.stages.at(stage);
    const auto reached = [&](const T_STAG_LOAD& load) {
        const int at = UlfStepNumber(model, stage, load.step);
        return at != 0 && at <= now;
    };
    for (const T_STAG_LOAD& load : record.activate.loads) {
        const auto& gone = record.deactivate.loads;
        const bool left = std::any_of(gone.begin(), gone.end(), [&](const T_STAG_LOAD& g) {
            return g.loadCase == load.loadCase && reached(g);
        });
        if (reached(load) && !left) acting.push_back(load.loadCase);
    }
    return acting;
}
