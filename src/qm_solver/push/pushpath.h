// The path of a push in the space of its hinges, from event to event.
#pragma once

#include "qm_solver/push/flowsystem.h"
#include "qm_solver/push/pushflow.h"

#include <map>
#include <tuple>
#include <utility>

namespace solver {

/// Rates along the path.
struct T_PUSH_RATE {
    double factor = 0.0;         // of the load factor
    double control = 0.0;        // of the control displacement
    std::vector<double> flow;    // by active flow
    std::vector<double> plastic; // by row
    std::vector<double> force;   // by row
};

/// What the direction of the path is told from: the change that the last event has begun goes on.
struct T_PUSH_DRIVE {
    enum class KIND { Control, Factor, Before, Flows, Forces };
    KIND kind = KIND::Control;
    double sign = 1.0;              // of control or factor
    std::vector<std::size_t> flows; // that go on, or whose force grows (sign -1: falls)
};

/// A functional of the state that the run watches.
struct T_WATCH {
    T_PROBE probe;
    double value = 0.0, rate = 0.0;
    std::vector<double> byLoads; // by set of loads: of the elastic answer
};

/// Forces s, plastic deformations q, load factor, and the state of every flow; the conditions of
/// the flows that are active form the small system. Columns of the structure are asked for when a
/// row begins to flow, with those of the rows that are next.
class CPushPath {
public:
    /// Rates below this part of the largest one, both by strengths, count as none.
    static constexpr double kLeastRate = 1e-9;
    /// Of the elastic answer: a smaller one is the rounding of a mechanism.
    static constexpr double kMechanism = 1e-6;
    using T_FAULT = std::optional<T_SOLVER_ERROR>;

    CPushPath(const T_PUSH_MODEL& model, CPushStructure& structure);

    /// Functionals that are watched; before the first stage.
    std::size_t Watch(T_PROBE probe);
    double Watched(std::size_t w) const { return m_watches[w].value; }
    double WatchRate(std::size_t w) const { return m_watches[w].rate; }

    /// The set of loads that grows from here on, the sets before it standing as they are.
    /// control: watch number of the control displacement; none: controlled by the load factor.
    T_FAULT BeginStage(std::size_t set, std::optional<std::size_t> control);
    enum class WAY { On, None, Fault };
    /// Answers of the structure anew, after another factorisation; the state stays.
    T_FAULT Renew();
    /// So many flows are active that a factorisation with what has yielded pays.
    bool WantsFold() const;
    /// Takes the flows that harden into the elastic structure, as springs in series: they need no
    /// column and no row of the small system any more, until they turn. Selects must follow.
    T_FAULT Fold() { return FoldThose(true); }
    /// Where Select finds no way on: displaces the control (that of BeginStage) to `control`, lets
    /// give way what is beyond its strength then, and comes to a state in which every condition
    /// holds again. Nothing is said of the way between. None: there is no such state.
    WAY Leap(double control, T_FAULT& fault);
    /// No force is beyond what its hinge carries, none that flows below.
    bool IsAdmitted();

    /// Finds who flows next and the rates.
    WAY Select(T_FAULT& fault);
    void SetDrive(T_PUSH_DRIVE drive) { m_drive = std::move(drive); }
    const T_PUSH_RATE& Rate() const { return m_rate; }

    /// Parameter to the next event along the rates; infinite without one. `back`: how far behind an
    /// event may lie that another factorisation has moved.
    double NextEvent(double back = 0.0) const;
    /// The rates once more, of the same flows.
    [[nodiscard]] int Again() { return MakeRates(); }
    void Advance(double by);
    /// Turns what has come to its event; the hinges that have turned are in Turned. -1, or the
    /// hinge whose axial force has left its line of strength.
    long Turn();
    std::vector<T_HINGE_EVENT> TakeTurned();
    /// Brings the forces back onto the yield conditions, the control displacement at `control`
    /// (none: the load factor as it is), and sums them up anew.
    T_FAULT Correct(std::optional<double> control);

