// Model of the pushover load case dialog: control and stop criteria, and the list of load patterns.
// Lengths in the caller's units, angles in degrees. One class serves both dialogs of load cases.
#pragma once

#include "qm_db/records.h"
#include "qm_rps/hingedialog.h"

#include <functional>

class CPO_LoadCaseDlg : public CHingeDialog {
public:
    /// What is chosen and typed for a pattern row.
    struct T_PATTERN_INPUT {
        int kind = 0;           // 0 static load case, 1 uniform acceleration, 2 mode, 3 mode x mass
        int loadCase = 0;       // key of the chosen static load case
        int directionIndex = 0; // position in the list of directions, from 0
        double mode = 0.0;      // as typed; truncated
        double factor = 1.0;
    };

    /// Tells whether the document has an increment function (T_POFC_D) of this key.
    explicit CPO_LoadCaseDlg(std::function<bool(int key)> hasIncrementFunction);

    void Data2Dlg(const T_POLC_D& data);
    /// Checks, then writes. 0: `data` as it was. Where patterns were edited, the master kind is
    /// that of the first row and the modes are those of the mode rows.
    [[nodiscard]] int Dlg2Data(T_POLC_D& data);

    /// The case as edited. A case without control data (another solver's) checks its name alone.
    T_POLC_D m_case;
    int m_selected = -1; // index of the selected pattern row

    /// Rules of the record that are not kept, in the order of the check; CheckData shows the first.
    std::vector<T_FINDING> Findings() const override;

    /// What the row checks say of rows that are already stored.
    static std::vector<T_FINDING> PatternFindings(const std::vector<T_POLC_PATTERN>& rows);

    /// A row from the input. 0 refused with a message. A kind outside 0 to 3 raises the release
    /// assertion and gives a row with its scale factor only (number 0).
    [[nodiscard]] int CheckPattern(const T_PATTERN_INPUT& input, T_POLC_PATTERN& row);
    /// Checks and appends a row and selects it. 0 refused with a message, the list as it was.
    [[nodiscard]] int OnAddPattern(const T_PATTERN_INPUT& input);
    /// Checks and replaces the selected row.
    [[nodiscard]] int OnModifyPattern(const T_PATTERN_INPUT& input);
    [[nodiscard]] int OnDeletePattern();

private:
    bool HasSelection() const;

    std::function<bool(int)> m_hasIncrementFunction;
    bool m_patternsEdited = false;
};
