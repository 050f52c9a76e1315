// Model of the list of hinges generated for elements, with the texts of the hinge type's codes.
#pragma once

#include "qm_base/mdialog.h"
#include "qm_db/records.h"
#include "qm_rps/yieldstrengthcalcoptdlg.h"

#include <functional>
#include <vector>

class CPushOverHingeListDlg : public zql::frx::MDialog {
public:
    /// Text of the interaction kind 0 to 4; another code is an assertion failure and an empty text.
    static std::string InteractionText(int code);
    /// Text of the curve family: 0 multilinear, 1 FEMA; any other is shown as an error.
    static std::string FamilyText(int code);
    /// Head of the column of a component's strength: "Fx(+)", "Mz(-)".
    static std::string ColumnHead(HINGE_COMPONENT c, bool positive);
    /// Text of the strength's kind: crack or yield, force or moment.
    static std::string StrengthText(HINGE_COMPONENT c, bool crack);

    /// A row of the list: strengths of one kind per component and sign.
    struct T_ROW {
        int key = 0, element = 0;
        std::string type; // "2 : column"; an error text where it is gone
        std::array<T_SIDES<double>, 6> strengths{};
        bool operator==(const T_ROW&) const = default;
    };
    /// Heads of the columns of strengths: "Fx(+)", "Fx(-)" ... "Mz(-)".
    static std::vector<std::string> Heads();
    /// The hinges by key with their crack or yield strengths.
    std::vector<T_ROW> Rows(bool crack) const;

    std::function<T_TABLE<T_PHGE_D>()> m_hinges; // all generated hinges by key
    std::function<T_TABLE<T_PHGT_D>()> m_types;  // all hinge types by key
    int m_selected = 0;                          // key of the chosen hinge; 0: none

    /// The chosen hinge exists. 0 with a message otherwise.
    int CheckData() override;

    /// Hinges of a type for elements; 1 stored, 0 with the reason. Deletes a hinge; 1 deleted.
    std::function<int(int type, const std::vector<int>& elements, std::string& refusal)> m_generate;
    std::function<int(int key)> m_erase;
    /// Elements of the document that hinges of such a type can be for, ascending; the kind of an
    /// element; its section and material.
    std::function<std::vector<int>(HINGE_ELEMENT)> m_elements;
    std::function<std::optional<HINGE_ELEMENT>(int id)> m_kindOf;
    T_YIELD_CALC_LOOKUP m_lookup;
    T_UNITS m_units;      // of the strengths
    bool m_crack = false; // crack strengths are shown, else yield strengths
    int m_type = 0;       // key of the type of new hinges; 0: none

    /// Another type: the elements are all that suit it again, where the kind is another one.
    void OnSelChangeType(int type);
    /// Which elements get hinges: all, or those of the options.
    std::vector<int> Elements() const;
    /// Runs the options of the yield strength calculation in the view; 1 accepted.
    [[nodiscard]] int OnOptionBtn();
    /// Hinges of the type for these elements, one edit. 0 with a message.
    [[nodiscard]] int OnGenerate();
    /// Deletes the chosen hinge. 0 with a message.
    [[nodiscard]] int OnDelete();

private:
    std::optional<HINGE_ELEMENT> TypeElement() const;

    T_YIELD_CALC_OPT m_options;
};
