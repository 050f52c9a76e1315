// Pushover load cases as rows of a list: what the list and the selection show.
#pragma once

#include "qm_db/dbdoc.h"

#include <array>
#include <string>
#include <vector>

inline constexpr std::array<const char*, 5> kLoadCaseHeads{
    "IDS_QM_UI_HEAD_KEY", "IDS_QM_UI_HEAD_NAME", "IDS_QM_UI_HEAD_CONTROL",
    "IDS_QM_UI_HEAD_DIRECTION", "IDS_QM_UI_HEAD_PATTERN"};

struct T_LOADCASE_ROW {
    int key = 0;
    std::array<std::string, kLoadCaseHeads.size()> cells; // under kLoadCaseHeads
};

/// Every pushover load case, keys ascending.
std::vector<T_LOADCASE_ROW> LoadCaseRows(const CDBDoc& doc);
/// Kind of a load pattern in words, 0 to 3; "" of another.
std::string PatternKindText(int kind);
/// Index of the row with that key; -1: none.
int RowOfLoadCase(const std::vector<T_LOADCASE_ROW>& rows, int key);
