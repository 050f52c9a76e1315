// Model of the older editor of one hinge type: the table of the hinge diagram of a component
// (FEMA curve, ASCE 41 7.5.1) and its acceptance criteria.
// Units: as the type's. Signs: the negative side holds negative numbers.
#pragma once

#include "qm_rps/hingedialog.h"
#include "qm_rps/hingesiderules.h"

#include <functional>
#include <optional>

class CPushOverHingeDataType : public CHingeDialog {
public:
    /// Names of the rows of the diagram.
    static constexpr std::array<const char*, 9> kRows{"-E", "-D", "-C", "-B", "A",
                                                      "B",  "C",  "D",  "E"};
    /// Names of the criteria.
    static constexpr std::array<const char*, 3> kCriteria{"IO", "LS", "CP"};

    /// The type of a key, or none; and how it is stored (1 done).
    std::function<std::optional<T_PHGT_D>(int key)> m_find;
    std::function<int(int key, const T_PHGT_D&)> m_store;

    /// Takes a type and shows the diagram of a component. 0 with a message: no type chosen (key 0),
    /// or it does not exist; 0 without one: the component has no FEMA curve. Nothing changes then.
    [[nodiscard]] int Data2Dlg(int key, HINGE_COMPONENT component);

    /// A point of the diagram by its row, or null (row A, which is the origin, and rows outside).
    T_SKEL_POINT* Point(std::size_t row);
    /// A criterion of a side, or null.
    double* Criterion(std::size_t index, bool positive);

    /// The diagram first: signs, deformations A <= B <= C <= D <= E, strengths; then the criteria
    /// IO <= LS <= CP. One message key for each of the two tables.
    std::vector<T_FINDING> Findings() const override;
    /// Checks and stores. 0: a finding, the type is gone, or the document refused.
    [[nodiscard]] int OnOK() override;

private:
    T_SKEL_FEMA* Curve();

    int m_key = 0;
    HINGE_COMPONENT m_component = HINGE_COMPONENT::My;
    T_PHGT_D m_type;
    bool m_taken = false;
};
