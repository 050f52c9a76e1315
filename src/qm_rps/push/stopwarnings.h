// Stops of a pushover load case that can't act on the model: the push then goes on to its target
// although it was to end before.
#pragma once

#include "qm_base/finding.h"
#include "qm_rps/push/pushlaws.h"

/// "stops.drift" in a model without storeys; "stops.state" where no hinge that acts has acceptance
/// criteria (LS, CP) or a point of failure (failed).
std::vector<T_FINDING> StopWarnings(const T_PUSH_STOPS_D& stops, bool hasStoreys,
                                    std::span<const T_PUSH_LAW_PLACE> laws);

/// The same of a record of the document. Empty, too, where its frame or hinges can't be built: the
/// push then refuses the load case with the reason.
std::vector<T_FINDING> StopWarnings(CDBDoc& doc, const T_POLC_D& record);
