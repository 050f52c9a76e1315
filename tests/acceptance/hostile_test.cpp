// Files and limits that are meant to harm, given to the real program.
#include "program.h"

#include <sys/stat.h>

namespace {

/// A case in m and kN whose steps come from the recorder file of that path.
std::string CaseWith(const std::string& path)
{
    const std::string source = "{\"path\": \"" + path + "\", \"column\": ";
    return "{\"format\": \"qm-rps case 1\", \"units\": {\"force\": \"kN\", \"length\": \"m\"},"
           "\"nodes\": [{\"id\": 1, \"xyz\": [0, 0, 0]}, {\"id\": 2, \"xyz\": [0, 0, 3]}],"
           "\"pushover\": [{\"name\": \"P\", \"control_node\": 2, \"direction\": \"DX\","
           "\"pattern\": {\"kind\": \"static\"}, \"steps\": {\"files\": {\"load_factor\": " +
           source + "1}, \"base_reaction\": " + source + "2}, \"displacement\": {\"2\": " + source +
           "3}}}}}]}";
}

class Hostile : public CProgramTest {};

TEST_F(Hostile, RecorderFilesAreFilesInTheFolderOfTheCase)
{
    const std::string table = "1 10 0.01\n2 15 0.02\n";
    std::filesystem::create_directories(m_folder / "case/sub");
    Write("case/sub/in.out", table);
    Write("outside.out", table);
    std::filesystem::create_symlink("../outside.out", m_folder / "case/link.out");
    ASSERT_EQ(0, mkfifo((m_folder / "case/pipe.out").c_str(), 0600));
    const std::string absolute = m_folder / "outside.out";
    const struct {
        std::string path;
        int code;
        const char* says;
    } rows[] = {
        {"sub/in.out", 0, ""},
        {"sub/../sub/in.out", 0, ""},
        {"../outside.out", 3, "lies outside the folder of the case file"},
        {"link.out", 3, "--allow-outside"},
        {absolute, 3, "lies outside"},
        {"/dev/zero", 3, "lies outside"},
        {"pipe.out", 4, "pipe.out: can't read: a pipe or a device, not a file"},
        {"sub", 4, "sub: can't read"},
    };
    for (const auto& row : rows) {
        SCOPED_TRACE(row.path);
        Write("case/c.json", CaseWith(row.path));
        if (row.code == 0)
            Done("info case/c.json");
        else
            ExpectRefused("info case/c.json", row.code, row.says);
        if (row.code != 3) continue;
        if (row.path == "/dev/zero")
            ExpectRefused("--allow-outside info case/c.json", 4, "a pipe or a device, not a file");
        else
            Done("--allow-outside info case/c.json");
    }
}

TEST_F(Hostile, AnObjectiveThatIsTooLargeForANumberIsNoResult)
{
    Write("beam.json", With(ReadText(ExampleCase("tuned-beam")), "0, 0, 100", "0, 0, 1e-160"));
    const T_RUN run = Run("ulf solve beam.json --item PROPS");
    EXPECT_EQ(3, run.code);
    EXPECT_EQ(std::string::npos, (run.out + run.err).find("inf")) << run.out << run.err;
    ExpectHolds(run.out + run.err, {"too large for a number"});
}

/// Too little address space ends a command with one line and code 4; it never spins or aborts.
TEST_F(Hostile, OutOfMemoryIsOneLineAndCode4)
{
#if defined(__SANITIZE_ADDRESS__)
    GTEST_SKIP() << "the sanitizer itself needs more than these limits";
#endif
    Done("import @tuned-beam beam.qmdb");
    Done("import @first-steps first.qmdb");
    const char* const commands[] = {"analyse beam.qmdb --case W --no-store",
                                    "ulf solve @tuned-beam --item PROPS",
                                    "evaluate first.qmdb --no-store", "info first.qmdb --check"};
    for (const char* const command : commands) {
        bool hasFailed = false;
        for (const int megaBytes : {260, 300, 340, 420, 2000}) {
            SCOPED_TRACE(std::string(command) + " in MB: " + std::to_string(megaBytes));
            const std::string limit =
                "ulimit -v " + std::to_string(megaBytes * 1024) + "; timeout 60 ";
            const T_RUN run = Run(command, limit);
            if (run.code == 0) continue;
            hasFailed = true;
            EXPECT_EQ(4, run.code) << run.err;
            EXPECT_EQ(1U, Lines(run.err).size()) << run.err;
            ExpectHolds(run.err, {"memory"});
            EXPECT_LT(megaBytes, 2000);
        }
        const bool needsEngine = std::string(command).starts_with("analyse");
        EXPECT_TRUE(hasFailed || !needsEngine) << "the limits don't reach the engine";
    }
}

} // namespace
