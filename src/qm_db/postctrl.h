// Reading results: eigen modes and pushover steps, in the document's current units.
#pragma once

#include "qm_db/results/stagedreader.h"
#include "qm_db/results/staticreader.h"
#include "qm_db/results/storeylevels.h"

#include <cstdint>
#include <map>
#include <string>
#include <vector>

/// Modal participation factors, one per direction X, Y, Z, RX, RY, RZ.
struct T_MPAF_D {
    T_DOF6 factor{}; // of the normalisation of the mode's shape
};
/// Effective modal masses in per cent of the direction's total.
struct T_MPAM_D {
    T_DOF6 percent{}; // 0 to 100
};

/// Limit-state steps of the pushover load cases, kept with the model.
class CPoverInfo {
public:
    explicit CPoverInfo(CDataCtrl& data) : m_data(data) {}

    /// Steps of the Eurocode 8 limit states; -2 stands for not found.
    void SetStepEC8(int loadCase, int stepDL, int stepSD, int stepNC);
    /// Steps of the NTC limit states, for the 2008 and the 2018 code. SLO is not stored, on
    /// purpose.
    void SetStepNTC2008(int loadCase, int stepSLD, int stepSLV, int stepSLC);
    /// 1 stored steps exist; 0 none, outputs as they were.
    [[nodiscard]] int GetStepEC8(int loadCase, std::array<int, 3>& out) const;
    /// The same of NTC: SLD, SLV, SLC.
    [[nodiscard]] int GetStepNTC2008(int loadCase, std::array<int, 3>& out) const;

private:
    CDataCtrl& m_data;
};

/// Results of the document: modes, pushover steps, static and stage results, in current units.
class CPostCtrl {
public:
    explicit CPostCtrl(CDataCtrl& data)
        : m_data(data), m_poverInfo(data), m_static(data), m_staged(data)
    {
    }

    /// Never null; lives as long as this object.
    CPoverInfo* GetPoverInfo() { return &m_poverInfo; }

    /// Number of eigen modes; modes count from 1.
    int GetNumEigvPost() const;
    /// Selects the mode that GetEiMode reads. 1 done; 0 there is no such mode.
    [[nodiscard]] int SelectMode(int mode);
    /// Shape components of a node in the selected mode; all 0 for a node outside the shape.
    void GetEiMode(int node, T_DOF6& out) const;
    /// Participation factors and effective masses of a mode as recorded, else from the nodal
    /// masses and the shape (factor = L / M; percent = 100 L2 / (M total)). 1 done; 0 no such mode.
    [[nodiscard]] int GetEiMpafNeutral(int mode, T_MPAF_D& out) const;
    [[nodiscard]] int GetEiMpam(int mode, T_MPAM_D& out) const;
    /// Both from the nodal masses and the shape, whatever is recorded. As above.
    [[nodiscard]] int CalcEiParticipation(int mode, T_MPAF_D& factor, T_MPAM_D& percent) const;

    /// Selects the pushover load case whose steps are read; its run with the loads turned so many
    /// times by its static angle. 1 done; 0 it has no such results.
    [[nodiscard]] int SelectPushover(int loadCase, int turn = 0);
    /// Steps of the selected pushover load case; 0 without results.
    int GetStepCount() const;
    /// Steps count from 1. 1 done; 0 out of range.
    [[nodiscard]] int SelectStep(int step);
    /// Values of the selected step in the control direction. 1 done; 0 not there or not readable
    /// (Error says why), output as it was.
    [[nodiscard]] int GetStepFactor_PO(double& factor);
    [[nodiscard]] int GetReacNew(double& reaction);
    [[nodiscard]] int GetDispNew(int node, double& displacement);
    /// Whether the node has results in the selected pushover load case.
    bool ExistNodePost(int node) const;
    /// The node with results that has moved most in the control direction at the last step, the
    /// smallest id of several. 1 found; 0 no steps, or not readable (Error), output as it was.
    [[nodiscard]] int FindControlNode(int& node);

    /// The run of our own that the results are of, in SI; null: none, or another solver's results.
    IPushRun* RunOf(int loadCase, int turn = 0) const;
    /// Whether the run was computed from something else than the model as it is; `reason` says what
    /// has changed. Results of another solver never are.
    bool IsStale(int loadCase, std::string& reason, int turn = 0);
    /// What the run of the selected load case has beside the values above, in current units (those
    /// of hinges by their component). 1 done; 0 it has none, no such node, step or hinge, or not
    /// readable (Error); lists are then empty.
    [[nodiscard]] int GetRunHead(T_RUN_HEAD& out) const;
    [[nodiscard]] int GetRunSteps(std::vector<T_RUN_STEP>& out);
    [[nodiscard]] int GetRunEvents(std::vector<T_RUN_EVENT>& out);
    [[nodiscard]] int GetRunHinges(std::vector<T_RUN_HINGE>& out);
    /// A node, or a hinge by its place in the list, over all steps; all of them in one step.
    [[nodiscard]] int GetRunNode(int node, std::vector<T_DOF6>& out);
    [[nodiscard]] int GetRunShape(int step, std::vector<T_DOF6>& out);
    [[nodiscard]] int GetRunHinge(std::size_t hinge, std::vector<T_RUN_STATE>& out);
    [[nodiscard]] int GetRunStates(int step, std::vector<T_RUN_STATE>& out);

