// Model of the dialog of the options of the yield strength calculation.
#pragma once

#include "qm_rps/yieldstrengthcalcoptmatdescdlg.h"

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
    T_UNITS m_units; // for the heads of the descriptions
    /// `element`: the kind of element that the calculation is for.
    explicit CYieldStrengthCalcOptDlg(HINGE_ELEMENT element = HINGE_ELEMENT::BeamColumn)
        : m_element(element)
    {
    }

    static constexpr const char* kTitleKey = "IDS_DB_DT_YSCO";

    void SetData(const T_YIELD_CALC_OPT& data) { m_data = data; }
    void GetData(T_YIELD_CALC_OPT& data) const { data = m_data; }

    /// Restricts the calculation to the selection, or takes the restriction off. 0 shows
    /// IDS_CMD2_SOD_SEL_ELEM_WRONG_ELEM for an element of another kind; the options stay.
    int OnSelectElemChk(bool on, const std::vector<T_SELECTED_ELEM>& selection);
    /// Kind of an element of the document, or none: it does not exist.
    std::function<std::optional<HINGE_ELEMENT>(int id)> m_kindOf;
    /// Restricts the calculation to the elements of a list, "1, 2, 5-9". 0 with a message: no such
    /// list, or an element does not exist or is of another kind; the options stay.
    int OnSelectionText(const std::string& text);
    std::string SelectionText() const;
    const T_YIELD_CALC_OPT& Data() const { return m_data; }

    /// Elements that the calculation is for when it is not restricted, ascending, and where their
    /// sections and materials come from.
    void SetElements(std::vector<int> elements, T_YIELD_CALC_LOOKUP lookup);
    /// The elements of the calculation: the selected ones, or all.
    const std::vector<int>& Elements() const
    {
        return m_data.selectedOnly ? m_data.elements : m_all;
    }
    /// Show the material strengths, and the effective section properties, of these elements in the
    /// view. 0 without a view.
    int OnMatlDescBtn();
    int OnEffeDescBtn();

private:
    HINGE_ELEMENT m_element;
    T_YIELD_CALC_OPT m_data;
    std::vector<int> m_all;
    T_YIELD_CALC_LOOKUP m_lookup;
};
