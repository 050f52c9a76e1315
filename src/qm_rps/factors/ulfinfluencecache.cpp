#include "qm_rps/factors/ulfinfluencecache.h"

#include <cmath>
#include <limits>
#include <set>

namespace {

constexpr double kNotRead = std::numeric_limits<double>::quiet_NaN();

} // namespace

CUlfInfluenceCache::CUlfInfluenceCache(IUlfResponse& source,
                                       std::function<std::uint64_t()> revision)
    : m_source(source), m_revision(std::move(revision))
{
}

std::size_t CUlfInfluenceCache::ColumnOf(const T_OPT_ITEM& item)
{
    return m_columns.try_emplace({item[0], item[3]}, m_columns.size()).first->second;
}

int CUlfInfluenceCache::Read(std::span<const T_OPT_ITEM> items,
                             std::span<const T_OPT_QUANTITY> what, std::span<double> out)
{
    if (const std::uint64_t now = m_revision(); now != m_readAt) {
        m_columns.clear();
        m_rows.clear();
        m_readAt = now;
    }
    std::vector<std::size_t> columns;
    for (const T_OPT_ITEM& item : items)
        columns.push_back(ColumnOf(item));
    std::vector<std::vector<double>*> rows;
    for (const T_OPT_QUANTITY& q : what) {
        rows.push_back(&m_rows[q]); // a map: its elements stay where they are
        rows.back()->resize(m_columns.size(), kNotRead);
    }
    if (!Fetch(items, columns, what)) return 0;
    for (std::size_t q = 0; q < what.size(); ++q)
        for (std::size_t i = 0; i < items.size(); ++i)
            out[q * items.size() + i] = (*rows[q])[columns[i]];
    return 1;
}

int CUlfInfluenceCache::Fetch(std::span<const T_OPT_ITEM> items,
                              std::span<const std::size_t> columns,
                              std::span<const T_OPT_QUANTITY> what)
{
    // A two-bound inequality asks for its quantity twice.
    const std::set<T_OPT_QUANTITY> once(what.begin(), what.end());
    std::vector<std::pair<T_OPT_QUANTITY, std::vector<double>*>> rows;
    for (const T_OPT_QUANTITY& q : once)
        rows.emplace_back(q, &m_rows[q]);
    // Items that lack the same quantities are read together: mostly all of them, or the new ones.
    std::map<std::vector<std::size_t>, std::vector<std::size_t>> groups; // quantities -> items
    for (std::size_t i = 0; i < items.size(); ++i) {
        std::vector<std::size_t> missing;
        for (std::size_t q = 0; q < rows.size(); ++q)
            if (std::isnan((*rows[q].second)[columns[i]])) missing.push_back(q);
        if (!missing.empty()) groups[missing].push_back(i);
    }
    for (const auto& [quantities, members] : groups) {
        std::vector<T_OPT_ITEM> someItems;
        std::vector<T_OPT_QUANTITY> some;
        for (const std::size_t i : members)
            someItems.push_back(items[i]);
        for (const std::size_t q : quantities)
            some.push_back(rows[q].first);
        std::vector<double> values(some.size() * someItems.size());
        if (!m_source.Read(someItems, some, values)) return 0;
        for (std::size_t q = 0; q < quantities.size(); ++q)
            for (std::size_t i = 0; i < members.size(); ++i)
                (*rows[quantities[q]].second)[columns[members[i]]] = values[q * members.size() + i];
    }
    return 1;
}
