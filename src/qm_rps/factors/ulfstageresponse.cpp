#include "qm_rps/factors/ulfstageresponse.h"

#include "qm_base/msgfunction.h"
#include "qm_rps/factors/optrows.h"
#include "qm_rps/factors/ulfstageplace.h"

#include <algorithm>
#include <cmath>

using zql::lib::MMSGFunction;

namespace {

constexpr const char* kSumOfAll = "IDS_DB_SGLD_SUM";
/// Load groups 0 and 1 both read it. UlfStageItem rules refuse a row whose load is not in it.
constexpr const char* kDeadSum = "IDS_DB_SGLD_DL";

bool HasResponse(int group)
{
    return group >= kLoadGroupDead && group <= kLoadGroupRest;
}

} // namespace

int CUlfStageResponse::Select(const T_OPT_ITEM& item, int loadCase, int at)
{
    const int stage = StageOfUlfNumber(at);
    const int step = StepOfUlfNumber(at);
    const int group = Truncated(item[3]);
    if (group == kLoadGroupRest) return m_results.SelectCase(loadCase, stage, step);
    return m_results.SelectSum(MMSGFunction::GetValue(m_sumStageLoads ? kSumOfAll : kDeadSum),
                               stage, step);
}

int CUlfStageResponse::Read(std::span<const T_OPT_ITEM> items, std::span<const T_OPT_QUANTITY> what,
                            std::span<double> out)
{
    m_error.clear();
    // Quantities of one stage and step together: each selection is made once.
    std::vector<std::size_t> order(what.size());
    for (std::size_t q = 0; q < order.size(); ++q)
        order[q] = q;
    std::ranges::stable_sort(order, {}, [&](std::size_t q) { return what[q].at; });
    for (std::size_t i = 0; i < items.size(); ++i) {
        const bool has = HasResponse(Truncated(items[i][3]));
        int selected = -1;
        for (const std::size_t q : order) {
            double& value = out[q * items.size() + i];
            value = 0.0;
            if (!has) continue;
            const int at = what[q].at != 0 ? what[q].at : Truncated(items[i][0]);
            const int load = i < m_loads.size() ? m_loads[i] : 0;
            const bool ok = (at == selected || Select(items[i], load, at)) &&
                            m_results.ReadOne(what[q], value) && std::isfinite(value);
            selected = at;
            if (ok) continue;
            m_error = m_results.Error();
            return 0;
        }
    }
    return 1;
}
