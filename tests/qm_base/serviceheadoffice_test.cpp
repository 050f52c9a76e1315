#include "qm_base/serviceheadoffice.h"

#include <gtest/gtest.h>

namespace {

class CEchoAgency : public CServiceAgency {
public:
    int Service(const T_SERVICE_REQUEST& request) override { return request.kind == 3 ? 1 : 0; }
};

} // namespace

TEST(ServiceHeadOffice, FindsTheAgencyRegisteredFirst)
{
    CServiceHeadOffice* const office = CServiceHeadOffice::Instance();
    ASSERT_NE(nullptr, office);
    EXPECT_EQ(nullptr, office->GetAgency("echo"));
    auto agency = std::make_unique<CEchoAgency>();
    const CServiceAgency* const first = agency.get();
    EXPECT_EQ(1, office->RegAgency("echo", std::move(agency)));
    EXPECT_EQ(0, office->RegAgency("echo", std::make_unique<CEchoAgency>()));

    CServiceAgency* const found = CServiceHeadOffice::Instance()->GetAgency("echo");
    ASSERT_EQ(first, found);
    EXPECT_EQ(1, found->Service({.kind = 3}));
    EXPECT_EQ(0, found->Service({.kind = 4}));
}

TEST(ServiceHeadOffice, RefusesNoNameAndNoAgency)
{
    CServiceHeadOffice office;
    EXPECT_EQ(0, office.RegAgency("", std::make_unique<CEchoAgency>()));
    EXPECT_EQ(0, office.RegAgency("none", nullptr));
    EXPECT_EQ(nullptr, office.GetAgency("none"));
}
