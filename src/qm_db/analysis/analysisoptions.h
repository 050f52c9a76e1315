// What an analysis is asked to do, and why it was refused.
#pragma once

#include <cstddef>
#include <functional>
#include <string>
#include <vector>

struct T_ANALYSIS_OPTIONS {
    bool allCases = true;   // every static load case, else those in `cases`
    std::vector<int> cases; // keys
    int modes = 0;          // number of eigen modes to find; 0: none
    /// Done and total parts of the whole run; returns false to cancel.
    std::function<bool(std::size_t done, std::size_t total)> progress;
    bool stages = true; // construction stages, where the model has any
};

/// A load case whose direct solution kept less than eight digits, so that it was refined.
struct T_LOST_DIGITS {
    int loadCase = 0;                    // key; 0: construction stages, the worst of all solutions
    double unrefined = 0.0, error = 0.0; // estimated relative error before and after
};

enum class ANALYSIS_FAULT {
    None,
    BadModel,     // something is missing or wrong: element, node or load case named
    Mechanism,    // the model can move: node and direction, or the part, named
    NoMass,       // modes of a model without mass
    NotConverged, // the modes, or the axial forces of a construction stage
    Cancelled,
    Failed, // the factorisation failed for another reason
    NoMemory,
};

struct T_ANALYSIS_ERROR {
    ANALYSIS_FAULT fault = ANALYSIS_FAULT::None;
    int node = 0, element = 0; // ids, 0: none
    int loadCase = 0;          // key, 0: none
    int stage = 0;             // key of the construction stage, 0: none
    int direction = -1;        // of a mechanism, 0 to 5: X, Y, Z, RX, RY, RZ
    std::vector<int> part;     // nodes of a part that moves as a rigid body
    std::string text;          // one line: place and reason
};
