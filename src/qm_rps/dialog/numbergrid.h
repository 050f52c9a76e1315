// A grid of numbers over a record: text of the cells, edits and paste of a block of text.
#pragma once

#include "qm_base/mdialog.h"
#include "qm_rps/dialog/gridblock.h"

#include <cstddef>
#include <string>
#include <vector>

/// Base of the grids of interaction points. The numbers stay in the record of the dialog, which
/// must outlive the grid.
class CNumberGrid : public zql::frx::MDialog {
public:
    virtual std::size_t Rows() const = 0;
    virtual std::size_t Columns() const = 0;
    virtual std::string RowHead(std::size_t row) const = 0;
    virtual std::string ColumnHead(std::size_t column) const = 0;

    /// Field of a cell as findings name it; empty: none.
    virtual std::string CellField(std::size_t, std::size_t) const { return {}; }

    /// Empty outside the grid.
    std::string CellText(std::size_t row, std::size_t column) const;

    /// 1 stored; 0 outside the grid, no finite number, or a value whose ratio has no scale.
    int SetCellText(std::size_t row, std::size_t column, const std::string& text);

    /// Pastes lines of tab-separated numbers, as a spreadsheet copies them (a last line end is no
    /// row). Into one selected cell the block must fit between it and the grid's end; into several,
    /// it must have their size. 0 shows the first of: IDS_CMD_PASTE_RANGE_MISMATCH (empty or ragged
    /// block, another size than the selection, or selection outside the grid),
    /// IDS_CMD_PASTE_EXCEED_COLUMN, IDS_CMD_PASTE_EXCEED_ROW, IDS_QM_PASTE_NOT_A_NUMBER; then
    /// nothing is pasted.
    int Paste(const std::string& text, const T_GRID_RANGE& range);

protected:
    /// The number behind a cell of the grid.
    virtual double* CellOf(std::size_t row, std::size_t column) const = 0;
    /// What the stored number is multiplied by for display.
    virtual double ScaleOf(std::size_t, std::size_t) const { return 1.0; }
    virtual std::string Format(double value) const = 0;

private:
    bool Read(const std::string& text, std::size_t row, std::size_t column, double& value) const;
};
