// Model of the window that makes storeys from the levels of a model's nodes.
#pragma once

#include "qm_base/checkeddialog.h"
#include "qm_db/dbdoc.h"
#include "qm_rps/create/storeylevels.h"

class CStoreyGuideDlg : public CCheckedDialog {
public:
    enum COLUMN { Taken, Name, Elevation, Height, Nodes, Spread, Columns };

    /// The document must outlive the dialog. The tolerance starts as 10 cm.
    explicit CStoreyGuideDlg(CDBDoc& doc);

    double Tolerance() const { return m_tolerance; } // in current units
    std::string UnitText() const { return std::string(NameOf(m_doc.Unit().Units().length)); }
    /// Finds the levels again; names and choices start anew.
    void OnTolerance(double tolerance);

    /// A row for each level, from top to bottom as a building stands.
    std::size_t Rows() const { return m_levels.size(); }
    std::string ColumnHead(COLUMN column) const;
    std::string CellText(std::size_t row, COLUMN column) const;
    /// Taken and Name alone. 0: refused.
    int SetCell(std::size_t row, COLUMN column, const std::string& text);
    /// How many storeys come, and how many there are now.
    std::string NotesText() const;
    /// A line for each level whose nodes span more than 0.5 m: two floors may be one level.
    std::string DoubtText() const;

    std::vector<T_FINDING> Findings() const override;
    /// Puts the storeys in place of all that the model has, as one edit that can be undone.
    int OnOK() override;

private:
    std::size_t LevelOfRow(std::size_t row) const { return m_levels.size() - 1 - row; }
    [[nodiscard]] int Make(std::vector<T_STOR_D>& out, T_FINDING& fault) const;

    CDBDoc& m_doc;
    double m_tolerance = 0.0;
    std::vector<T_LEVEL_OF_NODES> m_levels;
    std::vector<bool> m_taken;
    std::vector<std::string> m_names; // by level; empty: by its number
};
