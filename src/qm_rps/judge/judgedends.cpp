#include "qm_rps/judge/judgement.h"

#include "qm_base/say.h"
#include "qm_rps/generate/steeljoint.h"
#include "qm_rps/judge/hingelookup.h"
#include "qm_rps/judge/vectors.h"
#include "qm_rps/push/pushstoreys.h"

#include <algorithm>
#include <cmath>
#include <map>

namespace {

/// The lowest storey that does not end below a height; empty: none.
std::string StoreyAt(const T_PUSH_RUN& run, double top)
{
    constexpr double kSame = 0.01; // of the height of the storey
    const auto at = std::ranges::find_if(run.storeys, [&](const T_PUSH_STOREY_SERIES& s) {
        return top <= s.elevation + kSame * s.height;
    });
    return at == run.storeys.end() ? std::string() : at->name;
}

void PutHinge(const CHingeLookup& lookup, const char* place, T_JUDGED_END& end)
{
    end.hinge = lookup.Hinge(end.place.element, end.place.component, place);
    if (end.hinge >= 0)
        end.spring = lookup.run.hinges[static_cast<std::size_t>(end.hinge)].law.stiffness;
}

/// The criteria of the hinge's type, or why there are none.
void PutCriteria(const CHingeLookup& lookup, T_JUDGED_END& end)
{
    const T_PUSH_HINGE_SERIES& hinge = lookup.run.hinges[static_cast<std::size_t>(end.hinge)];
    if (!hinge.place.criteria) {
        end.why = Say("IDS_QM_JUDGE_NO_CRITERIA");
        return;
    }
    end.basis = JUDGE_BASIS::Criteria;
    end.marks = {hinge.law.positive.marks, hinge.law.negative.marks};
}

/// The ends of one element.
class CEndsOf {
public:
    CEndsOf(const CHingeLookup& lookup, const T_JUDGE_OPTIONS& options,
            std::vector<T_JUDGED_END>& out)
        : m_lookup(lookup), m_model(lookup.model), m_options(options), m_out(out),
          m_codeOfModel(lookup.CodeOfModel())
    {
    }

    void Add(int id, const T_ELEM_D& element)
    {
        m_first = m_out.size();
        m_any = {};
        m_tie = 0.0;
        m_connection = {};
        m_any.place.element = id;
        const std::size_t up = VerticalAxis(m_model);
        const int other = element.kind == ELEM_KIND::Spring ? element.nodeI : element.nodeJ;
        m_any.storey = StoreyAt(m_lookup.run, std::max(m_model.nodes.at(element.nodeI).xyz[up],
                                                       m_model.nodes.at(other).xyz[up]));
        if (element.kind == ELEM_KIND::Link || element.kind == ELEM_KIND::Spring)
            return AddSpring();
        const std::optional<T_MEMBER_AXES> axes = AxesOf(m_model, element);
        if (axes) m_any.axes = *axes;
        std::optional<HINGE_CODE> code = m_options.code;
        bool secondary = m_options.secondary;
        const T_PHGT_D* const type = m_lookup.GeneratedType(id);
        if (type) m_connection = type->generated->connection;
        if (!code && type) {
            code = HingeCodeNamed(type->generated->code);
            secondary = type->generated->secondary;
            m_tie = type->generated->tie;
        }
        if (!code && !m_lookup.HasHinge(id)) code = m_codeOfModel;
        if (element.kind == ELEM_KIND::Truss) return AddBrace(axes.has_value(), code, secondary);
        if (!axes)
            m_any.why = Say("IDS_QM_GEN_CLEAR");
        else if (code)
            AddByCode(*code, secondary);
        else
            AddByCriteria();
        if (m_out.size() == m_first) AddNothing();
    }

private:
    void AddByCode(HINGE_CODE code, bool secondary)
    {
        T_HINGE_MEMBER member;
        if (!ReadMember(m_model, m_any.place.element, CInitialAxial(), member, m_any.why)) return;
        if (member.kind == MEMBER_KIND::Brace) return AddBrace(true, code, secondary);
        if (code == HINGE_CODE::Asce17 && m_connection &&
            !ReadSteelJoints(m_model, *m_connection, member, m_any.why))
            return;
        m_any.column = IsUpright(member.kind);
        for (const HINGE_COMPONENT component : member.bending)
            for (const bool atJ : {false, true}) {
                const auto at = static_cast<std::size_t>(component);
                T_JUDGED_END end = EndAt(component, atJ);
                if ((atJ ? member.release.J : member.release.I)[at]) {
                    end.why = Say("IDS_QM_PUSH_HINGE_RELEASED");
                } else {
                    end.basis = JUDGE_BASIS::Code;
                    T_CODE_OPTIONS options{code, secondary, m_tie};
                    if (code == HINGE_CODE::Asce17) options.connection = m_connection;
                    end.member = EndOf(m_model, member, options, component, !atJ, 0.0);
                    end.shearHinge =
                        m_lookup.Hinge(m_any.place.element,
                                       component == HINGE_COMPONENT::My ? HINGE_COMPONENT::Fz
                                                                        : HINGE_COMPONENT::Fy,
                                       "C") >= 0;
                }
                m_out.push_back(std::move(end));
            }
    }

