#include "qm_rps/spectrumdlg.h"

#include "qm_base/say.h"
#include "qm_db/editscope.h"
#include "qm_db/spectrumrules.h"
#include "qm_rps/create/spectrumtext.h"
#include "qm_rps/desk/freename.h"

CSpectrumDlg::CSpectrumDlg(CDBDoc& doc, int key) : m_doc(doc)
{
    const auto& all = doc.Data().Model().spectra;
    if (key == 0 && !all.empty()) key = all.begin()->first;
    Read(key);
}

void CSpectrumDlg::Read(int key)
{
    T_SPFC_D record;
    m_key = m_doc.Attr().GetSpfc(key, record) ? key : 0;
    if (m_key == 0) {
        const auto& all = m_doc.Data().Model().spectra;
        record = CSpectrumEdit().Record();
        int ignored = 0;
        if (m_doc.Attr().FindSpfc(record.name, ignored)) record.name = FreeName(all, NextKey(all));
    }
    m_edit.Take(record);
    m_read = m_edit.Record();
}

std::vector<std::string> CSpectrumDlg::Names() const
{
    std::vector<std::string> names;
    for (const auto& [key, spectrum] : m_doc.Data().Model().spectra)
        names.push_back(spectrum.name);
    return names;
}

int CSpectrumDlg::Index() const
{
    const auto& all = m_doc.Data().Model().spectra;
    const auto at = all.find(m_key);
    return at == all.end() ? -1 : static_cast<int>(std::distance(all.begin(), at));
}

bool CSpectrumDlg::MayLeave()
{
    constexpr const char* kAsk = "IDS_QM_UI_SECT_KEEP";
    return !IsChanged() || !AskYesNo(kAsk, Say(kAsk, m_edit.m_name)) || Store();
}

void CSpectrumDlg::OnSelChange(int index)
{
    const auto& all = m_doc.Data().Model().spectra;
    if (index < 0 || index >= std::ssize(all) || index == Index()) return;
    const int key = std::next(all.begin(), index)->first;
    if (MayLeave()) Read(key);
}

void CSpectrumDlg::OnNew()
{
    if (MayLeave()) Read(0);
}

T_TEXT_TABLE CSpectrumDlg::Values() const
{
    return Findings().empty() ? SpectrumValues(m_edit.Record()) : T_TEXT_TABLE{};
}

std::string CSpectrumDlg::CommandText() const
{
    return SpectrumText(m_edit.Record());
}

std::vector<T_FINDING> CSpectrumDlg::Findings() const
{
    return RecordFindings(m_doc.Data().Model(), m_edit.Record(), m_key);
}

int CSpectrumDlg::Store()
{
    if (!CheckData()) return 0;
    const T_SPFC_D record = m_edit.Record();
    const int key = m_key ? m_key : NextKey(m_doc.Data().Model().spectra);
    CEditScope edit(m_doc, record.name);
    bool done = edit.Put(key, record) != 0;
    // Evaluations name their spectrum: those of this one keep it under its new name.
    for (const int id : m_doc.Attr().GetKeys<T_EVAL_D>()) {
        T_EVAL_D evaluation;
        if (m_key == 0 || m_read.name == record.name || !m_doc.Attr().GetEval(id, evaluation) ||
            evaluation.spectrum != m_read.name)
            continue;
        evaluation.spectrum = record.name;
        done = done && edit.Put(id, evaluation);
    }
    if (done && edit.Commit()) {
        m_key = key;
        m_read = record;
        return 1;
    }
    ShowMessage("IDS_QM_UI_EDIT_BUSY");
    return 0;
}

int CSpectrumDlg::OnOK()
{
    return m_key != 0 && !IsChanged() ? 1 : Store();
}
