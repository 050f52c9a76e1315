// Model of the main dialog of unknown load factors: the list of items.
#pragma once

#include "qm_base/mdialog.h"
#include "qm_db/dbdoc.h"

class CUnknownLoadFactorDlg : public zql::frx::MDialog {
public:
    struct T_ROW {
        int key = 0;
        std::string name;
        std::string combination; // its name; empty when it is gone
        bool operator==(const T_ROW&) const = default;
    };

    explicit CUnknownLoadFactorDlg(CDBDoc& doc) : m_doc(doc) {}

    /// In the order of definition.
    std::vector<T_ROW> Rows() const;

    int m_selected = 0; // key of the chosen item; 0: none
    /// Open the item dialog on a new item or on the chosen one. 1 stored; 0 cancelled or refused
    /// with a message: no general combination in the model (add), no such item any more (modify).
    [[nodiscard]] int OnAdd();
    [[nodiscard]] int OnModify();
    /// Deletes the chosen item; can be undone. 0 with a message: no such item.
    [[nodiscard]] int OnDelete();
    /// The chosen item exists; 0 with a message otherwise.
    int CheckData() override;

private:
    CDBDoc& m_doc;
};
