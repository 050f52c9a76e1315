#include "qm_base/msgfunction.h"
#include "qm_db/postctrl.h"

// Results of static load cases and their combinations.

using zql::lib::MMSGFunction;

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

int CPostCtrl::GetDispNew(int node, T_DOF6& out)
{
    const int done = m_static.ReadDisplacement(node, out);
    m_error = m_static.Error();
    if (done) ToCurrentUnits(out, kDimLength, kDimNone);
    return done;
}

int CPostCtrl::GetReacNew(int node, T_DOF6& out)
{
    const int done = m_static.ReadReaction(node, out);
    m_error = m_static.Error();
    if (done) ToCurrentUnits(out, kDimForce, kDimMoment);
    return done;
}

int CPostCtrl::ReadForces(int element, ELEM_KIND kind, const char* otherKind, T_ELEM_FORCES& out)
{
    const auto it = m_data.Model().elements.find(element);
    if (it == m_data.Model().elements.end() || it->second.kind != kind) {
        m_error = MMSGFunction::Format(otherKind, {std::to_string(element)});
        return 0;
    }
    const int done = m_static.ReadForces(element, out);
    m_error = m_static.Error();
    return done;
}

int CPostCtrl::GetStrtNew(int element, double& axial)
{
    T_ELEM_FORCES forces;
    if (!ReadForces(element, ELEM_KIND::Truss, "IDS_QM_DB_RESULT_NO_TRUSS", forces)) return 0;
    axial = FromSi(forces[0][0], m_data.Units(), kDimForce);
    return 1;
}

int CPostCtrl::GetStrbNew(int element, int position, T_DOF6& out)
{
    if (position < 0 || position >= static_cast<int>(kForcePositions)) {
        m_error = MMSGFunction::Format("IDS_QM_DB_RESULT_NO_POSITION", {std::to_string(position)});
        return 0;
    }
    T_ELEM_FORCES forces;
    if (!ReadForces(element, ELEM_KIND::Beam, "IDS_QM_DB_RESULT_NO_BEAM", forces)) return 0;
    out = forces[static_cast<std::size_t>(position)];
    ToCurrentUnits(out, kDimForce, kDimMoment);
    return 1;
}

int CPostCtrl::CheckStaticResult(int loadCase)
{
    const int done = m_static.CheckCase(loadCase);
    m_error = m_static.Error();
    return done;
}
