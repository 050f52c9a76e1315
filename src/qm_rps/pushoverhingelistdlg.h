// Model of the list of hinges generated for elements, with the texts of the hinge type's codes.
#pragma once

#include "qm_base/mdialog.h"
#include "qm_rps/generate/generatedtypes.h"
#include "qm_rps/yieldstrengthcalcoptdlg.h"

#include <vector>

class CPushOverHingeListDlg : public zql::frx::MDialog {
public:
    /// The document must outlive the list; strengths are in its current units.
    explicit CPushOverHingeListDlg(CDBDoc& doc) : m_doc(doc), m_types(doc) {}

    /// Text of the interaction kind 0 to 4; another code is an assertion failure and an empty text.
    static std::string InteractionText(int code);
    /// Interaction kinds of My and Mz and the curve families of a type's active components: "PMM,
    /// P; FEMA, multilinear".
    static std::string KindText(const T_PHGT_D& type);
    /// The same of the chosen type; empty: none is.
    std::string TypeKind() const;
    /// Text of the curve family: 0 multilinear, 1 FEMA; any other is shown as an error.
    static std::string FamilyText(int code);
    /// Head of the column of a component's strength: "Fx(+)", "Mz(-)".
    static std::string ColumnHead(HINGE_COMPONENT c, bool positive);
    /// Text of the strength's kind: crack or yield, force or moment.
    static std::string StrengthText(HINGE_COMPONENT c, bool crack);

    /// A row of the list: strengths of one kind per component and sign.
    struct T_ROW {
        int key = 0, element = 0;
        std::string type; // "2 : column", "2 : column, J-end"; an error text where it is gone
        std::array<T_SIDES<double>, 6> strengths{}; // 0: the end has no such hinge, or no strength
        std::string stale;   // strengths that are not those of today; empty: all are
        std::string fault{}; // of a generated type: why its numbers are not the code's today
        bool operator==(const T_ROW&) const = default;
    };
    /// Heads of the columns of strengths: "Fx(+)", "Fx(-)" ... "Mz(-)".
    static std::vector<std::string> Heads();
    /// The hinges by key with their crack or yield strengths; two rows for a hinge whose ends have
    /// strengths of their own.
    std::vector<T_ROW> Rows(bool crack) const;

    CDBDoc& Doc() const { return m_doc; }
    int m_selected = 0; // key of the chosen hinge; 0: none

    /// The chosen hinge exists. 0 with a message otherwise.
    int CheckData() override;

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

    CDBDoc& m_doc;
    mutable CGeneratedTypes m_types; // keeps what it found
    T_YIELD_CALC_OPT m_options;
};
