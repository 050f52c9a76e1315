#include "qm_db/casefile/casereadertable.h"
#include "qm_db/records/loadcaserules.h"
#include "qm_db/records/pushcontrol.h"

namespace {

constexpr int kFirstModeKind = 2; // "mode" and "mode x story mass" need mode numbers

/// The kind and the modes are those of the rows where there are rows: an evaluation reads them, the
/// push reads the rows.
void CheckAgainstRows(CJsonReader in, const T_POLC_D& push)
{
    T_POLC_D byRows = push;
    TakeMasterPattern(byRows);
    if (byRows.patternKind != push.patternKind) in.Fail("IDS_QM_CASE_PATTERN_ROWS");
    if (push.patternKind >= kFirstModeKind && byRows.modes != push.modes)
        in.Fail("IDS_QM_CASE_PATTERN_ROWS");
}

void CheckPattern(CJsonReader in, const T_MODEL& model, const T_POLC_D& push)
{
    CheckAgainstRows(in, push);
    if (push.patternKind >= kFirstModeKind && push.modes.empty())
        in.Fail("IDS_QM_CASE_NEEDS_MODES");
    in.CheckEach(
        "modes", push.modes, [](int m) { return m > 0; }, "IDS_QM_CASE_MODES_FROM_1");
    if (model.modes.empty()) return; // numbers of the solver that made the results
    in.CheckEach(
        "modes", push.modes, [&](int m) { return model.modes.contains(m); }, "IDS_QM_CASE_NO_MODE");
}

void Judge(CJsonReader& in, const char* key, const char* reason)
{
    if (reason) in.FailAt(key, reason);
}

void JudgeInitialLoads(CJsonReader& in, const std::vector<T_PUSH_INITIAL_LOAD>& loads)
{
    if (loads.empty()) return;
    in.Member("initial_loads").ForEachItem([&](CJsonReader& item, std::size_t i) {
        Judge(item, "factor", InitialLoadFault(loads[i], "factor"));
    });
}

} // namespace

void JudgePushControl(CJsonReader& in, const T_POGC_D& control)
{
    JudgeInitialLoads(in, control.initialLoads);
    for (const char* const key : {"steps", "most_events", "most_steps"})
        Judge(in, key, PushControlFault(control, key));
}

void JudgePush(CJsonReader& in, const T_MODEL& model, const T_POLC_D& push)
{
    if (push.initialLoads) JudgeInitialLoads(in, *push.initialLoads);
    for (const char* const key : {"initial_case", "eccentricity"})
        Judge(in, key, LoadCaseFault(push, model, key));
    Judge(in, in.Has(kIncrementsKey) ? kIncrementsKey : "steps",
          LoadCaseFault(push, model, "steps"));
    in.CheckEach(
        "additional_displacements", push.additionalDisplacements,
        [&](double d) { return IsOnTheWay(push, d); }, "IDS_QM_PUSH_ADDITIONAL");
    if (!in.Has("stops")) return;
    CJsonReader stops = in.Member("stops");
    for (const char* const key : {"drift", "fraction_of_peak"})
        Judge(stops, key, LoadCaseFault(push, model, key));
}

void JudgePushNames(CJsonReader& in, const T_MODEL& model, const T_POLC_D& push)
{
    in.Check("control_node", model.nodes.contains(push.controlNode), "IDS_QM_CASE_NO_NODE");
    CheckPattern(in.Member("pattern"), model, push);
}

void ReadSteps(CJsonReader& in, const CCaseNames& names, const T_CASE_FOLDER& folder, int key,
               T_POLC_D& push, T_MODEL_CONTENT& content)
{
    T_MODEL& model = content.model;
    JudgePushNames(in, model, push);
    if (push.control && in.Has("steps") && in.Member("steps").IsNumber()) {
        if (push.steps) in.FailAt("steps", "IDS_QM_CASE_SAME_AS", kIncrementsKey);
        in.Get("steps", push.steps);
    } else if (in.Has("steps") || !push.control) { // a case with "control" may still have to be run
        T_PUSH_DATA data;
        CJsonReader steps = in.Member("steps");
        ReadSteps(steps, folder, model, push, data);
        content.results[key] = MakePushResult(std::move(data));
    }
    if (!in.Has("limit_state_steps")) return;
    CJsonReader steps = in.Member("limit_state_steps");
    CCaseGet::Record(steps, model.styp.units, names, {}, model.poverSteps[key]);
}
