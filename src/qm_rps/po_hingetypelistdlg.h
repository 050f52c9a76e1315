// Model of the list of hinge types of a document, in its current units.
#pragma once

#include "qm_base/mdialog.h"
#include "qm_db/dbdoc.h"
#include "qm_rps/generate/generatedtypes.h"

#include <optional>

class CPO_HingeTypeListDlg : public zql::frx::MDialog {
public:
    struct T_ROW {
        int key = 0;
        std::string name;    // "1 : column", key and name
        std::string element; // text of the element type
        std::string code{};  // that has generated it: "ASCE41-17"; empty: none
        std::string fault{}; // of a generated one: why its numbers are not those of the code today
        bool operator==(const T_ROW&) const = default;
    };
    static constexpr std::array<const char*, 3> kHeads{
        "IDS_RPS_PO_Hinge_Name", "IDS_RPS_PO_Element_Type", "IDS_QM_UI_GEN_GENERATED"};

    /// The document must outlive the list.
    explicit CPO_HingeTypeListDlg(CDBDoc& doc) : m_doc(doc), m_types(doc) {}

    std::vector<T_ROW> Rows() const;
    /// Text of an element type; a value outside the five is shown as an error, not refused.
    static std::string DataToStr(HINGE_ELEMENT element);
    /// "%d : %s"
    static std::string NameOf(int key, const std::string& name);

    /// The message for a chosen key: none chosen (0), or no such type; none where all is well.
    static std::optional<zql::frx::T_MESSAGE> ChoiceFault(int key, bool exists);

    /// Key of the chosen type; 0: none.
    int m_selected = 0;
    /// The chosen type exists. 0 with a message otherwise.
    int CheckData() override;
    /// Deletes the chosen type. 0 with a message: none chosen, gone, or used (naming elements).
    [[nodiscard]] int OnDelete();
    /// A new type, or the chosen one, in the editor. 1 stored, and the type is chosen then.
    [[nodiscard]] int OnAdd();
    [[nodiscard]] int OnModify();
    /// A copy of the chosen type under the next key, with a name of its own ("column (2)").
    [[nodiscard]] int OnCopy();
    /// The chosen type, "beam-column, My" and the elements that use it; empty: none is chosen.
    std::string Description() const;

private:
    int Edit(int key, const T_PHGT_D& type, bool fresh);

    CDBDoc& m_doc;
    mutable CGeneratedTypes m_types; // keeps what it found
};
