#include "qm_rps/hinge/hingemirror.h"

#include "qm_rps/hinge/backbonerules.h"

#include <type_traits>

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

/// A member of a side that symmetry fixes.
template <class SIDE>
struct T_MIRROR_FIELD {
    const char* name;
    double (*value)(const SIDE&);
};
using S = T_SKEL_SIDE;
using M = T_SKEL_MULTI_SIDE;
constexpr T_MIRROR_FIELD<S> kBackboneFields[] = {
    {"yield", [](const S& s) { return s.yield; }},
    {"yieldDeform", [](const S& s) { return s.yieldDeform; }},
    {"B.deform", [](const S& s) { return s.B.deform; }},
    {"B.strength", [](const S& s) { return s.B.strength; }},
    {"C.deform", [](const S& s) { return s.C.deform; }},
    {"C.strength", [](const S& s) { return s.C.strength; }},
    {"D.deform", [](const S& s) { return s.D.deform; }},
    {"D.strength", [](const S& s) { return s.D.strength; }},
    {"E.deform", [](const S& s) { return s.E.deform; }},
    {"E.strength", [](const S& s) { return s.E.strength; }},
    {"IO", [](const S& s) { return s.IO; }},
    {"LS", [](const S& s) { return s.LS; }},
    {"CP", [](const S& s) { return s.CP; }},
};
constexpr T_MIRROR_FIELD<M> kMultiFields[] = {
    {"P1", [](const M& s) { return s.P1; }},
    {"P2", [](const M& s) { return s.P2; }},
    {"P3", [](const M& s) { return s.P3; }},
    {"D1", [](const M& s) { return s.D1; }},
    {"D2", [](const M& s) { return s.D2; }},
    {"D3", [](const M& s) { return s.D3; }},
    {"alpha1", [](const M& s) { return s.alpha1; }},
    {"alpha2", [](const M& s) { return s.alpha2; }},
    {"userStiffness", [](const M& s) { return s.userStiffness; }},
};

/// Compares the stored negative side with what symmetry makes of the positive one.
template <class SIDE, std::size_t N>
void Compare(const T_MIRROR_FIELD<SIDE> (&fields)[N], const SIDE& stored, const SIDE& mirrored,
             const T_HINGE_PLACE& place, std::vector<T_FINDING>& out)
{
    bool leftOut = true;
    for (const T_MIRROR_FIELD<SIDE>& f : fields)
        leftOut = leftOut && f.value(stored) == 0.0;
    if (leftOut) return;
    for (const T_MIRROR_FIELD<SIDE>& f : fields) {
        if (f.value(stored) == f.value(mirrored)) continue;
        const std::string field = std::string("sides.neg.") + f.name;
        out.push_back(FindingOf(T_HINGE_HEAD{.message = "IDS_QM_HINGE_NOT_SYMMETRIC",
                                             .text = field.c_str(),
                                             .field = field.c_str()},
                                place));
    }
}

/// The sides of a curve by itself, then those of its axial forces.
template <class CURVE>
void CompareCurve(const CURVE& curve, const T_HINGE_PLACE& place, std::vector<T_FINDING>& out)
{
    if (!curve.symmetric) return;
    CURVE mirrored = curve;
    Mirror(mirrored);
    if constexpr (std::is_same_v<CURVE, T_SKEL_MULTI>) {
        Compare(kMultiFields, curve.sides.neg, mirrored.sides.neg, place, out);
    } else {
        Compare(kBackboneFields, curve.sides.neg, mirrored.sides.neg, place, out);
    }
    if constexpr (std::is_same_v<CURVE, T_SKEL_FEMA>) {
        T_HINGE_PLACE at = place;
        for (std::size_t i = 0; i < curve.curves.size(); ++i) {
            at.curve = static_cast<int>(i);
            Compare(kBackboneFields, curve.curves[i].sides.neg, mirrored.curves[i].sides.neg, at,
                    out);
        }
    }
}

} // namespace

void MirrorFindings(const T_SKEL_CURVE& curve, const T_HINGE_PLACE& place,
                    std::vector<T_FINDING>& out)
{
    std::visit([&](const auto& c) { CompareCurve(c, place, out); }, curve);
}

T_HINGE_COMPONENT MirroredComponent(T_HINGE_COMPONENT component)
{
    std::visit([](auto& curve) { Mirror(curve); }, component.curves.I);
    std::visit([](auto& curve) { Mirror(curve); }, component.curves.J);
    if (component.sameEnds) component.curves.J = component.curves.I;
    return component;
}
