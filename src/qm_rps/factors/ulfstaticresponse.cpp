#include "qm_rps/factors/ulfstaticresponse.h"

#include "qm_base/msgfunction.h"
#include "qm_db/dbdoc.h"
#include "qm_db/results/fingerprint.h"
#include "qm_rps/factors/optrows.h"

#include <cmath>

using zql::lib::MMSGFunction;

namespace {

/// Order-dependent mix of 64-bit numbers (FNV-1a over whole words).
std::uint64_t Mixed(std::uint64_t hash, std::uint64_t value)
{
    constexpr std::uint64_t prime = 1099511628211ULL;
    return (hash ^ value) * prime;
}

} // namespace

int CUlfStaticResponse::ReadOne(const T_OPT_QUANTITY& what, double& out)
{
    CPostCtrl& post = m_doc.Post();
    const auto component = static_cast<std::size_t>(what.component - 1);
    T_DOF6 values{};
    if (what.component < 1 || component >= values.size()) return 0;
    int done = 0;
    switch (what.kind) {
    case 1:
        done = post.GetDispNew(what.id, values);
        break;
    case 2:
        done = post.GetReacNew(what.id, values);
        break;
    case 3: // the truss has one force
        done = component == 0 ? post.GetStrtNew(what.id, values[0]) : 0;
        break;
    case 4:
        done = post.GetStrbNew(what.id, what.position - 1, values);
        break;
    default:
        break;
    }
    if (!done || !std::isfinite(values[component])) return 0;
    out = values[component];
    return 1;
}

int CUlfStaticResponse::Read(std::span<const T_OPT_ITEM> items,
                             std::span<const T_OPT_QUANTITY> what, std::span<double> out)
{
    m_error.clear();
    CPostCtrl& post = m_doc.Post();
    for (std::size_t i = 0; i < items.size(); ++i) {
        const int loadCase = Truncated(items[i][0]);
        bool ok = post.SelectLoadCombNew(CPostCtrl::MakeLoadComb(loadCase, 1.0)) != 0;
        for (std::size_t q = 0; ok && q < what.size(); ++q)
            ok = ReadOne(what[q], out[q * items.size() + i]) != 0;
        if (ok) continue;
        m_error = post.Error();
        if (m_error.empty())
            m_error = MMSGFunction::Format("IDS_QM_ULF_CASE_NOT_READ", {std::to_string(loadCase)});
        return 0;
    }
    return 1;
}

std::uint64_t CUlfStaticResponse::Revision()
{
    const CDataCtrl& data = m_doc.Data();
    if (data.Revision() == m_documentRevision) return m_revision;
    const T_MODEL& model = data.Model();
    const std::uint64_t structure = FingerprintOfStructure(model);
    std::uint64_t hash = Mixed(structure, static_cast<std::uint64_t>(data.Units().force));
    hash = Mixed(hash, static_cast<std::uint64_t>(data.Units().length));
    for (const auto& [key, loadCase] : model.loadCases) {
        hash = Mixed(hash, static_cast<std::uint64_t>(key));
        hash = Mixed(hash, FingerprintOfCase(structure, loadCase));
    }
    for (const auto& [key, result] : data.Content().staticResults) {
        hash = Mixed(hash, static_cast<std::uint64_t>(key));
        hash = Mixed(hash, result->Fingerprint());
    }
    m_documentRevision = data.Revision();
    return m_revision = hash;
}
