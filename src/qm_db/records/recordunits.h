// Quantities of a record: the numbers of its list of members that have a dimension.
#pragma once

#include "qm_db/records/tables.h"

#include <functional>

using QuantityFn = std::function<void(double& value, T_DIM dim)>;

template <class... R>
std::variant<T_STYP_D*, R*...> PointerTo(const std::tuple<T_RECORD_ROW<R>...>&);
/// Any record.
using T_RECORD_POINTER = decltype(PointerTo(kRecords));

/// Calls f(value, dim) for each quantity of the record. Plastic deformations have the dimension of
/// the component's deformation, ratios D / Dy none; mode shapes are in the normalisation of their
/// source.
void ForEachQuantity(T_RECORD_POINTER record, const QuantityFn& f);
template <class R>
void ForEachQuantity(R& record, const QuantityFn& f)
{
    ForEachQuantity(T_RECORD_POINTER(&record), f);
}

/// Converts every quantity of a record between the given units and SI, in place.
template <class T>
void RecordToSi(T& r, const T_UNITS& units)
{
    ForEachQuantity(r, [&](double& v, T_DIM d) { v = ToSi(v, units, d); });
}
template <class T>
void RecordFromSi(T& r, const T_UNITS& units)
{
    ForEachQuantity(r, [&](double& v, T_DIM d) { v = FromSi(v, units, d); });
}
