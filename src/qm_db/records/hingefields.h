// Members of the records of hinges; see fieldwords.h.
#pragma once

#include "qm_db/records/hingenames.h"
#include "qm_db/records/hingetype.h"
#include "qm_db/records/structfields.h"

/// Dimensions of one curve.
struct T_CURVE_DIMS {
    T_DIM strength, deform;
    T_DIM measure; // of the points of a FEMA or Eurocode curve
    T_DIM Stiffness() const
    {
        return {strength.force - deform.force, strength.length - deform.length};
    }
};

// ---- curves -------------------------------------------------------------------------------------

template <class V, class T, class... C>
void CaseFields(V& v, const T_SIDES<T>& r, const C&... context)
{
    v.Part("positive", r.pos, context...);
    v.Part("negative", r.neg, context...);
}
template <class V, class T, class... C>
void CaseFields(V& v, T_SIDES<T>& r, const C&... context)
{
    v.Part("positive", r.pos, context...);
    v.Part("negative", r.neg, context...);
}

template <class V>
void SidesOfValue(V& v, T_FIELD_REF<V, T_SIDES<double>> r, T_DIM dim = kDimNone)
{
    v.Opt("positive", r.pos, 0.0, dim);
    v.Opt("negative", r.neg, 0.0, dim);
}
template <class V>
void CaseFields(V& v, const T_SIDES<double>& r, const T_DIM& dim)
{
    SidesOfValue<V>(v, r, dim);
}
template <class V>
void CaseFields(V& v, T_SIDES<double>& r, const T_DIM& dim)
{
    SidesOfValue<V>(v, r, dim);
}

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_SKEL_POINT> r, const T_CURVE_DIMS& dims)
{
    v.Opt("deform", r.deform, 0.0, dims.measure);
    v.Opt("strength", r.strength, 0.0);
}

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_SKEL_SIDE> r, const T_CURVE_DIMS& dims)
{
    v.Opt("yield", r.yield, 0.0, dims.strength);
    v.Opt("yield_deform", r.yieldDeform, 0.0, dims.deform);
    v.Part("B", r.B, dims);
    v.Part("C", r.C, dims);
    v.Part("D", r.D, dims);
    v.Part("E", r.E, dims);
    v.Opt("IO", r.IO, 0.0, dims.measure);
    v.Opt("LS", r.LS, 0.0, dims.measure);
    v.Opt("CP", r.CP, 0.0, dims.measure);
    v.Opt("user_stiffness", r.userStiffness, 0.0, dims.Stiffness());
    v.Padded("energy", r.energy, kDimNone);
}

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_SKEL_AXIAL> r, const T_CURVE_DIMS& dims)
{
    v.Need("axial", r.axial, kDimForce);
    CaseFields(v, r.sides, dims);
}

