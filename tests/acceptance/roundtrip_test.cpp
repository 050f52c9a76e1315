// Case file and model file hold the same: export and import lose nothing, results are equal.
#include "program.h"

namespace fs = std::filesystem;

namespace {

std::vector<std::string> AllCases()
{
    std::vector<std::string> files;
    for (const char* folder : {"examples", "tests/data/cases", "tests/data/oracle"}) {
        for (const auto& entry : fs::recursive_directory_iterator(ProjectFolder() / folder)) {
            const std::string name = entry.path().string();
            if (name.ends_with(".json") && !name.ends_with(".expected.json") &&
                !name.ends_with("checks.json"))
                files.push_back(name);
        }
    }
    return files;
}

using RoundTrip = CProgramTest;

TEST_F(RoundTrip, ExportImportExportIsTheSameText)
{
    const std::vector<std::string> files = AllCases();
    ASSERT_GE(files.size(), 12U);
    for (const std::string& file : files) {
        Done("import " + file + " m.qmdb --overwrite");
        const std::string text = Done("export m.qmdb");
        EXPECT_GT(text.size(), 500U) << file;
        EXPECT_EQ(text, Done("export " + file)) << file << ": model against case file";
        Write("again.json", text);
        EXPECT_EQ(text, Done("export again.json")) << file << ": second pass";
    }
}

TEST_F(RoundTrip, CaseFileAndModelGiveTheSameResultsToTheLastByte)
{
    for (const std::string name : {"first-steps", "steel-frame-2-storey", "rc-frame-2-storey",
                                   "rc-frame-3-storey", "rc-space-frame-3-storey"}) {
        Done("import @" + name + " m.qmdb --overwrite");
        const T_RUN fromCase = Run("evaluate @" + name + " --json -");
        const T_RUN fromModel = Run("evaluate m.qmdb --json -");
        EXPECT_EQ(fromCase.code, fromModel.code) << name;
        EXPECT_GT(fromCase.out.size(), 10000U) << name;
        EXPECT_EQ(fromCase.out, fromModel.out) << name;
        EXPECT_EQ(fromModel.out, Run("evaluate m.qmdb --json -").out)
            << name << ": after the steps were stored";
    }
}

TEST_F(RoundTrip, StoredLimitStateStepsStandInInfoAndExport)
{
    Done("import @first-steps m.qmdb");
    const std::string before = Done("export m.qmdb");
    Done("evaluate m.qmdb --no-store");
    EXPECT_EQ(before, Done("export m.qmdb"));
    Done("evaluate m.qmdb");
    // Demands 0.0599, 0.14975 and 0.2246 m of a push to 0.18 m; step 10 + k lies at 0.036 +
    // 0.0048 k: DL and SD are nearest to steps 15 and 34, NC lies beyond.
    ExpectHolds(Done("info m.qmdb"), {"EC8 steps: DL 15, SD 34, NC -"});
    const std::string text = Done("export m.qmdb");
    ExpectHolds(text, {"\"limit_state_steps\""});
    Write("again.json", text);
    EXPECT_EQ(text, Done("export again.json"));
}

} // namespace
