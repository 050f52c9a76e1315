// What the exit codes say: 0 found, 1 not found, 2 usage, 3 bad input, 4 file access.
#include "program.h"

#include <gtest/gtest.h>

namespace {

TEST(ExitCode, Is1WhenOnePointWasNotFound)
{
    const std::string file = ExampleCase("steel-frame-2-storey");
    const T_RUN run = RunProgram({"evaluate", file, "--only", "PX_MODE1 ATC-40 A beyond capacity"});
    EXPECT_EQ(1, run.code);
    EXPECT_EQ("", run.err);
    EXPECT_NE(std::string::npos, run.out.find("not found"));
    EXPECT_NE(std::string::npos, run.out.find("no crossing with the reduced demand"));
    EXPECT_EQ(0, RunProgram({"evaluate", file, "--only", "PX_MODE1 ATC-40 A"}).code);
}

TEST(ExitCode, Is2ForWrongUsage)
{
    const std::string file = ExampleCase("first-steps");
    const std::vector<std::string> cases[] = {
        {},
        {"calculate", file},
        {"evaluate"},
        {"evaluate", file, "--fast"},
        {"evaluate", file, "--only"},
        {"evaluate", file, "--only", "no such evaluation"},
        {"--lang", "de", "info", file},
        {"import", file},
    };
    for (const auto& arguments : cases) {
        const T_RUN run = RunProgram(arguments);
        const std::string label = arguments.empty() ? "no argument" : arguments.back();
        EXPECT_EQ(2, run.code) << label;
        EXPECT_EQ("", run.out) << label;
        EXPECT_EQ(1U, Lines(run.err).size()) << label << ": " << run.err;
    }
}

TEST(ExitCode, Is4WhenAFileCantBeReadOrWritten)
{
    const CTempFolder folder;
    const std::string file = ExampleCase("first-steps");
    const std::string nowhere = folder / "no-folder/x";
    const std::vector<std::string> cases[] = {
        {"evaluate", nowhere},
        {"info", nowhere},
        {"info", nowhere + ".qmdb"},
        {"import", nowhere, folder / "m.qmdb"},
        {"export", nowhere + ".qmdb"},
        {"import", file, nowhere + ".qmdb"},
        {"export", file, nowhere},
        {"evaluate", file, "--json", nowhere},
        {"evaluate", file, "--report", nowhere},
        {"evaluate", file, "--curve", nowhere},
#ifdef QM_UI
        {"evaluate", file, "--only", "PX ATC-40 A", "--plot", nowhere + ".svg"},
#endif
    };
    for (const auto& arguments : cases) {
        const T_RUN run = RunProgram(arguments);
        const std::string label = arguments[0] + " ... " + arguments.back();
        EXPECT_EQ(4, run.code) << label;
        EXPECT_EQ("", run.out) << label;
        ASSERT_EQ(1U, Lines(run.err).size()) << label << ": " << run.err;
        EXPECT_NE(std::string::npos, run.err.find(nowhere)) << label << ": " << run.err;
        EXPECT_TRUE(folder.Names().empty()) << label;
    }
}

TEST(ExitCode, Is0ForVersionAndHelp)
{
    const T_RUN version = RunProgram({"--version"});
    EXPECT_EQ(0, version.code);
    EXPECT_EQ("qm_rps 0.1.0\n", version.out);
    for (const char* command : {"import", "export", "info", "evaluate"})
        EXPECT_EQ(0, RunProgram({command, "--help"}).code) << command;
}

} // namespace
