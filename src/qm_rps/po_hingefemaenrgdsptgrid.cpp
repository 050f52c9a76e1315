#include "qm_rps/po_hingefemaenrgdsptgrid.h"

#include "qm_rps/hinge/backbonerules.h"

void CPO_HingeFEMAEnrgDsptGrid::Data2Dlg(const T_SIDES<T_SKEL_SIDE>& sides)
{
    m_factors = {sides.pos.energy, sides.neg.energy};
}

void CPO_HingeFEMAEnrgDsptGrid::Dlg2Data(T_SIDES<T_SKEL_SIDE>& sides) const
{
    sides.pos.energy = m_factors[0];
    sides.neg.energy = m_factors[1];
}

int CPO_HingeFEMAEnrgDsptGrid::CheckData()
{
    T_SIDES<T_SKEL_SIDE> sides;
    Dlg2Data(sides);
    std::vector<T_FINDING> found;
    CheckEnergyFactors({sides.pos, sides.neg}, {}, found);
    if (found.empty()) return 1;
    ShowMessage(found.front().messageKey, found.front().text);
    return 0;
}
