#include "qm_rps/po_hingeyieldpropgrid.h"

#include "qm_base/textformat.h"

std::string CPO_HingeYieldPropGrid::ColumnHead(std::size_t column) const
{
    const char* side = column < 2 ? "(+)" : "(-)";
    const char axis = m_aboutY ? 'y' : 'z';
    if (column % 2 == 0) return m_showValue ? "P" : "P/Pmax";
    return m_showValue ? FormatText("M%c%s", axis, side) : FormatText("M/MY%c,max%s", axis, side);
}

std::string CPO_HingeYieldPropGrid::CellField(std::size_t row, std::size_t column) const
{
    return FormatText("%c.curves.%s[%zu].%c", m_aboutY ? 'y' : 'z', column < 2 ? "pos" : "neg", row,
                      column % 2 == 0 ? 'p' : 'm');
}

double* CPO_HingeYieldPropGrid::CellOf(std::size_t row, std::size_t column) const
{
    T_PM_POINT& point = (column < 2 ? Axis().curves.pos : Axis().curves.neg)[row];
    return column % 2 == 0 ? &point.p : &point.m;
}

double CPO_HingeYieldPropGrid::ScaleOf(std::size_t, std::size_t column) const
{
    if (!m_showValue) return 1.0;
    if (column % 2 == 0) return m_level.compression;
    return column < 2 ? Axis().momentMax.pos : Axis().momentMax.neg;
}

std::string CPO_HingeYieldPropGrid::Format(double value) const
{
    return FormatText("%.15g", value);
}
