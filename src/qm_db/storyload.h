// Nodal masses that take part in lateral loading.
#pragma once

#include "qm_db/datactrl.h"

#include <array>
#include <vector>

struct T_NODAL_MASS {
    int node = 0;
    std::array<double, 3> mass{};   // X, Y, Z in current units (force * s2 / length)
    std::array<int, 6> restraint{}; // 1 restrained
};

class CStoryLoad {
public:
    explicit CStoryLoad(const CDataCtrl& data) : m_data(data) {}

    /// Nodes with a mass, ascending by id: those listed in the storeys, each once; all nodes of a
    /// model without storeys. A mass in a restrained direction does not count and is given as 0.
    std::vector<T_NODAL_MASS> Calc_Nodal_Mass() const;

private:
    const CDataCtrl& m_data;
};