    /// About the axes that have a hinge at either end.
    void AddByCriteria()
    {
        m_any.why = Say("IDS_QM_JUDGE_NO_DATA");
        for (const HINGE_COMPONENT component : {HINGE_COMPONENT::My, HINGE_COMPONENT::Mz}) {
            std::array<T_JUDGED_END, 2> ends{EndAt(component, false), EndAt(component, true)};
            if (ends[0].hinge < 0 && ends[1].hinge < 0) continue;
            const auto& release = m_model.elements.at(m_any.place.element).release;
            for (T_JUDGED_END& end : ends) {
                const T_DIRS6& free = end.place.atJ ? release.J : release.I;
                if (end.hinge >= 0)
                    PutCriteria(m_lookup, end);
                else
                    end.why =
                        Say(free[static_cast<std::size_t>(component)] ? "IDS_QM_PUSH_HINGE_RELEASED"
                                                                      : "IDS_QM_JUDGE_NO_HINGE");
                m_out.push_back(std::move(end));
            }
        }
    }

    void AddSpring()
    {
        m_any.kind = JUDGED_KIND::Spring;
        m_any.why = Say("IDS_QM_JUDGE_SPRING");
        m_out.push_back(m_any);
    }

    /// A brace of steel by a code, else any truss by the criteria of its hinge; without either a
    /// row that says so.
    void AddBrace(bool hasAxes, std::optional<HINGE_CODE> code, bool secondary)
    {
        T_JUDGED_END end = m_any;
        end.kind = JUDGED_KIND::Brace;
        end.place.component = HINGE_COMPONENT::Fx;
        PutHinge(m_lookup, "C", end);
        T_HINGE_MEMBER member;
        const int id = end.place.element;
        const bool isRead = ReadMember(m_model, id, CInitialAxial(), member, end.why) != 0;
        const auto material = m_model.materials.find(m_model.elements.at(id).material);
        if (code && material != m_model.materials.end() &&
            material->second.type == MATL_CLASS::Steel) {
            if (!hasAxes) end.why = Say("IDS_QM_GEN_CLEAR");
            if (isRead && hasAxes && !IsChordCode(*code) && end.hinge < 0)
                end.why = Say("IDS_QM_JUDGE_NO_HINGE");
            if (end.why.empty()) {
                end.basis = JUDGE_BASIS::Code;
                end.member =
                    EndOf(m_model, member, {*code, secondary}, HINGE_COMPONENT::My, true, 0.0);
            }
        } else if (end.hinge >= 0) {
            PutCriteria(m_lookup, end);
        } else {
            end.why = Say(code ? "IDS_QM_JUDGE_TRUSS" : "IDS_QM_JUDGE_NO_DATA");
        }
        m_out.push_back(std::move(end));
    }

