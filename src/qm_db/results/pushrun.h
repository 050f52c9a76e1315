// What a push of our own leaves beside the curve that an evaluation reads: all displacements, the
// hinges by step, the vertices of its path, how it ended, and what it was computed from. In SI;
// index 0 is step 1.
#pragma once

#include "qm_db/records.h"
#include "qm_db/results/pushresult.h"

#include <cstdint>
#include <utility>

namespace solver {
enum class PUSH_OUTCOME;
enum class HINGE_TURN;
} // namespace solver

/// Fingerprints of what a run was computed from; see pushprint.h.
struct T_RUN_PRINT {
    std::uint64_t structure = 0, hinges = 0, loads = 0, setup = 0;
    bool operator==(const T_RUN_PRINT&) const = default;
};

/// A stored step; totals, the initial loads included.
struct T_RUN_STEP {
    int stage = 0; // of several that follow each other: the cases that it starts from
    double loadFactor = 0.0;
    double displacement = 0.0; // of the control
    double baseReaction = 0.0; // what the supports take in the control direction
    T_DOF6 base{};             // sum of the reactions, global, moments about the origin
    double residual = 0.0;     // out of balance over the largest force
    bool additional = false;   // asked for by the user
    bool evaluated = false;    // additional for what evaluations find: they do not read it
    bool operator==(const T_RUN_STEP&) const = default;
};

/// One component of a hinge.
struct T_RUN_HINGE {
    int element = 0;
    double at = 0.0;   // fraction of the flexible length: 0 I-end, 1 J-end
    int component = 0; // 0 Fx to 5 Mz
    bool operator==(const T_RUN_HINGE&) const = default;
};

struct T_RUN_STATE {
    double deformation = 0.0, force = 0.0; // as the engine gives them (solver::T_HINGE_STATE)
    double axial = 0.0;                    // force at the hinge, tension positive
    int place = 0;                         // on the backbone
    bool operator==(const T_RUN_STATE&) const = default;
};

/// A vertex of the path: its hinges (by their place in the list) and what they do there.
struct T_RUN_TURN {
    int hinge = 0;
    solver::HINGE_TURN turn{};
    int point = 0; // vertex that was reached, from 1
    bool positive = true;
    bool operator==(const T_RUN_TURN&) const = default;
};
struct T_RUN_EVENT {
    int stage = 0; // -1: the initial loads
    double loadFactor = 0.0, displacement = 0.0, baseReaction = 0.0;
    T_DOF6 base{};
    std::vector<T_RUN_TURN> turns;
    bool operator==(const T_RUN_EVENT&) const = default;
};

struct T_RUN_END {
    solver::PUSH_OUTCOME outcome{};
    int stage = 0;
    double loadFactor = 0.0, displacement = 0.0;
    int element = 0; // of the hinge that ended it; 0: none
    int hinge = 0;   // its first component, from 1 in the list of hinges; 0: none, or not known
    int storey = 0;  // whose drift ended it, from 1, bottom to top; 0: none, or not known
    bool operator==(const T_RUN_END&) const = default;
};

/// What is known of a run without reading it.
struct T_RUN_HEAD {
    int turn = 0;               // k: the loads are turned about Z by k times the static angle
    double angle = 0.0;         // by so many degrees
    T_DOF6 control{};           // unit vector of the control direction, global
    double startReaction = 0.0; // base reaction before the first step
    T_RUN_PRINT print;
    T_RUN_END end;
    bool operator==(const T_RUN_HEAD&) const = default;
};

/// A run in memory. Steps are appended while it goes on: `steps`, `displacement` and `states` keep
/// the same length.
struct T_RUN_DATA {
    T_RUN_HEAD head;
    std::vector<int> nodes; // ids, ascending
    std::vector<T_RUN_HINGE> hinges;
    std::vector<T_RUN_STEP> steps;
    std::vector<std::vector<T_DOF6>> displacement;  // by step and node, global
    std::vector<std::vector<T_RUN_STATE>> states{}; // by step and hinge
    std::vector<T_RUN_EVENT> events{};
    std::vector<T_DOF6> start{}; // by node: displacements before the first step
    bool operator==(const T_RUN_DATA&) const = default;
};

/// Results of our own as an evaluation reads them, and the rest. A file-backed source reads only
/// what is asked for: a node, or a hinge, over all steps is a short run of the file. All functions
/// that read: 1 done; 0 not there or not readable (Error says why), output cleared.
class IPushRun : public IPushResult {
public:
    IPushRun* Run() override { return this; }

    virtual const T_RUN_HEAD& Head() const = 0;
    [[nodiscard]] virtual int ReadSteps(std::vector<T_RUN_STEP>& out) = 0;
    [[nodiscard]] virtual int ReadEvents(std::vector<T_RUN_EVENT>& out) = 0;
    [[nodiscard]] virtual int ReadHinges(std::vector<T_RUN_HINGE>& out) = 0;
    /// Displacements before the first step, by node (NodeIds).
    [[nodiscard]] virtual int ReadStart(std::vector<T_DOF6>& out) = 0;
    /// Displacements of one node, by step; of all nodes (NodeIds) in one step, from 1.
    [[nodiscard]] virtual int ReadNode(int node, std::vector<T_DOF6>& out) = 0;
    [[nodiscard]] virtual int ReadShape(int step, std::vector<T_DOF6>& out) = 0;
    /// States of one hinge (its place in the list, from 0), by step; of all hinges in one step.
    [[nodiscard]] virtual int ReadHinge(std::size_t hinge, std::vector<T_RUN_STATE>& out) = 0;
    [[nodiscard]] virtual int ReadStates(int step, std::vector<T_RUN_STATE>& out) = 0;

    // From the above: in the control direction, of the push alone, as an evaluation takes them:
    // what stood before its first step is taken off.
    [[nodiscard]] int ReadLoadFactors(std::vector<double>& out) override;
    [[nodiscard]] int ReadBaseReactions(std::vector<double>& out) override;
    [[nodiscard]] int ReadDisplacements(int node, std::vector<double>& out) override;

private:
    [[nodiscard]] int ReadOfSteps(double T_RUN_STEP::*member, std::vector<double>& out);
};

/// A source over a run in memory.
std::shared_ptr<IPushRun> MakePushRun(T_RUN_DATA data);
/// Everything. 1 done; 0 a read failed (error filled), output cleared.
[[nodiscard]] int ReadWholeRun(IPushRun& source, T_RUN_DATA& out, std::string& error);

/// Runs with turned loads: by the key of the pushover load case and the turn, from 1. The run that
/// is not turned stands among the results of the load cases.
using T_TURNED_MAP = std::map<std::pair<int, int>, std::shared_ptr<IPushResult>>;
