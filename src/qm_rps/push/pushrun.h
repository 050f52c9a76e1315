// The push of a model's load cases, and its results.
#pragma once

#include "qm_rps/push/pushcases.h"
#include "qm_rps/push/pushend.h"
#include "qm_rps/push/pushstates.h"
#include "qm_solver/pushsolver.h"

#include <memory>

/// A component of a hinge over the steps.
struct T_PUSH_HINGE_SERIES {
    T_PUSH_LAW_PLACE place;
    solver::T_HINGE_LAW law;                // as it was used
    bool biaxial = false;                   // My and Mz share one surface
    std::vector<double> deformation, force; // beyond the elastic member; as an analysis prints it
    std::vector<PUSH_STATE> state;
};

struct T_PUSH_EVENT_ROW {
    bool initial = false; // while the initial loads came in
    double loadFactor = 0.0, displacement = 0.0, baseReaction = 0.0;
    struct T_TURN {
        std::size_t hinge = 0; // of the run's hinges
        std::string to;        // see EventTarget
    };
    std::vector<T_TURN> hinges;
};

struct T_PUSH_STOREY_SERIES {
    std::string name;
    double elevation = 0.0, height = 0.0; // of its top, and down to the storey below
    std::vector<double> displacement, drift;
    std::vector<double> shear; // empty: not known (loads of cases before this one are in it)
};

/// One result of a load case, in SI; index 0 is step 1. Along the direction of control, totals:
/// what the initial loads have moved is in them.
struct T_PUSH_RUN {
    std::string name;
    int key = 0;               // of the load case
    int turn = 0;              // of its static angle: so many times
    std::size_t direction = 0; // 0 to 5
    PUSH_STATUS status = PUSH_STATUS::Failed;
    std::string outcome, advice;
    std::vector<std::string> warnings; // of a run: no hinge acts, stiffness factors, stops
    bool cancelled = false;
    double startDisplacement = 0.0;      // of the control node, before the first step
    std::optional<double> startReaction; // then; empty: the state before is not known
    std::vector<double> loadFactor, displacement, baseReaction, residual;
    std::vector<int> additional; // numbers of the steps that were asked for
    std::vector<T_PUSH_EVENT_ROW> events;
    std::vector<T_PUSH_HINGE_SERIES> hinges;
    std::vector<T_PUSH_STOREY_SERIES> storeys;
    T_RUN_DATA data; // the same steps as they are stored, with all displacements
};

struct T_PUSH_PROGRESS {
    std::string name;
    std::size_t done = 0, total = 0; // steps
    double displacement = 0.0, baseReaction = 0.0;
    double startDisplacement = 0.0, startReaction = 0.0; // before the first step
};
/// What member forces are those of.
enum class FORCES_OF {
    Step,
    InitialLoads, // alone, before any push
    Start,        // of the load case, behind those that it starts from
};
/// The member forces of a step, told once its load case has been pushed.
struct T_STEP_FORCES {
    const T_PUSH_RUN& run;
    std::size_t step = 0;             // index of the run's steps
    const std::vector<int>& elements; // ids by the index of `result`
    const solver::T_RESULT& result;
    FORCES_OF of = FORCES_OF::Step; // else `run` has that state as its only step
};
using PUSH_FORCES_FN = std::function<void(const T_STEP_FORCES&)>;

/// Told after each step; false: no further one is wanted.
using PUSH_PROGRESS_FN = std::function<bool(const T_PUSH_PROGRESS&)>;

/// Pushes load cases of one model, which must stay as it is meanwhile. Cases with the same initial
/// loads and P-Delta share one factorisation.
class CPushRun {
public:
    explicit CPushRun(CDBDoc& doc);
    ~CPushRun();
    CPushRun(const CPushRun&) = delete;
    CPushRun& operator=(const CPushRun&) = delete;

    /// All results of a load case; with a static angle several. 1 done, however they ended; 0
    /// `error` says what is wrong with model, hinges or load case, `out` unchanged.
    /// extra: displacements of the control node (m) at what evaluations find, steps too, beside
    /// those of the record; evaluations do not read them. Between the axes they are left out.
    [[nodiscard]] int Run(int key, const PUSH_PROGRESS_FN& progress, std::vector<T_PUSH_RUN>& out,
                          std::string& error, const std::vector<double>& extra = {});

    /// Runs from now on tell the member forces under the initial loads, at their start, and of
    /// their steps, in order.
    void TellForces(PUSH_FORCES_FN tell) { m_forces = std::move(tell); }

    /// The results of a load case that the document has, as Run gives them: states and storey
    /// values are made again from the stored steps. 1 done; 0 `error` says why not (there are none
    /// of our own, they can't be read, or they are older than the model), `out` unchanged.
    [[nodiscard]] int Read(int key, int turn, T_PUSH_RUN& out, std::string& error);

    /// The lowest modes of the frame with the springs of its hinges, as load patterns take those
    /// that the model does not hold. 1 done; 0 `error` says what is wrong with model or hinges.
    [[nodiscard]] int Modes(std::size_t count, std::vector<solver::T_MODE>& out,
                            std::string& error);

    /// Puts the results of a load case, as Run gives them, in place of those that the document has.
    void Keep(std::vector<T_PUSH_RUN>& runs);

private:
    struct T_PREPARED;
    int BuildFrame(std::string& error);
    int PrepareCases(int key, std::vector<T_PUSH_CASE>& out, T_PREPARED*& on, std::string& error);
    std::optional<std::vector<double>> FactorsBefore(int key);
    int Prepare(const T_PUSH_BASIS& basis, T_PREPARED*& out, std::string& error);
    int PrepareNew(const T_PUSH_BASIS& basis, T_PREPARED& to, std::string& error);
    int AxialOf(const solver::T_LOAD_CASE& initial, T_PREPARED& to, std::string& error);
    std::vector<solver::T_VEC6> ModeShape(T_PREPARED& on, int mode, const T_POLC_D& record,
                                          std::string& error);
    int RunCase(T_PREPARED& on, const T_PUSH_CASE& c, const PUSH_PROGRESS_FN& progress,
                T_PUSH_RUN& out, std::string& error);
    int TellStarts(T_PREPARED& on, const T_PUSH_CASE& c,
                   const std::vector<solver::T_PUSH_STEP>& starts, std::string& error);
    int TellSteps(T_PREPARED& on, const T_PUSH_RUN& run,
                  const std::vector<solver::T_PUSH_STEP>& steps, std::string& error);
    std::string Words(const solver::T_SOLVER_ERROR& error) const;

    CDBDoc& m_doc;
    const T_MODEL& m_model;
    CAnalysisModel m_frame;
    bool m_hasFrame = false;
    std::vector<std::unique_ptr<T_PREPARED>> m_prepared;
    PUSH_FORCES_FN m_forces;
};
