// A document's frame and its displacements as the picture of moved frames takes them.
#pragma once

#include "analysis/analysisresults.h"
#include "qm_ui/frame/shapeplot.h"

/// Nodes and members; no state yet.
T_SHAPE ShapeOfModel(CDBDoc& doc);
/// Displacements of all nodes in the order of the shape.
T_SHAPE_STATE StateOf(const std::string& name, const std::vector<T_BY_ID<T_DOF6>>& displacements);
