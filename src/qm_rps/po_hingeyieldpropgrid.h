// Grid of the interaction points of one axis of a yield level, both sides.
#pragma once

#include "qm_db/records.h"
#include "qm_rps/dialog/numbergrid.h"
#include "qm_rps/hinge/hingepartfindings.h"

/// Ten rows; columns P and M of (+), P and M of (-); as ratios or as values (ratio times Pmax or
/// the largest moment of that side), with 15 digits.
class CPO_HingeYieldPropGrid : public CNumberGrid {
public:
    /// The level is not owned. aboutY: the y axis, else the z axis.
    CPO_HingeYieldPropGrid(T_YIELD_LEVEL& level, bool aboutY) : m_level(level), m_aboutY(aboutY) {}

    /// IDS_RPS_Show_Value against IDS_RPS_Show_Ratio.
    bool m_showValue = false;

    std::size_t Rows() const override { return kPmPointNames.size(); }
    std::size_t Columns() const override { return 4; }
    std::string RowHead(std::size_t row) const override { return kPmPointNames.at(row); }
    std::string ColumnHead(std::size_t column) const override;
    /// In the level: "y.curves.pos[3].m".
    std::string CellField(std::size_t row, std::size_t column) const override;

protected:
    double* CellOf(std::size_t row, std::size_t column) const override;
    double ScaleOf(std::size_t row, std::size_t column) const override;
    std::string Format(double value) const override;

private:
    T_YIELD_AXIS& Axis() const { return m_aboutY ? m_level.y : m_level.z; }

    T_YIELD_LEVEL& m_level;
    bool m_aboutY;
};
