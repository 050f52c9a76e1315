// A regular frame of a building from bays, storeys, sections and loads: nodes, members, supports,
// load cases, masses, diaphragms, storeys and combinations.
#pragma once

#include "qm_base/finding.h"
#include "qm_db/modelstore.h"

#include <array>
#include <string>
#include <vector>

enum class BUILDING_BRACES { None, Diagonal, Cross };
/// Which beams carry the line loads.
enum class LOADED_BEAMS { All, AlongX, AlongY };

/// What is wanted; lengths, forces and line loads in these units.
struct T_BUILDING {
    std::string title{};
    T_UNITS units{};
    std::vector<double> baysX{}, baysY{}; // without baysY: a plane frame in XZ
    std::vector<double> storeys{};        // heights, bottom to top
    /// "0.4x0.4": a rectangle, b x h (of a column h along X); else a steel shape ("HEB 200").
    std::string columns{}, beams{}, braceSection{};
    /// A grade ("C25/30", "S355") of each.
    std::string columnGrade{}, beamGrade{}, braceGrade{};
    bool isPinned = false; // the feet of the columns
    BUILDING_BRACES braces = BUILDING_BRACES::None;
    /// Bays of the outer frames, from 1: "x2" along X, "y1" along Y.
    std::vector<std::string> braceBays{};
    double dead = 0.0, live = 0.0;         // force / length on the beams of the floors
    double deadRoof = 0.0, liveRoof = 0.0; // of the roof
    LOADED_BEAMS loaded = LOADED_BEAMS::All;
    double liveInMass = 0.3; // psi2 of the masses and of the seismic combination
    bool hasDiaphragms = true;
};

/// Of one level, in the units of the building.
struct T_BUILDING_LEVEL {
    std::string name;
    double elevation = 0.0;
    double dead = 0.0, live = 0.0, self = 0.0; // forces: loads on its beams, weight of members that
                                               // hang on its nodes
    double mass = 0.0;                         // (dead + self + liveInMass live) / g
};
struct T_BUILDING_FACTS {
    std::vector<T_BUILDING_LEVEL> levels; // bottom to top; the first is the ground
    std::size_t nodes = 0, elements = 0;
    std::string plan; // "2 x 1 bays, 10 x 5 m"
};

/// Names of the load cases that the frame has.
inline constexpr std::array<const char*, 3> kBuildingCases{"SELF", "DEAD", "LIVE"};

/// All mass stands in the nodes, self weight in the case SELF as line loads, and the materials have
/// no density: analyses, pushes and evaluations then read the same mass. 1 made; 0 `fault` names
/// the field and why (a list, a section, a grade, a bay), outputs as they were.
[[nodiscard]] int MakeBuilding(const T_BUILDING& in, T_MODEL_CONTENT& out, T_BUILDING_FACTS& facts,
                               T_FINDING& fault);

/// Loads and masses of each level and their sums, to be checked by hand: a row each.
std::vector<std::vector<std::string>> BuildingRows(const T_BUILDING_FACTS& facts);
std::vector<std::string> BuildingHeads(const T_UNITS& units);
