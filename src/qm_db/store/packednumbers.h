// What is made of numbers of one kind, as a row of them: members that a packed list holds.
#pragma once

#include "qm_db/records.h"

#include <concepts>
#include <cstddef>
#include <span>
#include <vector>

using T_END_RELEASES = T_ENDS<T_DIRS6>; // one bit per released direction, the I-end's first

/// False where one of the packed doubles is not finite.
bool AllFinite(std::span<const std::byte> packed);

/// Kind of number and how many.
template <class T>
struct T_PACKED_AS {
    using Scalar = int;
    static constexpr std::size_t kCount = 1;
};
template <>
struct T_PACKED_AS<double> {
    using Scalar = double;
    static constexpr std::size_t kCount = 1;
};
template <class T, std::size_t N>
struct T_PACKED_AS<std::array<T, N>> {
    using Scalar = typename T_PACKED_AS<T>::Scalar;
    static constexpr std::size_t kCount = N * T_PACKED_AS<T>::kCount;
};
template <class T>
struct T_PACKED_AS<T_SIDES<T>> : T_PACKED_AS<std::array<T, 2>> {
};
template <class T>
struct T_PACKED_AS<T_ENDS<T>> : T_PACKED_AS<std::array<T, 2>> {
};
template <>
struct T_PACKED_AS<T_END_RELEASES> : T_PACKED_AS<int> {
};

template <class T>
using PACKED_SCALAR = typename T_PACKED_AS<std::remove_const_t<T>>::Scalar;

/// The numbers of a value, one after the other.
class CNumberWriter {
public:
    template <class S>
    static void Put(std::vector<S>& to, const S& value)
    {
        to.push_back(value);
    }
    static void Put(std::vector<int>& to, ELEM_KIND kind) { to.push_back(static_cast<int>(kind)); }
    static void Put(std::vector<int>& to, const T_END_RELEASES& release);
    template <class S, class T, std::size_t N>
    static void Put(std::vector<S>& to, const std::array<T, N>& values)
    {
        for (const T& value : values)
            Put(to, value);
    }
    template <class S, class T>
    static void Put(std::vector<S>& to, const T_SIDES<T>& sides)
    {
        Put(to, sides.pos), Put(to, sides.neg);
    }
    template <class S, class T>
    static void Put(std::vector<S>& to, const T_ENDS<T>& ends)
    {
        Put(to, ends.I), Put(to, ends.J);
    }
};

/// Takes them back; `from` goes on behind what was taken. Returns false for a number that the value
/// can't have.
class CNumberReader {
public:
    template <class S>
    static bool Take(const S*& from, S& value)
    {
        value = *from++;
        return true;
    }
    static bool Take(const int*& from, ELEM_KIND& kind);
    static bool Take(const int*& from, T_END_RELEASES& release);
    template <class S, class T, std::size_t N>
    static bool Take(const S*& from, std::array<T, N>& values)
    {
        bool right = true;
        for (T& value : values)
            right &= Take(from, value);
        return right;
    }
    template <class S, class T>
    static bool Take(const S*& from, T_SIDES<T>& sides)
    {
        return Take(from, sides.pos) && Take(from, sides.neg);
    }
    template <class S, class T>
    static bool Take(const S*& from, T_ENDS<T>& ends)
    {
        return Take(from, ends.I) && Take(from, ends.J);
    }
};
