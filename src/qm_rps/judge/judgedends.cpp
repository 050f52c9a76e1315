#include "qm_rps/judge/judgement.h"

#include "qm_base/say.h"
#include "qm_rps/push/pushstoreys.h"

#include <algorithm>

namespace {

/// The generated hinge type of an element.
const T_PHGT_D* GeneratedType(const T_MODEL& model, int element)
{
    for (const auto& entry : model.hinges) {
        if (entry.second.element != element) continue;
        const auto type = model.hingeTypes.find(entry.second.hingeType);
        if (type != model.hingeTypes.end() && type->second.generated) return &type->second;
    }
    return nullptr;
}

std::optional<HINGE_CODE> CodeNamed(const std::string& name)
{
    const auto at = std::ranges::find(kHingeCodeNames, name);
    if (at == kHingeCodeNames.end()) return {};
    return static_cast<HINGE_CODE>(at - kHingeCodeNames.begin());
}

/// The lowest storey that the element does not rise above; empty: none.
std::string StoreyOf(const T_MODEL& model, const T_ELEM_D& e, const T_PUSH_RUN& run)
{
    constexpr double kSame = 0.01; // of the height of the storey
    const std::size_t vertical = VerticalAxis(model);
    const double top =
        std::max(model.nodes.at(e.nodeI).xyz[vertical], model.nodes.at(e.nodeJ).xyz[vertical]);
    const auto at = std::ranges::find_if(run.storeys, [&](const T_PUSH_STOREY_SERIES& s) {
        return top <= s.elevation + kSame * s.height;
    });
    return at == run.storeys.end() ? std::string() : at->name;
}

/// The ends of one element.
class CEndsOf {
public:
    CEndsOf(const T_MODEL& model, const T_PUSH_RUN& run, const T_JUDGE_OPTIONS& options,
            std::vector<T_JUDGED_END>& out)
        : m_model(model), m_run(run), m_options(options), m_out(out)
    {
    }

    void Add(int id, const T_ELEM_D& element)
    {
        m_first = m_out.size();
        m_any = {};
        m_any.place.element = id;
        m_any.storey = StoreyOf(m_model, element, m_run);
        const std::optional<T_MEMBER_AXES> axes = AxesOf(m_model, element);
        if (axes) m_any.axes = *axes;
        std::optional<HINGE_CODE> code = m_options.code;
        bool secondary = m_options.secondary;
        const T_PHGT_D* const type = GeneratedType(m_model, id);
        if (!code && type) {
            code = CodeNamed(type->generated->code);
            secondary = type->generated->secondary;
        }
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
        m_any.column = IsUpright(member.kind);
        for (const HINGE_COMPONENT component : member.bending)
            for (const bool atJ : {false, true}) {
                const auto at = static_cast<std::size_t>(component);
                T_JUDGED_END end = EndAt(component, atJ);
                if ((atJ ? member.release.J : member.release.I)[at]) {
                    end.why = Say("IDS_QM_PUSH_HINGE_RELEASED");
                } else {
                    end.basis = JUDGE_BASIS::Code;
                    end.member = EndOf(m_model, member, {code, secondary}, component, !atJ, 0.0);
                    // Plastic rotations are those of a hinge: without one the demand is not known.
                    if (!IsChordCode(code) && end.hinge < 0) {
                        end.basis = JUDGE_BASIS::Nothing;
                        end.why = Say("IDS_QM_JUDGE_NO_HINGE");
                    }
                }
                m_out.push_back(std::move(end));
            }
    }

    void AddByCriteria()
    {
        m_any.why = Say("IDS_QM_JUDGE_NO_DATA");
        for (const HINGE_COMPONENT component : {HINGE_COMPONENT::My, HINGE_COMPONENT::Mz})
            for (const bool atJ : {false, true}) {
                T_JUDGED_END end = EndAt(component, atJ);
                if (end.hinge < 0) continue;
                const T_PUSH_HINGE_SERIES& hinge =
                    m_run.hinges[static_cast<std::size_t>(end.hinge)];
                if (hinge.place.criteria) {
                    end.basis = JUDGE_BASIS::Criteria;
                    end.marks = {hinge.law.positive.marks, hinge.law.negative.marks};
                } else {
                    end.why = Say("IDS_QM_JUDGE_NO_CRITERIA");
                }
                m_out.push_back(std::move(end));
            }
    }

    void AddNothing()
    {
        T_HINGE_MEMBER member;
        std::string ignored;
        HINGE_COMPONENT component = HINGE_COMPONENT::My;
        if (ReadMember(m_model, m_any.place.element, CInitialAxial(), member, ignored)) {
            m_any.column = IsUpright(member.kind);
            component = member.bending.front();
        }
        for (const bool atJ : {false, true})
            m_out.push_back(EndAt(component, atJ));
    }

    T_JUDGED_END EndAt(HINGE_COMPONENT component, bool atJ) const
    {
        T_JUDGED_END end = m_any;
        end.place.component = component;
        end.place.atJ = atJ;
        const auto at = std::ranges::find_if(m_run.hinges, [&](const T_PUSH_HINGE_SERIES& h) {
            return h.place.element == end.place.element && h.place.component == component &&
                   h.place.end == (atJ ? "J" : "I");
        });
        if (at == m_run.hinges.end()) return end;
        end.hinge = at - m_run.hinges.begin();
        end.spring = at->law.stiffness;
        return end;
    }

    const T_MODEL& m_model;
    const T_PUSH_RUN& m_run;
    const T_JUDGE_OPTIONS& m_options;
    std::vector<T_JUDGED_END>& m_out;
    std::size_t m_first = 0;
    T_JUDGED_END m_any; // what the ends of the element share
};

} // namespace

std::vector<T_JUDGED_END> JudgedEnds(const T_MODEL& model, const T_PUSH_RUN& run,
                                     const T_JUDGE_OPTIONS& options)
{
    std::vector<T_JUDGED_END> out;
    CEndsOf ends(model, run, options, out);
    for (const auto& [id, element] : model.elements)
        if (element.kind == ELEM_KIND::Beam) ends.Add(id, element);
    return out;
}
