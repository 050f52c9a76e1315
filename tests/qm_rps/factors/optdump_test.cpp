#include "tempfolder.h"
#include "ulfsample.h"

#include "qm_rps/factors/optdump.h"

#include <gtest/gtest.h>

namespace {

constexpr const char* kText = R"(      ============================================================
                      UNKNOWN LOAD FACTOR : OPTIMIZED
                      QM RPS
      ============================================================
      NVAR  = 2
      NCON  = 1
      NEQ   = 0
      IOBJ  = 2
      ISIGN = -1


      RHS8(1) = -5.000000


      WGTFAC(1) = 2.000000
      WGTFAC(2) = 0.500000


      COEFVEC(1) = -1.000000
      COEFVEC(2) = -2.250000
)";

} // namespace

TEST(OptDump, WritesTheProblemHandedOverAndAsksBeforeOverwriting)
{
    const CTempFolder folder;
    const std::string path = folder / "frame_[OPTIMIZE].out";
    CTableResponse source;
    source.m_table[{1, 1, 0, 1}] = {1, 2.25};
    T_OPT_PROBLEM p;
    p.items = {{1, 0, 2, 0}, {2, 0, 0.5, 0}};
    p.nvar = p.iobj = 2, p.isign = -1;
    p.constraints = {{1, 1, 1, 5, 1, 1}};
    T_HANDED handed;
    T_OPT_ANSWER answer;
    COptDsgn optimizer(source);
    optimizer.SetSolver(Answering(handed, {0, 0}));
    const auto run = [&] { ASSERT_EQ(1, optimizer.Run(p, answer)); };

    run();
    EXPECT_TRUE(folder.Names().empty()); // off by default
    optimizer.m_dump = {true, folder / "frame.qmdb", {}};
    run();
    run(); // nobody to ask: added
    EXPECT_EQ(std::string(kText) + kText, ReadText(path));
    optimizer.m_dump.overwrite = [] { return true; };
    run();
    EXPECT_EQ(kText, ReadText(path));
    optimizer.m_dump.modelPath = folder / "missing/frame.qmdb";
    run(); // silently skipped
}

TEST(OptDump, NamesTheFileByModelAndMode)
{
    EXPECT_EQ("/a/frame.v2_[EXACT].out", OptDumpPath("/a/frame.v2.qmdb", true));
    EXPECT_EQ("frame_[OPTIMIZE].out", OptDumpPath("frame", false));
    EXPECT_NE(std::string::npos, OptDumpText({}, true, 1, 0).find("UNKNOWN LOAD FACTOR : SOLVE\n"));
}
