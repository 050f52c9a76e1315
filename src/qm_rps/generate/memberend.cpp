#include "qm_rps/generate/memberend.h"

#include "qm_base/say.h"
#include "qm_db/sectionproperties.h"
#include "qm_rps/generate/rcmember.h"
#include "qm_rps/push/pushstoreys.h"

#include <algorithm>
#include <cmath>
#include <numeric>

namespace {

using T_VECTOR = std::array<double, 3>;
constexpr double kSameAxial = 1e-6; // of the squash load
/// Of the rules by which hinges are made, raised where a rule changes what comes out: a type of an
/// earlier edition is stale, not edited.
constexpr double kEdition = 3.0;
constexpr std::size_t kPlaceOfEdition = 2; // among the inputs, behind the axial forces
constexpr auto kMy = HINGE_COMPONENT::My, kMz = HINGE_COMPONENT::Mz;

double Dot(const T_VECTOR& a, const T_VECTOR& b)
{
    return std::inner_product(a.begin(), a.end(), b.begin(), 0.0);
}

/// The end of the elastic part: node and rigid offset.
T_VECTOR PlaceOf(const T_MODEL& model, int node, const std::array<double, 3>& offset)
{
    T_VECTOR place{};
    const T_NODE_D& record = model.nodes.at(node);
    for (std::size_t i = 0; i < place.size(); ++i)
        place[i] = record.xyz[i] + offset[i];
    return place;
}

/// Local z before it is made normal to the axis x, a unit vector.
T_VECTOR ReferenceOf(const T_ELEM_D& e, const T_VECTOR& x)
{
    constexpr double kVertical = 1e-6;
    if (e.zAxis != T_VECTOR{}) return e.zAxis;
    return std::hypot(x[0], x[1]) < kVertical ? T_VECTOR{1.0, 0.0, 0.0} : T_VECTOR{0.0, 0.0, 1.0};
}

/// How far a direction normal to the axis x lies along another one: 0 across it, 1 along it.
double Alignment(const T_VECTOR& direction, const T_VECTOR& with, const T_VECTOR& x)
{
    const auto across = [&](T_VECTOR v) {
        const double along = Dot(v, x);
        for (std::size_t i = 0; i < v.size(); ++i)
            v[i] -= along * x[i];
        return v;
    };
    const T_VECTOR a = across(direction), b = across(with);
    return std::fabs(Dot(a, b)) / std::sqrt(Dot(a, a) * Dot(b, b));
}

/// About which local axes the member bends: that of a beam is the horizontal one, of which empty
/// says that none is, within 10 degrees.
std::vector<HINGE_COMPONENT> BendingOf(const T_MODEL& model, const T_ELEM_D& e, const T_VECTOR& x,
                                       bool column)
{
    if (!model.styp.plane && column) return {kMy, kMz};
    constexpr std::array<std::size_t, 3> kNormals{2, 1, 0}; // of XY, XZ, YZ
    T_VECTOR across{}; // the plane in which the member bends: its normal, or the vertical in it
    if (model.styp.plane)
        across[kNormals[static_cast<std::size_t>(*model.styp.plane)]] = 1.0;
    else
        across[VerticalAxis(model)] = 1.0;
    const double aligned = Alignment(ReferenceOf(e, x), across, x);
    if (model.styp.plane) return {aligned > 0.5 ? kMz : kMy};
    constexpr double kNear = 0.98480775301; // cos 10 degrees
    if (aligned > kNear) return {kMy};
    if (aligned < std::sqrt(1.0 - kNear * kNear)) return {kMz};
    return {};
}

int Refuse(std::string& reason, std::string words)
{
    reason = std::move(words);
    return 0;
}

/// Local y and z, those of the section.
HINGE_COMPONENT StrongAxis(const T_SECT_D& section)
{
    return section.size[0] >= section.size[1] ? kMy : kMz;
}

bool TurnsFreely(const T_ELEM_D& e, const std::vector<HINGE_COMPONENT>& bending)
{
    return !bending.empty() && std::ranges::all_of(bending, [&](HINGE_COMPONENT c) {
        const auto at = static_cast<std::size_t>(c);
        return e.release.I[at] && e.release.J[at];
    });
}

/// What the member is, and about which axes it bends.
void SetKind(const T_MODEL& model, const T_ELEM_D& e, const T_VECTOR& x, T_HINGE_MEMBER& m)
{
    const T_SECT_D& section = model.sections.at(e.section);
    const MATL_CLASS material = model.materials.at(e.material).type;
    const bool steep = std::fabs(x[VerticalAxis(model)]) > std::sqrt(0.5);
    m.kind = steep ? MEMBER_KIND::Column : MEMBER_KIND::Beam;
    if (material == MATL_CLASS::Masonry) m.kind = steep ? MEMBER_KIND::Pier : MEMBER_KIND::Spandrel;
    m.bending = BendingOf(model, e, x, steep);
    if (e.kind == ELEM_KIND::Truss ||
        (material == MATL_CLASS::Steel && TurnsFreely(e, m.bending))) {
        m.kind = MEMBER_KIND::Brace;
        m.bending.clear();
        return;
    }
    const HINGE_COMPONENT strong = StrongAxis(section);
    const bool inPlane = std::ranges::count(m.bending, strong) > 0;
    const bool wall =
        material == MATL_CLASS::Concrete && steep && IsWallSection(section) && inPlane;
    if (wall) m.kind = MEMBER_KIND::Wall;
    if (wall || (m.kind == MEMBER_KIND::Pier && inPlane)) m.bending = {strong};
}

/// Compressive strength of concrete or masonry alone, or of steel: the measure of axial forces.
double SquashLoad(const T_SECT_D& section, const T_MATL_D& material)
{
    const T_MATL_MEAN mean = material.mean.value_or(T_MATL_MEAN{});
    if (material.type == MATL_CLASS::Concrete && section.shape == SECT_SHAPE::Rectangle)
        return section.size[0] * section.size[1] * std::max(material.fck, mean.fc);
    T_SECT_D s;
    SECT_FAULT fault = SECT_FAULT::None;
    if (!CSectionProperties::Calc(section, s, fault)) return 0.0;
    return s.area * (material.type == MATL_CLASS::Steel ? std::max(material.Fy, mean.fy)
                                                        : std::max(material.fck, mean.fc));
}

void Append(std::vector<double>& to, std::initializer_list<double> values)
{
    to.insert(to.end(), values);
}

void AppendMaterial(const T_MATL_D& m, std::vector<double>& to)
{
    const T_MATL_MEAN mean = m.mean.value_or(T_MATL_MEAN{});
    Append(to, {m.E, ShearModulus(m), m.fck, m.fyk, m.Es, mean.fc, mean.fy, mean.fyw});
    Append(to,
           {m.confidence.value_or(0.0), m.knowledge ? 1.0 + static_cast<int>(*m.knowledge) : 0.0});
    if (m.type == MATL_CLASS::Steel) Append(to, {m.Fy});
    if (!m.masonry) return;
    Append(to, {m.masonry->tau0, m.masonry->fv0, m.masonry->fb, m.masonry->interlocking});
    Append(to, {1.0 * static_cast<int>(m.masonry->bond), m.masonry->hollowBlocks ? 1.0 : 0.0});
}

void AppendSection(const T_SECT_D& s, std::vector<double>& to)
{
    const T_SECT_DETAIL d = s.detailing.value_or(T_SECT_DETAIL{});
    Append(to, {s.size[0], s.size[1], d.cover, d.stirrupDiameter, d.stirrupSpacing, d.lapLength});
    Append(to, {1.0 * d.legsY, 1.0 * d.legsZ, 1.0 * static_cast<int>(d.hooks),
                d.tiesInCore ? 1.0 : 0.0, d.poorSplice ? 1.0 : 0.0});
    const T_SECT_FACTORS f = MeanFactors(s);
    Append(to, {f.area, f.Asy, f.Asz, f.J, f.Iyy, f.Izz});
    if (s.shape != SECT_SHAPE::Rectangle)
        Append(to, {1.0 * static_cast<int>(s.shape), s.size[2], s.size[3], s.fillet});
    if (s.taper > 0.0) Append(to, {s.taper});
    for (const T_REBAR& bar : s.bars)
        Append(to, {bar.y, bar.z, bar.area});
}

/// The first ones are axial forces over the squash load.
bool SameNumbers(const std::vector<double>& a, const std::vector<double>& b, std::size_t forces)
{
    constexpr double kDigits = 1e-9; // a file in other units gives back this much
    if (a.size() != b.size()) return false;
    for (std::size_t i = 0; i < a.size(); ++i) {
        const double most =
            i < forces ? kSameAxial : kDigits * std::max(std::fabs(a[i]), std::fabs(b[i]));
        if (!(std::fabs(a[i] - b[i]) <= most)) return false;
    }
    return true;
}

/// What a type was asked for with, as numbers; names by their place in the list of names.
std::vector<double> SealOf(const T_GENERATED& made)
{
    const auto placeIn = [](const auto& names, const std::string& name) {
        return static_cast<double>(std::ranges::find(names, name) - names.begin());
    };
    const T_STEEL_CONNECTION c = made.connection.value_or(T_STEEL_CONNECTION{});
    const std::vector<double>& range = made.axialRange;
    return {placeIn(kHingeCodeNames, made.code),
            made.secondary ? 1.0 : 0.0,
            made.axial.I,
            made.axial.J,
            made.tie,
            range.empty() ? 0.0 : range.front(),
            range.empty() ? 0.0 : range.back(),
            made.connection ? 1.0 + placeIn(kFrConnectionNames, c.kind) : 0.0,
            c.columnFlange,
            c.continuityPlate,
            c.panelRatio};
}

} // namespace

