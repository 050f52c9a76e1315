#include "qm_db/records/recordunits.h"

#include "qm_db/records/hingefields.h"
#include "qm_db/records/pushfields.h"
#include "qm_db/records/stagefields.h"

namespace {

class CQuantities : public CFieldLook<CQuantities> {
public:
    template <class T>
    using Ref = T&;
    explicit CQuantities(const QuantityFn& f) : m_f(f) {}

    void Number(double& value, T_DIM dim)
    {
        if (dim != kDimNone) m_f(value, dim);
    }

private:
    const QuantityFn& m_f;
};

} // namespace

void ForEachQuantity(T_RECORD_POINTER record, const QuantityFn& f)
{
    CQuantities quantities(f);
    std::visit([&](auto* r) { CaseFields(quantities, *r); }, record);
}
