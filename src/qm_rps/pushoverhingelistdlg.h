// Model of the list of hinges generated for elements, with the texts of the hinge type's codes.
#pragma once

#include "qm_base/mdialog.h"
#include "qm_db/hingerecords.h"
#include "qm_db/records.h"

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
};
