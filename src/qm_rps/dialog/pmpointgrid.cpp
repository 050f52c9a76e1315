#include "qm_rps/dialog/pmpointgrid.h"

#include "qm_base/textformat.h"

double* CPmPointGrid::CellOf(std::size_t row, std::size_t column) const
{
    T_PM_POINT& point = Point(row);
    return column == 0 ? &point.p : &point.m;
}

std::string CPmPointGrid::Format(double value) const
{
    return FormatText(m_format, value);
}
