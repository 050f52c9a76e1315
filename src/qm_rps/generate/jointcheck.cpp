#include "qm_rps/generate/jointcheck.h"

#include "qm_base/say.h"
#include "qm_rps/codes/en1998shear.h"
#include "qm_rps/generate/rcend.h"
#include "qm_rps/push/pushstoreys.h"

#include <algorithm>
#include <cmath>
#include <numeric>

namespace {

using T_VECTOR = std::array<double, 3>;
constexpr auto K = CODE_MARK::Computed;
constexpr double kSteep = 0.7071;   // cosine of 45 degrees
constexpr double kInLine = 0.99619; // of five: directions that count as one
constexpr double kSquare = 0.08716; // of 85: those that count as at right angles

int Fail(std::string& reason, std::string words)
{
    reason = std::move(words);
    return 0;
}

/// From the node to the other end; nothing: a model without that node.
std::optional<T_VECTOR> WayFrom(const T_MODEL& model, const T_ELEM_D& e, int node)
{
    const auto from = model.nodes.find(node);
    const auto to = model.nodes.find(e.nodeI == node ? e.nodeJ : e.nodeI);
    if (from == model.nodes.end() || to == model.nodes.end()) return {};
    T_VECTOR way{};
    for (std::size_t i = 0; i < way.size(); ++i)
        way[i] = to->second.xyz[i] - from->second.xyz[i];
    const double length = std::sqrt(std::inner_product(way.begin(), way.end(), way.begin(), 0.0));
    if (!(length > 0.0)) return {};
    for (double& w : way)
        w /= length;
    return way;
}

double Dot(const T_VECTOR& a, const T_VECTOR& b)
{
    return std::inner_product(a.begin(), a.end(), b.begin(), 0.0);
}

/// Horizontal direction of a way that is not steep, a unit vector.
T_VECTOR PlanOf(T_VECTOR way, std::size_t up)
{
    way[up] = 0.0;
    const double length = std::sqrt(Dot(way, way));
    for (double& w : way)
        w /= length;
    return way;
}

/// Members that meet at a node.
struct T_MEETING {
    std::vector<int> above, below;
    std::vector<int> ahead, behind, across;
    bool skewed = false; // a beam neither in the plane nor across it

