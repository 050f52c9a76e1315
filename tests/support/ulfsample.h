// A table of responses in the place of an analysis, and a solver that keeps what it is handed.
#pragma once

#include "qm_rps/optdsgn.h"

#include <map>

/// Responses by quantity, one per load case 1, 2, 3 ...
class CTableResponse : public IUlfResponse {
public:
    std::map<T_OPT_QUANTITY, std::vector<double>> m_table;
    std::map<std::pair<T_OPT_QUANTITY, int>, int> m_reads; // how often each was read

    int Read(std::span<const T_OPT_ITEM> items, std::span<const T_OPT_QUANTITY> what,
             std::span<double> out) override
    {
        for (std::size_t q = 0; q < what.size(); ++q)
            for (std::size_t i = 0; i < items.size(); ++i) {
                const int loadCase = Truncated(items[i][0]);
                const auto row = m_table.find(what[q]);
                if (row == m_table.end() || loadCase > static_cast<int>(row->second.size()))
                    return 0;
                ++m_reads[{what[q], loadCase}];
                out[q * items.size() + i] = row->second[static_cast<std::size_t>(loadCase) - 1];
            }
        return 1;
    }
    std::string Error() const override { return "not in the table"; }
};

/// What Calc_UnknownLoadFactor was handed.
struct T_HANDED {
    int calls = 0, mode = -1, ncon = 0, nvar = 0, neq = 0, iobj = 0, isign = 0;
    std::vector<double> matrix, rhs, weights;
};

/// Keeps its arguments in `handed` and answers with the factors, the code and the return value.
inline COptDsgn::Solver Answering(T_HANDED& handed, std::vector<double> factors, int code = 0,
                                  int result = 1)
{
    return [&handed, factors, code, result](int mode, int ncon, int nvar, int neq, auto matrix,
                                            auto rhs, std::span<double> x, auto weights, int iobj,
                                            int isign, int& out) {
        const auto list = [](std::span<const double> v) {
            return std::vector<double>(v.begin(), v.end());
        };
        handed = {handed.calls + 1, mode,      ncon,         nvar, neq, iobj, isign,
                  list(matrix),     list(rhs), list(weights)};
        std::copy(factors.begin(), factors.end(), x.begin());
        out = code;
        return result;
    };
}
