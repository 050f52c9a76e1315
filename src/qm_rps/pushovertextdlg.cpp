#include "qm_rps/pushovertextdlg.h"

#include "qm_rps/pushover/pushoverreport.h"

int CPushOverTextDlg::OnSave()
{
    std::string path = m_askPath ? m_askPath() : std::string();
    if (path.empty()) return 0;
    if (!path.ends_with(".txt")) path += ".txt";
    std::string error;
    if (!WritePushoverText(m_text, path, error)) {
        ShowMessage("IDS_RPS_PUSHOVER_Can_t_create_the_file__", error);
        return 0;
    }
    m_saved = path;
    return 1;
}
