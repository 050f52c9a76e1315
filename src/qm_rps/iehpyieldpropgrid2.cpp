#include "qm_rps/iehpyieldpropgrid2.h"

#include "qm_rps/po_hingeyieldpropgrid.h"

std::string CIehpYieldPropGrid2::RowHead(std::size_t row) const
{
    return kPmPointNames.at(row);
}
