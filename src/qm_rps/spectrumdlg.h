// Model of the window of a spectrum: kind, parameters, what follows from them, two pictures.
#pragma once

#include "qm_base/checkeddialog.h"
#include "qm_db/dbdoc.h"
#include "qm_rps/create/spectrumedit.h"

class CSpectrumDlg : public CCheckedDialog {
public:
    /// The document must outlive the dialog. key: of the spectrum; 0: the first one, or a new one
    /// where there is none.
    explicit CSpectrumDlg(CDBDoc& doc, int key = 0);

    int Key() const { return m_key; } // 0: not stored yet
    std::vector<std::string> Names() const;
    int Index() const; // -1: a new one
    /// Another spectrum, or a new one. What was changed is stored first, if the person wants it and
    /// it is sound; else this one stays, or its changes go.
    void OnSelChange(int index);
    void OnNew();

    CSpectrumEdit m_edit; // in current units
    bool IsChanged() const { return !(m_edit.Record() == m_read); }
    T_UNITS Units() const { return m_doc.Unit().Units(); }
    /// Symbols, values, units, meanings; empty while a rule is not kept.
    T_TEXT_TABLE Values() const;
    /// "ec8-2004:soil=C,ag=0.25,type=1", as commands take it.
    std::string CommandText() const;

    std::vector<T_FINDING> Findings() const override;
    /// Checks, then stores the spectrum as one edit that can be undone; evaluations follow a new
    /// name. 0: refused.
    int OnOK() override;

private:
    bool MayLeave();
    void Read(int key);
    int Store();

    CDBDoc& m_doc;
    int m_key = 0;
    T_SPFC_D m_read; // as it was read
};
