// Members of the records of the structure: each is listed once, with its key in the case file and
// its dimension, for reading (CCaseGet), writing (CCasePut) and for the list of quantities
// (CCaseQuantities). Names of records stand outside. loadfields.h and hingefields.h go on.
//
// Need: a member that must be there. Opt: left out when it has the given default; OptOr: with an
// older key that is still read. Enum, EnumOpt: a name out of a list. Code: the same, other numbers
// stay numbers. Part: a nested record, left out when it has nothing to say. NeedFixed, OptFixed:
// exactly so many numbers, each with its dimension. Flags: the names of the flags that are set.
// NeedRef, OptRef: another record, by name in a case file and by key in the model file. Node,
// Element: ids that must be there. Check: a rule of the case file for a member. PartIf, List,
// Padded, Pairs, Texts: as their types say.
#pragma once

#include "qm_db/records.h"
#include "qm_db/records/casenames.h"
#include "qm_db/records/hingenames.h"
#include "qm_db/records/structnames.h"

/// T& for a visitor that reads or converts, const T& for one that writes.
template <class V, class T>
using T_FIELD_REF = typename V::template Ref<T>;

inline constexpr T_DIM kDimArea{0, 2};
inline constexpr T_DIM kDimModulus{0, 3};
inline constexpr T_DIM kDimInertia{0, 4};
inline constexpr T_DIM kDimDensity{1, -4}; // mass per volume: force * s2 / length^4
inline constexpr T_DIM kDimSpring{1, -1};
inline constexpr T_DIM kDimLineLoad{1, -1};

using T_DIMS3 = std::array<T_DIM, 3>;
using T_DIMS6 = std::array<T_DIM, 6>; // of X, Y, Z, RX, RY, RZ
inline constexpr T_DIMS3 kRatios3{};
inline constexpr T_DIMS3 kLengths3{kDimLength, kDimLength, kDimLength};
inline constexpr T_DIMS6 kDofLengths{kDimLength, kDimLength, kDimLength};
inline constexpr T_DIMS6 kDofForces{kDimForce,  kDimForce,  kDimForce,
                                    kDimMoment, kDimMoment, kDimMoment};
inline constexpr T_DIMS6 kDofSprings{kDimSpring, kDimSpring, kDimSpring,
                                     kDimMoment, kDimMoment, kDimMoment};

// ---- materials and sections ---------------------------------------------------------------------

inline constexpr const char* kNotNegative = "the value can't be negative";

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_MATL_D> r)
{
    v.EnumOpt("type", r.type, MATL_CLASS::Steel, kMatlNames, "material type");
    v.Opt("E", r.E, 0.0, kDimStress);
    v.Check("E", r.E >= 0.0, kNotNegative);
    v.Opt("nu", r.nu, 0.0);
    v.OptIf("G", r.G, kDimStress);
    v.Check("G", r.G.value_or(1.0) > 0.0, "a shear modulus must be above 0");
    v.Opt("density", r.density, 0.0, kDimDensity);
    v.Check("density", r.density >= 0.0, kNotNegative);
    v.Opt("alpha", r.alpha, 0.0);
    v.OptOr("fy", "Fy", r.Fy, 0.0, kDimStress);
    v.Opt("fck", r.fck, 0.0, kDimStress);
    v.Opt("fyk", r.fyk, 0.0, kDimStress);
    v.Opt("Es", r.Es, 0.0, kDimStress);
}

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_REBAR> r)
{
    v.Need("y", r.y, kDimLength);
    v.Need("z", r.z, kDimLength);
    v.Need("area", r.area, kDimArea);
}

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_SECT_FACTORS> r)
{
    v.Opt("area", r.area, 1.0);
    v.Opt("Asy", r.Asy, 1.0);
    v.Opt("Asz", r.Asz, 1.0);
    v.Opt("J", r.J, 1.0);
    v.Opt("Iyy", r.Iyy, 1.0);
    v.Opt("Izz", r.Izz, 1.0);
}

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_SECT_D> r)
{
    v.EnumOpt("shape", r.shape, SECT_SHAPE::Value, kShapeNames, "shape");
    v.Padded("size", r.size, kDimLength);
    const auto property = [&](const char* key, const char* old, auto& value, T_DIM dim) {
        const char* const used = v.OptOr(key, old, value, 0.0, dim);
        v.Check(used, value >= 0.0, kNotNegative);
    };
    property("A", "area", r.area, kDimArea);
    property("Asy", nullptr, r.Asy, kDimArea);
    property("Asz", nullptr, r.Asz, kDimArea);
    property("J", nullptr, r.J, kDimInertia);
    property("Iy", "Iyy", r.Iyy, kDimInertia);
    property("Iz", "Izz", r.Izz, kDimInertia);
    property("Zy", nullptr, r.Zy, kDimModulus);
    property("Zz", nullptr, r.Zz, kDimModulus);
    v.Part("factors_I", r.factorsI);
    v.Part("factors_J", r.factorsJ);
    v.List("bars", r.bars);
}

// ---- elements and constraints -------------------------------------------------------------------

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_ENDS<T_DIRS6>> r)
{
    v.Flags("I", r.I, kReleaseNames, "release");
    v.Flags("J", r.J, kReleaseNames, "release");
}

using T_END_OFFSETS = T_ENDS<std::array<double, 3>>;

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_END_OFFSETS> r)
{
    v.OptFixed("I", r.I, {}, kLengths3);
    v.OptFixed("J", r.J, {}, kLengths3);
}

/// What an element has follows from its kind; other keys are unknown ones.
template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_ELEM_D> r)
{
    v.Need("id", r.id);
    v.EnumOpt("kind", r.kind, ELEM_KIND::Beam, kElemKindNames, "kind");
    std::vector<int> nodes{r.nodeI};
    if (r.kind != ELEM_KIND::Spring) nodes.push_back(r.nodeJ);
    v.NodeList("nodes", nodes);
    v.Rule("nodes", nodes.size() == (r.kind == ELEM_KIND::Spring ? 1U : 2U),
           r.kind == ELEM_KIND::Spring ? "a spring has one node" : "an element has two nodes");
    if constexpr (V::kReads) {
        r.nodeI = nodes.empty() ? 0 : nodes.front();
        r.nodeJ = nodes.size() < 2 ? 0 : nodes[1];
    }
    if (r.kind == ELEM_KIND::Link || r.kind == ELEM_KIND::Spring) {
        v.NeedFixed("stiffness", r.stiffness, kDofSprings);
        v.CheckEach(
            "stiffness", r.stiffness, [](double k) { return k >= 0.0; }, kNotNegative);
    } else {
        v.OptRef("material", r.material, CASE_REF::Material);
        v.OptRef("section", r.section, CASE_REF::Section);
        v.OptFixed("z_axis", r.zAxis, {}, kRatios3);
    }
    if (r.kind == ELEM_KIND::Beam) {
        v.Part("release", r.release);
        v.Part("offset", r.offset);
    }
    v.Opt("member", r.member, 0);
}

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_DIAP_D> r)
{
    v.NodeList("nodes", r.nodes);
    v.Rule("nodes", r.nodes.size() > 1, "at least two nodes are needed");
    v.Enum("normal", r.normal, kAxisNames, "axis");
}

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_EQDS_D> r)
{
    v.NodeList("nodes", r.nodes);
    v.Rule("nodes", r.nodes.size() > 1, "at least two nodes are needed");
    v.Flags("directions", r.directions, kDirectionNames, "direction");
    v.Rule("directions", r.directions != T_DIRS6{}, "at least one direction is needed");
}
