// Which fields of a record are quantities, and of which dimension: one place for every converter.
// ForEachQuantity(record, f) calls f(double& value, T_DIM) for each of them.
#pragma once

#include "qm_db/records.h"

#include <functional>

using QuantityFn = std::function<void(double& value, T_DIM dim)>;

template <class F>
void ForEachQuantity(T_STYP_D& r, F&& f)
{
    if (r.gravity) f(*r.gravity, kDimAccel);
}

template <class F>
void ForEachQuantity(T_NODE_D& r, F&& f)
{
    for (double& v : r.xyz)
        f(v, kDimLength);
    for (double& v : r.mass)
        f(v, kDimMass);
}

template <class F>
void ForEachQuantity(T_STOR_D& r, F&& f)
{
    f(r.height, kDimLength);
}

template <class F>
void ForEachQuantity(T_SPFC_D& r, F&& f)
{
    if (auto* user = std::get_if<T_SPFC_USER>(&r.data); user && user->gravity)
        f(*user->gravity, kDimAccel);
}

// Plastic deformations have the dimension of the component's deformation, ratios D / Dy none.
void ForEachQuantity(T_MATL_D& r, const QuantityFn& f);
void ForEachQuantity(T_SECT_D& r, const QuantityFn& f);
void ForEachQuantity(T_PHGT_D& r, const QuantityFn& f);
void ForEachQuantity(T_PHGE_D& r, const QuantityFn& f);
void ForEachQuantity(T_IEHP_D& r, const QuantityFn& f);
void ForEachQuantity(T_POLC_D& r, const QuantityFn& f);
void ForEachQuantity(T_ELEM_D& r, const QuantityFn& f);
void ForEachQuantity(T_STLD_D& r, const QuantityFn& f);
void ForEachQuantity(T_ULFC_D& r, const QuantityFn& f);

// Mode shapes are in the normalisation of their source; the others hold no lengths.
template <class F>
void ForEachQuantity(T_EIGV_D&, F&&)
{
}
template <class F>
void ForEachQuantity(T_DIAP_D&, F&&)
{
}
template <class F>
void ForEachQuantity(T_EQDS_D&, F&&)
{
}
template <class F>
void ForEachQuantity(T_LCOM_D&, F&&)
{
}
template <class F>
void ForEachQuantity(T_ULFI_D&, F&&)
{
}
template <class F>
void ForEachQuantity(T_STAG_D&, F&&)
{
}
template <class F>
void ForEachQuantity(T_ULSI_D&, F&&)
{
}
template <class F>
void ForEachQuantity(T_POFC_D&, F&&)
{
}
template <class F>
void ForEachQuantity(T_EVAL_D&, F&&)
{
}
template <class F>
void ForEachQuantity(T_POVR_D&, F&&)
{
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
