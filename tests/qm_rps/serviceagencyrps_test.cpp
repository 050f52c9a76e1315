#include "qm_rps/serviceagencyrps.h"

#include "frametest.h"
#include "numbers.h"
#include "qm_base/appbase.h"
#include "qm_rps/po_femastrlossfigure0dlg.h"
#include "qm_rps/po_femastrlossfigureedlg.h"
#include "qm_rps/po_femaunloadstifffigureedlg.h"
#include "qm_rps/po_hingeskcvtabfemaaxialdlg.h"
#include "qm_rps/po_hingeskcvtabfemadlg.h"
#include "qm_rps/rps_main.h"

#include <random>

namespace {

class Service : public FrameTest {
protected:
    void SetUp() override
    {
        CModelessDlgCtrl::Of(m_doc).SetView(&m_view);
        (void)CAppBase::TakeAssertions_ST();
    }
    int Ask(T_SERVICE_REQUEST request) { return m_agency.Service(request); }
    static std::size_t Raised() { return CAppBase::TakeAssertions_ST().size(); }
    CServiceAgencyRps m_agency;
};

/// Random records: every field of a curve has a value of its own.
class CRandomHinge {
public:
    T_SKEL_FEMA Curve()
    {
        T_SKEL_FEMA c;
        c.symmetric = Flag();
        c.autoYield = Flag();
        c.measure = static_cast<SKEL_MEASURE>(Int(1));
        c.sides = {Side(), Side()};
        c.strengthLoss = Flag();
        c.initStiffness = static_cast<INIT_STIFFNESS>(Int(4));
        c.asymStiffness = Flag();
        c.unloadType = static_cast<UNLOAD_TYPE>(Int(4));
        c.unloadFactor = Real();
        c.unloadExponent = Real();
        c.unloadProportion = Real();
        c.energyBased = Flag();
        c.multiCurve = Flag();
        for (int i = Int(3); i > 0; --i)
            c.curves.push_back({Real(), {Side(), Side()}});
        if (Flag()) c.dcRatio = T_SIDES<double>{Real(), Real()};
        c.infillStrut = Flag();
        c.infillGeneral = Flag();
        c.compliance = Flag();
        return c;
    }
    T_IEHP_D Record()
    {
        T_IEHP_D r;
        r.name = "hinge " + std::to_string(Int(1000));
        for (auto& c : r.components)
            if (Int(3) > 0) c = Curve();
        return r;
    }
    bool Flag() { return Int(1) == 1; }
    int Int(int most) { return std::uniform_int_distribution<int>(0, most)(m_engine); }
    double Real() { return std::normal_distribution<double>(0.0, 1e3)(m_engine); }

private:
    T_SKEL_SIDE Side()
    {
        T_SKEL_SIDE s;
        s.yield = Real();
        s.yieldDeform = Real();
        for (T_SKEL_POINT* p : {&s.B, &s.C, &s.D, &s.E})
            *p = {Real(), Real()};
        s.IO = Real();
        s.LS = Real();
        s.CP = Real();
        s.userStiffness = Real();
        for (double& e : s.energy)
            e = Real();
        return s;
    }
    std::mt19937 m_engine{7};
};

/// A curve that keeps every rule, of a moment component.
T_SKEL_FEMA GoodCurve()
{
    T_SKEL_FEMA c;
    T_SKEL_SIDE& s = c.sides.pos;
    s.yield = 100.0;
    s.yieldDeform = 0.01;
    s.B = {1.0, 1.0};
    s.C = {6.0, 1.1};
    s.D = {7.0, 0.4};
    s.E = {9.0, 0.3};
    s.IO = 2.0;
    s.LS = 4.0;
    s.CP = 6.0;
    return c;
}

std::vector<T_SKEL_AXIAL> Rows(std::initializer_list<double> forces)
{
    std::vector<T_SKEL_AXIAL> rows;
    for (const double f : forces) {
        rows.push_back({f, {}});
        rows.back().sides.pos.yield = 100.0 + f;
    }
    return rows;
}

} // namespace

TEST_F(Service, ConversionsLoseNothingEitherWayForEveryComponent)
{
    CRandomHinge random;
    for (int round = 0; round < 200; ++round)
        for (int c = 0; c < 6; ++c) {
            const T_IEHP_D iehp = random.Record();
            T_PHGT_D type;
            ASSERT_EQ(1, CAttrCtrl::Convert_IehpToPhgt_FEMA(iehp, c, type));
            T_IEHP_D back = iehp, fresh;
            back.name = "other";
            back.components[static_cast<std::size_t>(c)] = random.Curve(); // to be overwritten
            ASSERT_EQ(1, CAttrCtrl::Convert_PhgtToIehp_FEMA(type, c, back));
            EXPECT_EQ(iehp, back) << c; // the component, and the others as they were
            ASSERT_EQ(1, CAttrCtrl::Convert_PhgtToIehp_FEMA(type, c, fresh));
            T_PHGT_D again;
            ASSERT_EQ(1, CAttrCtrl::Convert_IehpToPhgt_FEMA(fresh, c, again));
            EXPECT_EQ(type, again) << c;
        }
}

