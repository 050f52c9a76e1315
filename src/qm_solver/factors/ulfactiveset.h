// Dual active-set method for the shortest y that meets linear rows.
#pragma once

#include "qm_solver/factors/ulffactor.h"

#include <utility>

enum class ULF_STEP { Done, Infeasible, Limit };

/// Minimises y * y / 2 + g * y (and cap times the violation of each elastic row) subject to the
/// hard rows. Works from outside: starts at y = -g and adds violated rows one at a time, dropping
/// those whose multiplier would turn negative, so every visited point is optimal for its rows.
/// Method: Goldfarb and Idnani (1983); y and the multipliers are refined in long double on the
/// active rows, before the answer is given and where a normal is nearly dependent.
/// Range: a row whose normal depends on the active ones and which is violated by no more than
/// kUlfRelaxedTol is left aside; the certificate of
/// the answer says whether it is met. State: one problem per object; `rows` must outlive it.
class CUlfActiveSet {
public:
    explicit CUlfActiveSet(const T_ULF_ROWS& rows, ULF_PRECISION precision = ULF_PRECISION::Double);

    /// g, and the factor by which the caps of the elastic rows grow. Keeps the active rows, without
    /// those whose multiplier has left its range.
    void SetObjective(std::span<const double> gradient, double capFactor);
    /// Makes rows active before the first Solve, without those that depend on the others. Their
    /// multipliers must come out within their range for the gradient set before.
    void Start(std::span<const std::size_t> rows);
    /// Meets all rows with an index from `begin` up to `end`, keeping those met before.
    ULF_STEP Solve(std::size_t begin, std::size_t end);

    std::span<const long double> Y() const { return m_y; }
    /// One multiplier per row, zero for rows that are not active: y + g + sum of multiplier *
    /// normal = 0. Not negative for inequalities.
    std::vector<long double> Multipliers() const;
    /// Multipliers u of the active rows with cost + sum of u * normal = 0 in the least squares
    /// sense; `cost` follows the side on which each elastic row now is.
    std::vector<long double> MultipliersOf(std::span<const double> cost, double capFactor) const;
    int Steps() const { return m_steps; }
    /// After Infeasible: rows and factors whose sum contradicts itself (Farkas): normals add up to
    /// zero, right-hand sides to less than zero.
    const std::vector<std::pair<std::size_t, long double>>& Proof() const { return m_proof; }

private:
    struct T_RATIO {
        long double t = 0.0L;
        std::size_t at = 0;
    };
    std::vector<long double> OnThisSide(std::span<const double> gradient, double capFactor) const;
    long double Tolerance(double relative) const;
    long double Cap(std::size_t row) const;
    long double Violation(std::size_t row) const;
    std::size_t WorstFast(std::size_t end);
    std::size_t WorstExact(std::size_t end) const;
    ULF_STEP Add(std::size_t row);
    bool TurnsRound(std::size_t row);
    void Direct(std::size_t row);
    bool IsDependent() const;
    T_RATIO DualRatio() const;
    void Move(long double t, bool primal);
    void Activate(std::size_t row, long double multiplier);
    ULF_STEP GiveUp(std::size_t row, long double multiplier);
    void Drop(std::size_t at);
    void Flip(std::size_t row);
    void Refine();
    long double RefineOnce();
    bool Repair();
    void Rebuild();

    const T_ULF_ROWS& m_rows;
    ULF_PRECISION m_precision;
    std::unique_ptr<IUlfFactor> m_factor;
    T_ULF_DIRECTION m_dir;              // as the factor gives it
    std::vector<long double> m_z, m_dr; // the same, refined where needed
    std::vector<long double> m_g, m_y, m_u;
    std::vector<std::size_t> m_active;
    std::vector<double> m_orient; // per row, -1: taken from the other side
    std::vector<char> m_state;    // per row: 0 free, 1 active, 2 left aside
    std::vector<double> m_slack, m_yFast;
    std::vector<std::pair<std::size_t, long double>> m_proof;
    double m_capFactor = 1.0;
    int m_steps = 0, m_stepLimit = 0;
};
