#include "qm_rps/po_hingeintegrationpointdlg.h"

#include <algorithm>

int CPO_HingeIntegrationPointDlg::Selected() const
{
    const auto at = std::find(kChoices.begin(), kChoices.end(), m_points);
    return at == kChoices.end() ? -1 : static_cast<int>(at - kChoices.begin());
}

int CPO_HingeIntegrationPointDlg::OnSelect(int index)
{
    if (index < 0 || index >= static_cast<int>(kChoices.size())) return 0;
    m_points = kChoices[static_cast<std::size_t>(index)];
    return 1;
}
