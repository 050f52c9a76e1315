// Model of the description of the material strengths that a yield strength calculation uses.
// Characteristic values without partial factors, in the document's current units.
#pragma once

#include "qm_base/mdialog.h"
#include "qm_db/dbdoc.h"
#include "qm_rps/codes/concretelaw.h"

#include <optional>

class CYieldStrengthCalcOptMatDescDlg : public zql::frx::MDialog {
public:
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
        /// Law of concrete; empty for other materials and above C90.
        std::optional<T_CONCRETE_LAW> law{};
        const char* faultKey = ""; // IDS_CMD_IEHP_NO_MATL
        bool operator==(const T_ROW&) const = default;
    };

    CYieldStrengthCalcOptMatDescDlg(CDBDoc& doc, const std::vector<int>& elements);
    const std::vector<T_ROW>& Rows() const { return m_rows; }
    /// The rows as a table with units in its heads; where something is missing the last cell says
    /// what.
    std::vector<std::string> Heads() const;
    std::vector<std::string> Cells(std::size_t row) const;

private:
    T_UNITS m_units; // for the heads
    std::vector<T_ROW> m_rows;
};