    bool IsJoint() const { return Column() != 0 && !(ahead.empty() && behind.empty()); }
    int Above() const { return above.empty() ? 0 : above.front(); }
    int Column() const { return below.empty() ? Above() : below.front(); }
    std::vector<int> Beams() const
    {
        std::vector<int> all = ahead;
        all.insert(all.end(), behind.begin(), behind.end());
        return all;
    }
};
T_MEETING MeetingAt(const T_MODEL& model, std::span<const int> beams, int node,
                    const T_VECTOR& along)
{
    T_MEETING m;
    const std::size_t up = VerticalAxis(model);
    for (const int id : beams) {
        const auto way = WayFrom(model, model.elements.at(id), node);
        if (!way) continue;
        if (std::fabs((*way)[up]) > kSteep) {
            ((*way)[up] > 0.0 ? m.above : m.below).push_back(id);
            continue;
        }
        const double share = Dot(PlanOf(*way, up), along);
        if (std::fabs(share) > kInLine) {
            (share > 0.0 ? m.ahead : m.behind).push_back(id);
        } else {
            m.across.push_back(id);
            m.skewed = m.skewed || std::fabs(share) > kSquare;
        }
    }
    return m;
}

/// Section and material of an element, where both are there and of concrete.
struct T_PART {
    const T_SECT_D* section = nullptr;
    const T_MATL_D* material = nullptr;
};
T_PART PartOf(const T_MODEL& model, int element)
{
    const T_ELEM_D& e = model.elements.at(element);
    const auto section = model.sections.find(e.section);
    const auto material = model.materials.find(e.material);
    const bool fits = section != model.sections.end() && material != model.materials.end() &&
                      material->second.type == MATL_CLASS::Concrete &&
                      section->second.shape == SECT_SHAPE::Rectangle;
    return fits ? T_PART{&section->second, &material->second} : T_PART{};
}

JOINT_KIND KindOf(const T_MEETING& m)
{
    const bool interior = !m.ahead.empty() && !m.behind.empty();
    const bool transverse = m.across.size() > 1;
    if (interior) return transverse ? JOINT_KIND::InteriorWithBeams : JOINT_KIND::Interior;
    if (m.above.empty()) return JOINT_KIND::Knee;
    return transverse ? JOINT_KIND::ExteriorWithBeams : JOINT_KIND::Exterior;
}

/// Whether the plane runs along local z of the column (else y); empty: along neither. Upright local
/// z is the element's own vector, else global X.
std::optional<bool> IsAlongZ(const T_ELEM_D& e, const T_VECTOR& along, std::size_t up)
{
    const T_VECTOR z = e.zAxis == T_VECTOR{} ? T_VECTOR{1.0, 0.0, 0.0} : e.zAxis;
    const double share = std::fabs(Dot(PlanOf(z, up), along));
    if (share > kInLine) return true;
    return share < kSquare ? std::optional(false) : std::nullopt;
}

/// Why these members are no joint that the codes' rules are for; empty: they are.
std::string FaultOf(const T_MODEL& model, const T_MEETING& m)
{
    if (!m.IsJoint() || m.ahead.size() > 1 || m.behind.size() > 1)
        return Say("IDS_QM_GEN_NO_JOINT");
    if (m.above.size() > 1 || m.below.size() > 1) return Say("IDS_QM_GEN_JOINT_SEVERAL");
    for (const auto* posts : {&m.above, &m.below})
        for (const int post : *posts) {
            const T_PART part = PartOf(model, post);
            if (part.section && IsWallSection(*part.section)) return Say("IDS_QM_GEN_JOINT_WALL");
        }
    return m.skewed ? Say("IDS_QM_GEN_JOINT_SKEWED") : std::string();
}

/// Between the outermost bars; 0: there are no two.
double BetweenBars(const T_SECT_D& section, bool alongZ)
{
    const auto place = alongZ ? &T_REBAR::z : &T_REBAR::y;
    if (section.bars.empty()) return 0.0;
    const auto [low, high] = std::ranges::minmax_element(section.bars, {}, place);
    return (*high).*place - (*low).*place;
}

/// Width that carries shear: ACI 318 15.4.2.4 or EN 1998-1 5.5.3.3(2).
double WidthOf(HINGE_CODE code, double column, double beam, double hc)
{
    if (!IsChordCode(code)) return std::min(column, beam + hc);
    return column > beam ? std::min(column, beam + 0.5 * hc) : std::min(beam, column + 0.5 * hc);
}

/// EN 1998-1 5.5.3.3(2): diagonal compression over the depth between the outermost bars.
std::optional<double> EnJointStrength(const T_JOINT& j, double axial, CCodeSheet& sheet)
{
    constexpr const char* kClause = "EN 1998-1 5.5.3.3";
    constexpr auto R = CODE_MARK::Recalled;
    const double eta = sheet.Put("eta", 0.6 * (1.0 - j.fc / kPascalsPerMpa / 250.0), kClause,
                                 "0.6 (1 - fc/250)", R);
    const double nu =
        sheet.Put("nu_d", std::max(0.0, axial) / (j.columnArea * j.fcd), kClause, "N/(Ac fcd)", R);
    if (!sheet.Positive({{"eta", eta}}) || !sheet.Within("axial", nu, 0.0, eta)) return {};
    const bool interior = j.kind == JOINT_KIND::Interior || j.kind == JOINT_KIND::InteriorWithBeams;
    const double share = sheet.Put("share", interior ? 1.0 : 0.8, kClause, "exterior 0.8", R);
    return sheet.Put("Vj,R", share * eta * j.fcd * std::sqrt(1.0 - nu / eta) * j.width * j.hjc,
                     kDimForce, kClause, "eta fcd sqrt(1 - nu_d/eta) bj hjc", R);
}

bool Asce(const T_JOINT& j, const T_JOINT_DEMAND& d, T_JOINT_CHECK& out, CCodeSheet& sheet)
{
    T_ASCE_JOINT in;
    in.kind = j.kind;
    in.hc = j.hc;
    in.fc = j.lower;
    in.Ag = j.columnArea;
    in.area = j.width * j.hc;
    in.axial = d.axial;
    in.shear = out.shear;
    const std::optional<double> strength = AsceJointStrength(in, sheet);
    if (!strength) return false;
    out.capacity = *strength;
    in.fc = j.fc;
    CCodeSheet expected; // the table's own strength is the expected one
    out.rotations = AsceJoint(in, expected);
    return true;
}

bool Circolare(const T_JOINT& j, const T_JOINT_DEMAND& d, T_JOINT_CHECK& out, CCodeSheet& sheet)
{
    const auto s = CircolareJoint(d.axial, out.shear, j.width * j.hjc, j.fcd, sheet);
    if (!s) return false;
    const bool tension = s->tension / s->tensionLimit > s->compression / s->compressionLimit;
    out.demand = tension ? s->tension : s->compression;
    out.capacity = tension ? s->tensionLimit : s->compressionLimit;
    out.dim = kDimStress;
    return true;
}

} // namespace

