// Model of the main dialog of unknown load factors: the list of items, static ones and those of
// construction stages.
#pragma once

#include "qm_base/mdialog.h"
#include "qm_db/dbdoc.h"
#include "qm_rps/ulfitemdialog.h"

#include <memory>

class CUnknownLoadFactorDlg : public zql::frx::MDialog {
public:
    struct T_ROW {
        int key = 0;
        std::string name;
        std::string combination; // its name; empty when it is gone, and of an item of stages
        bool stage = false;      // an item of construction stages; keys run per kind
        bool operator==(const T_ROW&) const = default;
    };

    explicit CUnknownLoadFactorDlg(CDBDoc& doc) : m_doc(doc) {}

    /// Static items in the order of definition, then those of stages.
    std::vector<T_ROW> Rows() const;

    int m_selected = 0;   // key of the chosen item; 0: none
    bool m_stage = false; // it is one of construction stages
    /// Open the item dialog on a new item or on the chosen one. 1 stored; 0 cancelled or refused
    /// with a message: no general combination in the model (add), no such item any more (modify).
    [[nodiscard]] int OnAdd();
    /// The same with an item of construction stages; refused in a model that has none.
    [[nodiscard]] int OnAddStage();
    [[nodiscard]] int OnModify();
    /// Deletes the chosen item; can be undone. 0 with a message: no such item.
    [[nodiscard]] int OnDelete();
    /// The dialog of the chosen item, with this one's view, for its calculation. Null with a
    /// message: no such item. It must not outlive this object.
    std::unique_ptr<CUlfItemDialog> ChosenItem();
    /// The chosen item exists; 0 with a message otherwise.
    int CheckData() override;

private:
    template <class DIALOG>
    [[nodiscard]] int Show(DIALOG&& dialog, bool stage);

    CDBDoc& m_doc;
};
