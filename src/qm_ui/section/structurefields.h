// Fields that the windows of sections and materials have alike.
#pragma once

#include "qm_base/say.h"
#include "qm_rps/dialog/unithead.h"
#include "qm_ui/form/formview.h"

/// A caption with the unit of a quantity.
template <class DLG>
TextFn Head(const DLG& d, const char* key, T_DIM dim)
{
    return [&d, key, dim] { return HeadWithUnit(Say(key), dim, d.Units()); };
}

/// The record that is edited, and a button for a new one.
template <class DLG>
void AddChoice(CFormView& form, DLG& d, const char* caption)
{
    form.Columns();
    form.Choice(KeyText(caption),
                {[&d] { return d.Index(); }, [&d](const int& index) { d.OnSelChange(index); }},
                [&d] { return d.Names(); })
        .name = "record";
    form.NextColumn();
    form.Button(KeyText("IDS_QM_UI_SECT_NEW"), [&d] { d.OnNew(); }).name = "new";
    form.EndColumns();
}

/// A member of a part of a record, which may be switched off.
template <class PART, class T>
T_BINDING<T> PartRef(std::optional<PART>& part, T PART::*member)
{
    return {[&part, member] { return part ? (*part).*member : T{}; },
            [&part, member](const T& value) {
                if (part) (*part).*member = value;
            }};
}
