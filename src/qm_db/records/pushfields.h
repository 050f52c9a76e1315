// Members of the records of pushover load cases, spectra and evaluations; see fieldwords.h.
#pragma once

#include "qm_db/records/evaluationrules.h"
#include "qm_db/records/structfields.h"

#include <utility>

// ---- global control and pushover load cases -----------------------------------------------------

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_PUSH_INITIAL_LOAD> r)
{
    v.NeedRef("case", r.loadCase, KindOf<T_STLD_D>());
    v.Opt("factor", r.factor, 1.0);
}

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_POGC_D> r)
{
    static const T_POGC_D d;
    v.List("initial_loads", r.initialLoads);
    v.EnumOpt("p_delta", r.pDelta, d.pDelta, kPDeltaNames, "IDS_QM_CHOICE_P_DELTA");
    v.Opt("steps", r.steps, d.steps);
    v.EnumOpt("on_failure", r.onFailure, d.onFailure, kPushFailureNames, "IDS_QM_CHOICE_FAILURE");
    v.EnumOpt("flow", r.flow, d.flow, kPushFlowNames, "IDS_QM_CHOICE_FLOW");
    v.Refs("hinge_types", r.hingeTypes, KindOf<T_PHGT_D>());
    v.Opt("most_events", r.mostEvents, d.mostEvents);
    v.Opt("most_steps", r.mostSteps, d.mostSteps);
}

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_PUSH_STOPS_D> r)
{
    v.OptIf("drift", r.drift);
    v.EnumIf("state", r.state, kStateStopNames, "IDS_QM_CHOICE_STATE");
    v.OptIf("fraction_of_peak", r.fractionOfPeak);
}

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_POLC_PATTERN> r)
{
    v.Enum("kind", r.kind, kPatternNames, "IDS_QM_CHOICE_PATTERN");
    if (r.kind == 0)
        v.FreeKeyRef("number", r.number, KindOf<T_STLD_D>());
    else
        v.Need("number", r.number);
    v.Opt("factor", r.factor, 1.0);
}

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_POLC_CONTROL> r, const T_DIM& displacement)
{
    static const T_POLC_CONTROL d;
    v.Code("increment_method", r.incrementMethod, kIncrementNames, "IDS_QM_CHOICE_INCREMENT");
    v.Opt("increment_option", r.incrementOption, d.incrementOption);
    v.Opt("increment_function", r.incrementFunction, d.incrementFunction);
    v.Opt("stiffness_ratio_limit", r.stiffnessRatioLimit, d.stiffnessRatioLimit);
    v.Opt("generate_static_angle", r.generateStaticAngle, d.generateStaticAngle);
    v.Opt("static_angle", r.staticAngle, d.staticAngle);
    v.Opt("master_node_control", r.masterNodeControl, d.masterNodeControl);
    v.Opt("master_max_displ", r.masterMaxDispl, d.masterMaxDispl, displacement);
    v.Opt("max_trans_displ", r.maxTransDispl, d.maxTransDispl, displacement);
}

/// A case file has them in "steps" where no results of another solver stand there.
inline constexpr const char* kIncrementsKey = "increments";

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_POLC_D> r)
{
    v.Need("control_node", r.controlNode);
    v.template Enum<1>("direction", r.direction, kDirectionNames, "IDS_QM_CHOICE_DIRECTION");
    v.Group("pattern", [&](auto& pattern) {
        pattern.Enum("kind", r.patternKind, kPatternNames, "IDS_QM_CHOICE_PATTERN");
        pattern.Opt("modes", r.modes, {});
    });
    v.List("patterns", r.patterns);
    const T_DIM displacement = DisplacementDim(r.direction); // read before
    v.PartIf("control", r.control, displacement);
    v.Opt("control_option", r.controlOption, 1);
    v.ListIf("initial_loads", r.initialLoads);
    v.OptNameRef("initial_case", r.initialCase, KindOf<T_POLC_D>());
    v.EnumIf("p_delta", r.pDelta, kPDeltaNames, "IDS_QM_CHOICE_P_DELTA");
    v.OptIf(kIncrementsKey, r.steps);
    v.EnumIf("on_failure", r.onFailure, kPushFailureNames, "IDS_QM_CHOICE_FAILURE");
    v.Part("stops", r.stops);
    v.Opt("eccentricity", r.eccentricity, 0.0);
    v.Opt("additional_displacements", r.additionalDisplacements, {}, displacement);
    v.Opt("additional_evaluations", r.additionalEvaluations, false);
}

/// They stand in the load case that they belong to.
template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_POVR_D> r)
{
    const auto isStep = [](int step) { return step >= -2; };
    v.OptIf("EC8", r.ec8);
    if (r.ec8) v.CheckEach("EC8", *r.ec8, isStep, "IDS_QM_CASE_LIMIT_STEP");
    v.OptIf("NTC", r.ntc);
    if (r.ntc) v.CheckEach("NTC", *r.ntc, isStep, "IDS_QM_CASE_LIMIT_STEP");
}

// ---- spectra ------------------------------------------------------------------------------------

template <class V>
void CheckAbove(V& v, const char* key, double value)
{
    v.Check(key, value > 0.0, "IDS_QM_CASE_ABOVE_0");
}

template <class V>
void DampingField(V& v, T_FIELD_REF<V, std::optional<double>> damping)
{
    v.OptIf("damping", damping);
    v.Check("damping", damping.value_or(0.0) >= 0.0, "IDS_QM_CASE_DAMPING");
}

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_SPFC_ATC40> r)
{
    v.Need("Ca", r.Ca);
    CheckAbove(v, "Ca", r.Ca);
    v.Need("Cv", r.Cv);
    CheckAbove(v, "Cv", r.Cv);
    v.OptIf("floors", r.floors);
}

