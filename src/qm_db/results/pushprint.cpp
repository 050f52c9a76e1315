#include "qm_db/results/pushprint.h"

#include "qm_db/casefile/caseput.h"
#include "qm_db/file/checksum.h"
#include "qm_db/records/loadcaserules.h"
#include "qm_db/records/pushcontrol.h"
#include "qm_db/results/fingerprint.h"

#include <set>

namespace {

constexpr int kStaticPattern = 0;
constexpr int kFollowsFunction = 2;

/// A checksum over records as the model file has them: a new member counts from the day it exists.
class CRecordSum {
public:
    template <class R>
    void Add(const R& record)
    {
        CJsonWriter text(kSiUnits);
        text.BeginObject();
        CCasePut put(text);
        CaseFields(put, record);
        text.EndObject();
        AddText(text.TakeText());
        if (text.Failed()) AddText(text.Error().text); // not finite, for example
    }
    /// There may be many: without a text. Strengths count, not the load that they were taken at.
    void Add(const T_PHGE_D& hinge)
    {
        using T_STRENGTHS = decltype(hinge.yield);
        struct T_BYTES {
            int element, hingeType;
            T_STRENGTHS crack, yield, crackJ, yieldJ;
        };
        static_assert(sizeof(T_BYTES) == 2 * sizeof(int) + 48 * sizeof(double)); // nothing between
        static_assert(sizeof hinge == sizeof(T_BYTES) + sizeof(double));         // and axialCase
        const T_BYTES bytes{hinge.element, hinge.hingeType, hinge.crack,
                            hinge.yield,   hinge.crackJ,    hinge.yieldJ};
        m_sum.AddBytes(std::as_bytes(std::span(&bytes, 1)));
    }
    template <class R>
    void Add(const T_TABLE<R>& table)
    {
        for (const auto& [key, record] : table) {
            Add(static_cast<std::uint64_t>(key));
            Add(record);
        }
        Add(std::uint64_t{table.size()});
    }
    void Add(std::uint64_t word) { m_sum.AddWord(word); }
    void AddNumbers(std::span<const double> values) { m_sum.AddBytes(std::as_bytes(values)); }
    std::uint64_t Value() const { return m_sum.Value(); }

private:
    void AddText(const std::string& text)
    {
        m_sum.AddWord(text.size());
        m_sum.AddBytes(std::as_bytes(std::span(text)));
    }
    CChecksum m_sum;
};

std::uint64_t HingesOf(const T_MODEL& model, const T_POGC_D& control)
{
    CRecordSum sum;
    sum.Add(model.hingeTypes);
    sum.Add(model.hinges);
    sum.Add(model.materials);
    sum.Add(model.sections);
    T_POGC_D acting;
    acting.hingeTypes = control.hingeTypes;
    sum.Add(acting);
    sum.Add(std::uint64_t{model.styp.alternativeHysteresis} << 2 |
            std::uint64_t{model.styp.wallStrengthDegradation} << 1 | std::uint64_t{model.styp.gsd});
    return sum.Value();
}

std::uint64_t LoadsOf(const T_MODEL& model, const T_POLC_D& push, const T_POGC_D& control)
{
    std::set<int> cases;
    for (const T_PUSH_INITIAL_LOAD& load : control.initialLoads)
        cases.insert(load.loadCase);
    for (const T_POLC_PATTERN& row : push.patterns)
        if (row.kind == kStaticPattern) cases.insert(row.number);
    CRecordSum sum;
    for (const int key : cases) {
        sum.Add(static_cast<std::uint64_t>(key));
        if (const auto it = model.loadCases.find(key); it != model.loadCases.end())
            sum.Add(it->second);
    }
    for (const auto& [id, node] : model.nodes)
        sum.AddNumbers(node.mass);
    sum.Add(model.storeys);
    for (const T_POLC_PATTERN& row : push.patterns) {
        const auto mode = model.modes.find(row.number);
        if (IsModePattern(row.kind) && mode != model.modes.end()) sum.Add(mode->second);
    }
    return sum.Value();
}

/// What does not change the path is left out; the case that it starts from stands apart.
std::uint64_t SetupOf(const T_MODEL& model, T_POLC_D push, T_POGC_D control)
{
    control.hingeTypes.clear();
    push.initialCase.clear();
    push.initialLoads.reset();
    push.pDelta.reset();
    push.steps.reset();
    push.onFailure.reset();
    push.controlOption = T_POLC_D().controlOption;
    push.additionalEvaluations = false;
    CRecordSum sum;
    sum.Add(push);
    sum.Add(control);
    if (!push.control || push.control->incrementOption != kFollowsFunction) return sum.Value();
    const auto function = model.incrementFunctions.find(push.control->incrementFunction);
    if (function != model.incrementFunctions.end()) sum.Add(function->second);
    return sum.Value();
}

void AddPrint(const T_MODEL& model, int loadCase, std::set<int>& seen, CRecordSum& loads,
              CRecordSum& setup)
{
    const auto it = model.pushovers.find(loadCase);
    if (it == model.pushovers.end() || !seen.insert(loadCase).second) return;
    const T_POGC_D control = PushControlOf(model, it->second);
    loads.Add(LoadsOf(model, it->second, control));
    setup.Add(SetupOf(model, it->second, control));
    if (it->second.initialCase.empty()) return;
    for (const auto& [key, other] : model.pushovers)
        if (other.name == it->second.initialCase) return AddPrint(model, key, seen, loads, setup);
}

} // namespace

T_RUN_PRINT PrintOfPush(const T_MODEL& model, int loadCase)
{
    CRecordSum loads, setup;
    std::set<int> seen;
    AddPrint(model, loadCase, seen, loads, setup);
    return {FingerprintOfStructure(model), HingesOf(model, model.pushControl), loads.Value(),
            setup.Value()};
}

const char* ChangeSince(const T_RUN_PRINT& before, const T_RUN_PRINT& now)
{
    if (before.structure != now.structure) return "IDS_QM_DB_PUSH_OLD_STRUCTURE";
    if (before.hinges != now.hinges) return "IDS_QM_DB_PUSH_OLD_HINGES";
    if (before.loads != now.loads) return "IDS_QM_DB_PUSH_OLD_LOADS";
    if (before.setup != now.setup) return "IDS_QM_DB_PUSH_OLD_SETUP";
    return nullptr;
}
