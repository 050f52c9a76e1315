#include "qm_db/store/recordcodecpacked.h"

#include "qm_db/file/storefault.h"
#include "qm_db/store/packednumbers.h"

#include <algorithm>
#include <bit>
#include <variant>

namespace {

constexpr std::size_t kChunkNodes = 512; // nodes that are packed together
constexpr const char* kElements = "elements";
constexpr const char* kHinges = "hinges"; // generated ones are many and small

/// A list in which everything is 0 is left out, as files of version 2 leave out most of an
/// element's; -0.0 is not 0.
enum class LIST { Always, UnlessZero };

// ---- the lists of each kind: the first has the key ----------------------------------------------

template <class V, class N>
requires std::same_as<std::remove_const_t<N>, T_NODE_D>
void PackedLists(V& v, auto& key, N& n)
{
    v.List("id", LIST::Always, key);
    v.List("xyz", LIST::Always, n.xyz);
    v.List("mass", LIST::Always, n.mass);
    v.List("restraint", LIST::UnlessZero, n.restraint);
}

template <class V, class E>
requires std::same_as<std::remove_const_t<E>, T_ELEM_D>
void PackedLists(V& v, auto& key, E& e)
{
    v.List("data", LIST::Always, key, e.nodeI, e.nodeJ, e.section, e.material, e.member);
    v.List("kind", LIST::UnlessZero, e.kind);
    v.List("release", LIST::UnlessZero, e.release);
    v.List("z_axis", LIST::UnlessZero, e.zAxis);
    v.List("offset", LIST::UnlessZero, e.offset);
    v.List("stiffness", LIST::UnlessZero, e.stiffness);
}

template <class V, class H>
requires std::same_as<std::remove_const_t<H>, T_PHGE_D>
void PackedLists(V& v, auto& key, H& h)
{
    v.List("refs", LIST::Always, key, h.element, h.hingeType);
    v.List("crack", LIST::Always, h.crack);
    v.List("yield", LIST::Always, h.yield);
    v.List("crack_J", LIST::UnlessZero, h.crackJ);
    v.List("yield_J", LIST::UnlessZero, h.yieldJ);
    v.List("axial_case", LIST::UnlessZero, h.axialCase);
}

// ---- writing and reading them -------------------------------------------------------------------

struct T_LIST {
    const char* name = "";
    LIST rule = LIST::Always;
    std::variant<std::vector<int>, std::vector<double>> numbers;
};

bool IsZero(int v)
{
    return v == 0;
}
bool IsZero(double v)
{
    return std::bit_cast<std::uint64_t>(v) == 0;
}

/// Goes through the lists of one record after the other, always in the same order.
class CPackPut {
public:
    template <class R>
    void Add(int key, const R& record)
    {
        m_next = 0;
        PackedLists(*this, key, record);
    }
    template <class FIRST, class... REST>
    void List(const char* name, LIST rule, const FIRST& first, const REST&... rest)
    {
        using NUMBERS = std::vector<PACKED_SCALAR<FIRST>>;
        if (m_next == m_lists.size()) m_lists.push_back({name, rule, NUMBERS()});
        NUMBERS& to = std::get<NUMBERS>(m_lists[m_next++].numbers);
        CNumberWriter::Put(to, first);
        (CNumberWriter::Put(to, rest), ...);
    }
    void Store(const char* owner, std::int64_t chunk, CPackedArrays& arrays) const
    {
        for (const T_LIST& list : m_lists)
            std::visit(
                [&](const auto& numbers) {
                    const auto isZero = [](auto v) { return IsZero(v); };
                    if (list.rule == LIST::Always || !std::ranges::all_of(numbers, isZero))
                        arrays.Put(owner, chunk, list.name, numbers);
                },
                list.numbers);
    }

private:
    std::vector<T_LIST> m_lists;
    std::size_t m_next = 0;
};

class CPackGet {
public:
    CPackGet(const CPackedArrays& arrays, const char* owner, std::int64_t chunk)
        : m_arrays(arrays), m_owner(owner), m_chunk(chunk)
    {
    }
    /// The records; throws "damaged" with `place` where the lists do not go together.
    template <class R>
    void Take(T_TABLE<R>& table, const std::string& place)
    {
        for (m_at = 0; m_at < m_count; ++m_at) {
            m_next = 0;
            int key = 0;
            R record;
            PackedLists(*this, key, record);
            if (!m_isRight) ThrowDamaged(place);
            if (m_count == kUnknown) return; // no list at all
            if constexpr (requires { record.id; }) record.id = key;
            if (!table.empty() && key <= table.rbegin()->first) ThrowDamaged(place);
            table.emplace_hint(table.end(), key, std::move(record));
        }
    }
    template <class FIRST, class... REST>
    void List(const char* name, LIST rule, FIRST& first, REST&... rest)
    {
        using SCALAR = PACKED_SCALAR<FIRST>;
        constexpr std::size_t kWidth =
            (T_PACKED_AS<FIRST>::kCount + ... + T_PACKED_AS<REST>::kCount);
        if (m_next == m_lists.size()) Load<SCALAR>(name, rule, kWidth);
        const auto& numbers = std::get<std::vector<SCALAR>>(m_lists[m_next++].numbers);
        if (!m_isRight || numbers.empty()) return;
        const SCALAR* from = &numbers[m_at * kWidth];
        m_isRight = CNumberReader::Take(from, first) && (CNumberReader::Take(from, rest) && ...);
    }

private:
    static constexpr std::size_t kUnknown = static_cast<std::size_t>(-1);

