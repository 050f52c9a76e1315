// Rows of a printed table of plastic deformations and acceptance, and the one interpolation of
// them: linear in every variable between rows, flat outside.
#pragma once

#include "qm_rps/codes/codesheet.h"

#include <array>
#include <limits>
#include <span>

/// a, b, c and the three acceptance values of ASCE 41; plastic deformations, or drifts of a wall.
struct T_CODE_PLASTIC {
    double a = 0.0, b = 0.0, c = 0.0;
    double IO = 0.0, LS = 0.0, CP = 0.0;
};

/// The row holds whatever the variable is.
inline constexpr double kAnyValue = std::numeric_limits<double>::infinity();

/// Up to three variables; those that a table does not have stand at kAnyValue.
struct T_CODE_ROW {
    int group = 0; // rows of one condition
    std::array<double, 3> at{kAnyValue, kAnyValue, kAnyValue};
    T_CODE_PLASTIC values;
    CODE_MARK mark = CODE_MARK::Recalled;
};

struct T_CODE_TABLE {
    const char* clause = "";
    std::array<const char*, 3> variables{"", "", ""}; // symbols
    std::span<const T_CODE_ROW> rows;
};

/// Interpolates within the rows of a group, and writes variables, rows with their weights and
/// values on the sheet. `name` is the condition as the table prints it.
/// Nothing, with the fault NoRow: the table has no row of that group.
std::optional<T_CODE_PLASTIC> Interpolate(const T_CODE_TABLE& table, int group,
                                          std::string_view name, std::array<double, 3> x,
                                          CCodeSheet& sheet);

/// The smaller of each value: where several conditions of a table hold.
T_CODE_PLASTIC LeastOf(const T_CODE_PLASTIC& p, const T_CODE_PLASTIC& q);
/// p + weight (q - p), value by value.
T_CODE_PLASTIC Between(const T_CODE_PLASTIC& p, const T_CODE_PLASTIC& q, double weight);
/// Every deformation times the factor; c stays.
T_CODE_PLASTIC Scaled(const T_CODE_PLASTIC& p, double factor);
/// a to CP as lines of the sheet; `dim` is that of the deformations.
void PutPlastic(const T_CODE_PLASTIC& p, std::string_view clause, std::string_view text,
                CODE_MARK mark, CCodeSheet& sheet, T_DIM dim = kDimNone);
/// Multiples of a yield deformation as deformations, with their lines.
T_CODE_PLASTIC InYields(const T_CODE_PLASTIC& multiples, double yieldDeform,
                        std::string_view clause, std::string_view symbol, CCodeSheet& sheet,
                        T_DIM dim = kDimNone);
