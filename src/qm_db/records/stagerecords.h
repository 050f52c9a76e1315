// Records of construction stages: what comes and goes at each stage, and unknown load factors of
// loads that act at a stage and step. Plain data; in the store every quantity is in SI.
#pragma once

#include <string>
#include <vector>

/// Steps of a stage count from 1. The last one, whatever its number, is -1.
inline constexpr int kStageFirstStep = 1;
inline constexpr int kStageLastStep = -1;

/// Groups of load cases by which the results of stages are summed.
inline constexpr int kLoadGroupDead = 0;
inline constexpr int kLoadGroupErection = 1;
inline constexpr int kLoadGroupRest = 2;

/// A static load case that comes or goes at the beginning of a step.
struct T_STAG_LOAD {
    int loadCase = 0; // key
    int step = kStageFirstStep;
    bool operator==(const T_STAG_LOAD&) const = default;
};

/// What comes, or goes, at a stage: elements and supports at its first step, loads at theirs.
struct T_STAG_PART {
    std::vector<int> elements;
    std::vector<int> supports; // node ids: the restraints of these nodes
    std::vector<T_STAG_LOAD> loads;
    bool operator==(const T_STAG_PART&) const = default;
};

/// Construction stage. Stages follow each other by their keys.
struct T_STAG_D {
    std::string name;
    T_STAG_PART activate, deactivate;
    int steps = 1;
    double duration = 0.0; // no result depends on it, and no unit is attached
    bool operator==(const T_STAG_D&) const = default;
};

/// Keys of stage load results beside those of the load cases: sums over load cases by their group.
inline constexpr int kStageLoadSum = -1; // all groups
inline constexpr int kStageLoadDead = -2;
inline constexpr int kStageLoadErection = -3;

/// Number of a step of a stage, 1 to its steps; 0 it has no such step.
inline int StageStepNumber(const T_STAG_D& stage, int step)
{
    const int number = step == kStageLastStep ? stage.steps : step;
    return number >= kStageFirstStep && number <= stage.steps ? number : 0;
}

/// How an element joins a structure that has moved.
enum class STAGE_BIRTH {
    OnDeformed, // free of stress between its nodes where they are
    ToDesign,   // forced from its design shape between displaced nodes
};

/// Control of the analysis in construction stages.
struct T_STCT_D {
    STAGE_BIRTH birth = STAGE_BIRTH::OnDeformed;
    bool geometricStiffness = false; // of the axial forces of beams and trusses
    bool cableSag = false;           // equivalent modulus of trusses with initial tension
    bool operator==(const T_STCT_D&) const = default;
};

// ---- unknown load factors of construction stages ------------------------------------------------

/// A load case that acts at a stage and step, with an unknown or a known factor.
struct T_ULSI_ROW {
    int stage = 0; // key
    int step = kStageFirstStep;
    int loadCase = 0; // key
    bool unknown = false;
    double factor = 1.0;            // of a known load
    double weight = 1.0;            // of an unknown one, in the objective function
    bool pretension = false;        // the unknown scales pretension loads
    int loadGroup = kLoadGroupRest; // what it reads: 0, 1 a sum of stage loads; 2 its own case
    bool operator==(const T_ULSI_ROW&) const = default;
};

/// Unknown load factor item of construction stages.
struct T_ULSI_D {
    std::string name;
    std::vector<T_ULSI_ROW> rows;
    int objective = 0;                    // 0 linear, 1 square, 2 min-max; IOBJ is one more
    int sign = 1;                         // 0 negative, 1 free, 2 positive; ISIGN is one less
    bool solveByEquations = false;        // as simultaneous equations
    std::vector<std::string> constraints; // names of those that take part, in their order
    bool sumStageLoads = false;           // load groups 0 and 1 read the sum of all stage loads
    bool operator==(const T_ULSI_D&) const = default;
};
