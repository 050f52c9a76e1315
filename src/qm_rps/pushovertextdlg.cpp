#include "qm_rps/pushovertextdlg.h"

#include "qm_base/say.h"
#include "qm_rps/pushover/report/pushoverreport.h"

#include <filesystem>

int CPushOverTextDlg::OnSave()
{
    std::string path = m_askPath ? m_askPath() : std::string();
    if (path.empty()) return 0;
    if (!path.ends_with(".txt")) {
        path += ".txt"; // a name that the person was not asked about
        if (std::filesystem::exists(path) &&
            !AskYesNo("IDS_QM_UI_REPLACE", Say("IDS_QM_UI_REPLACE", path)))
            return 0;
    }
    std::string error;
    if (!WritePushoverText(Text(), path, error)) {
        ShowMessage("IDS_RPS_PUSHOVER_Can_t_create_the_file__", error);
        return 0;
    }
    m_saved = path;
    return 1;
}
