#include "qm_rps/po_hingetypedlg.h"

#include "qm_rps/hinge/hingetypefindings.h"
#include "qm_rps/po_hingealphayspandlg.h"
#include "qm_rps/po_hingeintegrationpointdlg.h"
#include "qm_rps/po_hingelengthmphidlg.h"
#include "qm_rps/po_hingelengthmthetadlg.h"
#include "qm_rps/po_hingemasonrydlg.h"
#include "qm_rps/po_hingeskcvtabdlg.h"
#include "qm_rps/po_hingeskcvtabeurodlg.h"
#include "qm_rps/po_hingeskcvtabfemadlg.h"
#include "qm_rps/po_hingeyieldpropdlgnew.h"
#include "qm_rps/pushoverpmminteractiondlg.h"

#include <algorithm>

namespace {

using ENTRY = T_SKCV_ENTRY;

int Position(const std::vector<ENTRY>& list, SKEL_TYPE code)
{
    for (std::size_t i = 0; i < list.size(); ++i)
        if (list[i].code == code) return static_cast<int>(i);
    return -1;
}

/// An empty curve, a multilinear one with the default ratios of the model.
T_SKEL_CURVE FreshCurve(SKEL_TYPE type, const T_HINGE_CONTEXT& context)
{
    T_SKEL_CURVE curve = MakeSkelCurve(type);
    if (auto* m = std::get_if<T_SKEL_MULTI>(&curve)) {
        m->sides.pos.alpha1 = context.alpha1.pos, m->sides.neg.alpha1 = context.alpha1.neg;
        m->sides.pos.alpha2 = context.alpha2.pos, m->sides.neg.alpha2 = context.alpha2.neg;
        m->symmetric =
            context.alpha1.pos == context.alpha1.neg && context.alpha2.pos == context.alpha2.neg;
    }
    return curve;
}

void SetType(T_HINGE_COMPONENT& c, SKEL_TYPE type, const T_HINGE_CONTEXT& context)
{
    const T_SKEL_CURVE fresh = FreshCurve(type, context);
    c.type = type;
    if (c.curves.I.index() != fresh.index()) c.curves.I = fresh;
    if (c.curves.J.index() != fresh.index()) c.curves.J = fresh;
}

/// Runs a curve editor that holds one component.
template <class DLG>
int RunEditor(DLG& dlg, const CPO_HingeTypeDlg& type, HINGE_COMPONENT c)
{
    dlg.SetView(type.View());
    dlg.m_owner = type.Owner();
    const T_HINGE_COMPONENT& in = At(type.Type(), c);
    return dlg.Data2Dlg(c, in) && dlg.DoModal();
}

/// Runs an editor that writes its record when it is accepted.
template <class DLG>
int RunOn(DLG& dlg, const CPO_HingeTypeDlg& type)
{
    dlg.SetView(type.View());
    dlg.m_owner = type.Owner();
    return dlg.DoModal() && dlg.OnOK();
}

/// A part of the type with an editor of its own.
struct T_PART_EDITOR {
    const char* prefix; // of the fields of its findings
    int (CPO_HingeTypeDlg::*open)();
};
constexpr T_PART_EDITOR kParts[] = {{"yieldSurface.", &CPO_HingeTypeDlg::OnYieldSurfaceDlgDlg},
                                    {"pmm.", &CPO_HingeTypeDlg::OnUserInteractionDlg},
                                    {"masonry.", &CPO_HingeTypeDlg::OnMasonryPropDlg}};

const T_PART_EDITOR* PartOf(const T_FINDING& f)
{
    const auto at = std::ranges::find_if(
        kParts, [&](const T_PART_EDITOR& p) { return f.field.starts_with(p.prefix); });
    return at == std::end(kParts) ? nullptr : at;
}

} // namespace

CPO_HingeTypeDlg::CPO_HingeTypeDlg(T_HINGE_CONTEXT context) : m_context(std::move(context)) {}

void CPO_HingeTypeDlg::Data2Dlg(const T_PHGT_D& data)
{
    m_type = data;
    RefillSkcv();
}