TEST_F(Service, TheEditorChangesTheCallersComponentOnOkAlone)
{
    T_IEHP_D record;
    record.name = "steel";
    record.components[4] = GoodCurve();
    record.components[0] = GoodCurve();
    const T_IEHP_D before = record;
    int answer = 0;
    T_SERVICE_REQUEST request{.kind = 1, .index = 4, .record = &record};
    m_view.m_run = [&](zql::frx::MDialog& dialog) {
        auto& fema = dynamic_cast<CPO_HingeSkcvTabFemaDlg&>(dialog);
        EXPECT_TRUE(fema.IsTimeHistory());
        for (int c = 0; c < 6; ++c) // components 3 and 4, as they are numbered
            EXPECT_EQ(c == 3 || c == 4, fema.IsMomentRotationEnabled(HINGE_COMPONENT(c))) << c;
        fema.Curve(HINGE_COMPONENT::My, HINGE_END::Both)->sides.pos.yield = 120.0;
        request.index = 0; // the record was copied
        return answer;
    };
    EXPECT_EQ(0, Ask(request));
    EXPECT_EQ(before, record);
    answer = 1;
    request.index = 4;
    EXPECT_EQ(1, Ask(request));
    EXPECT_EQ(120.0, record.components[4]->sides.pos.yield);
    EXPECT_EQ(before.components[0], record.components[0]);
    EXPECT_EQ(2, m_view.m_shown);
    EXPECT_EQ(0U, Raised());
}

TEST_F(Service, ABrokenCurveNeverReachesTheCaller)
{
    T_IEHP_D record; // its component is not there: an empty curve breaks the rules
    const T_IEHP_D before = record;
    m_view.m_run = [](zql::frx::MDialog&) { return 1; };
    EXPECT_EQ(0, Ask({.kind = 1, .index = 5, .record = &record}));
    EXPECT_EQ(before, record);
    m_view.m_run = [](zql::frx::MDialog& dialog) {
        auto& fema = dynamic_cast<CPO_HingeSkcvTabFemaDlg&>(dialog);
        *fema.Curve(HINGE_COMPONENT::Mz, HINGE_END::Both) = GoodCurve();
        return fema.OnOK();
    };
    EXPECT_EQ(1, Ask({.kind = 1, .index = 5, .record = &record}));
    ASSERT_TRUE(record.components[5].has_value());
    EXPECT_EQ(-6.0, record.components[5]->sides.neg.C.deform); // mirrored
}

TEST_F(Service, WrongRequestsAssertAndGiveZero)
{
    T_IEHP_D record;
    for (const T_SERVICE_REQUEST& request :
         {T_SERVICE_REQUEST{.kind = 0}, T_SERVICE_REQUEST{.kind = 6}, T_SERVICE_REQUEST{.kind = -1},
          T_SERVICE_REQUEST{.kind = 1}, T_SERVICE_REQUEST{.kind = 1, .index = 6, .record = &record},
          T_SERVICE_REQUEST{.kind = 1, .index = -1, .record = &record},
          T_SERVICE_REQUEST{.kind = 2}}) {
        EXPECT_EQ(0, Ask(request)) << request.kind;
        EXPECT_EQ(1U, Raised()) << request.kind;
    }
    EXPECT_EQ(0, m_view.m_shown);
}

TEST_F(Service, AxialForcesAreRebuiltFromTheEditedTableFirst)
{
    auto rows = Rows({0.0, 250.0, 500.0});
    m_view.m_run = [](zql::frx::MDialog& dialog) {
        auto& d = dynamic_cast<CPO_HingeSkcvTabFemaAxialDlg&>(dialog);
        EXPECT_EQ(1, d.SetYield(250.0, HINGE_SIDE::Positive, 77.0));
        EXPECT_EQ(1, d.ChangeForce(0.0, 100.0)); // its curve goes with it
        EXPECT_EQ(1, d.AddForce(450.0));         // starts with that of 500
        return 1;
    };
    EXPECT_EQ(1, Ask({.kind = 2, .rows = &rows}));
    ASSERT_EQ(4U, rows.size());
    const std::vector<std::pair<double, double>> expected{
        {100.0, 100.0}, {250.0, 77.0}, {450.0, 600.0}, {500.0, 600.0}};
    for (std::size_t i = 0; i < expected.size(); ++i) {
        EXPECT_EQ(expected[i].first, rows[i].axial);
        EXPECT_EQ(expected[i].second, rows[i].sides.pos.yield);
    }
    const auto before = rows;
    m_view.m_run = [](zql::frx::MDialog& dialog) {
        return 1 - dynamic_cast<CPO_HingeSkcvTabFemaAxialDlg&>(dialog).RemoveForce(100.0);
    };
    EXPECT_EQ(0, Ask({.kind = 2, .rows = &rows})); // cancelled
    EXPECT_EQ(before, rows);
    EXPECT_EQ(0U, Raised());
}

