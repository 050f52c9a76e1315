// The model of the database as arrays for the analysis engine, and the engine's results back.
#pragma once

#include "qm_db/analysis/analysisoptions.h"
#include "qm_db/results/staticresult.h"
#include "qm_solver/framesolver.h"

#include <span>

/// A translation of one model, which must stay as it is while this object is used. Everything is in
/// SI; the engine's indices follow the ascending ids of nodes and elements and the ascending keys
/// of materials and sections.
class CAnalysisModel {
public:
    explicit CAnalysisModel(const T_MODEL& model) : m_model(model) {}

    /// Translates the structure. A plane model is restrained out of its plane at every node; G that
    /// is not given is E / (2 (1 + nu)); gravity that is not given is 9.80665 m/s2. Stiffness
    /// factors of sections count with the mean of both ends, mass and weight have the whole area.
    /// 1 done; 0 error filled: an element lacks its node, section
    /// or material. What the engine checks itself is left to it.
    [[nodiscard]] int BuildFrame(T_ANALYSIS_ERROR& error);
    const solver::T_FRAME& Frame() const { return m_frame; }
    /// Ids by the engine's indices, ascending.
    const std::vector<int>& NodeIds() const { return m_nodes; }
    const std::vector<int>& ElementIds() const { return m_elements; }
    /// Directions that a plane model holds at every node; none of a space model.
    solver::T_DIRS6 OutOfPlane() const;

    /// Translates a load case. 1 done; 0 error filled: a load is on something that is not there.
    [[nodiscard]] int BuildCase(int key, solver::T_LOAD_CASE& out, T_ANALYSIS_ERROR& error) const;

    T_STATIC_DATA ResultOf(const solver::T_RESULT& result, std::uint64_t fingerprint) const;
    T_EIGV_D ModeOf(const solver::T_MODE& mode) const;

    /// An error of the engine in the user's numbers and names. `cases`: keys of the load cases in
    /// the order in which the engine got them.
    T_ANALYSIS_ERROR ErrorOf(const solver::T_SOLVER_ERROR& error, std::span<const int> cases) const;

private:
    int AddElement(const T_ELEM_D& e, T_ANALYSIS_ERROR& error);
    int FailElement(const T_ELEM_D& e, const std::string& reason, T_ANALYSIS_ERROR& error) const;
    template <class L, class T>
    int AddNodeLoads(const T_STLD_D& record, const std::vector<L>& from, std::vector<T>& to,
                     T_ANALYSIS_ERROR& error) const;
    template <class L, class T>
    int AddElementLoads(const T_STLD_D& record, const std::vector<L>& from, std::vector<T>& to,
                        T_ANALYSIS_ERROR& error) const;

    const T_MODEL& m_model;
    solver::T_FRAME m_frame;
    std::vector<int> m_nodes, m_elements, m_materials, m_sections; // ids and keys by index
};
