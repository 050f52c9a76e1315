// Members of the records of the structure; see fieldwords.h. loadfields.h and hingefields.h go on.
#pragma once

#include "qm_db/records/fieldwords.h"
#include "qm_db/records/namedrecords.h"

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
inline constexpr T_DIMS3 kMasses3{kDimMass, kDimMass, kDimMass};
inline constexpr T_DIMS6 kDofLengths{kDimLength, kDimLength, kDimLength};
inline constexpr T_DIMS6 kDofForces{kDimForce,  kDimForce,  kDimForce,
                                    kDimMoment, kDimMoment, kDimMoment};
inline constexpr T_DIMS6 kDofSprings{kDimSpring, kDimSpring, kDimSpring,
                                     kDimMoment, kDimMoment, kDimMoment};

inline constexpr const char* kNotNegative = "IDS_QM_CASE_NOT_NEGATIVE";

// ---- options of the model -----------------------------------------------------------------------

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_DESIGN_CODES> r)
{
    v.OptIf("concrete", r.concrete);
    v.OptIf("steel", r.steel);
}

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_STCT_D> r)
{
    v.EnumOpt("birth", r.birth, STAGE_BIRTH::OnDeformed, kStageBirthNames, "IDS_QM_CHOICE_BIRTH");
    v.Opt("geometric_stiffness", r.geometricStiffness, false);
    v.Opt("cable_sag", r.cableSag, false);
}

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_REPORT_D> r)
{
    v.Opt("project", r.project, {});
    v.Opt("author", r.author, {});
    v.Opt("checker", r.checker, {});
    v.Opt("date", r.date, {});
    v.Texts("chapters", r.chapters);
    v.CheckEach(
        "chapters", r.chapters,
        [](const std::string& name) { return std::ranges::count(kReportChapterNames, name) > 0; },
        "IDS_QM_CASE_REPORT_CHAPTER");
    v.Opt("rows", r.rows, 200);
    v.Check("rows", r.rows >= 0, kNotNegative);
}

/// What a case file begins with.
template <class V>
void HeadFields(V& v, T_FIELD_REF<V, T_STYP_D> r)
{
    v.Opt("title", r.title, {});
    v.Group("units", [&](auto& units) {
        units.Enum("force", r.units.force, kForceNames, "IDS_QM_CHOICE_UNIT");
        units.Enum("length", r.units.length, kLengthNames, "IDS_QM_CHOICE_UNIT");
    });
    v.OptIf("gravity", r.gravity, kDimAccel);
    v.Check("gravity", r.gravity.value_or(1.0) > 0.0, "IDS_QM_CASE_GRAVITY");
    v.EnumIf("plane", r.plane, kPlaneNames, "IDS_QM_CHOICE_PLANE");
}

template <class V>
void OptionFields(V& v, T_FIELD_REF<V, T_STYP_D> r)
{
    v.Group("design_codes", [&](auto& codes) { CaseFields(codes, r.designCodes); });
    v.Group("stage_control", [&](auto& control) { CaseFields(control, r.stageControl); });
    v.Group("hinge_options", [&](auto& options) {
        options.Opt("alternative_hysteresis", r.alternativeHysteresis, false);
        options.Opt("wall_strength_degradation", r.wallStrengthDegradation, false);
        options.Opt("gsd", r.gsd, false);
        options.Padded("default_alpha1", r.defaultAlpha1, kDimNone);
        options.Padded("default_alpha2", r.defaultAlpha2, kDimNone);
    });
    v.Group("report", [&](auto& report) { CaseFields(report, r.report); });
}

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_STYP_D> r)
{
    HeadFields(v, r);
    OptionFields(v, r);
}

// ---- nodes, storeys, modes ----------------------------------------------------------------------

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_NODE_D> r)
{
    v.Need("id", r.id);
    v.Check("id", r.id > 0, "IDS_QM_CASE_NODE_ID");
    v.NeedFixed("xyz", r.xyz, kLengths3);
    v.StateFixed("mass", r.mass, kMasses3);
    v.CheckEach(
        "mass", r.mass, [](double m) { return m >= 0.0; }, "IDS_QM_CASE_MASS");
    v.State("restraint", r.restraint);
    v.CheckEach(
        "restraint", r.restraint, [](int flag) { return flag == 0 || flag == 1; },
        "IDS_QM_CASE_RESTRAINT");
}

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_STOR_D> r)
{
    v.Need("height", r.height, kDimLength);
    v.Check("height", r.height > 0.0, "IDS_QM_CASE_STOREY_HEIGHT");
    v.NodeList("nodes", r.nodes);
}

