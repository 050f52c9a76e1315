// Reading the model's records, in the document's current units. 1 found; 0 not, output as it was.
#pragma once

#include "qm_db/datactrl.h"

#include <string_view>

class CAttrCtrl {
public:
    explicit CAttrCtrl(const CDataCtrl& data) : m_data(data) {}

    /// Title, units and gravity of the model; gravity only where the model states one.
    [[nodiscard]] int GetStyp(T_STYP_D& out) const;
    [[nodiscard]] int GetNode(int id, T_NODE_D& out) const;
    /// Restraints of a node, 1 where restrained, in the order X, Y, Z, RX, RY, RZ.
    [[nodiscard]] int GetConsNode(int id, std::array<int, 6>& out) const;
    [[nodiscard]] int GetPolc(int key, T_POLC_D& out) const;
    [[nodiscard]] int GetSpfc(int key, T_SPFC_D& out) const;
    [[nodiscard]] int GetEval(int key, T_EVAL_D& out) const;

    /// Key of the record with that name. 1 found; 0 not, output as it was.
    [[nodiscard]] int FindPolc(std::string_view name, int& key) const;
    [[nodiscard]] int FindSpfc(std::string_view name, int& key) const;

private:
    const CDataCtrl& m_data;
};
