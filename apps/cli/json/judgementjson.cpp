#include "json/judgementjson.h"

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
        w.Member("force", NameOf(m_j.units.force)).Member("length", NameOf(m_j.units.length));
        w.Member("rotation", "rad").End();
        if (m_j.note.empty())
            w.Member("verdict", kVerdictNames[static_cast<std::size_t>(m_j.Verdict())]);
        else
            w.Member("reason", m_j.note);
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

    void WriteCount(CJsonText& w, const T_VERDICT_COUNT& count) const
    {
        for (std::size_t v = 0; v < count.count.size(); ++v)
            w.Member(kVerdictNames[v], count.count[v]);
    }

    void WriteCheck(CJsonText& w, const T_JUDGED_END& end, const T_JUDGED_ROW& row, JUDGE_MODE mode,
                    std::size_t level) const
    {
        const bool rotation = mode == JUDGE_MODE::Rotation;
        const std::optional<T_CHECK>& check = row.checks.Of(mode, level);
        w.Key(kModeNames[static_cast<std::size_t>(mode)]).Object(kJsonOneLine);
        if (check) {
            const T_DIM dim = rotation ? kDimNone : kDimForce;
            w.Member("demand", Shown(check->demand, dim));
            w.Member("capacity", Shown(check->capacity, dim));
            w.Member("ratio", check->Ratio());
            w.Member("verdict", kVerdictNames[check->Holds() ? 0 : 1]);
            if (end.basis == JUDGE_BASIS::Code) {
                const auto& trace = rotation ? row.checks.rotationTrace : row.checks.shearTrace;
                w.Member("clause", ClauseOf(end, row, mode, level));
                w.Member("least_sure_figure",
                         kMarkWords[static_cast<std::size_t>(LeastSureOf(trace))]);
            }
        } else {
            w.Member("verdict", kVerdictNames[2]);
            w.Member("reason", rotation ? row.checks.whyNoRotation : row.checks.whyNoShear);
        }
        w.End();
    }

    void Write(CJsonText& w, const T_JUDGED_STATE& state, const T_JUDGED_ROW& row) const
    {
        const T_JUDGED_END& end = m_j.ends[row.end];
        w.Object();
        w.Member("element", end.place.element);
        w.Beside().Member("end", end.place.atJ ? "J" : "I");
        w.Beside().Member("component",
                          kComponentNames[static_cast<std::size_t>(end.place.component)]);
        w.Beside().Member("storey", end.storey);
        w.Beside().Member("by", end.basis == JUDGE_BASIS::Nothing ? std::nullopt
                                                                  : std::optional(end.Code()));
        w.Beside().Member("level", end.Levels()[state.level]);
        w.Member("N", Shown(row.state.N, kDimForce)).Beside();
        w.Member("M", Shown(row.state.M, kDimMoment)).Beside();
        w.Member("V", Shown(row.state.V, kDimForce)).Beside();
        const auto known = [](double v) { return v > 0.0 ? std::optional(v) : std::nullopt; };
        w.Member("LV", Shown(known(row.checks.LV), kDimLength)).Beside();
        w.Member("theta_y", known(row.checks.thetaY)).Beside();
        w.Member("chord_rotation", row.state.chord).Beside();
        w.Member("hinge_deformation", row.state.flowed).Beside();
        w.Member("ductility", known(row.checks.ductility));
        WriteCheck(w, end, row, JUDGE_MODE::Rotation, state.level);
        WriteCheck(w, end, row, JUDGE_MODE::Shear, state.level);
        w.Member("ratio", row.ratio);
        const bool any = row.checks.rotation[state.level] || row.checks.shear[state.level];
        w.Beside().Member(
            "governing",
            any ? std::optional<std::string>(kModeNames[static_cast<std::size_t>(row.governing)])
                : std::nullopt);
        w.Beside().Member("verdict", kVerdictNames[static_cast<std::size_t>(row.verdict)]);
        if (m_trace) {
            WriteTrace(w, "rotation_trace", row.checks.rotationTrace, m_j.units);
            WriteTrace(w, "shear_trace", row.checks.shearTrace, m_j.units);
        }
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
        w.Member("mode", kModeNames[static_cast<std::size_t>(first.mode)]);
        if (first.end) {
            const T_END_PLACE& place = m_j.ends[*first.end].place;
            w.Member("element", place.element).Member("end", place.atJ ? "J" : "I");
            w.Member("component", kComponentNames[static_cast<std::size_t>(place.component)]);
            w.Member("displacement", Shown(first.displacement, kDimLength));
            w.Member("base_reaction", Shown(first.baseReaction, kDimForce));
        }
        w.Member("capacity_displacement", Shown(limit.capacity, kDimLength));
        w.Member("demand_displacement", Shown(limit.demand, kDimLength));
        w.Member("spectrum_factor", limit.factor);
        w.Member("demand_pga", limit.demandPga);
        w.Member("capacity_pga", limit.factor && limit.demandPga
                                     ? std::optional(*limit.factor * *limit.demandPga)
                                     : std::nullopt);
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
