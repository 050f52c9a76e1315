#include "qm_base/checkeddialog.h"

int CCheckedDialog::CheckData()
{
    const std::vector<T_FINDING> found = Findings();
    if (found.empty()) return 1;
    ShowMessage(found.front().messageKey, found.front().text);
    return 0;
}
