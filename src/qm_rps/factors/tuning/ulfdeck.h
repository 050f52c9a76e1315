// What is looked at while load factors are tuned: displacements and moments along the deck, forces
// of the stays. Each value is linear in the factors: unit responses are read once and superposed.
#pragma once

#include "qm_rps/factors/ulfresult.h"
#include "qm_rps/factors/ulfstageresponse.h"

/// A place along the deck, in current units of length.
struct T_DECK_STATION {
    double along = 0.0;
    T_OPT_QUANTITY what;
};

/// Beams that lie within 10 % of the horizontal, in the order of their horizontal coordinate.
struct T_ULF_DECK {
    std::vector<T_DECK_STATION> displacements; // vertical, of the nodes
    std::vector<T_DECK_STATION> moments;       // about the horizontal local axis, at five places
    std::vector<T_OPT_QUANTITY> stays;         // axial forces of the elements asked for
};
T_ULF_DECK DeckOf(const T_MODEL& model, const T_UNITS& units, std::span<const int> stays);

/// Values = base + sum of factor times unit; by the order of DeckOf.
class CUlfDeckValues {
public:
    /// A static item: unit responses of all its cases; the known ones, with their factors, are the
    /// base. 1 done; 0 source.Error() says why not.
    [[nodiscard]] int Read(const T_ULF_DECK& deck, const T_ULF_RESULT& result,
                           IUlfResponse& source);
    /// An item of construction stages, at the end of the last one: the structure as it was analysed
    /// stands for factors of 1. 1 done; 0 results.Error() says why not.
    [[nodiscard]] int Read(const T_ULF_DECK& deck, const T_ULSI_D& item, const T_MODEL& model,
                           IUlfStageResults& results);

    struct T_VALUES {
        std::vector<double> displacements, moments, stays;
    };
    /// factors: of the unknowns, in their order. Without unit responses: empty.
    T_VALUES At(std::span<const double> factors) const;

private:
    std::array<std::size_t, 3> m_counts{}; // of the three kinds
    std::vector<double> m_base;
    std::vector<std::vector<double>> m_units; // by unknown
};
