// The results of pushes that a document has.
#pragma once

#include "qm_rps/push/pushrun.h"

/// A result: that of a load case, or of one direction of its static angle.
struct T_PUSH_RESULT_ID {
    int key = 0, turn = 0;
    std::string name; // of a direction "NAME@90"
    bool operator==(const T_PUSH_RESULT_ID&) const = default;
};

/// Those of our own, by the keys of the load cases.
std::vector<T_PUSH_RESULT_ID> PushResultsOf(CDBDoc& doc);

/// The axis nearest to the direction of control that the run had: 0 to 5.
std::size_t DirectionOf(const T_RUN_HEAD& head);

/// Steps of another solver can't be had again from the model: no push puts its own in their place
/// unless it is told to.
bool HasImportedSteps(CDBDoc& doc, int key);

/// Steps and displacements of a result that is older than the model: without states of hinges and
/// storey values, which the present model does not know. 1 done; 0 `error` says why not.
[[nodiscard]] int ReadOldRun(CDBDoc& doc, const T_PUSH_RESULT_ID& id, T_PUSH_RUN& out,
                             std::string& error);
