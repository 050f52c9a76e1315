// Construction stages: iterated pretension through the program, judged on the saved model by
// another process; and tensions found backwards that must lead forwards to the chosen bridge.
#include "program.h"
#include "qm_db/casefile.h"
#include "qm_db/dbdoc.h"

#include <cmath>
#include <gtest/gtest.h>
#include <nlohmann/json.hpp>

namespace fs = std::filesystem;

namespace {

using json = nlohmann::json;

/// A document analysed in its stages.
class CStages {
public:
    explicit CStages(const std::string& model)
    {
        T_FILE_ERROR error;
        EXPECT_TRUE(m_doc.OpenModel(model, OPEN_MODE::ReadOnly, error)) << error.text;
        Analyse();
    }
    explicit CStages(T_MODEL_CONTENT content)
    {
        m_doc.Data().Assign(std::move(content));
        Analyse();
    }

    T_DOF6 Displacement(int node, int stage, int step = kStageLastStep)
    {
        T_DOF6 u{};
        m_doc.Post().SelectStage(stage, step, kStageLoadSum);
        EXPECT_TRUE(m_doc.Post().GetDspcNew(node, u)) << m_doc.Post().Error();
        return u;
    }
    double Axial(int element, int stage)
    {
        double n = 0.0;
        T_DOF6 f{};
        m_doc.Post().SelectStage(stage, kStageLastStep, kStageLoadSum);
        if (m_doc.Post().GetStrtcNew(element, n)) return n;
        // Positions 1/4 to 3/4: the middle of a beam has the mean of its ends.
        EXPECT_TRUE(m_doc.Post().GetStrbcNew(element, 2, f)) << m_doc.Post().Error();
        return f[0];
    }
    const T_MODEL& Model() { return m_doc.Data().Model(); }
    int LastStage() { return Model().stages.rbegin()->first; }

private:
    void Analyse()
    {
        T_ANALYSIS_OPTIONS options;
        options.allCases = false;
        T_ANALYSIS_ERROR error;
        EXPECT_TRUE(m_doc.RunAnalysis(options, error)) << error.text;
    }
    CDBDoc m_doc;
};

struct T_ITERATED {
    json history;
    std::string model; // the last copy
};

/// Imports an example and iterates it through the program.
T_ITERATED Iterated(const CTempFolder& folder, const std::string& example, const std::string& item)
{
    const std::string model = folder / "bridge.qmdb";
    const T_RUN import = RunProgram({"import", ExampleCase(example), model});
    EXPECT_EQ(0, import.code) << import.err;
    const T_RUN run = RunProgram({"ulf", "iterate", model, "--item", item, "--tolerance", "1e-6",
                                  "--iterations", "20", "--json", "-"});
    EXPECT_EQ(0, run.code) << run.err;
    T_ITERATED result{json::parse(run.out), model};
    EXPECT_EQ("converged", result.history.at("status"));
    const json& steps = result.history.at("history");
    result.model = (folder.Path() / fs::path(steps.back().at("file").get<std::string>())).string();
    return result;
}

/// What the named displacements of an item miss, largest.
double LargestMiss(CStages& stages)
{
    double largest = 0.0;
    for (const auto& [key, c] : stages.Model().ulfConstraints) {
        const T_DOF6 u = stages.Displacement(c.id, c.stage, c.step);
        largest = std::max(largest, std::fabs(u[static_cast<std::size_t>(c.component)]));
    }
    return largest;
}

TEST(Stages, TunedBridgeKeepsItsConstraintsWhenAnalysedFromItsFile)
{
    const CTempFolder folder;
    const T_ITERATED run = Iterated(folder, "cable-stayed-bridge-staged", "STAYS");
    const json& history = run.history.at("history");
    EXPECT_GT(history.size(), 2U) << "axial forces and sag need more than one iteration";
    for (const json& row : history.back().at("factors"))
        EXPECT_NEAR(1.0, row.at("factor").get<double>(), 1e-6);
    CStages before(folder / "bridge.qmdb"), after(run.model);
    const double untuned = LargestMiss(before), tuned = LargestMiss(after);
    EXPECT_GT(untuned, 0.1); // m
    EXPECT_LT(tuned, 1e-6 * untuned);
    // 45 % of 1860 MPa would do for service; nothing may be slack or beyond the strength.
    const double kArea[] = {60, 40, 35, 30, 30, 35, 40, 65}; // cm2
    for (int s = 101; s <= 108; ++s) {
        EXPECT_GT(after.Axial(s, after.LastStage()), 0.0) << s;
        EXPECT_LT(after.Axial(s, after.LastStage()), 186.0 * kArea[s - 101]) << s;
        std::printf("N %d %.3f\n", s, after.Axial(s, after.LastStage()));
    }
    std::printf("untuned %.6g tuned %.6g\n", untuned, tuned);
}

/// Tensions and births from tests/oracle/backward.py.
void ExpectForwardAssembly(const std::string& name)
{
    const fs::path data = ProjectFolder() / "tests/data/stages";
    T_MODEL_CONTENT content;
    T_FILE_ERROR error;
    ASSERT_TRUE(CCaseFile::Read((data / (name + ".json")).string(), content, error)) << error.text;
    const json target = json::parse(ReadText(data / (name + ".target.json")));
    CStages stages(std::move(content));
    double size = 0.0, miss = 0.0;
    for (const auto& [node, u] : target.at("displacement").items()) {
        const T_DOF6 found = stages.Displacement(std::stoi(node), stages.LastStage());
        for (const std::size_t d : {0U, 1U}) {
            size = std::max(size, std::fabs(u.at(d).get<double>()));
            miss = std::max(miss, std::fabs(u.at(d).get<double>() - found[2 * d]));
        }
    }
    EXPECT_GT(size, 0.1); // m
    EXPECT_LT(miss, 1e-6 * size);
    std::printf("%s size %.6g miss %.3g\n", name.c_str(), size, miss);
    for (const auto& [stay, n] : target.at("stay").items())
        EXPECT_NEAR(n.get<double>(), stages.Axial(std::stoi(stay), stages.LastStage()),
                    1e-6 * n.get<double>())
            << stay;
    // Every axial force of every stage, so that a way there that differs is seen too.
    double force = 0.0, wrong = 0.0;
    int stage = 0;
    for (const json& at : target.at("axial")) {
        ++stage;
        for (const auto& [element, n] : at.at("force").items()) {
            if (element == "40") continue; // the link: no truss, no beam
            const double f = stages.Axial(std::stoi(element), stage);
            force = std::max(force, std::fabs(f));
            wrong = std::max(wrong, std::fabs(f - n.get<double>()));
        }
    }
    EXPECT_LT(wrong, 1e-6 * force);
    std::printf("force %.6g wrong %.3g\n", force, wrong);
}

TEST(Stages, TensionsFoundBackwardsLeadForwardsToTheTargetInFirstOrder)
{
    ExpectForwardAssembly("forward-first-order");
}

TEST(Stages, TensionsFoundBackwardsLeadForwardsToTheTargetInSecondOrder)
{
    ExpectForwardAssembly("forward-second-order");
}

} // namespace
