// What storeys must keep so that drifts can be taken from one to the next.
#pragma once

#include "qm_base/finding.h"
#include "qm_db/records.h"

#include <vector>

/// Storeys are listed from bottom to top: those whose nodes stand lower, in the mean, than those of
/// the storey before. Drifts would be between the wrong levels. Nodes at one height say nothing: a
/// curve that was read in may come with a model that has no heights.
/// Elevation: Z, of a plane XY model Y. Storeys without nodes are left out.
std::vector<T_FINDING> StoreyFindings(const T_MODEL& model);
