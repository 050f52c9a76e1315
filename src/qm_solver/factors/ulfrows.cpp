#include "qm_solver/factors/ulfrows.h"

void T_ULF_ROWS::SetWide(std::span<const double> rows, std::span<const double> right,
                         std::size_t nEq, std::size_t wideVars, std::size_t vars)
{
    wide = rows;
    nVar = vars;
    nWide = wideVars;
    nWideRows = right.size();
    rhs.assign(right.begin(), right.end());
    cap.assign(right.size(), kHard);
    equality.assign(right.size(), false);
    for (std::size_t i = 0; i < nEq; ++i)
        equality[i] = true;
}

void T_ULF_ROWS::AddShort(const T_ULF_SHORT_ROW& row, double right, double rowCap, bool isEquality)
{
    shortRows.push_back(row);
    rhs.push_back(right);
    cap.push_back(rowCap);
    equality.push_back(isEquality);
}

long double T_ULF_ROWS::Dot(std::size_t row, std::span<const long double> y) const
{
    if (const T_ULF_SHORT_ROW* s = Short(row)) return s->a * y[s->j] + s->b * y[s->k];
    const std::span<const double> normal = Wide(row);
    long double sum = 0.0L;
    for (std::size_t j = 0; j < nWide; ++j)
        sum += normal[j] * y[j];
    return sum;
}

void T_ULF_ROWS::AddTo(std::size_t row, long double factor, std::span<long double> to) const
{
    if (const T_ULF_SHORT_ROW* s = Short(row)) {
        to[s->j] += factor * s->a;
        to[s->k] += factor * s->b;
        return;
    }
    const std::span<const double> normal = Wide(row);
    for (std::size_t j = 0; j < nWide; ++j)
        to[j] += factor * normal[j];
}
