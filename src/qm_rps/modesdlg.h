// Model of the window of a model's modes: found by an analysis, or typed.
#pragma once

#include "qm_base/mdialog.h"
#include "qm_db/dbdoc.h"
#include "qm_rps/create/typedmode.h"
#include "qm_rps/dialog/texttable.h"

#include <functional>

class CModesDlg : public zql::frx::MDialog {
public:
    /// The document must outlive the dialog.
    explicit CModesDlg(CDBDoc& doc) : m_doc(doc) {}

    int m_count = 6; // that the analysis finds

    /// Runs work that tells parts done of a total and stops where that asks it to (false); set by
    /// the application. Empty: it runs untold.
    using TELL_FN = std::function<bool(std::size_t, std::size_t)>;
    std::function<int(const std::function<int(TELL_FN)>&)> m_withProgress;
    /// Finds modes, which take the place of all that the model has, as an edit that can be undone.
    /// 0 with a message.
    int OnFind();

    // ---- typed ----
    double m_period = 1.0; // s
    int m_direction = 0;   // 0 X, 1 Y
    std::string m_shape;   // list by storey
    /// Adds the typed mode behind the others, as an edit that can be undone. 0 with a message.
    int OnAdd();
    int Chosen() const { return m_chosen; } // row; -1: none
    void OnChoose(int row) { m_chosen = row; }
    /// Deletes the chosen mode; those behind it move up. 0 with a message: nothing is chosen, or
    /// pushover load cases name a mode.
    int OnDelete();

    /// Number, period, and per cent of the mass along X, Y and Z: a row each.
    T_TEXT_TABLE Table();
    std::string NotesText() const;
    /// Which pushover load cases name modes by number: modes that are found anew may change under
    /// them. Empty: none does.
    std::string PushesText() const;

private:
    int Refuse(const char* key, const std::string& text);
    int PutModes(const std::vector<T_EIGV_D>& modes);

    CDBDoc& m_doc;
    int m_chosen = -1;
};
