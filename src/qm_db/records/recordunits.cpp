#include "qm_db/records/recordunits.h"

#include "qm_db/records/casequantities.h"

namespace {

template <class R>
void Visit(R& r, const QuantityFn& f)
{
    CCaseQuantities<QuantityFn> quantities(f);
    CaseFields(quantities, r);
}

} // namespace

void ForEachQuantity(T_MATL_D& r, const QuantityFn& f)
{
    Visit(r, f);
}
void ForEachQuantity(T_SECT_D& r, const QuantityFn& f)
{
    Visit(r, f);
}
void ForEachQuantity(T_PHGT_D& r, const QuantityFn& f)
{
    Visit(r, f);
}
void ForEachQuantity(T_PHGE_D& r, const QuantityFn& f)
{
    Visit(r, f);
}
void ForEachQuantity(T_IEHP_D& r, const QuantityFn& f)
{
    Visit(r, f);
}
void ForEachQuantity(T_POLC_D& r, const QuantityFn& f)
{
    Visit(r, f);
}
void ForEachQuantity(T_ELEM_D& r, const QuantityFn& f)
{
    Visit(r, f);
}
void ForEachQuantity(T_STLD_D& r, const QuantityFn& f)
{
    Visit(r, f);
}
void ForEachQuantity(T_ULFC_D& r, const QuantityFn& f)
{
    Visit(r, f);
}