T_NODE_BEAMS BeamsByNode(const T_MODEL& model)
{
    T_NODE_BEAMS out;
    for (const auto& [id, e] : model.elements) {
        if (e.kind != ELEM_KIND::Beam) continue;
        out[e.nodeI].push_back(id);
        if (e.nodeJ != e.nodeI) out[e.nodeJ].push_back(id);
    }
    return out;
}

std::vector<T_VECTOR> JointPlanes(const T_MODEL& model, std::span<const int> around, int node)
{
    const std::size_t up = VerticalAxis(model);
    const std::size_t first = up == 0 ? 1 : 0;
    std::vector<T_VECTOR> planes;
    for (const int id : around) {
        const auto way = WayFrom(model, model.elements.at(id), node);
        if (!way || std::fabs((*way)[up]) > kSteep) continue;
        T_VECTOR plan = PlanOf(*way, up);
        const auto size = [](double a, double b) { return std::fabs(a) < std::fabs(b); };
        if (*std::ranges::max_element(plan, size) < 0.0)
            for (double& p : plan)
                p = 0.0 - p;
        if (std::ranges::none_of(planes, [&](const T_VECTOR& other) {
                return std::fabs(Dot(other, plan)) > kInLine;
            }))
            planes.push_back(plan);
    }
    std::ranges::stable_sort(planes, {},
                             [first](const T_VECTOR& v) { return -std::fabs(v[first]); });
    return planes;
}

T_JOINT_MEMBERS MembersOfJoint(const T_MODEL& model, std::span<const int> beams, int node,
                               const T_VECTOR& along)
{
    const T_MEETING m = MeetingAt(model, beams, node, along);
    if (!m.IsJoint()) return {};
    return {m.Above(), m.Column(), m.Beams()};
}

