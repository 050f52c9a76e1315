// A table of records of one type, over its columns.
#pragma once

#include "qm_base/msgfunction.h"
#include "qm_db/editscope.h"
#include "qm_db/recordform.h"
#include "qm_rps/desk/gridorder.h"
#include "qm_rps/desk/recordcolumns.h"
#include "qm_rps/dialog/unithead.h"

#include <algorithm>

template <class R>
class CRecordTable : public CRecordGrid {
public:
    CRecordTable(CDBDoc& doc, const char* title, T_RECORD_COLUMNS<R> columns)
        : m_doc(doc), m_title(title), m_columns(std::move(columns))
    {
    }

    std::size_t Rows() const override { return Keys().size(); }
    std::size_t Columns() const override { return m_columns.size(); }
    std::string ColumnHead(std::size_t c) const override
    {
        return c < m_columns.size()
                   ? HeadWithUnit(m_columns[c].head, m_columns[c].dim, m_doc.Unit().Units())
                   : std::string();
    }
    CELL_KIND Kind(std::size_t c) const override { return m_columns.at(c).kind; }
    bool CanEdit(std::size_t c) const override
    {
        return c < m_columns.size() && m_columns[c].set != nullptr;
    }
    std::vector<std::string> Choices(std::size_t c) const override
    {
        const auto& choices = m_columns.at(c).choices;
        return choices ? choices(Model()) : std::vector<std::string>();
    }
    std::string CellText(std::size_t row, std::size_t c) const override
    {
        const int key = KeyOf(row);
        return key == 0 || c >= m_columns.size() ? std::string()
                                                 : m_columns[c].get(Model(), key, Read(key));
    }
    int KeyOf(std::size_t row) const override { return row < Keys().size() ? Keys()[row] : 0; }
    long RowOf(int key) const override
    {
        const auto& keys = Keys();
        if (IsByKey()) {
            const auto it = std::ranges::lower_bound(keys, key);
            return it == keys.end() || *it != key ? -1 : static_cast<long>(it - keys.begin());
        }
        const auto it = std::ranges::find(keys, key);
        return it == keys.end() ? -1 : static_cast<long>(it - keys.begin());
    }

    int SetCellText(std::size_t row, std::size_t c, const std::string& text) override
    {
        return Edit([&](CEditScope& edit) { return Take(edit, row, c, text); });
    }

    int Paste(const std::string& text, const T_GRID_RANGE& range) override
    {
        const T_GRID_BLOCK block = BlockOfText(text);
        if (const char* key = WrongShape(block, range, Rows(), Columns())) return Say(key);
        return Edit([&](CEditScope& edit) {
            for (std::size_t r = 0; r < block.size(); ++r)
                for (std::size_t c = 0; c < block[r].size(); ++c)
                    if (!Take(edit, range.row + r, range.column + c, block[r][c])) return 0;
            return 1;
        });
    }

    int OnAdd() override
    {
        std::string reason;
        if (MakeRecord(m_doc, KindOf<R>(), {}, m_made, reason)) return 1;
        ShowMessage("IDS_QM_UI_RECORD_REFUSED", reason);
        return 0;
    }
    int MadeKey() const override { return m_made; }

    int OnDelete(const std::vector<std::size_t>& rows) override
    {
        std::vector<int> keys;
        for (const std::size_t row : rows)
            if (KeyOf(row) != 0) keys.push_back(KeyOf(row));
        std::string reason;
        if (keys.empty()) return 0;
        if (DeleteRecords(m_doc, KindOf<R>(), keys, reason)) return 1;
        ShowMessage("IDS_QM_UI_RECORD_REFUSED", reason);
        return 0;
    }

    void SetOrder(const T_GRID_ORDER& order) override
    {
        if (order == m_order) return;
        m_order = order;
        m_revision = -1;
    }
    const T_GRID_ORDER& Order() const override { return m_order; }

private:
    const T_MODEL& Model() const { return m_doc.Data().Model(); }

    bool IsByKey() const { return m_order.column < 0 && !m_order.falling; }
    const std::vector<int>& Keys() const
    {
        if (m_revision != m_doc.Data().Revision()) {
            m_revision = m_doc.Data().Revision();
            m_readKey = 0;
            m_keys = m_doc.Attr().template GetKeys<R>();
            if (!m_order.filter.empty()) std::erase_if(m_keys, [&](int k) { return !Passes(k); });
            if (!IsByKey()) OrderKeys(m_keys, m_order.falling, TextsOfColumn());
        }
        return m_keys;
    }
    std::string TextOf(int key, std::size_t c) const
    {
        return m_columns[c].get(Model(), key, Read(key));
    }
    bool Passes(int key) const
    {
        for (std::size_t c = 0; c < m_columns.size(); ++c)
            if (HoldsText(TextOf(key, c), m_order.filter)) return true;
        return false;
    }
    std::vector<std::string> TextsOfColumn() const
    {
        std::vector<std::string> texts;
        const auto column = static_cast<std::size_t>(std::max(m_order.column, 0));
        for (const int key : m_keys)
            texts.push_back(column < m_columns.size() ? TextOf(key, column) : std::string());
        return texts;
    }
    /// In current units; kept for the other cells of the row.
    const R& Read(int key) const
    {
        if (m_readKey != key || m_readRevision != m_doc.Data().Revision()) {
            m_read = TableOf<R>(Model()).at(key);
            // Digits as they were entered, and values that an edit of another one leaves alone.
            const T_UNITS& units = m_doc.Unit().Units();
            ForEachQuantity(m_read, [&](double& v, T_DIM d) { v = ShortFromSi(v, units, d); });
            m_readKey = key;
            m_readRevision = m_doc.Data().Revision();
        }
        return m_read;
    }
    int Say(const char* key)
    {
        ShowMessage(key);
        return 0;
    }
    /// Runs an edit whole or not at all.
    template <class F>
    int Edit(F change)
    {
        CEditScope edit(m_doc, zql::lib::MMSGFunction::GetValue(m_title));
        if (!edit.IsOpen()) return Say("IDS_QM_UI_EDIT_BUSY");
        return change(edit) && edit.Commit();
    }
    int Take(CEditScope& edit, std::size_t row, std::size_t c, const std::string& text)
    {
        const int key = KeyOf(row);
        if (key == 0 || !CanEdit(c)) return Say("IDS_QM_UI_CELL_FIXED");
        R record = Read(key);
        if (m_columns[c].set(Model(), record, text) && edit.Put(key, std::move(record))) return 1;
        constexpr const char* kKey = "IDS_QM_UI_CELL_REFUSED";
        ShowMessage(
            kKey, zql::lib::MMSGFunction::Format(kKey, {text, ColumnHead(c), std::to_string(key)}));
        return 0;
    }
    CDBDoc& m_doc;
    const char* m_title;
    T_RECORD_COLUMNS<R> m_columns;
    T_GRID_ORDER m_order;
    int m_made = 0;
    mutable std::vector<int> m_keys;
    mutable R m_read{};
    mutable int m_readKey = 0;
    mutable long m_readRevision = -1;
    mutable long m_revision = -1;
};
