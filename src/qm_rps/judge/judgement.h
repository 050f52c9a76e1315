// Every member end judged in the steps of a push that an evaluation names, and where along the push
// the first one passes a limit state. SI.
#pragma once

#include "qm_rps/judge/judgedend.h"
#include "qm_rps/push/pushatpoint.h"

enum class VERDICT { Fulfilled, NotFulfilled, NotChecked };
inline constexpr std::array<const char*, 3> kVerdictNames{"fulfilled", "not fulfilled",
                                                          "not checked"};

/// An end at a limit state.
struct T_JUDGED_ROW {
    std::size_t end = 0; // of the judgement's ends
    T_END_STATE state, shearState;
    T_END_CHECKS checks;
    VERDICT verdict = VERDICT::NotChecked; // of all modes
    JUDGE_MODE governing = JUDGE_MODE::Rotation;
    std::optional<double> ratio; // of the governing mode; empty: not checked, or no capacity
};

struct T_VERDICT_COUNT {
    std::string storey;
    std::array<std::size_t, kVerdictNames.size()> count{};  // ends by VERDICT
    std::array<std::size_t, kVerdictNames.size()> joints{}; // of these
};

/// One limit state at one displacement.
struct T_JUDGED_STATE {
    T_PUSH_POINT point;
    std::size_t level = 0; // of kLevelNames
    std::string name;      // of the limit state: "SD"; of performance points that of the ends
    AT_POINT found = AT_POINT::Beyond;
    std::string shearAt;            // why shear is read elsewhere than at the point; else empty
    std::vector<T_JUDGED_ROW> rows; // the worst first
    T_VERDICT_COUNT all;
    std::vector<T_VERDICT_COUNT> storeys; // bottom to top, those that have ends
    std::vector<T_STOREY_AT_POINT> drifts;
};

/// Where the first end passes a limit state.
struct T_FIRST_PASS {
    std::size_t level = 0;
    JUDGE_MODE mode = JUDGE_MODE::Rotation;
    std::optional<std::size_t> end; // empty: none does, up to the end of the push
    bool atStart = false;           // passed in the first state already
    double displacement = 0.0, baseReaction = 0.0;
    std::size_t unchecked = 0; // that have this mode without numbers: one may be the first
    std::size_t all = 0;       // that have this mode
};

/// Codes of the ends, or one for all.
struct T_JUDGE_OPTIONS {
    std::optional<HINGE_CODE> code;   // empty: that of the generated hinges
    bool secondary = false;           // with `code`: members
    std::optional<std::size_t> level; // this one alone
    T_JUDGE_FACTORS factors;
    bool trace = false; // keep the numbers behind every check
    bool operator==(const T_JUDGE_OPTIONS&) const = default;
};

/// "EN1998-3"; empty: there is no such code.
std::optional<HINGE_CODE> HingeCodeNamed(const std::string& name);
/// Codes that all members may be judged by: not AISC 342, which knows columns of steel alone.
std::vector<std::string> JudgedCodeNames();

/// The ends of the beam elements: about the axes that a code or their hinges bend them, else one
/// row that says why there is nothing to judge; trusses, links and springs; then the joints of
/// columns with beams by their nodes, in each plane that has beams. `run`: its hinges and storeys.
std::vector<T_JUDGED_END> JudgedEnds(const T_MODEL& model, const T_PUSH_RUN& run,
                                     const T_JUDGE_OPTIONS& options);

/// What is judged, in a step of the push.
T_END_STATE StateOf(const T_JUDGED_END& end, const T_STEP_FORCES& step);

/// The Circolare 2019 (C8.7.2.2.3) reads shear, and brittle demands on joints and columns, at the
/// displacement of the largest base reaction where that comes before the state.
bool ReadsShearAtPeak(const T_JUDGED_END& end);

/// What an end is judged with in a state of the path; `brittle`: where brittle demands are read.
T_STATE_CONTEXT ContextOf(const T_JUDGED_PATH& path, std::size_t end, const T_END_STATE& brittle,
                          const T_JUDGE_FACTORS& factors);

/// Fills rows and counts of a state that the path has at `index`.
void JudgeState(const std::vector<T_JUDGED_END>& ends, const T_JUDGED_PATH& path, std::size_t index,
                const T_JUDGE_OPTIONS& options, T_JUDGED_STATE& state);

/// By level and mode, of the modes that some end has. Between the last state of the path that keeps
/// a limit and the first one that does not, the crossing is found by halving on the straight line
/// between them, so that it is exact to 1e-9 of that piece. A limit that is passed and kept again
/// between two neighbouring states is not seen.
/// States of the path are left out where they can't matter: behind what has been passed first
/// already, and between two judged ones whose forces and deformations bound those of all states
/// between and whose ratios leave twice their difference (at least 0.02) up to 1.
std::vector<T_FIRST_PASS> FirstPasses(const std::vector<T_JUDGED_END>& ends,
                                      const T_JUDGED_PATH& path, const T_JUDGE_FACTORS& factors);
