#include "analysis/analysisresults.h"

#include "qm_rps/view/resultgetters.h"

#include "qm_base/say.h"

#include <algorithm>
#include <set>

namespace {

/// No "-0" in tables and files.
T_DOF6 Tidy(T_DOF6 v)
{
    for (double& x : v)
        x += 0.0;
    return v;
}

/// Nodes that the ground holds: restrained by themselves (not by the model's plane) or by springs.
std::set<int> HeldNodes(const T_MODEL& model)
{
    std::set<int> held;
    for (const auto& [id, node] : model.nodes) {
        if (std::ranges::any_of(node.restraint, [](int r) { return r != 0; })) held.insert(id);
    }
    for (const auto& [id, e] : model.elements) {
        if (e.kind == ELEM_KIND::Spring) held.insert(e.nodeI);
    }
    return held;
}

struct T_SUM_NAME {
    std::string_view name;
    int key;
};
constexpr T_SUM_NAME kSums[] = {
    {"sum", kStageLoadSum}, {"dead", kStageLoadDead}, {"erection", kStageLoadErection}};

bool ReadNode(CPostCtrl& post, const T_RESULT_GETTERS& get, int id, bool isHeld,
              T_CASE_RESULTS& out)
{
    T_DOF6 value{};
    if (!(post.*get.displacement)(id, value)) return false;
    out.displacements.push_back({id, Tidy(value)});
    if (!isHeld) return true;
    if (!(post.*get.reaction)(id, value)) return false;
    out.reactions.push_back({id, Tidy(value)});
    return true;
}

bool ReadElement(CPostCtrl& post, const T_RESULT_GETTERS& get, const T_ELEM_D& e,
                 T_CASE_RESULTS& out)
{
    if (e.kind == ELEM_KIND::Truss) {
        double axial = 0.0;
        if (!(post.*get.truss)(e.id, axial)) return false;
        out.trusses.push_back({e.id, axial + 0.0});
    }
    if (e.kind != ELEM_KIND::Beam) return true;
    T_BEAM_ROWS rows{};
    for (std::size_t p = 0; p < rows.size(); ++p) {
        if (!(post.*get.beam)(e.id, static_cast<int>(p), rows[p])) return false;
        rows[p] = Tidy(rows[p]);
    }
    out.beams.push_back({e.id, rows});
    return true;
}

} // namespace

bool FindShownCases(CDBDoc& doc, const std::vector<std::string>& names,
                    std::vector<T_SHOWN_CASE>& out, std::string& error)
{
    if (names.empty()) {
        for (const auto& [key, record] : doc.Data().Model().loadCases)
            out.push_back({record.name, CPostCtrl::MakeLoadComb(key)});
        if (out.empty()) error = Say("IDS_QM_CLI_NO_CASES");
        return !out.empty();
    }
    for (const std::string& name : names) {
        int key = 0;
        T_LCOM_D combination;
        if (doc.Attr().FindStld(name, key))
            out.push_back({name, CPostCtrl::MakeLoadComb(key)});
        else if (doc.Attr().GetLcom_(name, combination))
            out.push_back({name, combination});
        else
            error = Say("IDS_QM_CLI_NO_CASE", name);
    }
    return error.empty();
}

bool LoadCasesOf(CDBDoc& doc, const std::vector<T_SHOWN_CASE>& shown, std::vector<int>& out,
                 std::string& error)
{
    std::set<int> keys;
    for (const T_SHOWN_CASE& s : shown) {
        T_LCOM_D flat;
        if (!doc.Attr().NormalizeLcom(s.combination, flat, error)) return false;
        for (const T_LCOM_ITEM& item : flat.items)
            keys.insert(item.key);
    }
    out.assign(keys.begin(), keys.end());
    return true;
}

bool ReadCaseResults(CDBDoc& doc, const T_SHOWN_CASE& shown, T_CASE_RESULTS& out,
                     std::string& error)
{
    CPostCtrl& post = doc.Post();
    const T_MODEL& model = doc.Data().Model();
    const std::set<int> held = HeldNodes(model);
    const bool done = post.SelectLoadCombNew(shown.combination) &&
                      std::ranges::all_of(model.nodes,
                                          [&](const auto& n) {
                                              return ReadNode(post, kStaticGetters, n.first,
                                                              held.contains(n.first), out);
                                          }) &&
                      std::ranges::all_of(model.elements, [&](const auto& e) {
                          return ReadElement(post, kStaticGetters, e.second, out);
                      });
    if (!done) error = post.Error();
    return done;
}

bool FindShownStages(CDBDoc& doc, const std::string& stage, int step, const std::string& load,
                     std::vector<T_SHOWN_STAGE>& out, std::string& error)
{
    int key = 0;
    const auto* const sum = std::ranges::find(kSums, load, &T_SUM_NAME::name);
    if (sum != std::end(kSums))
        key = sum->key;
    else if (!doc.Attr().FindStld(load, key))
        error = Say("IDS_QM_CLI_NO_STAGE_LOAD", load);
    for (const auto& [number, record] : doc.Data().Model().stages) {
        if (!stage.empty() && record.name != stage) continue;
        const T_STAGE_CHOICE choice{number, StageStepNumber(record, step), key};
        if (choice.step == 0) error = Say("IDS_QM_CLI_NO_STAGE_STEP", stage, std::to_string(step));
        out.push_back({record.name,
                       load,
                       record.steps,
                       choice,
                       StandingElements(doc.Data().Model(), number).size(),
                       {}});
    }
    if (error.empty() && out.empty() && !stage.empty()) error = Say("IDS_QM_CLI_NO_STAGE", stage);
    return error.empty();
}

bool ReadStageResults(CDBDoc& doc, const T_STAGE_CHOICE& choice, T_CASE_RESULTS& out,
                      std::string& error)
{
    CPostCtrl& post = doc.Post();
    const T_MODEL& model = doc.Data().Model();
    const std::set<int> elements = StandingElements(model, choice.stage), held = HeldNodes(model);
    std::set<int> nodes;
    for (const int id : elements)
        for (const int node : {model.elements.at(id).nodeI, model.elements.at(id).nodeJ})
            if (model.nodes.contains(node)) nodes.insert(node); // a spring has one node
    post.SelectStage(choice.stage, choice.step, choice.load);
    const bool done =
        std::ranges::all_of(
            nodes,
            [&](int id) { return ReadNode(post, kStageGetters, id, held.contains(id), out); }) &&
        std::ranges::all_of(elements, [&](int id) {
            return ReadElement(post, kStageGetters, model.elements.at(id), out);
        });
    if (!done) error = post.Error();
    return done;
}

std::vector<T_MODE_RESULTS> ReadModes(CDBDoc& doc)
{
    std::vector<T_MODE_RESULTS> out;
    const int count = doc.Post().GetNumEigvPost();
    for (int mode = 1; mode <= count; ++mode) {
        T_MODE_RESULTS& m = out.emplace_back();
        T_MPAF_D factor;
        T_MPAM_D percent;
        if (!doc.Post().SelectMode(mode) || !doc.Post().GetEiMpafNeutral(mode, factor) ||
            !doc.Post().GetEiMpam(mode, percent))
            continue;
        m.period = doc.Data().Model().modes.at(mode).period;
        m.participation = Tidy(factor.factor);
        m.massPercent = Tidy(percent.percent);
        for (const auto& entry : doc.Data().Model().nodes) {
            T_DOF6 shape{};
            doc.Post().GetEiMode(entry.first, shape);
            m.shape.push_back({entry.first, Tidy(shape)});
        }
    }
    return out;
}
