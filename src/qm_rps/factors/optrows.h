// Rows of the load factor optimizer: from constraint records and responses to coefficients and
// right-hand sides.
#pragma once

#include "qm_rps/factors/ulfresponse.h"

#include <optional>
#include <vector>

/// Constraint record of the optimizer; integers are stored as doubles and truncated when read.
/// Kinds 1 to 3: 0 kind, 1 node or element, 2 component (from 1), 3 value, 4 relation (0 equal,
/// -1 at most, 1 at least), 5 comparison (1 with the value, 0 with the same quantity of another
/// node or element), 6 that other one. Kind 4 has its position (from 1) at 2, the rest one later.
/// Last entry, construction stage only: stage and step where it is read, 0 those of the item.
using T_OPT_RECORD = std::array<double, 9>;

/// A row: coefficients (one per unknown item, in item order) times the factors, related to rhs.
struct T_OPT_ROW {
    std::vector<double> coefficients;
    double rhs = 0.0;
    int relation = 0; // 0 equal, -1 at most, 1 at least
    bool operator==(const T_OPT_ROW&) const = default;
};

/// What a record says.
struct T_OPT_READING {
    T_OPT_QUANTITY first;
    std::optional<T_OPT_QUANTITY> second{}; // compared with this one instead of the value
    double value = 0.0;
    int relation = 0;
};

/// True when the item's factor is to be found: its known factor is below 1e-12.
bool IsUnknownItem(const T_OPT_ITEM& item);
/// Truncated towards zero; 0 for what no int can hold.
int Truncated(double value);

/// nullopt for a kind other than 1 to 4.
std::optional<T_OPT_READING> ReadRecord(const T_OPT_RECORD& record);

/// The row of a constraint from the responses r1 (and r2 of a compared one, else empty), one per
/// item. `coefficients` gets the response of every item, known or unknown (r1, or r1 - r2).
/// Not compared: rhs = value - sum of r1 times the known factor. Compared: rhs = sum of (r2 - r1)
/// times the known factor, so the row reads first place minus second place, related to zero.
T_OPT_ROW BuildRow(std::span<const T_OPT_ITEM> items, const T_OPT_READING& reading,
                   std::span<const double> r1, std::span<const double> r2,
                   std::vector<double>& coefficients);

/// Rows of all constraints. A kind other than 1 to 4 gives a row of zeros that counts as an
/// equality. coefficients[i]: see BuildRow. 1 done; 0 a response is missing (source.Error()).
[[nodiscard]] int BuildRows(std::span<const T_OPT_ITEM> items,
                            std::span<const T_OPT_RECORD> constraints, IUlfResponse& source,
                            std::vector<T_OPT_ROW>& rows,
                            std::vector<std::vector<double>>& coefficients);
