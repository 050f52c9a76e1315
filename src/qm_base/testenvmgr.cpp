#include "qm_base/testenvmgr.h"

#include <cstdlib>
#include <map>
#include <mutex>

namespace {

struct T_SWITCHES {
    std::mutex guard;
    std::map<std::string, std::string, std::less<>> values;
};

T_SWITCHES& Switches()
{
    static T_SWITCHES switches;
    return switches;
}

} // namespace

bool CTestEnvMgr::IsTestEnvST(std::string_view name, std::string_view value)
{
    {
        T_SWITCHES& switches = Switches();
        const std::lock_guard lock(switches.guard);
        const auto found = switches.values.find(name);
        if (found != switches.values.end()) return found->second == value;
    }
    const char* const set = std::getenv(std::string("QM_TEST_").append(name).c_str());
    return set && value == set;
}

void CTestEnvMgr::SetTestEnvST(std::string_view name, std::string_view value)
{
    T_SWITCHES& switches = Switches();
    const std::lock_guard lock(switches.guard);
    switches.values.insert_or_assign(std::string(name), std::string(value));
}

void CTestEnvMgr::ClearST()
{
    T_SWITCHES& switches = Switches();
    const std::lock_guard lock(switches.guard);
    switches.values.clear();
}
