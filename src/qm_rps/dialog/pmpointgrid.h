// Grid of the points of one interaction curve: a row per point, columns P and M.
#pragma once

#include "qm_db/records.h"
#include "qm_rps/dialog/numbergrid.h"

/// Base of the grids that show one curve. heads: of the two columns; format: of a number.
class CPmPointGrid : public CNumberGrid {
public:
    std::size_t Columns() const override { return 2; }
    std::string ColumnHead(std::size_t column) const override { return m_heads.at(column); }

protected:
    CPmPointGrid(std::array<const char*, 2> heads, const char* format)
        : m_heads(heads), m_format(format)
    {
    }
    virtual T_PM_POINT& Point(std::size_t row) const = 0;
    double* CellOf(std::size_t row, std::size_t column) const override;
    std::string Format(double value) const override;

private:
    std::array<const char*, 2> m_heads;
    const char* m_format;
};
