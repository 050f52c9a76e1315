// Model of the window of a section: its dimensions, how its bars are held, the bars.
#pragma once

#include "qm_base/checkeddialog.h"
#include "qm_db/dbdoc.h"
#include "qm_rps/section/barlayout.h"

class CSectionDlg : public CCheckedDialog {
public:
    enum COLUMN { Y, Z, Diameter, Area, Columns };

    /// The document must outlive the dialog. key: of the section; 0: the first one, or a new one
    /// where there is none.
    explicit CSectionDlg(CDBDoc& doc, int key = 0);

    int Key() const { return m_key; } // 0: not stored yet
    std::vector<std::string> Names() const;
    int Index() const; // -1: a new one
    /// Another section, or a new one. What was changed is stored first, if the person wants it and
    /// it is sound; else this one stays, or its changes go.
    void OnSelChange(int index);
    void OnNew();

    T_SECT_D m_section; // as edited, in current units
    bool IsChanged() const { return !(m_section == m_read); }
    /// Another shape. The fillet of a shape that can't have one goes, and is there again later; one
    /// given by values starts with those of the shape before.
    void OnShape(SECT_SHAPE shape);
    bool HasFillet() const;
    bool HasTaper() const; // a channel
    /// Of a channel: where loads must pass that do not twist it. Empty: there is no such place.
    std::string ShearCentreText() const;

    /// Families of rolled shapes ("IPE"): the one that was chosen, else that of the section.
    static std::vector<std::string> FamilyTexts();
    int FamilyIndex() const;
    void OnFamily(int index);
    /// Rolled shapes of the family; the first entry stands for any other section.
    std::vector<std::string> StockTexts() const;
    int StockIndex() const;
    void OnStock(int index);
    /// The rolled shape with these dimensions, or the hollow one that was named; else empty.
    std::string StockName() const;
    /// Takes the dimensions of a steel shape by its name (see FindShape); a new section that has
    /// not been named gets the name. 0 with a message: there is no such shape.
    [[nodiscard]] int OnStockName(const std::string& name);

    bool HasDetailing() const { return m_section.detailing.has_value(); }
    /// Switched off and on again it is as it was.
    void OnDetailing(bool on);
    /// Area and second moments that go with the dimensions; as entered where there are none.
    T_SECT_D Calculated() const;

    /// What the buttons lay.
    T_BAR_GROUP m_group;
    /// Adds the bars of the group. 0 with a message.
    [[nodiscard]] int OnAddBars();
    void OnClearBars() { m_section.bars.clear(); }
    void OnDeleteBar(int row);
    void OnNewBar() { m_section.bars.push_back({}); }
    int m_bar = -1; // chosen row

    std::string CellText(std::size_t row, COLUMN column) const;
    /// 0: no such cell, or no finite number.
    [[nodiscard]] int SetCell(std::size_t row, COLUMN column, const std::string& text);
    std::string ColumnHead(COLUMN column) const;
    /// Number and area of the bars, and their share of the section.
    std::string BarsText() const;

    T_UNITS Units() const { return m_doc.Unit().Units(); }
    std::vector<T_FINDING> Findings() const override;
    /// Checks, then stores the section as one edit that can be undone. 0: refused.
    int OnOK() override;

private:
    bool MayLeave();
    bool IsStock(const std::string& name) const;
    const T_ROLLED_SHAPE* Rolled() const;
    std::string Family() const;
    void Read(int key);
    int Store();

    CDBDoc& m_doc;
    int m_key = 0;
    T_SECT_D m_read;        // as it was read
    T_SECT_DETAIL m_detail; // while it is switched off
    double m_fillet = 0.0;  // while the shape can't have one
    double m_taper = 0.0;   // likewise
    std::string m_family;   // that was chosen
    std::string m_stock;    // the shape that was named
};
