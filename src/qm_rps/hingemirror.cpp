#include "qm_rps/hingemirror.h"

#include "qm_rps/hingesiderules.h"

namespace {

void Mirror(T_SKEL_MULTI& m)
{
    if (!m.symmetric) return;
    const double gap = m.sides.neg.gap;
    m.sides.neg = m.sides.pos;
    m.sides.neg.gap = gap;
}

void Mirror(T_SKEL_FEMA& f)
{
    if (!f.symmetric) return;
    MirrorSide(f.sides.pos, f.sides.neg);
    for (T_SKEL_AXIAL& c : f.curves)
        MirrorSide(c.sides.pos, c.sides.neg);
}

void Mirror(T_SKEL_EC8& e)
{
    if (e.symmetric) MirrorSide(e.sides.pos, e.sides.neg);
}

} // namespace

T_HINGE_COMPONENT MirroredComponent(T_HINGE_COMPONENT component)
{
    std::visit([](auto& curve) { Mirror(curve); }, component.curves.I);
    std::visit([](auto& curve) { Mirror(curve); }, component.curves.J);
    if (component.sameEnds) component.curves.J = component.curves.I;
    return component;
}
