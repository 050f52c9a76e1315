// Keeps responses to unit load cases, so that each (constraint quantity, load case) is read once,
// also when a solve is repeated with other bounds.
#pragma once

#include "qm_rps/factors/ulfresponse.h"

#include <cstdint>
#include <functional>
#include <map>
#include <optional>
#include <utility>
#include <vector>

/// Memory: 8 bytes per quantity and load case read.
/// State: lives with one item's model; everything is dropped when `revision` gives another number
/// (what the responses follow from has changed: structure, loads, results or units; see
/// CPostCtrl::StaticRevision).
class CUlfInfluenceCache : public IUlfResponse {
public:
    /// `source` is not owned and must outlive this object.
    CUlfInfluenceCache(IUlfResponse& source, std::function<std::uint64_t()> revision);

    [[nodiscard]] int Read(std::span<const T_OPT_ITEM> items, std::span<const T_OPT_QUANTITY> what,
                           std::span<double> out) override;
    std::string Error() const override { return m_source.Error(); }

private:
    std::size_t ColumnOf(const T_OPT_ITEM& item);
    [[nodiscard]] int Fetch(std::span<const T_OPT_ITEM> items, std::span<const std::size_t> columns,
                            std::span<const T_OPT_QUANTITY> what);

    IUlfResponse& m_source;
    std::function<std::uint64_t()> m_revision;
    std::optional<std::uint64_t> m_readAt;
    std::map<std::pair<double, double>, std::size_t> m_columns; // by entries 0 and 3 of the item
    std::map<T_OPT_QUANTITY, std::vector<double>> m_rows;       // by column; NaN: not read yet
};
