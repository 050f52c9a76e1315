// What the tests of the windows of load factors share.
#pragma once

#include "ulftools.h"
#include "windowplay.h"

namespace desktop_test {

class UlfWindows : public DesktopTest {
protected:
    void OpenRecord(EXPLORER_TABLE table, int key)
    {
        EXPECT_TRUE(OpenUlfRecord(m_main->Desktop(), table, key));
    }
    /// A copy of the example that may be written beside.
    void OpenCopy(const char* example, const char* name)
    {
        ASSERT_TRUE(Open(example));
        T_FILE_ERROR error;
        ASSERT_TRUE(m_main->Doc().SaveModelAs(File(name).toStdString(), error)) << error.text;
    }
    /// In N, of the first tension of a load case.
    double Tension(const char* loadCase)
    {
        for (const auto& entry : Model().loadCases)
            if (entry.second.name == loadCase) return entry.second.pretension.at(0).force;
        return 0.0;
    }
};

} // namespace desktop_test
