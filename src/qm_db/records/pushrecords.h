// Records of the pushover analysis: its global control and its load cases. Plain data; in the store
// every quantity is in SI.
#pragma once

#include <array>
#include <optional>
#include <string>
#include <vector>

// ---- global control -----------------------------------------------------------------------------

/// A static load case that stands before the push.
struct T_PUSH_INITIAL_LOAD {
    int loadCase = 0; // key
    double factor = 1.0;
    bool operator==(const T_PUSH_INITIAL_LOAD&) const = default;
};

/// Axial forces that P-Delta takes: none, those of the initial loads, those of each stored step.
enum class PUSH_P_DELTA { None, Initial, Updated };
/// What a hinge beyond its strength does: it loses it along its backbone, or the run stops. Leap:
/// it loses it, and where no equilibrium leads on the run goes on at its next step.
enum class PUSH_FAILURE { Drop, Stop, Leap };
/// Flow of hinges with interaction: in the rotations alone, or normal to the yield surface.
enum class PUSH_FLOW { Rotations, Associated };
/// State that the first hinge may not pass.
enum class PUSH_STATE_STOP { LS, CP, Failed };

/// Global control of the pushover analysis: defaults of all load cases.
struct T_POGC_D {
    std::vector<T_PUSH_INITIAL_LOAD> initialLoads{}; // empty: zero conditions
    PUSH_P_DELTA pDelta = PUSH_P_DELTA::None;
    int steps = 100; // increments up to the target
    PUSH_FAILURE onFailure = PUSH_FAILURE::Drop;
    PUSH_FLOW flow = PUSH_FLOW::Rotations;
    std::vector<int> hingeTypes{}; // keys of the types that act; empty: all
    int mostEvents = 100000;       // a run with more of them is stopped
    int mostSteps = 100000;
    bool operator==(const T_POGC_D&) const = default;
};

// ---- load cases ---------------------------------------------------------------------------------

/// Directions of control: 1 to 6 as the pushover load case names them.
inline constexpr std::array<const char*, 6> kDirectionNames{"DX", "DY", "DZ", "RX", "RY", "RZ"};
/// Kinds of load pattern: 0 static load, 1 uniform acceleration, 2 mode shape,
/// 3 mode shape times storey mass.
inline constexpr std::array<const char*, 4> kPatternNames{"static", "acceleration", "mode",
                                                          "mode x story mass"};

/// One row of a load case's pattern list.
struct T_POLC_PATTERN {
    int kind = 0;        // 0 static load case, 1 uniform acceleration, 2 mode, 3 mode x storey mass
    int number = 0;      // key of the static load case, direction 1 to 3, or mode number
    double factor = 1.0; // scale factor, not 0
    bool operator==(const T_POLC_PATTERN&) const = default;
};

/// How the solver increments a load case and when it stops.
struct T_POLC_CONTROL {
    int incrementMethod = 1;          // 1 displacement control, else force control
    int incrementOption = 0;          // 2: increments follow an increment function
    int incrementFunction = 0;        // its key
    double stiffnessRatioLimit = 0.0; // current stiffness / initial stiffness, stop criterion
    bool generateStaticAngle = false;
    double staticAngle = 0.0; // degrees
    bool masterNodeControl = true;
    double masterMaxDispl = 0.0; // of the master node; sign gives the direction
    double maxTransDispl = 0.0;  // largest one of any node; both are rad where RX to RZ control
    bool operator==(const T_POLC_CONTROL&) const = default;
};

/// Where a push ends before its target.
struct T_PUSH_STOPS_D {
    std::optional<double> drift{};          // largest storey drift, a ratio
    std::optional<PUSH_STATE_STOP> state{}; // of the first hinge
    std::optional<double> fractionOfPeak{}; // of the base reaction, behind its peak
    bool operator==(const T_PUSH_STOPS_D&) const = default;
};

/// Pushover load case. Optional members that are absent follow the global control.
struct T_POLC_D {
    std::string name;
    int controlNode = 0;                     // node whose displacement is followed
    int direction = 1;                       // 1 to 6: DX, DY, DZ, RX, RY, RZ
    int patternKind = 0;                     // kind of the master load pattern, 0 to 3
    std::vector<int> modes;                  // mode numbers that the pattern names, in order
    std::vector<T_POLC_PATTERN> patterns{};  // pattern rows, may be empty
    std::optional<T_POLC_CONTROL> control{}; // absent for a case from another solver
    int controlOption = 1; // 1: the node named above; else evaluations take the one that has moved
                           // most at the last step
    std::optional<std::vector<T_PUSH_INITIAL_LOAD>> initialLoads{}; // empty: zero conditions
    std::optional<PUSH_P_DELTA> pDelta{};
    std::optional<int> steps{}; // increments up to the target
    std::optional<PUSH_FAILURE> onFailure{};
    std::string initialCase{}; // name of the load case whose end it starts from; empty: from the
                               // initial loads
    T_PUSH_STOPS_D stops{};
    double eccentricity = 0.0; // of the loads: fraction of the storey's extent normal to the push
    std::vector<double>
        additionalDisplacements{};      // of the control node (or rad): steps of their own
    bool additionalEvaluations = false; // likewise at the performance points of evaluations
    bool operator==(const T_POLC_D&) const = default;
};
