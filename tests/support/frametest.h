// The base of tests of what knows the document of a frame and shows dialogs.
#pragma once

#include "scriptview.h"

#include "qm_rps/modelessdlgctrl.h"

#include <gtest/gtest.h>

#include <string>

/// A document of an example, with a view.
class FrameTest : public testing::Test {
protected:
    void Open(const char* example)
    {
        T_FILE_ERROR error;
        const std::string path = std::string(QM_PROJECT "/examples/") + example + "/case.json";
        ASSERT_EQ(1, m_doc.ImportCase(path, error)) << error.text;
        CModelessDlgCtrl::Of(m_doc).SetView(&m_view);
    }
    const T_MODEL& Model() const { return m_doc.Data().Model(); }

    CScriptView m_view;
    CDBDoc m_doc;
};
