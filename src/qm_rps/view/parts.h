// Parts of a model that are hidden and shown together: by section, storey and plane.
#pragma once

#include "qm_rps/desk/selection.h"

enum class PART_KIND { Section, Storey, Plane };

struct T_MODEL_PART {
    PART_KIND kind = PART_KIND::Section;
    std::string name; // "HEB200", "Storey 2", "X = 5 m"
    CSelection::T_KEYS elements;
};

/// Sections in use; storeys, each with the elements between its level and the one below (both
/// included, the lower one's own beams not); planes normal to an axis with at least `least`
/// elements in them, at most `most` of each axis, those with most elements.
[[nodiscard]] std::vector<T_MODEL_PART> PartsOf(CDBDoc& doc, std::size_t least = 2,
                                                std::size_t most = 30);
