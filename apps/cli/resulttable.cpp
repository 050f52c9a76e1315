#include "resulttable.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_rps/pushover/fema440coefficients.h"
#include "qm_rps/pushover/report/pushovercells.h"

#include <algorithm>

namespace {

std::string Number(const std::optional<double>& v)
{
    return v ? FormatText("%.5g", *v) : "-";
}
std::string Step(const std::optional<int>& v)
{
    return v ? std::to_string(*v) : "-";
}

std::size_t NameWidth(const std::vector<T_PUSH_EVALUATION>& results)
{
    std::size_t width = Say("IDS_QM_CLI_EVALUATION").size();
    for (const auto& e : results)
        width = std::max(width, e.eval.name.size());
    return width;
}

std::string Method(const T_PUSH_EVALUATION& e)
{
    std::string text = MethodName(e.eval.method);
    if (!e.IsTarget()) text += std::string(" ") + e.procedure;
    return text;
}

std::string PointLine(const T_PUSH_EVALUATION& e, int width)
{
    static constexpr const char* kStatus[] = {"IDS_QM_CLI_NOT_FOUND", "IDS_QM_CLI_FOUND",
                                              "IDS_QM_CLI_ELASTIC", "IDS_QM_CLI_BEYOND"};
    const auto value = [&](auto member) {
        return e.point ? Number((*e.point).*member) : std::string("-");
    };
    return FormatText("%-*s %-11s %-10s %11s %11s %11s %10s %9s %9s %6zu\n", width,
                      e.eval.name.c_str(), Method(e).c_str(), Say(kStatus[e.Status()]).c_str(),
                      value(&T_PERF_POINT::D).c_str(), value(&T_PERF_POINT::V).c_str(),
                      value(&T_PERF_POINT::Sd).c_str(), value(&T_PERF_POINT::Sa).c_str(),
                      value(&T_PERF_POINT::Teff).c_str(),
                      e.point ? Number(e.point->damping).c_str() : "-", e.trace.size());
}

std::string StateLines(const T_PUSH_EVALUATION& e)
{
    std::string text =
        "\n" + Say("IDS_QM_CLI_LIMIT_STATES", e.eval.name, NameOf(e.units.length)) + "\n";
    const std::string step = Say("IDS_QM_CLI_STEP");
    // printf counts bytes, of which an accented letter has two.
    const std::string capacity = Say("IDS_QM_CLI_CAPACITY");
    const int more = static_cast<int>(std::ranges::count_if(
        capacity, [](char c) { return (static_cast<unsigned char>(c) & 0xC0U) == 0x80U; }));
    text += FormatText("  %-6s %12s %6s %*s %6s  %s\n", Say("IDS_QM_CLI_STATE").c_str(),
                       Say("IDS_QM_CLI_DEMAND").c_str(), step.c_str(), 12 + more, capacity.c_str(),
                       step.c_str(), Say("IDS_QM_CLI_REMARK").c_str());
    for (const T_LIMIT_ROW& r : e.limitStates) {
        const auto cell = [&](const std::string& value) { return e.elastic ? "-" : value; };
        text += FormatText(
            "  %-6s %12s %6s %12s %6s  %s\n", r.name.c_str(), cell(Number(r.demand)).c_str(),
            cell(Step(r.demandStep)).c_str(),
            (e.elastic ? Say("IDS_QM_CLI_CAPACITY_ELASTIC") : Number(r.capacity)).c_str(),
            cell(Step(r.capacityStep)).c_str(), r.RemarkText().c_str());
    }
    return text;
}

/// First change of slope, T0 and the effective periods by ductility, where the method has them.
std::string SlopeLine(const T_PUSH_EVALUATION& e)
{
    std::string text;
    if (e.slopeChange)
        text += FormatText("  %s: %.5g, %.5g;",
                           Say("IDS_QM_UI_PUSH_SLOPE_CHANGE", NameOf(e.units.length)).c_str(),
                           e.slopeChange->x, e.slopeChange->y);
    for (std::size_t i = 0; i < e.teffs.size() && i < kTeffDuctilities.size(); ++i)
        text += FormatText("  %s = %.4g s", TeffName(i).c_str(), e.teffs[i]);
    return text.empty() ? text : text + "\n";
}

std::string AdditionalLines(const T_PUSH_EVALUATION& e, int width)
{
    std::string text;
    if (e.allPoints.size() > 1) {
        text += FormatText("%-*s   %s", width, "", Say("IDS_QM_CLI_ALL_POINTS").c_str());
        for (const T_PERF_POINT& p : e.allPoints)
            text += FormatText(" %.5g", p.D);
        text += "\n";
    }
    for (const T_ADDITIONAL_STEP& s : e.additionalSteps)
        text += FormatText("%-*s   %s: D = %.5g, V = %.5g, Sd = %.5g, Sa = %.5g\n", width, "",
                           Say("IDS_QM_CLI_STEP_NUMBER", std::to_string(s.step)).c_str(), s.D, s.V,
                           s.Sd, s.Sa);
    for (const T_ADDITIONAL_POINT& p : e.additionalPoints)
        text += FormatText(
            "%-*s   %s: %s, D = %s, V = %s\n", width, "",
            Say("IDS_QM_CLI_SPECTRUM", p.spectrum).c_str(), OutcomeName(p.outcome).c_str(),
            p.point ? Number(p.point->D).c_str() : "-", p.point ? Number(p.point->V).c_str() : "-");
    return text;
}

std::string TrialLines(const T_PUSH_EVALUATION& e)
{
    const char* const format =
        "  %5s %10s %10s %10s %10s %9s %9s %8s %9s %8s %8s %9s %9s %10s %10s";
    std::string text =
        FormatText(format, Say("IDS_QM_CLI_TRIAL").c_str(), "dpi", "api", "dy", "ay", "alpha", "mu",
                   "kappa", "beta_eff", "SRa", "SRv", "T_eff", "M", "Di", "Ai") +
        "\n";
    for (const T_PERFPT_TRIAL& t : e.trace) {
        text += FormatText(format, std::to_string(t.trial).c_str(), Number(t.dpi).c_str(),
                           Number(t.api).c_str(), Number(t.dy).c_str(), Number(t.ay).c_str(),
                           Number(t.alpha).c_str(), Number(t.mu).c_str(), Number(t.kappa).c_str(),
                           Number(t.betaEff).c_str(), Number(t.SRa).c_str(), Number(t.SRv).c_str(),
                           Number(t.Teff).c_str(), Number(t.M).c_str(), Number(t.Di).c_str(),
                           Number(t.Ai).c_str());
        text += t.row ? "  " + Fema440RowText(*t.row) + "\n" : "\n";
    }
    return text;
}

} // namespace

