// Bindings and fields of the pushover views.
#pragma once

#include "qm_ui/form/formview.h"
#include "qm_ui/plot/plotdata.h"

/// A name as the position in a list of names.
T_BINDING<int> NameRef(std::string& value, std::function<std::vector<std::string>()> names);

/// A value that may be absent, shown as its default then. Setting the default leaves it absent
/// where it was.
template <class T>
T_BINDING<T> OrDefault(std::optional<T>& value, T absent)
{
    return {[&value, absent] { return value.value_or(absent); },
            [&value, absent](const T& v) {
                if (value || v != absent) value = v;
            }};
}

/// A number from 0 to what `most` says, by a slider and an edit field with arrows.
std::unique_ptr<CFormField> MakeStepField(T_BINDING<int> binding, std::function<int()> most,
                                          ChangedFn changed, QWidget* parent);
/// Adds a picture that wants no more than this size.
CFormField& AddPicture(CFormView& form, std::function<T_PLOT()> plot, const QSize& size);
/// Lines of a text in a fixed-width font, to be read and copied.
std::unique_ptr<CFormField> MakeTextPage(TextFn text, QWidget* parent);