int ReadMember(const T_MODEL& model, int element, const CInitialAxial& axial, T_HINGE_MEMBER& out,
               std::string& reason)
{
    const auto found = model.elements.find(element);
    if (found == model.elements.end()) return Refuse(reason, Say("IDS_CMD_IEHP_NO_ELEM"));
    const T_ELEM_D& e = found->second;
    if (e.kind != ELEM_KIND::Beam && e.kind != ELEM_KIND::Truss)
        return Refuse(reason, Say("IDS_QM_GEN_NO_BEAM"));
    if (!model.sections.contains(e.section)) return Refuse(reason, Say("IDS_CMD_IEHP_NO_SECT"));
    if (!model.materials.contains(e.material)) return Refuse(reason, Say("IDS_CMD_IEHP_NO_MATL"));
    if (e.member != 0)
        for (const auto& [id, other] : model.elements)
            if (id != element && other.member == e.member)
                return Refuse(reason, Say("IDS_QM_GEN_PARTS", std::to_string(e.member)));
    T_VECTOR x = PlaceOf(model, e.nodeJ, e.offset.J);
    const T_VECTOR start = PlaceOf(model, e.nodeI, e.offset.I);
    T_VECTOR whole = PlaceOf(model, e.nodeJ, {});
    const T_VECTOR nodeI = PlaceOf(model, e.nodeI, {});
    for (std::size_t i = 0; i < x.size(); ++i) {
        x[i] -= start[i];
        whole[i] -= nodeI[i];
    }
    T_HINGE_MEMBER m;
    m.clear = std::sqrt(Dot(x, x));
    m.length = std::sqrt(Dot(whole, whole));
    if (!(m.clear > 0.0) || !(Dot(x, whole) > 0.0)) return Refuse(reason, Say("IDS_QM_GEN_CLEAR"));
    for (double& component : x)
        component /= m.clear;
    m.element = element;
    m.section = e.section;
    m.material = e.material;
    SetKind(model, e, x, m);
    if (m.bending.empty() && m.kind != MEMBER_KIND::Brace)
        return Refuse(reason, Say("IDS_QM_GEN_SKEW"));
    m.axial = axial.Of(element);
    const double squash = SquashLoad(model.sections.at(e.section), model.materials.at(e.material));
    if (std::fabs(m.axial.I - m.axial.J) <= kSameAxial * squash) m.axial.J = m.axial.I;
    m.release = e.release;
    out = std::move(m);
    return 1;
}

