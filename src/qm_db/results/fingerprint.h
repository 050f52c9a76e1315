// Fingerprints of what static results depend on: when one differs, the results are older than the
// model. The names and the units of the document do not count, nor do masses.
#pragma once

#include "qm_db/records.h"

#include <cstdint>

/// Nodes, materials, sections, elements, constraints between nodes, plane and gravity.
std::uint64_t FingerprintOfStructure(const T_MODEL& model);

/// Stages, their control, and the load cases that they name with their groups, on the structure.
std::uint64_t FingerprintOfStages(const T_MODEL& model);

/// The same without the loads: what the engine prepares before it takes them.
std::uint64_t FingerprintOfStagePlan(const T_MODEL& model);

/// Of one load case on a structure; the results of an analysis carry this one.
std::uint64_t FingerprintOfCase(std::uint64_t structure, const T_STLD_D& loadCase);
