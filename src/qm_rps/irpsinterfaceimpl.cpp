#include "qm_rps/irpsinterfaceimpl.h"

#include "qm_rps/rpsmanager.h"

int IRPSInterfaceImpl::BuildReport()
{
    m_error.clear();
    CRPSManager* manager = CRPSManager::Current();
    if (!manager) {
        m_error = "no document";
        return 0;
    }
    auto info = std::make_shared<SSReportInfoRW>();
    if (!BuildReportInfo(*CDBDoc::GetDocPoint(), *info, m_error)) return 0;
    manager->SetReportInfo(std::move(info));
    return 1;
}