int ReadJoint(const T_MODEL& model, std::span<const int> around, int node, const T_VECTOR& along,
              HINGE_CODE code, T_JOINT& out, std::string& reason)
{
    const T_MEETING m = MeetingAt(model, around, node, along);
    if (std::string fault = FaultOf(model, m); !fault.empty())
        return Fail(reason, std::move(fault));
    const int column = m.Column();
    const std::vector<int> beams = m.Beams();
    const T_PART post = PartOf(model, column);
    if (!post.section) return Fail(reason, Say("IDS_QM_GEN_JOINT_CONCRETE"));
    CCodeSheet sheet;
    const auto material = RcMaterial(*post.material, code, sheet);
    if (!material) return Fail(reason, ReasonOf(sheet));
    T_JOINT j;
    j.code = code;
    j.node = node;
    j.column = column;
    j.beams = beams;
    j.kind = KindOf(m);
    j.fc = j.fcd = material->fc;
    j.lower = post.material->fck > 0.0 ? post.material->fck : material->fc;
    j.columnArea = post.section->size[0] * post.section->size[1];
    const auto alongZ = IsAlongZ(model.elements.at(column), along, VerticalAxis(model));
    if (!alongZ) return Fail(reason, Say("IDS_QM_GEN_JOINT_TURNED"));
    j.hc = post.section->size[*alongZ ? 0 : 1];
    j.hjc = BetweenBars(*post.section, *alongZ);
    double widest = 0.0;
    for (const int beam : beams) {
        const T_PART part = PartOf(model, beam);
        if (!part.section) return Fail(reason, Say("IDS_QM_GEN_JOINT_CONCRETE"));
        for (const bool positive : {true, false}) {
            CCodeSheet side;
            const auto bending = RcBending(*part.section, true, positive, side);
            if (!bending) return Fail(reason, ReasonOf(side));
            const double lever = 0.9 * bending->d;
            j.lever = j.lever > 0.0 ? std::min(j.lever, lever) : lever;
        }
        widest = std::max(widest, part.section->size[1]);
    }
    j.width = WidthOf(code, j.columnArea / j.hc, widest, j.hc);
    j.trace = sheet.Trace();
    out = std::move(j);
    return 1;
}

int CheckJoint(const T_JOINT& joint, const T_JOINT_DEMAND& demand, T_JOINT_CHECK& out,
               std::string& reason)
{
    CCodeSheet sheet;
    sheet.Positive({{"lever", joint.lever}, {"hc", joint.hc}, {"width", joint.width}});
    sheet.Positive({{"fc", joint.fc}, {"columnArea", joint.columnArea}});
    sheet.Finite({{"beam moments", demand.beamMoments}, {"column shear", demand.columnShear}});
    if (!sheet.Finite({{"axial", demand.axial}})) return Fail(reason, ReasonOf(sheet));
    T_JOINT_CHECK check;
    sheet.Put("z", joint.lever, kDimLength, "", "0.9 d of the beams", K);
    const bool bars = IsChordCode(joint.code);
    if (bars) sheet.Positive({{"hjc", joint.hjc}});
    sheet.Put(bars ? "bj hjc" : "bj hc", joint.width * (bars ? joint.hjc : joint.hc), T_DIM{0, 2},
              "", bars ? "hjc: between the outermost bars of the column" : "", K);
    sheet.Put("N", demand.axial, kDimForce, "", "of the column above", K);
    check.shear = sheet.Put("Vj", std::fabs(demand.beamMoments / joint.lever - demand.columnShear),
                            kDimForce, "", "sum M/z - V of the column", K);
    check.demand = check.shear;
    check.dim = kDimForce;
    bool done = true;
    if (joint.code == HINGE_CODE::Circolare2019) {
        done = Circolare(joint, demand, check, sheet);
    } else if (joint.code == HINGE_CODE::En1998) {
        const auto strength = EnJointStrength(joint, demand.axial, sheet);
        done = strength.has_value();
        check.capacity = strength.value_or(0.0);
    } else {
        done = Asce(joint, demand, check, sheet);
    }
    if (!done || !sheet.Sound()) return Fail(reason, ReasonOf(sheet));
    sheet.Warn("IDS_QM_GEN_WARN_JOINT_HOOPS", {});
    if (IsChordCode(joint.code) && joint.kind == JOINT_KIND::InteriorWithBeams)
        sheet.Warn("IDS_QM_GEN_WARN_JOINT_CONFINED", {});
    check.trace = joint.trace;
    check.trace.insert(check.trace.end(), sheet.Trace().begin(), sheet.Trace().end());
    check.warnings = sheet.Warnings();
    out = std::move(check);
    return 1;
}
