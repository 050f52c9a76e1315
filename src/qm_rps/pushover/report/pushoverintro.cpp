#include "qm_rps/pushover/report/pushoverintro.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_rps/pushover/explain/evaluationfacts.h"
#include "qm_rps/pushover/explain/spectrumof.h"
#include "qm_rps/pushover/outcometext.h"

#include <algorithm>

namespace {

std::string Line(const std::string& name, const std::string& text)
{
    return "* " + name + " : " + text + "\n";
}

std::string Number(double value)
{
    return FormatText("%.6g", value);
}

/// Mass and weight of the push and those of the equivalent system, where there is a curve.
std::string MassLines(const T_PUSH_EVALUATION& e)
{
    if (e.capacity.Sd.empty()) return {};
    const std::string force(NameOf(e.units.force)), length(NameOf(e.units.length));
    const std::string mass = " " + force + " s2/" + length;
    return Line(Say("IDS_QM_FACT_MASS") + ", M", Number(e.factors.mass) + mass) +
           Line(Say("IDS_QM_FACT_WEIGHT") + ", W", Number(e.factors.weight) + " " + force) +
           Line(Say("IDS_QM_FACT_MSTAR") + ", m*", Number(e.mStar) + mass) +
           Line(Say("IDS_QM_FACT_GAMMA") + ", Gamma", Number(e.factors.gamma)) +
           Line(Say("IDS_QM_FACT_ALPHA") + ", alpha", Number(e.factors.alpha));
}

std::string UnitLine(const T_PUSH_EVALUATION& e)
{
    return Line(Say("IDS_QM_REPORT_UNITS"),
                Say("IDS_QM_INTRO_UNITS", std::string(NameOf(e.units.length)),
                    std::string(NameOf(e.units.force))));
}

/// What the remarks of limit states mean, of those that stand there.
std::string RemarkLines(const T_PUSH_EVALUATION& e)
{
    if (e.limitStates.empty()) return {};
    std::string text =
        Line("N/A", Say("IDS_QM_INTRO_NOT_MET")) + Line("-", Say("IDS_QM_INTRO_NONE"));
    const auto isUnchecked = [](const T_LIMIT_ROW& row) { return row.remark == kNotChecked; };
    const auto unchecked = std::ranges::find_if(e.limitStates, isUnchecked);
    if (unchecked != e.limitStates.end())
        text += Line(unchecked->RemarkText(), Say("IDS_QM_INTRO_NOT_CHECKED"));
    return text;
}

} // namespace

std::string PushoverIntroText(const T_PUSH_EVALUATION& e, const T_MODEL& model)
{
    std::string text = "[ " + Say("IDS_QM_INTRO_TITLE") + " ]\n" +
                       Line(Say("IDS_QM_JUDGE_EVALUATION"), e.eval.name);
    for (const T_FACT& input : InputsOf(e, SpectrumOf(model, e.eval.spectrum)))
        text += Line(input.definition, input.text);
    text += MassLines(e) + UnitLine(e) +
            Line(Say("IDS_QM_REPORT_OUTCOME"),
                 OutcomeText(e.outcome) + ". " + OutcomeAdvice(e.outcome));
    if (!e.pointNote.empty()) text += "! " + e.pointNote + "\n";
    for (const auto& message : e.messages)
        text += "! " + message.text + "\n";
    if (e.messages.empty() && e.pointNote.empty())
        text += Line(Say("IDS_QM_INTRO_WARNINGS"), Say("IDS_QM_INTRO_NO_WARNINGS"));
    return text + RemarkLines(e) + "\n";
}
