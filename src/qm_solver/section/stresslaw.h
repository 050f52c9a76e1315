// A law of stress over strain cut into smooth pieces.
#pragma once

#include "qm_solver/sectionmodel.h"

#include <array>
#include <limits>
#include <optional>
#include <span>

namespace solver {

enum class LAW_SHAPE { Polynomial, Power, Mander };

/// From `from` up to, not including, `to`.
struct T_LAW_PIECE {
    double from = -std::numeric_limits<double>::infinity();
    double to = std::numeric_limits<double>::infinity();
    LAW_SHAPE shape = LAW_SHAPE::Polynomial;
    std::array<double, 3> c{}; // of a polynomial, by rising power
    /// Where a broken power begins, no polynomial follows it; quadrature gathers points there. None
    /// beside a smooth piece.
    std::optional<double> root;

    bool Zero() const
    {
        return shape == LAW_SHAPE::Polynomial && c[0] == 0.0 && c[1] == 0.0 && c[2] == 0.0;
    }
};

class CStressLaw {
public:
    /// The law must be sound. Plastic: steel without its elastic part.
    CStressLaw(const T_STRESS_LAW& law, bool plastic);

    /// Where a block ends, once the largest strain of the section is known.
    void SetTopStrain(double strain);

    std::span<const T_LAW_PIECE> Pieces() const { return {m_pieces.data(), m_count}; }
    double Stress(const T_LAW_PIECE& piece, double strain) const;
    double Tangent(const T_LAW_PIECE& piece, double strain) const;
    const T_LAW_PIECE& PieceAt(double strain) const;
    double Stress(double strain) const { return Stress(PieceAt(strain), strain); }

private:
    void AddUpTo(double to, LAW_SHAPE shape, std::array<double, 3> c = {},
                 std::optional<double> root = {});
    void AddMander(double to);
    void MakeConcrete();
    void MakeSteel(bool plastic);

    T_STRESS_LAW m_law;
    double m_power = 0.0; // Mander: r
    std::array<T_LAW_PIECE, 9> m_pieces;
    std::size_t m_count = 0;
};

} // namespace solver
