#include "qm_db/stagedreader.h"

#include "qm_base/msgfunction.h"
#include "qm_db/fingerprint.h"

#include <algorithm>

namespace {

using zql::lib::MMSGFunction;

constexpr std::size_t kKeptBytes = std::size_t{256} << 20;

std::size_t SizeOf(const T_STATIC_DATA& data)
{
    return data.nodes.size() * 2 * sizeof(T_DOF6) + data.elements.size() * sizeof(T_ELEM_FORCES);
}

} // namespace

void CStagedReader::Select(const T_STAGE_CHOICE& choice)
{
    m_choice = choice;
    m_selected.reset();
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
        m_selected.reset();
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
    return m_data.StagedResult()->HasLoadCase(m_choice.load) ||
           Fail("IDS_QM_DB_STAGED_NO_LOAD", {loadCase->second.name}) != 0;
}

/// The results that are selected; null: Error says why.
IStaticResult* CStagedReader::Prepare()
{
    if (!Check()) return nullptr;
    if (m_selected) return m_selected.get();
    const T_STAG_D* stage = nullptr;
    if (!CheckChoice(stage)) return nullptr;
    const auto kept = m_kept.find(m_choice);
    if (kept != m_kept.end()) {
        m_selected = kept->second;
        return m_selected.get();
    }
    T_STATIC_DATA data;
    if (!m_data.StagedResult()->Read(m_choice, data)) {
        (void)Fail("IDS_QM_DB_STAGED_FAILED", {stage->name});
        return nullptr;
    }
    if (m_kept.size() >= kKeptBytes / std::max<std::size_t>(SizeOf(data), 1)) m_kept.clear();
    m_selected = MakeStaticResult(std::move(data));
    m_kept[m_choice] = m_selected;
    return m_selected.get();
}

template <class T>
int CStagedReader::Read(int (IStaticResult::*read)(int, T&), const char* none, int id, T& out)
{
    IStaticResult* const source = Prepare();
    if (!source) return 0;
    if ((source->*read)(id, out)) return 1;
    return Fail(none, {m_data.Model().stages.at(m_choice.stage).name, std::to_string(id)});
}

int CStagedReader::ReadDisplacement(int node, T_DOF6& out)
{
    return Read(&IStaticResult::ReadDisplacement, "IDS_QM_DB_STAGED_NO_NODE", node, out);
}

int CStagedReader::ReadReaction(int node, T_DOF6& out)
{
    return Read(&IStaticResult::ReadReaction, "IDS_QM_DB_STAGED_NO_NODE", node, out);
}

int CStagedReader::ReadForces(int element, T_ELEM_FORCES& out)
{
    return Read(&IStaticResult::ReadForces, "IDS_QM_DB_STAGED_NO_ELEMENT", element, out);
}
