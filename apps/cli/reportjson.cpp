#include "reportjson.h"

#include "resultjson.h"

#include <nlohmann/json.hpp>

#include <algorithm>

namespace {

using json = nlohmann::ordered_json;

json StoreyJson(const T_REPORT_STOREY& s)
{
    return {{"name", s.name},
            {"height", s.height},
            {"elevation", s.elevation},
            {"mass", s.mass},
            {"nodes", s.nodes}};
}

json StepJson(const T_REPORT_STEP& s, const std::vector<T_REPORT_STOREY>& storeys)
{
    json row{{"step", s.step},
             {"load_factor", s.loadFactor},
             {"base_reaction", s.baseReaction},
             {"control_displacement", s.controlDisplacement},
             {"drifts", json::array()}};
    for (const T_STOREY_DRIFT& d : s.drifts) {
        const auto storey = std::ranges::find(storeys, d.storey, &T_REPORT_STOREY::key);
        row["drifts"].push_back({{"storey", storey == storeys.end() ? "" : storey->name},
                                 {"plain", d.plain},
                                 {"centre", d.centre}});
    }
    return row;
}

json PushJson(const T_REPORT_PUSH& p, const std::vector<T_REPORT_STOREY>& storeys)
{
    json out{{"name", p.name},
             {"control_node", p.controlNode},
             {"direction", kDirectionNames.at(static_cast<std::size_t>(p.direction - 1))},
             {"limit_states", json::array()},
             {"steps", json::array()}};
    for (const T_REPORT_LIMIT& l : p.limitStates)
        out["limit_states"].push_back(
            {{"name", l.name}, {"step", l.step > 0 ? json(l.step) : json(nullptr)}});
    for (const T_REPORT_STEP& s : p.steps)
        out["steps"].push_back(StepJson(s, storeys));
    return out;
}

} // namespace

std::string ReportJson(const SSReportInfoRW& info)
{
    json out{
        {"title", info.title},
        {"units", {{"force", NameOf(info.units.force)}, {"length", NameOf(info.units.length)}}},
        {"gravity", info.gravity},
        {"storeys", json::array()},
        {"pushover", json::array()}};
    for (const T_REPORT_STOREY& s : info.storeys)
        out["storeys"].push_back(StoreyJson(s));
    for (const T_REPORT_PUSH& p : info.pushovers)
        out["pushover"].push_back(PushJson(p, info.storeys));
    out["evaluations"] = json::parse(ResultJson(info.evaluations));
    return out.dump(1) + "\n";
}
