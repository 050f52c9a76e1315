// Axial forces of members under the loads that stand before a push. SI.
#pragma once

#include "qm_db/dbdoc.h"

#include <map>
#include <string>

class CInitialAxial {
public:
    /// By linear analysis, of the initial loads of the global control or of one static load case
    /// (its key). 1 done; 0 with the reason in words. Without loads every force is 0.
    [[nodiscard]] int Analyse(const T_MODEL& model, std::string& reason, int loadCase = 0);
    bool IsLoaded() const { return m_isLoaded; }
    /// Compression positive.
    T_ENDS<double> Of(int element) const;

private:
    std::map<int, T_ENDS<double>> m_axial;
    bool m_isLoaded = false;
};
