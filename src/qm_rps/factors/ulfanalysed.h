// The structure as it was analysed last beside what the load factors forecast: an iteration that
// has converged may still forecast another structure than the one that stands in the model.
#pragma once

#include "qm_db/datactrl.h"
#include "qm_rps/factors/ulfresult.h"
#include "qm_rps/factors/ulfstageresponse.h"

#include <map>

/// A constraint in both, in its unit.
struct T_ULF_ANALYSED {
    std::string name;
    std::string place; // stage and step where it is read
    std::string unit;
    double forecast = 0.0; // the rows' results times their factors
    double analysed = 0.0; // from the sum of all stage loads, each with factor 1
    double allowed = 0.0;  // difference that factors within the tolerance of 1 explain
    double scale = 0.0;    // what is small in the row, see UlfScale
    bool Agrees() const;   // false for a NaN
    /// For tables: what rounding has left of a zero is shown as 0.
    double Shown(double value) const { return UlfShown(value, scale); }
    bool operator==(const T_ULF_ANALYSED&) const = default;
};

/// For every constraint of a solved item, with the results from which it was solved. With factors f
/// of the scaled unknowns and |f - 1| <= tolerance the two differ by at most tolerance times the
/// length of their influences (Cauchy and Schwarz); what is left of rounding is allowed as well.
/// 1 done; 0 results.Error() says what can't be read, `out` as it was.
[[nodiscard]] int CompareWithAnalysis(const T_ULF_RUN& run, const T_ULF_RESULT& result,
                                      const T_ULSI_D& item, const CDataCtrl& data,
                                      IUlfStageResults& results, double tolerance,
                                      std::vector<T_ULF_ANALYSED>& out);

/// An element whose pretension an unknown scales, in the document's unit of force.
struct T_ULF_STAY {
    int element = 0;
    std::string load; // name of the load case with its pretension
    double start = 0.0;
    double now = 0.0;
    std::optional<double> force{}; // axial force with it (in stages: at the end of the last one)
    /// By what the pretension has been multiplied; empty: it was 0.
    std::optional<double> Factor() const;
    bool operator==(const T_ULF_STAY&) const = default;
};

/// Initial tensions of a load case; several of one element count as one.
std::map<int, double> PretensionByElement(const T_STLD_D& load);

/// Pretension of the elements that the item's unknowns scale, by load case and element.
using ULF_PRETENSION = std::map<std::pair<int, int>, double>;
ULF_PRETENSION PretensionOf(const T_ULSI_D& item, const CDataCtrl& data);

/// The same now beside what it was, with the forces of the sum of all stage loads.
std::vector<T_ULF_STAY> StaysOf(const ULF_PRETENSION& start, const CDataCtrl& data,
                                IUlfStageResults& results);
