// Case file and model file hold the same: export and import lose nothing, results are equal.
#include "program.h"

#include <gtest/gtest.h>

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

std::string Export(const std::string& file)
{
    const T_RUN run = RunProgram({"export", file});
    EXPECT_EQ(0, run.code) << file << ": " << run.err;
    return run.out;
}

TEST(RoundTrip, ExportImportExportIsTheSameText)
{
    const std::vector<std::string> files = AllCases();
    ASSERT_GE(files.size(), 12U);
    const CTempFolder folder;
    const std::string model = folder / "m.qmdb", again = folder / "again.json";
    for (const std::string& file : files) {
        const T_RUN import = RunProgram({"import", file, model});
        ASSERT_EQ(0, import.code) << file << ": " << import.err;
        const std::string text = Export(model);
        EXPECT_GT(text.size(), 500U) << file;
        EXPECT_EQ(text, Export(file)) << file << ": model against case file";
        WriteText(again, text);
        EXPECT_EQ(text, Export(again)) << file << ": second pass";
    }
}

TEST(RoundTrip, CaseFileAndModelGiveTheSameResultsToTheLastByte)
{
    const CTempFolder folder;
    const std::string model = folder / "m.qmdb";
    for (const char* name : {"first-steps", "steel-frame-2-storey", "rc-frame-2-storey",
                             "rc-frame-3-storey", "rc-space-frame-3-storey"}) {
        const std::string file = ExampleCase(name);
        ASSERT_EQ(0, RunProgram({"import", file, model}).code) << name;
        const T_RUN fromCase = RunProgram({"evaluate", file, "--json", "-"});
        const T_RUN fromModel = RunProgram({"evaluate", model, "--json", "-"});
        EXPECT_EQ(fromCase.code, fromModel.code) << name;
        EXPECT_GT(fromCase.out.size(), 10000U) << name;
        EXPECT_EQ(fromCase.out, fromModel.out) << name;
        EXPECT_EQ(fromModel.out, RunProgram({"evaluate", model, "--json", "-"}).out)
            << name << ": after the steps were stored";
    }
}

TEST(RoundTrip, StoredLimitStateStepsStandInInfoAndExport)
{
    const CTempFolder folder;
    const std::string model = folder / "m.qmdb";
    ASSERT_EQ(0, RunProgram({"import", ExampleCase("first-steps"), model}).code);
    const std::string before = Export(model);
    ASSERT_EQ(0, RunProgram({"evaluate", model, "--no-store"}).code);
    EXPECT_EQ(before, Export(model));

    ASSERT_EQ(0, RunProgram({"evaluate", model}).code);
    // Demands 0.0599, 0.14975 and 0.2246 m of a push to 0.18 m; step 10 + k lies at 0.036 +
    // 0.0048 k: DL and SD are nearest to steps 15 and 34, NC lies beyond.
    const std::string info = RunProgram({"info", model}).out;
    EXPECT_NE(std::string::npos, info.find("EC8 steps: DL 15, SD 34, NC -2")) << info;
    const std::string text = Export(model);
    EXPECT_NE(std::string::npos, text.find("\"limit_state_steps\"")) << text;
    WriteText(folder / "again.json", text);
    EXPECT_EQ(text, Export(folder / "again.json"));
}

} // namespace
