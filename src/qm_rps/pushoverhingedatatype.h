// Model of the older editor of one hinge type: the table of the hinge diagram of a component
// (FEMA curve, ASCE 41 7.5.1) and its acceptance criteria.
// Units: as the type's. Signs: the negative side holds negative numbers.
#pragma once

#include "qm_base/checkeddialog.h"
#include "qm_db/dbdoc.h"
#include "qm_rps/hinge/hingelabels.h"

class CPushOverHingeDataType : public CCheckedDialog {
public:
    /// Names of the rows of the diagram.
    static constexpr std::array<const char*, 9> kRows{"-E", "-D", "-C", "-B", "A",
                                                      "B",  "C",  "D",  "E"};
    /// Names of the criteria.
    static constexpr std::array<const char*, 3> kCriteria{"IO", "LS", "CP"};

    /// The document must outlive the editor; values are in its current units.
    explicit CPushOverHingeDataType(CDBDoc& doc) : m_doc(doc) {}
    CDBDoc& Doc() const { return m_doc; }

    /// Chooses the first FEMA curve of the document, or its first type where there is none. 0 with
    /// a message: the document has no hinge type.
    [[nodiscard]] int ChooseFirst();
    /// Chooses another type or component. Edits of the one on show are lost: the person is asked
    /// first. Where the component has no FEMA curve nothing can be edited (IsTaken).
    void OnSelChange(int key, HINGE_COMPONENT component);
    /// Key of the type on show; 0: none.
    int Key() const { return m_key; }
    HINGE_COMPONENT ComponentOnShow() const { return m_component; }
    /// Whether the component has a FEMA curve, which can be edited.
    bool IsTaken() const { return m_taken; }
    /// Whether the negative side of the curve follows the positive one.
    bool IsSymmetric() const;
    T_HINGE_OWNER Owner() const { return {m_type, m_doc.Unit().Units()}; }
    /// The curve as edited, or null.
    const T_SKEL_FEMA* Shown() const;
    /// After each edit: the negative side of a symmetric curve follows the positive one.
    void OnEdited();
    /// Field of a point's values, as findings name it: "sides.pos.B."; empty for A.
    static std::string PointField(std::size_t row);

    /// Takes a type and shows the diagram of a component. 0 with a message: no type chosen (key 0),
    /// or it does not exist; 0 without one: the component has no FEMA curve. Nothing changes then.
    [[nodiscard]] int Data2Dlg(int key, HINGE_COMPONENT component);

    /// Switches the measure of the curve. 0: nothing is shown, or (with a message) a side has no
    /// yield deformation to convert with, and the curve is as it was.
    [[nodiscard]] int OnMeasureRdo(SKEL_MEASURE measure);
    /// The deformation of a row in the measure that is not shown; "-" without a yield deformation,
    /// empty for A.
    std::string OtherMeasureText(std::size_t row) const;
    /// A point of the diagram by its row, or null (row A, which is the origin, and rows outside).
    T_SKEL_POINT* Point(std::size_t row);
    /// A criterion of a side, or null.
    double* Criterion(std::size_t index, bool positive);

    /// See DiagramFindings.
    std::vector<T_FINDING> Findings() const override;
    /// Checks and stores. 0: a finding, the type is gone, or the document refused.
    [[nodiscard]] int OnOK() override;

private:
    T_SKEL_FEMA* Curve();

    CDBDoc& m_doc;
    int m_key = 0;
    HINGE_COMPONENT m_component = HINGE_COMPONENT::My;
    T_PHGT_D m_type;
    T_PHGT_D m_given; // as it was taken
    bool m_taken = false;
};
