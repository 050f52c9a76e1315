// Internal forces along members as a picture shows them, and members as they are bent.
#pragma once

#include "qm_rps/push/pushrun.h"
#include "qm_rps/view/viewresults.h"

enum class MEMBER_FORCE { N, Vy, Vz, T, My, Mz };
inline constexpr std::array<const char*, 6> kMemberForceNames{"N", "Vy", "Vz", "T", "My", "Mz"};

struct T_DIAGRAM_POINT {
    double at = 0.0;    // fraction of the flexible length, from I
    double value = 0.0; // current units; two points at one place: it leaps
};

/// One member's part of the points.
struct T_MEMBER_DIAGRAM {
    std::size_t line = 0; // of the scene
    std::size_t first = 0, count = 0;
    std::size_t largest = 0, smallest = 0; // points
    std::array<double, 3> along{};         // unit vector that positive values point along
    bool exact = true; // false: straight between the five positions of the analysis, see FitTo
};

/// Values by member, current units. Moments stand on the side in tension: positive My along +z,
/// positive Mz along -y; the others along z, Vy along y.
struct T_DIAGRAM {
    std::string name, unit; // "My", "kN*m"
    std::vector<T_DIAGRAM_POINT> points;
    std::vector<T_MEMBER_DIAGRAM> members;
    std::size_t largest = 0, smallest = 0; // members with the picture's extremes
    std::size_t notExact = 0;              // members

    double Value(std::size_t point) const { return points[point].value; }
    /// Size of the largest value by magnitude; 0: nothing but zeros.
    double Size() const;
};

/// Forces that are all 0 within rounding are 0. Links, members without length and results without
/// forces give no member.
[[nodiscard]] T_DIAGRAM DiagramOf(const CViewFrame& frame, const T_FRAME_SCENE& scene,
                                  const T_VIEW_RESULTS& results, const solver::T_LOAD_CASE& loads,
                                  MEMBER_FORCE what, const T_UNITS& units);

/// Every line of a scene as it is bent: movements of `parts` + 1 equally spaced points from node I
/// to node J, line after line, current lengths.
struct T_BENT_LINES {
    std::size_t parts = 0; // 0: none, lines are straight
    std::vector<std::array<double, 3>> moved;
};
inline constexpr std::size_t kBentParts = 32;
/// Up to so many lines are drawn bent; what moves more is drawn straight, and said so.
inline constexpr std::size_t kBentLines = 8000;

/// What the hinges at the ends of members have flowed, by element: about y and z.
using T_HINGE_TURNS = std::map<int, T_ENDS<std::array<double, 2>>>;
/// Of a step, from 1; hinges along members are left out.
[[nodiscard]] T_HINGE_TURNS HingeTurnsOf(const T_PUSH_RUN& run, int step);
/// From the rotations of the nodes to those of the member's ends, behind the hinges.
void TakeHinges(const T_HINGE_TURNS& turns, int element, T_LINE_ENDS& ends);

/// With the forces of an analysis exact along prismatic beams; without (pushes, modes) by the
/// cubic of the ends' displacements behind the hinges.
/// dim: kDimLength, or kDimNone where the movements are those of a mode.
[[nodiscard]] T_BENT_LINES BentLinesOf(const CViewFrame& frame, const T_FRAME_SCENE& scene,
                                       const T_VIEW_RESULTS& results,
                                       const solver::T_LOAD_CASE& loads, const T_UNITS& units,
                                       T_DIM dim, const T_HINGE_TURNS& hingeTurns = {});
