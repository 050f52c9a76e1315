// Hinges of masonry piers and spandrels: moment at the ends, shear in the middle.
#pragma once

#include "qm_rps/generate/codeside.h"

/// Of a rectangle of masonry. Circolare 2019 (NTC 2018): flexure, sliding and diagonal of piers,
/// spandrels with a tie; EN 1998-3 Annex C: flexure and sliding of piers. What comes first decides;
/// strengths are those at the initial axial force. Drift limits of the mode of each hinge.
/// 1 done; 0 with the reason in words, `out` unchanged.
[[nodiscard]] int MasonryHinge(const T_MEMBER_END& end, T_SIDES<T_CODE_SIDE>& out,
                               std::string& reason);
