#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_db/recordfacts.h"
#include "qm_rps/pushover/explain/evaluationfacts.h"
#include "qm_rps/pushover/explain/spectrumof.h"

namespace {

std::string N(double value)
{
    return FormatText("%.6g", value);
}

std::string Percent(std::optional<double> damping)
{
    constexpr double kUsual = 5.0; // per cent, where nothing is stated
    return N(damping.value_or(kUsual)) + " %";
}

// ---- spectra ------------------------------------------------------------------------------------

std::string Describe(const T_SPFC_ATC40& s)
{
    return "Ca = " + N(s.Ca) + " g, Cv = " + N(s.Cv) + " g s";
}

std::string Describe(const T_SPFC_EURO2003& s)
{
    std::string text = FormatText("type %d, soil %c, ag = ", s.type, s.soil) + N(s.ag) +
                       " g, xi = " + Percent(s.damping);
    const auto add = [&](const char* name, const std::optional<double>& value) {
        if (value) text += std::string(", ") + name + " = " + N(*value);
    };
    add("S", s.S);
    add("TB", s.TB);
    add("TC", s.TC);
    add("TD", s.TD);
    return text;
}

std::string Describe(const T_SPFC_EURO1996& s)
{
    return FormatText("soil %c, ag = ", s.soil) + N(s.ag) + " g, xi = " + Percent(s.damping);
}

std::string Describe(const T_SPFC_NTC& s)
{
    std::string text = FormatText("soil %c, T%d, xi = ", s.soil, s.topography) + Percent(s.damping);
    for (std::size_t i = 0; i < s.states.size(); ++i)
        if (const auto& state = s.states[i])
            text += std::string("; ") + kLimitStateNames[i] + ": ag = " + N(state->ag) +
                    " g, F0 = " + N(state->F0) + ", TC* = " + N(state->TCstar) + " s";
    return text;
}

std::string Describe(const T_SPFC_USER& s)
{
    return N(static_cast<double>(s.T.size())) + " (T, Sa), T = " + N(s.T.front()) + " ... " +
           N(s.T.back()) + " s";
}

T_FACT Input(const char* key, std::string text)
{
    T_FACT fact;
    fact.definition = Say(key);
    fact.text = std::move(text);
    return fact;
}

// ---- options ------------------------------------------------------------------------------------

constexpr std::array<const char*, 4> kAtcBehaviours{"A", "B", "C", "IDS_QM_FACT_USER_DAMPING"};
constexpr std::array<const char*, 4> kFemaBehaviours{
    "IDS_QM_FACT_BILINEAR", "IDS_QM_FACT_STIFFNESS_DEGRADING", "IDS_QM_FACT_STRENGTH_DEGRADING",
    "IDS_QM_FACT_ANY_TYPE"};

std::string Behaviour(const T_EVAL_D& eval)
{
    const auto i = static_cast<std::size_t>(eval.behavior.value_or(0));
    const auto& keys = eval.method == PUSH_METHOD::Fema440 ? kFemaBehaviours : kAtcBehaviours;
    const std::string key = keys.at(i);
    std::string text = key.starts_with("IDS") ? Say(key) : key;
    if (eval.method == PUSH_METHOD::Atc40 && eval.userDamping && i + 1 == keys.size())
        text +=
            ": beta1 = " + N((*eval.userDamping)[0]) + " %, kappa1 = " + N((*eval.userDamping)[1]) +
            ", beta2 = " + N((*eval.userDamping)[2]) + " %, kappa2 = " + N((*eval.userDamping)[3]);
    return text;
}

void AddPointInputs(const T_PUSH_EVALUATION& e, std::vector<T_FACT>& out)
{
    out.push_back(Input("IDS_QM_FACT_PROCEDURE", std::string(1, e.procedure)));
    out.push_back(Input("IDS_QM_UI_PUSH_BEHAVIOR", Behaviour(e.eval)));
    out.push_back(Input("IDS_QM_FACT_ELASTIC_DAMPING", Percent(e.eval.elasticDamping)));
    if (e.eval.method == PUSH_METHOD::Fema440)
        out.push_back(Input("IDS_QM_FACT_ALPHA_ROWS",
                            Say(e.eval.alphaInPercent.value_or(false) ? "IDS_QM_FACT_IN_PERCENT"
                                                                      : "IDS_QM_FACT_AS_RATIO")));
}

void AddTargetInputs(const T_PUSH_EVALUATION& e, std::vector<T_FACT>& out)
{
    if (e.IsMasonry()) out.push_back(Input("IDS_QM_FACT_MASONRY", Say("IDS_QM_FACT_YES")));
    out.push_back(Input("IDS_QM_FACT_DRIFTS",
                        Say(e.eval.driftKind.value_or(1) == 1 ? "IDS_QM_FACT_DRIFT_PAIRS"
                                                              : "IDS_QM_FACT_DRIFT_CENTRE")));
}

} // namespace

const T_SPFC_D* SpectrumOf(const T_MODEL& model, const std::string& name)
{
    for (const auto& [key, spectrum] : model.spectra)
        if (spectrum.name == name) return &spectrum;
    return nullptr;
}

std::vector<T_FACT> InputsOf(const T_PUSH_EVALUATION& e, const T_SPFC_D* spectrum)
{
    const auto method = static_cast<std::size_t>(e.eval.method) - kFirstMethod;
    std::vector<T_FACT> out{Input("IDS_QM_FACT_METHOD", kMethodNames[method]),
                            Input("IDS_QM_FACT_LOAD_CASE", e.eval.push)};
    if (e.loadCase.controlNode > 0)
        out.push_back(
            Input("IDS_QM_FACT_CONTROL",
                  std::to_string(e.loadCase.controlNode) + ", " +
                      kDirectionNames[static_cast<std::size_t>(e.loadCase.direction - 1)]));
    if (spectrum) {
        const std::string kind = kSpectrumKinds[spectrum->data.index()];
        out.push_back(Input(
            "IDS_QM_FACT_SPECTRUM",
            spectrum->name + " (" + kind +
                "): " + std::visit([](const auto& s) { return Describe(s); }, spectrum->data)));
    }
    if (e.IsTarget())
        AddTargetInputs(e, out);
    else
        AddPointInputs(e, out);
    out.push_back(Input("IDS_QM_FACT_FACTORS",
                        Say(e.factors.eigenBased ? "IDS_QM_FACT_EIGEN" : "IDS_QM_FACT_MASSES",
                            std::to_string(e.factors.mode))));
    return out;
}
