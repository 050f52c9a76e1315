// What the parts of the model store throw at each other; CModelStore turns it into a T_FILE_ERROR.
#pragma once

#include "qm_base/say.h"
#include "qm_db/fileerror.h"

#include <exception>
#include <new>
#include <string>
#include <utility>

/// A refusal: message key, whose {1} is the file's name and whose {2} to {4} are details.
class CStoreFault : public std::exception {
public:
    CStoreFault(FILE_FAULT fault, const char* key, std::string second = {}, std::string third = {},
                std::string fourth = {})
        : m_fault(fault), m_key(key), m_second(std::move(second)), m_third(std::move(third)),
          m_fourth(std::move(fourth))
    {
    }
    const char* what() const noexcept override { return m_key; }
    /// The whole message, one line.
    T_FILE_ERROR ForFile(const std::string& path) const;

private:
    FILE_FAULT m_fault;
    const char* m_key; // a literal
    std::string m_second, m_third, m_fourth;
};

/// BadInput: "<file> is damaged: <what>".
[[noreturn]] void ThrowDamaged(const std::string& what);
/// What the system's error number says.
std::string SystemReason(int errorNumber);
/// NoAccess with the text of the system's error number as the detail.
[[noreturn]] void ThrowSystem(const char* key, int errorNumber);

/// The door of this room: runs `work`; what it throws becomes the error. 1 done, 0 refused.
template <class F>
int Guarded(const std::string& path, T_FILE_ERROR& error, const F& work)
{
    try {
        work();
        error = {};
        return 1;
    } catch (const CStoreFault& fault) {
        error = fault.ForFile(path);
    } catch (const std::bad_alloc&) {
        error = {FILE_FAULT::NoAccess, path + ": " + Say("IDS_QM_NO_MEMORY")};
    } catch (const std::exception& fault) {
        error = {FILE_FAULT::NoAccess, path + ": " + fault.what()};
    }
    return 0;
}
