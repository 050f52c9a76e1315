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
    bool IsChanged() const { return !(m_material == m_read); }

    /// Grades that the material may have: of steel, of concrete and of its bars.
    bool TakesGrades(GRADE_OF of) const;
    /// The first entry stands for values of one's own.
    static std::vector<std::string> GradeTexts(GRADE_OF of);
    /// The grade that was taken, while the material has its strength and modulus; else 0.
    int GradeIndex(GRADE_OF of) const;
    /// Its values take the place of the material's.
    void OnGrade(GRADE_OF of, int index);
    /// Where the grades that were taken come from, and whether that was checked; else empty.
    std::string GradeNote() const;

    bool HasMean() const { return m_material.mean.has_value(); }
    /// Switched off and on again they are as they were.
    void OnMean(bool on);
    bool HasMasonry() const { return m_material.masonry.has_value(); }
    void OnMasonry(bool on);
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
    T_MATL_D m_read;    // as it was read
    T_MATL_MEAN m_mean; // while they are switched off
    T_MATL_MASONRY m_masonry;
    std::array<const T_MATL_GRADE*, 3> m_grades{}; // that were taken, by GRADE_OF
};