    void AddNothing()
    {
        T_HINGE_MEMBER member;
        std::string ignored;
        HINGE_COMPONENT component = HINGE_COMPONENT::My;
        if (ReadMember(m_model, m_any.place.element, CInitialAxial(), member, ignored)) {
            if (member.kind == MEMBER_KIND::Brace) return AddBrace(true, {}, false);
            m_any.column = IsUpright(member.kind);
            if (!member.bending.empty()) component = member.bending.front();
        }
        for (const bool atJ : {false, true})
            m_out.push_back(EndAt(component, atJ));
    }

    T_JUDGED_END EndAt(HINGE_COMPONENT component, bool atJ) const
    {
        T_JUDGED_END end = m_any;
        end.place.component = component;
        end.place.atJ = atJ;
        PutHinge(m_lookup, atJ ? "J" : "I", end);
        return end;
    }

    const CHingeLookup& m_lookup;
    const T_MODEL& m_model;
    const T_JUDGE_OPTIONS& m_options;
    std::vector<T_JUDGED_END>& m_out;
    std::size_t m_first = 0;
    T_JUDGED_END m_any;                             // what the ends of the element share
    double m_tie = 0.0;                             // of spandrels, as their hinges were generated
    std::optional<T_STEEL_CONNECTION> m_connection; // of beams, as their hinges were generated
    std::optional<HINGE_CODE> m_codeOfModel;        // of members without hinges
};

/// The joints of frames: where a column and a beam meet, but for those of masonry and on the
/// ground.
class CJoints {
public:
    CJoints(const CHingeLookup& lookup, const T_JUDGE_OPTIONS& options,
            std::vector<T_JUDGED_END>& out)
        : m_lookup(lookup), m_model(lookup.model), m_options(options), m_out(out)
    {
    }
    void Add(int node, std::span<const int> around)
    {
        for (const T_VECTOR& along : JointPlanes(m_model, around, node))
            if (!IsHeld(node, along)) AddAlong(node, along, around);
    }

private:
    /// In all axes that the direction has a part of.
    bool IsHeld(int node, const T_VECTOR& along) const
    {
        constexpr double kPart = 0.0872; // sine of five degrees
        for (std::size_t i = 0; i < along.size(); ++i)
            if (std::fabs(along[i]) > kPart && !m_model.nodes.at(node).restraint[i]) return false;
        return true;
    }

    void AddAlong(int node, const T_VECTOR& along, std::span<const int> around)
    {
        const T_JOINT_MEMBERS members = MembersOfJoint(m_model, around, node, along);
        if (members.column == 0) return;
        const auto material = m_model.materials.find(m_model.elements.at(members.column).material);
        const bool isKnown = material != m_model.materials.end();
        if (isKnown && material->second.type == MATL_CLASS::Masonry) return;
        T_JUDGED_END end;
        end.kind = JUDGED_KIND::Joint;
        end.place.element = members.column;
        const std::size_t up = VerticalAxis(m_model);
        end.storey = StoreyAt(m_lookup.run, m_model.nodes.at(node).xyz[up]);
        if (isKnown) end.member.material = material->second;
        auto joint = std::make_shared<T_JUDGED_JOINT>();
        joint->node = node;
        joint->forth = along;
        joint->up[up] = 1.0;
        joint->axis = PlaneName(along, up);
        std::optional<HINGE_CODE> code = m_options.code ? m_options.code : CodeOf(members);
        const bool hasParts = Place(members, *joint);
        if (!code)
            end.why = Say("IDS_QM_JUDGE_NO_DATA");
        else if (!hasParts)
            end.why = Say("IDS_QM_GEN_CLEAR");
        else if (isKnown && material->second.type == MATL_CLASS::Steel)
            AddPanel(node, *code, members, *joint, end);
        else if (ReadJoint(m_model, around, node, along, *code, joint->joint, end.why) != 0)
            end.basis = JUDGE_BASIS::Code;
        end.joint = std::move(joint);
        m_out.push_back(std::move(end));
    }

