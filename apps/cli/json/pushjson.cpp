#include "json/pushjson.h"

#include <algorithm>

namespace {

constexpr T_JSON_LAYOUT kRuns{1, 0}, kRun{2, 1}, kRows{3, 2};

/// Writes values of SI in the units of the document.
class CWriter {
public:
    explicit CWriter(const T_UNITS& units) : m_units(units), m_w(JSON_REALS::Shortest) {}

    std::string Text(const std::vector<T_PUSH_RUN>& runs, const std::set<int>& nodes)
    {
        m_w.List(kRuns);
        for (const T_PUSH_RUN& run : runs)
            Write(run, nodes);
        m_w.End();
        return m_w.Text();
    }

private:
    void Write(const T_PUSH_RUN& run, const std::set<int>& nodes)
    {
        const bool turns = run.direction > 2;
        const T_DIM displacement = turns ? kDimNone : kDimLength;
        const T_DIM force = turns ? kDimMoment : kDimForce;
        m_w.Object(kRun);
        m_w.Member("name", run.name);
        m_w.Member("status", kPushStatusNames[static_cast<std::size_t>(run.status)]);
        m_w.Key("outcome").Object(kJsonOneLine);
        m_w.Member("name", run.outcome).Member("advice", run.advice);
        m_w.End();
        if (!run.warnings.empty()) m_w.Items("warnings", run.warnings, kJsonOneLine);
        Series("load_factor", run.loadFactor, kDimNone);
        Series("displacement", run.displacement, displacement);
        Series("base_reaction", run.baseReaction, force);
        Series("residual", run.residual, kDimNone);
        m_w.Items("additional", run.additional, kJsonOneLine);
        WriteEvents(run, displacement, force);
        m_w.Key("hinges").List(kRows);
        for (const T_PUSH_HINGE_SERIES& hinge : run.hinges)
            Write(hinge);
        m_w.End();
        m_w.Key("storeys").List(kRows);
        for (const T_PUSH_STOREY_SERIES& storey : run.storeys)
            Write(storey);
        m_w.End();
        if (!nodes.empty()) WriteNodes(run, nodes);
        m_w.End();
    }

    void Series(const char* name, const std::vector<double>& values, T_DIM dim)
    {
        m_w.Key(name).List(kJsonOneLine);
        for (const double v : values)
            m_w.Value(FromSi(v, m_units, dim));
        m_w.End();
    }

    void WriteEvents(const T_PUSH_RUN& run, T_DIM displacement, T_DIM force)
    {
        m_w.Key("events").List(kRows);
        for (const T_PUSH_EVENT_ROW& event : run.events) {
            m_w.Object(kJsonOneLine);
            m_w.Member("load_factor", event.loadFactor);
            m_w.Member("displacement", FromSi(event.displacement, m_units, displacement));
            m_w.Member("base_reaction", FromSi(event.baseReaction, m_units, force));
            m_w.Member("stage", event.initial ? "initial" : "push");
            m_w.Key("hinges").List(kJsonOneLine);
            for (const auto& turn : event.hinges) {
                m_w.Object(kJsonOneLine);
                WritePlace(m_w, run.hinges[turn.hinge].place);
                m_w.Member("to", turn.to);
                m_w.End();
            }
            m_w.End();
            m_w.End();
        }
        m_w.End();
    }

    void Write(const T_PUSH_HINGE_SERIES& hinge)
    {
        const bool moment = hinge.place.component >= HINGE_COMPONENT::Mx;
        m_w.Object(kJsonOneLine);
        WritePlace(m_w, hinge.place);
        Series("deformation", hinge.deformation, moment ? kDimNone : kDimLength);
        Series("force", hinge.force, StrengthDim(hinge.place.component));
        m_w.Key("state").List(kJsonOneLine);
        for (const PUSH_STATE state : hinge.state)
            m_w.Value(kPushStateNames[static_cast<std::size_t>(state)]);
        m_w.End();
        m_w.End();
    }

    void Write(const T_PUSH_STOREY_SERIES& storey)
    {
        m_w.Object(kJsonOneLine);
        m_w.Member("name", storey.name);
        Series("displacement", storey.displacement, kDimLength);
        Series("drift", storey.drift, kDimNone);
        Series("shear", storey.shear, kDimForce);
        m_w.End();
    }

    void WriteNodes(const T_PUSH_RUN& run, const std::set<int>& nodes)
    {
        m_w.Key("nodes").Object(kRows);
        for (std::size_t i = 0; i < run.data.nodes.size(); ++i) {
            if (!nodes.contains(run.data.nodes[i])) continue;
            m_w.Key(std::to_string(run.data.nodes[i])).List(kJsonOneLine);
            for (const auto& step : run.data.displacement) {
                m_w.List(kJsonOneLine);
                for (std::size_t d = 0; d < 6; ++d)
                    m_w.Value(FromSi(step[i][d], m_units, d < 3 ? kDimLength : kDimNone));
                m_w.End();
            }
            m_w.End();
        }
        m_w.End();
    }

    T_UNITS m_units;
    CJsonText m_w;
};

} // namespace

void WritePlace(CJsonText& w, const T_PUSH_LAW_PLACE& place)
{
    w.Member("element", place.element);
    if (std::ranges::all_of(place.end, [](char c) { return c >= '0' && c <= '9'; }))
        w.Member("end", std::stoi(place.end));
    else
        w.Member("end", place.end);
    w.Member("component", kComponentNames[static_cast<std::size_t>(place.component)]);
}

std::string PushJson(const std::vector<T_PUSH_RUN>& runs, const std::set<int>& nodes,
                     const T_UNITS& units)
{
    return CWriter(units).Text(runs, nodes);
}
