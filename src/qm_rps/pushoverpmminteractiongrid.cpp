#include "qm_rps/pushoverpmminteractiongrid.h"

int CPushoverPMMInteractionGrid::SelectCurve(std::size_t curve)
{
    if (curve >= kPmmCurveNames.size()) return 0;
    m_curve = curve;
    return 1;
}
