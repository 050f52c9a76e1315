// Linear relations between displacements, eliminated one after the other.
#pragma once

#include "qm_solver/framemodel.h"

#include <unordered_map>
#include <vector>

namespace solver {

/// One contribution to a displacement: factor times the value at `index`.
struct T_TERM {
    int index = 0;
    double factor = 0.0;
};
using T_RELATION = std::vector<T_TERM>;

/// Master-slave form of the rigid diaphragms and equal displacements of a frame: each relation
/// expresses one displacement by others. Gauss elimination with a free displacement as the pivot;
/// a relation between prescribed displacements alone becomes a demand on their values.
class CConstraints {
public:
    explicit CConstraints(const T_FRAME& frame);

    /// What an eliminated displacement is made of; null if it is independent or prescribed.
    const T_RELATION* Expression(int full) const;
    const std::vector<T_RELATION>& Demands() const { return m_demands; }

private:
    void AddDiaphragm(const T_DIAPHRAGM& diaphragm);
    void AddEqual(const T_EQUAL_DISPLACEMENT& equal);
    void Eliminate(const T_RELATION& relation);
    T_RELATION Substituted(const T_RELATION& relation) const;
    double Size(const T_TERM& term) const;
    bool IsFixed(int full) const;

    const T_FRAME& m_frame; // used while constructing
    double m_length = 1.0;  // makes factors of rotations comparable with those of translations
    std::unordered_map<int, T_RELATION> m_expression;
    std::unordered_map<int, std::vector<int>> m_users; // eliminated ones that use a displacement
    std::vector<T_RELATION> m_demands;
};

} // namespace solver
