// Construction stages: iterated pretension through the program, judged on the saved model by
// another process; and tensions found backwards that must lead forwards to the chosen bridge.
#include "program.h"
#include "qm_db/casefile.h"
#include "qm_db/dbdoc.h"

#include <cmath>

namespace {

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

double LargestOffOne(const json& factors)
{
    double largest = 0.0;
    for (const json& row : factors)
        largest = std::max(largest, std::fabs(1.0 - row.at("factor").get<double>()));
    return largest;
}

class Stages : public CProgramTest {
protected:
    /// Iterates the case file in a model file "m.qmdb"; its history.
    json Iterated(const std::string& file, const std::string& item) const
    {
        Done("import " + file + " m.qmdb --overwrite");
        const json result =
            Json("ulf iterate m.qmdb --item " + item + " --tolerance 1e-6 --iterations 20");
        EXPECT_EQ("converged", result.at("status"));
        return result.at("history");
    }
    std::string Last(const json& history) const
    {
        return m_folder / history.back().at("file").get<std::string>();
    }
};

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

TEST_F(Stages, TunedBridgeKeepsItsConstraintsWhenAnalysedFromItsFile)
{
    const json history = Iterated("@cable-stayed-bridge-staged", "STAYS");
    EXPECT_GT(history.size(), 2U) << "axial forces and sag need more than one iteration";
    EXPECT_LE(LargestOffOne(history.back().at("factors")), 1e-6);

    // Here, in another process than the one that wrote the file; then by the program once more.
    CStages before(m_folder / "m.qmdb"), after(Last(history));
    const double untuned = LargestMiss(before);
    EXPECT_GT(untuned, 0.1); // m
    EXPECT_LT(LargestMiss(after), 1e-6 * untuned);
    const json again = Json("ulf iterate " + Last(history) + " --item STAYS --iterations 0");
    EXPECT_EQ("solved", again.at("status"));
    ASSERT_EQ(1U, again.at("history").size());
    EXPECT_LE(LargestOffOne(again.at("history").front().at("factors")), 1e-6);

    // Nothing slack, nothing overstressed: up to 55 % of 1860 MPa.
    const double kArea[] = {60, 40, 35, 30, 30, 35, 40, 65}; // cm2
    for (int s = 101; s <= 108; ++s) {
        EXPECT_GT(after.Axial(s, after.LastStage()), 0.0) << s;
        EXPECT_LT(after.Axial(s, after.LastStage()), 0.55 * 186.0 * kArea[s - 101]) << s;
    }
}

TEST_F(Stages, FirstOrderBridgeConvergesInOneIteration)
{
    Write("first.json",
          With(ReadText(ExampleCase("cable-stayed-bridge-staged")),
               R"("geometric_stiffness": true, "cable_sag": true)", R"("birth": "deformed")"));
    const json history = Iterated("first.json", "STAYS");
    ASSERT_EQ(2U, history.size());
    EXPECT_GT(history.front().at("tolerance").get<double>(), 1.0);
    EXPECT_LT(history.back().at("tolerance").get<double>(), 1e-10);
}

TEST_F(Stages, TwoHangersHaveTheReactionsOfABeamOnThreeSupports)
{
    // q = 20 kN/m, L = 10 m; each hanger E A / L = 1e4 kN/m. Finished: 10/8 q L and 3/8 q L. While
    // piece 1 is alone, its hanger carries q L / 2 = 100 of the 250 that it was stressed by.
    const json history = Iterated("@staged-two-hangers", "HANGERS");
    ASSERT_EQ(2U, history.size());
    const json& factors = history.front().at("factors");
    EXPECT_NEAR(2.5, factors.at(0).at("factor"), 1e-12);
    EXPECT_NEAR(0.75, factors.at(1).at("factor"), 1e-12);
    EXPECT_LE(LargestOffOne(history.back().at("factors")), 1e-12);
    CStages stages(Last(history));
    EXPECT_NEAR(0.015, stages.Displacement(2, 1)[2], 1e-12);
    EXPECT_NEAR(100.0, stages.Axial(11, 1), 1e-9);
    EXPECT_NEAR(0.0, stages.Displacement(2, 2)[2], 1e-12);
    EXPECT_NEAR(0.0, stages.Displacement(3, 2)[2], 1e-12);
    EXPECT_NEAR(250.0, stages.Axial(11, 2), 1e-9);
    EXPECT_NEAR(75.0, stages.Axial(12, 2), 1e-9);
}

TEST_F(Stages, TheBridgeIsWhatItsScriptWrites)
{
    if (RunShell("python3 --version", m_folder.Path()).code != 0)
        GTEST_SKIP() << "python3 is not installed";
    const T_RUN run = RunShell("python3 -B " QM_PROJECT "/tests/oracle/stagedbridge.py -o b.json",
                               m_folder.Path());
    ASSERT_EQ(0, run.code) << run.err;
    EXPECT_EQ(ReadText(ExampleCase("cable-stayed-bridge-staged")), Text("b.json"));
}

/// Tensions and births from tests/oracle/backward.py.
void ExpectForwardAssembly(const std::string& name)
{
    const std::filesystem::path data = ProjectFolder() / "tests/data/stages";
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
}

TEST_F(Stages, TensionsFoundBackwardsLeadForwardsToTheTarget)
{
    ExpectForwardAssembly("forward-first-order");
    ExpectForwardAssembly("forward-second-order");
}

} // namespace
