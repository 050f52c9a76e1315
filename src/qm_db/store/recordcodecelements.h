// Elements as packed lists: they are too many for rows.
#pragma once

#include "qm_db/records.h"
#include "qm_db/store/recordcodecarrays.h"

void PutElements(const T_TABLE<T_ELEM_D>& elements, CPackedArrays& arrays);
/// Throws "damaged" when the lists do not fit each other.
void GetElements(const CPackedArrays& arrays, T_TABLE<T_ELEM_D>& elements);