    double Factor() const { return m_factors.back(); }
    const std::vector<double>& Factors() const { return m_factors; }
    const std::vector<double>& Plastic() const { return m_plastic; }
    /// As the structure is now, softer where flows are folded.
    T_PUSH_STATE State() const { return {m_factors, m_plastic}; }
    /// As the structure was given.
    T_PUSH_STATE WholeState() const;
    std::vector<T_HINGE_STATE> HingeStates() const;
    /// Plastic and elastic part of the deformation of a law, and its rate.
    double Deformation(std::size_t hinge, std::size_t law, double& rate) const;
    const T_PUSH_FLOWS& Flows() const { return m_flows; }
    /// The path moves neither the load factor nor the control displacement.
    bool IsElsewhere() const;
    /// The loads grow along the rates.
    bool LoadGrows() const { return LoadRate() > 0.0 || (m_rate.factor > 0.0 && m_norm == 0.0); }
    /// Conditions hang on the axial force in more than a straight way: steps need Correct.
    bool IsCurved() const { return m_isCurved; }
    /// Behind an Advance by so much: goes back to the first condition that was met before, and says
    /// how far, as a number below 0; 0 where none was. The rates tell of a condition that
    /// multiplies moment and axial force (My and Mz under an axial force) to the first order alone.
    double Recede(double by);

private:
    struct T_COLUMN {
        std::vector<double> force; // by row
        std::vector<double> watch;
    };

    // pushselection.cpp
    T_FAULT Fetch(std::span<const std::size_t> rows);
    std::vector<std::size_t> MissingRows(std::span<const std::size_t> flows);
    T_FAULT Activate(std::size_t flow);
    void Deactivate(std::size_t flow);
    int MakeRates();
    int SolveDirection(std::vector<double>& x);
    double DriveSign() const;
    void RatesOf(std::span<const double> x, double sign);
    double Norm() const;
    struct T_CHANGE {
        std::size_t flow;
        double amount;
        enum class KIND { Unload, Start, StartBack, End, EndBack, Part } kind;
    };
    std::vector<T_CHANGE> Violations();
    void ChoosePart(std::size_t flow);
    void Touch(std::size_t flow);
    T_FAULT Apply(const T_CHANGE& change);
    T_FAULT Sync(std::size_t flow);
    T_FAULT SyncTouched();
    void NoteTurns(bool isEnd);

    CHingeBackbone& Backbone(std::size_t flow)
    {
        return m_flows.backbones[m_flows.flows[flow].backbone];
    }
    const CHingeBackbone& Backbone(std::size_t flow) const
    {
        return m_flows.backbones[m_flows.flows[flow].backbone];
    }
    // pushleap.cpp
    double Excess(std::size_t flow);
    T_FAULT FindWorst(double close, std::size_t& worst);
    WAY Give(std::size_t flow, T_FAULT& fault);
    void NoteLeap(std::span<const CHingeBackbone> before);
    struct T_BEFORE {
        std::vector<double> factors, plastic;
        std::vector<CHingeBackbone> backbones;
    };
    T_FAULT Restore(T_BEFORE before);
    WAY Settle(double control, T_FAULT& fault);
    // pushfold.cpp
    T_FAULT FoldThose(bool folds);
    T_FAULT Unfold() { return FoldThose(false); }
    // pushpath.cpp
    /// Rate of the loads as that of the elastic forces that they make; 0 in a mechanism.
    double LoadRate() const;
    /// Largest elastic force by the loads over its strength, at the load factor 1.
    double LoadSize() const;
    T_FAULT Rebuild();
    T_FAULT Rebase();
    void SumUp();
    bool IsMoving(std::size_t flow) const;
    bool IsFoldable(std::size_t flow) const;
    /// The flow is told by its row's spring alone.
    bool IsFolded(std::size_t flow) const;
    bool BelongsInSystem(std::size_t flow) const;
    double FlowRate(std::size_t flow) const;
    /// ... with what flows of its mates give it: the rate along its backbone.
    double MeasureRate(std::size_t flow) const;
    /// Part of the flow of an active one that counts for this one.
    double ShareOf(std::size_t flow, std::size_t other) const;
    bool IsShared(std::size_t flow) const;
    /// Condition of an active flow: alpha rate of its force = beta rate of its unknown.
    double Alpha(std::size_t flow) const;
    double Beta(std::size_t flow) const;
    void FindOpposites();
    double Misfit(std::size_t flow) const;
    void MoveFlows(std::span<const double> unknowns, std::span<const double> forces, double by);
    void TakeDrive(std::span<const std::size_t> begun);
    double Least() const { return kLeastRate * m_norm; }
    void MakeRowScales();
    void UpdateLock(std::size_t flow);
    void AddColumns(std::span<const double> by, std::span<double> forces) const;