T_MEMBER_END EndOf(const T_MODEL& model, const T_HINGE_MEMBER& member,
                   const T_CODE_OPTIONS& options, HINGE_COMPONENT component, bool atI, double axial)
{
    T_MEMBER_END end;
    end.code = options.code;
    end.secondary = options.secondary;
    end.tie = options.tie;
    end.kind = member.kind;
    end.aboutY = component == kMy;
    end.section = model.sections.at(member.section);
    end.material = model.materials.at(member.material);
    SECT_FAULT fault = SECT_FAULT::None;
    (void)CSectionProperties::Calc(end.section, end.section, fault); // judged with the strengths
    end.clear = member.clear;
    end.axial = axial;
    const T_MATL_D& m = end.material;
    T_SECT_D stiff = end.section; // as the analysis has it
    (void)CalcStiffness(end.section, stiff, fault);
    end.EI = m.E * (end.aboutY ? stiff.Iyy : stiff.Izz);
    end.EA = m.E * stiff.area;
    end.GA = ShearModulus(m) * (end.aboutY ? stiff.Asz : stiff.Asy);
    if (member.joints) {
        end.connection = options.connection;
        end.joint = atI ? member.joints->I : member.joints->J;
    }
    const auto axis = std::ranges::find(member.bending, component) - member.bending.begin();
    const std::size_t place = 4 * static_cast<std::size_t>(axis) + (atI ? 0 : 2);
    if (place + 1 < member.pushed.size() && member.pushed[place] > 0.0)
        end.pushed =
            T_PUSHED_SHEAR{member.pushed[place], std::clamp(member.pushed[place + 1],
                                                            end.LeastSpan(), end.LongestSpan())};
    return end;
}

