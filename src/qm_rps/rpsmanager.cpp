#include "qm_rps/rpsmanager.h"

#include "qm_rps/desk/docmodule.h"

namespace {
constexpr const char* kSource = "src/qm_rps/rpsmanager";
}

CRPSManager* CRPSManager::Current()
{
    return CurrentDocModule<CRPSManager>(kSource);
}

void CRPSManager::SetReportInfo(std::shared_ptr<const SSReportInfoRW> info)
{
    if (info && info == m_info && CAppBase::IsReleaseAssert_ST())
        CAppBase::ReleaseAssertion_ST(kSource, __LINE__);
    m_info = std::move(info);
}
