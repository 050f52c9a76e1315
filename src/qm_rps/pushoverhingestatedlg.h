// Model of the window that shows the hinges of a push step by step: on the frame, in a list, and
// one of them on its law.
#pragma once

#include "qm_rps/desk/hingemarks.h"
#include "qm_rps/pushoverresultdlg.h"

class CPushOverHingeStateDlg : public CPushOverResultDlg {
public:
    static constexpr std::array<const char*, 6> kHeads{
        "IDS_QM_UI_PUSH_HINGE_ELEMENT",   "IDS_QM_UI_PUSH_HINGE_END",
        "IDS_QM_UI_PUSH_HINGE_COMPONENT", "IDS_QM_UI_PUSH_HINGE_DEFORMATION",
        "IDS_QM_UI_PUSH_HINGE_FORCE",     "IDS_QM_UI_PUSH_HINGE_STATE"};

    explicit CPushOverHingeStateDlg(CDBDoc& doc);

    /// The table: all hinge components, or those that are not elastic in the step.
    bool m_onlyYielded = false;
    void OnFilter();
    std::size_t Rows() const { return m_rows.size(); }
    std::string CellText(std::size_t row, std::size_t column) const;
    PUSH_STATE StateAt(std::size_t row) const;
    /// "kN m", "rad": of the table's forces and deformations, which differ by component.
    std::string UnitsText() const;

    /// The hinge that is looked at, by its place in the run; -1: none.
    long Hinge() const { return m_hinge; }
    void OnHinge(long hinge);
    int HingeRow() const; // -1: not in the table
    void OnHingeRow(int row);
    std::string HingeText() const; // "Element 3 at J, My"

    /// The frame in the step, in current units; valid until another result is shown.
    const T_FRAME_SCENE& Scene() { return m_scene.Scene(); }
    const std::vector<std::array<double, 3>>& Moves() const { return m_moves; }
    const T_HINGE_MARKS& Marks() const { return m_marks; }
    double Scale() const { return m_scale; } // of the displacements: one for all steps

private:
    void OnShown(bool anotherResult) override;
    void ShowMoves(int step);
    void ShowRows();

    CFrameScene m_scene;
    std::vector<std::array<double, 3>> m_moves;
    T_HINGE_MARKS m_marks;
    std::vector<std::size_t> m_rows; // hinges of the run
    long m_hinge = -1;
    double m_scale = 1.0;
};
