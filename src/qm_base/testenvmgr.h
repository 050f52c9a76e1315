// Switches of the test environment: named values that enable diagnostics.
#pragma once

#include <string>
#include <string_view>

class CTestEnvMgr {
public:
    /// True when the switch `name` was set to exactly `value`, for example ("FEMA440", "yes").
    /// A switch that was never set is read from the environment variable QM_TEST_<name>.
    static bool IsTestEnvST(std::string_view name, std::string_view value);
    static void SetTestEnvST(std::string_view name, std::string_view value);
    /// Forgets every switch set by SetTestEnvST.
    static void ClearST();
};
