#include "qm_db/casefile/caseget.h"
#include "qm_db/casefile/casereader.h"
#include "qm_db/casefile/jsonnames.h"

namespace {

constexpr int kFirstModeKind = 2; // "mode" and "mode x story mass" need mode numbers

void ReadPattern(CJsonReader in, const T_MODEL& model, T_POLC_D& push)
{
    in.Keys({"kind", "modes"});
    push.patternKind = in.Choice("kind", kPatternNames, "pattern");
    in.GetIf("modes", push.modes);
    if (push.patternKind >= kFirstModeKind && push.modes.empty())
        in.Fail("this kind of pattern needs at least one mode number in \"modes\"");
    in.CheckEach(
        "modes", push.modes, [](int m) { return m > 0; }, "mode numbers start at 1");
    if (model.modes.empty()) return; // numbers of the solver that made the results
    in.CheckEach(
        "modes", push.modes, [&](int m) { return model.modes.contains(m); },
        "there is no such mode");
}

void ReadStepTriple(CJsonReader& in, std::string_view key, std::optional<std::array<int, 3>>& out)
{
    in.Get(key, out);
    if (out)
        in.CheckEach(
            key, *out, [](int s) { return s >= -2; }, "a step is -2 or above");
}

void ReadLimitStateSteps(CJsonReader in, T_POVR_D& out)
{
    in.Keys({"EC8", "NTC"});
    ReadStepTriple(in, "EC8", out.ec8);
    ReadStepTriple(in, "NTC", out.ntc);
}

void ReadPushover(CJsonReader& in, int key, const std::string& folder, T_MODEL_CONTENT& content,
                  std::set<std::string>& taken)
{
    T_MODEL& model = content.model;
    T_POLC_D push;
    CCaseGet rest(in, model.styp.units,
                  {"name", "control_node", "direction", "pattern", "steps", "limit_state_steps"});
    CaseFields(rest, push);
    rest.Finish();
    in.GetName("name", push.name, taken);
    in.Get("control_node", push.controlNode);
    in.Check("control_node", model.nodes.contains(push.controlNode), "there is no such node");
    push.direction = 1 + in.Choice("direction", kDirectionNames, "direction");
    ReadPattern(in.Member("pattern"), model, push);
    if (in.Has("steps") || !push.control) { // a case with "control" may still have to be run
        T_PUSH_DATA data;
        CJsonReader steps = in.Member("steps");
        ReadSteps(steps, folder, model, push, data);
        content.results[key] = MakePushResult(std::move(data));
    }
    if (in.Has("limit_state_steps"))
        ReadLimitStateSteps(in.Member("limit_state_steps"), model.poverSteps[key]);
    model.pushovers[key] = std::move(push);
}

} // namespace

void ReadPushovers(CJsonReader& root, const std::string& folder, T_MODEL_CONTENT& content)
{
    std::set<std::string> taken;
    ForEachRecord(root, "pushover", [&](CJsonReader& item, std::size_t index) {
        ReadPushover(item, static_cast<int>(index) + 1, folder, content, taken);
    });
}
