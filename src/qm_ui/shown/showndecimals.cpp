#include "qm_ui/shown/showndecimals.h"

namespace {

T_DECIMALS& Shown()
{
    static T_DECIMALS shown = kAsStored;
    return shown;
}

} // namespace

void SetShownDecimals(const T_DECIMALS& decimals)
{
    Shown() = decimals;
}

const T_DECIMALS& ShownDecimals()
{
    return Shown();
}

std::string ShownNumber(const std::string& number, std::string_view head)
{
    if (Shown() == kAsStored) return number;
    const QUANTITY quantity = QuantityOf(head);
    return quantity == QUANTITY::Count
               ? number
               : WithDecimals(number, Shown()[static_cast<std::size_t>(quantity)]);
}
