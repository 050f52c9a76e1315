#include "qm_rps/iehpyieldpropgrid2.h"

#include "qm_base/textformat.h"
#include "qm_rps/po_hingeyieldpropgrid.h"

std::string CIehpYieldPropGrid2::RowHead(std::size_t row) const
{
    return kPmPointNames.at(row);
}

std::string CIehpYieldPropGrid2::ColumnHead(std::size_t column) const
{
    return column == 0 ? "P/Pmax" : "M/MY,max";
}

double* CIehpYieldPropGrid2::CellOf(std::size_t row, std::size_t column) const
{
    return column == 0 ? &m_curve[row].p : &m_curve[row].m;
}

std::string CIehpYieldPropGrid2::Format(double value) const
{
    return FormatText("%.15g", value);
}