/// Dimensions of the points in the measure of the curve; the measure has been read before.
inline T_CURVE_DIMS DimsInMeasure(T_CURVE_DIMS dims, SKEL_MEASURE measure)
{
    dims.measure = measure == SKEL_MEASURE::Plastic ? dims.deform : kDimNone;
    return dims;
}

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_SKEL_FEMA> r, const T_CURVE_DIMS& given)
{
    static const T_SKEL_FEMA d;
    v.Opt("symmetric", r.symmetric, d.symmetric);
    v.Opt("auto_yield", r.autoYield, d.autoYield);
    v.EnumOpt("measure", r.measure, d.measure, kMeasureNames, "IDS_QM_CHOICE_MEASURE");
    const T_CURVE_DIMS dims = DimsInMeasure(given, r.measure);
    CaseFields(v, r.sides, dims);
    v.Opt("strength_loss", r.strengthLoss, d.strengthLoss);
    v.EnumOpt("initial_stiffness", r.initStiffness, d.initStiffness, kStiffnessNames,
              "IDS_QM_CHOICE_STIFFNESS");
    v.Opt("asymmetric_stiffness", r.asymStiffness, d.asymStiffness);
    v.EnumOpt("unload_type", r.unloadType, d.unloadType, kUnloadNames, "IDS_QM_CHOICE_UNLOADING");
    v.Opt("unload_factor", r.unloadFactor, d.unloadFactor);
    v.Opt("unload_exponent", r.unloadExponent, d.unloadExponent);
    v.Opt("unload_proportion", r.unloadProportion, d.unloadProportion);
    v.Opt("energy_based", r.energyBased, d.energyBased);
    v.Opt("multi_curve", r.multiCurve, d.multiCurve);
    v.List("axial_curves", r.curves, dims);
    v.PartIf("dc_ratio", r.dcRatio, kDimNone);
    v.Opt("infill_strut", r.infillStrut, d.infillStrut);
    v.Opt("infill_general", r.infillGeneral, d.infillGeneral);
    v.Opt("compliance_criteria", r.compliance, d.compliance);
}

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_SKEL_EC8> r, const T_CURVE_DIMS& given)
{
    static const T_SKEL_EC8 d;
    v.Opt("symmetric", r.symmetric, d.symmetric);
    v.Opt("auto_yield", r.autoYield, d.autoYield);
    v.Opt("strength_loss", r.strengthLoss, d.strengthLoss);
    v.EnumOpt("measure", r.measure, d.measure, kMeasureNames, "IDS_QM_CHOICE_MEASURE");
    v.EnumOpt("initial_stiffness", r.initStiffness, d.initStiffness, kStiffnessNames,
              "IDS_QM_CHOICE_STIFFNESS");
    CaseFields(v, r.sides, DimsInMeasure(given, r.measure));
}

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_SKEL_MULTI_SIDE> r, const T_CURVE_DIMS& dims)
{
    v.Opt("P1", r.P1, 0.0, dims.strength);
    v.Opt("P2", r.P2, 0.0, dims.strength);
    v.Opt("P3", r.P3, 0.0, dims.strength);
    v.Opt("D1", r.D1, 0.0, dims.deform);
    v.Opt("D2", r.D2, 0.0, dims.deform);
    v.Opt("D3", r.D3, 0.0, dims.deform);
    v.Opt("alpha1", r.alpha1, 0.0);
    v.Opt("alpha2", r.alpha2, 0.0);
    v.Opt("gap", r.gap, 0.0, dims.deform);
    v.Opt("user_stiffness", r.userStiffness, 0.0, dims.Stiffness());
}

/// A symmetric curve without a negative side has the gap of the positive one on both. The side that
/// was left out is told from one that is written without a gap.
template <class V>
void MultiSides(V& v, T_FIELD_REF<V, T_SKEL_MULTI> r, const T_CURVE_DIMS& dims)
{
    v.Part("positive", r.sides.pos, dims);
    T_SKEL_MULTI_SIDE leftOut;
    if (r.symmetric) leftOut.gap = r.sides.pos.gap;
    if constexpr (V::kReads) {
        if (!v.Has("negative")) {
            r.sides.neg = leftOut;
            return;
        }
    } else if constexpr (V::kWrites) {
        if (!(r.sides.neg == leftOut)) v.NeedPart("negative", r.sides.neg, dims);
        return;
    }
    v.Part("negative", r.sides.neg, dims);
}

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_SKEL_MULTI> r, const T_CURVE_DIMS& dims)
{
    static const T_SKEL_MULTI d;
    v.Opt("symmetric", r.symmetric, d.symmetric);
    v.Opt("auto_yield", r.autoYield, d.autoYield);
    v.Opt("use_ultimate", r.useUltimate, d.useUltimate);
    v.Opt("use_deformation", r.useDeformation, d.useDeformation);
    v.EnumOpt("initial_stiffness", r.initStiffness, d.initStiffness, kStiffnessNames,
              "IDS_QM_CHOICE_STIFFNESS");
    v.EnumOpt("gap_sides", r.gapSides, d.gapSides, kGapNames, "IDS_QM_CHOICE_GAP_SIDE");
    MultiSides<V>(v, r, dims);
}

/// The alternative has been set by the type of the component.
template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_SKEL_CURVE> r, const T_CURVE_DIMS& dims)
{
    std::visit([&](auto& curve) { CaseFields(v, curve, dims); }, r);
}

