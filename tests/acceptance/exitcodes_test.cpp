// What the exit codes say: 0 found, 1 not found, 2 usage, 3 bad input, 4 file access.
#include "program.h"

namespace {

using ExitCode = CProgramTest;

TEST_F(ExitCode, Is1WhenOnePointWasNotFound)
{
    const T_RUN run =
        Run("evaluate @steel-frame-2-storey --only 'PX_MODE1 ATC-40 A beyond capacity'");
    EXPECT_EQ(1, run.code);
    EXPECT_EQ("", run.err);
    ExpectHolds(run.out, {"not found", "no crossing with the reduced demand"});
    Done("evaluate @steel-frame-2-storey --only 'PX_MODE1 ATC-40 A'");
}

TEST_F(ExitCode, TellsWhyNothingWasDone)
{
    const struct {
        const char* arguments;
        int code;
        const char* says = "";
    } kRows[] = {
        {"", 2},
        {"calculate @first-steps", 2},
        {"evaluate", 2},
        {"evaluate @first-steps --fast", 2},
        {"evaluate @first-steps --only", 2},
        {"evaluate @first-steps --only 'no such evaluation'", 2},
        {"compare @first-steps --push PX --spectrum none", 2},
        {"compare @first-steps --push none --spectrum ATC", 2},
        {"--lang de info @first-steps", 2},
        {"import @first-steps", 2},
        {"analyse @tuned-beam --case none", 2},
        {"analyse @tuned-beam --modes 0", 2},
        {"analyse @first-steps", 3}, // no load cases
        {"evaluate no/x", 4, "no/x"},
        {"info no/x", 4, "no/x"},
        {"info no/x.qmdb", 4, "no/x"},
        {"import no/x m.qmdb", 4, "no/x"},
        {"export no/x.qmdb", 4, "no/x"},
        {"import @first-steps no/x.qmdb", 4, "no/x"},
        {"export @first-steps no/x", 4, "no/x"},
        {"evaluate @first-steps --json no/x", 4, "no/x"},
        {"evaluate @first-steps --report no/x", 4, "no/x"},
        {"evaluate @first-steps --curve no/x", 4, "no/x"},
        {"analyse no/x", 4, "no/x"},
#ifdef QM_UI
        {"evaluate @first-steps --json o.json --only 'PX ATC-40 A' --plot p.gif", 2, "p.gif"},
        {"analyse @tuned-beam --plot p.gif", 2, "p.gif"},
        {"evaluate @first-steps --only 'PX ATC-40 A' --plot no/x.svg", 4, "no/x"},
#endif
    };
    for (const auto& row : kRows) {
        ExpectRefused(row.arguments, row.code, row.says);
        EXPECT_TRUE(m_folder.Names().empty()) << row.arguments;
    }
    EXPECT_EQ(4, Run("analyse @tuned-beam --json no/x").code); // after its tables
}

TEST_F(ExitCode, Is0ForVersionAndHelp)
{
    EXPECT_EQ("qm_rps 0.1.0\n", Done("--version"));
    Done("export --help");
}

} // namespace
