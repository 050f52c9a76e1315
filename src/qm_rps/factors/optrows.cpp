#include "qm_rps/factors/optrows.h"

#include <algorithm>
#include <cmath>
#include <limits>

namespace {

constexpr double kUnknownBelow = 1e-12; // absolute known factor of an unknown item
constexpr int kBeam = 4;

} // namespace

bool IsUnknownItem(const T_OPT_ITEM& item)
{
    return std::fabs(item[1]) < kUnknownBelow;
}

int Truncated(double value)
{
    constexpr double most = std::numeric_limits<int>::max();
    return value >= -most && value <= most ? static_cast<int>(value) : 0;
}

std::optional<T_OPT_READING> ReadRecord(const T_OPT_RECORD& record)
{
    const int kind = Truncated(record[0]);
    if (kind < 1 || kind > kBeam) return std::nullopt;
    const std::size_t shift = kind == kBeam ? 1 : 0; // the position stands before the component
    T_OPT_READING r;
    r.first = {kind, Truncated(record[1]), shift ? Truncated(record[2]) : 0,
               Truncated(record[2 + shift]), Truncated(record.back())};
    r.value = record[3 + shift];
    r.relation = Truncated(record[4 + shift]);
    if (Truncated(record[5 + shift]) == 0) {
        r.second = r.first;
        r.second->id = Truncated(record[6 + shift]);
    }
    return r;
}

T_OPT_ROW BuildRow(std::span<const T_OPT_ITEM> items, const T_OPT_READING& reading,
                   std::span<const double> r1, std::span<const double> r2,
                   std::vector<double>& coefficients)
{
    T_OPT_ROW row{{}, r2.empty() ? reading.value : 0.0, reading.relation};
    coefficients.resize(items.size());
    for (std::size_t i = 0; i < items.size(); ++i) {
        const double response = r2.empty() ? r1[i] : r1[i] - r2[i];
        coefficients[i] = response;
        if (IsUnknownItem(items[i]))
            row.coefficients.push_back(response);
        else
            row.rhs -= response * items[i][1];
    }
    return row;
}

int BuildRows(std::span<const T_OPT_ITEM> items, std::span<const T_OPT_RECORD> constraints,
              IUlfResponse& source, std::vector<T_OPT_ROW>& rows,
              std::vector<std::vector<double>>& coefficients)
{
    std::vector<std::optional<T_OPT_READING>> readings;
    std::vector<T_OPT_QUANTITY> what;
    for (const T_OPT_RECORD& record : constraints) {
        readings.push_back(ReadRecord(record));
        if (!readings.back()) continue;
        what.push_back(readings.back()->first);
        if (readings.back()->second) what.push_back(*readings.back()->second);
    }
    std::vector<double> responses(what.size() * items.size());
    if (!source.Read(items, what, responses)) return 0;

    const auto nUnknown =
        static_cast<std::size_t>(std::count_if(items.begin(), items.end(), IsUnknownItem));
    rows.assign(constraints.size(), {std::vector<double>(nUnknown), 0.0, 0});
    coefficients.assign(constraints.size(), std::vector<double>(items.size()));
    std::span<const double> next = responses;
    const auto take = [&] {
        const auto taken = next.first(items.size());
        next = next.subspan(items.size());
        return taken;
    };
    for (std::size_t i = 0; i < constraints.size(); ++i) {
        if (!readings[i]) continue;
        const auto r1 = take();
        const auto r2 = readings[i]->second ? take() : std::span<const double>();
        rows[i] = BuildRow(items, *readings[i], r1, r2, coefficients[i]);
    }
    return 1;
}