int CPO_HingeTypeDlg::Dlg2Data(T_PHGT_D& data)
{
    if (!CheckData()) return 0;
    data = m_type;
    return 1;
}

int CPO_HingeTypeDlg::OnApply()
{
    T_PHGT_D checked;
    if (!Dlg2Data(checked)) return 0;
    const std::vector<T_FINDING> warnings = HingeTypeWarnings(checked);
    if (!warnings.empty()) ShowMessage(warnings.front().messageKey, warnings.front().text);
    if (m_store && m_store(checked)) return 1;
    if (m_store) ShowMessage("IDS_QM_HINGE_NOT_STORED");
    return 0;
}

void CPO_HingeTypeDlg::OnUpdate(T_HINGE_CONTEXT context)
{
    m_context = std::move(context);
    RefillSkcv();
}

std::vector<T_FINDING> CPO_HingeTypeDlg::Findings() const
{
    std::vector<T_FINDING> out;
    if (std::ranges::find(m_otherNames, m_type.name) != m_otherNames.end())
        out.push_back(
            FindingOf({.message = "IDS_QM_UI_HINGE_NAME_TAKEN", .field = "name"}, T_RULE_PLACE{}));
    for (T_FINDING& f : HingeTypeFindings(m_type, m_context))
        out.push_back(std::move(f));
    return out;
}

std::string CPO_HingeTypeDlg::FieldOf(const T_FINDING& f)
{
    if (f.part < 0 || PartOf(f)) return f.field;
    const std::string name = kComponentNames.at(static_cast<std::size_t>(f.part));
    return name + (f.field == "type" ? ".type" : ".curve");
}

int CPO_HingeTypeDlg::OnFinding(const T_FINDING& f)
{
    if (const T_PART_EDITOR* part = PartOf(f)) return (this->*part->open)();
    if (f.part < 0) return 0;
    m_preview.ShowFirstOf(ComponentOf(f));
    return OnBtnSkcvProp(ComponentOf(f));
}

std::vector<ENTRY> CPO_HingeTypeDlg::CustomizeSkcvCmb(HINGE_COMPONENT c) const
{
    return OfferedCurves(m_type, c, m_context);
}

T_PART_STATES CPO_HingeTypeDlg::CustomizeDlgByMode() const
{
    return PartStates(m_type, m_context.altHysteresis);
}

std::vector<T_STIFFNESS_ROW> CPO_HingeTypeDlg::UpdateInitialStiffness() const
{
    return StiffnessRows(m_type, m_context, m_memberLength);
}

int CPO_HingeTypeDlg::SelectedSkcv(HINGE_COMPONENT c) const
{
    return Position(CustomizeSkcvCmb(c), At(m_type, c).type);
}

void CPO_HingeTypeDlg::OnSelChangeElement(HINGE_ELEMENT element)
{
    m_type.element = element;
    RefillSkcv();
}

void CPO_HingeTypeDlg::OnSelChangeDefinition(HINGE_DEFINITION definition)
{
    m_type.definition = definition;
    RefillSkcv();
}

void CPO_HingeTypeDlg::OnSelChangeMaterial(MATL_CLASS material)
{
    m_type.material = material;
    RefillSkcv();
}

void CPO_HingeTypeDlg::OnComponentCtrl(HINGE_COMPONENT c, bool active)
{
    At(m_type, c).active = active;
}

void CPO_HingeTypeDlg::OnLocationCtrl(HINGE_COMPONENT c, HINGE_LOCATION location)
{
    At(m_type, c).location = location;
}

void CPO_HingeTypeDlg::OnIJSymmetryRdo(HINGE_COMPONENT c, bool sameEnds)
{
    if (At(m_type, c).sameEnds == sameEnds) return;
    At(m_type, c).sameEnds = sameEnds;
    At(m_type, c).curves.J = At(m_type, c).curves.I;
}

int CPO_HingeTypeDlg::OnSelChangeSkcv(HINGE_COMPONENT c, int index)
{
    const std::vector<ENTRY> list = CustomizeSkcvCmb(c);
    if (index < 0 || index >= static_cast<int>(list.size())) return 0;
    const ENTRY& entry = list[static_cast<std::size_t>(index)];
    if (!entry.enabled) return 0;
    SetType(At(m_type, c), entry.code, m_context);
    return 1;
}

