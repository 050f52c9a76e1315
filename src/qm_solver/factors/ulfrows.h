// The rows of a quadratic problem: wide ones and rows with one or two entries.
#pragma once

#include <cstddef>
#include <limits>
#include <span>
#include <vector>

/// Normal with the entries `a` at unknown `j` and `b` at unknown `k`; one entry: b = 0.
struct T_ULF_SHORT_ROW {
    std::size_t j = 0;
    double a = 0.0;
    std::size_t k = 0;
    double b = 0.0;
};

/// Rows normal * y <= rhs or = rhs of a problem with nVar unknowns. The wide rows come first and
/// reach the first nWide unknowns. A row with a finite cap is elastic: its multiplier never grows
/// past the cap, that is, its violation costs `cap` a unit instead of being forbidden.
struct T_ULF_ROWS {
    static constexpr double kHard = std::numeric_limits<double>::infinity();

    std::size_t nVar = 0, nWide = 0, nWideRows = 0;
    std::span<const double> wide; // nWideRows x nWide, owned by the caller
    std::vector<T_ULF_SHORT_ROW> shortRows;
    std::vector<double> rhs;    // wide rows, then short rows
    std::vector<double> cap;    // likewise
    std::vector<bool> equality; // likewise

    /// The wide rows; the first nEq are equalities.
    void SetWide(std::span<const double> rows, std::span<const double> rhs, std::size_t nEq,
                 std::size_t wideVars, std::size_t vars);
    void AddShort(const T_ULF_SHORT_ROW& row, double rhs = 0.0, double cap = kHard,
                  bool isEquality = false);

    std::size_t Size() const { return rhs.size(); }
    std::span<const double> Wide(std::size_t row) const { return wide.subspan(row * nWide, nWide); }
    const T_ULF_SHORT_ROW* Short(std::size_t row) const
    {
        return row < nWideRows ? nullptr : &shortRows[row - nWideRows];
    }
    /// normal * y.
    long double Dot(std::size_t row, std::span<const long double> y) const;
    /// to += factor * normal.
    void AddTo(std::size_t row, long double factor, std::span<long double> to) const;
};
