// Members of the records of construction stages; see fieldwords.h.
#pragma once

#include "qm_db/records/loadfields.h"

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_STAG_LOAD> r)
{
    v.NeedRef("case", r.loadCase, KindOf<T_STLD_D>());
    v.StageStep("step", r.step, kStageFirstStep);
}

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_STAG_PART> r)
{
    v.OptElements("elements", r.elements);
    v.OptNodes("supports", r.supports);
    v.List("loads", r.loads);
}

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_STAG_D> r)
{
    v.Part("activate", r.activate);
    v.Part("deactivate", r.deactivate);
    v.Opt("steps", r.steps, 1);
    v.Check("steps", r.steps >= 1, "IDS_QM_CASE_STAGE_STEPS");
    v.Opt("duration", r.duration, 0.0);
    v.Check("duration", r.duration >= 0.0, kNotNegative);
}

/// What a row has follows from the list that it stands in.
template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_ULSI_ROW> r, bool unknown)
{
    if constexpr (V::kReads) r.unknown = unknown;
    v.NeedRef("stage", r.stage, KindOf<T_STAG_D>());
    v.StageStep("step", r.step, kStageFirstStep);
    v.NeedRef("case", r.loadCase, KindOf<T_STLD_D>());
    if (unknown) {
        v.Opt("weight", r.weight, 1.0);
        v.Opt("pretension", r.pretension, false);
    } else {
        v.Opt("factor", r.factor, 1.0);
    }
    LoadGroupField(v, r.loadGroup);
}

/// Rows of unknown factors stand before those of known ones (FitRecord sees to it).
template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_ULSI_D> r)
{
    v.Enum("objective", r.objective, kObjectiveNames, "IDS_QM_CHOICE_OBJECTIVE");
    v.EnumOpt("sign", r.sign, 1, kSignNames, "IDS_QM_CHOICE_SIGN");
    v.Opt("solve_by_equations", r.solveByEquations, false);
    v.Opt("sum_stage_loads", r.sumStageLoads, false);
    std::vector<T_ULSI_ROW> unknown, known;
    for (const T_ULSI_ROW& row : r.rows)
        (row.unknown ? unknown : known).push_back(row);
    v.List("unknown", unknown, true);
    v.List("known", known, false);
    if constexpr (V::kReads) {
        unknown.insert(unknown.end(), known.begin(), known.end());
        r.rows = std::move(unknown);
    }
    v.NameRefs("constraints", r.constraints, KindOf<T_ULFC_D>());
}
