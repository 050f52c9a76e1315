// One question for every result: is each of its numbers finite?
#pragma once

#include <cmath>
#include <concepts>
#include <ranges>
#include <tuple>

/// Of a number; of what is in a range or an optional; of the members that a record hands out by
/// its function Numbers(record), a tuple. An empty optional or range has no number that is not.
template <class T>
bool IsFinite(const T& value)
{
    if constexpr (std::floating_point<T>)
        return std::isfinite(value);
    else if constexpr (std::integral<T>)
        return true;
    else if constexpr (requires { Numbers(value); })
        return std::apply([](const auto&... member) { return (IsFinite(member) && ...); },
                          Numbers(value));
    else if constexpr (std::ranges::range<const T>) {
        for (const auto& item : value)
            if (!IsFinite(item)) return false;
        return true;
    } else {
        return !value || IsFinite(*value); // an optional
    }
}