std::vector<double> InputsOf(const T_MODEL& model, const T_HINGE_MEMBER& member)
{
    const T_SECT_D& section = model.sections.at(member.section);
    const T_MATL_D& material = model.materials.at(member.material);
    const double squash = SquashLoad(section, material);
    // Axial forces first, over the squash load, so that their tolerance is that of all.
    std::vector<double> inputs;
    for (const double force : {member.axial.I, member.axial.J})
        inputs.push_back(member.HasAxial() && squash > 0.0 ? force / squash : 0.0);
    Append(inputs, {kEdition, static_cast<double>(member.kind), member.clear, member.length});
    for (const HINGE_COMPONENT c : {kMy, kMz}) {
        const auto at = static_cast<std::size_t>(c);
        Append(inputs, {member.release.I[at] ? 1.0 : 0.0, member.release.J[at] ? 1.0 : 0.0});
        Append(inputs, {std::ranges::count(member.bending, c) > 0 ? 1.0 : 0.0});
    }
    AppendMaterial(material, inputs);
    AppendSection(section, inputs);
    inputs.insert(inputs.end(), member.pushed.begin(), member.pushed.end());
    if (!member.joints) return inputs;
    for (const T_STEEL_JOINT& j : {member.joints->I, member.joints->J})
        Append(inputs,
               {j.columnFlange, j.columnDepth, j.columnWeb, j.columnFye, j.storey, j.beams});
    return inputs;
}

void PutSeal(T_GENERATED& made)
{
    const std::vector<double> seal = SealOf(made);
    made.inputs.insert(made.inputs.end(), seal.begin(), seal.end());
}

INPUT_STATE InputStateOf(const T_GENERATED& made, const std::vector<double>& today)
{
    const std::vector<double> seal = SealOf(made);
    const auto count = static_cast<std::ptrdiff_t>(seal.size());
    const std::vector<double>& all = made.inputs;
    // Those of an earlier edition have another seal, or none.
    if (all.size() < kPlaceOfEdition + 1 + seal.size() || all[kPlaceOfEdition] != kEdition)
        return INPUT_STATE::Stale;
    if (!SameNumbers({all.end() - count, all.end()}, seal, 0)) return INPUT_STATE::Edited;
    return SameInputs({all.begin(), all.end() - count}, today) ? INPUT_STATE::Same
                                                               : INPUT_STATE::Stale;
}

bool SameInputs(const std::vector<double>& a, const std::vector<double>& b)
{
    return SameNumbers(a, b, kPlaceOfEdition);
}
