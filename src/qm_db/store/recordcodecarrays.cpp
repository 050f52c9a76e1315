#include "qm_db/store/recordcodecarrays.h"

#include "qm_db/file/checksum.h"
#include "qm_db/file/storefault.h"
#include "qm_db/store/packednumbers.h"
#include "qm_db/store/sqlitedb.h"
#include "qm_db/store/sqlitestmt.h"

#include <cstring>
#include <limits>

static_assert(sizeof(double) == 8 && std::numeric_limits<double>::is_iec559 && sizeof(int) == 4);

namespace {

template <class T>
std::vector<std::byte> Pack(std::span<const T> values)
{
    const auto bytes = std::as_bytes(values);
    return {bytes.begin(), bytes.end()};
}

template <class T>
std::vector<T> Unpack(std::span<const std::byte> bytes)
{
    std::vector<T> values(bytes.size() / sizeof(T));
    if (!values.empty()) std::memcpy(values.data(), bytes.data(), bytes.size());
    return values;
}

std::string Place(const std::string& owner, std::int64_t key, const std::string& name)
{
    return owner + ' ' + std::to_string(key) + ' ' + name;
}

std::int64_t WidthOf(char kind)
{
    if (kind == 't') return 1;
    return kind == 'f' ? 8 : 4;
}

} // namespace

void CPackedArrays::Put(const std::string& owner, std::int64_t key, const char* name,
                        std::span<const double> values)
{
    if (!AllFinite(std::as_bytes(values))) {
        throw CStoreFault(FILE_FAULT::BadInput, "IDS_QM_DB_FILE_NOT_FINITE",
                          Place(owner, key, name));
    }
    m_arrays[{owner, key, name}] = {'f', Pack(values)};
}

void CPackedArrays::Put(const std::string& owner, std::int64_t key, const char* name,
                        std::span<const int> values)
{
    m_arrays[{owner, key, name}] = {'i', Pack(values)};
}

void CPackedArrays::Put(const std::string& owner, std::int64_t key, const char* name,
                        std::string_view text)
{
    m_arrays[{owner, key, name}] = {'t', Pack(std::span<const char>(text))};
}

bool CPackedArrays::Has(const std::string& owner, std::int64_t key, const char* name) const
{
    return m_arrays.contains({owner, key, name});
}

std::span<const std::byte> CPackedArrays::Bytes(const std::string& owner, std::int64_t key,
                                                const char* name, char kind) const
{
    const auto it = m_arrays.find({owner, key, name});
    if (it == m_arrays.end()) return {};
    if (it->second.kind != kind) ThrowDamaged(Place(owner, key, name));
    return it->second.bytes;
}

std::vector<double> CPackedArrays::Doubles(const std::string& owner, std::int64_t key,
                                           const char* name) const
{
    return Unpack<double>(Bytes(owner, key, name, 'f'));
}

std::vector<int> CPackedArrays::Ints(const std::string& owner, std::int64_t key,
                                     const char* name) const
{
    return Unpack<int>(Bytes(owner, key, name, 'i'));
}

std::string CPackedArrays::Text(const std::string& owner, std::int64_t key, const char* name) const
{
    const auto bytes = Bytes(owner, key, name, 't');
    std::string text(bytes.size(), '\0');
    if (!text.empty()) std::memcpy(text.data(), bytes.data(), bytes.size());
    return text;
}

std::vector<std::int64_t> CPackedArrays::Keys(const std::string& owner) const
{
    std::vector<std::int64_t> keys;
    for (auto it = m_arrays.lower_bound({owner, std::numeric_limits<std::int64_t>::min(), {}});
         it != m_arrays.end() && std::get<0>(it->first) == owner; ++it)
        if (keys.empty() || keys.back() != std::get<1>(it->first))
            keys.push_back(std::get<1>(it->first));
    return keys;
}

void CPackedArrays::Write(const CSqliteDb& db) const
{
    CSqliteStmt insert(db, "INSERT INTO arrays(owner, key, name, kind, count, width, byte_order, "
                           "data) VALUES(?1, ?2, ?3, ?4, ?5, ?6, 'little', ?7)");
    for (const auto& [place, packed] : m_arrays) {
        const auto& [owner, key, name] = place;
        insert.Bind(1, std::string_view(owner));
        insert.Bind(2, key);
        insert.Bind(3, std::string_view(name));
        insert.Bind(4, std::string_view(&packed.kind, 1));
        const std::int64_t width = WidthOf(packed.kind);
        insert.Bind(5, static_cast<std::int64_t>(packed.bytes.size()) / width);
        insert.Bind(6, width);
        insert.Bind(7, std::span<const std::byte>(packed.bytes));
        insert.Run();
    }
}

CPackedArrays::T_PACKED CPackedArrays::CheckedRow(const CSqliteStmt& row)
{
    const char kind = row.Text(3) == "f" ? 'f' : row.Text(3) == "t" ? 't' : 'i';
    const std::span<const std::byte> bytes = row.Blob(7);
    const auto size = static_cast<std::int64_t>(bytes.size());
    const std::int64_t width = WidthOf(kind);
    const bool right = row.Text(3) == std::string_view(&kind, 1) && row.Int(5) == width &&
                       size % width == 0 && size / width == row.Int(4) && row.Text(6) == "little" &&
                       (kind != 'f' || AllFinite(bytes));
    if (!right) ThrowDamaged(Place(std::string(row.Text(0)), row.Int(1), std::string(row.Text(2))));
    return {kind, {bytes.begin(), bytes.end()}};
}

CPackedArrays CPackedArrays::Read(const CSqliteDb& db, CChecksum& sum, const std::string& streamed,
                                  const Sink& sink)
{
    CPackedArrays arrays;
    CPackedArrays group; // of the streamed owner, all of one key
    std::int64_t groupKey = 0;
    const auto finishGroup = [&] {
        if (!group.m_arrays.empty()) sink(group, groupKey);
        group.m_arrays.clear();
    };
    CSqliteStmt rows(db,
                     "SELECT owner, key, name, kind, count, width, byte_order, data FROM arrays "
                     "ORDER BY owner, key, name");
    while (rows.Step()) {
        rows.AddRowTo(sum);
        const std::int64_t key = rows.Int(1);
        const bool isStreamed = rows.Text(0) == streamed;
        if (!isStreamed || key != groupKey) finishGroup();
        if (isStreamed) groupKey = key;
        auto& to = isStreamed ? group.m_arrays : arrays.m_arrays;
        to.emplace_hint(to.end(), std::tuple(rows.Text(0), key, rows.Text(2)), CheckedRow(rows));
    }
    finishGroup();
    return arrays;
}
