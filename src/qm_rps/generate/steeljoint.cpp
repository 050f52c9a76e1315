#include "qm_rps/generate/steeljoint.h"

#include "qm_base/say.h"
#include "qm_db/sectionproperties.h"
#include "qm_rps/generate/steelmember.h"
#include "qm_rps/push/pushstoreys.h"

#include <algorithm>
#include <cmath>
#include <numeric>

namespace {

using T_VECTOR = std::array<double, 3>;
const double kAlong = std::sqrt(0.5); // cosine: within 45 degrees

double Dot(const T_VECTOR& a, const T_VECTOR& b)
{
    return std::inner_product(a.begin(), a.end(), b.begin(), 0.0);
}

/// A steel I of the frame that ends at a node.
struct T_NEIGHBOUR {
    T_VECTOR axis{}, depth{}; // unit vectors: from I to J, local z
    double length = 0.0;
    bool held = true; // it holds a moment about y there
    T_SECT_D section; // with its properties
    double fy = 0.0;  // expected
};

/// Unit length; of the part normal to `normal` where that is not zero.
T_VECTOR Unit(T_VECTOR v, const T_VECTOR& normal = {})
{
    const double along = Dot(v, normal);
    for (std::size_t i = 0; i < v.size(); ++i)
        v[i] -= along * normal[i];
    const double size = std::sqrt(Dot(v, v));
    for (double& component : v)
        component = size > 0.0 ? component / size : 0.0;
    return v;
}

std::optional<T_NEIGHBOUR> NeighbourOf(const T_MODEL& model, const T_ELEM_D& e, int node)
{
    if (e.kind != ELEM_KIND::Beam || (e.nodeI != node && e.nodeJ != node)) return {};
    const auto section = model.sections.find(e.section);
    const auto material = model.materials.find(e.material);
    if (section == model.sections.end() || material == model.materials.end()) return {};
    if (section->second.shape != SECT_SHAPE::IShape) return {};
    T_NEIGHBOUR n;
    SECT_FAULT fault = SECT_FAULT::None;
    if (!CSectionProperties::Calc(section->second, n.section, fault)) return {};
    T_VECTOR way{};
    for (std::size_t i = 0; i < way.size(); ++i)
        way[i] = model.nodes.at(e.nodeJ).xyz[i] - model.nodes.at(e.nodeI).xyz[i];
    n.length = std::sqrt(Dot(way, way));
    n.axis = Unit(way);
    const bool vertical = std::hypot(n.axis[0], n.axis[1]) < 1e-6;
    const T_VECTOR usual = vertical ? T_VECTOR{1.0, 0.0, 0.0} : T_VECTOR{0.0, 0.0, 1.0};
    n.depth = Unit(e.zAxis != T_VECTOR{} ? e.zAxis : usual, n.axis);
    const auto& release = e.nodeI == node ? e.release.I : e.release.J;
    n.held = !release[static_cast<std::size_t>(HINGE_COMPONENT::My)];
    T_MEMBER_END end; // the strength that hinges have
    end.section = n.section;
    end.material = material->second;
    end.clear = n.length;
    CCodeSheet sheet;
    const std::optional<T_STEEL_BASIS> basis = SteelBasis(end, sheet);
    if (!basis) return {};
    n.fy = basis->fy;
    return n;
}

/// The weaker column's plates, the mean length of the columns.
void AddColumn(const T_NEIGHBOUR& n, int& count, T_STEEL_JOINT& joint)
{
    const auto& [depth, width, web, flange] = n.section.size;
    const bool first = count++ == 0;
    joint.storey += (n.length - joint.storey) / count;
    joint.columnFlange = first ? flange : std::min(joint.columnFlange, flange);
    if (!first && depth * web * n.fy >= joint.columnDepth * joint.columnWeb * joint.columnFye)
        return;
    joint.columnDepth = depth;
    joint.columnWeb = web;
    joint.columnFye = n.fy;
    joint.columnArea = n.section.area;
}

std::optional<T_STEEL_JOINT> JointAt(const T_MODEL& model, int node, const T_VECTOR& beam)
{
    std::vector<T_NEIGHBOUR> neighbours;
    for (const auto& [id, e] : model.elements)
        if (auto n = NeighbourOf(model, e, node)) neighbours.push_back(std::move(*n));
    T_STEEL_JOINT joint;
    int columns = 0;
    const std::size_t up = VerticalAxis(model);
    for (const T_NEIGHBOUR& n : neighbours)
        if (std::fabs(n.axis[up]) > kAlong && std::fabs(Dot(n.depth, beam)) > kAlong)
            AddColumn(n, columns, joint);
    for (const T_NEIGHBOUR& n : neighbours)
        if (n.held && std::fabs(Dot(n.axis, beam)) > kAlong && n.length > joint.columnDepth)
            joint.beams += n.section.Zy * n.fy * n.length / (n.length - joint.columnDepth);
    return columns > 0 ? std::optional(joint) : std::nullopt;
}

} // namespace

int ReadPanelZone(const T_MODEL& model, int node, const std::array<double, 3>& along,
                  std::span<const int> beams, T_PANEL_ZONE& out, std::string& reason)
{
    const std::optional<T_STEEL_JOINT> joint = JointAt(model, node, along);
    if (!joint) {
        reason = Say("IDS_QM_JUDGE_PANEL_COLUMN");
        return 0;
    }
    T_PANEL_ZONE zone{*joint, 0.0};
    for (const int id : beams) {
        const auto beam = NeighbourOf(model, model.elements.at(id), node);
        if (!beam) {
            reason = Say("IDS_QM_JUDGE_PANEL_BEAM", std::to_string(id));
            return 0;
        }
        const double depth = beam->section.size[0];
        zone.depth = zone.depth > 0.0 ? std::min(zone.depth, depth) : depth;
    }
    out = zone;
    return 1;
}

int ReadSteelJoints(const T_MODEL& model, const T_STEEL_CONNECTION& asked, T_HINGE_MEMBER& member,
                    std::string& reason)
{
    member.joints.reset();
    if (member.kind != MEMBER_KIND::Beam ||
        model.materials.at(member.material).type != MATL_CLASS::Steel)
        return 1;
    T_ENDS<T_STEEL_JOINT> joints;
    if (asked.columnFlange > 0.0 && asked.panelRatio > 0.0) {
        member.joints = joints;
        return 1;
    }
    const T_ELEM_D& e = model.elements.at(member.element);
    T_VECTOR axis{};
    for (std::size_t i = 0; i < axis.size(); ++i)
        axis[i] = model.nodes.at(e.nodeJ).xyz[i] - model.nodes.at(e.nodeI).xyz[i];
    axis = Unit(axis);
    const auto bending = static_cast<std::size_t>(member.bending.front());
    const bool atI = !e.release.I[bending], atJ = !e.release.J[bending];
    for (const bool first : {true, false}) {
        if (!(first ? atI : atJ)) continue;
        const int node = first ? e.nodeI : e.nodeJ;
        const std::optional<T_STEEL_JOINT> joint = JointAt(model, node, axis);
        if (!joint) {
            reason = Say("IDS_QM_GEN_NO_STEEL_COLUMN", std::to_string(node));
            return 0;
        }
        (first ? joints.I : joints.J) = *joint;
    }
    if (!atI) joints.I = joints.J; // a released end has no hinge
    if (!atJ) joints.J = joints.I;
    member.joints = joints;
    return 1;
}
