// One connection to an SQLite database. Failures are thrown as CStoreFault.
#pragma once

#include <cstdint>
#include <memory>
#include <string>

struct sqlite3;

class CSqliteDb {
public:
    /// A file that nobody changes in place: no locks, no journal, no file made beside it. Its
    /// content is not trusted: no statement takes more steps than a file of `bytes` can ask for.
    static CSqliteDb OpenReadOnly(const std::string& path, std::int64_t bytes);
    /// An empty file that only this process knows; no journal, the caller fsyncs it.
    static CSqliteDb OpenForWriting(const std::string& path);
    /// A copy in memory, no more trusted.
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
    /// A statement begins to look for its next row.
    void StartStep() const;

private:
    /// Calls of the progress handler: since the last row, and how many are allowed.
    struct T_WORK {
        std::int64_t calls = 0, most = 0;
    };
    CSqliteDb(const std::string& uri, int flags, bool writes);
    void Distrust(std::int64_t bytes);
    static int CountWork(void* work);

    sqlite3* m_db = nullptr; // owned
    bool m_writes = false;   // what a failure is called
    std::int64_t m_bytes = 0;
    std::unique_ptr<T_WORK> m_work; // null: trusted
};
