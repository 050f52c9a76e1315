#include "json/judgementjson.h"

#include "qm_rps/generate/codehingerows.h"
#include "qm_rps/judge/judgementtable.h"
#include "qm_rps/push/pushatpointtext.h"
#include "json/tracejson.h"

namespace {

class CWriter {
public:
    CWriter(const T_JUDGEMENT& judgement, bool trace) : m_j(judgement), m_trace(trace) {}

    void Write(CJsonText& w) const
    {
        w.Object();
        w.Member("evaluation", m_j.evaluation).Member("push", m_j.push);
        w.Key("units").Object(kJsonOneLine);
        w.Member("force", ::NameOf(m_j.units.force)).Member("length", ::NameOf(m_j.units.length));
        w.Member("rotation", "rad").End();
        if (m_j.note.empty())
            w.Member("verdict", kVerdictNames[static_cast<std::size_t>(m_j.Verdict())]);
        else
            w.Member("reason", m_j.note);
        if (!m_j.stale.empty()) w.Member("stale_hinges", m_j.stale);
        if (m_j.note.empty()) w.Member("start_displacement", Shown(m_j.start, kDimLength));
        w.Key("factors").Object(kJsonOneLine);
        const T_JUDGE_FACTORS& f = m_j.options.factors;
        w.Member("gamma_c", f.gammaC).Member("gamma_s", f.gammaS).Member("gamma", f.gamma).End();
        w.Key("limit_states").List();
        for (const T_JUDGED_STATE& state : m_j.states)
            Write(w, state);
        w.End();
        w.Key("first_passes").List();
        for (const T_JUDGED_LIMIT& limit : m_j.limits)
            Write(w, limit);
        w.End();
        w.Items("notes", m_j.note.empty() ? JudgementNotes(m_j) : std::vector<std::string>(),
                kJsonNested);
        w.End();
    }

private:
    std::optional<double> Shown(std::optional<double> si, T_DIM dim) const
    {
        return si ? std::optional(FromSi(*si, m_j.units, dim) + 0.0) : si;
    }

    static const char* NameOf(JUDGE_MODE mode)
    {
        return kModeNames[static_cast<std::size_t>(mode)];
    }

    void WriteCount(CJsonText& w, const T_VERDICT_COUNT& count) const
    {
        for (std::size_t v = 0; v < count.count.size(); ++v)
            w.Member(kVerdictNames[v], count.count[v]);
        for (std::size_t v = 0; v < count.joints.size(); ++v)
            w.Member(("joints " + std::string(kVerdictNames[v])).c_str(), count.joints[v]);
    }

    void WriteCheck(CJsonText& w, const T_JUDGED_END& end, const T_MODE_CHECK& mode,
                    std::size_t level) const
    {
        const std::optional<T_CHECK>& check = mode.at[level];
        w.Key(NameOf(mode.mode)).Object(kJsonOneLine);
        if (check) {
            w.Member("demand", Shown(check->demand, mode.dim));
            w.Member("capacity", Shown(check->capacity, mode.dim));
            if (mode.mode == JUDGE_MODE::Joint) w.Member("unit", UnitText(mode.dim, m_j.units));
            w.Member("ratio", check->Ratio());
            w.Member("verdict", kVerdictNames[check->Holds() ? 0 : 1]);
            if (end.basis == JUDGE_BASIS::Code) {
                w.Member("clause", mode.clause[level]);
                w.Member("least_sure_figure", kMarkWords[static_cast<std::size_t>(mode.leastSure)]);
            }
        } else {
            w.Member("verdict", kVerdictNames[2]).Member("reason", mode.why);
        }
        w.End();
    }

    /// Which end of which element, or which joint.
    void WritePlace(CJsonText& w, const T_JUDGED_END& end) const
    {
        if (end.joint) {
            w.Member("node", end.joint->node);
            w.Beside().Member("axis", end.joint->axis);
            return;
        }
        const T_END_PLACE& place = end.place;
        w.Member("element", place.element);
        if (end.kind == JUDGED_KIND::Spring) return;
        const char* const at = end.kind == JUDGED_KIND::Brace ? "C" : place.atJ ? "J" : "I";
        w.Beside().Member("end", at);
        w.Beside().Member("component", kComponentNames[static_cast<std::size_t>(place.component)]);
    }

    /// What the end does: of joints forces alone.
    void WriteMotion(CJsonText& w, const T_JUDGED_END& end, const T_JUDGED_ROW& row) const
    {
        if (end.joint || end.kind == JUDGED_KIND::Spring) return;
        const bool brace = end.kind == JUDGED_KIND::Brace;
        const T_DIM dim = brace ? kDimLength : kDimNone;
        const auto known = [](double v) { return v > 0.0 ? std::optional(v) : std::nullopt; };
        w.Member("LV", Shown(known(row.checks.LV), kDimLength)).Beside();
        w.Member("theta_y", known(row.checks.thetaY)).Beside();
        w.Member(brace ? "elongation" : "chord_rotation", Shown(row.state.chord, dim)).Beside();
        w.Member("hinge_deformation", Shown(row.state.flowed, dim)).Beside();
        w.Member("ductility", known(row.checks.ductility));
    }

