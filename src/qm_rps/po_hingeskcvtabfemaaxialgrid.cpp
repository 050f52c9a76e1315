#include "qm_rps/po_hingeskcvtabfemaaxialgrid.h"

int CPO_HingeSkcvTabFemaAxialGrid::OnRemove()
{
    if (m_selected < 0 || m_selected >= static_cast<int>(Rows().size())) return 0;
    return RemoveForce(Rows()[static_cast<std::size_t>(m_selected)].axial);
}

int CPO_HingeSkcvTabFemaAxialGrid::Done(const CAxialForceList::REFUSAL& refusal)
{
    if (refusal) ShowMessage(refusal->key, refusal->text);
    return refusal ? 0 : 1;
}
