#include "analysis/analysistext.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_db/recordfacts.h"

#include <algorithm>
#include <cmath>

namespace {

/// A column never runs into the next one: a blank stands before the widest number.
std::string Column(double value)
{
    return FormatText(" %13.6g", value);
}

std::string Short(double value)
{
    return FormatText("%.6g", value);
}

std::string Columns(const T_DOF6& values)
{
    std::string text;
    for (const double v : values)
        text += Column(v);
    return text;
}

std::string Head(const std::string& first, const std::vector<std::string>& names)
{
    std::string text = FormatText("%10s", first.c_str());
    for (const std::string& name : names)
        text += FormatText(" %13s", name.c_str());
    return text + "\n";
}

std::vector<std::string> Dofs(const char* a, const std::string& unitA, const char* b,
                              const std::string& unitB)
{
    std::vector<std::string> out;
    for (const char* prefix : {a, b})
        for (const char* axis : {"X", "Y", "Z"})
            out.push_back(std::string(prefix) + axis + " (" + (prefix == a ? unitA : unitB) + ")");
    return out;
}

constexpr double kModeRounding = 1e-10; // of the largest of all modes
constexpr double kCaseRounding = 1e-12; // of the largest of a load case

/// Without what rounding has left beside the largest.
T_DOF6 Cleaned(T_DOF6 values, double largest, double part = kModeRounding)
{
    for (double& v : values)
        if (std::fabs(v) <= part * largest) v = 0.0;
    return values;
}

template <class ROWS>
void Grow(double& largest, const ROWS& rows)
{
    for (const auto& row : rows)
        for (const double v : row.value)
            largest = std::max(largest, std::fabs(v));
}

/// The results as the tables show them: displacements, and forces with moments, without rounding.
T_CASE_RESULTS WithoutRounding(T_CASE_RESULTS r)
{
    double moved = 0.0, force = 0.0;
    Grow(moved, r.displacements);
    Grow(force, r.reactions);
    for (const auto& row : r.trusses)
        force = std::max(force, std::fabs(row.value));
    for (const auto& row : r.beams)
        for (const T_DOF6& at : row.value)
            for (const double v : at)
                force = std::max(force, std::fabs(v));
    for (auto& row : r.displacements)
        row.value = Cleaned(row.value, moved, kCaseRounding);
    for (auto& row : r.reactions)
        row.value = Cleaned(row.value, force, kCaseRounding);
    for (auto& row : r.trusses)
        if (std::fabs(row.value) <= kCaseRounding * force) row.value = 0.0;
    for (auto& row : r.beams)
        for (T_DOF6& at : row.value)
            at = Cleaned(at, force, kCaseRounding);
    return r;
}

struct T_LARGEST {
    double value = 0.0;
    int id = 0;
};

/// The largest of a group of three components over all rows.
template <class ROWS, class F>
T_LARGEST Largest(const ROWS& rows, const F& size)
{
    T_LARGEST out;
    for (const auto& row : rows) {
        const double v = size(row.value);
        if (std::fabs(v) > std::fabs(out.value)) out = {v, row.id};
    }
    return out;
}

double Translation(const T_DOF6& d)
{
    return std::hypot(d[0], d[1], d[2]);
}

std::string BeamTable(const T_CASE_RESULTS& r, const T_UNITS& units)
{
    std::vector<std::string> names;
    for (std::size_t i = 0; i < 6; ++i) // "moment y (kN*m)" is too wide for its column
        names.push_back(std::string(i == 0   ? "N"
                                    : i == 1 ? "Vy"
                                    : i == 2 ? "Vz"
                                    : i == 3 ? "Mx"
                                    : i == 4 ? "My"
                                             : "Mz") +
                        " (" + (i < 3 ? ForceName(units) : MomentName(units)) + ")");
    std::string text =
        "\n" + Say("IDS_QM_CLI_BEAM_FORCES") + "\n" + Head(Say("IDS_QM_CLI_ELEMENT_AT"), names);
    for (const auto& beam : r.beams) {
        for (std::size_t p = 0; p < beam.value.size(); ++p) {
            text += p == 0 ? FormatText("%6d %3s", beam.id, kPositionNames[p])
                           : FormatText("%6s %3s", "", kPositionNames[p]);
            text += Columns(beam.value[p]) + "\n";
        }
    }
    return text;
}

double LargestOf(const std::vector<T_MODE_RESULTS>& modes, T_DOF6 T_MODE_RESULTS::*member)
{
    double largest = 0.0;
    for (const T_MODE_RESULTS& mode : modes)
        for (const double v : mode.*member)
            largest = std::max(largest, std::fabs(v));
    return largest;
}

} // namespace

