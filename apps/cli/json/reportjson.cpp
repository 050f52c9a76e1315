#include "json/reportjson.h"

#include "json/resultjson.h"

#include <algorithm>

namespace {

void Write(CJsonText& w, const T_REPORT_STOREY& s)
{
    w.Object();
    w.Member("name", s.name).Member("height", s.height);
    w.Member("elevation", s.elevation).Items("mass", s.mass, kJsonNested);
    w.Items("nodes", s.nodes, kJsonNested);
    w.End();
}

void Write(CJsonText& w, const T_REPORT_STEP& s, const std::vector<T_REPORT_STOREY>& storeys)
{
    w.Object();
    w.Member("step", s.step).Member("load_factor", s.loadFactor);
    w.Member("base_reaction", s.baseReaction);
    w.Member("control_displacement", s.controlDisplacement);
    w.Key("drifts").List();
    for (const T_STOREY_DRIFT& d : s.drifts) {
        const auto storey = std::ranges::find(storeys, d.storey, &T_REPORT_STOREY::key);
        w.Object();
        w.Member("storey", storey == storeys.end() ? std::string() : storey->name);
        w.Member("plain", d.plain).Member("centre", d.centre);
        w.End();
    }
    w.End();
    w.End();
}

void Write(CJsonText& w, const T_REPORT_PUSH& p, const std::vector<T_REPORT_STOREY>& storeys)
{
    w.Object();
    w.Member("name", p.name).Member("control_node", p.controlNode);
    w.Member("direction", kDirectionNames.at(static_cast<std::size_t>(p.direction - 1)));
    w.Key("ended");
    if (p.ended) {
        w.Object();
        w.Member("status", kPushStatusNames[static_cast<std::size_t>(p.ended->status)]);
        w.Member("outcome", PushOutcomeName(p.ended->outcome));
        w.Member("displacement", p.ended->displacement);
        w.End();
    } else {
        w.Value(nullptr);
    }
    w.Key("old");
    if (p.old.empty())
        w.Value(nullptr);
    else
        w.Value(p.old);
    w.Key("limit_states").List();
    for (const T_REPORT_LIMIT& l : p.limitStates) {
        w.Object();
        w.Member("name", l.name);
        w.Member("step", l.step > 0 ? std::optional(l.step) : std::nullopt);
        w.End();
    }
    w.End();
    w.Key("steps").List();
    for (const T_REPORT_STEP& s : p.steps)
        Write(w, s, storeys);
    w.End();
    w.End();
}

} // namespace

std::string ReportJson(const SSReportInfoRW& info)
{
    CJsonText w(JSON_REALS::WithPoint);
    w.Object();
    w.Member("title", info.title);
    w.Key("units").Object();
    w.Member("force", NameOf(info.units.force)).Member("length", NameOf(info.units.length));
    w.End();
    w.Member("gravity", info.gravity);
    w.Key("storeys").List();
    for (const T_REPORT_STOREY& s : info.storeys)
        Write(w, s);
    w.End();
    w.Key("pushover").List();
    for (const T_REPORT_PUSH& p : info.pushovers)
        Write(w, p, info.storeys);
    w.End();
    w.Key("evaluations");
    WriteResults(w, info.evaluations);
    w.End();
    return w.Text();
}
