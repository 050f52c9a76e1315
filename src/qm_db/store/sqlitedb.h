// One connection to an SQLite database. Failures are thrown as CStoreFault.
#pragma once

#include <string>

struct sqlite3;

class CSqliteDb {
public:
    /// A file that nobody changes in place: no locks, no journal, no file made beside it.
    static CSqliteDb OpenReadOnly(const std::string& path);
    /// An empty file that only this process knows; no journal, the caller fsyncs it.
    static CSqliteDb OpenForWriting(const std::string& path);
    /// A copy in memory.
    static CSqliteDb MemoryCopyOf(const CSqliteDb& source);

    CSqliteDb(CSqliteDb&& other) noexcept;
    CSqliteDb& operator=(CSqliteDb&&) = delete;
    ~CSqliteDb();

    /// Runs statements without results.
    void Exec(const std::string& sql) const;
    /// First column of the first row as text; empty without a row.
    std::string QueryText(const std::string& sql) const;
    /// Throws what the connection reports last, with the extended result code `code`.
    [[noreturn]] void ThrowLast(int code) const;

    sqlite3* Handle() const { return m_db; }

private:
    CSqliteDb(const std::string& uri, int flags, bool writes);

    sqlite3* m_db = nullptr; // owned
    bool m_writes = false;   // what a failure is called
};
