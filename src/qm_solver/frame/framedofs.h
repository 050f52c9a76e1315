// Degrees of freedom of a frame: which are unknown, which are prescribed, and how every
// displacement follows from those.
#pragma once

#include "qm_solver/frame/constraints.h"

#include <span>
#include <vector>

namespace solver {

/// Directions of an element's nodes to which it can give stiffness (releases notwithstanding).
T_DIRS6 ActsOn(const T_ELEMENT& element);

/// u = T q + S g. u: all displacements, full index = 6 * node + direction. q: the unknowns
/// (equations). g: the prescribed displacements of the supports, indexed as u. Fixed directions,
/// rigid diaphragms and equal displacements are eliminated (master-slave), so T has one entry of 1
/// in most rows and a few in the rows of slaves.
///
/// A direction to which no attached element can give stiffness is inactive: it gets no equation
/// and stays 0. Beams act in all six directions of their nodes (releases notwithstanding: a node
/// that is free by releases alone is a mechanism), trusses in the three translations, links and
/// springs where their stiffness is not 0. A node that is tied to active ones by a constraint is
/// active with them.
///
/// State: fixed; may be shared between threads.
class CFrameDofs {
public:
    /// Of a checked model (indices in range).
    explicit CFrameDofs(const T_FRAME& frame);

    std::size_t FullCount() const { return 6 * m_nodes; }
    std::size_t EquationCount() const { return m_owner.size(); }
    /// Terms over the equations that make up displacement `full`; empty if it does not move.
    std::span<const T_TERM> Terms(std::size_t full) const { return m_terms.Row(full); }
    /// Terms over prescribed displacements (full indices of fixed directions).
    std::span<const T_TERM> FixedTerms(std::size_t full) const { return m_fixedTerms.Row(full); }
    /// Displacement `full` depends on a direction that nothing gives stiffness to.
    bool Inactive(std::size_t full) const { return m_inactive[full]; }
    /// The displacement that equation `equation` stands for, as a full index.
    std::size_t Owner(std::size_t equation) const { return m_owner[equation]; }
    /// Block of each equation: the equations of one node, blocks counting from 0.
    std::span<const int> Blocks() const { return m_block; }
    /// Relations between prescribed displacements alone that the constraints demand: the sum of
    /// factor times displacement of each row must be 0.
    std::span<const T_RELATION> Demands() const { return m_demands; }

    /// u = T q; `full` is overwritten.
    void Expand(std::span<const double> q, std::span<double> full) const;
    /// The same of unknowns q + rest, as full + fullRest: `rest` is what doubles round away.
    void Expand(std::span<const double> q, std::span<const double> rest, std::span<double> full,
                std::span<double> fullRest) const;
    /// q += T' f.
    void Reduce(std::span<const double> full, std::span<double> q) const;

private:
    /// Rows of terms, one after the other.
    struct T_ROWS {
        std::vector<std::size_t> start{0};
        std::vector<T_TERM> terms;
        std::span<const T_TERM> Row(std::size_t i) const
        {
            return {terms.data() + start[i], start[i + 1] - start[i]};
        }
        void Close() { start.push_back(terms.size()); }
    };
    std::size_t m_nodes = 0;
    T_ROWS m_terms, m_fixedTerms;
    std::vector<char> m_inactive;
    std::vector<std::size_t> m_owner;
    std::vector<int> m_block;
    std::vector<T_RELATION> m_demands;
};

} // namespace solver
