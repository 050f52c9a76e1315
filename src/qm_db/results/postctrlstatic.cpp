#include "qm_base/msgfunction.h"
#include "qm_db/postctrl.h"
#include "qm_db/results/fingerprint.h"

// Results of static load cases, of their combinations and of construction stages.

using zql::lib::MMSGFunction;

namespace {

/// Order-dependent mix of 64-bit numbers (FNV-1a over whole words).
std::uint64_t Mixed(std::uint64_t hash, std::uint64_t value)
{
    constexpr std::uint64_t prime = 1099511628211ULL;
    return (hash ^ value) * prime;
}

} // namespace

T_LCOM_D CPostCtrl::MakeLoadComb(int loadCase, double factor)
{
    return {{}, {{false, loadCase, factor}}};
}

int CPostCtrl::SelectLoadCombNew(const T_LCOM_D& combination)
{
    m_static.Select(combination);
    return 1;
}

int CPostCtrl::SelectLoadCombNew(int combination)
{
    return m_static.SelectKey(combination);
}

void CPostCtrl::ToCurrentUnits(T_DOF6& values, T_DIM linear, T_DIM angular) const
{
    for (std::size_t i = 0; i < values.size(); ++i)
        values[i] = FromSi(values[i], m_data.Units(), i < 3 ? linear : angular);
}

// The readers of both families have the same operations.

template <class R>
int CPostCtrl::ReadNode(R& reader, int (R::*read)(int, T_DOF6&), int node, T_DOF6& out,
                        T_DIM linear, T_DIM angular)
{
    const int done = (reader.*read)(node, out);
    m_error = reader.Error();
    if (done) ToCurrentUnits(out, linear, angular);
    return done;
}

template <class R>
int CPostCtrl::ReadForces(R& reader, int element, ELEM_KIND kind, T_ELEM_FORCES& out)
{
    const auto it = m_data.Model().elements.find(element);
    if (it == m_data.Model().elements.end() || it->second.kind != kind) {
        m_error = MMSGFunction::Format(kind == ELEM_KIND::Truss ? "IDS_QM_DB_RESULT_NO_TRUSS"
                                                                : "IDS_QM_DB_RESULT_NO_BEAM",
                                       {std::to_string(element)});
        return 0;
    }
    const int done = reader.ReadForces(element, out);
    m_error = reader.Error();
    return done;
}

template <class R>
int CPostCtrl::ReadTruss(R& reader, int element, double& axial)
{
    T_ELEM_FORCES forces;
    if (!ReadForces(reader, element, ELEM_KIND::Truss, forces)) return 0;
    axial = FromSi(forces[0][0], m_data.Units(), kDimForce);
    return 1;
}

template <class R>
int CPostCtrl::ReadBeam(R& reader, int element, int position, T_DOF6& out)
{
    if (position < 0 || position >= static_cast<int>(kForcePositions)) {
        m_error = MMSGFunction::Format("IDS_QM_DB_RESULT_NO_POSITION", {std::to_string(position)});
        return 0;
    }
    T_ELEM_FORCES forces;
    if (!ReadForces(reader, element, ELEM_KIND::Beam, forces)) return 0;
    out = forces[static_cast<std::size_t>(position)];
    ToCurrentUnits(out, kDimForce, kDimMoment);
    return 1;
}

int CPostCtrl::GetDispNew(int node, T_DOF6& out)
{
    return ReadNode(m_static, &CStaticReader::ReadDisplacement, node, out, kDimLength, kDimNone);
}

int CPostCtrl::GetReacNew(int node, T_DOF6& out)
{
    return ReadNode(m_static, &CStaticReader::ReadReaction, node, out, kDimForce, kDimMoment);
}

int CPostCtrl::GetStrtNew(int element, double& axial)
{
    return ReadTruss(m_static, element, axial);
}

int CPostCtrl::GetStrbNew(int element, int position, T_DOF6& out)
{
    return ReadBeam(m_static, element, position, out);
}

int CPostCtrl::CheckStaticResult(int loadCase)
{
    const int done = m_static.CheckCase(loadCase);
    m_error = m_static.Error();
    return done;
}

void CPostCtrl::SelectStage(int stage, int step, int load)
{
    m_staged.Select({stage, step, load});
}

int CPostCtrl::GetDspcNew(int node, T_DOF6& out)
{
    return ReadNode(m_staged, &CStagedReader::ReadDisplacement, node, out, kDimLength, kDimNone);
}

int CPostCtrl::GetReccNew(int node, T_DOF6& out)
{
    return ReadNode(m_staged, &CStagedReader::ReadReaction, node, out, kDimForce, kDimMoment);
}

int CPostCtrl::GetStrtcNew(int element, double& axial)
{
    return ReadTruss(m_staged, element, axial);
}

int CPostCtrl::GetStrbcNew(int element, int position, T_DOF6& out)
{
    return ReadBeam(m_staged, element, position, out);
}

int CPostCtrl::CheckStagedResult()
{
    const int done = m_staged.Check();
    m_error = m_staged.Error();
    return done;
}

std::uint64_t CPostCtrl::StaticRevision()
{
    if (m_data.Revision() == m_staticRevisionAt) return m_staticRevision;
    const T_MODEL& model = m_data.Model();
    const std::uint64_t structure = FingerprintOfStructure(model);
    std::uint64_t hash = Mixed(structure, static_cast<std::uint64_t>(m_data.Units().force));
    hash = Mixed(hash, static_cast<std::uint64_t>(m_data.Units().length));
    for (const auto& [key, loadCase] : model.loadCases) {
        hash = Mixed(hash, static_cast<std::uint64_t>(key));
        hash = Mixed(hash, FingerprintOfCase(structure, loadCase));
    }
    for (const auto& [key, result] : m_data.Content().staticResults) {
        hash = Mixed(hash, static_cast<std::uint64_t>(key));
        hash = Mixed(hash, result->Fingerprint());
    }
    m_staticRevisionAt = m_data.Revision();
    return m_staticRevision = hash;
}
