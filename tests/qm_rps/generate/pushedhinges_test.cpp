// Hinges that a code gives with the shear of a push: progress, and what a stopped one leaves.
#include "frametest.h"
#include "qm_rps/codehingedlg.h"

namespace {

using PushedHinges = FrameTest;

} // namespace

TEST_F(PushedHinges, AStoppedPushLeavesTheDocumentAsItWas)
{
    Open("rc-frame-code-hinges");
    CCodeHingeDlg dlg(m_doc);
    dlg.SetView(&m_view);
    dlg.OnAll();
    dlg.m_options.m_code = HINGE_CODE::Asce17;
    dlg.m_options.m_shear = 1; // PX
    std::size_t told = 0, total = 0;
    const std::size_t most = 3;
    dlg.m_withProgress = [&](const std::function<int(CCodeHingeDlg::TELL_FN)>& work) {
        return work([&](std::size_t done, std::size_t of) {
            told = done, total = of;
            return done < most;
        });
    };
    const auto before = m_doc.Data().Model().hinges;
    const auto types = m_doc.Data().Model().hingeTypes;
    EXPECT_EQ(0, dlg.OnPreview());
    EXPECT_NE(std::string::npos, dlg.StatusText().find("cancelled")) << dlg.StatusText();
    EXPECT_FALSE(dlg.HasPreview());
    EXPECT_EQ(most, told);
    EXPECT_EQ(50u, total); // steps of PX
    EXPECT_EQ(0, dlg.OnApply());
    EXPECT_EQ(before, m_doc.Data().Model().hinges);
    EXPECT_EQ(types, m_doc.Data().Model().hingeTypes);
}
