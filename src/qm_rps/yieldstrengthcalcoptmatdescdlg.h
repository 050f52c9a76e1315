// Model of the description of the material strengths that a yield strength calculation uses.
// Characteristic values without partial factors, in the caller's units.
#pragma once

#include "qm_base/mdialog.h"
#include "qm_db/records.h"

#include <functional>

/// Section and material of an element; null what it lacks.
struct T_YIELD_CALC_ELEM {
    std::optional<T_SECT_D> section;
    std::optional<T_MATL_D> material;
};
using T_YIELD_CALC_LOOKUP = std::function<T_YIELD_CALC_ELEM(int element)>;

class CYieldStrengthCalcOptMatDescDlg : public zql::frx::MDialog {
public:
    T_UNITS m_units; // for the heads
    /// What the numbers mean.
    static constexpr const char* kNoteKey = "IDS_QM_YSCO_MATERIAL";
    /// Strengths that the material's class uses; the others are empty.
    struct T_ROW {
        int element = 0;
        std::string material;        // name; empty: faultKey says why
        std::optional<double> Fy;    // steel
        std::optional<double> fck;   // concrete and masonry
        std::optional<double> fyk;   // bars
        std::optional<double> E, Es; // elastic moduli of the material and of the bars
        const char* faultKey = "";   // IDS_CMD_IEHP_NO_MATL
        bool operator==(const T_ROW&) const = default;
    };

    CYieldStrengthCalcOptMatDescDlg(const std::vector<int>& elements,
                                    const T_YIELD_CALC_LOOKUP& lookup);
    const std::vector<T_ROW>& Rows() const { return m_rows; }
    /// The rows as a table with units in its heads; where something is missing the last cell says
    /// what.
    std::vector<std::string> Heads() const;
    std::vector<std::string> Cells(std::size_t row) const;

private:
    std::vector<T_ROW> m_rows;
};
