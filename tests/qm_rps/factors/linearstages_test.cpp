// A linear staged model: the factors of its pretension are 1 after a single iteration, since every
// stage result is proportional to the load that makes it.
#include "iterationperson.h"
#include "qm_rps/ulfiterationdochost.h"

#include <filesystem>
#include <random>

namespace {

constexpr int kInner = 4; // nodes 2 to 5 between the walls 1 and 6

/// A row of trusses between walls, loaded at stage 1; stages 2 and 3 bring two stays each from a
/// wall to an inner node, tensioned as they come, stage 3 more load. Each stay's factor is unknown,
/// each inner node has a wanted place at the end.
T_MODEL_CONTENT Random(unsigned seed)
{
    std::mt19937 random(seed);
    const auto number = [&](double least, double most) {
        return least + (most - least) * double(random()) / double(std::mt19937::max());
    };
    T_MODEL_CONTENT content;
    T_MODEL& m = content.model;
    m.styp.units = {FORCE_UNIT::N, LENGTH_UNIT::m};
    m.styp.stageControl.birth = seed % 2 ? STAGE_BIRTH::ToDesign : STAGE_BIRTH::OnDeformed;
    m.materials[1].name = "M";
    m.materials[1].E = 1.0;
    for (int i = 1; i <= kInner + 2; ++i) {
        m.nodes[i].id = i;
        m.nodes[i].xyz = {i + number(-0.3, 0.3), 0, 0};
        m.nodes[i].restraint = {i == 1 || i == kInner + 2, 1, 1, 1, 1, 1};
    }
    const auto truss = [&](int id, int from, int to) {
        m.sections[id].name = "S" + std::to_string(id);
        m.sections[id].area = number(5.0, 20.0);
        m.elements[id] = {id, from, to, id, 1, 0, ELEM_KIND::Truss};
    };
    T_STAG_PART& first = m.stages[1].activate;
    first.supports = {1, 2, 3, 4, 5, 6};
    for (int i = 1; i <= kInner + 1; ++i) {
        truss(i, i, i + 1);
        first.elements.push_back(i);
    }
    T_ULSI_D& item = m.ulfStageItems[1];
    item.name = "ALL";
    const auto load = [&](int key, const char* name, int stage, int step) {
        m.loadCases[key].name = name + std::to_string(key);
        m.stages[stage].activate.loads.push_back({key, step});
        m.stages[stage].name = "S" + std::to_string(stage);
    };
    for (int i = 0; i < kInner; ++i) {
        const int id = 10 + i, stage = 2 + i / 2;
        truss(id, i % 2 ? kInner + 2 : 1, i + 2);
        m.stages[stage].activate.elements.push_back(id);
        m.stages[stage].steps = 2;
        load(id, "T", stage, 1 + i % 2);
        m.loadCases[id].pretension = {{id, number(0.5, 2.0)}};
        item.rows.push_back(
            {3, kStageLastStep, id, true, 1.0, 1.0, true, kLoadGroupRest}); // their final effect
        T_ULFC_D& c = m.ulfConstraints[i + 1];
        c.name = "U" + std::to_string(i + 2);
        c.type = ULFC_TYPE::Displacement;
        c.id = i + 2;
        c.value = number(-0.1, 0.1);
        c.stage = 3;
        item.constraints.push_back(c.name);
    }
    for (const int key : {1, 2}) {
        load(key, "G", key == 1 ? 1 : 3, kStageFirstStep);
        for (int i = 0; i < kInner; ++i)
            m.loadCases[key].nodal.push_back({i + 2, {number(-3, 3), 0, 0, 0, 0, 0}});
        item.rows.push_back({3, kStageLastStep, key, false, 1.0, 1.0, false, kLoadGroupRest});
    }
    return content;
}

} // namespace

TEST(LinearStages, ConvergeInOneIterationAndMeetEveryConstraint)
{
    const std::string folder = testing::TempDir() + "qm_linear_stages";
    for (unsigned seed = 1; seed <= 12; ++seed) {
        std::filesystem::remove_all(folder);
        std::filesystem::create_directory(folder);
        CDBDoc doc;
        doc.Data().Assign(Random(seed));
        T_FILE_ERROR error;
        ASSERT_EQ(1, doc.SaveAs(folder + "/m.qmdb", error)) << error.text;
        T_ANALYSIS_OPTIONS options;
        options.allCases = false;
        T_ANALYSIS_ERROR fault;
        ASSERT_EQ(1, doc.RunAnalysis(options, fault)) << seed << ": " << fault.text;
        CUlfIterationDocHost host(doc, doc.Data().Model().ulfStageItems.at(1), false);
        CPerson willing;
        CUlfIteration run(host, willing, {5, 1e-9});
        ASSERT_EQ(1, run.Run()) << seed << ": " << host.Error();
        EXPECT_EQ(ULF_ITER_END::Converged, run.End()) << seed;
        ASSERT_EQ(2U, run.History().size()) << seed;
        EXPECT_GT(run.History()[0].tolerance, 1e-3) << seed << ": nothing was to be done";
        // The state that a person reads, not the optimizer's rows.
        doc.Post().SelectStage(3, kStageLastStep, kStageLoadSum);
        for (int node = 2; node < kInner + 2; ++node) {
            T_DOF6 u{};
            ASSERT_EQ(1, doc.Post().GetDspcNew(node, u));
            EXPECT_NEAR(doc.Data().Model().ulfConstraints.at(node - 1).value, u[0], 1e-10) << seed;
        }
    }
}
