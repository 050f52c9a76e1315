#include "qm_base/mdialog.h"

#include "qm_base/msgfunction.h"

namespace zql::frx {

int MDialog::DoModal()
{
    return m_view ? m_view->RunModal(*this) : 0;
}

void MDialog::ShowMessage(const std::string& key)
{
    ShowMessage(key, zql::lib::MMSGFunction::GetValue(key));
}

void MDialog::ShowMessage(const std::string& key, const std::string& text)
{
    m_messages.push_back({key, text});
    if (m_view) m_view->ShowMessage(key, text);
}

bool MDialog::AskYesNo(const std::string& key)
{
    return AskYesNo(key, zql::lib::MMSGFunction::GetValue(key));
}

bool MDialog::AskYesNo(const std::string& key, const std::string& text)
{
    return m_view && m_view->AskYesNo(key, text);
}

ANSWER MDialog::AskYesNoCancel(const std::string& key, const std::string& text)
{
    return m_view ? m_view->AskYesNoCancel(key, text) : ANSWER::Cancel;
}

} // namespace zql::frx
