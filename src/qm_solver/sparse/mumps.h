// The sparse direct solver as an object, its calls one at a time.
#pragma once

#include "qm_solver/solverreason.h"

#include <cstddef>

#include <dmumps_c.h>

namespace solver {

static_assert(sizeof(MUMPS_INT) == sizeof(int));

/// Right-hand sides in a block: about ten times cheaper per side than single solves.
constexpr std::size_t kRhsBlock = 64;

/// One MUMPS instance: job -1 when made, job -2 when destroyed.
class CMumps {
public:
    CMumps();
    ~CMumps();
    CMumps(const CMumps&) = delete;
    CMumps& operator=(const CMumps&) = delete;

    static constexpr int kAnalyse = 1, kFactor = 2, kSolve = 3; // phases
    static constexpr int kGivenOrder = 1;                       // ICNTL(7)
    static constexpr int kFirstSlackPct = 30; // ICNTL(14): memory beyond the estimate

    /// Runs a phase and returns INFOG(1).
    int Run(int job);
    /// Why the last phase failed.
    T_SOLVER_REASON Words() const;
    DMUMPS_STRUC_C& Id() { return m_id; }
    int& Control(int i) { return m_id.icntl[i - 1]; } // numbered as in the library's guide
    int Global(int i) const { return m_id.infog[i - 1]; }
    /// Counts that do not fit are given in millions, negative.
    double GlobalCount(int i) const;
    /// Entries of the main work array that the analysis estimates.
    double SpaceEstimate() const;
    /// Lends the library its main work array.
    void Lend(double* space, std::size_t size);

private:
    DMUMPS_STRUC_C m_id{};
};

} // namespace solver
