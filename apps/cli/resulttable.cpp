#include "resulttable.h"

#include "qm_base/textformat.h"
#include "qm_rps/pushover/fema440coefficients.h"

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
    std::size_t width = 10;
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
    static constexpr const char* kStatus[] = {"not found", "found", "elastic"};
    const auto value = [&](auto member) {
        return e.point ? Number((*e.point).*member) : std::string("-");
    };
    return FormatText("%-*s %-11s %-10s %11s %11s %11s %10s %9s %9s %6zu\n", width,
                      e.eval.name.c_str(), Method(e).c_str(), kStatus[e.result],
                      value(&T_PERF_POINT::D).c_str(), value(&T_PERF_POINT::V).c_str(),
                      value(&T_PERF_POINT::Sd).c_str(), value(&T_PERF_POINT::Sa).c_str(),
                      value(&T_PERF_POINT::Teff).c_str(),
                      e.point ? Number(e.point->damping).c_str() : "-", e.trace.size());
}

std::string StateLines(const T_PUSH_EVALUATION& e)
{
    std::string text = FormatText("\n%s: limit states (%s at the control node)\n",
                                  e.eval.name.c_str(), std::string(NameOf(e.units.length)).c_str());
    text += FormatText("  %-6s %12s %6s %12s %6s  %s\n", "state", "demand", "step", "capacity",
                       "step", "remark");
    for (const T_LIMIT_ROW& r : e.limitStates)
        text +=
            FormatText("  %-6s %12s %6s %12s %6s  %s\n", r.name.c_str(), Number(r.demand).c_str(),
                       Step(r.demandStep).c_str(), Number(r.capacity).c_str(),
                       Step(r.capacityStep).c_str(), r.remark.empty() ? "-" : r.remark.c_str());
    return text;
}

std::string AdditionalLines(const T_PUSH_EVALUATION& e, int width)
{
    std::string text;
    if (e.allPoints.size() > 1) {
        text += FormatText("%-*s   demand equals capacity at D =", width, "");
        for (const T_PERF_POINT& p : e.allPoints)
            text += FormatText(" %.5g", p.D);
        text += "\n";
    }
    for (const T_ADDITIONAL_STEP& s : e.additionalSteps)
        text += FormatText("%-*s   step %d: D = %.5g, V = %.5g, Sd = %.5g, Sa = %.5g\n", width, "",
                           s.step, s.D, s.V, s.Sd, s.Sa);
    for (const T_ADDITIONAL_POINT& p : e.additionalPoints)
        text +=
            FormatText("%-*s   spectrum %s: %s, D = %s, V = %s\n", width, "", p.spectrum.c_str(),
                       OutcomeName(p.outcome).c_str(), p.point ? Number(p.point->D).c_str() : "-",
                       p.point ? Number(p.point->V).c_str() : "-");
    return text;
}

std::string TrialLines(const T_PUSH_EVALUATION& e)
{
    const char* const format =
        "  %5s %10s %10s %10s %10s %9s %9s %8s %9s %8s %8s %9s %9s %10s %10s";
    std::string text = FormatText(format, "trial", "dpi", "api", "dy", "ay", "alpha", "mu", "kappa",
                                  "beta_eff", "SRa", "SRv", "T_eff", "M", "Di", "Ai") +
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
        FormatText("%-*s %-11s %-10s %11s %11s %11s %10s %9s %9s %6s\n", width, "evaluation",
                   "method", "status", ("D [" + L + "]").c_str(), ("V [" + F + "]").c_str(),
                   ("Sd [" + L + "]").c_str(), "Sa [g]", "T_eff [s]", "beta [%]", "trials");
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
    std::string text = FormatText("%-12s %12s %12s %12s %10s %9s  %s\n", "method",
                                  ("D [" + L + "]").c_str(), ("V [" + F + "]").c_str(),
                                  ("Sd [" + L + "]").c_str(), "Sa [g]", "D / mean", "outcome");
    for (const T_COMPARISON_ROW& row : c.rows) {
        const auto value = [&](double v) { return row.found ? FormatText("%.5g", v) : "-"; };
        text += FormatText("%-12s %12s %12s %12s %10s %9s  %s\n", row.label.c_str(),
                           value(row.D).c_str(), value(row.V).c_str(), value(row.Sd).c_str(),
                           value(row.Sa).c_str(),
                           row.found ? FormatText("%.3f", row.D / c.meanD).c_str() : "-",
                           OutcomeName(row.outcome).c_str());
    }
    if (c.count > 0)
        text += FormatText("\nspread of D over %d methods: %.5g to %.5g %s, mean %.5g, "
                           "largest / smallest %.3f\n",
                           c.count, c.minD, c.maxD, L.c_str(), c.meanD, c.maxD / c.minD);
    return text;
}

