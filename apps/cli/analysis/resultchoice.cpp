#include "analysis/resultchoice.h"

#include "qm_db/recordfacts.h"

#include <algorithm>
#include <cmath>
#include <functional>

namespace {

double Size(const T_DOF6& v)
{
    return std::hypot(v[0], v[1], v[2]);
}
double Size(double v)
{
    return std::fabs(v);
}
double Size(const T_BEAM_ROWS& rows)
{
    double largest = 0.0;
    for (const T_DOF6& row : rows)
        largest = std::max({largest, std::fabs(row[4]), std::fabs(row[5])});
    return largest;
}

/// A table: which ids of it are chosen, and where it stands in the results.
template <class T>
void Choose(std::vector<T_BY_ID<T>>& rows, const std::set<int>& ids, const T_RESULT_CHOICE& choice)
{
    const bool all = choice.nodes.empty() && choice.elements.empty();
    if (!all) std::erase_if(rows, [&](const T_BY_ID<T>& row) { return !ids.contains(row.id); });
    if (choice.top == 0) return;
    std::ranges::stable_sort(rows, std::greater{},
                             [](const T_BY_ID<T>& row) { return Size(row.value); });
    rows.resize(std::min(rows.size(), choice.top));
}

struct T_VALUE {
    std::string component;
    double value;
};

std::vector<T_VALUE> Values(const char* force, const char* moment, const T_DOF6& v)
{
    std::vector<T_VALUE> out;
    for (std::size_t i = 0; i < v.size(); ++i)
        out.push_back({std::string(i < 3 ? force : moment) + "XYZ"[i % 3], v[i]});
    return out;
}

std::vector<T_VALUE> BeamValues(const T_BEAM_ROWS& rows)
{
    constexpr std::array kNames{"N", "Vy", "Vz", "Mx", "My", "Mz"};
    std::vector<T_VALUE> out;
    for (std::size_t p = 0; p < rows.size(); ++p)
        for (std::size_t i = 0; i < kNames.size(); ++i)
            out.push_back({std::string(kNames[i]) + " " + kPositionNames[p], rows[p][i]});
    return out;
}

/// The envelope of one table; values(row) lists the components in their order.
template <class T, class VALUES>
std::vector<T_ENVELOPE_ROW> Enveloped(const std::vector<T_CASE_RESULTS>& cases,
                                      std::vector<T_BY_ID<T>> T_CASE_RESULTS::*table,
                                      const std::set<int>& ids, const VALUES& values)
{
    std::vector<T_ENVELOPE_ROW> out;
    for (std::size_t r = 0; r < (cases[0].*table).size(); ++r) {
        const int id = (cases[0].*table)[r].id;
        if (!ids.contains(id)) continue;
        const std::size_t first = out.size();
        for (std::size_t c = 0; c < cases.size(); ++c) {
            const std::vector<T_VALUE> found = values((cases[c].*table)[r].value);
            for (std::size_t k = 0; k < found.size(); ++k) {
                const auto& [component, v] = found[k];
                if (c == 0) out.push_back({id, component, v, v, 0, 0});
                T_ENVELOPE_ROW& row = out[first + k];
                if (v < row.min) row.min = v, row.minCase = c;
                if (v > row.max) row.max = v, row.maxCase = c;
            }
        }
    }
    std::erase_if(out, [](const T_ENVELOPE_ROW& row) { return row.min == 0.0 && row.max == 0.0; });
    return out;
}

/// The ids of a table that are chosen in any of the cases.
template <class T>
std::set<int> ChosenIds(const std::vector<T_CASE_RESULTS>& chosen,
                        std::vector<T_BY_ID<T>> T_CASE_RESULTS::*table)
{
    std::set<int> ids;
    for (const T_CASE_RESULTS& results : chosen)
        for (const T_BY_ID<T>& row : results.*table)
            ids.insert(row.id);
    return ids;
}

} // namespace

T_CASE_RESULTS Chosen(const T_CASE_RESULTS& results, const T_RESULT_CHOICE& choice)
{
    T_CASE_RESULTS out = results;
    Choose(out.displacements, choice.nodes, choice);
    Choose(out.reactions, choice.nodes, choice);
    Choose(out.trusses, choice.elements, choice);
    Choose(out.beams, choice.elements, choice);
    return out;
}

T_ENVELOPE EnvelopeOf(const std::vector<T_CASE_RESULTS>& cases, const T_RESULT_CHOICE& choice)
{
    std::vector<T_CASE_RESULTS> chosen;
    for (const T_CASE_RESULTS& results : cases)
        chosen.push_back(Chosen(results, choice));
    using R = T_CASE_RESULTS;
    const auto one = [](double v) { return std::vector<T_VALUE>{{"N", v}}; };
    const auto moved = [](const T_DOF6& v) { return Values("D", "R", v); };
    const auto held = [](const T_DOF6& v) { return Values("F", "M", v); };
    return {Enveloped(cases, &R::displacements, ChosenIds(chosen, &R::displacements), moved),
            Enveloped(cases, &R::reactions, ChosenIds(chosen, &R::reactions), held),
            Enveloped(cases, &R::trusses, ChosenIds(chosen, &R::trusses), one),
            Enveloped(cases, &R::beams, ChosenIds(chosen, &R::beams), BeamValues)};
}
