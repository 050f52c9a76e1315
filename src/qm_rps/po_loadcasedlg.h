// Model of the pushover load case dialog: control and stop criteria, and the list of load patterns.
// Lengths in the caller's units, angles in degrees. With a document it edits one of its load cases
// and stores it on OK; without one it checks what it is given, as if in an empty model.
#pragma once

#include "qm_rps/rpsdlgbase.h"

class CPO_LoadCaseDlg : public CRPSDlgBase {
public:
    /// What is chosen and typed for a pattern row.
    struct T_PATTERN_INPUT {
        int kind = 0;           // 0 static load case, 1 uniform acceleration, 2 mode, 3 mode x mass
        int loadCase = 0;       // key of the chosen static load case
        int directionIndex = 0; // position in the list of directions, from 0
        double mode = 0.0;      // as typed; truncated
        double factor = 1.0;
    };

    /// Takes the document and its first load case, or a new one where it has none.
    void SetDoc(CDBDoc* doc) override;
    /// Reads a load case of the document; 0: a new one, with the node at the top as control node.
    /// 1 done; 0 there is no such one, all as it was.
    [[nodiscard]] int SetKey(int key);
    /// Key of the load case that is edited; 0: a new one.
    int Key() const { return m_key; }
    /// The host chooses the load case to show. One that is not there changes nothing.
    void ExternalSetting(int key);
    /// Checks, then stores in the document as one edit that can be undone; evaluations follow a
    /// new name. A new load case gets the next key. 0 with a message, the document as it was; so
    /// too where the stored case or the units have changed since it was read (another edit, an
    /// undo, another model). Stops that can't act are said (StopWarnings) and stored.
    int OnOK() override;
    /// A new load case of a document: with control data and a name that is free.
    static T_POLC_D MakeNew(CDBDoc& doc);
    /// Key of the next load case: no stored results wait under it.
    static int NextKey(const CDBDoc& doc);
    /// Whether the case has results. They hold in its direction, which then stays.
    bool HasResults() const;

    void Data2Dlg(const T_POLC_D& data);
    /// Checks, then writes. 0: `data` as it was. Where patterns were edited, the master kind is
    /// that of the first row and the modes are those of the mode rows.
    [[nodiscard]] int Dlg2Data(T_POLC_D& data);

    /// The case as edited. A case without control data (another solver's) checks its name alone.
    T_POLC_D m_case;
    int m_selected = -1; // index of the selected pattern row
    /// Takes another state of it, whose pattern rows may be others.
    void TakeCase(T_POLC_D record);

    /// Where the push starts: the initial loads of the global control, loads of its own, or the end
    /// of another load case (the first other one, where none was named yet; without any the case
    /// stays where it starts).
    enum class START { Global, Own, OtherCase };
    START Start() const;
    void SetStart(START start);
    /// Names of the other load cases.
    std::vector<std::string> OtherCases() const;
    /// What the case follows where it has nothing of its own.
    T_POGC_D GlobalControl() const;

    T_PATTERN_INPUT m_input; // what OnAddPattern and OnModifyPattern of a window take

    /// Rules of the record that are not kept, in the order of the check, then those of the document
    /// (free name, existing node, modes and load cases); CheckData shows the first.
    std::vector<T_FINDING> Findings() const override;

    /// A row from the input. 0 refused with a message. A kind outside 0 to 3 raises the release
    /// assertion and gives a row with its scale factor only (number 0).
    [[nodiscard]] int CheckPattern(const T_PATTERN_INPUT& input, T_POLC_PATTERN& row);
    /// Checks and appends a row and selects it. 0 refused with a message, the list as it was.
    [[nodiscard]] int OnAddPattern(const T_PATTERN_INPUT& input);
    /// Checks and replaces the selected row.
    [[nodiscard]] int OnModifyPattern(const T_PATTERN_INPUT& input);
    [[nodiscard]] int OnDeletePattern();
    /// Chooses a row (-1: none) and takes it as input.
    void SelectPattern(int row);

    /// What a pattern row names, in words.
    std::string NumberText(const T_POLC_PATTERN& row) const;
    std::vector<std::string> LoadCaseNames() const;
    std::vector<std::string> FunctionNames() const;
    /// Keys in the order of these names.
    std::vector<int> LoadCaseKeys() const;
    std::vector<int> FunctionKeys() const;

private:
    bool HasSelection() const;
    /// Shows the first of them. True where there is none.
    bool IsKept(const std::vector<T_FINDING>& findings);
    bool Store(CEditScope& edit, const T_POLC_D& record);
    bool IsAsRead();
    void KeepRead();

    int m_key = 0;
    T_POLC_D m_read; // in SI, when the case was read
    T_UNITS m_units; // of the document then
    bool m_patternsEdited = false;
};
