// Defaults of a new model.
#pragma once

#include "qm_db/datactrl.h"

class CInitCtrl {
public:
    explicit CInitCtrl(const CDataCtrl& data) : m_data(data) {}

    /// Standard gravity, 9.80665 m/s2, in the current length unit.
    double DefaultGravity() const { return FromSi(9.80665, m_data.Units(), kDimAccel); }

private:
    const CDataCtrl& m_data;
};