    /// A panel zone of steel, which ASCE 41 and FEMA 356 have a strength for.
    void AddPanel(int node, HINGE_CODE code, const T_JOINT_MEMBERS& members, T_JUDGED_JOINT& joint,
                  T_JUDGED_END& end) const
    {
        if (IsChordCode(code)) {
            end.why = Say("IDS_QM_JUDGE_PANEL_ZONE");
            return;
        }
        T_PANEL_ZONE zone;
        if (!ReadPanelZone(m_model, node, joint.forth, members.beams, zone, end.why)) return;
        joint.joint.code = code;
        joint.panel = zone;
        end.basis = JUDGE_BASIS::Code;
    }

    /// That of the column, else of the first beam that has one.
    std::optional<HINGE_CODE> CodeOf(const T_JOINT_MEMBERS& members) const
    {
        std::vector<int> order{members.column, members.above};
        order.insert(order.end(), members.beams.begin(), members.beams.end());
        for (const int element : order)
            if (const auto code = m_lookup.CodeOf(element)) return code;
        return {};
    }

    /// Ends and axes of the members; false: one has no length.
    bool Place(const T_JOINT_MEMBERS& members, T_JUDGED_JOINT& joint) const
    {
        const auto part = [&](int element) -> std::optional<T_JUDGED_JOINT::T_PART> {
            const T_ELEM_D& e = m_model.elements.at(element);
            const auto axes = AxesOf(m_model, e);
            if (!axes) return {};
            return T_JUDGED_JOINT::T_PART{element, e.nodeJ == joint.node, *axes};
        };
        for (const int beam : members.beams) {
            const auto placed = part(beam);
            if (!placed) return false;
            joint.beams.push_back(*placed);
        }
        if (members.above == 0) return true;
        joint.above = part(members.above);
        return joint.above.has_value();
    }

    const CHingeLookup& m_lookup;
    const T_MODEL& m_model;
    const T_JUDGE_OPTIONS& m_options;
    std::vector<T_JUDGED_END>& m_out;
};

} // namespace

std::optional<HINGE_CODE> HingeCodeNamed(const std::string& name)
{
    const auto at = std::ranges::find(kHingeCodeNames, name);
    if (at == kHingeCodeNames.end()) return {};
    return static_cast<HINGE_CODE>(at - kHingeCodeNames.begin());
}

std::vector<std::string> JudgedCodeNames()
{
    std::vector<std::string> names(kHingeCodeNames.begin(), kHingeCodeNames.end());
    std::erase(names, kHingeCodeNames[static_cast<std::size_t>(HINGE_CODE::Aisc342)]);
    return names;
}

std::vector<T_JUDGED_END> JudgedEnds(const T_MODEL& model, const T_PUSH_RUN& run,
                                     const T_JUDGE_OPTIONS& options)
{
    std::vector<T_JUDGED_END> out;
    const CHingeLookup lookup(model, run);
    CEndsOf ends(lookup, options, out);
    for (const auto& [id, element] : model.elements)
        ends.Add(id, element);
    CJoints joints(lookup, options, out);
    for (const auto& [node, around] : BeamsByNode(model))
        joints.Add(node, around);
    return out;
}

T_END_STATE StateOf(const T_JUDGED_END& end, const T_STEP_FORCES& step)
{
    if (end.joint)
        return end.basis == JUDGE_BASIS::Nothing ? T_END_STATE{} : JointState(*end.joint, step);
    return end.axes.length > 0.0 ? EndState(end.place, end.axes, end.hinge, step) : T_END_STATE{};
}
