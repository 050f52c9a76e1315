// Model of the choice of the number of integration points of a distributed hinge.
#pragma once

#include "qm_base/mdialog.h"

#include <array>

class CPO_HingeIntegrationPointDlg : public zql::frx::MDialog {
public:
    /// Gauss-Lobatto rules: from the fewest that see both ends and the middle.
    static constexpr std::array<int, 6> kChoices{3, 4, 5, 6, 7, 10};

    /// A number that is not offered is kept until another is chosen; no option is then marked.
    void SetInitValue(int points) { m_points = points; }
    int GetValue() const { return m_points; }
    /// Index of the marked option, or -1.
    int Selected() const;
    /// 1 chosen; 0 no such option, nothing changed.
    [[nodiscard]] int OnSelect(int index);

private:
    int m_points = 5;
};
