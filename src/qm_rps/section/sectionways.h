// For the files of section checks alone: what the ways share, and the ways of each material.
#pragma once

#include "qm_rps/section/sectioncheck.h"
#include "qm_solver/sectionsolver.h"

#include <cmath>
#include <span>

/// A section that is checked.
struct T_CHECK_JOB {
    const T_SECT_D& section; // with its properties
    const T_SECTION_CHECK_REQUEST& request;
    T_SECTION_STRENGTHS strengths;
    const solver::CSectionSolver& solver;
    double compression = 0.0, tension = 0.0; // without moments; 0: not known
    T_UNITS units;                           // of reasons

    bool IsDesign() const { return request.options.values == SECTION_VALUES::Design; }
    /// The moment in a direction that the section carries at an axial force. None: `reason` says
    /// why.
    std::optional<double> Moment(double direction, double axial, std::string& reason) const;
};

/// The ratio; none where the sheet has a fault or `reason` says why.
using CHECK_RULE = std::optional<double> (*)(const T_CHECK_JOB& job, const T_SECTION_FORCES& forces,
                                             CCodeSheet& sheet, std::string& reason);

struct T_CHECK_WAY {
    SECTION_CHECKED what = SECTION_CHECKED::Bending;
    const char* by = "";
    std::optional<SECTION_CHECK_CODE> code{}; // none: of no code, always there
    bool (*asked)(const T_SECTION_FORCES& forces) = nullptr;
    CHECK_RULE rule = nullptr;
};

/// In the order in which they are told.
std::span<const T_CHECK_WAY> ConcreteWays();
std::span<const T_CHECK_WAY> SteelWays();

inline bool HasAxial(const T_SECTION_FORCES& f)
{
    return f.N != 0.0;
}
inline bool HasMoment(const T_SECTION_FORCES& f)
{
    return f.My != 0.0 || f.Mz != 0.0;
}
inline bool HasBothMoments(const T_SECTION_FORCES& f)
{
    return f.My != 0.0 && f.Mz != 0.0;
}
inline bool HasShearY(const T_SECTION_FORCES& f)
{
    return f.Vy != 0.0;
}
inline bool HasShearZ(const T_SECTION_FORCES& f)
{
    return f.Vz != 0.0;
}
