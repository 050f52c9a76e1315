#include "qm_rps/storeyguidedlg.h"

#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_db/editscope.h"
#include "qm_rps/create/createfault.h"
#include "qm_rps/desk/elementlist.h"
#include "qm_rps/dialog/unithead.h"

#include <cmath>

CStoreyGuideDlg::CStoreyGuideDlg(CDBDoc& doc) : m_doc(doc)
{
    constexpr double kFirst = 0.1; // m
    OnTolerance(ShortFromSi(kFirst, doc.Unit().Units(), kDimLength));
}

void CStoreyGuideDlg::OnTolerance(double tolerance)
{
    m_tolerance = tolerance;
    m_levels.clear();
    if (tolerance >= 0.0 && std::isfinite(tolerance))
        m_levels =
            LevelsOf(m_doc.Data().Model(), ToSi(tolerance, m_doc.Unit().Units(), kDimLength));
    m_taken.assign(m_levels.size(), true);
    m_names.assign(m_levels.size(), {});
}

int CStoreyGuideDlg::Make(std::vector<T_STOR_D>& out, T_FINDING& fault) const
{
    if (!std::isfinite(m_tolerance))
        return CreateFault(fault, "tolerance", "IDS_QM_NEW_NOT_FINITE");
    if (m_tolerance < 0.0) return CreateFault(fault, "tolerance", "IDS_QM_NEW_NOT_NEGATIVE");
    std::vector<std::string> names;
    for (std::size_t i = 0; i < m_levels.size(); ++i)
        if (m_taken[i] && !m_levels[i].isGround) names.push_back(m_names[i]);
    return StoreysFromLevels(m_levels, m_taken, names, out, fault);
}

std::string CStoreyGuideDlg::ColumnHead(COLUMN column) const
{
    const T_UNITS units = m_doc.Unit().Units();
    switch (column) {
    case Taken:
        return Say("IDS_QM_NEW_STATE_USED");
    case Name:
        return Say("IDS_QM_UI_HEAD_NAME");
    case Elevation:
        return HeadWithUnit(Say("IDS_QM_NEW_HEAD_ELEVATION"), kDimLength, units);
    case Height:
        return HeadWithUnit(Say("IDS_QM_NEW_HEAD_HEIGHT"), kDimLength, units);
    case Spread:
        return HeadWithUnit(Say("IDS_QM_NEW_HEAD_SPREAD"), kDimLength, units);
    default:
        return Say("IDS_QM_NEW_HEAD_NODES");
    }
}

std::string CStoreyGuideDlg::CellText(std::size_t row, COLUMN column) const
{
    if (row >= m_levels.size()) return {};
    const std::size_t at = LevelOfRow(row);
    const T_LEVEL_OF_NODES& level = m_levels[at];
    const auto length = [this](double si) {
        return FormatText("%.6g", FromSi(si, m_doc.Unit().Units(), kDimLength));
    };
    std::vector<T_STOR_D> storeys;
    T_FINDING fault;
    const T_STOR_D* storey = nullptr;
    if (Make(storeys, fault))
        for (const T_STOR_D& s : storeys)
            if (s.nodes == level.nodes) storey = &s;
    switch (column) {
    case Taken:
        return m_taken[at] && !level.isGround ? "1" : "0";
    case Name:
        return level.isGround ? Say("IDS_QM_NEW_GROUND") : storey ? storey->name : m_names[at];
    case Elevation:
        return length(level.elevation);
    case Height:
        return storey ? length(storey->height) : "";
    case Spread:
        return length(level.highest - level.lowest);
    default:
        return ElementListText(level.nodes);
    }
}

int CStoreyGuideDlg::SetCell(std::size_t row, COLUMN column, const std::string& text)
{
    if (row >= m_levels.size() || m_levels[LevelOfRow(row)].isGround) return 0;
    if (column == Taken)
        m_taken[LevelOfRow(row)] = text == "1";
    else if (column == Name)
        m_names[LevelOfRow(row)] = text;
    return column == Taken || column == Name;
}

std::string CStoreyGuideDlg::NotesText() const
{
    std::vector<T_STOR_D> storeys;
    T_FINDING fault;
    if (!Make(storeys, fault)) return fault.text;
    const std::string doubt = DoubtText();
    return Say("IDS_QM_NEW_STOREYS_COME", std::to_string(storeys.size()),
               std::to_string(m_doc.Data().Model().storeys.size())) +
           (doubt.empty() ? "" : "\n" + doubt);
}

std::string CStoreyGuideDlg::DoubtText() const
{
    constexpr double kMostSpread = 0.5; // m: more is no slope or step of one floor
    std::string text;
    for (std::size_t row = 0; row < m_levels.size(); ++row) {
        const T_LEVEL_OF_NODES& level = m_levels[LevelOfRow(row)];
        if (level.highest - level.lowest <= kMostSpread) continue;
        text += (text.empty() ? "" : "\n") + Say("IDS_QM_NEW_WIDE_LEVEL", CellText(row, Elevation),
                                                 CellText(row, Spread),
                                                 std::string(NameOf(m_doc.Unit().Units().length)));
    }
    return text;
}

std::vector<T_FINDING> CStoreyGuideDlg::Findings() const
{
    std::vector<T_STOR_D> storeys;
    T_FINDING fault;
    return Make(storeys, fault) ? std::vector<T_FINDING>() : std::vector{fault};
}

int CStoreyGuideDlg::OnOK()
{
    std::vector<T_STOR_D> storeys;
    T_FINDING fault;
    if (!CheckData() || !Make(storeys, fault)) return 0;
    CEditScope edit(m_doc, Say("IDS_QM_NEW_STOREYS_TITLE"));
    bool done = edit.IsOpen();
    for (std::size_t i = 0; i < storeys.size(); ++i) {
        RecordFromSi(storeys[i], m_doc.Unit().Units());
        done = done && edit.Put(static_cast<int>(i) + 1, storeys[i]);
    }
    for (const int key : m_doc.Attr().GetKeys<T_STOR_D>())
        if (key > std::ssize(storeys)) done = done && edit.Erase<T_STOR_D>(key);
    if (done && edit.Commit()) return 1;
    ShowMessage("IDS_QM_UI_EDIT_BUSY");
    return 0;
}
