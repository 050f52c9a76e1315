#include "qm_rps/push/pushquantity.h"

#include "qm_base/say.h"
#include "qm_db/recordfacts.h"

std::string T_PUSH_QUANTITY::Unit() const
{
    const std::string length(NameOf(units.length)), force(NameOf(units.force));
    if (dim == kDimMoment) return force + " " + length;
    if (dim == kDimForce) return force;
    return dim == kDimLength ? length : "rad";
}

std::string T_PUSH_QUANTITY::Head(const char* key) const
{
    return Say(key) + " (" + Unit() + ")";
}

T_PUSH_QUANTITY DisplacementIn(std::size_t direction, const T_UNITS& units)
{
    return {DisplacementDim(static_cast<int>(direction) + 1), units};
}

T_PUSH_QUANTITY ReactionIn(std::size_t direction, const T_UNITS& units)
{
    return {ReactionDim(static_cast<int>(direction) + 1), units};
}

T_PUSH_QUANTITY DeformationOf(HINGE_COMPONENT component, const T_UNITS& units)
{
    return {component < HINGE_COMPONENT::Mx ? kDimLength : kDimNone, units};
}

T_PUSH_QUANTITY ForceOf(HINGE_COMPONENT component, const T_UNITS& units)
{
    return {component < HINGE_COMPONENT::Mx ? kDimForce : kDimMoment, units};
}
