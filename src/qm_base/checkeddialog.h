// Base of the dialogs whose one pass is a list of rules: the first finding is the message.
#pragma once

#include "qm_base/finding.h"
#include "qm_base/mdialog.h"

#include <vector>

class CCheckedDialog : public zql::frx::MDialog {
public:
    /// Every rule that is not kept, in the order of the check.
    virtual std::vector<T_FINDING> Findings() const = 0;
    /// Shows the first finding. 1 there is none.
    int CheckData() override;
};
