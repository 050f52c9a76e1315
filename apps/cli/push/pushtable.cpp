#include "push/pushtable.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_rps/push/pushatpointtext.h"

#include <algorithm>

namespace {

/// Numbers of the steps that are printed, from 0.
std::vector<std::size_t> Rows(const T_PUSH_RUN& run, std::size_t most)
{
    const std::size_t count = run.loadFactor.size();
    std::vector<std::size_t> rows;
    const std::size_t every = most > 0 && count > most ? (count + most - 1) / most : 1;
    for (std::size_t i = 0; i < count; ++i) {
        const bool asked =
            std::ranges::find(run.additional, static_cast<int>(i + 1)) != run.additional.end();
        if (i % every == 0 || i + 1 == count || asked) rows.push_back(i);
    }
    return rows;
}

using T_COUNTS = std::array<std::size_t, kPushStateNames.size()>;

T_COUNTS CountsAt(const T_PUSH_RUN& run, std::size_t step)
{
    T_COUNTS counts{};
    for (const T_PUSH_HINGE_SERIES& hinge : run.hinges)
        ++counts[static_cast<std::size_t>(hinge.state[step])];
    return counts;
}

/// A heading with its unit.
std::string Head(const char* key, const std::string& unit)
{
    return Say(key) + (unit.empty() ? "" : " (" + unit + ")");
}

std::string MomentUnit(const T_UNITS& units)
{
    return std::string(NameOf(units.force)) + "*" + std::string(NameOf(units.length));
}

} // namespace

std::string PushTable(const T_PUSH_RUN& run, const T_UNITS& units, std::size_t mostRows)
{
    std::string text = "\n== " + run.name + ": " + PushStatusText(run.status) + " (" +
                       PushOutcomeText(run.data.head.end.outcome) + ")\n" + run.advice + "\n";
    for (const std::string& warning : run.warnings)
        text += "! " + warning + "\n";
    const std::vector<std::size_t> rows = Rows(run, mostRows);
    if (rows.empty()) return text + Say("IDS_QM_CLI_PUSH_NO_STEP") + "\n";
    const bool turns = run.direction > 2;
    const std::string length(turns ? "rad" : NameOf(units.length));
    const std::string force = turns ? MomentUnit(units) : std::string(NameOf(units.force));
    T_COUNTS seen{};
    for (const std::size_t row : rows)
        for (std::size_t s = 0; s < seen.size(); ++s)
            seen[s] += CountsAt(run, row)[s];
    text += FormatText("\n%7s %13s %18s %20s", Say("IDS_QM_CLI_STEP").c_str(),
                       Say("IDS_QM_CLI_PUSH_FACTOR").c_str(),
                       Head("IDS_QM_CLI_PUSH_DISPLACEMENT", length).c_str(),
                       Head("IDS_QM_CLI_PUSH_REACTION", force).c_str());
    for (std::size_t s = 0; s < seen.size(); ++s)
        if (seen[s] > 0)
            text += FormatText(" %8s", PushStateText(static_cast<PUSH_STATE>(s)).c_str());
    for (const std::size_t row : rows) {
        const bool asked =
            std::ranges::find(run.additional, static_cast<int>(row + 1)) != run.additional.end();
        text += FormatText("\n%6zu%s %13.6g %18.6g %20.6g", row + 1, asked ? "+" : " ",
                           run.loadFactor[row],
                           FromSi(run.displacement[row], units, turns ? kDimNone : kDimLength),
                           FromSi(run.baseReaction[row], units, turns ? kDimMoment : kDimForce));
        const T_COUNTS counts = CountsAt(run, row);
        for (std::size_t s = 0; s < seen.size(); ++s)
            if (seen[s] > 0) text += FormatText(" %8zu", counts[s]);
    }
    text += "\n";
    if (rows.size() < run.loadFactor.size())
        text += Say("IDS_QM_CLI_PUSH_THINNED", std::to_string(rows.size()),
                    std::to_string(run.loadFactor.size())) +
                "\n";
    return text;
}

std::string PushHingeTable(const T_PUSH_RUN& run, const T_UNITS& units)
{
    if (run.loadFactor.empty() || run.hinges.empty()) return {};
    std::string text =
        "\n" + Say("IDS_QM_CLI_PUSH_HINGES", run.name, std::to_string(run.loadFactor.size())) +
        "\n" +
        FormatText("%10s %4s %4s %16s %16s  %s\n", Say("IDS_QM_CLI_ELEMENT").c_str(),
                   Say("IDS_QM_CLI_PUSH_END").c_str(), "",
                   Say("IDS_QM_CLI_PUSH_DEFORMATION").c_str(), Say("IDS_QM_CLI_PUSH_FORCE").c_str(),
                   Say("IDS_QM_CLI_STATE").c_str());
    for (const T_PUSH_HINGE_SERIES& hinge : run.hinges) {
        const bool moment = hinge.place.component >= HINGE_COMPONENT::Mx;
        text += FormatText("%10d %4s %4s %16.6g %16.6g  %s\n", hinge.place.element,
                           hinge.place.end.c_str(),
                           kComponentNames[static_cast<std::size_t>(hinge.place.component)],
                           FromSi(hinge.deformation.back(), units, moment ? kDimNone : kDimLength),
                           FromSi(hinge.force.back(), units, StrengthDim(hinge.place.component)),
                           PushStateText(hinge.state.back()).c_str());
    }
    return text +
           Say("IDS_QM_CLI_PUSH_HINGE_UNITS", std::string(NameOf(units.length)),
               std::string(NameOf(units.force)), MomentUnit(units)) +
           "\n";
}
