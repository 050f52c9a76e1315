// The report data set: what a seismic report says of a model. Plain data, in the document's current
// units; accelerations in g, damping in per cent.
#pragma once

#include "qm_db/dbdoc.h"
#include "qm_rps/push/pushended.h"
#include "qm_rps/pushover/pushevaluation.h"

/// A storey, bottom to top.
struct T_REPORT_STOREY {
    int key = 0; // of the record
    std::string name;
    double height = 0.0;          // of the storey
    double elevation = 0.0;       // of the level, above the lowest storey's foot
    std::array<double, 3> mass{}; // lumped masses of the level's nodes in X, Y, Z
    std::vector<int> nodes;       // ids
};

/// A step of a capacity curve.
struct T_REPORT_STEP {
    int step = 0; // from 1
    double loadFactor = 0.0;
    double baseReaction = 0.0, controlDisplacement = 0.0; // in the control direction
    std::vector<T_STOREY_DRIFT> drifts;                   // empty where there are no storeys
};

/// A limit state with the step of the curve where it is reached; -2: not found.
struct T_REPORT_LIMIT {
    std::string name; // "DL", "SLV" ...
    int step = -2;    // from 1
};

/// A pushover load case; without steps where it has no results.
struct T_REPORT_PUSH {
    int key = 0;
    std::string name;
    int controlNode = 0;                     // id
    int direction = 1;                       // 1 to 6: DX to RZ
    std::vector<T_REPORT_STEP> steps;        // all, in their order
    std::vector<T_REPORT_LIMIT> limitStates; // those that the model keeps
    std::optional<T_PUSH_ENDED> ended;       // empty: steps of another solver, or none
    std::string old; // why the steps are older than the model; empty where they are not
};

/// The whole data set.
struct SSReportInfoRW {
    std::string title;                          // of the model
    T_UNITS units;                              // of every number here
    double gravity = 0.0;                       // acceleration in these units
    std::vector<T_REPORT_STOREY> storeys;       // bottom to top
    std::vector<T_REPORT_PUSH> pushovers;       // in the order of their keys
    std::vector<T_PUSH_EVALUATION> evaluations; // performance points and target displacements
};

/// Fills a data set from the model: every storey, load case, step and evaluation. The model is not
/// changed. 1 done; 0 results can't be read or an evaluation names what does not exist (error says
/// which), out as it was.
[[nodiscard]] int BuildReportInfo(CDBDoc& doc, SSReportInfoRW& out, std::string& error);
