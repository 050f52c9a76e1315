// Model of the description of the effective section properties: the properties of the section times
// its stiffness factors at the I-end and the J-end, in the document's current units.
#pragma once

#include "qm_base/mdialog.h"
#include "qm_db/dbdoc.h"

class CYieldStrengthCalcOptEffDescDlg : public zql::frx::MDialog {
public:
    /// What the numbers mean.
    static constexpr const char* kNoteKey = "IDS_QM_YSCO_SECTION";
    struct T_ROW {
        int element = 0;
        std::string section;                   // name; empty: faultKey says why
        T_ENDS<T_SECT_FACTORS> factors;        // as the section has them
        T_ENDS<T_SECT_FACTORS> effective;      // property times factor
        std::array<double, 2> plasticModuli{}; // Zy, Zz, without factors
        /// Avy, Avz of the strength of steel, without factors; 0 for other materials.
        std::array<double, 2> shearAreas{};
        const char* faultKey = ""; // IDS_CMD_IEHP_NO_SECT, or the section's fault
        bool operator==(const T_ROW&) const = default;
    };

    CYieldStrengthCalcOptEffDescDlg(CDBDoc& doc, const std::vector<int>& elements);
    const std::vector<T_ROW>& Rows() const { return m_rows; }
    /// The rows as a table with units in its heads; where something is missing the last cell says
    /// what.
    std::vector<std::string> Heads() const;
    std::vector<std::string> Cells(std::size_t row) const;

private:
    T_UNITS m_units; // for the heads
    std::vector<T_ROW> m_rows;
};