/// One curve, "curve", for equal ends; "I" and "J" otherwise. "same_ends" stands only beside two
/// different curves of which the J-end's is out of use.
template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_HINGE_COMPONENT> r, const T_CURVE_DIMS& dims)
{
    if constexpr (V::kReads) v.Must("type"); // before what depends on it
    if constexpr (V::kWrites) {
        if (!FitsType(r.curves.I, r.type) || !FitsType(r.curves.J, r.type))
            v.Fail("IDS_QM_CASE_CURVE_TYPE");
    }
    v.Opt("active", r.active, true); // a component that is listed
    v.Enum("type", r.type, kSkelNames, "IDS_QM_CHOICE_CURVE");
    v.template EnumOpt<1>("location", r.location, HINGE_LOCATION::BothEnds, kLocationNames,
                          "IDS_QM_CHOICE_LOCATION");
    if constexpr (V::kReads) {
        r.curves.I = r.curves.J = MakeSkelCurve(r.type);
        const bool two = v.Has("I") || v.Has("J");
        v.Opt("same_ends", r.sameEnds, !two);
        if (!two) {
            v.Part("curve", r.curves.I, dims);
            r.curves.J = r.curves.I;
            return;
        }
    } else if (V::kWrites && r.sameEnds && r.curves.I == r.curves.J) {
        return v.Part("curve", r.curves.I, dims);
    } else {
        v.Opt("same_ends", r.sameEnds, false);
    }
    v.NeedPart("I", r.curves.I, dims);
    v.NeedPart("J", r.curves.J, dims);
}

// ---- hinge types and hinges ---------------------------------------------------------------------

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_YIELD_AXIS> r)
{
    v.Opt("used", r.used, true);
    v.Part("moment", r.moment, kDimMoment);
    v.Part("moment_max", r.momentMax, kDimMoment);
    v.Pairs("positive", r.curves.pos);
    v.Pairs("negative", r.curves.neg);
}

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_YIELD_LEVEL> r)
{
    v.Opt("tension", r.tension, 0.0, kDimForce);
    v.Opt("compression", r.compression, 0.0, kDimForce);
    v.Part("y", r.y);
    v.Part("z", r.z);
}

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_YIELD_SURFACE> r)
{
    v.PartIf("crack", r.crack);
    v.Part("yield", r.yield);
}

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_PMM_CURVES> r)
{
    v.Pairs("curve_1", r[0]);
    v.Pairs("curve_2", r[1]);
}

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_PMM_TABLE> r)
{
    v.Opt("Pmax", r.Pmax, 0.0, kDimForce);
    CaseFields(v, r.curves);
    v.PartIf("negative", r.negative);
    v.Opt("balanced", r.balanced, false);
}

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_MASONRY_HINGE> r)
{
    v.Opt("form", r.form, 1);
    v.Opt("comp_strength", r.compStrength, 0.0, kDimStress);
    v.Opt("shear_strength", r.shearStrength, 0.0, kDimStress);
    v.Opt("Hp", r.Hp, 0.0, kDimLength);
    v.Opt("distribution", r.distribution, 1.0);
}

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_HINGE_LENGTH> r)
{
    v.Opt("relative", r.relative, false);
    const T_DIM dim = r.relative ? kDimNone : kDimLength;
    v.Opt("My_I", r.My.I, 0.0, dim);
    v.Opt("My_J", r.My.J, 0.0, dim);
    v.Opt("Mz_I", r.Mz.I, 0.0, dim);
    v.Opt("Mz_J", r.Mz.J, 0.0, dim);
    v.Padded("components_I", r.components.I, dim);
    v.Padded("components_J", r.components.J, dim);
    v.Opt("integration_points", r.integrationPoints, 5);
    v.Opt("auto_span", r.autoSpan, true);
    v.Opt("span", r.span, 0.0, kDimLength);
}

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_STEEL_CONNECTION> r)
{
    v.Need("kind", r.kind);
    v.Opt("column_flange", r.columnFlange, 0.0); // SI, as all that follows from a generator
    v.Opt("continuity_plate", r.continuityPlate, 0.0);
    v.Opt("panel_ratio", r.panelRatio, 0.0);
}

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_GENERATED> r)
{
    v.Need("code", r.code);
    v.Opt("secondary", r.secondary, false);
    v.Opt("axial_I", r.axial.I, 0.0, kDimForce);
    v.Opt("axial_J", r.axial.J, 0.0, kDimForce);
    v.Need("inputs", r.inputs);
    v.Opt("pushed", r.pushed, {});
    v.Opt("axial_range", r.axialRange, {});
    v.Opt("tie", r.tie, 0.0);
    v.PartIf("connection", r.connection);
}