    /// A combination of one static load case (by key), for SelectLoadCombNew.
    static T_LCOM_D MakeLoadComb(int loadCase, double factor = 1.0);
    /// Makes a combination of static load cases, nested or not, the current result. O(1): nothing
    /// is read or checked before the first result is asked for. 1 done; 0 (by key) there is no
    /// such combination, the selection stays.
    [[nodiscard]] int SelectLoadCombNew(const T_LCOM_D& combination);
    [[nodiscard]] int SelectLoadCombNew(int combination);
    /// Results of the current combination in current units, superposed for this node or element
    /// alone. Displacements and reactions: global X, Y, Z, RX, RY, RZ; a reaction is the force of
    /// the support on the structure. 1 done; 0 output as it was and Error says why: a case of the
    /// combination has no results, or its results are older than the model (the case is named),
    /// there is no such node or element, the element is not of that kind.
    [[nodiscard]] int GetDispNew(int node, T_DOF6& out);
    [[nodiscard]] int GetReacNew(int node, T_DOF6& out);
    /// Axial force of a truss, tension positive.
    [[nodiscard]] int GetStrtNew(int element, double& axial);
    /// Internal forces of a beam: axial, shear y, shear z, torsion, moment y, moment z in its local
    /// axes, of the cut seen from the I side. position 0 to 4: I-end, 1/4, 2/4, 3/4, J-end.
    [[nodiscard]] int GetStrbNew(int element, int position, T_DOF6& out);
    /// 1 the static load case has results of the model as it is; 0 Error says why not.
    [[nodiscard]] int CheckStaticResult(int loadCase);
    /// Another number when what static results show has changed: structure, loads, results or
    /// units; not when only combinations or load factor items did.
    std::uint64_t StaticRevision();

    /// Makes the state at the end of a step of a construction stage the current stage result.
    /// stage: its key; step: its number, or kStageLastStep; load: a key of CAttrCtrl::GetSgldKey.
    /// O(1): judged and computed with the first value that is asked for.
    void SelectStage(int stage, int step, int load);
    /// The selected stage result in current units, signs and positions as those of the static
    /// results; what does not stand at that stage has zeros. 1 done; 0 output as it was and Error
    /// says why: the stages have no results, or older ones than the model; no such stage, step,
    /// load case, node or element of that kind.
    [[nodiscard]] int GetDspcNew(int node, T_DOF6& out);
    [[nodiscard]] int GetReccNew(int node, T_DOF6& out);
    [[nodiscard]] int GetStrtcNew(int element, double& axial);
    [[nodiscard]] int GetStrbcNew(int element, int position, T_DOF6& out);
    /// 1 the construction stages have results of the model as it is; 0 Error says why not.
    [[nodiscard]] int CheckStagedResult();

    /// Why a read was refused, in the user's language.
    std::string Error() const { return m_error; }

    /// Storey drift ratios of a step, largest over the storeys: kind 1 over the storey's vertical
    /// node pairs, so that torsion counts, kind 2 at the storey's centre of mass; see DriftOf.
    /// Nodes without results do not count; a storey without any adds its height to the next one.
    /// 1 done; 0 no storeys or no results, outputs as they were.
    [[nodiscard]] int GetPushoverStoryDriftRatio(int loadCase, int step, double& kind1,
                                                 double& kind2, int turn = 0);

    /// The same by storey, bottom to top, with signs.
    [[nodiscard]] int GetPushoverStoryDrifts(int loadCase, int step,
                                             std::vector<T_STOREY_DRIFT>& out, int turn = 0);

    /// True when some storeys have nodes with results and others none: drifts then span several
    /// storeys.
    bool HasStoreyGaps(int loadCase, int turn = 0) const;

private:
    template <class R>
    int ReadForces(R& reader, int element, ELEM_KIND kind, T_ELEM_FORCES& out);
    template <class R>
    int ReadNode(R& reader, int (R::*read)(int, T_DOF6&), int node, T_DOF6& out, T_DIM linear,
                 T_DIM angular);
    template <class R>
    int ReadTruss(R& reader, int element, double& axial);
    template <class R>
    int ReadBeam(R& reader, int element, int position, T_DOF6& out);
    void ToCurrentUnits(T_DOF6& values, T_DIM linear, T_DIM angular) const;
    int ReadSeries(int node, const std::vector<double>*& out);
    int ReadCurve();
    int ReadLevels();
    void DeriveParticipation(const T_EIGV_D& mode, T_MPAF_D& factor, T_MPAM_D& percent) const;
    template <class T, class... A>
    int ReadRun(int (IPushRun::*read)(A..., std::vector<T>&), A... what, std::vector<T>& out);
    template <class T>
    void PathToCurrentUnits(T& at) const;
    void StateToCurrentUnits(T_RUN_STATE& state, int component) const;
    IPushResult* SourceOf(int loadCase, int turn) const;
    IPushResult* Source() const { return SourceOf(m_pushover, m_turn); }
    int Direction() const; // 0 to 5
    double MassAlong(const T_NODE_D& node) const;
    T_DIM DispDim() const;
    T_DIM ReacDim() const;

    CDataCtrl& m_data;
    CPoverInfo m_poverInfo;
    CStaticReader m_static;
    CStagedReader m_staged;
    int m_mode = 0;
    int m_pushover = 0, m_turn = 0;
    int m_step = 0;
    long m_revision = -1; // revision of the data that the caches belong to
    long m_printsAt = -1;
    std::map<int, T_RUN_PRINT> m_prints; // of load cases, at that revision of the data
    long m_staticRevisionAt = -1;
    std::uint64_t m_staticRevision = 0; // at that revision of the data
    std::vector<double> m_factors, m_reactions;
    std::map<int, std::vector<double>> m_series;
    std::vector<T_LEVEL> m_levels; // bottom to top, of the selected pushover
    std::string m_error;
};
