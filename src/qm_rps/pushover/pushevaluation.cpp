#include "qm_rps/pushover/pushevaluation.h"

#include "qm_base/msgfunction.h"

#include <algorithm>
#include <cmath>

bool T_PUSH_EVALUATION::IsOld() const
{
    return std::ranges::any_of(messages, [](const auto& m) { return m.key == kResultsAreOld; });
}

int T_PUSH_EVALUATION::Status() const
{
    constexpr int kBeyond = 3;
    if (result == 0 || !IsTarget() || capacity.Sd.empty()) return result;
    const double last = std::fabs(factors.gamma) * *std::ranges::max_element(capacity.Sd);
    const bool isReached = std::ranges::any_of(limitStates, [last](const T_LIMIT_ROW& r) {
        return r.demand && std::fabs(*r.demand) <= last;
    });
    return isReached ? result : kBeyond;
}

std::string T_LIMIT_ROW::RemarkText() const
{
    if (remark.empty()) return "-";
    return remark == kNotChecked ? zql::lib::MMSGFunction::GetValue("IDS_QM_REMARK_NOT_CHECKED")
                                 : remark;
}
