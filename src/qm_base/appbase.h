// Release assertion: internal inconsistencies are logged with source and line; work carries on.
#pragma once

#include <string>
#include <vector>

struct T_ASSERTION {
    std::string source; // source file without extension, for example "src/qm_rps/optdsgn"
    int line = 0;
    bool operator==(const T_ASSERTION&) const = default;
};

class CAppBase {
public:
    /// Are release assertions reported? Here always; callers ask before they raise one.
    static bool IsReleaseAssert_ST() { return true; }

    /// Logs source and line through GDebugOut, keeps the latest 1,000 for inspection, and returns.
    static void ReleaseAssertion_ST(const char* source, int line);

    /// The assertions raised since the last call, oldest first; the list is emptied.
    static std::vector<T_ASSERTION> TakeAssertions_ST();
};