/// Mode shapes are in the normalisation of their source: no member is a quantity.
template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_EIGV_D> r)
{
    v.Need("period", r.period);
    v.Check("period", r.period > 0.0, "IDS_QM_CASE_MODE_PERIOD");
    v.NodeTable("shape", r.shape);
    v.OptIf("participation", r.participation);
    v.OptIf("mass_percent", r.massPercent);
}

// ---- materials and sections ---------------------------------------------------------------------

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_MATL_MEAN> r)
{
    v.Opt("fc", r.fc, 0.0, kDimStress);
    v.Check("fc", r.fc >= 0.0, kNotNegative);
    v.Opt("fy", r.fy, 0.0, kDimStress);
    v.Check("fy", r.fy >= 0.0, kNotNegative);
    v.Opt("fyw", r.fyw, 0.0, kDimStress);
    v.Check("fyw", r.fyw >= 0.0, kNotNegative);
}

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_MATL_MASONRY> r)
{
    v.Opt("tau0", r.tau0, 0.0, kDimStress);
    v.Check("tau0", r.tau0 >= 0.0, kNotNegative);
    v.Opt("fv0", r.fv0, 0.0, kDimStress);
    v.Check("fv0", r.fv0 >= 0.0, kNotNegative);
    v.Opt("fb", r.fb, 0.0, kDimStress);
    v.Check("fb", r.fb >= 0.0, kNotNegative);
    v.EnumOpt("bond", r.bond, BOND_KIND::Irregular, kBondNames, "IDS_QM_CHOICE_BOND");
    v.Opt("interlocking", r.interlocking, 1.0);
    v.Check("interlocking", r.interlocking >= 0.0, kNotNegative);
    v.Opt("hollow_blocks", r.hollowBlocks, false);
}

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_MATL_D> r)
{
    v.EnumOpt("type", r.type, MATL_CLASS::Steel, kMatlNames, "IDS_QM_CHOICE_MATERIAL");
    v.Opt("E", r.E, 0.0, kDimStress);
    v.Check("E", r.E >= 0.0, kNotNegative);
    v.Opt("nu", r.nu, 0.0);
    v.OptIf("G", r.G, kDimStress);
    v.Check("G", r.G.value_or(1.0) > 0.0, "IDS_QM_CASE_SHEAR_MODULUS");
    v.Opt("density", r.density, 0.0, kDimDensity);
    v.Check("density", r.density >= 0.0, kNotNegative);
    v.Opt("alpha", r.alpha, 0.0);
    v.OptOr("fy", "Fy", r.Fy, 0.0, kDimStress);
    v.Opt("fck", r.fck, 0.0, kDimStress);
    v.Opt("fyk", r.fyk, 0.0, kDimStress);
    v.Opt("Es", r.Es, 0.0, kDimStress);
    v.PartIf("mean", r.mean);
    v.EnumIf("knowledge", r.knowledge, kKnowledgeNames, "IDS_QM_CHOICE_KNOWLEDGE");
    v.OptIf("confidence_factor", r.confidence);
    v.Check("confidence_factor", r.confidence.value_or(1.0) >= 1.0, "IDS_QM_CASE_CONFIDENCE");
    v.PartIf("masonry", r.masonry);
    // A case file may name a grade; what is written are its values.
    if constexpr (requires { v.TextOf("grade"); })
        if (v.Has("grade"))
            v.Check("grade", FillFromGrades(v.TextOf("grade"), v.Has("type"), r),
                    "IDS_QM_CASE_GRADE");
}

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_REBAR> r)
{
    v.Need("y", r.y, kDimLength);
    v.Need("z", r.z, kDimLength);
    v.Need("area", r.area, kDimArea);
}

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_SECT_DETAIL> r)
{
    v.Need("cover", r.cover, kDimLength);
    v.Check("cover", r.cover >= 0.0, kNotNegative);
    v.Need("stirrup_diameter", r.stirrupDiameter, kDimLength);
    v.Check("stirrup_diameter", r.stirrupDiameter > 0.0, "IDS_QM_CASE_ABOVE_0");
    v.Need("stirrup_spacing", r.stirrupSpacing, kDimLength);
    v.Check("stirrup_spacing", r.stirrupSpacing > 0.0, "IDS_QM_CASE_ABOVE_0");
    v.Opt("legs_y", r.legsY, 2);
    v.Check("legs_y", r.legsY >= 2, "IDS_QM_CASE_LEGS");
    v.Opt("legs_z", r.legsZ, 2);
    v.Check("legs_z", r.legsZ >= 2, "IDS_QM_CASE_LEGS");
    v.EnumOpt("hooks", r.hooks, STIRRUP_HOOKS::Hooks135, kHookNames, "IDS_QM_CHOICE_HOOKS");
    v.Opt("lap_length", r.lapLength, 0.0, kDimLength);
    v.Check("lap_length", r.lapLength >= 0.0, kNotNegative);
    v.Opt("ties_in_core", r.tiesInCore, true);
    v.Opt("poor_splice", r.poorSplice, false);
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

/// The steel shape that a case file names, if it does; a name that is near to one is refused.
template <class V>
std::optional<T_SECT_D> NamedShapeOf(V& v)
{
    if constexpr (requires { v.TextOf("shape"); }) {
        if (!v.Has("shape")) return {};
        const std::string name = v.TextOf("shape");
        if (const std::optional<T_SECT_D> named = NamedShape(name)) return named;
        const std::string near = NearestShape(name);
        const bool word = std::ranges::find(kShapeNames, name) != kShapeNames.end();
        if (!word && !near.empty()) v.Refuse("shape", "IDS_QM_SECC_NEAR_SHAPE", name, near);
    }
    return {};
}

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_SECT_D> r)
{
    // What is written are the dimensions.
    const std::optional<T_SECT_D> named = NamedShapeOf(v);
    if (!named) v.EnumOpt("shape", r.shape, SECT_SHAPE::Value, kShapeNames, "IDS_QM_CHOICE_SHAPE");
    v.Padded("size", r.size, kDimLength);
    v.Opt("fillet", r.fillet, 0.0, kDimLength);
    v.Opt("taper", r.taper, 0.0);
    v.Check("taper", TaperFits(r), "IDS_QM_CASE_TAPER");
    v.Check("fillet", FilletFits(r), "IDS_QM_CASE_FILLET");
    if constexpr (V::kReads) {
        if (named) {
            v.Check("size", !v.Has("size"), "IDS_QM_CASE_SHAPE_SIZE");
            v.Check("fillet", !v.Has("fillet"), "IDS_QM_CASE_SHAPE_SIZE");
            v.Check("taper", !v.Has("taper"), "IDS_QM_CASE_SHAPE_SIZE");
            r.shape = named->shape, r.size = named->size;
            r.fillet = named->fillet, r.taper = named->taper;
        }
    }
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
    v.PartIf("detailing", r.detailing);
    v.Check("detailing", LeavesCore(r), "IDS_QM_CASE_COVER");
    v.Check("bars", !LeavesCore(r) || HoldsBars(r), "IDS_QM_CASE_BARS_OUTSIDE");
}

