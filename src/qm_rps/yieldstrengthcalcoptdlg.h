// Model of the dialog of the options of the yield strength calculation.
#pragma once

#include "qm_base/mdialog.h"
#include "qm_db/dbdoc.h"

#include <string>

struct T_YIELD_CALC_OPT {
    bool selectedOnly = false; // calculate for the selected elements alone
    std::vector<int> elements; // their ids, ascending
    bool operator==(const T_YIELD_CALC_OPT&) const = default;
};

struct T_SELECTED_ELEM {
    int id = 0;
    HINGE_ELEMENT element = HINGE_ELEMENT::BeamColumn;
};

class CYieldStrengthCalcOptDlg : public zql::frx::MDialog {
public:
    /// `element`: the kind of element that the calculation is for. The document must outlive this.
    CYieldStrengthCalcOptDlg(CDBDoc& doc, HINGE_ELEMENT element) : m_doc(doc), m_element(element) {}

    static constexpr const char* kTitleKey = "IDS_DB_DT_YSCO";

    void SetData(const T_YIELD_CALC_OPT& data) { m_data = data; }
    void GetData(T_YIELD_CALC_OPT& data) const { data = m_data; }

    /// Restricts the calculation to the selection, or takes the restriction off. 0 shows
    /// IDS_CMD2_SOD_SEL_ELEM_WRONG_ELEM for an element of another kind; the options stay.
    int OnSelectElemChk(bool on, const std::vector<T_SELECTED_ELEM>& selection);
    /// Restricts the calculation to the elements of a list, "1, 2, 5-9". 0 with a message: no such
    /// list, or an element does not exist or is of another kind; the options stay.
    int OnSelectionText(const std::string& text);
    std::string SelectionText() const;
    const T_YIELD_CALC_OPT& Data() const { return m_data; }

    /// What the design codes of the model mean for the calculation.
    std::string ModeText() const;
    /// The elements of the calculation, ascending: the selected ones, or all that suit it.
    std::vector<int> Elements() const;
    /// Show the material strengths, and the effective section properties, of these elements in the
    /// view. 0 without a view.
    int OnMatlDescBtn();
    int OnEffeDescBtn();

private:
    CDBDoc& m_doc;
    HINGE_ELEMENT m_element;
    T_YIELD_CALC_OPT m_data;
};
