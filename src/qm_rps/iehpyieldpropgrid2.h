// Grid of the interaction points of one curve of an inelastic hinge property.
#pragma once

#include "qm_rps/dialog/pmpointgrid.h"

/// Ten rows, columns P/Pmax and M/MY,max, with 15 digits. The curve is not owned.
class CIehpYieldPropGrid2 : public CPmPointGrid {
public:
    explicit CIehpYieldPropGrid2(T_PM_CURVE& curve)
        : CPmPointGrid({"P/Pmax", "M/MY,max"}, "%.15g"), m_curve(curve)
    {
    }

    std::size_t Rows() const override { return m_curve.size(); }
    std::string RowHead(std::size_t row) const override;

private:
    T_PM_POINT& Point(std::size_t row) const override { return m_curve[row]; }

    T_PM_CURVE& m_curve;
};
