#include "qm_rps/pushoverpmminteractiongrid.h"

#include "qm_base/textformat.h"

int CPushoverPMMInteractionGrid::SelectCurve(std::size_t curve)
{
    if (curve >= kPmmCurveNames.size()) return 0;
    m_curve = curve;
    return 1;
}

std::string CPushoverPMMInteractionGrid::CellField(std::size_t row, std::size_t column) const
{
    return FormatText("%s[%zu][%zu].%c", IsOwnNegative() ? "negative" : "curves", m_curve / 2, row,
                      column == 0 ? 'p' : 'm');
}