std::string ForceName(const T_UNITS& units)
{
    return std::string(NameOf(units.force));
}

std::string LengthName(const T_UNITS& units)
{
    return std::string(NameOf(units.length));
}

std::string MomentName(const T_UNITS& units)
{
    return ForceName(units) + "*" + LengthName(units);
}

std::string StageTitle(const T_SHOWN_STAGE& stage)
{
    return Say("IDS_QM_CLI_STAGE_TITLE", stage.stage, std::to_string(stage.choice.step),
               std::to_string(stage.steps), stage.load, std::to_string(stage.elements));
}

std::string CaseTables(const T_SHOWN_CASE& shown, const T_CASE_RESULTS& results,
                       const T_RESULT_CHOICE& choice, const T_UNITS& units)
{
    const T_CASE_RESULTS r = Chosen(WithoutRounding(results), choice);
    const std::string force = ForceName(units), length = LengthName(units);
    std::string text = "\n== " + shown.name + "\n\n" + Say("IDS_QM_CLI_DISPLACEMENTS") + "\n" +
                       Head(Say("IDS_QM_CLI_NODE"), Dofs("D", length, "R", "rad"));
    for (const auto& row : r.displacements)
        text += FormatText("%10d", row.id) + Columns(row.value) + "\n";
    text += "\n" + Say("IDS_QM_CLI_REACTIONS") + "\n" +
            Head(Say("IDS_QM_CLI_NODE"), Dofs("F", force, "M", MomentName(units)));
    for (const auto& row : r.reactions)
        text += FormatText("%10d", row.id) + Columns(row.value) + "\n";
    if (!r.trusses.empty())
        text += "\n" + Say("IDS_QM_CLI_TRUSS_FORCES") + "\n" +
                Head(Say("IDS_QM_CLI_ELEMENT"), {"N (" + force + ")"});
    for (const auto& row : r.trusses)
        text += FormatText("%10d", row.id) + Column(row.value) + "\n";
    if (!r.beams.empty()) text += BeamTable(r, units);
    return text;
}

namespace {

/// "DX (m)"; the unit of a component by its first letters and table.
std::string WithUnit(const std::string& component, bool moves, const T_UNITS& units)
{
    const char first = component[0];
    if (moves) return component + " (" + (first == 'D' ? LengthName(units) : "rad") + ")";
    return component + " (" + (first == 'M' ? MomentName(units) : ForceName(units)) + ")";
}

std::string EnvelopeTable(const char* title, const char* id,
                          const std::vector<T_ENVELOPE_ROW>& rows, bool moves,
                          const std::vector<T_SHOWN_CASE>& shown, const T_UNITS& units)
{
    if (rows.empty()) return {};
    std::string text = "\n" + Say(title) + "\n" + FormatText("%10s  %-16s", Say(id).c_str(), "") +
                       FormatText(" %13s  %-20s", Say("IDS_QM_CLI_SMALLEST").c_str(), "") +
                       FormatText(" %13s", Say("IDS_QM_CLI_LARGEST").c_str()) + "\n";
    for (const T_ENVELOPE_ROW& row : rows)
        text += FormatText("%10d  %-16s", row.id, WithUnit(row.component, moves, units).c_str()) +
                Column(row.min) + FormatText("  %-20s", shown[row.minCase].name.c_str()) +
                Column(row.max) + "  " + shown[row.maxCase].name + "\n";
    return text;
}

} // namespace

