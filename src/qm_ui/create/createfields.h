// Fields that the windows of new models have in common.
#pragma once

#include "qm_rps/create/spectrumedit.h"
#include "qm_ui/form/formview.h"

#include <QSize>

/// A text of many lines, as it is pasted; taken with each change.
std::unique_ptr<CFormField> MakePasteField(T_BINDING<std::string> binding, ChangedFn changed,
                                           QWidget* parent);

/// Kind, name and parameters of a spectrum. changed: called after each change of a value, before
/// the form is read again; may be empty. withTable: the user table can be edited here.
void AddSpectrumFields(CFormView& form, CSpectrumEdit& edit, const std::function<void()>& changed,
                       bool withTable);

/// A member that tells of its changes.
template <class T>
T_BINDING<T> Told(T& value, std::function<void()> tell)
{
    return {[&value] { return value; },
            [&value, tell = std::move(tell)](const T& v) {
                value = v;
                tell();
            }};
}
/// Likewise of an enumeration, as an index.
template <class E>
T_BINDING<int> ToldIndex(E& value, std::function<void()> tell)
{
    return {[&value] { return static_cast<int>(value); },
            [&value, tell = std::move(tell)](const int& v) {
                value = static_cast<E>(v);
                tell();
            }};
}

/// A table that is only read, within these sizes.
CFormField& AddReadTable(CFormView& form, std::function<T_TEXT_TABLE()> make, const char* name,
                         QSize least, int most);
