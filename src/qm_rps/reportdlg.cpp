#include "qm_rps/reportdlg.h"

#include "qm_base/say.h"
#include "qm_db/editscope.h"

#include <algorithm>
#include <filesystem>

std::string CReportDlg::ChapterText(std::size_t chapter)
{
    return Say(ChapterKey(static_cast<REPORT_CHAPTER>(chapter)));
}

CReportDlg::CReportDlg(CDBDoc& doc) : m_head(doc.Data().Model().styp.report), m_doc(doc)
{
    m_rows = m_head.rows;
    for (std::size_t i = 0; i < m_chosen.size(); ++i)
        m_chosen[i] = m_head.chapters.empty() ||
                      std::ranges::count(m_head.chapters, kReportChapterNames[i]) > 0;
}

T_REPORT_D CReportDlg::Settings() const
{
    T_REPORT_D settings = m_head;
    settings.rows = m_rows;
    settings.chapters.clear();
    if (std::ranges::count(m_chosen, false) == 0) return settings; // all: no list of them
    for (std::size_t i = 0; i < m_chosen.size(); ++i)
        if (m_chosen[i]) settings.chapters.emplace_back(kReportChapterNames[i]);
    return settings;
}

int CReportDlg::Keep()
{
    T_STYP_D styp = m_doc.Data().Model().styp;
    const T_REPORT_D settings = Settings();
    if (styp.report == settings) return 1;
    styp.report = settings;
    CEditScope edit(m_doc, Say("IDS_QM_REPORT_SETTINGS"));
    return edit.PutStyp(std::move(styp)) && edit.Commit();
}

T_REPORT_OPTIONS CReportDlg::Options() const
{
    T_REPORT_OPTIONS options;
    options.head = m_head;
    for (std::size_t i = 0; i < m_chosen.size(); ++i)
        if (m_chosen[i]) options.only.push_back(static_cast<REPORT_CHAPTER>(i));
    options.mostRows = static_cast<std::size_t>(m_rows);
    options.fileName = std::filesystem::path(m_doc.Path()).filename().string();
    return options;
}

bool CReportDlg::IsCurrent() const
{
    return IsMade() && m_madeHead == m_head && m_madeChosen == m_chosen && m_madeRows == m_rows &&
           m_madeRevision == m_doc.Data().Revision();
}

int CReportDlg::OnMake()
{
    if (std::ranges::count(m_chosen, true) == 0 || m_rows < 0) {
        ShowMessage(m_rows < 0 ? "IDS_QM_UI_REPORT_ROWS_REFUSED" : "IDS_QM_UI_REPORT_NO_CHAPTER");
        return 0;
    }
    // What the person sets here does not change what the file says of the structure.
    const bool isSaved = !m_doc.Data().IsModified() || m_hashRevision == m_doc.Data().Revision();
    if (!Keep()) {
        ShowMessage("IDS_QM_UI_REPORT_NOT_KEPT");
        return 0;
    }
    m_hashRevision = isSaved ? m_doc.Data().Revision() : -1;
    const auto make = [this, isSaved](const TELL_FN& tell) {
        T_REPORT_OPTIONS options = Options();
        options.progress = tell;
        if (isSaved) options.fileHash = m_fileHash;
        return MakeModelReport(m_doc, options, m_document);
    };
    if (!(m_run ? m_run(make) : make({}))) return 0;
    m_madeHead = m_head;
    m_madeChosen = m_chosen;
    m_madeRows = m_rows;
    m_madeRevision = m_doc.Data().Revision();
    ++m_times;
    return 1;
}

int CReportDlg::OnWrite(bool pdf)
{
    if (!IsCurrent() && !OnMake()) return 0;
    const std::string path = m_askFile ? m_askFile(pdf) : std::string();
    std::string error;
    if (path.empty()) return 0;
    if (m_write && m_write(pdf, path, error)) return 1;
    ShowMessage("IDS_QM_UI_FILE_REFUSED", error);
    return 0;
}

std::string CReportDlg::StateText(std::size_t pages) const
{
    if (!IsMade()) return Say("IDS_QM_UI_REPORT_NOT_MADE");
    const std::string text = Say("IDS_QM_UI_REPORT_PAGES", std::to_string(pages));
    return IsCurrent() ? text : text + "; " + Say("IDS_QM_UI_REPORT_CHANGED");
}
