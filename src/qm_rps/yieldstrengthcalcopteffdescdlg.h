// Model of the description of the effective section properties: the properties of the section times
// its stiffness factors at the I-end and the J-end, in the caller's units.
#pragma once

#include "qm_rps/yieldstrengthcalcoptmatdescdlg.h"

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
        const char* faultKey = "";             // IDS_CMD_IEHP_NO_SECT, or the section's fault
        bool operator==(const T_ROW&) const = default;
    };

    CYieldStrengthCalcOptEffDescDlg(const std::vector<int>& elements,
                                    const T_YIELD_CALC_LOOKUP& lookup);
    const std::vector<T_ROW>& Rows() const { return m_rows; }

private:
    std::vector<T_ROW> m_rows;
};
