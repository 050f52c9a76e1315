// Records of linear analysis: static load cases, combinations, unknown load factors. Plain data;
// in the store every quantity is in SI.
#pragma once

#include "qm_db/records/stagerecords.h"

#include <array>
#include <optional>
#include <string>
#include <vector>

// ---- static load cases --------------------------------------------------------------------------

struct T_NODAL_LOAD {
    int node = 0;
    std::array<double, 6> load{}; // forces and moments, global
    bool operator==(const T_NODAL_LOAD&) const = default;
};

enum class BEAM_LOAD_AXES { Local, Global };
enum class BEAM_LOAD_TYPE { Distributed, Point, Moment };

/// Load on a beam. Distributed: from w[0] at at[0] to w[1] at at[1]; point, moment: w[0] at at[0].
/// Positions are fractions of the flexible length.
struct T_BEAM_LOAD {
    int element = 0;
    BEAM_LOAD_AXES axes = BEAM_LOAD_AXES::Local;
    int direction = 2; // 0 x, 1 y, 2 z
    BEAM_LOAD_TYPE type = BEAM_LOAD_TYPE::Distributed;
    std::array<double, 2> w{};
    std::array<double, 2> at{0.0, 1.0};
    bool operator==(const T_BEAM_LOAD&) const = default;
};

struct T_SETTLEMENT {
    int node = 0;
    std::array<double, 6> displacement{}; // lengths and radians
    bool operator==(const T_SETTLEMENT&) const = default;
};

struct T_TEMPERATURE_LOAD {
    int element = 0;
    double change = 0.0; // degrees
    bool operator==(const T_TEMPERATURE_LOAD&) const = default;
};

/// Initial tension of a truss or beam: an initial strain T / (E A).
struct T_PTNS_D {
    int element = 0;
    double force = 0.0;
    bool operator==(const T_PTNS_D&) const = default;
};

/// Static load case.
struct T_STLD_D {
    std::string name;
    std::array<double, 3> selfWeight{}; // multiples of gravity in X, Y, Z
    std::vector<T_NODAL_LOAD> nodal;
    std::vector<T_BEAM_LOAD> beam;
    std::vector<T_SETTLEMENT> settlement;
    std::vector<T_TEMPERATURE_LOAD> temperature;
    std::vector<T_PTNS_D> pretension;
    int group = kLoadGroupRest; // of the results of construction stages
    bool operator==(const T_STLD_D&) const = default;
};

// ---- combinations -------------------------------------------------------------------------------

/// A load case, or another combination, times a factor.
struct T_LCOM_ITEM {
    bool combination = false; // key is that of a combination
    int key = 0;
    double factor = 1.0;
    bool operator==(const T_LCOM_ITEM&) const = default;
};

/// General load combination.
struct T_LCOM_D {
    std::string name;
    std::vector<T_LCOM_ITEM> items;
    bool operator==(const T_LCOM_D&) const = default;
};

// ---- unknown load factors -----------------------------------------------------------------------

/// Codes as stored: 0 reaction of a node, 1 displacement of a node, 2 axial force of a truss,
/// 3 force of a beam.
enum class ULFC_TYPE { Reaction, Displacement, Truss, Beam };

/// Constraint of unknown load factors.
struct T_ULFC_D {
    std::string name;
    ULFC_TYPE type = ULFC_TYPE::Displacement;
    int id = 0;                    // node or element
    int position = 0;              // of a beam: 0 I-end, 1 1/4, 2 2/4, 3 3/4, 4 J-end
    int component = 0;             // 0 to 5; of a node X to RZ, of a beam axial to moment z
    bool inequality = false;       // else equality
    bool compareWithValue = true;  // equality: with the value, else with `otherId`
    double value = 0.0;            // target of an equality
    int otherId = 0;               // node or element that a compared equality names
    std::optional<double> upper{}; // inequality: at most
    std::optional<double> lower{}; // inequality: at least
    int stage = 0;                 // key of the construction stage whose result it reads; 0: none
    int step = kStageLastStep;     // of that stage
    bool operator==(const T_ULFC_D&) const = default;
};

struct T_ULFI_UNKNOWN {
    int loadCase = 0;    // key of a static load case
    double weight = 1.0; // in the objective function
    bool operator==(const T_ULFI_UNKNOWN&) const = default;
};

/// Unknown load factor item.
struct T_ULFI_D {
    std::string name;
    int combination = 0;                  // key of the general combination it is built on
    int objective = 0;                    // 0 linear, 1 square, 2 min-max; IOBJ is one more
    int sign = 1;                         // 0 negative, 1 free, 2 positive; ISIGN is one less
    bool solveByEquations = false;        // as simultaneous equations
    std::vector<T_ULFI_UNKNOWN> unknowns; // the other cases of the combination are known
    std::vector<std::string> constraints; // names of those that take part, in their order
    bool operator==(const T_ULFI_D&) const = default;
};
