// Tables of records as files: comma-separated values, spreadsheet.
#pragma once

#include "qm_rps/desk/recordgrid.h"
#include "qm_rps/dialog/texttable.h"

/// All rows in their order, with stored digits; flags as 1 and 0.
T_TEXT_TABLE TableOfGrid(const CRecordGrid& grid);

/// A spreadsheet for a path that ends in .xlsx, else values with commas. 1 written; 0 error says
/// why not, the file as it was.
[[nodiscard]] int ExportGrid(const CRecordGrid& grid, const std::string& path, std::string& error);
