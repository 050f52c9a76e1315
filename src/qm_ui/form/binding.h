// What a field of a view is bound to: how its value is read from the dialog model and given back.
#pragma once

#include <functional>
#include <optional>
#include <string>
#include <vector>

template <class T>
struct T_BINDING {
    std::function<T()> get;
    std::function<void(const T&)> set; // empty: the field can only be read
};

/// Binds to a member of a model, which must outlive the view.
template <class T>
T_BINDING<T> Ref(T& value)
{
    return {[&value] { return value; }, [&value](const T& v) { value = v; }};
}

/// An enumeration, or another number, as the position in a list of choices.
template <class E>
T_BINDING<int> IndexRef(E& value)
{
    return {[&value] { return static_cast<int>(value); },
            [&value](const int& v) { value = static_cast<E>(v); }};
}

/// A text that is asked for each time it is shown, so that it follows language and state.
using TextFn = std::function<std::string()>;

/// The catalogue's text of a key.
TextFn KeyText(std::string key);
/// The same text always.
TextFn PlainLabel(std::string text);
/// Texts of several keys, by index.
std::function<std::vector<std::string>()> KeyTexts(std::vector<std::string> keys);
