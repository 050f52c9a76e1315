// Keeps responses to unit load cases, so that each (constraint quantity, load case) is read once,
// also when a solve is repeated with other bounds.
#pragma once

#include "qm_rps/ulfresponse.h"

#include <functional>
#include <map>
#include <utility>
#include <vector>

/// Memory: 8 bytes per quantity and load case read.
/// State: lives with one item's model; everything is dropped when `revision` gives another number
/// (the document's records or results changed).
class CUlfInfluenceCache : public IUlfResponse {
public:
    /// `source` is not owned and must outlive this object.
    CUlfInfluenceCache(IUlfResponse& source, std::function<long()> revision);

    [[nodiscard]] int Read(std::span<const T_ULF_ITEM> items, std::span<const T_ULF_QUANTITY> what,
                           std::span<double> out) override;
    std::string Error() const override { return m_source.Error(); }

private:
    std::size_t ColumnOf(const T_ULF_ITEM& item);
    [[nodiscard]] int Fetch(std::span<const T_ULF_ITEM> items, std::span<const std::size_t> columns,
                            std::span<const T_ULF_QUANTITY> what);

    IUlfResponse& m_source;
    std::function<long()> m_revision;
    long m_readAt = -1;
    std::map<std::pair<double, double>, std::size_t> m_columns; // by entries 0 and 3 of the item
    std::map<T_ULF_QUANTITY, std::vector<double>> m_rows;       // by column; NaN: not read yet
};
