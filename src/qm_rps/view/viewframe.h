// The structure as the engine has it, for views of results: members by the lines of a scene, with
// their axes, stiffness and loads. SI.
#pragma once

#include "qm_db/analysisframe.h"
#include "qm_rps/desk/framescene.h"
#include "qm_rps/judge/endstate.h"
#include "qm_rps/view/memberline.h"

/// The document must outlive the object. Everything is made again when the document has changed.
class CViewFrame {
public:
    explicit CViewFrame(CDBDoc& doc) : m_doc(doc) {}

    /// 1 done; 0 `why`: the model is not one that can be analysed.
    [[nodiscard]] int Refresh(std::string& why);
    const solver::T_FRAME& Frame() const { return m_model->Frame(); }
    /// Index of an element or node of the model by its id; -1: none.
    [[nodiscard]] long ElementAt(int id) const;
    [[nodiscard]] long NodeAt(int id) const;
    int ElementId(std::size_t element) const { return m_model->ElementIds()[element]; }
    int NodeId(std::size_t node) const { return m_model->NodeIds()[node]; }
    /// Local axes by the index of the element; nothing of one without length.
    const std::optional<T_MEMBER_AXES>& Axes(std::size_t element) const { return m_axes[element]; }
    [[nodiscard]] T_LINE_STIFFNESS Stiffness(std::size_t element) const;
    /// What the ends of the flexible length do when the nodes move so, local axes.
    [[nodiscard]] T_LINE_ENDS Ends(std::size_t element, const T_DOF6& nodeI,
                                   const T_DOF6& nodeJ) const;

    /// The loads that a source stands for: of a load case, of a combination with its factors, of
    /// a stage those that act at the step. 1 done; 0 `why`.
    [[nodiscard]] int LoadsOf(const T_SHAPE_SOURCE& source, int step, solver::T_LOAD_CASE& out,
                              std::string& why) const;
    /// By element: what acts along beams, their weight included, local axes.
    [[nodiscard]] std::vector<std::vector<T_LINE_LOAD>>
    LineLoads(const solver::T_LOAD_CASE& loads) const;

private:
    int AddCase(int key, double factor, solver::T_LOAD_CASE& to, std::string& why) const;

    CDBDoc& m_doc;
    std::optional<CAnalysisModel> m_model{};
    std::vector<std::optional<T_MEMBER_AXES>> m_axes;
    long m_revision = -1;
    std::string m_why; // not empty: the model can't be analysed
};

/// A vector in the axes of a member, and back.
[[nodiscard]] std::array<double, 3> ToAxes(const T_MEMBER_AXES& axes,
                                           const std::array<double, 3>& v);
[[nodiscard]] std::array<double, 3> FromAxes(const T_MEMBER_AXES& axes,
                                             const std::array<double, 3>& v);
