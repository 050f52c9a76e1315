// Several evaluations side by side, as the program writes them.
#include "program.h"

namespace {

class Overview : public CProgramTest {};

} // namespace

TEST_F(Overview, EvaluationsAreOverlaidDrawnAsBarsAndListed)
{
    const std::string two =
        "evaluate @rc-frame-3-storey --only 'PX_MODE1 ATC-40 B' --only 'PX_MODE1 NTC2018'";
    (void)Done(two + " --overlay o.svg --bars b.svg --bars-of drift --summary s.csv");
    ExpectHolds(Text("o.svg"), {"PX_MODE1 ATC-40 B", "PX_MODE1 NTC2018 (SLV)"});
    ExpectHolds(Text("b.svg"), {"drift (%)", "NG"});
    const std::vector<std::string> rows = Lines(Text("s.csv"));
    ASSERT_EQ(3U, rows.size());
    EXPECT_TRUE(rows[1].starts_with("PX_MODE1 ATC-40 B,ATC-40 B,PX_MODE1,ATC design,"));
    ExpectHolds(rows[1], {",not checked,"});
    ExpectHolds(rows[2], {",SLV,NG,"});
    // The figures are those of the results.
    const json point =
        Json("evaluate @rc-frame-3-storey --only 'PX_MODE1 ATC-40 B'")[0].at("performance_point");
    char D[32];
    std::snprintf(D, sizeof D, "%.4g", point.at("D").get<double>());
    ExpectHolds(rows[1], {D});
}

TEST_F(Overview, AnUnknownNameOrAnExistingFileIsRefused)
{
    ExpectRefused("evaluate @rc-frame-3-storey --only 'PX_MODE1 EC8' --only nope --overlay o.svg",
                  2, "nope");
    Write("o.svg", "mine");
    ExpectRefused("evaluate @rc-frame-3-storey --only 'PX_MODE1 EC8' --overlay o.svg", 4, "o.svg");
    EXPECT_EQ("mine", Text("o.svg"));
}
