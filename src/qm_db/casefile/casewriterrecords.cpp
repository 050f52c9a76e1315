#include "qm_db/casefile/caseput.h"
#include "qm_db/casefile/casewriter.h"
#include "qm_db/casefile/jsonnames.h"

namespace {

/// A name that stands for a number, or a fault when the number has none.
void WriteName(CJsonWriter& out, const char* key, std::span<const char* const> names, int index)
{
    out.Key(key);
    if (index < 0 || static_cast<std::size_t>(index) >= names.size())
        return out.Fail("no name for the value " + std::to_string(index));
    out.Value(names[static_cast<std::size_t>(index)]);
}

void WriteData(CJsonWriter& out, const T_SPFC_ATC40& s)
{
    out.Member("Ca", s.Ca);
    out.Member("Cv", s.Cv);
    out.MemberIf("floors", s.floors);
}

void WriteData(CJsonWriter& out, const T_SPFC_EURO2003& s)
{
    out.Member("type", s.type);
    out.Member("soil", std::string_view(&s.soil, 1));
    out.Member("ag", s.ag);
    out.MemberIf("damping", s.damping);
    out.MemberIf("S", s.S);
    out.MemberIf("TB", s.TB);
    out.MemberIf("TC", s.TC);
    out.MemberIf("TD", s.TD);
}

void WriteData(CJsonWriter& out, const T_SPFC_EURO1996& s)
{
    out.Member("soil", std::string_view(&s.soil, 1));
    out.Member("ag", s.ag);
    out.MemberIf("damping", s.damping);
}

void WriteData(CJsonWriter& out, const T_SPFC_NTC& s)
{
    out.Member("soil", std::string_view(&s.soil, 1));
    WriteName(out, "topography", kTopographies, s.topography - 1);
    out.MemberIf("damping", s.damping);
    out.Key("limit_states");
    out.BeginObject();
    for (std::size_t i = 0; i < s.states.size(); ++i) {
        if (!s.states[i]) continue;
        out.Key(kLimitStateNames[i]);
        out.BeginObject(true);
        out.Member("ag", s.states[i]->ag);
        out.Member("F0", s.states[i]->F0);
        out.Member("TC*", s.states[i]->TCstar);
        out.EndObject();
    }
    out.EndObject();
}

void WriteData(CJsonWriter& out, const T_SPFC_USER& s)
{
    out.Member("T", s.T);
    out.Member("Sa", s.Sa);
    if (s.gravity) out.Member("gravity", *s.gravity, kDimAccel);
}

using T_SERIES = std::vector<double>;

/// One value per step, or a fault.
void WriteSeries(CJsonWriter& out, const std::string& key, const T_SERIES& values, T_DIM dim,
                 const IPushResult& result, int read)
{
    out.Key(key);
    if (!read) return out.Fail("the result can't be read: " + result.Error());
    if (values.size() != static_cast<std::size_t>(result.StepCount()))
        return out.Fail(std::to_string(values.size()) + " values, expected " +
                        std::to_string(result.StepCount()));
    out.Value(values, dim);
}

void WriteSteps(CJsonWriter& out, IPushResult& result, int direction)
{
    T_SERIES values;
    out.BeginObject();
    int read = result.ReadLoadFactors(values);
    WriteSeries(out, "load_factor", values, kDimNone, result, read);
    read = result.ReadBaseReactions(values);
    WriteSeries(out, "base_reaction", values, ReactionDim(direction), result, read);
    out.Key("displacement");
    out.BeginObject();
    for (const int node : result.NodeIds()) {
        if (out.Failed()) return;
        read = result.ReadDisplacements(node, values);
        WriteSeries(out, std::to_string(node), values, DisplacementDim(direction), result, read);
    }
    out.EndObject();
    out.EndObject();
}

void WriteLimitStateSteps(CJsonWriter& out, const T_MODEL& model, int push)
{
    const auto it = model.poverSteps.find(push);
    if (it == model.poverSteps.end()) return;
    out.Key("limit_state_steps");
    out.BeginObject(true);
    out.MemberIf("EC8", it->second.ec8);
    out.MemberIf("NTC", it->second.ntc);
    out.EndObject();
}

void WritePushover(CJsonWriter& out, const T_MODEL_CONTENT& content, int key, const T_POLC_D& push)
{
    out.BeginObject();
    out.Member("name", push.name);
    out.Member("control_node", push.controlNode);
    WriteName(out, "direction", kDirectionNames, push.direction - 1);
    out.Key("pattern");
    out.BeginObject(true);
    WriteName(out, "kind", kPatternNames, push.patternKind);
    if (!push.modes.empty()) out.Member("modes", push.modes);
    out.EndObject();

    CCasePut rest(out);
    CaseFields(rest, push);
    const auto it = content.results.find(key);
    const bool hasSteps = it != content.results.end() && it->second && it->second->StepCount() > 0;
    if (hasSteps || !push.control) out.Key("steps");
    if (hasSteps)
        WriteSteps(out, *it->second, push.direction);
    else if (!push.control)
        return out.Fail("the load case \"" + push.name +
                        "\" has no results, which a case file "
                        "can't leave out");
    if (out.Failed()) return;
    WriteLimitStateSteps(out, content.model, key);
    out.EndObject();
}

void WriteBilinear(CJsonWriter& out, const T_EVAL_BILINEAR& bilinear)
{
    out.Key("bilinear");
    out.BeginObject(true);
    out.MemberIf("rule", bilinear.rule);
    out.MemberIf("secant", bilinear.secant);
    out.MemberIf("drop", bilinear.drop);
    out.MemberIf("iterate", bilinear.iterate);
    out.EndObject();
}

void WriteEvaluation(CJsonWriter& out, const T_EVAL_D& eval)
{
    out.BeginObject();
    out.Member("name", eval.name);
    out.Member("push", eval.push);
    WriteName(out, "method", kMethodNames, static_cast<int>(eval.method) - kFirstMethod);
    if (eval.procedure) out.Member("procedure", std::string_view(&*eval.procedure, 1));
    out.Member("spectrum", eval.spectrum);
    out.MemberIf("behavior", eval.behavior);
    out.MemberIf("elastic_damping", eval.elasticDamping);
    out.MemberIf("user_damping", eval.userDamping);
    out.MemberIf("eigen_factors", eval.eigenFactors);
    out.MemberIf("masonry", eval.masonry);
    out.MemberIf("drift_kind", eval.driftKind);
    out.MemberIf("plot_type", eval.plotType);
    out.MemberIf("alpha_in_percent", eval.alphaInPercent);
    if (eval.bilinear) WriteBilinear(out, *eval.bilinear);
    out.EndObject();
}

} // namespace

void WriteSpectra(CJsonWriter& out, const T_MODEL& model)
{
    if (model.spectra.empty()) return;
    out.Key("spectra");
    out.BeginArray();
    for (const auto& entry : model.spectra) {
        const T_SPFC_D& spectrum = entry.second;
        out.BeginObject();
        out.Member("name", spectrum.name);
        out.Member("kind", kSpectrumKinds[spectrum.data.index()]);
        std::visit([&](const auto& data) { WriteData(out, data); }, spectrum.data);
        out.EndObject();
    }
    out.EndArray();
}

void WritePushovers(CJsonWriter& out, const T_MODEL_CONTENT& content)
{
    if (content.model.pushovers.empty()) return;
    out.Key("pushover");
    out.BeginArray();
    for (const auto& [key, push] : content.model.pushovers) {
        WritePushover(out, content, key, push);
        if (out.Failed()) return;
    }
    out.EndArray();
}

void WriteEvaluations(CJsonWriter& out, const T_MODEL& model)
{
    if (out.Failed() || model.evaluations.empty()) return;
    out.Key("evaluations");
    out.BeginArray();
    for (const auto& entry : model.evaluations)
        WriteEvaluation(out, entry.second);
    out.EndArray();
}
