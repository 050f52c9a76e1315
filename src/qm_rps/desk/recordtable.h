// A table of records of one type, over its columns.
#pragma once

#include "qm_base/msgfunction.h"
#include "qm_db/editscope.h"
#include "qm_rps/desk/recordcolumns.h"
#include "qm_rps/dialog/unithead.h"

#include <algorithm>

template <class R>
class CRecordTable : public CRecordGrid {
public:
    /// makeNew: a new record for the next key (1 more than the last); empty: none can be added.
    CRecordTable(CDBDoc& doc, const char* title, T_RECORD_COLUMNS<R> columns,
                 std::function<R(const T_MODEL&, int key)> makeNew = {})
        : m_doc(doc), m_title(title), m_columns(std::move(columns)), m_makeNew(std::move(makeNew))
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
        const auto it = std::ranges::lower_bound(Keys(), key);
        return it == Keys().end() || *it != key ? -1 : static_cast<long>(it - Keys().begin());
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

    bool CanAdd() const override { return m_makeNew != nullptr; }
    int OnAdd() override
    {
        if (!m_makeNew) return 0;
        const int key = NextKey(TableOf<R>(Model()));
        return Edit([&](CEditScope& edit) { return edit.Put(key, m_makeNew(Model(), key)); });
    }

    int OnDelete(const std::vector<std::size_t>& rows) override
    {
        std::vector<int> keys;
        for (const std::size_t row : rows)
            if (KeyOf(row) != 0) keys.push_back(KeyOf(row));
        if (keys.empty()) return 0;
        return Edit([&](CEditScope& edit) {
            return std::ranges::all_of(keys, [&](int key) { return EraseOne(edit, key) != 0; });
        });
    }

private:
    const T_MODEL& Model() const { return m_doc.Data().Model(); }

    const std::vector<int>& Keys() const
    {
        if (m_revision != m_doc.Data().Revision()) {
            m_keys = m_doc.Attr().template GetKeys<R>();
            m_revision = m_doc.Data().Revision();
        }
        return m_keys;
    }
    R Read(int key) const
    {
        R record = TableOf<R>(Model()).at(key);
        RecordFromSi(record, m_doc.Unit().Units());
        return record;
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
    int EraseOne(CEditScope& edit, int key)
    {
        T_RECORD_USERS users;
        if (edit.Erase<R>(key, users)) return 1;
        std::string names;
        constexpr std::size_t kNamed = 10;
        for (std::size_t i = 0; i < users.size() && i < kNamed; ++i)
            names += (i ? ", " : "") + DescribeUser(Model(), users[i]);
        if (users.size() > kNamed) names += ", ...";
        constexpr const char* kKey = "IDS_QM_UI_RECORD_USED";
        ShowMessage(kKey, zql::lib::MMSGFunction::Format(kKey, {std::to_string(key), names}));
        return 0;
    }

    CDBDoc& m_doc;
    const char* m_title;
    T_RECORD_COLUMNS<R> m_columns;
    std::function<R(const T_MODEL&, int)> m_makeNew;
    mutable std::vector<int> m_keys;
    mutable long m_revision = -1;
};
