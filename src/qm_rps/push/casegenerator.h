// Pushover load cases made at once: both ways along X and Y, two patterns, eccentricities.
#pragma once

#include "qm_db/dbdoc.h"

#include <array>
#include <optional>
#include <string>
#include <vector>

/// What is wanted. Both ways of each direction, each pattern and each eccentricity is a case.
struct T_CASE_CHOICE {
    std::array<bool, 2> directions{true, true}; // X, Y
    bool uniform = true;                        // masses times a unit acceleration
    bool mode = true; // masses times the shape of the mode with the largest mass in the direction
    double eccentricity = 0.0;      // fraction of the storey's extent; 0: none, and the signs say
    bool plus = true, minus = true; // nothing
    int controlNode = 0;            // 0: see ControlNodeOf
    std::optional<double> target; // displacement, length; absent: 2 % of the control node's height
};

/// What the cases were made with, in current units.
struct T_CASE_BASIS {
    int controlNode = 0;
    double height = 0.0; // of the control node above the lowest node
    double target = 0.0;
    std::array<int, 2> mode{};           // by direction; 0: none was needed
    std::array<double, 2> massPercent{}; // that takes part in it
    bool ownModes = false;               // the model has modes; else they were computed here
};

/// The modes that the cases take, a line for each direction, and which move less than half of the
/// mass; empty: none is taken.
std::string ModeBasisText(const T_CASE_BASIS& basis);
bool HasLowMass(const T_CASE_BASIS& basis);

/// Directions in which the model can be pushed: it has masses there, and a node at the top moves.
std::array<bool, 2> PushableDirections(const T_MODEL& model);

/// Names in the order of the cases: "PX+ uniform", "PX- uniform", "PX+ mode e+" ...
std::vector<std::string> CaseNames(const T_CASE_CHOICE& choice);

/// The cases in the order of their names, in current units; loads and sign of the target point the
/// same way. Control node: of the top storey the node nearest to its centre of mass, without
/// storeys the highest one. Modes are those of the model, where it has any, else computed as the
/// push does (of the elastic frame where its hinges can't be pushed yet). 1 done; 0 `error` says
/// why (nothing chosen, a name that exists, no mass, no mode, a control node that is not there or
/// restrained, a target or an eccentricity out of range); `out` and `basis` unchanged.
[[nodiscard]] int GenerateCases(CDBDoc& doc, const T_CASE_CHOICE& choice,
                                std::vector<T_POLC_D>& out, T_CASE_BASIS& basis,
                                std::string& error);
