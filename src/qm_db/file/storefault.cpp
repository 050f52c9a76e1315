#include "qm_db/file/storefault.h"

#include "qm_base/msgfunction.h"

#include <system_error>

T_FILE_ERROR CStoreFault::ForFile(const std::string& path) const
{
    std::string text = zql::lib::MMSGFunction::Format(m_key, {path, m_second, m_third, m_fourth});
    for (char& letter : text) {
        if (letter == '\n' || letter == '\r') letter = ' ';
    }
    return {m_fault, std::move(text)};
}

void ThrowDamaged(const std::string& what)
{
    throw CStoreFault(FILE_FAULT::BadInput, "IDS_QM_DB_FILE_DAMAGED", what);
}

void ThrowSystem(const char* key, int errorNumber)
{
    throw CStoreFault(FILE_FAULT::NoAccess, key, std::generic_category().message(errorNumber));
}
