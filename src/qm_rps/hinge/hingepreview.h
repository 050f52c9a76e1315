// Preview of a skeleton curve as data: the backbone in yield-normalised units and the acceptance
// criteria on it. The plot component draws it.
#pragma once

#include "qm_db/records.h"

#include <string>
#include <vector>

struct T_PREVIEW_POINT {
    double x = 0.0, y = 0.0; // D / Dy and strength / yield strength
    std::string label;       // "-E" to "E" of a backbone; empty on an extension
    bool operator==(const T_PREVIEW_POINT&) const = default;
};

struct T_HINGE_PREVIEW {
    std::vector<T_PREVIEW_POINT> line;  // from the negative end to the positive end
    std::vector<T_PREVIEW_POINT> marks; // "IO", "LS", "CP", "-IO" ... on the line
    bool plasticAxis = false;           // x is the plastic deformation: Dy is not known
    bool schematicGap = false;          // the gap's scale is not known: drawn as a quarter of Dy
};

/// Half the side of the box of the small preview, in yield-normalised units.
inline constexpr double kPreviewEdge = 2.0;

/// Extends the outermost segment of each side along its own line to the edge of the box -2 ... 2.
/// Negative side first: where its end has both coordinates above -2 it is moved to x = -2, or to
/// y = -2 if the line passes below that first, and the positive side is left as it is in this call
/// (so callers call twice). The positive side likewise to x = 2 or y = 2. A vertical segment is
/// not extended, nor an end on or beyond the edge. Fewer than two points: nothing is done.
void AdjustEndPoint(std::vector<T_PREVIEW_POINT>& line);

/// Backbone and criteria of a curve, ends not extended. 1 done; 0 when the curve has no shape yet
/// (strengths of a trilinear curve not known, values not finite); out is then empty.
[[nodiscard]] int BackboneOf(const T_SKEL_CURVE& curve, SKEL_TYPE type, T_HINGE_PREVIEW& out);

/// BackboneOf with both ends extended to the edge of the box -2 ... 2, for the small preview.
[[nodiscard]] int PreviewOf(const T_SKEL_CURVE& curve, SKEL_TYPE type, T_HINGE_PREVIEW& out);
