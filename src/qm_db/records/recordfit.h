// What a record does not use gets its default before it is kept, so that every file gives back the
// record that was put into the model.
#pragma once

#include "qm_db/records.h"

/// Members that belong to other kinds of element.
void FitRecord(T_ELEM_D& r);
/// Second value and position of point loads and moments.
void FitRecord(T_STLD_D& r);
/// Position, component, value, other id and bounds that the kind of constraint does not have.
void FitRecord(T_ULFC_D& r);
/// Curves that are not of their component's type.
void FitRecord(T_PHGT_D& r);
/// Rows of unknown factors come first, in their order.
void FitRecord(T_ULSI_D& r);

template <class T>
void FitRecord(T&)
{
}
