// Grid of the interaction points of one curve of an inelastic hinge property.
#pragma once

#include "qm_db/hingerecords.h"
#include "qm_rps/hingenumbergrid.h"

/// Ten rows, columns P/Pmax and M/MY,max, with 15 digits. The curve is not owned.
class CIehpYieldPropGrid2 : public CHingeNumberGrid {
public:
    explicit CIehpYieldPropGrid2(T_PM_CURVE& curve) : m_curve(curve) {}

    std::size_t Rows() const override { return m_curve.size(); }
    std::size_t Columns() const override { return 2; }
    std::string RowHead(std::size_t row) const override;
    std::string ColumnHead(std::size_t column) const override;

protected:
    double* CellOf(std::size_t row, std::size_t column) const override;
    std::string Format(double value) const override;

private:
    T_PM_CURVE& m_curve;
};
