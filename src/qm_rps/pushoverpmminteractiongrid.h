// Grid of one user-defined P-M interaction curve.
#pragma once

#include "qm_rps/dialog/pmpointgrid.h"

inline constexpr std::array<const char*, 4> kPmmCurveNames{"Py-My(+)", "Py-My(-)", "Pz-Mz(+)",
                                                           "Pz-Mz(-)"};

/// Eleven rows, columns P/Pmax and M/Mmax, with 5 digits. Where (-) has no curves of its own, it
/// shows and edits those of (+). The table is not owned.
class CPushoverPMMInteractionGrid : public CPmPointGrid {
public:
    explicit CPushoverPMMInteractionGrid(T_PMM_TABLE& table)
        : CPmPointGrid({"P/Pmax", "M/Mmax"}, "%.5g"), m_table(table)
    {
    }

    /// Which of kPmmCurveNames is shown. 1 done; 0 no such curve, unchanged.
    [[nodiscard]] int SelectCurve(std::size_t curve);
    std::size_t Curve() const { return m_curve; }

    std::size_t Rows() const override { return m_table.curves[0].size(); }
    std::string RowHead(std::size_t row) const override { return std::to_string(row + 1); }
    /// In the table: "curves[0][3].m", "negative[1][3].p".
    std::string CellField(std::size_t row, std::size_t column) const override;

private:
    bool IsOwnNegative() const { return m_curve % 2 == 1 && m_table.negative; }
    T_PM_POINT& Point(std::size_t row) const override
    {
        return (IsOwnNegative() ? *m_table.negative : m_table.curves)[m_curve / 2][row];
    }

    T_PMM_TABLE& m_table;
    std::size_t m_curve = 0;
};
