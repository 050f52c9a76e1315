// Results as tables: displacements, reactions, forces of members, by source or as an envelope.
#pragma once

#include "qm_db/sheetfile.h"
#include "qm_rps/view/diagram.h"

enum class RESULT_TABLE { Displacements, Reactions, Forces };
inline constexpr std::array<const char*, 3> kResultTableNames{"displacements", "reactions",
                                                              "forces"};

struct T_RESULT_TABLE_CHOICE {
    RESULT_TABLE what = RESULT_TABLE::Forces;
    std::vector<std::pair<T_SHAPE_SOURCE, int>> sources; // with the step of each
    bool envelope = false;                               // over them
    std::set<int> nodes, elements;                       // these alone; empty: all
};

struct T_RESULT_CELL {
    std::string text;
    std::optional<double> number{}; // in place of a text
};

/// What an envelope is over when nothing is named: load cases and combinations with results.
std::vector<T_SHAPE_SOURCE> EnvelopeSources(const std::vector<T_SHAPE_SOURCE>& all);

/// Current units, which the heads name; numbers with all their digits.
struct T_RESULT_TABLE {
    std::string title;
    std::vector<std::string> notes; // what holds for the numbers
    std::vector<std::string> heads;
    std::vector<std::vector<T_RESULT_CELL>> rows; // as many cells as heads
};

/// Rows by source and id. Forces stand at I, 1/4, 2/4, 3/4, J, at places between where My or
/// Mz has an extreme, and on both sides ("x = 3-", "x = 3+") of where a component leaps. An
/// envelope has the smallest and largest value of each component with the sources that give them;
/// of forces also over the whole member, exact under its loads. Modes stand alone, in their own
/// normalisation. 1 done; 0 `why`: a source has no such results, or is a mode beside others.
[[nodiscard]] int MakeResultTable(CDBDoc& doc, CFrameScene& scene,
                                  const T_RESULT_TABLE_CHOICE& choice, T_RESULT_TABLE& out,
                                  std::string& why);

/// Comma-separated, lines end with "\n", texts with commas or quotes are quoted; '.' in numbers.
[[nodiscard]] std::string CsvText(const T_RESULT_TABLE& table);
/// With a bold head of columns that fit.
[[nodiscard]] T_SHEET SheetOf(const T_RESULT_TABLE& table);