TEST_F(Service, AForceInNeitherTableAssertsAndGetsNoRow)
{
    T_SIDES<T_SKEL_SIDE> edited, old;
    edited.pos.yield = 1.0;
    old.pos.yield = 2.0;
    const auto rows =
        CServiceAgencyRps::RebuildRows({5.0, 6.0, 7.0}, {{5.0, edited}}, {{5.0, old}, {7.0, old}});
    EXPECT_EQ(1U, Raised());
    ASSERT_EQ(2U, rows.size());
    EXPECT_EQ(1.0, rows[0].sides.pos.yield); // the edited one goes first
    EXPECT_EQ(2.0, rows[1].sides.pos.yield);
}

TEST_F(Service, TheAxialTableHoldsTenForcesAndRefusesBadOnes)
{
    CPO_HingeSkcvTabFemaAxialDlg d;
    d.SetView(&m_view);
    EXPECT_EQ(0, d.Data2Dlg(Rows({1, 2, 3, 4, 5, 6, 7, 8, 9, 10, 11})));
    EXPECT_EQ(0, d.Data2Dlg(Rows({1, 1})));
    EXPECT_EQ(0, d.Data2Dlg(Rows({kNan})));
    ASSERT_EQ(1, d.Data2Dlg(Rows({1, 2, 3, 4, 5, 6, 7, 8, 9, 10})));
    EXPECT_EQ(0, d.AddForce(11.0));
    for (double f = 1.0; f < 10.5; f += 1.0)
        ASSERT_EQ(1, d.SetYield(f, HINGE_SIDE::Negative, f));
    EXPECT_EQ(1, d.ChangeForce(10.0, 20.0)); // with every value edited already
    EXPECT_EQ(10.0, d.SidesOf(20.0).neg.yield);
    EXPECT_EQ(110.0, d.SidesOf(20.0).pos.yield);
    EXPECT_EQ(10U, d.Values().size());
    EXPECT_EQ(0, d.SetYield(1.0, HINGE_SIDE::Positive, -1.0));
    EXPECT_EQ(0, d.RemoveForce(33.0));
    EXPECT_EQ(1, d.RemoveForce(3.0));
    EXPECT_EQ(0, d.AddForce(4.0)); // is there
    EXPECT_EQ(1, d.AddForce(3.0));
    EXPECT_EQ(10U, d.Keys().size());
    const std::vector<std::string> keys{"IDS_RPS_PUSHOVER_Maxnum_reached",
                                        "IDS_QM_UI_AXIAL_ROWS",
                                        "IDS_QM_UI_AXIAL_ROWS",
                                        "IDS_RPS_PUSHOVER_Maxnum_reached",
                                        "IDS_QM_UI_AXIAL_YIELD",
                                        "Axial Force %g does not exist!",
                                        "Axial Force %g already exists!"};
    EXPECT_EQ(keys, m_view.m_messages);
}

TEST_F(Service, FiguresAreShownAndGiveZero)
{
    std::vector<std::string> shown;
    m_view.m_run = [&](zql::frx::MDialog& dialog) {
        shown.push_back(dynamic_cast<CFemaFigureDlg&>(dialog).TitleKey());
        return 1;
    };
    for (const int kind : {3, 4, 5})
        EXPECT_EQ(0, Ask({.kind = kind}));
    EXPECT_EQ((std::vector<std::string>{CPO_FEMAStrLossFigure0Dlg().TitleKey(),
                                        CPO_FEMAStrLossFigureEDlg().TitleKey(),
                                        CPO_FEMAUnloadStiffFigureEDlg().TitleKey()}),
              shown);
    EXPECT_EQ(0U, Raised());
}

TEST_F(Service, IsReachedAtTheHeadOfficeUnderItsName)
{
    EXPECT_EQ(1, RegisterRPSService());
    CServiceAgency* agency = CServiceHeadOffice::Instance()->GetAgency("rps");
    ASSERT_NE(nullptr, dynamic_cast<CServiceAgencyRps*>(agency));
    EXPECT_EQ(1, RegisterRPSService()); // the same one
    EXPECT_EQ(agency, CServiceHeadOffice::Instance()->GetAgency("rps"));
    EXPECT_EQ(nullptr, CServiceHeadOffice::Instance()->GetAgency("\"rps\""));
    EXPECT_EQ(0, agency->Service({.kind = 4}));
    EXPECT_EQ(1, m_view.m_shown);
}

TEST_F(Service, WithoutADocumentNothingIsShown)
{
    CDBDoc::SetDocPoint(nullptr);
    T_IEHP_D record;
    record.components[4] = GoodCurve();
    EXPECT_EQ(0, Ask({.kind = 1, .index = 4, .record = &record}));
    EXPECT_EQ(0, Ask({.kind = 3}));
    EXPECT_EQ(0, m_view.m_shown);
}
