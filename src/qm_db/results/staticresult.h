// Results of static analysis: displacements and reactions of nodes, forces of elements, one source
// per load case. Everything is in SI.
#pragma once

#include "qm_db/records.h"

#include <cstdint>
#include <map>
#include <memory>
#include <string>
#include <vector>

/// Positions of element forces: I-end, 1/4, 2/4, 3/4, J-end.
inline constexpr std::size_t kForcePositions = 5;
/// Axial, shear y, shear z, torsion, moment y, moment z at each position; a truss and a link have
/// the same at all of them, a spring none.
using T_ELEM_FORCES = std::array<T_DOF6, kForcePositions>;

/// Results of one load case, by position in the lists of ids.
struct T_STATIC_DATA {
    std::uint64_t fingerprint = 0; // of what they were computed from, see CFingerprint
    std::vector<int> nodes;        // ids, ascending
    std::vector<T_DOF6> displacement, reaction;
    std::vector<int> elements; // ids, ascending
    std::vector<T_ELEM_FORCES> force;
    bool operator==(const T_STATIC_DATA&) const = default;
};

/// What the readers of results use. A file-backed source reads only the blocks that it needs.
class IStaticResult {
public:
    IStaticResult() = default;
    IStaticResult(const IStaticResult&) = delete;
    IStaticResult& operator=(const IStaticResult&) = delete;
    virtual ~IStaticResult() = default;

    virtual std::uint64_t Fingerprint() const = 0;
    /// 1 done; 0 there are no results of that node or element, or they can't be read (then Error
    /// says why), output as it was.
    [[nodiscard]] virtual int ReadDisplacement(int node, T_DOF6& out) = 0;
    [[nodiscard]] virtual int ReadReaction(int node, T_DOF6& out) = 0;
    [[nodiscard]] virtual int ReadForces(int element, T_ELEM_FORCES& out) = 0;
    /// Everything at once, for saving and listing. 1 done; 0 it can't be read, output as it was.
    [[nodiscard]] virtual int ReadAll(T_STATIC_DATA& out) = 0;
    /// Why the last read failed: file, block and reason; empty when nothing failed.
    virtual std::string Error() const { return {}; }
};

/// A source over results in memory; all lists fit each other and the ids ascend.
std::shared_ptr<IStaticResult> MakeStaticResult(T_STATIC_DATA data);

/// Result sources by the key of the load case.
using T_STATIC_MAP = std::map<int, std::shared_ptr<IStaticResult>>;
