#include "qm_db/dblib.h"

std::string CDBLib::GetConCodeName() const
{
    return m_data.Model().styp.designCodes.concrete.value_or("");
}

std::string CDBLib::GetStlCodeName() const
{
    return m_data.Model().styp.designCodes.steel.value_or("");
}