std::string EnvelopeTables(const std::vector<T_SHOWN_CASE>& shown,
                           const std::vector<T_CASE_RESULTS>& results,
                           const T_RESULT_CHOICE& choice, const T_UNITS& units)
{
    if (shown.empty()) return {};
    std::vector<T_CASE_RESULTS> clean;
    for (const T_CASE_RESULTS& r : results)
        clean.push_back(WithoutRounding(r));
    const T_ENVELOPE e = EnvelopeOf(clean, choice);
    const auto table = [&](const char* title, const char* id, const auto& rows, bool moves) {
        return EnvelopeTable(title, id, rows, moves, shown, units);
    };
    return "\n== " + Say("IDS_QM_CLI_ENVELOPE", std::to_string(shown.size())) + "\n" +
           table("IDS_QM_CLI_DISPLACEMENTS", "IDS_QM_CLI_NODE", e.displacements, true) +
           table("IDS_QM_CLI_REACTIONS", "IDS_QM_CLI_NODE", e.reactions, false) +
           table("IDS_QM_CLI_TRUSS_FORCES", "IDS_QM_CLI_ELEMENT", e.trusses, false) +
           table("IDS_QM_CLI_BEAM_FORCES", "IDS_QM_CLI_ELEMENT", e.beams, false);
}

std::string CaseSummary(const T_SHOWN_CASE& shown, const T_CASE_RESULTS& r, const T_UNITS& units)
{
    const std::string force = ForceName(units), length = LengthName(units);
    const T_LARGEST d = Largest(r.displacements, Translation);
    std::string text = shown.name + ": " +
                       Say(d.id ? "IDS_QM_CLI_LARGEST_AT_NODE" : "IDS_QM_CLI_LARGEST_DISPLACEMENT",
                           Short(d.value), length, std::to_string(d.id));
    T_DOF6 sum{};
    for (const auto& row : r.reactions)
        for (std::size_t i = 0; i < sum.size(); ++i)
            sum[i] += row.value[i];
    double size = 0.0; // reactions that cancel leave rounding
    for (const auto& row : r.reactions)
        size = std::max(
            {size, std::fabs(row.value[0]), std::fabs(row.value[1]), std::fabs(row.value[2])});
    for (double& s : sum)
        if (std::fabs(s) <= 1e-10 * size) s = 0.0;
    text += "; " +
            Say("IDS_QM_CLI_SUM_OF_REACTIONS", Short(sum[0]), Short(sum[1]), Short(sum[2]), force);
    const T_LARGEST n = Largest(r.trusses, [](double v) { return v; });
    if (n.id)
        text += "; " + Say("IDS_QM_CLI_LARGEST_TRUSS", Short(n.value), force, std::to_string(n.id));
    const auto bending = [](const T_BEAM_ROWS& rows) {
        double largest = 0.0;
        for (const T_DOF6& row : rows)
            largest = std::max({largest, std::fabs(row[4]), std::fabs(row[5])});
        return largest;
    };
    const T_LARGEST m = Largest(r.beams, bending);
    if (m.id)
        text += "; " + Say("IDS_QM_CLI_LARGEST_MOMENT", Short(m.value), MomentName(units),
                           std::to_string(m.id));
    return text + "\n";
}

std::string ModeTable(const std::vector<T_MODE_RESULTS>& modes)
{
    std::string text = "\n" + Say("IDS_QM_CLI_MODES") + "\n" +
                       Head(Say("IDS_QM_CLI_MODE"),
                            {"T (s)", "X (%)", "Y (%)", "Z (%)", "RX (%)", "RY (%)", "RZ (%)"});
    T_DOF6 sum{};
    for (std::size_t i = 0; i < modes.size(); ++i) {
        text += FormatText("%10zu", i + 1) + Column(modes[i].period) +
                Columns(Cleaned(modes[i].massPercent, 100.0)) + "\n";
        for (std::size_t k = 0; k < sum.size(); ++k)
            sum[k] += modes[i].massPercent[k];
    }
    text += FormatText("%10s %13s", Say("IDS_QM_CLI_SUM").c_str(), "") +
            Columns(Cleaned(sum, 100.0)) + "\n\n" + Say("IDS_QM_CLI_PARTICIPATION") + "\n" +
            Head(Say("IDS_QM_CLI_MODE"), {"X", "Y", "Z", "RX", "RY", "RZ"});
    const double largest = LargestOf(modes, &T_MODE_RESULTS::participation);
    for (std::size_t i = 0; i < modes.size(); ++i)
        text +=
            FormatText("%10zu", i + 1) + Columns(Cleaned(modes[i].participation, largest)) + "\n";
    return text;
}
