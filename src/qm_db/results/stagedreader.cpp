#include "qm_db/results/stagedreader.h"

#include "qm_base/msgfunction.h"
#include "qm_db/results/fingerprint.h"

#include <algorithm>

namespace {

using zql::lib::MMSGFunction;

constexpr std::size_t kKeptBytes = std::size_t{256} << 20;

/// Bytes of one choice of results in memory, at most.
std::size_t SizeOf(const T_MODEL& model)
{
    return model.nodes.size() * 2 * sizeof(T_DOF6) + model.elements.size() * sizeof(T_ELEM_FORCES);
}

void Add(double& sum, double value)
{
    sum += value;
}
template <class T>
void Add(T& sum, const T& value)
{
    for (std::size_t i = 0; i < sum.size(); ++i)
        Add(sum[i], value[i]);
}

} // namespace

void CStagedReader::Select(const T_STAGE_CHOICE& choice)
{
    m_choice = choice;
    m_selected = nullptr;
    m_error.clear();
}

int CStagedReader::Fail(const char* key, std::initializer_list<std::string_view> args)
{
    m_error = MMSGFunction::Format(key, args);
    return 0;
}

int CStagedReader::Check()
{
    m_error.clear();
    if (m_revision != m_data.Revision()) {
        m_revision = m_data.Revision();
        m_selected = nullptr;
        m_kept.clear();
        m_isCurrent.reset();
    }
    const auto& result = m_data.StagedResult();
    if (!result) return Fail("IDS_QM_DB_STAGED_NONE");
    if (!m_isCurrent) m_isCurrent = result->Fingerprint() == FingerprintOfStages(m_data.Model());
    return *m_isCurrent ? 1 : Fail("IDS_QM_DB_STAGED_OLD");
}

bool CStagedReader::CheckChoice(const T_STAG_D*& stage)
{
    const T_MODEL& model = m_data.Model();
    const auto it = model.stages.find(m_choice.stage);
    if (m_choice.stage == 0) return Fail("IDS_QM_DB_STAGED_NOTHING") != 0;
    if (it == model.stages.end())
        return Fail("IDS_QM_DB_STAGED_NO_STAGE", {std::to_string(m_choice.stage)}) != 0;
    stage = &it->second;
    const int step = StageStepNumber(*stage, m_choice.step); // "last" and its number are one
    if (step == 0) {
        return Fail("IDS_QM_DB_STAGED_NO_STEP", {stage->name, std::to_string(m_choice.step),
                                                 std::to_string(stage->steps)}) != 0;
    }
    m_choice.step = step;
    if (m_choice.load < 0 && m_choice.load >= kStageLoadErection) return true;
    const auto loadCase = model.loadCases.find(m_choice.load);
    if (loadCase == model.loadCases.end())
        return Fail("IDS_QM_DB_RESULT_NO_CASE", {std::to_string(m_choice.load)}) != 0;
    const std::vector<int> acting = StageLoadCases(model); // ascending
    return std::binary_search(acting.begin(), acting.end(), m_choice.load) ||
           Fail("IDS_QM_DB_STAGED_NO_LOAD", {loadCase->second.name}) != 0;
}

/// The results that are selected; null: Error says why.
const CStagedReader::T_TERMS* CStagedReader::Prepare()
{
    if (!Check()) return nullptr;
    if (m_selected) return m_selected;
    const T_STAG_D* stage = nullptr;
    if (!CheckChoice(stage)) return nullptr;
    if (const auto kept = m_kept.find(m_choice); kept != m_kept.end())
        return m_selected = &kept->second;
    T_TERMS terms;
    if (!m_data.StagedResult()->Open(m_choice, terms)) {
        (void)Fail("IDS_QM_DB_STAGED_FAILED", {stage->name, {}});
        return nullptr;
    }
    if (m_kept.size() >= kKeptBytes / std::max<std::size_t>(SizeOf(m_data.Model()), 1))
        m_kept.clear();
    return m_selected = &(m_kept[m_choice] = std::move(terms));
}

template <class T>
int CStagedReader::Read(int (IStaticResult::*read)(int, T&), bool isInModel, const char* none,
                        int id, T& out)
{
    const T_TERMS* const terms = Prepare();
    if (!terms) return 0;
    const std::string& stage = m_data.Model().stages.at(m_choice.stage).name;
    if (!isInModel) return Fail(none, {stage, std::to_string(id)});
    T sum{};
    for (const auto& term : *terms) {
        T value{};
        if ((term.get()->*read)(id, value))
            Add(sum, value);
        else if (const std::string error = term->Error(); !error.empty())
            return Fail("IDS_QM_DB_STAGED_FAILED", {stage, error});
    }
    out = sum;
    return 1;
}

int CStagedReader::ReadDisplacement(int node, T_DOF6& out)
{
    return Read(&IStaticResult::ReadDisplacement, m_data.Model().nodes.contains(node),
                "IDS_QM_DB_STAGED_NO_NODE", node, out);
}

int CStagedReader::ReadReaction(int node, T_DOF6& out)
{
    return Read(&IStaticResult::ReadReaction, m_data.Model().nodes.contains(node),
                "IDS_QM_DB_STAGED_NO_NODE", node, out);
}

int CStagedReader::ReadForces(int element, T_ELEM_FORCES& out)
{
    return Read(&IStaticResult::ReadForces, m_data.Model().elements.contains(element),
                "IDS_QM_DB_STAGED_NO_ELEMENT", element, out);
}
