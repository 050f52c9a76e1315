#include "qm_rps/pushoverhingestatedlg.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_rps/push/pushatpointtext.h"
#include "qm_rps/push/pushquantity.h"

#include <algorithm>
#include <cmath>

CPushOverHingeStateDlg::CPushOverHingeStateDlg(CDBDoc& doc) : CPushOverResultDlg(doc), m_scene(doc)
{
    ShowFirst();
}

void CPushOverHingeStateDlg::OnShown(bool anotherResult)
{
    const T_PUSH_RUN& run = Run();
    if (anotherResult) {
        m_marks = PlaceHinges(run, Scene(), m_doc.Data().Model());
        // The first one that has yielded is looked at.
        m_hinge = run.hinges.empty() ? -1 : 0;
        for (const T_PUSH_EVENT_ROW& event : run.events)
            if (!event.hinges.empty()) {
                m_hinge = static_cast<long>(event.hinges.front().hinge);
                break;
            }
    }
    if (anotherResult && Step() > 0) {
        const auto furthest = std::ranges::max_element(
            run.displacement, {}, [](double displacement) { return std::fabs(displacement); });
        ShowMoves(static_cast<int>(furthest - run.displacement.begin()) + 1);
        m_scale = CFrameScene::RoundScale(Scene(), m_moves);
    }
    ShowMoves(Step());
    if (Step() > 0) ShowStates(run, Step(), m_hinge, m_marks);
    ShowRows();
}

void CPushOverHingeStateDlg::ShowMoves(int step)
{
    const T_RUN_DATA& data = Run().data;
    if (step > 0)
        m_moves = MovesOf(Scene(), data.nodes,
                          data.displacement.at(static_cast<std::size_t>(step - 1)), Units());
    else
        m_moves.assign(Scene().nodes.size(), {});
}

void CPushOverHingeStateDlg::ShowRows()
{
    m_rows.clear();
    for (std::size_t i = 0; i < m_marks.hinges.size(); ++i)
        if (!m_onlyYielded || m_marks.hinges[i].state != PUSH_STATE::Elastic) m_rows.push_back(i);
}

void CPushOverHingeStateDlg::OnFilter()
{
    ShowRows();
}

void CPushOverHingeStateDlg::OnHinge(long hinge)
{
    if (hinge < 0 || hinge >= std::ssize(Run().hinges)) return;
    m_hinge = hinge;
    if (Step() > 0) ShowStates(Run(), Step(), m_hinge, m_marks);
}

int CPushOverHingeStateDlg::HingeRow() const
{
    const auto it = std::ranges::find(m_rows, static_cast<std::size_t>(m_hinge));
    return m_hinge < 0 || it == m_rows.end() ? -1 : static_cast<int>(it - m_rows.begin());
}

void CPushOverHingeStateDlg::OnHingeRow(int row)
{
    if (row >= 0 && row < std::ssize(m_rows))
        OnHinge(static_cast<long>(m_rows[static_cast<std::size_t>(row)]));
}

PUSH_STATE CPushOverHingeStateDlg::StateAt(std::size_t row) const
{
    return m_marks.hinges.at(m_rows.at(row)).state;
}

std::string CPushOverHingeStateDlg::CellText(std::size_t row, std::size_t column) const
{
    const T_PUSH_HINGE_SERIES& hinge = Run().hinges.at(m_rows.at(row));
    const auto step = static_cast<std::size_t>(Step() - 1);
    const HINGE_COMPONENT c = hinge.place.component;
    switch (column) {
    case 0:
        return std::to_string(hinge.place.element);
    case 1:
        return hinge.place.end;
    case 2:
        return kComponentNames[static_cast<std::size_t>(c)];
    case 3:
        return FormatText("%.5g", DeformationOf(c, Units()).Shown(hinge.deformation.at(step)));
    case 4:
        return FormatText("%.5g", ForceOf(c, Units()).Shown(hinge.force.at(step)));
    default:
        return PushStateText(StateAt(row));
    }
}

std::string CPushOverHingeStateDlg::UnitsText() const
{
    const std::string length(NameOf(Units().length)), force(NameOf(Units().force));
    return Say("IDS_QM_CLI_PUSH_HINGE_UNITS", length, force, force + " " + length);
}

std::string CPushOverHingeStateDlg::HingeText() const
{
    if (m_hinge < 0) return {};
    const T_PUSH_LAW_PLACE& place = Run().hinges[static_cast<std::size_t>(m_hinge)].place;
    return Say("IDS_QM_UI_PUSH_HINGE_NAME", std::to_string(place.element), place.end,
               kComponentNames[static_cast<std::size_t>(place.component)]);
}