/// Corner periods that are given ascend; the others come from the table of the code.
inline bool AreOrdered(const std::optional<double>& a, const std::optional<double>& b)
{
    return !a || !b || *a <= *b;
}

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_SPFC_EURO2003> r)
{
    v.Need("type", r.type);
    v.Check("type", r.type == 1 || r.type == 2, "IDS_QM_CASE_SPECTRUM_TYPE");
    v.Letter("soil", r.soil, std::span(kSoils), "IDS_QM_CHOICE_SOIL");
    v.Need("ag", r.ag);
    CheckAbove(v, "ag", r.ag);
    DampingField(v, r.damping);
    const auto override = [&](const char* key, auto& value) {
        v.OptIf(key, value);
        CheckAbove(v, key, value.value_or(1.0));
    };
    override("S", r.S);
    override("TB", r.TB);
    override("TC", r.TC);
    override("TD", r.TD);
    v.Check("TC", AreOrdered(r.TB, r.TC), "IDS_QM_CASE_TC_BELOW_TB");
    v.Check("TD", AreOrdered(r.TB, r.TD), "IDS_QM_CASE_TD_BELOW_TB");
    v.Check("TD", AreOrdered(r.TC, r.TD), "IDS_QM_CASE_TD_BELOW_TC");
}

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_SPFC_EURO1996> r)
{
    v.Letter("soil", r.soil, std::span(kSoils).first(3), "IDS_QM_CHOICE_SOIL");
    v.Need("ag", r.ag);
    CheckAbove(v, "ag", r.ag);
    DampingField(v, r.damping);
}

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_SPFC_NTC_STATE> r)
{
    v.Need("ag", r.ag);
    CheckAbove(v, "ag", r.ag);
    v.Need("F0", r.F0);
    CheckAbove(v, "F0", r.F0);
    v.Need("TC*", r.TCstar);
    CheckAbove(v, "TC*", r.TCstar);
}

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_SPFC_NTC> r)
{
    v.Letter("soil", r.soil, std::span(kSoils), "IDS_QM_CHOICE_SOIL");
    v.template Enum<1>("topography", r.topography, kTopographies, "IDS_QM_CHOICE_TOPOGRAPHY");
    DampingField(v, r.damping);
    v.NeedGroup("limit_states", [&](auto& states) {
        for (std::size_t i = 0; i < r.states.size(); ++i)
            states.PartIf(kLimitStateNames[i], r.states[i]);
    });
}

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_SPFC_USER> r)
{
    const auto isNotNegative = [](double value) { return value >= 0.0; };
    double before = -1.0;
    const auto isAscending = [&](double T) { return T > std::exchange(before, T); };
    v.Need("T", r.T);
    v.Check("T", r.T.size() >= 2, "IDS_QM_CASE_SPECTRUM_POINTS");
    v.Need("Sa", r.Sa);
    v.SameCount("Sa", r.Sa.size(), r.T.size());
    v.CheckEach("T", r.T, isNotNegative, "IDS_QM_CASE_PERIOD_NEGATIVE");
    v.CheckEach("T", r.T, isAscending, "IDS_QM_CASE_PERIODS_ASCEND");
    v.CheckEach("Sa", r.Sa, isNotNegative, "IDS_QM_CASE_SA_NEGATIVE");
    v.OptIf("gravity", r.gravity, kDimAccel);
    v.Check("gravity", r.gravity.value_or(1.0) > 0.0, "IDS_QM_CASE_GRAVITY");
}

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_SPFC_D> r)
{
    v.Variant("kind", r.data, kSpectrumKinds, "IDS_QM_CHOICE_SPECTRUM");
    std::visit([&](auto& data) { CaseFields(v, data); }, r.data);
}

// ---- evaluations --------------------------------------------------------------------------------

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_EVAL_BILINEAR> r)
{
    v.WordIf("rule", r.rule, kBilinearRules, "IDS_QM_CHOICE_BILINEAR_RULE");
    v.OptIf("secant", r.secant);
    v.OptIf("drop", r.drop);
    v.OptIf("iterate", r.iterate);
    v.WordIf("strength", r.strength, kStrengthRules, "IDS_QM_CHOICE_STRENGTH_RULE");
}

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_EVAL_D> r)
{
    v.NameRef("push", r.push, KindOf<T_POLC_D>());
    v.template Enum<kFirstMethod>("method", r.method, kMethodNames, "IDS_QM_CHOICE_METHOD");
    const std::span<const char* const> offered = ProceduresOf(r.method);
    v.LetterIf("procedure", r.procedure,
               offered.empty() ? std::span<const char* const>(kProcedures) : offered,
               "IDS_QM_CHOICE_PROCEDURE");
    v.Check("procedure", !offered.empty(), "IDS_QM_CASE_PROCEDURES");
    v.NameRef("spectrum", r.spectrum, KindOf<T_SPFC_D>());
    v.OptIf("behavior", r.behavior);
    v.OptIf("elastic_damping", r.elasticDamping);
    v.OptIf("user_damping", r.userDamping);
    v.OptIf("eigen_factors", r.eigenFactors);
    v.OptIf("masonry", r.masonry);
    v.OptIf("drift_kind", r.driftKind);
    v.OptIf("plot_type", r.plotType);
    v.OptIf("alpha_in_percent", r.alphaInPercent);
    v.PartIf("bilinear", r.bilinear);
    v.OptIf("weight", r.weight, kDimForce);
    v.OptNodes("monitored_nodes", r.monitoredNodes);
}
