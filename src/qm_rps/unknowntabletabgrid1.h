// Model of the list of unknown load factor constraints.
#pragma once

#include "qm_base/mdialog.h"
#include "qm_db/dbdoc.h"

class CUnknownTableTabGrid1 : public zql::frx::MDialog {
public:
    struct T_ROW {
        int key = 0;
        std::string name;
        /// Quantity, relation and bound in the document's current units; stage and step, if any.
        std::string description;
        bool operator==(const T_ROW&) const = default;
    };

    explicit CUnknownTableTabGrid1(CDBDoc& doc) : m_doc(doc) {}

    /// In the order of definition.
    std::vector<T_ROW> Rows() const;

    int m_selected = 0; // key of the chosen constraint; 0: none
    /// Open the constraint dialog on a new one or on the chosen one. 1 stored; 0 cancelled, or
    /// (modify) refused with a message because none is chosen or it is gone.
    [[nodiscard]] int OnAdd();
    [[nodiscard]] int OnModify();
    /// Deletes the chosen constraint. 0 with a message: none chosen, gone, or used by items, which
    /// are named.
    [[nodiscard]] int OnDelete();
    /// The chosen constraint exists; 0 with a message otherwise.
    int CheckData() override;

private:
    CDBDoc& m_doc;
};