    template <class SCALAR>
    void Load(const char* name, LIST rule, std::size_t width)
    {
        std::vector<SCALAR> numbers;
        if constexpr (std::same_as<SCALAR, int>)
            numbers = m_arrays.Ints(m_owner, m_chunk, name);
        else
            numbers = m_arrays.Doubles(m_owner, m_chunk, name);
        if (m_lists.empty() && !numbers.empty() && numbers.size() % width == 0)
            m_count = numbers.size() / width;
        const std::size_t count = m_count == kUnknown ? 0 : m_count;
        const bool isLeftOut = rule == LIST::UnlessZero && numbers.empty();
        m_isRight = m_isRight && (isLeftOut || numbers.size() == count * width);
        m_lists.push_back({name, rule, std::move(numbers)});
    }

    const CPackedArrays& m_arrays;
    const char* m_owner;
    std::int64_t m_chunk;
    std::vector<T_LIST> m_lists;
    std::size_t m_count = kUnknown; // of the records; known from the first list
    std::size_t m_at = 0, m_next = 0;
    bool m_isRight = true;
};

template <class R>
void PutAll(const T_TABLE<R>& table, const char* owner, CPackedArrays& arrays)
{
    CPackPut put;
    for (const auto& [key, record] : table)
        put.Add(key, record);
    put.Store(owner, 0, arrays);
}

} // namespace

void PutNodes(const T_TABLE<T_NODE_D>& nodes, CPackedArrays& arrays)
{
    auto node = nodes.begin();
    for (std::int64_t chunk = 0; node != nodes.end(); ++chunk) {
        CPackPut put;
        for (std::size_t i = 0; i < kChunkNodes && node != nodes.end(); ++i, ++node)
            put.Add(node->first, node->second);
        put.Store(kNodes, chunk, arrays);
    }
}

void GetNodeChunk(const CPackedArrays& arrays, std::int64_t chunk, T_TABLE<T_NODE_D>& nodes)
{
    const std::string place = kNodes + (' ' + std::to_string(chunk));
    if (static_cast<std::size_t>(chunk) * kChunkNodes != nodes.size()) ThrowDamaged(place);
    CPackGet(arrays, kNodes, chunk).Take(nodes, place);
}

void PutElements(const T_TABLE<T_ELEM_D>& elements, CPackedArrays& arrays)
{
    PutAll(elements, kElements, arrays);
}

void GetElements(const CPackedArrays& arrays, T_TABLE<T_ELEM_D>& elements)
{
    CPackGet(arrays, kElements, 0).Take(elements, kElements);
}

void PutHinges(const T_TABLE<T_PHGE_D>& hinges, CPackedArrays& arrays)
{
    PutAll(hinges, kHinges, arrays);
}

void GetHinges(const CPackedArrays& arrays, T_TABLE<T_PHGE_D>& hinges)
{
    CPackGet(arrays, kHinges, 0).Take(hinges, kHinges);
}
