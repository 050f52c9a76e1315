#include "qm_base/serviceheadoffice.h"

CServiceHeadOffice* CServiceHeadOffice::Instance()
{
    static CServiceHeadOffice office;
    return &office;
}

int CServiceHeadOffice::RegAgency(std::string_view name, std::unique_ptr<CServiceAgency> agency)
{
    if (name.empty() || !agency) return 0;
    return m_agencies.try_emplace(std::string(name), std::move(agency)).second ? 1 : 0;
}

CServiceAgency* CServiceHeadOffice::GetAgency(std::string_view name) const
{
    const auto found = m_agencies.find(name);
    return found == m_agencies.end() ? nullptr : found->second.get();
}
