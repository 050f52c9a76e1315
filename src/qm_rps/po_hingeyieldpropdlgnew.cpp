#include "qm_rps/po_hingeyieldpropdlgnew.h"

std::vector<T_FINDING> CPO_HingeYieldPropDlgNew::Findings() const
{
    return YieldSurfaceFindings(m_surface, m_type);
}

int CPO_HingeYieldPropDlgNew::OnOK()
{
    if (!CheckData()) return 0;
    m_record = m_surface;
    return 1;
}

int CPO_HingeYieldPropDlgNew::OnCalculateBtn()
{
    if (!m_calculated) return 0;
    const bool y = m_surface.yield.y.used, z = m_surface.yield.z.used;
    m_surface.yield = *m_calculated;
    m_surface.yield.y.used = y;
    m_surface.yield.z.used = z;
    return 1;
}

T_PM_LINES CPO_HingeYieldPropDlgNew::LinesOf(const T_YIELD_LEVEL& level) const
{
    if (!m_calculated || !m_owner.sources) return {};
    T_YIELD_LEVEL same = *m_calculated;
    same.y.used = level.y.used;
    same.z.used = level.z.used;
    if (same != level) return {};
    return m_owner.sources->Lines(m_owner.type.section, m_owner.type.sectionMaterial);
}

std::vector<CPO_HingeYieldPropDlgNew::T_LEVEL> CPO_HingeYieldPropDlgNew::Levels()
{
    if (IsTrilinear(m_type) && !m_surface.crack) m_surface.crack.emplace();
    std::vector<T_LEVEL> out;
    for (const T_YIELD_LEVEL_NAMES& names : YieldLevels(m_type)) {
        if (names.crack)
            out.push_back({names, "IDS_QM_UI_HINGE_LEVEL_CRACK", &*m_surface.crack});
        else
            out.push_back({names, "IDS_QM_UI_HINGE_LEVEL_YIELD", &m_surface.yield});
    }
    return out;
}

void CPO_HingeYieldPropDlgNew::OnAxisChk(bool aboutY, bool used)
{
    (aboutY ? m_surface.yield.y : m_surface.yield.z).used = used;
    if (m_surface.crack) (aboutY ? m_surface.crack->y : m_surface.crack->z).used = used;
}

std::string CPO_HingeYieldPropDlgNew::AxisNoteKey(bool aboutY) const
{
    if (aboutY) return m_surface.yield.y.used ? "" : "IDS_RPS_PO_Y_AXIS_NOT_USED";
    return m_surface.yield.z.used ? "" : "IDS_RPS_PO_Z_AXIS_NOT_USED";
}
