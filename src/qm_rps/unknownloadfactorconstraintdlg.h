// Model of the dialog of one unknown load factor constraint. Values in the document's current
// units.
#pragma once

#include "qm_base/checkeddialog.h"
#include "qm_db/dbdoc.h"

class CUnknownLoadFactorConstraintDlg : public CCheckedDialog {
public:
    /// Texts of the types, by code; of the place that an equality is compared with, likewise.
    static constexpr std::array<const char*, 4> kTypeKeys{"IDS_QM_ULFC_REACTION",
                                                          "IDS_QM_ULFC_DISPLACEMENT",
                                                          "IDS_QM_ULFC_TRUSS", "IDS_QM_ULFC_BEAM"};
    static constexpr std::array<const char*, 4> kOtherKeys{
        "IDS_RPS_Other_Node", "IDS_RPS_Other_Node", "IDS_RPS_Other_Truss", "IDS_RPS_Other_Beam"};

    /// The document must outlive the dialog. key: of the constraint to edit, 0 for a new one.
    explicit CUnknownLoadFactorConstraintDlg(CDBDoc& doc, int key = 0);

    void Data2Dlg(const T_ULFC_D& constraint) { m_constraint = constraint; }
    /// Checks, then writes. 0: a message was shown, `constraint` as it was. What the chosen
    /// kind does not use is dropped (FitRecord).
    [[nodiscard]] int Dlg2Data(T_ULFC_D& constraint);

    T_ULFC_D m_constraint; // as edited

    /// Texts of the components that the chosen type offers, by index.
    std::vector<std::string> ComponentTexts() const;

    /// Another type: a component that it does not offer becomes the first one.
    void OnSelChangeType(int type);
    /// What the quantity is held to: a value, the same quantity elsewhere, or bounds.
    enum RELATION { EqualsValue, EqualsOther, Bounds };
    static constexpr std::array<const char*, 3> kRelationKeys{
        "IDS_QM_UI_ULF_EQUALS_VALUE", "IDS_QM_UI_ULF_EQUALS_OTHER", "IDS_QM_UI_ULF_BOUNDS"};
    RELATION Relation() const;
    void OnSelChangeRelation(int relation);
    static std::vector<std::string> PositionTexts();
    /// Unit of value and bounds.
    std::string UnitText() const;

    /// Construction stages: the first choice is none (a result of static load cases).
    std::vector<std::string> PlaceTexts() const;
    int PlaceIndex() const; // -1: a place that the model does not have
    void OnSelChangePlace(int index);

    /// Rules that are not kept, in the order of the check; CheckData shows the first.
    std::vector<T_FINDING> Findings() const override;
    /// Checks, then stores the constraint as one edit that can be undone; items that name it take
    /// a changed name over in the same edit. 0: refused, nothing stored.
    int OnOK() override;
    int Key() const { return m_key; }

private:
    CDBDoc& m_doc;
    int m_key = 0;
};