int CPO_HingeTypeDlg::OnBtnSkcvProp(HINGE_COMPONENT c)
{
    T_HINGE_COMPONENT& component = At(m_type, c);
    if (component.type == SKEL_TYPE::Fema) {
        CPO_HingeSkcvTabFemaDlg dlg;
        if (m_context.sources)
            dlg.m_axialRange =
                m_context.sources->AxialRange(m_type.section, m_type.sectionMaterial);
        return RunEditor(dlg, *this, c) && dlg.Dlg2Data(c, component);
    }
    if (component.type == SKEL_TYPE::Ec8) {
        CPO_HingeSkcvTabEuroDlg dlg;
        return RunEditor(dlg, *this, c) && dlg.Dlg2Data(component);
    }
    CPO_HingeSkcvTabDlg dlg;
    dlg.m_alpha1 = m_context.alpha1;
    dlg.m_alpha2 = m_context.alpha2;
    return RunEditor(dlg, *this, c) && dlg.Dlg2Data(component);
}

int CPO_HingeTypeDlg::OnSelChangeInteraction(HINGE_COMPONENT c, int index)
{
    HINGE_INTERACTION chosen{};
    if (index >= static_cast<int>(OfferedInteractions(m_type, c)) ||
        !ConvertInteraction(index, chosen))
        return 0;
    HINGE_INTERACTION mz = InteractionOf(m_type, HINGE_COMPONENT::Mz);
    (c == HINGE_COMPONENT::Mz ? mz : m_type.interaction) = chosen;
    m_type.interactionMz =
        mz == m_type.interaction ? std::nullopt : std::optional<HINGE_INTERACTION>(mz);
    return 1;
}

void CPO_HingeTypeDlg::InitDataByDof(HINGE_COMPONENT c)
{
    const bool axial = c == HINGE_COMPONENT::Fx || c == HINGE_COMPONENT::Mx;
    const bool hasEnds =
        m_type.element == HINGE_ELEMENT::BeamColumn || m_type.element == HINGE_ELEMENT::Wall;
    T_HINGE_COMPONENT fresh;
    fresh.active = At(m_type, c).active;
    fresh.location = axial || !hasEnds ? HINGE_LOCATION::Center : HINGE_LOCATION::BothEnds;
    const SKEL_TYPE first = CustomizeSkcvCmb(c).front().code;
    fresh.type = first;
    fresh.curves.I = fresh.curves.J = FreshCurve(first, m_context);
    for (T_SKEL_CURVE* curve : {&fresh.curves.I, &fresh.curves.J})
        std::visit(
            [&](auto& k) {
                k.initStiffness = IsBending(c) ? INIT_STIFFNESS::EI6L : INIT_STIFFNESS::Elastic;
            },
            *curve);
    At(m_type, c) = fresh;
}

int CPO_HingeTypeDlg::OnBtnDefaults()
{
    if (!AskYesNo("IDS_QM_UI_HINGE_LOSE_CURVES")) return 0;
    InitDataCheckedAll();
    return 1;
}

int CPO_HingeTypeDlg::OnBtnOptions()
{
    const std::optional<T_HINGE_CONTEXT> changed = m_editOptions ? m_editOptions() : std::nullopt;
    if (!changed) return 0;
    OnUpdate(*changed);
    return 1;
}

void CPO_HingeTypeDlg::InitDataCheckedAll()
{
    for (std::size_t i = 0; i < m_type.components.size(); ++i)
        if (m_type.components[i].active) InitDataByDof(static_cast<HINGE_COMPONENT>(i));
}

int CPO_HingeTypeDlg::OnYieldSurfaceDlgDlg()
{
    T_YIELD_SURFACE surface = m_type.yieldSurface.value_or(T_YIELD_SURFACE{});
    const SKEL_TYPE curve = YieldSurfaceCurve(m_type);
    if (IsTrilinear(curve) && !surface.crack) surface.crack.emplace();
    CPO_HingeYieldPropDlgNew dlg(surface, curve);
    dlg.m_calculated = CalculatedLevel(Owner());
    if (!m_type.yieldSurface) (void)dlg.OnCalculateBtn(); // zeros where there is none
    if (!RunOn(dlg, *this)) return 0;
    m_type.yieldSurface = surface;
    return 1;
}