// ---- elements and constraints -------------------------------------------------------------------

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_ENDS<T_DIRS6>> r)
{
    v.Flags("I", r.I, kReleaseNames, "IDS_QM_CHOICE_RELEASE");
    v.Flags("J", r.J, kReleaseNames, "IDS_QM_CHOICE_RELEASE");
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
    v.Check("id", r.id > 0, "IDS_QM_CASE_ELEMENT_ID");
    v.EnumOpt("kind", r.kind, ELEM_KIND::Beam, kElemKindNames, "IDS_QM_CHOICE_KIND");
    const bool spring = r.kind == ELEM_KIND::Spring;
    v.NodePair("nodes", r.nodeI, r.nodeJ, spring ? 1 : 2,
               spring ? "IDS_QM_CASE_ONE_NODE" : "IDS_QM_CASE_TWO_NODES");
    if (spring || r.kind == ELEM_KIND::Link) {
        v.NeedFixed("stiffness", r.stiffness, kDofSprings);
        v.CheckEach(
            "stiffness", r.stiffness, [](double k) { return k >= 0.0; }, kNotNegative);
    } else {
        v.OptRef("material", r.material, KindOf<T_MATL_D>());
        v.OptRef("section", r.section, KindOf<T_SECT_D>());
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
    v.Rule("nodes", r.nodes.size() > 1, "IDS_QM_CASE_NODES_NEEDED");
    v.Enum("normal", r.normal, kAxisNames, "IDS_QM_CHOICE_AXIS");
}

template <class V>
void CaseFields(V& v, T_FIELD_REF<V, T_EQDS_D> r)
{
    v.NodeList("nodes", r.nodes);
    v.Rule("nodes", r.nodes.size() > 1, "IDS_QM_CASE_NODES_NEEDED");
    v.Flags("directions", r.directions, kDirectionNames, "IDS_QM_CHOICE_DIRECTION");
    v.Rule("directions", r.directions != T_DIRS6{}, "IDS_QM_CASE_DIRECTION_NEEDED");
}
