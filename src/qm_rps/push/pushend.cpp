#include "qm_rps/push/pushend.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"

#include <array>

namespace {

struct T_ROW {
    PUSH_STATUS status;
    const char* name;
    const char* advice;
};

// In the order of solver::PUSH_OUTCOME.
// clang-format off
constexpr std::array<T_ROW, 17> kRows{{
    {PUSH_STATUS::Reached, "IDS_QM_PUSH_END_REACHED", "IDS_QM_PUSH_ADVICE_REACHED"},
    {PUSH_STATUS::Failed, "IDS_QM_PUSH_END_NO_EQUILIBRIUM", "IDS_QM_PUSH_ADVICE_NO_EQUILIBRIUM"},
    {PUSH_STATUS::Stopped, "IDS_QM_PUSH_END_DRIFT", "IDS_QM_PUSH_ADVICE_DRIFT"},
    {PUSH_STATUS::Stopped, "IDS_QM_PUSH_END_PEAK", "IDS_QM_PUSH_ADVICE_PEAK"},
    {PUSH_STATUS::Stopped, "IDS_QM_PUSH_END_STIFFNESS", "IDS_QM_PUSH_ADVICE_STIFFNESS"},
    {PUSH_STATUS::Stopped, "IDS_QM_PUSH_END_MARK", "IDS_QM_PUSH_ADVICE_MARK"},
    {PUSH_STATUS::Stopped, "IDS_QM_PUSH_END_LOSS", "IDS_QM_PUSH_ADVICE_LOSS"},
    {PUSH_STATUS::Stopped, "IDS_QM_PUSH_END_LAST_POINT", "IDS_QM_PUSH_ADVICE_LAST_POINT"},
    {PUSH_STATUS::Failed, "IDS_QM_PUSH_END_INITIAL", "IDS_QM_PUSH_ADVICE_INITIAL"},
    {PUSH_STATUS::Failed, "IDS_QM_PUSH_END_NO_PATH", "IDS_QM_PUSH_ADVICE_NO_PATH"},
    {PUSH_STATUS::Failed, "IDS_QM_PUSH_END_SNAP_BACK", "IDS_QM_PUSH_ADVICE_SNAP_BACK"},
    {PUSH_STATUS::Failed, "IDS_QM_PUSH_END_AXIAL", "IDS_QM_PUSH_ADVICE_AXIAL"},
    {PUSH_STATUS::Failed, "IDS_QM_PUSH_END_EVENTS", "IDS_QM_PUSH_ADVICE_EVENTS"},
    {PUSH_STATUS::Failed, "IDS_QM_PUSH_END_BALANCE", "IDS_QM_PUSH_ADVICE_BALANCE"},
    {PUSH_STATUS::Failed, "IDS_QM_PUSH_END_CANCELLED", "IDS_QM_PUSH_ADVICE_CANCELLED"},
    {PUSH_STATUS::Failed, "IDS_QM_PUSH_END_MECHANISM", "IDS_QM_PUSH_ADVICE_MECHANISM"},
    {PUSH_STATUS::Reached, "IDS_QM_PUSH_END_LEAPS", "IDS_QM_PUSH_ADVICE_LEAPS"},
}};
// clang-format on
static_assert(kRows.size() == static_cast<std::size_t>(solver::PUSH_OUTCOME::ReachedByLeaps) + 1);

const T_ROW& RowOf(solver::PUSH_OUTCOME outcome)
{
    return kRows[static_cast<std::size_t>(outcome)];
}

} // namespace

PUSH_STATUS StatusOf(solver::PUSH_OUTCOME outcome)
{
    return RowOf(outcome).status;
}

std::string PushOutcomeName(solver::PUSH_OUTCOME outcome)
{
    return zql::lib::MMSGFunction::GetValueOf("en", RowOf(outcome).name);
}

std::string PushStatusText(PUSH_STATUS status)
{
    constexpr const char* kKeys[] = {"IDS_QM_CLI_PUSH_REACHED", "IDS_QM_CLI_PUSH_STOPPED",
                                     "IDS_QM_CLI_PUSH_FAILED"};
    return Say(kKeys[static_cast<std::size_t>(status)]);
}

std::string PushOutcomeText(solver::PUSH_OUTCOME outcome)
{
    return Say(RowOf(outcome).name);
}

std::string PushOutcomeAdvice(solver::PUSH_OUTCOME outcome, double loadFactor,
                              const std::string& place, bool hasSteps)
{
    const char* key = RowOf(outcome).advice;
    if (!hasSteps && outcome == solver::PUSH_OUTCOME::Cancelled)
        key = "IDS_QM_PUSH_ADVICE_CANCELLED_FIRST";
    if (!hasSteps && outcome == solver::PUSH_OUTCOME::OutOfBalance)
        key = "IDS_QM_PUSH_ADVICE_BALANCE_FIRST";
    const std::string text = Say(key, FormatText("%.6g", loadFactor));
    return place.empty() ? text : text + " " + place;
}