    void Write(CJsonText& w, const T_JUDGED_STATE& state, const T_JUDGED_ROW& row) const
    {
        const T_JUDGED_END& end = m_j.ends[row.end];
        w.Object();
        WritePlace(w, end);
        w.Beside().Member("storey", end.storey);
        w.Beside().Member("by", end.basis == JUDGE_BASIS::Nothing ? std::nullopt
                                                                  : std::optional(end.Code()));
        w.Beside().Member("level", end.Levels()[state.level]);
        const auto known = [&](double v) {
            return end.HasForces() ? std::optional(v) : std::nullopt;
        };
        w.Member("N", Shown(known(row.state.N), kDimForce)).Beside();
        w.Member("M", Shown(known(row.state.M), kDimMoment)).Beside();
        w.Member("V", Shown(known(row.state.V), kDimForce)).Beside();
        WriteMotion(w, end, row);
        bool any = false;
        for (const T_MODE_CHECK& mode : row.checks.modes) {
            WriteCheck(w, end, mode, state.level);
            any = any || mode.at[state.level];
        }
        w.Member("ratio", row.ratio);
        w.Beside().Member("governing",
                          any ? std::optional<std::string>(NameOf(row.governing)) : std::nullopt);
        w.Beside().Member("verdict", kVerdictNames[static_cast<std::size_t>(row.verdict)]);
        for (const T_MODE_CHECK& mode : row.checks.modes)
            if (m_trace)
                WriteTrace(w, (std::string(NameOf(mode.mode)) + "_trace").c_str(), mode.trace,
                           m_j.units);
        w.End();
    }

    void Write(CJsonText& w, const T_JUDGED_STATE& state) const
    {
        w.Object();
        w.Member("name", state.name);
        w.Member("of",
                 state.point.kind == PUSH_POINT::Performance ? "performance point" : "demand");
        w.Member("displacement", Shown(state.point.displacement, kDimLength));
        if (state.found != AT_POINT::Reached) {
            w.Member("verdict", kVerdictNames[2]).Member("reason", WhyNot(state.found));
            w.End();
            return;
        }
        w.Member("verdict", kVerdictNames[static_cast<std::size_t>(VerdictOf(state))]);
        w.Key("count").Object(kJsonOneLine);
        WriteCount(w, state.all);
        w.End();
        w.Key("storeys").List();
        for (const T_VERDICT_COUNT& storey : state.storeys) {
            w.Object(kJsonOneLine);
            w.Member("name", storey.storey);
            WriteCount(w, storey);
            w.End();
        }
        w.End();
        w.Key("drifts").List();
        for (const T_STOREY_AT_POINT& storey : state.drifts) {
            w.Object(kJsonOneLine);
            w.Member("name", storey.name).Member("drift", storey.drift);
            w.End();
        }
        w.End();
        if (!state.shearAt.empty()) w.Member("shear_at", state.shearAt);
        w.Key("ends").List();
        for (const T_JUDGED_ROW& row : state.rows)
            Write(w, state, row);
        w.End();
        w.End();
    }

    void Write(CJsonText& w, const T_JUDGED_LIMIT& limit) const
    {
        const T_FIRST_PASS& first = limit.first;
        w.Object(kJsonOneLine);
        w.Member("name", limit.state);
        w.Member("mode", NameOf(first.mode));
        if (first.end) {
            WritePlace(w, m_j.ends[*first.end]);
            w.Member("displacement", Shown(first.displacement, kDimLength));
            w.Member("base_reaction", Shown(first.baseReaction, kDimForce));
        }
        w.Member("capacity_displacement", Shown(limit.capacity, kDimLength));
        w.Member("demand_displacement", Shown(limit.demand, kDimLength));
        w.Member("spectrum_factor", limit.factor);
        w.Member("pga_ratio", limit.PgaRatio());
        w.Member("demand_pga", limit.DemandPga());
        w.Member("capacity_pga", limit.CapacityPga());
        w.Member("ends_not_checked", first.unchecked);
        if (!limit.why.empty()) w.Member("reason", limit.why);
        w.End();
    }

    const T_JUDGEMENT& m_j;
    bool m_trace;
};

} // namespace

std::string JudgementJson(std::span<const T_JUDGEMENT> judgements, bool trace)
{
    CJsonText w(JSON_REALS::Shortest);
    w.List();
    for (const T_JUDGEMENT& judgement : judgements)
        CWriter(judgement, trace).Write(w);
    w.End();
    return w.Text();
}
