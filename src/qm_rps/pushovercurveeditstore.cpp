// What of the evaluation that is edited stands in the document.
#include "qm_base/msgfunction.h"
#include "qm_db/editscope.h"
#include "qm_rps/evaluatedsteps.h"
#include "qm_rps/pushovercurveedit.h"

using zql::lib::MMSGFunction;

int CPushOverCurveEdit::KeyOf(const std::string& name) const
{
    for (const auto& [key, record] : m_doc.Data().Model().evaluations)
        if (record.name == name) return key;
    return 0;
}

bool CPushOverCurveEdit::HasUnsaved() const
{
    T_EVAL_D now = m_settings;
    if (now.bilinear == T_EVAL_BILINEAR{}) now.bilinear.reset(); // looked at, nothing chosen
    return now != m_stored;
}

int CPushOverCurveEdit::OnStore()
{
    if (!Update()) {
        ShowMessage("IDS_QM_UI_PUSH_NOT_STORED",
                    MMSGFunction::Format("IDS_QM_UI_PUSH_NOT_STORED", {m_shown.Refused()}));
        return 0;
    }
    if (m_settings.name.empty()) return Say("IDS_QM_UI_PUSH_NO_NAME");
    const auto& table = m_doc.Data().Model().evaluations;
    int key = NextKey(table);
    for (const auto& [other, record] : table) {
        if (record.name != m_settings.name) continue;
        if (record == m_settings) {
            m_opened = record.name;
            m_stored = m_settings;
            return 1;
        }
        if (!AskYesNo("IDS_QM_UI_PUSH_REPLACE",
                      MMSGFunction::Format("IDS_QM_UI_PUSH_REPLACE", {record.name})))
            return 0;
        key = other;
        break;
    }
    if (!Put(key)) return Say("IDS_QM_UI_EDIT_BUSY");
    Update();
    if (m_changed) m_changed();
    return 1;
}

int CPushOverCurveEdit::Put(int key)
{
    CEditScope edit(m_doc, MMSGFunction::Format("IDS_QM_EVAL_EDITED", {m_settings.name}));
    if (!edit.Put(key, m_settings) || !edit.Commit()) return 0;
    m_opened = m_settings.name;
    m_stored = m_settings;
    return 1;
}

int CPushOverCurveEdit::OnKeep()
{
    const int key = m_settings.name == m_opened ? KeyOf(m_opened) : 0;
    if (key == 0 || m_settings == m_stored || !m_shown.Refused().empty()) return 0;
    if (!Put(key)) return Say("IDS_QM_UI_EDIT_BUSY");
    m_revision = m_doc.Data().Revision(); // it was evaluated with these settings
    if (m_changed) m_changed();
    return 1;
}

/// Another window, or an undo, may have changed the opened evaluation, or taken it away: then the
/// settings are those of a new one.
void CPushOverCurveEdit::ReadAgain()
{
    if (m_opened.empty()) return;
    T_EVAL_D now;
    if (!m_doc.Attr().GetEval(KeyOf(m_opened), now)) {
        const std::vector<T_EVAL_D> all = EvaluationsOf(m_doc); // directions of a load case too
        const auto it = std::ranges::find(all, m_opened, &T_EVAL_D::name);
        if (it != all.end()) now = *it;
    }
    if (now.name.empty()) {
        m_opened.clear();
        m_stored = {};
    } else if (now != m_stored) {
        m_settings = m_stored = now;
    }
}