int CPO_HingeTypeDlg::OnUserInteractionDlg()
{
    T_PMM_TABLE table = m_type.pmm.value_or(T_PMM_TABLE{});
    CPushOverPMMInteractionDlg dlg(table);
    if (!RunOn(dlg, *this)) return 0;
    m_type.pmm = table;
    return 1;
}

int CPO_HingeTypeDlg::OnMasonryPropDlg()
{
    CPO_HingeMasonryDlg dlg;
    dlg.SetView(View());
    dlg.m_owner = Owner();
    T_MASONRY_HINGE masonry = m_type.masonry.value_or(T_MASONRY_HINGE{});
    dlg.Data2Dlg(masonry);
    if (!dlg.DoModal() || !dlg.Dlg2Data(masonry)) return 0;
    m_type.masonry = masonry;
    return 1;
}

int CPO_HingeTypeDlg::OnBtnIntegrationPoint()
{
    CPO_HingeIntegrationPointDlg dlg;
    dlg.SetView(View());
    dlg.SetInitValue(m_type.length.integrationPoints);
    if (!dlg.DoModal()) return 0;
    m_type.length.integrationPoints = dlg.GetValue();
    return 1;
}

int CPO_HingeTypeDlg::OnBtnHingeLength()
{
    if (m_type.definition == HINGE_DEFINITION::MomentRotation) {
        CPO_HingeLengthMThetaDlg dlg;
        dlg.SetView(View());
        dlg.m_owner = Owner();
        dlg.Data2Dlg(m_type.length);
        if (!dlg.DoModal()) return 0;
        dlg.Dlg2Data(m_type.length);
        return 1;
    }
    CPO_HingeLengthMPhiDlg dlg;
    dlg.SetView(View());
    dlg.m_owner = Owner();
    dlg.SetData(m_type.length.components);
    dlg.m_relative = m_type.length.relative;
    if (!dlg.DoModal()) return 0;
    m_type.length.components = dlg.GetData();
    m_type.length.relative = dlg.m_relative;
    return 1;
}

int CPO_HingeTypeDlg::OnBtnAlphaYSpan()
{
    CPO_HingeAlphaYSpanDlg dlg;
    dlg.SetView(View());
    dlg.m_owner = Owner();
    dlg.Data2Dlg(m_type.length);
    if (!dlg.DoModal()) return 0;
    dlg.Dlg2Data(m_type.length);
    return 1;
}

void CPO_HingeTypeDlg::OnMasonryChk(bool on)
{
    if (on != m_type.masonry.has_value())
        m_type.masonry = on ? std::optional(T_MASONRY_HINGE{}) : std::nullopt;
}

void CPO_HingeTypeDlg::OnInfillStrutChk(bool on)
{
    T_HINGE_COMPONENT& axial = At(m_type, HINGE_COMPONENT::Fx);
    for (T_SKEL_CURVE* curve : {&axial.curves.I, &axial.curves.J})
        if (auto* f = std::get_if<T_SKEL_FEMA>(curve)) f->infillStrut = on;
}

bool CPO_HingeTypeDlg::IsInfillStrut() const
{
    const auto* f = std::get_if<T_SKEL_FEMA>(&At(m_type, HINGE_COMPONENT::Fx).curves.I);
    return f && f->infillStrut;
}

/// A stored curve type that is not in its list gives way to the first entry.
void CPO_HingeTypeDlg::RefillSkcv()
{
    for (std::size_t i = 0; i < m_type.components.size(); ++i) {
        const auto c = static_cast<HINGE_COMPONENT>(i);
        const std::vector<ENTRY> list = CustomizeSkcvCmb(c);
        if (Position(list, m_type.components[i].type) < 0)
            SetType(m_type.components[i], list.front().code, m_context);
    }
}