std::string ResultTable(const std::vector<T_PUSH_EVALUATION>& results)
{
    if (results.empty()) return {};
    const int width = static_cast<int>(NameWidth(results));
    const std::string F(NameOf(results[0].units.force)), L(NameOf(results[0].units.length));
    std::string text =
        FormatText("%-*s %-11s %-10s %11s %11s %11s %10s %9s %9s %6s\n", width,
                   Say("IDS_QM_CLI_EVALUATION").c_str(), Say("IDS_QM_CLI_METHOD").c_str(),
                   Say("IDS_QM_CLI_STATUS").c_str(), ("D [" + L + "]").c_str(),
                   ("V [" + F + "]").c_str(), ("Sd [" + L + "]").c_str(), "Sa [g]", "T_eff [s]",
                   "beta [%]", Say("IDS_QM_CLI_TRIALS").c_str());
    for (const auto& e : results)
        text += PointLine(e, width);
    for (const auto& e : results) {
        if (!e.limitStates.empty()) text += StateLines(e);
    }
    text += "\n";
    for (const auto& e : results) {
        text += FormatText("%-*s %s: %s\n", width, e.eval.name.c_str(),
                           OutcomeName(e.outcome).c_str(), OutcomeAdvice(e.outcome).c_str());
        if (!e.pointNote.empty())
            text += FormatText("%-*s   > %s\n", width, "", e.pointNote.c_str());
        text += AdditionalLines(e, width);
        for (const auto& m : e.messages)
            text += FormatText("%-*s   ! %s\n", width, "", m.text.c_str());
    }
    return text;
}

std::string ComparisonTable(const T_PUSH_COMPARISON& c)
{
    if (c.results.empty()) return {};
    const std::string F(NameOf(c.results[0].units.force)), L(NameOf(c.results[0].units.length));
    std::string text =
        FormatText("%-12s %12s %12s %12s %10s %9s  %s\n", Say("IDS_QM_CLI_METHOD").c_str(),
                   ("D [" + L + "]").c_str(), ("V [" + F + "]").c_str(), ("Sd [" + L + "]").c_str(),
                   "Sa [g]", Say("IDS_QM_CLI_BY_MEAN").c_str(), Say("IDS_QM_CLI_OUTCOME").c_str());
    for (const T_COMPARISON_ROW& row : c.rows) {
        const auto value = [&](double v) { return row.found ? FormatText("%.5g", v) : "-"; };
        text += FormatText("%-12s %12s %12s %12s %10s %9s  %s\n", row.label.c_str(),
                           value(row.D).c_str(), value(row.V).c_str(), value(row.Sd).c_str(),
                           value(row.Sa).c_str(),
                           row.found ? FormatText("%.3f", row.D / c.meanD).c_str() : "-",
                           OutcomeName(row.outcome).c_str());
    }
    if (c.count > 0)
        text += "\n" +
                Say("IDS_QM_CLI_SPREAD", std::to_string(c.count), Number(c.minD), Number(c.maxD), L,
                    Number(c.meanD), FormatText("%.3f", c.maxD / c.minD)) +
                "\n";
    for (const std::string& remark : RemarksOf(c))
        text += "! " + remark + "\n";
    return text;
}

std::string TraceTable(const T_PUSH_EVALUATION& e)
{
    std::string text =
        FormatText("\n%s: %s\n", e.eval.name.c_str(),
                   Say(e.IsTarget() ? "IDS_QM_CLI_DERIVATION" : "IDS_QM_CLI_TRIALS").c_str());
    if (!e.IsTarget()) text += TrialLines(e) + SlopeLine(e);
    for (std::size_t i = 0; i < e.targets.size(); ++i) {
        const T_TARGET_DISP& t = e.targets[i];
        text += FormatText("  %s T*=%s Tc=%s Se=%s ay=%s dy=%s qu=%s det*=%s dt*=%s%s\n",
                           e.targets.size() > 1 ? kLimitStateNames[i] : "SD",
                           Number(t.Tstar).c_str(), Number(t.Tc).c_str(), Number(t.Se).c_str(),
                           Number(t.ay).c_str(), Number(t.dy).c_str(), Number(t.qu).c_str(),
                           Number(t.det).c_str(), Number(t.dt).c_str(),
                           t.capped ? (" " + Say("IDS_QM_CLI_CAPPED")).c_str() : "");
        if (t.found) text += "    " + TargetLine(t, e.factors.gamma) + "\n";
    }
    return text;
}
