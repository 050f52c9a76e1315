// Where beams of steel meet columns, read from the frame for the connections' factors. SI.
#pragma once

#include "qm_rps/generate/memberend.h"

#include <span>

/// The joints of a steel beam's ends that are not released; other members are left as they are. A
/// column counts where it is a steel I whose web lies in the plane of the beam: the weaker of those
/// above and below. The beams are those of steel along the same line that hold a moment there. What
/// the connection gives by itself is not read.
/// 1 done; 0 with the reason: no such column at a node.
[[nodiscard]] int ReadSteelJoints(const T_MODEL& model, const T_STEEL_CONNECTION& asked,
                                  T_HINGE_MEMBER& member, std::string& reason);

/// The panel zone of a steel joint.
struct T_PANEL_ZONE {
    T_STEEL_JOINT joint;
    double depth = 0.0; // of the shallowest beam
};
/// At a node with beams along a horizontal axis: the web of the weaker column, as above. Beams must
/// be I-sections of steel. 1 done; 0 with the reason, `out` unchanged.
[[nodiscard]] int ReadPanelZone(const T_MODEL& model, int node, const std::array<double, 3>& along,
                                std::span<const int> beams, T_PANEL_ZONE& out, std::string& reason);
