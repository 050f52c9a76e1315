#include "qm_rps/materialdlg.h"

#include "qm_base/say.h"
#include "qm_db/editscope.h"
#include "qm_db/recordfacts.h"
#include "qm_rps/codes/en1998rotation.h"
#include "qm_rps/desk/freename.h"

CMaterialDlg::CMaterialDlg(CDBDoc& doc, int key) : m_doc(doc)
{
    const auto& materials = doc.Data().Model().materials;
    if (key == 0 && !materials.empty()) key = materials.begin()->first;
    Read(key);
}

void CMaterialDlg::Read(int key)
{
    T_MATL_D material;
    m_key = m_doc.Attr().GetMatl(key, material) ? key : 0;
    if (m_key == 0) {
        const auto& all = m_doc.Data().Model().materials;
        material.name = FreeName(all, NextKey(all));
        material.type = MATL_CLASS::Concrete;
    }
    m_material = m_read = std::move(material);
    m_mean = m_material.mean.value_or(T_MATL_MEAN{});
}

std::vector<std::string> CMaterialDlg::Names() const
{
    std::vector<std::string> names;
    for (const auto& [key, material] : m_doc.Data().Model().materials)
        names.push_back(material.name);
    return names;
}

int CMaterialDlg::Index() const
{
    const auto& all = m_doc.Data().Model().materials;
    const auto at = all.find(m_key);
    return at == all.end() ? -1 : static_cast<int>(std::distance(all.begin(), at));
}

bool CMaterialDlg::MayLeave()
{
    constexpr const char* kAsk = "IDS_QM_UI_SECT_KEEP";
    return m_material == m_read || !AskYesNo(kAsk, Say(kAsk, m_material.name)) || Store();
}

void CMaterialDlg::OnSelChange(int index)
{
    const auto& all = m_doc.Data().Model().materials;
    if (index < 0 || index >= std::ssize(all) || index == Index()) return;
    const int key = std::next(all.begin(), index)->first;
    if (MayLeave()) Read(key);
}

void CMaterialDlg::OnNew()
{
    if (MayLeave()) Read(0);
}

void CMaterialDlg::OnMean(bool on)
{
    if (on == HasMean()) return;
    if (!on) m_mean = *m_material.mean;
    m_material.mean = on ? std::optional(m_mean) : std::nullopt;
}

std::optional<double> CMaterialDlg::Confidence() const
{
    if (m_material.confidence || !m_material.knowledge) return m_material.confidence;
    CCodeSheet sheet;
    return ConfidenceFactor(static_cast<int>(*m_material.knowledge) + 1, sheet);
}

std::vector<T_FINDING> CMaterialDlg::Findings() const
{
    return RecordFindings(m_doc.Data().Model(), m_material, m_key);
}

int CMaterialDlg::Store()
{
    if (!CheckData()) return 0;
    const int key = m_key ? m_key : NextKey(m_doc.Data().Model().materials);
    CEditScope edit(m_doc, m_material.name);
    if (edit.Put(key, m_material) && edit.Commit()) {
        m_key = key;
        m_read = m_material;
        return 1;
    }
    ShowMessage("IDS_QM_UI_EDIT_BUSY");
    return 0;
}

int CMaterialDlg::OnOK()
{
    return m_key != 0 && m_material == m_read ? 1 : Store();
}
