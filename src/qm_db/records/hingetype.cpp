#include "qm_db/records/hingetype.h"

namespace {

bool IsComponent(int component)
{
    return component >= 0 && component < 6;
}

} // namespace

T_SKEL_CURVE MakeSkelCurve(SKEL_TYPE type)
{
    if (type == SKEL_TYPE::Fema) return T_SKEL_FEMA{};
    if (type == SKEL_TYPE::Ec8) return T_SKEL_EC8{};
    return T_SKEL_MULTI{};
}

bool FitsType(const T_SKEL_CURVE& curve, SKEL_TYPE type)
{
    if (type == SKEL_TYPE::Fema) return std::holds_alternative<T_SKEL_FEMA>(curve);
    if (type == SKEL_TYPE::Ec8) return std::holds_alternative<T_SKEL_EC8>(curve);
    return std::holds_alternative<T_SKEL_MULTI>(curve);
}

void FitCurves(T_PHGT_D& type)
{
    for (T_HINGE_COMPONENT& c : type.components) {
        if (!FitsType(c.curves.I, c.type)) c.curves.I = MakeSkelCurve(c.type);
        if (FitsType(c.curves.J, c.type)) continue;
        c.curves.J = c.sameEnds ? c.curves.I : MakeSkelCurve(c.type);
    }
}

int ConvertIehpToPhgtFema(const T_IEHP_D& in, int component, T_PHGT_D& out)
{
    if (!IsComponent(component)) return 0;
    const auto index = static_cast<std::size_t>(component);
    T_PHGT_D type;
    type.name = in.name;
    T_HINGE_COMPONENT& c = type.components[index];
    c.active = in.components[index].has_value(); // so that one that is not there stays so
    c.type = SKEL_TYPE::Fema;
    c.curves.I = c.curves.J = in.components[index].value_or(T_SKEL_FEMA{});
    out = std::move(type);
    return 1;
}

int ConvertPhgtToIehpFema(const T_PHGT_D& in, int component, T_IEHP_D& out)
{
    if (!IsComponent(component)) return 0;
    const auto index = static_cast<std::size_t>(component);
    const auto* curve = std::get_if<T_SKEL_FEMA>(&in.components[index].curves.I);
    if (!curve) return 0;
    out.name = in.name;
    if (in.components[index].active)
        out.components[index] = *curve;
    else
        out.components[index].reset();
    return 1;
}
