#include "qm_rps/pushoverpmminteractiongrid.h"

#include "qm_base/textformat.h"

int CPushoverPMMInteractionGrid::SelectCurve(std::size_t curve)
{
    if (curve >= kPmmCurveNames.size()) return 0;
    m_curve = curve;
    return 1;
}

std::string CPushoverPMMInteractionGrid::RowHead(std::size_t row) const
{
    return std::to_string(row + 1);
}

std::string CPushoverPMMInteractionGrid::ColumnHead(std::size_t column) const
{
    return column == 0 ? "P/Pmax" : "M/Mmax";
}

double* CPushoverPMMInteractionGrid::CellOf(std::size_t row, std::size_t column) const
{
    T_PM_POINT& point = m_table.curves[m_curve / 2][row];
    return column == 0 ? &point.p : &point.m;
}

std::string CPushoverPMMInteractionGrid::Format(double value) const
{
    return FormatText("%.5g", value);
}
