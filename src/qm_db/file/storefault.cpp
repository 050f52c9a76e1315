#include "qm_db/file/storefault.h"

#include "qm_base/msgfunction.h"
#include "qm_base/say.h"

#include <algorithm>
#include <array>
#include <cerrno>
#include <system_error>

namespace {

struct T_SYSTEM_TEXT {
    int errorNumber;
    const char* key;
};

// What a person can meet and mend; the system words the rest.
constexpr std::array<T_SYSTEM_TEXT, 14> kSystemTexts{{
    {ENOENT, "IDS_QM_SYSTEM_NO_ENTRY"},
    {EACCES, "IDS_QM_SYSTEM_NO_PERMISSION"},
    {EPERM, "IDS_QM_SYSTEM_NOT_PERMITTED"},
    {EISDIR, "IDS_QM_SYSTEM_FOLDER"},
    {ENOTDIR, "IDS_QM_SYSTEM_NO_FOLDER"},
    {EROFS, "IDS_QM_SYSTEM_READ_ONLY"},
    {ENOSPC, "IDS_QM_SYSTEM_NO_SPACE"},
    {EDQUOT, "IDS_QM_SYSTEM_QUOTA"},
    {EFBIG, "IDS_QM_SYSTEM_TOO_BIG"},
    {EEXIST, "IDS_QM_SYSTEM_EXISTS"},
    {ETXTBSY, "IDS_QM_SYSTEM_BUSY"},
    {EINVAL, "IDS_QM_SYSTEM_INVALID"},
    {EIO, "IDS_QM_SYSTEM_INPUT_OUTPUT"},
    {ENAMETOOLONG, "IDS_QM_SYSTEM_NAME_TOO_LONG"},
}};

} // namespace

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

std::string SystemReason(int errorNumber)
{
    const auto known = std::ranges::find(kSystemTexts, errorNumber, &T_SYSTEM_TEXT::errorNumber);
    return known != kSystemTexts.end() ? Say(known->key)
                                       : std::generic_category().message(errorNumber);
}

void ThrowSystem(const char* key, int errorNumber)
{
    throw CStoreFault(FILE_FAULT::NoAccess, key, SystemReason(errorNumber));
}
