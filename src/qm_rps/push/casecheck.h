// The check of a case: what is wrong with the set-up of its pushes, and what should be known of it.
#pragma once

#include "qm_base/finding.h"
#include "qm_db/dbdoc.h"

struct T_CASE_REMARK {
    std::string where; // load case, function ...; empty: the whole model
    T_FINDING finding;
    bool isWarning = false; // it keeps no push from running
};

/// In the order in which they are told: settings of all pushes, storeys, functions, load cases, the
/// model.
std::vector<T_CASE_REMARK> CheckCase(CDBDoc& doc);
