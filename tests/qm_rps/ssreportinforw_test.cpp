#include "qm_rps/ssreportinforw.h"

#include "frametest.h"
#include "qm_base/appbase.h"
#include "qm_rps/irpsinterfaceimpl.h"
#include "qm_rps/rpsmanager.h"

namespace {
class Report : public FrameTest {};
} // namespace

TEST_F(Report, HoldsStoreysStepsAndResultsOfTheModel)
{
    Open("rc-frame-3-storey");
    IRPSInterfaceImpl interface;
    ASSERT_EQ(1, interface.BuildReport()) << interface.Error();
    const SSReportInfoRW& info = *CRPSManager::Current()->ReportInfo();
    ASSERT_EQ(3U, info.storeys.size());
    EXPECT_EQ("3F", info.storeys[2].name);
    EXPECT_EQ(168.0, info.storeys[2].height); // in, as the case file states them
    EXPECT_EQ(504.0, info.storeys[2].elevation);
    EXPECT_EQ((std::vector<int>{41, 42, 43, 44}), info.storeys[2].nodes);
    // 2 x 0.062950310559 + 2 x 0.121770186335 kips s2/in
    EXPECT_NEAR(0.369440993788, info.storeys[0].mass[0], 1e-12);
    EXPECT_EQ(0.0, info.storeys[0].mass[1]);
    ASSERT_EQ(3U, info.pushovers.size());
    // Step 50 of PX_UNIFORM computed apart from the recorder files (row 51): sum of the base
    // reactions; over 168 the largest difference of a vertical pair of nodes, and of the storeys'
    // mass-weighted mean displacements.
    const T_REPORT_PUSH& push = info.pushovers[1];
    EXPECT_EQ("PX_UNIFORM", push.name);
    ASSERT_EQ(500U, push.steps.size());
    const T_REPORT_STEP& step = push.steps[49];
    EXPECT_EQ(50, step.step);
    EXPECT_NEAR(391.11289416999995, step.baseReaction, 1e-6);
    EXPECT_NEAR(5.040651092 - 0.0006510923811, step.controlDisplacement, 1e-9); // from row 1
    ASSERT_EQ(3U, step.drifts.size());
    constexpr double kPlain[] = {0.026323188131131, 0.002874338305941, 0.001026719119851};
    constexpr double kCentre[] = {0.026231238656492, 0.002744887126278, 0.001025080484511};
    for (std::size_t i = 0; i < 3; ++i) {
        EXPECT_EQ(static_cast<int>(i) + 1, step.drifts[i].storey);
        EXPECT_NEAR(kPlain[i], step.drifts[i].plain, 1e-12);
        EXPECT_NEAR(kCentre[i], step.drifts[i].centre, 1e-12);
    }
    EXPECT_EQ(Model().evaluations.size(), info.evaluations.size());
    EXPECT_FALSE(m_doc.Data().IsModified()); // a report changes nothing
}

TEST_F(Report, ListsTheLimitStatesThatTheModelKeeps)
{
    Open("rc-frame-3-storey");
    m_doc.Post().GetPoverInfo()->SetStepEC8(1, 12, 40, -2);
    SSReportInfoRW info;
    std::string error;
    ASSERT_EQ(1, BuildReportInfo(m_doc, info, error)) << error;
    const auto& states = info.pushovers[0].limitStates;
    ASSERT_EQ(3U, states.size());
    EXPECT_EQ(std::pair(std::string("SD"), 40), std::pair(states[1].name, states[1].step));
    EXPECT_TRUE(info.pushovers[1].limitStates.empty());
}

TEST_F(Report, TheSameSetTwiceAssertsAndIsTakenStill)
{
    CRPSManager manager;
    const auto info = std::make_shared<SSReportInfoRW>();
    (void)CAppBase::TakeAssertions_ST();
    manager.SetReportInfo(std::make_shared<SSReportInfoRW>()); // equal, but another one
    manager.SetReportInfo(nullptr);
    manager.SetReportInfo(nullptr);
    manager.SetReportInfo(info);
    EXPECT_TRUE(CAppBase::TakeAssertions_ST().empty());
    manager.SetReportInfo(info);
    const auto raised = CAppBase::TakeAssertions_ST();
    ASSERT_EQ(1U, raised.size());
    EXPECT_EQ("src/qm_rps/rpsmanager", raised[0].source);
    EXPECT_EQ(info, manager.ReportInfo());
}

TEST_F(Report, WithoutADocumentNothingIsBuilt)
{
    CDBDoc::SetDocPoint(nullptr);
    IRPSInterfaceImpl interface;
    EXPECT_EQ(0, interface.BuildReport());
    EXPECT_EQ("no document", interface.Error());
}