std::string TraceTable(const T_PUSH_EVALUATION& e)
{
    std::string text =
        FormatText("\n%s: %s\n", e.eval.name.c_str(), e.IsTarget() ? "derivation" : "trials");
    if (!e.IsTarget()) text += TrialLines(e);
    for (std::size_t i = 0; i < e.targets.size(); ++i) {
        const T_TARGET_DISP& t = e.targets[i];
        text +=
            FormatText("  %s T*=%s Tc=%s Se=%s ay=%s dy=%s qu=%s det*=%s dt*=%s%s\n",
                       e.targets.size() > 1 ? kLimitStateNames[i] : "SD", Number(t.Tstar).c_str(),
                       Number(t.Tc).c_str(), Number(t.Se).c_str(), Number(t.ay).c_str(),
                       Number(t.dy).c_str(), Number(t.qu).c_str(), Number(t.det).c_str(),
                       Number(t.dt).c_str(), t.capped ? " (limited to 3 det*)" : "");
    }
    return text;
}

std::string InfoText(CDBDoc& doc)
{
    const T_MODEL& m = doc.Data().Model();
    std::string text =
        FormatText("%s\n  title: %s\n  units: %s, %s\n", doc.Path().c_str(), m.styp.title.c_str(),
                   std::string(NameOf(m.styp.units.force)).c_str(),
                   std::string(NameOf(m.styp.units.length)).c_str());
    text += FormatText("  nodes: %zu, storeys: %zu, modes: %zu, spectra: %zu, evaluations: %zu\n",
                       m.nodes.size(), m.storeys.size(), m.modes.size(), m.spectra.size(),
                       m.evaluations.size());
    for (const auto& [key, polc] : m.pushovers) {
        const auto result = doc.Data().Content().results.find(key);
        const int steps =
            result != doc.Data().Content().results.end() ? result->second->StepCount() : 0;
        text += FormatText("  pushover %s: %d steps, node %d %s, %s\n", polc.name.c_str(), steps,
                           polc.controlNode,
                           kDirectionNames[static_cast<std::size_t>(polc.direction - 1)],
                           kPatternNames[static_cast<std::size_t>(polc.patternKind)]);
        std::array<int, 3> s{};
        if (doc.Post().GetPoverInfo()->GetStepEC8(key, s))
            text += FormatText("    EC8 steps: DL %d, SD %d, NC %d\n", s[0], s[1], s[2]);
        if (doc.Post().GetPoverInfo()->GetStepNTC2008(key, s))
            text += FormatText("    NTC steps: SLD %d, SLV %d, SLC %d\n", s[0], s[1], s[2]);
    }
    for (const auto& [key, spectrum] : m.spectra)
        text += FormatText("  spectrum %s\n", spectrum.name.c_str());
    for (const auto& [key, eval] : m.evaluations)
        text += FormatText("  evaluation %s: %s on %s with %s\n", eval.name.c_str(),
                           MethodName(eval.method), eval.push.c_str(), eval.spectrum.c_str());
    return text;
}
