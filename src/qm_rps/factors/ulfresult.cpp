#include "qm_rps/factors/ulfresult.h"

#include "qm_rps/factors/ulftexts.h"

#include <algorithm>
#include <cmath>

namespace {

constexpr double kActiveTolerance = 1e-8; // of the row's scale
constexpr double kMetTolerance = 1e-6;    // likewise
constexpr double kZeroTolerance = 1e-12;  // likewise: what rounding has left of a zero

} // namespace

T_ULF_RESULT_CONSTRAINT UlfResultConstraint(const T_ULFC_D& c)
{
    T_ULF_RESULT_CONSTRAINT out{c.name, UlfDescription(c), c.upper, c.lower};
    if (!c.inequality) out.upper = out.lower = c.compareWithValue ? c.value : 0.0;
    return out;
}

T_ULF_RESULT UlfResultOf(const T_ULF_RUN& run, std::span<const double> factors)
{
    T_ULF_RESULT r;
    r.item = run.item;
    r.cases = run.cases;
    for (const T_ULF_CASE& c : run.cases)
        r.factors.push_back(c.factor);
    for (std::size_t i = 0; i < run.formed.unknowns.size(); ++i)
        r.factors[run.formed.unknowns[i]] = factors[i];
    for (const T_ULFC_D& c : run.constraints)
        r.constraints.push_back(UlfResultConstraint(c));
    for (std::size_t i = 0; i < run.places.size(); ++i)
        r.constraints[i].place = run.places[i];
    for (std::size_t i = 0; i < run.units.size(); ++i)
        r.constraints[i].unit = run.units[i];
    r.influence = run.influence;
    r.exact = run.answer.exact;
    r.code = run.answer.code;
    r.stage = run.formed.problem.stage;
    r.linearForecast = run.linearForecast;
    return r;
}

double UlfValue(const T_ULF_RESULT& r, std::size_t constraint)
{
    double sum = 0.0;
    for (std::size_t j = 0; j < r.factors.size(); ++j)
        sum += r.influence[constraint][j] * r.factors[j];
    return sum + r.constraints[constraint].constant.value_or(0.0);
}

std::string UlfNameAt(const std::string& name, const std::string& place)
{
    return place.empty() ? name : name + " (" + place + ")";
}

double UlfScale(const T_ULF_RESULT& r, std::size_t i)
{
    const T_ULF_RESULT_CONSTRAINT& c = r.constraints[i];
    double sum = std::fabs(c.constant.value_or(0.0));
    for (std::size_t j = 0; j < r.factors.size(); ++j)
        sum += std::fabs(r.influence[i][j] * r.factors[j]);
    return std::max({sum, std::fabs(c.upper.value_or(0.0)), std::fabs(c.lower.value_or(0.0))});
}

double UlfShown(double value, double scale)
{
    return std::fabs(value) <= kZeroTolerance * scale ? 0.0 : value + 0.0;
}

double UlfShownFactor(const T_ULF_RESULT& r, std::size_t j)
{
    bool isFelt = false;
    for (std::size_t i = 0; i < r.influence.size(); ++i) {
        const double part = std::fabs(r.influence[i][j] * r.factors[j]);
        if (part > kZeroTolerance * UlfScale(r, i)) return r.factors[j];
        isFelt |= std::fabs(r.influence[i][j]) > 0.0;
    }
    return isFelt ? 0.0 : r.factors[j] + 0.0;
}

std::vector<T_ULF_RESULT_ROW> UlfResultRows(const T_ULF_RESULT& r)
{
    std::vector<T_ULF_RESULT_ROW> rows;
    for (std::size_t i = 0; i < r.constraints.size(); ++i) {
        const T_ULF_RESULT_CONSTRAINT& c = r.constraints[i];
        T_ULF_RESULT_ROW row{c.name, c.description, UlfValue(r, i), c.upper, c.lower};
        row.place = c.place;
        row.unit = c.unit;
        const double scale = UlfScale(r, i);
        const auto at = [&](const std::optional<double>& bound) {
            return bound && std::fabs(row.value - *bound) <= kActiveTolerance * scale;
        };
        // A value that is not a number misses its bounds.
        if (c.upper && !(row.value <= *c.upper)) row.residual = row.value - *c.upper;
        if (c.lower && !(row.value >= *c.lower)) row.residual = row.value - *c.lower;
        row.met = std::fabs(row.residual) <= kMetTolerance * scale;
        row.active = at(c.upper) || at(c.lower) || row.residual != 0.0;
        rows.push_back(std::move(row));
    }
    return rows;
}

std::string UlfMisses(const T_ULF_RESULT& r)
{
    std::string names;
    for (const T_ULF_RESULT_ROW& row : UlfResultRows(r))
        if (!row.met) names += (names.empty() ? "" : ", ") + UlfNameAt(row.name, row.place);
    return names;
}

double UlfObjective(const T_ULF_RESULT& r)
{
    double sum = 0.0, largest = 0.0;
    for (std::size_t j = 0; j < r.cases.size(); ++j) {
        if (!r.cases[j].unknown) continue;
        const double term = std::fabs(r.cases[j].weight * r.factors[j]);
        sum += r.item.objective == 1 ? term * term : term;
        largest = std::max(largest, term);
    }
    return r.item.objective == 2 ? largest : sum;
}
