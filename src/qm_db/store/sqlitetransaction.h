// A transaction that rolls back unless it was committed.
#pragma once

#include "qm_db/file/storefault.h"
#include "qm_db/store/sqlitedb.h"

class CSqliteTransaction {
public:
    explicit CSqliteTransaction(const CSqliteDb& db) : m_db(db) { m_db.Exec("BEGIN"); }
    CSqliteTransaction(const CSqliteTransaction&) = delete;
    CSqliteTransaction& operator=(const CSqliteTransaction&) = delete;
    ~CSqliteTransaction()
    {
        try {
            if (m_open) m_db.Exec("ROLLBACK");
        } catch (const std::exception&) {
            // SQLite has rolled back by itself, or the file is given up anyway
        }
    }
    void Commit()
    {
        m_db.Exec("COMMIT");
        m_open = false;
    }

private:
    const CSqliteDb& m_db;
    bool m_open = true;
};
