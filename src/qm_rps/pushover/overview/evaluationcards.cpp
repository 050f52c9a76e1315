#include "qm_rps/pushover/overview/evaluationcards.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_rps/pushover/answertrial.h"

namespace {

/// Displacement over that of the yield point: of the bilinear curve of the answer's trial, or of
/// the one of the target displacement.
std::optional<double> DuctilityOf(const T_PUSH_EVALUATION& e)
{
    const auto over = [](double d, std::optional<double> dy) {
        return dy && *dy > 0.0 ? std::optional(d / *dy) : std::nullopt;
    };
    if (e.point) {
        const T_PERFPT_TRIAL* const trial = AnswerTrial(e);
        return trial ? over(e.point->Sd, trial->dy) : std::nullopt;
    }
    const T_TARGET_DISP* const target = TargetOfAnswer(e);
    return target ? over(target->dt, target->dy) : std::nullopt;
}

/// Secant period at a performance point, period T* of a target displacement.
std::optional<double> PeriodOf(const T_PUSH_EVALUATION& e)
{
    if (e.point) return e.point->Teff;
    const T_TARGET_DISP* const target = TargetOfAnswer(e);
    return target ? std::optional(target->Tstar) : std::nullopt;
}

T_CARD Card(CARD which, std::string definition, std::optional<double> value, std::string unit = {})
{
    return {kCardNames[static_cast<std::size_t>(which)], std::move(definition), value,
            std::move(unit)};
}

} // namespace

std::string T_CARD::NumberText() const
{
    return value ? FormatText("%.4g", *value) : "-";
}

std::vector<T_CARD> CardsOf(const T_EVALUATION_ENTRY& entry)
{
    const T_PUSH_EVALUATION& e = entry.result;
    const std::optional<T_EVALUATION_ANSWER> answer = AnswerOf(e);
    const std::string L(NameOf(e.units.length)), F(NameOf(e.units.force));
    const std::string state = answer && !answer->state.empty() ? " (" + answer->state + ")" : "";
    const bool curve = !e.capacity.Sd.empty();
    const auto only = [](bool has, double value) {
        return has ? std::optional(value) : std::nullopt;
    };
    const auto say = [](const char* key) { return Say(key); };
    constexpr double kPercent = 100.0;
    std::vector<T_CARD> cards;
    cards.push_back(Card(CARD::D, say("IDS_QM_FACT_D") + state,
                         answer ? std::optional(answer->D) : std::nullopt, L));
    cards.push_back(
        Card(CARD::V, say("IDS_QM_FACT_V") + state, answer ? answer->V : std::nullopt, F));
    cards.push_back(Card(CARD::Drift,
                         say(entry.drift ? "IDS_QM_EVAL_DRIFT" : "IDS_QM_EVAL_NO_DRIFT") + state,
                         entry.drift ? std::optional(kPercent * *entry.drift) : std::nullopt, "%"));
    cards.push_back(Card(CARD::Teff,
                         say(e.IsTarget() ? "IDS_QM_EVAL_TSTAR" : "IDS_QM_EVAL_TEFF") + state,
                         PeriodOf(e), "s"));
    cards.push_back(Card(CARD::Damping,
                         say(e.IsTarget() ? "IDS_QM_EVAL_NO_DAMPING" : "IDS_QM_FACT_BETA_EFF"),
                         e.point ? e.point->damping : std::nullopt, "%"));
    cards.push_back(Card(CARD::Gamma, say("IDS_QM_FACT_GAMMA"), only(curve, e.factors.gamma)));
    cards.push_back(
        Card(CARD::Mstar, say("IDS_QM_FACT_MSTAR"), only(curve, e.mStar), F + " s2/" + L));
    const std::optional<double> mu = DuctilityOf(e);
    cards.push_back(Card(CARD::Ductility,
                         !mu            ? say("IDS_QM_EVAL_NO_DUCTILITY")
                         : e.IsTarget() ? say("IDS_QM_EVAL_MU") + ", dt*/dy*" + state
                                        : say("IDS_QM_EVAL_MU") + ", Sd/dy",
                         mu));
    return cards;
}
