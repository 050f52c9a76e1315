// How the pushes of a document have ended, for those who read their results later.
#pragma once

#include "qm_base/mdialog.h"
#include "qm_db/dbdoc.h"
#include "qm_rps/push/pushend.h"

#include <optional>

/// Where and how a result of our own has ended.
struct T_PUSH_ENDED {
    PUSH_STATUS status = PUSH_STATUS::Failed;
    solver::PUSH_OUTCOME outcome{};
    bool earlier = false;         // already in a load case that this one starts from
    double displacement = 0.0;    // of the control at the last step, in current units
    std::string unit;             // of the displacement
    std::optional<double> leap{}; // displacement behind the first leap of the case; empty: none
};

/// turn: of the load case's static angle. Empty: imported steps, or no results.
std::optional<T_PUSH_ENDED> PushEndedOf(CDBDoc& doc, int key, int turn = 0);

/// That a push (its name) came neither to its target nor to a stop that was asked for, so that its
/// curve is a part of the one that was wanted; empty where it did, and for imported steps.
std::optional<zql::frx::T_MESSAGE> PushRemark(CDBDoc& doc, const std::string& push);
