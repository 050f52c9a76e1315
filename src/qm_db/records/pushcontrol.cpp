#include "qm_db/records/pushcontrol.h"

#include "qm_db/records/rulehead.h"

#include <algorithm>
#include <cmath>
#include <utility>

namespace {

// ---- global control -----------------------------------------------------------------------------

struct T_CHECK {
    const T_POGC_D& c;
    const T_MODEL* model; // null: what the control refers to is not judged
};

constexpr T_RECORD_RULE<T_CHECK> kControlRules[] = {
    {{.message = "IDS_QM_PUSH_STEPS",
      .field = "steps",
      .caseKey = "steps",
      .reason = "IDS_QM_PUSH_STEPS"},
     [](const T_CHECK& d) { return d.c.steps >= 1 && d.c.steps <= kMostPushSteps; }},
    {{.message = "IDS_QM_PUSH_MOST",
      .field = "mostEvents",
      .caseKey = "most_events",
      .reason = "IDS_QM_PUSH_MOST"},
     [](const T_CHECK& d) { return d.c.mostEvents >= 1; }},
    {{.message = "IDS_QM_PUSH_MOST",
      .field = "mostSteps",
      .caseKey = "most_steps",
      .reason = "IDS_QM_PUSH_MOST"},
     [](const T_CHECK& d) { return d.c.mostSteps >= 1; }},
    {{.message = "IDS_QM_PUSH_NO_HINGE_TYPE", .field = "hingeTypes"},
     [](const T_CHECK& d) {
         return std::ranges::all_of(d.c.hingeTypes,
                                    [&](int key) { return d.model->hingeTypes.contains(key); });
     },
     [](const T_CHECK& d) { return d.model != nullptr; }},
};

// ---- initial loads ------------------------------------------------------------------------------

struct T_LOAD {
    const T_PUSH_INITIAL_LOAD& l;
    const T_MODEL* model; // as above
};

constexpr T_RECORD_RULE<T_LOAD> kLoadRules[] = {
    {{.message = "IDS_QM_UI_POLC_NO_CASE", .field = "loadCase"},
     [](const T_LOAD& d) { return d.model->loadCases.contains(d.l.loadCase); },
     [](const T_LOAD& d) { return d.model != nullptr; }},
    {{.message = "IDS_QM_PUSH_INITIAL_FACTOR",
      .field = "factor",
      .caseKey = "factor",
      .reason = "IDS_QM_PUSH_INITIAL_FACTOR"},
     [](const T_LOAD& d) { return std::isfinite(d.l.factor) && d.l.factor != 0.0; }},
};

// ---- increment functions ------------------------------------------------------------------------

bool StartsAtOrigin(const T_POFC_D& f)
{
    return !f.step.empty() && !f.factor.empty() && f.step[0] == 0.0 && f.factor[0] == 0.0;
}
/// From above 0, behind a first row at the origin; a NaN fails.
bool Rises(const T_POFC_D& f, std::vector<double> T_POFC_D::*values)
{
    double before = 0.0;
    return std::ranges::all_of(std::span(f.*values).subspan(StartsAtOrigin(f) ? 1 : 0),
                               [&](double v) { return v > std::exchange(before, v); }) &&
           std::isfinite(before);
}

constexpr T_RECORD_RULE<T_POFC_D> kFunctionRules[] = {
    {{.message = "IDS_QM_PUSH_FUNCTION_ROWS",
      .field = "step",
      .caseKey = "step",
      .reason = "IDS_QM_PUSH_FUNCTION_ROWS"},
     [](const T_POFC_D& f) {
         return f.step.size() == f.factor.size() && f.step.size() > (StartsAtOrigin(f) ? 1U : 0U);
     }},
    {{.message = "IDS_QM_PUSH_FUNCTION_RISE",
      .field = "step",
      .caseKey = "step",
      .reason = "IDS_QM_PUSH_FUNCTION_RISE"},
     [](const T_POFC_D& f) { return Rises(f, &T_POFC_D::step); }},
    {{.message = "IDS_QM_PUSH_FUNCTION_RISE",
      .field = "factor",
      .caseKey = "factor",
      .reason = "IDS_QM_PUSH_FUNCTION_RISE"},
     [](const T_POFC_D& f) { return Rises(f, &T_POFC_D::factor); }},
};

} // namespace

T_POGC_D PushControlOf(const T_MODEL& model, const T_POLC_D& loadCase)
{
    T_POGC_D control = model.pushControl;
    if (loadCase.initialLoads) control.initialLoads = *loadCase.initialLoads;
    if (loadCase.pDelta) control.pDelta = *loadCase.pDelta;
    if (loadCase.steps) control.steps = *loadCase.steps;
    if (loadCase.onFailure) control.onFailure = *loadCase.onFailure;
    return control;
}

std::vector<T_FINDING> PushControlFindings(const T_POGC_D& control, const T_MODEL& model)
{
    std::vector<T_FINDING> out = InitialLoadFindings(control.initialLoads, model);
    WalkRules(kControlRules, {control, &model}, {}, out);
    return out;
}

std::vector<T_FINDING> InitialLoadFindings(std::span<const T_PUSH_INITIAL_LOAD> loads,
                                           const T_MODEL& model)
{
    std::vector<T_FINDING> out;
    for (std::size_t i = 0; i < loads.size(); ++i)
        WalkRules(kLoadRules, {loads[i], &model},
                  {.prefix = "initialLoads[" + std::to_string(i) + "]."}, out);
    return out;
}

std::vector<T_FINDING> IncrementFunctionFindings(const T_POFC_D& function)
{
    std::vector<T_FINDING> out;
    WalkRules(kFunctionRules, function, {}, out);
    return out;
}

const char* PushControlFault(const T_POGC_D& control, std::string_view caseKey)
{
    return FaultOf<T_CHECK>(kControlRules, {control, nullptr}, caseKey);
}

const char* InitialLoadFault(const T_PUSH_INITIAL_LOAD& load, std::string_view caseKey)
{
    return FaultOf<T_LOAD>(kLoadRules, {load, nullptr}, caseKey);
}

const char* IncrementFunctionFault(const T_POFC_D& function, std::string_view caseKey)
{
    return FaultOf<T_POFC_D>(kFunctionRules, function, caseKey);
}
