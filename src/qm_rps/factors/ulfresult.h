// Result set of a solved unknown load factor item, and its table.
#pragma once

#include "qm_base/finding.h"
#include "qm_rps/factors/ulfrecords.h"

struct T_ULF_RESULT_CONSTRAINT {
    std::string name;
    std::string description;
    std::optional<double> upper, lower; // an equality has its value as both
    /// What cases outside the table contribute; in a static analysis all cases stand in the table.
    std::optional<double> constant{};
    std::string place{}; // stage and step where it is read, of one that names them
    std::string unit{};  // of value and bounds
    bool operator==(const T_ULF_RESULT_CONSTRAINT&) const = default;
};

struct T_ULF_RESULT {
    T_ULFI_D item;
    std::vector<T_ULF_CASE> cases;                    // of the combination, or the item's rows
    std::vector<double> factors;                      // per case: solved or known
    std::vector<T_ULF_RESULT_CONSTRAINT> constraints; // one per user constraint
    std::vector<std::vector<double>> influence;       // per constraint: response of every case
    bool exact = false;                               // solved as equations
    int code = 0;                                     // of the solver
    bool stage = false; // the cases are loads at a construction stage and step
    /// The values are sums of results of a model that is analysed with geometric stiffness or sag:
    /// other tensions change its stiffness, and then they hold to the first order alone.
    bool linearForecast = false;
};

inline auto Numbers(const T_ULF_RESULT& r)
{
    return std::tie(r.factors, r.influence);
}

/// One calculation of an item: what went into the optimizer and what came out.
struct T_ULF_RUN {
    T_ULFI_D item;
    std::vector<T_ULF_CASE> cases;     // as in the result
    std::vector<T_ULFC_D> constraints; // that take part, in the document's current units
    T_ULF_FORMED formed;
    T_OPT_ANSWER answer;
    std::vector<std::vector<double>> influence; // per constraint: response of every case
    std::vector<std::string> places{};          // of the constraints; empty in a static analysis
    std::vector<std::string> units{};           // of the constraints
    bool linearForecast = false;                // see T_ULF_RESULT
};

/// What a calculation has come to.
struct T_ULF_CALCULATION {
    std::optional<T_ULF_RUN> run;       // it reached the optimizer
    std::optional<T_ULF_RESULT> result; // factors were found
    /// Without a result why there is none; with one the constraints that equations could not meet
    /// to 1e-6, if any.
    std::optional<T_FINDING> said;
};

/// The result set of a run with these factors, one per unknown: the solved ones, or others to be
/// shown in the same way.
T_ULF_RESULT UlfResultOf(const T_ULF_RUN& run, std::span<const double> factors);

/// A row of the result table.
struct T_ULF_RESULT_ROW {
    std::string name;
    std::string description;
    double value = 0.0;
    std::optional<double> upper, lower;
    /// By how much a bound or target is missed: above 0 over it, below 0 under it, 0 within.
    double residual = 0.0;
    bool active = false; // at a bound, to 1e-8 of the row's scale
    bool met = true;     // residual within 1e-6 of the row's scale
    std::string place{}; // as of the constraint
    std::string unit{};  // likewise
    bool operator==(const T_ULF_RESULT_ROW&) const = default;
};
inline auto Numbers(const T_ULF_RESULT_ROW& r)
{
    return std::tie(r.value, r.upper, r.lower, r.residual);
}

/// Bounds of a constraint as the table shows them. Compared equalities have 0 as both: the
/// difference of the two places.
T_ULF_RESULT_CONSTRAINT UlfResultConstraint(const T_ULFC_D& constraint);

/// Value of constraint i: influence times factors, and the constant. The sum runs in case order.
double UlfValue(const T_ULF_RESULT& result, std::size_t constraint);

/// A constraint's name with its place, "HOLD (S1/Last Step)".
std::string UlfNameAt(const std::string& name, const std::string& place);

/// What is small in the row of constraint i: its scale.
double UlfScale(const T_ULF_RESULT& result, std::size_t constraint);

/// For tables: what rounding has left of a zero is shown as 0.
double UlfShown(double value, double scale);

/// The factor of a case for tables: 0 where what it contributes to every constraint that feels it
/// is rounding.
double UlfShownFactor(const T_ULF_RESULT& result, std::size_t loadCase);

/// One row per user constraint. A row's scale: the largest of its bounds and the sum of the
/// absolute contributions of the cases.
std::vector<T_ULF_RESULT_ROW> UlfResultRows(const T_ULF_RESULT& result);

/// Names of the constraints that are not met, with their places; empty: all are.
std::string UlfMisses(const T_ULF_RESULT& result);

/// Value of the item's objective: sum of |w x|, sum of (w x)^2, or largest |w x|.
double UlfObjective(const T_ULF_RESULT& result);