/// Dimensions of a component's curve in a definition.
inline T_CURVE_DIMS CurveDims(std::size_t component, HINGE_DEFINITION definition)
{
    const auto c = static_cast<HINGE_COMPONENT>(component);
    return {StrengthDim(c), DeformDim(c, definition), kDimNone};
}

using T_HINGE_COMPONENTS = std::array<T_HINGE_COMPONENT, 6>;

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_HINGE_COMPONENTS> r, const HINGE_DEFINITION& definition)
{
    for (std::size_t i = 0; i < r.size(); ++i) {
        if constexpr (V::kReads) {
            if (!v.Has(kComponentNames[i])) continue;
        }
        if constexpr (V::kWrites) {
            if (r[i] == T_HINGE_COMPONENT{}) continue;
        }
        v.NeedPart(kComponentNames[i], r[i], CurveDims(i, definition));
    }
}

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_PHGT_D> r)
{
    static const T_PHGT_D d;
    v.Code("element", r.element, kHingeElementNames, "IDS_QM_CHOICE_ELEMENT");
    v.EnumOpt("definition", r.definition, d.definition, kDefinitionNames,
              "IDS_QM_CHOICE_DEFINITION");
    v.EnumOpt("interaction", r.interaction, d.interaction, kInteractionNames,
              "IDS_QM_CHOICE_INTERACTION");
    v.EnumIf("interaction_Mz", r.interactionMz, kInteractionNames, "IDS_QM_CHOICE_INTERACTION");
    v.EnumOpt("material", r.material, d.material, kMatlNames, "IDS_QM_CHOICE_MATERIAL");
    v.OptKeyRef("section", r.section, KindOf<T_SECT_D>());
    v.OptKeyRef("section_material", r.sectionMaterial, KindOf<T_MATL_D>());
    v.OptKeyRef("fibre_section", r.fibreSection, KindOf<T_SECT_D>());
    v.OptKeyRef("thickness_section", r.thicknessSection, KindOf<T_SECT_D>());
    v.Part("components", r.components, r.definition);
    v.PartIf("yield_surface", r.yieldSurface);
    v.Opt("exact_surface", r.exactSurface, false);
    v.PartIf("pmm", r.pmm);
    v.Part("length", r.length);
    v.Opt("withhold_mz_length", r.withholdMzLength, false);
    v.PartIf("masonry", r.masonry);
    v.PartIf("generated", r.generated);
}

using T_HINGE_STRENGTHS = std::array<T_SIDES<double>, 6>;

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_HINGE_STRENGTHS> r)
{
    for (std::size_t i = 0; i < r.size(); ++i)
        v.Part(kComponentNames[i], r[i], StrengthDim(static_cast<HINGE_COMPONENT>(i)));
}

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_PHGE_D> r)
{
    v.KeyRef("element", r.element, KindOf<T_ELEM_D>());
    v.KeyRef("hinge_type", r.hingeType, KindOf<T_PHGT_D>());
    v.Part("crack", r.crack);
    v.Part("yield", r.yield);
    v.Part("crack_J", r.crackJ);
    v.Part("yield_J", r.yieldJ);
    v.OptRef("axial_case", r.axialCase, KindOf<T_STLD_D>());
}

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_IEHP_D> r)
{
    for (std::size_t i = 0; i < r.components.size(); ++i)
        v.PartIf(kComponentNames[i], r.components[i],
                 CurveDims(i, HINGE_DEFINITION::MomentRotation));
}

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_POFC_D> r)
{
    v.Need("step", r.step);
    v.Need("factor", r.factor);
    v.SameCount("factor", r.factor.size(), r.step.size());
}
