// How well the steps of a push follow its exact curve.
#pragma once

#include "qm_db/dbdoc.h"

/// The vertex of a run that the line through its steps misses by most, of the push alone; SI. Those
/// that a drop of strength passes on its way back do not count.
struct T_MISSED_VERTEX {
    double share = 0.0; // distance, with displacements over the largest one and forces likewise
    double displacement = 0.0, baseReaction = 0.0;
    std::size_t steps = 0;
};

/// controlNode: the node whose displacement the run followed. 1 done; 0 the run has no steps or
/// can't be read, output as it was.
[[nodiscard]] int FindMissedVertex(IPushRun& run, int controlNode, T_MISSED_VERTEX& out);
