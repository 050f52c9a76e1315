// Members of the records of load cases, combinations and unknown load factors; see fieldwords.h.
#pragma once

#include "qm_db/records/structfields.h"

#include <span>

// ---- static load cases --------------------------------------------------------------------------

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_NODAL_LOAD> r)
{
    v.Node("node", r.node);
    v.NeedFixed("load", r.load, kDofForces);
}

inline constexpr std::array<T_DIM, 3> kBeamLoadDims{kDimLineLoad, kDimForce, kDimMoment};

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_BEAM_LOAD> r)
{
    if constexpr (V::kReads) v.Must("type"); // before what depends on it
    v.Element("element", r.element);
    v.EnumOpt("axes", r.axes, BEAM_LOAD_AXES::Local, kLoadAxesNames, "IDS_QM_CHOICE_AXES");
    v.Enum("direction", r.direction, kLoadDirectionNames, "IDS_QM_CHOICE_DIRECTION");
    v.Enum("type", r.type, kBeamLoadNames, "IDS_QM_CHOICE_BEAM_LOAD");
    constexpr const char* range = "IDS_QM_CASE_POSITION";
    const auto inside = [](double at) { return at >= 0.0 && at <= 1.0; };
    const T_DIM dim = kBeamLoadDims[static_cast<std::size_t>(r.type)];
    if (r.type != BEAM_LOAD_TYPE::Distributed) {
        v.Need("value", r.w[0], dim);
        v.Need("at", r.at[0]);
        return v.Check("at", inside(r.at[0]), range);
    }
    v.NeedFixed("w", r.w, {dim, dim});
    v.OptFixed("at", r.at, {0.0, 1.0}, {});
    v.CheckEach("at", r.at, inside, range);
    v.Check("at", r.at[0] < r.at[1], "IDS_QM_CASE_POSITIONS");
}

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_SETTLEMENT> r)
{
    v.Node("node", r.node);
    v.NeedFixed("displacement", r.displacement, kDofLengths);
}

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_TEMPERATURE_LOAD> r)
{
    v.Element("element", r.element);
    v.Need("change", r.change);
}

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_PTNS_D> r)
{
    v.Element("element", r.element);
    v.Need("force", r.force, kDimForce);
}

/// V::Ref<int>: int& or const int&.
template <class V>
void LoadGroupField(V& v, T_FIELD_REF<V, int> group)
{
    v.Opt("load_group", group, kLoadGroupRest);
    v.Check("load_group", group >= kLoadGroupDead && group <= kLoadGroupRest,
            "IDS_QM_CASE_LOAD_GROUP");
}

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_STLD_D> r)
{
    v.OptFixed("self_weight", r.selfWeight, {}, kRatios3);
    v.List("nodal", r.nodal);
    v.List("beam", r.beam);
    v.List("settlement", r.settlement);
    v.List("temperature", r.temperature);
    v.List("pretension", r.pretension);
    LoadGroupField(v, r.group);
}

// ---- combinations -------------------------------------------------------------------------------

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_LCOM_ITEM> r)
{
    if constexpr (V::kReads) r.combination = v.Has("combination");
    if (r.combination)
        v.NeedRef("combination", r.key, KindOf<T_LCOM_D>());
    else
        v.NeedRef("case", r.key, KindOf<T_STLD_D>());
    v.Need("factor", r.factor);
}

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_LCOM_D> r)
{
    v.List("items", r.items);
}

// ---- unknown load factors -----------------------------------------------------------------------

/// Names of the components of a kind of constraint.
inline std::span<const char* const> ComponentNames(ULFC_TYPE type)
{
    switch (type) {
    case ULFC_TYPE::Reaction:
        return kReactionNames;
    case ULFC_TYPE::Displacement:
        return kDirectionNames;
    case ULFC_TYPE::Truss:
        return std::span(kBeamForceNames).first(1);
    default:
        return kBeamForceNames;
    }
}

/// Dimension of the constrained quantity. Components 0 to 2 are displacements or forces.
inline T_DIM UlfcDim(ULFC_TYPE type, int component)
{
    if (type == ULFC_TYPE::Displacement) return component < 3 ? kDimLength : kDimNone;
    return component < 3 ? kDimForce : kDimMoment;
}

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_ULFC_D> r)
{
    if constexpr (V::kReads) v.Must("type"); // before what depends on it
    v.Enum("type", r.type, kUlfcTypeNames, "IDS_QM_CHOICE_CONSTRAINT");
    v.Need("id", r.id);
    if (r.type == ULFC_TYPE::Truss)
        v.EnumOpt("component", r.component, 0, ComponentNames(r.type), "IDS_QM_CHOICE_COMPONENT");
    else
        v.Enum("component", r.component, ComponentNames(r.type), "IDS_QM_CHOICE_COMPONENT");
    if (r.type == ULFC_TYPE::Beam)
        v.Enum("position", r.position, kPositionNames, "IDS_QM_CHOICE_POSITION");

    if constexpr (V::kReads) {
        const bool equal = v.Has("equal"), same = v.Has("same_as");
        r.inequality = v.Has("upper") | v.Has("lower");
        r.compareWithValue = !same;
        v.Rule(nullptr, int{equal} + int{same} + int{r.inequality} == 1,
               "IDS_QM_CASE_CONSTRAINT_EITHER");
    }
    if constexpr (V::kWrites) {
        if (r.inequality && !r.upper && !r.lower) return v.Fail("IDS_QM_CASE_CONSTRAINT_NO_BOUND");
    }
    v.OptRef("stage", r.stage, KindOf<T_STAG_D>());
    v.StageStep("step", r.step, kStageLastStep);
    v.Check("step", r.stage != 0, "IDS_QM_CASE_STEP_STAGE");
    const T_DIM dim = UlfcDim(r.type, r.component);
    if (r.inequality) {
        v.OptIf("upper", r.upper, dim);
        v.OptIf("lower", r.lower, dim);
    } else if (r.compareWithValue) {
        v.Need("equal", r.value, dim);
    } else {
        v.Need("same_as", r.otherId);
    }
}

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_ULFI_UNKNOWN> r)
{
    v.NeedRef("case", r.loadCase, KindOf<T_STLD_D>());
    v.Opt("weight", r.weight, 1.0);
}

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_ULFI_D> r)
{
    v.NeedRef("combination", r.combination, KindOf<T_LCOM_D>());
    v.Enum("objective", r.objective, kObjectiveNames, "IDS_QM_CHOICE_OBJECTIVE");
    v.EnumOpt("sign", r.sign, 1, kSignNames, "IDS_QM_CHOICE_SIGN");
    v.Opt("solve_by_equations", r.solveByEquations, false);
    v.List("unknown", r.unknowns);
    v.NameRefs("constraints", r.constraints, KindOf<T_ULFC_D>());
}
