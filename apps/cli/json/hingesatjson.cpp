#include "json/hingesatjson.h"

#include "qm_rps/push/pushatpointtext.h"
#include "qm_rps/push/pushquantity.h"
#include "json/pushjson.h"

#include <algorithm>

namespace {

/// Name of the point; of a limit state also which of its displacements.
void WritePoint(CJsonText& w, const T_PUSH_POINT& point, const T_UNITS& units)
{
    if (point.kind == PUSH_POINT::Performance)
        w.Member("point", "performance point");
    else
        w.Member("point", point.state)
            .Member("of", point.kind == PUSH_POINT::Demand ? "demand" : "capacity");
    w.Member("displacement", FromSi(point.displacement, units, kDimLength));
}

void Write(CJsonText& w, const T_HINGE_AT_POINT& hinge, const T_UNITS& units)
{
    const HINGE_COMPONENT component = hinge.place.component;
    w.Object(kJsonOneLine);
    WritePlace(w, hinge.place);
    w.Member("deformation", DeformationOf(component, units).Shown(hinge.deformation));
    w.Member("force", ForceOf(component, units).Shown(hinge.force));
    w.Member("state", kPushStateNames[static_cast<std::size_t>(hinge.state)]);
    w.Member("ratio", hinge.ratio);
    w.Member("ratio_of",
             hinge.ratio ? std::optional<std::string>(RatioOf(hinge.place)) : std::nullopt);
    w.End();
}

void Write(CJsonText& w, const T_STOREY_AT_POINT& storey, const T_UNITS& units)
{
    w.Object(kJsonOneLine);
    w.Member("name", storey.name);
    w.Member("displacement", FromSi(storey.displacement, units, kDimLength));
    w.Member("drift", storey.drift);
    w.Key("shear");
    if (storey.shear)
        w.Value(FromSi(*storey.shear, units, kDimForce));
    else
        w.Value(nullptr);
    w.End();
}

void WriteReached(CJsonText& w, const T_PUSH_AT_POINT& at, const T_UNITS& units)
{
    w.Object();
    WritePoint(w, at.point, units);
    w.Member("load_factor", at.loadFactor);
    w.Key("states").Object(kJsonOneLine);
    for (std::size_t s = 0; s < at.states.size(); ++s)
        if (at.states[s] > 0) w.Member(kPushStateNames[s], at.states[s]);
    w.End();
    w.Key("worst").List();
    for (const T_HINGE_AT_POINT& hinge : at.worst)
        Write(w, hinge, units);
    w.End();
    w.Key("storeys").List();
    for (const T_STOREY_AT_POINT& storey : at.storeys)
        Write(w, storey, units);
    w.End();
    w.End();
}

} // namespace

void WriteHingesAt(CJsonText& w, const T_HINGES_AT& hinges)
{
    if (hinges.push.empty()) return;
    const auto isReached = [](const T_PUSH_AT_POINT& at) { return at.found == AT_POINT::Reached; };
    w.Key("hinges_at").List();
    for (const T_PUSH_AT_POINT& at : hinges.points)
        if (isReached(at)) WriteReached(w, at, hinges.units);
    w.End();
    if (hinges.note.empty() && std::ranges::all_of(hinges.points, isReached)) return;
    w.Key("hinges_not_at").List();
    if (!hinges.note.empty()) {
        w.Object(kJsonOneLine);
        w.Member("reason", hinges.note);
        w.End();
    }
    for (const T_PUSH_AT_POINT& at : hinges.points) {
        if (isReached(at)) continue;
        w.Object(kJsonOneLine);
        WritePoint(w, at.point, hinges.units);
        w.Member("reason", WhyNot(at.found));
        w.End();
    }
    w.End();
}
