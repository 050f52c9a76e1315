// Design codes that the model is checked by.
#pragma once

#include "qm_db/datactrl.h"

class CDBLib {
public:
    explicit CDBLib(const CDataCtrl& data) : m_data(data) {}

    /// Name of the concrete and of the steel design code ("Eurocode2:04"); empty: none chosen.
    std::string GetConCodeName() const;
    std::string GetStlCodeName() const;

private:
    const CDataCtrl& m_data;
};
