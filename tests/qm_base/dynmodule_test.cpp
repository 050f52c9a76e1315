#include "qm_base/dynmodule.h"

#include <gtest/gtest.h>

TEST(DynModule, KeepsTheFirstModuleOfAName)
{
    CDynModuleMgr mgr;
    EXPECT_EQ(nullptr, mgr.GetDynModule("CRPSManager"));
    auto module = std::make_unique<CDynModule>();
    const CDynModule* const first = module.get();
    EXPECT_EQ(1, mgr.AddDynModule("CRPSManager", std::move(module)));
    EXPECT_EQ(first, mgr.GetDynModule("CRPSManager"));

    EXPECT_EQ(0, mgr.AddDynModule("CRPSManager", std::make_unique<CDynModule>()));
    EXPECT_EQ(first, mgr.GetDynModule("CRPSManager"));
}

TEST(DynModule, RefusesNoNameAndNoModule)
{
    CDynModuleMgr mgr;
    EXPECT_EQ(0, mgr.AddDynModule("", std::make_unique<CDynModule>()));
    EXPECT_EQ(0, mgr.AddDynModule("x", nullptr));
    EXPECT_EQ(nullptr, mgr.GetDynModule(""));
    EXPECT_EQ(1, mgr.AddDynModule("x", std::make_unique<CDynModule>())) << "x was not taken";
}
