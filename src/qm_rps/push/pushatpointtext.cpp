#include "qm_rps/push/pushatpointtext.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_rps/push/pushquantity.h"

#include <algorithm>
#include <cmath>

namespace {

constexpr int kNameWidth = 20;

/// Places and headings may hold letters of two bytes, which printf counts as two columns.
std::string Padded(const std::string& text, int width)
{
    const auto letters = std::ranges::count_if(
        text, [](char c) { return (static_cast<unsigned char>(c) & 0xC0U) != 0x80U; });
    const auto gap = static_cast<std::ptrdiff_t>(width) - letters;
    return text + std::string(static_cast<std::size_t>(std::max<std::ptrdiff_t>(gap, 0)), ' ');
}

std::string PointLine(const T_PUSH_AT_POINT& at, const T_STATES_SEEN& seen, const T_UNITS& units)
{
    std::string text = "  " + Padded(PointName(at.point), kNameWidth) +
                       FormatText(" %13.6g", FromSi(at.point.displacement, units, kDimLength));
    if (at.found != AT_POINT::Reached) return text + "  " + WhyNot(at.found) + "\n";
    for (std::size_t s = 0; s < seen.size(); ++s)
        if (seen[s]) text += FormatText(" %8zu", at.states[s]);
    return text + "  " + Padded(WorstHingeText(at), 36) + "  " + LargestDriftText(at) + "\n";
}

std::string WorstLines(const T_PUSH_AT_POINT& at, const T_UNITS& units)
{
    std::string text;
    for (const T_HINGE_AT_POINT& h : at.worst)
        text += "    " + Padded(HingePlaceText(h.place), 14) +
                FormatText(" %14.6g %14.6g  %-8s %s\n",
                           DeformationOf(h.place.component, units).Shown(h.deformation),
                           ForceOf(h.place.component, units).Shown(h.force),
                           PushStateText(h.state).c_str(), HingeRatioText(h).c_str());
    return text;
}

std::string StoreyLines(const T_PUSH_AT_POINT& at, const T_UNITS& units)
{
    std::string text;
    for (const T_STOREY_AT_POINT& s : at.storeys)
        text += "    " + Padded(s.name, 14) +
                FormatText(" %14.6g %14.6g", FromSi(s.displacement, units, kDimLength), s.drift) +
                "  " +
                (s.shear ? FormatText("%.6g", FromSi(*s.shear, units, kDimForce))
                         : Say("IDS_QM_UI_STOREY_UNKNOWN")) +
                "\n";
    return text;
}

/// "[ Hinges at the points of E1, push PX (kN, m) ]".
std::string Title(const T_HINGES_AT& h)
{
    return Say("IDS_QM_PUSH_AT_TITLE", h.evaluation, h.push, std::string(NameOf(h.units.force)),
               std::string(NameOf(h.units.length)));
}

} // namespace

std::string HingePlaceText(const T_PUSH_LAW_PLACE& place)
{
    return std::to_string(place.element) + " " + place.end + " " +
           kComponentNames[static_cast<std::size_t>(place.component)];
}

std::string HingeRatioText(const T_HINGE_AT_POINT& hinge)
{
    return hinge.ratio ? FormatText("%.3g %s", *hinge.ratio, RatioOf(hinge.place)) : "-";
}

std::string WorstHingeText(const T_PUSH_AT_POINT& at)
{
    if (at.worst.empty()) return "-";
    const T_HINGE_AT_POINT& worst = at.worst.front();
    return HingePlaceText(worst.place) + ", " + PushStateText(worst.state) + ", " +
           HingeRatioText(worst);
}

std::string LargestDriftText(const T_PUSH_AT_POINT& at)
{
    const auto largest = std::ranges::max_element(
        at.storeys, {}, [](const T_STOREY_AT_POINT& s) { return std::fabs(s.drift); });
    if (largest == at.storeys.end()) return "-";
    return FormatText("%.4g", largest->drift) + " (" + largest->name + ")";
}

T_STATES_SEEN StatesSeen(const T_HINGES_AT& h)
{
    T_STATES_SEEN seen{};
    for (const T_PUSH_AT_POINT& at : h.points)
        for (std::size_t s = 0; s < seen.size(); ++s)
            seen[s] = seen[s] || at.states[s] > 0;
    return seen;
}

std::string PushStateText(PUSH_STATE state)
{
    if (state == PUSH_STATE::Elastic) return Say("IDS_QM_UI_STATE_ELASTIC");
    if (state == PUSH_STATE::Failed) return Say("IDS_QM_UI_STATE_FAILED");
    return kPushStateNames[static_cast<std::size_t>(state)];
}

std::string PointName(const T_PUSH_POINT& point)
{
    switch (point.kind) {
    case PUSH_POINT::Demand:
        return Say("IDS_QM_PUSH_AT_DEMAND", point.state);
    case PUSH_POINT::Capacity:
        return Say("IDS_QM_PUSH_AT_CAPACITY", point.state);
    default:
        return Say("IDS_QM_PUSH_AT_PERFORMANCE");
    }
}

std::string WhyNot(AT_POINT found)
{
    if (found == AT_POINT::Reached) return {};
    return Say(found == AT_POINT::Beyond ? "IDS_QM_PUSH_AT_BEYOND" : "IDS_QM_PUSH_AT_NO_STEP");
}

std::string HingesAtTable(const T_HINGES_AT& h)
{
    if (!h.note.empty()) return "\n" + Title(h) + "\n  " + h.note + "\n";
    if (h.points.empty()) return {};
    const T_STATES_SEEN seen = StatesSeen(h);
    std::string text = "\n" + Title(h) + "\n  " + Padded("", kNameWidth) +
                       FormatText(" %13s", Say("IDS_QM_CLI_PUSH_DISPLACEMENT").c_str());
    for (std::size_t s = 0; s < seen.size(); ++s)
        if (seen[s]) text += FormatText(" %8s", PushStateText(static_cast<PUSH_STATE>(s)).c_str());
    text +=
        "  " + Padded(Say("IDS_QM_PUSH_AT_WORST"), 36) + "  " + Say("IDS_QM_PUSH_AT_DRIFT") + "\n";
    for (const T_PUSH_AT_POINT& at : h.points)
        text += PointLine(at, seen, h.units);
    return text;
}

std::string HingesAtReport(const T_HINGES_AT& h)
{
    std::string text = HingesAtTable(h);
    for (const T_PUSH_AT_POINT& at : h.points) {
        if (at.found != AT_POINT::Reached) continue;
        text += "\n  " + PointName(at.point) +
                FormatText(": %.6g", FromSi(at.point.displacement, h.units, kDimLength)) + "\n";
        if (!at.worst.empty())
            text += "  " + Say("IDS_QM_PUSH_AT_HINGES") + "\n" + WorstLines(at, h.units);
        if (!at.storeys.empty())
            text += "  " + Say("IDS_QM_PUSH_AT_STOREYS") + "\n" + StoreyLines(at, h.units);
    }
    return text.empty() ? text : text + "\n\n";
}
