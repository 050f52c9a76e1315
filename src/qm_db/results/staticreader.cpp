#include "qm_db/results/staticreader.h"

#include "qm_base/msgfunction.h"
#include "qm_db/records/lcomflatten.h"
#include "qm_db/results/fingerprint.h"

#include <cmath>

namespace {

using zql::lib::MMSGFunction;

void AddTo(double& sum, double factor, double value)
{
    sum += factor * value;
}
template <class T, std::size_t N>
void AddTo(std::array<T, N>& sum, double factor, const std::array<T, N>& value)
{
    for (std::size_t i = 0; i < N; ++i)
        AddTo(sum[i], factor, value[i]);
}

bool AllFinite(double value)
{
    return std::isfinite(value);
}
template <class T, std::size_t N>
bool AllFinite(const std::array<T, N>& values)
{
    for (const T& value : values) {
        if (!AllFinite(value)) return false;
    }
    return true;
}

} // namespace

void CStaticReader::Select(T_LCOM_D combination)
{
    m_combination = std::move(combination);
    m_key = 0;
    m_isPrepared = false;
    m_error.clear();
}

int CStaticReader::SelectKey(int combination)
{
    if (!m_data.Model().combinations.contains(combination)) return 0;
    m_key = combination;
    m_isPrepared = false;
    m_error.clear();
    return 1;
}

int CStaticReader::Fail(const char* key, const std::string& first, const std::string& second)
{
    m_error = MMSGFunction::Format(key, {first, second});
    return 0;
}

std::string CStaticReader::NameOf(int loadCase) const
{
    const auto it = m_data.Model().loadCases.find(loadCase);
    return it == m_data.Model().loadCases.end() ? std::to_string(loadCase) : it->second.name;
}

/// What was derived from the data is dropped when they have changed.
void CStaticReader::Refresh()
{
    m_error.clear();
    if (m_revision == m_data.Revision()) return;
    m_revision = m_data.Revision();
    m_structure = FingerprintOfStructure(m_data.Model());
    m_judged.clear();
    m_isPrepared = false;
}

int CStaticReader::CheckCase(int loadCase)
{
    Refresh();
    const auto [judged, isNew] = m_judged.try_emplace(loadCase);
    if (isNew) {
        const T_MODEL_CONTENT& content = m_data.Content();
        const auto record = content.model.loadCases.find(loadCase);
        const auto result = content.staticResults.find(loadCase);
        if (record == content.model.loadCases.end())
            (void)Fail("IDS_QM_DB_RESULT_NO_CASE", NameOf(loadCase));
        else if (result == content.staticResults.end() || !result->second)
            (void)Fail("IDS_QM_DB_RESULT_NONE", NameOf(loadCase));
        else if (result->second->Fingerprint() != FingerprintOfCase(m_structure, record->second))
            (void)Fail("IDS_QM_DB_RESULT_OLD", NameOf(loadCase));
        judged->second = m_error;
    }
    m_error = judged->second;
    return m_error.empty() ? 1 : 0;
}

/// Flattens the selection and looks up the results of its cases.
bool CStaticReader::Prepare()
{
    Refresh();
    if (m_isPrepared) return true;
    const auto& table = m_data.Model().combinations;
    const auto it = table.find(m_key);
    if (m_key != 0 && it == table.end())
        return Fail("IDS_QM_DB_RESULT_NO_COMBINATION", std::to_string(m_key)) != 0;
    T_LCOM_D flat;
    if (!FlattenLcom(m_data.Model(), m_key == 0 ? m_combination : it->second, flat, m_error))
        return false;
    m_terms.clear();
    for (const T_LCOM_ITEM& item : flat.items) {
        if (!CheckCase(item.key)) return false;
        m_terms.push_back(
            {item.key, item.factor, m_data.Content().staticResults.at(item.key).get()});
    }
    if (m_terms.empty()) return Fail("IDS_QM_DB_RESULT_NOTHING", {}) != 0;
    m_isPrepared = true;
    return true;
}

template <class T, class F>
int CStaticReader::Superpose(const char* what, int id, T& out, const F& read)
{
    if (!Prepare()) return 0;
    T sum{};
    for (const T_TERM& term : m_terms) {
        T value{};
        if (!read(*term.source, value)) {
            m_error = term.source->Error();
            return m_error.empty() ? Fail(what, NameOf(term.loadCase), std::to_string(id)) : 0;
        }
        AddTo(sum, term.factor, value);
    }
    if (!AllFinite(sum)) return Fail("IDS_QM_DB_RESULT_TOO_LARGE", std::to_string(id));
    out = sum;
    return 1;
}

int CStaticReader::ReadDisplacement(int node, T_DOF6& out)
{
    return Superpose("IDS_QM_DB_RESULT_NO_NODE", node, out,
                     [&](IStaticResult& r, T_DOF6& v) { return r.ReadDisplacement(node, v); });
}

int CStaticReader::ReadReaction(int node, T_DOF6& out)
{
    return Superpose("IDS_QM_DB_RESULT_NO_NODE", node, out,
                     [&](IStaticResult& r, T_DOF6& v) { return r.ReadReaction(node, v); });
}

int CStaticReader::ReadForces(int element, T_ELEM_FORCES& out)
{
    return Superpose("IDS_QM_DB_RESULT_NO_ELEMENT", element, out,
                     [&](IStaticResult& r, T_ELEM_FORCES& v) { return r.ReadForces(element, v); });
}
