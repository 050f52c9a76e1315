// Model of the window of a material: its stiffness and strengths, and what is known of it where it
// stands already.
#pragma once

#include "qm_base/checkeddialog.h"
#include "qm_db/dbdoc.h"

class CMaterialDlg : public CCheckedDialog {
public:
    /// The document must outlive the dialog. key: of the material; 0: the first one, or a new one
    /// where there is none.
    explicit CMaterialDlg(CDBDoc& doc, int key = 0);

    int Key() const { return m_key; } // 0: not stored yet
    std::vector<std::string> Names() const;
    int Index() const; // -1: a new one
    /// Another material, or a new one. What was changed is stored first, if the person wants it and
    /// it is sound; else this one stays, or its changes go.
    void OnSelChange(int index);
    void OnNew();

    T_MATL_D m_material; // as edited, in current units
    bool HasMean() const { return m_material.mean.has_value(); }
    /// Switched off and on again they are as they were.
    void OnMean(bool on);
    /// Of EN 1998-3: what the mean strengths are divided by; empty: not known.
    std::optional<double> Confidence() const;

    T_UNITS Units() const { return m_doc.Unit().Units(); }
    std::vector<T_FINDING> Findings() const override;
    /// Checks, then stores the material as one edit that can be undone. 0: refused.
    int OnOK() override;

private:
    bool MayLeave();
    void Read(int key);
    int Store();

    CDBDoc& m_doc;
    int m_key = 0;
    T_MATL_D m_read; // as it was read
    T_MATL_MEAN m_mean;
};
