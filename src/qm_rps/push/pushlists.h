// Lists of the push that grow at their end: initial loads, numbers, rows of an increment function.
// Their tables show one empty row more: what is typed there is added.
#pragma once

#include "qm_db/records.h"

#include <string>
#include <vector>

/// A column takes a finite number. 1 taken, 0 refused: the list as it was. An emptied cell takes
/// its row off; the empty row stays as it is.
[[nodiscard]] int SetListNumber(std::vector<double>& list, std::size_t row,
                                const std::string& text);
/// Empty for the row behind the last.
std::string ListNumberText(const std::vector<double>& list, std::size_t row);

/// Columns: static load case ("1 : G"), factor. Of the empty row the load case comes first.
std::string InitialLoadText(const T_MODEL& model, const std::vector<T_PUSH_INITIAL_LOAD>& loads,
                            std::size_t row, std::size_t column);
/// Load cases to choose from, an empty text first: it takes the row off.
std::vector<std::string> InitialLoadChoices(const T_MODEL& model);
[[nodiscard]] int SetInitialLoad(const T_MODEL& model, std::vector<T_PUSH_INITIAL_LOAD>& loads,
                                 std::size_t row, std::size_t column, const std::string& text);

/// Columns: step, factor. A value typed into the empty row adds a row; the other value of it is
/// that of the row before, so that the rules ask for it. Emptying either cell takes the row off.
std::string FunctionRowText(const T_POFC_D& function, std::size_t row, std::size_t column);
[[nodiscard]] int SetFunctionRow(T_POFC_D& function, std::size_t row, std::size_t column,
                                 const std::string& text);

/// Whether a hinge type acts; no types: all do.
bool HingeTypeActs(const std::vector<int>& acting, int type);
/// Lets a type act or not. A list of all types of the model becomes the empty one, which follows
/// the model; one of none can't be said and is refused (0).
[[nodiscard]] int SetHingeTypeActs(const T_MODEL& model, std::vector<int>& acting, int type,
                                   bool acts);
