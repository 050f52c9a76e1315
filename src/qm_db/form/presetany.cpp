// Default values of new records: they keep the rules of a case file, and are there to be changed.
#include "qm_base/say.h"
#include "qm_db/form/anyrecord.h"
#include "qm_db/form/formfill.h"

#include <algorithm>

namespace {

// Quantities of new records in SI.
constexpr double kStoreyHeight = 3.0, kSide = 0.3, kPeriod = 1.0;
constexpr double kGround = 0.25; // acceleration of new spectra, g
constexpr double kNtcF0 = 2.5,
                 kNtcTc = 0.35;     // s; of the order that NTC tables for Italian sites have
constexpr double kNewTarget = 0.02; // of the height of the control node

const char* NounOf(RECORD_KIND kind)
{
    const char* noun = "";
    WithKind(kind, [&](const auto& row) { noun = row.noun.data(); });
    return noun;
}

struct T_PRESET {
    const T_MODEL& model;
    int key;

    template <class R>
    void operator()(R&) const
    {
    }
    void operator()(T_NODE_D& r) const { r.id = key; }
    void operator()(T_ELEM_D& r) const
    {
        r.id = key;
        if (!model.materials.empty()) r.material = model.materials.begin()->first;
        if (!model.sections.empty()) r.section = model.sections.begin()->first;
    }
    void operator()(T_STOR_D& r) const
    {
        r.height = kStoreyHeight;
        r.nodes = NodesOfTop();
    }
    void operator()(T_EIGV_D& r) const { r.period = kPeriod; }
    void operator()(T_MATL_D& r) const { (void)FillFromGrades("S235", false, r); }
    void operator()(T_SECT_D& r) const
    {
        r.shape = SECT_SHAPE::Rectangle;
        r.size = {kSide, kSide, 0.0, 0.0};
    }
    void operator()(T_EQDS_D& r) const { r.directions[0] = true; }
    void operator()(T_ULFC_D& r) const
    {
        if (!model.nodes.empty()) r.id = model.nodes.begin()->first;
    }
    void operator()(T_POFC_D& r) const
    {
        r.step = {1.0, 2.0};
        r.factor = {0.5, 1.0};
    }
    void operator()(T_SPFC_D& r) const
    {
        if (auto* user = std::get_if<T_SPFC_USER>(&r.data); user && user->T.empty()) {
            user->T = {0.0, 1.0};
            user->Sa = {kGround, kGround};
        }
        const auto fill = [](double& value, double by) {
            if (value == 0.0) value = by;
        };
        if (auto* atc = std::get_if<T_SPFC_ATC40>(&r.data))
            fill(atc->Ca, kGround), fill(atc->Cv, kGround);
        if (auto* ec = std::get_if<T_SPFC_EURO2003>(&r.data)) fill(ec->ag, kGround);
        if (auto* env = std::get_if<T_SPFC_EURO1996>(&r.data)) fill(env->ag, kGround);
        auto* ntc = std::get_if<T_SPFC_NTC>(&r.data);
        const auto is = [](const auto& state) { return state.has_value(); };
        if (ntc && std::ranges::none_of(ntc->states, is))
            ntc->states[static_cast<std::size_t>(LIMIT_STATE::SLV)] = {kGround, kNtcF0, kNtcTc};
    }
    void operator()(T_POLC_D& r) const
    {
        r.controlNode = TopNode();
        r.patternKind = 1;
        r.patterns = {{.kind = 1, .number = 1}};
        r.control.emplace();
        if (const auto it = model.nodes.find(r.controlNode); it != model.nodes.end())
            r.control->masterMaxDispl = kNewTarget * (it->second.xyz[2] - Lowest());
    }
    void operator()(T_POVR_D& r) const { r.ec8.emplace(); }
    void operator()(T_EVAL_D& r) const
    {
        r.method = PUSH_METHOD::Atc40;
        r.procedure = 'A';
        if (model.spectra.empty()) return;
        const auto& data = model.spectra.begin()->second.data;
        if (std::holds_alternative<T_SPFC_NTC>(data)) r.method = PUSH_METHOD::Ntc2018;
        if (std::holds_alternative<T_SPFC_EURO2003>(data)) r.method = PUSH_METHOD::Ec8Opcm;
        if (r.method != PUSH_METHOD::Atc40) r.procedure.reset();
    }

private:
    static double Height(const T_NODE_D& node) { return node.xyz[2]; }
    double Lowest() const
    {
        double least = 0.0;
        for (const auto& [id, node] : model.nodes)
            least = std::min(least, Height(node));
        return least;
    }
    /// The node at the top, that of the top storey first, as the window of load cases takes it.
    int TopNode() const
    {
        for (auto it = model.storeys.rbegin(); it != model.storeys.rend(); ++it)
            if (!it->second.nodes.empty()) return it->second.nodes.front();
        const auto top = std::ranges::max_element(
            model.nodes, {}, [](const auto& entry) { return Height(entry.second); });
        return top == model.nodes.end() ? 0 : top->first;
    }
    std::vector<int> NodesOfTop() const
    {
        std::vector<int> nodes;
        if (model.nodes.empty()) return nodes;
        const double top = Height(model.nodes.at(TopNode()));
        for (const auto& [id, node] : model.nodes)
            if (Height(node) == top) nodes.push_back(id);
        return nodes;
    }
};

} // namespace

std::string NeedsFirst(RECORD_KIND kind)
{
    return Say("IDS_QM_FORM_NEEDS_FIRST", Say(NounOf(kind)));
}

void PresetAny(const T_MODEL& model, int key, T_ANY_RECORD& record)
{
    std::visit(
        [&]<class R>(R& r) {
            if constexpr (!std::is_same_v<R, std::monostate>) T_PRESET{model, key}(r);
        },
        record);
}

std::optional<RECORD_KIND> FillAny(const T_MODEL& model, T_ANY_RECORD& record)
{
    CFormFill fill(model);
    std::visit(
        [&]<class R>(R& r) {
            if constexpr (!std::is_same_v<R, std::monostate>) CaseFields(fill, r);
            // Nodes that stand as plain numbers.
            const bool node = std::is_same_v<R, T_ULFC_D> || std::is_same_v<R, T_POLC_D>;
            int first = 0;
            if (node && !fill.Missing()) fill.Node("", first);
        },
        record);
    return fill.Missing();
}