    double Resistance(std::size_t flow) const;
    double Phi(std::size_t flow, double resistance) const;
    double PhiRate(std::size_t flow) const;
    double Tolerance(std::size_t flow) const;
    bool IsActive(std::size_t flow) const { return m_place[flow] > 0; }

    const T_PUSH_MODEL& m_model;
    CPushStructure& m_structure;
    T_PUSH_FLOWS m_flows;
    CFlowSystem m_system;
    std::vector<std::size_t> m_active; // flows; unknown k of the system is entry k - 1
    std::vector<std::size_t> m_place;  // by flow: its unknown, 0 none
    std::map<std::size_t, T_COLUMN> m_columns;
    std::vector<const T_COLUMN*> m_columnOf; // by row
    std::vector<T_WATCH> m_watches;
    std::vector<double> m_factors;          // by set of loads
    std::vector<double> m_force, m_plastic; // plastic: beyond the springs of the structure
    std::vector<double> m_soft;             // by flow: compliance that the structure holds for it
    std::vector<std::size_t> m_opposite;    // by flow: that of the other side, or their number
    std::vector<std::size_t> m_softFlows;   // those that have some
    struct T_BASE { // from displacements; what has changed since is summed up
        std::vector<double> factors, plastic, force, watch;
    };
    T_BASE m_base;
    std::optional<std::size_t> m_control;
    /// What decides about a flow that is locked and hangs on the force of one row alone.
    struct T_LOCK {
        std::size_t row = 0;
        double sign = 1.0, upper = 0.0, lower = 0.0, force = 1.0;
        bool isPlain = false;
    };
    std::vector<std::size_t> m_firstLaw; // by hinge: its first law of all
    std::size_t m_lawCount = 0;
    std::vector<int> m_told;                      // by law and side: vertices that have been told
    std::vector<T_LOCK> m_lock;                   // by flow
    std::vector<double> m_byForce, m_byStiffness; // by row: rates over strengths
    std::vector<std::size_t> m_dropping;          // flows whose force falls at one deformation
    T_PUSH_RATE m_rate;
    double m_norm = 0.0;          // of the rates
    std::size_t m_sinceSum = 0;   // ways since the forces were summed up
    bool m_hasBefore = false;     // a way of this stage has been chosen
    std::vector<double> m_before; // forces' rates of the last way, and that of the control
    double m_beforeControl = 0.0, m_beforeLeast = 0.0;
    T_PUSH_DRIVE m_drive;
    struct T_WAS {
        CHingeBackbone::ON on;
        int vertex;
    };
    std::map<std::size_t, T_WAS> m_touched; // flows that change at this event
    std::vector<T_HINGE_EVENT> m_turned;
    bool m_isCurved = false;
    bool m_isBent = false; // some condition multiplies forces
    int m_border = 0;      // which row borders the system: 0 control, 1 load factor, 2 flows
};

} // namespace solver
