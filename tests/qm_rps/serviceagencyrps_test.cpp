#include "qm_rps/serviceagencyrps.h"

#include "frametest.h"
#include "hingesample.h"
#include "numbers.h"
#include "qm_base/appbase.h"
#include "qm_rps/po_hingeskcvtabfemaaxialdlg.h"
#include "qm_rps/po_hingeskcvtabfemadlg.h"
#include "qm_rps/po_inelastichingedlg.h"
#include "qm_rps/rps_main.h"

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

/// A curve that keeps every rule.
T_SKEL_FEMA GoodCurve()
{
    T_SKEL_FEMA c = ValidBackbone<T_SKEL_FEMA>();
    c.symmetric = true;
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
    std::vector<std::pair<double, double>> found;
    for (const T_SKEL_AXIAL& row : rows)
        found.emplace_back(row.axial, row.sides.pos.yield);
    const decltype(found) expected{{100, 100}, {250, 77}, {450, 600}, {500, 600}};
    EXPECT_EQ(expected, found);
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
    const char* const full = "IDS_RPS_PUSHOVER_Maxnum_reached";
    const char* const rows = "IDS_QM_UI_AXIAL_ROWS";
    const std::vector<std::string> keys{full,
                                        rows,
                                        rows,
                                        full,
                                        "IDS_QM_UI_AXIAL_YIELD",
                                        "Axial Force %g does not exist!",
                                        "Axial Force %g already exists!"};
    EXPECT_EQ(keys, m_view.m_messages);
}

TEST_F(Service, IsReachedAtTheHeadOfficeUnderItsName)
{
    EXPECT_EQ(1, RegisterRPSService());
    CServiceAgency* agency = CServiceHeadOffice::Instance()->GetAgency("rps");
    ASSERT_NE(nullptr, dynamic_cast<CServiceAgencyRps*>(agency));
    EXPECT_EQ(1, RegisterRPSService()); // the same one
    EXPECT_EQ(agency, CServiceHeadOffice::Instance()->GetAgency("rps"));
    EXPECT_EQ(nullptr, CServiceHeadOffice::Instance()->GetAgency("\"rps\""));
    for (const int kind : {3, 4, 5}) // the figures
        EXPECT_EQ(0, agency->Service({.kind = kind}));
    EXPECT_EQ(3, m_view.m_shown);
    EXPECT_EQ(0U, Raised());
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

// The window of inelastic hinges asks the agency for both editors; what is accepted is one edit.
TEST_F(Service, TheWindowOfInelasticHingesStoresWhatTheEditorsGive)
{
    (void)RegisterRPSService();
    CPO_InelasticHingeDlg hinges;
    hinges.SetDoc(&m_doc);
    EXPECT_EQ(0, hinges.OnCurve()); // there is no record
    ASSERT_EQ(1, hinges.OnNew());
    EXPECT_EQ(0, hinges.OnAxialForces()); // nor a curve
    m_view.m_run = [](zql::frx::MDialog& dialog) {
        auto& fema = dynamic_cast<CPO_HingeSkcvTabFemaDlg&>(dialog);
        *fema.Curve(HINGE_COMPONENT::My, HINGE_END::Both) = GoodCurve();
        return 1;
    };
    ASSERT_EQ(1, hinges.OnCurve());
    EXPECT_EQ("0", hinges.Cells().rows.at(4).at(2));
    m_view.m_run = [](zql::frx::MDialog& dialog) {
        return dynamic_cast<CPO_HingeSkcvTabFemaAxialDlg&>(dialog).AddForce(250.0);
    };
    ASSERT_EQ(1, hinges.OnAxialForces());
    EXPECT_EQ("1", hinges.Cells().rows.at(4).at(2));
    EXPECT_EQ(1, m_doc.Undo().Undo());
    EXPECT_EQ("0", hinges.Cells().rows.at(4).at(2));
}
