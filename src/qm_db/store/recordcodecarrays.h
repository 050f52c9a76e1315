// The packed lists of numbers of the model, and texts: rows of the table "arrays".
#pragma once

#include <cstddef>
#include <cstdint>
#include <functional>
#include <map>
#include <span>
#include <string>
#include <string_view>
#include <tuple>
#include <vector>

class CChecksum;
class CSqliteDb;
class CSqliteStmt;

/// All arrays of a model, held packed (little-endian) under (owner table, owner key, name).
class CPackedArrays {
public:
    /// The place names a number that is not finite in the refusal (BadInput).
    void Put(const std::string& owner, std::int64_t key, const char* name,
             std::span<const double> values);
    void Put(const std::string& owner, std::int64_t key, const char* name,
             std::span<const int> values);

    void Put(const std::string& owner, std::int64_t key, const char* name, std::string_view text);

    bool Has(const std::string& owner, std::int64_t key, const char* name) const;
    /// Empty when there is none. Throws "damaged" when it holds another kind of number.
    std::vector<double> Doubles(const std::string& owner, std::int64_t key, const char* name) const;
    std::vector<int> Ints(const std::string& owner, std::int64_t key, const char* name) const;
    std::string Text(const std::string& owner, std::int64_t key, const char* name) const;
    /// Keys of the owner's arrays, ascending.
    std::vector<std::int64_t> Keys(const std::string& owner) const;
    /// The packed numbers themselves; the view lives as long as this object.
    std::span<const std::byte> Bytes(const std::string& owner, std::int64_t key, const char* name,
                                     char kind) const;

    void Write(const CSqliteDb& db) const;
    /// Takes the arrays of one key of an owner that has too many to hold them all.
    using Sink = std::function<void(const CPackedArrays& arrays, std::int64_t key)>;
    /// Reads the whole table and adds its rows to the sum. The arrays of the owner `streamed` go to
    /// `sink`, key by key in ascending order; the others are returned.
    static CPackedArrays Read(const CSqliteDb& db, CChecksum& sum, const std::string& streamed,
                              const Sink& sink);

private:
    struct T_PACKED {
        char kind = 'f'; // 'f', 'i' or 't'
        std::vector<std::byte> bytes;
    };
    static T_PACKED CheckedRow(const CSqliteStmt& row);

    std::map<std::tuple<std::string, std::int64_t, std::string>, T_PACKED> m_arrays;
};
