#include "qm_rps/pushover/pushoutcome.h"

#include "qm_base/msgfunction.h"
#include "qm_base/textformat.h"
#include "qm_rps/pushover/outcometext.h"

#include <array>

namespace {

struct T_KEYS {
    const char* name;
    const char* advice;
};

// In the order of PUSH_OUTCOME.
// clang-format off
constexpr std::array<T_KEYS, 32> kKeys{{
    {"", ""},
    {"IDS_QM_OUTCOME_CONVERGED", "IDS_QM_ADVICE_CONVERGED"},
    {"IDS_QM_OUTCOME_ELASTIC", "IDS_QM_ADVICE_ELASTIC"},
    {"IDS_QM_OUTCOME_NO_CROSSING", "IDS_QM_ADVICE_NO_CROSSING"},
    {"IDS_QM_OUTCOME_TRIALS_1500", "IDS_QM_ADVICE_TRIALS_1500"},
    {"IDS_QM_OUTCOME_CAPACITY_ENDS", "IDS_QM_ADVICE_CAPACITY_ENDS"},
    {"IDS_QM_OUTCOME_NO_TRIAL_POINT", "IDS_QM_ADVICE_NO_TRIAL_POINT"},
    {"IDS_QM_OUTCOME_CYCLES", "IDS_QM_ADVICE_CYCLES"},
    {"IDS_QM_OUTCOME_BILINEAR_FAILED", "IDS_QM_ADVICE_BILINEAR_FAILED"},
    {"IDS_QM_OUTCOME_DAMPING_FAILED", "IDS_QM_ADVICE_DAMPING_FAILED"},
    {"IDS_QM_OUTCOME_ZERO_TRIAL", "IDS_QM_ADVICE_ZERO_TRIAL"},
    {"IDS_QM_OUTCOME_NO_LOCUS_CROSSING", "IDS_QM_ADVICE_NO_LOCUS_CROSSING"},
    {"IDS_QM_OUTCOME_PERIOD_UNDEFINED", "IDS_QM_ADVICE_PERIOD_UNDEFINED"},
    {"IDS_QM_OUTCOME_NO_CAPACITY", "IDS_QM_ADVICE_NO_CAPACITY"},
    {"IDS_QM_OUTCOME_CONVERSION_FAILED", "IDS_QM_ADVICE_CONVERSION_FAILED"},
    {"IDS_QM_OUTCOME_NO_EIGEN", "IDS_QM_ADVICE_NO_EIGEN"},
    {"IDS_QM_OUTCOME_EIGEN_ERROR", "IDS_QM_ADVICE_EIGEN_ERROR"},
    {"IDS_QM_OUTCOME_DUCTILITY_BELOW_1", "IDS_QM_ADVICE_DUCTILITY_BELOW_1"},
    {"IDS_QM_OUTCOME_COEFFICIENTS_FAILED", "IDS_QM_ADVICE_COEFFICIENTS_FAILED"},
    {"IDS_QM_OUTCOME_NO_PERIOD_CROSSING", "IDS_QM_ADVICE_NO_PERIOD_CROSSING"},
    {"IDS_QM_OUTCOME_CURVE_TOO_SHORT", "IDS_QM_ADVICE_CURVE_TOO_SHORT"},
    {"IDS_QM_OUTCOME_NOT_COMPUTED", "IDS_QM_ADVICE_NOT_COMPUTED"},
    {"IDS_QM_OUTCOME_TARGET_FOUND", "IDS_QM_ADVICE_TARGET_FOUND"},
    {"IDS_QM_OUTCOME_NO_TARGET", "IDS_QM_ADVICE_NO_TARGET"},
    {"IDS_QM_OUTCOME_BILINEAR_TOO_SHORT", "IDS_QM_ADVICE_BILINEAR_TOO_SHORT"},
    {"IDS_QM_OUTCOME_ZERO_DEMAND", "IDS_QM_ADVICE_ZERO_DEMAND"},
    {"IDS_QM_OUTCOME_TARGET_BEYOND", "IDS_QM_ADVICE_TARGET_BEYOND"},
    {"IDS_QM_OUTCOME_NO_TRIAL_POINT", "IDS_QM_ADVICE_TRIAL_BEYOND"},
    {"IDS_QM_OUTCOME_TARGET_BELOW", "IDS_QM_ADVICE_TARGET_BELOW"},
    {"IDS_QM_OUTCOME_TARGET_CYCLES", "IDS_QM_ADVICE_TARGET_CYCLES"},
    {"IDS_QM_OUTCOME_NEGATIVE_GAMMA", "IDS_QM_ADVICE_NEGATIVE_GAMMA"},
    {"IDS_QM_OUTCOME_NOT_FINITE", "IDS_QM_ADVICE_NOT_FINITE"},
}};
// clang-format on
static_assert(kKeys.size() == static_cast<std::size_t>(PUSH_OUTCOME::NotFinite) + 1);

} // namespace

std::string OutcomeName(const T_OUTCOME& outcome)
{
    using zql::lib::MMSGFunction;
    const char* key = kKeys[static_cast<std::size_t>(outcome.code)].name;
    std::string text = MMSGFunction::GetValueOf("en", key);
    const std::string mark = "{1}";
    if (const auto at = text.find(mark); at != std::string::npos)
        text.replace(at, mark.size(), std::to_string(outcome.count));
    return text;
}

std::string OutcomeText(const T_OUTCOME& outcome)
{
    return zql::lib::MMSGFunction::Format(kKeys[static_cast<std::size_t>(outcome.code)].name,
                                          {std::to_string(outcome.count)});
}

std::string OutcomeAdvice(const T_OUTCOME& outcome)
{
    return zql::lib::MMSGFunction::Format(kKeys[static_cast<std::size_t>(outcome.code)].advice,
                                          {std::to_string(outcome.count),
                                           FormatText("%.6g", outcome.between[0]),
                                           FormatText("%.6g", outcome.between[1])});
}
