// A mode as a person types it: a period, and a shape by storey along one direction.
#pragma once

#include "qm_base/finding.h"
#include "qm_db/records.h"

#include <vector>

struct T_TYPED_MODE {
    double period = 0.0;         // s
    int direction = 0;           // 0 X, 1 Y
    std::vector<double> shape{}; // by storey, bottom to top; every node of a storey moves alike
};

/// 1 made; 0 fault filled (field period, shape): no storeys, another number of values, a shape of
/// zeros, a period that is not above 0. `out` as it was.
[[nodiscard]] int MakeTypedMode(const T_MODEL& model, const T_TYPED_MODE& in, T_EIGV_D& out,
                                T_FINDING& fault);
