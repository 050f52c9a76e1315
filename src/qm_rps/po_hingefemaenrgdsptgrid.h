// Model of the grid of energy-dissipation factors of a FEMA curve with the energy-based model.
#pragma once

#include "qm_base/mdialog.h"
#include "qm_db/records.h"

class CPO_HingeFEMAEnrgDsptGrid : public zql::frx::MDialog {
public:
    static constexpr std::array<const char*, 4> kHeads{"A~B\n(Elast. Range)", "C\n(Ultim.~Loss)",
                                                       "D\n(Residual)", "E\n(Rupture)"};

    /// Rows: positive and negative side; columns as the heads. Factors are dimensionless.
    std::array<std::array<double, 4>, 2> m_factors{};

    void Data2Dlg(const T_SIDES<T_SKEL_SIDE>& sides);
    void Dlg2Data(T_SIDES<T_SKEL_SIDE>& sides) const;

    /// 0 A~B >= C >= D >= E >= 0 is not kept by a row: the rule is shown.
    int CheckData() override;
};
