#include "qm_base/dynmodule.h"

CDynModule* CDynModuleMgr::GetDynModule(std::string_view name) const
{
    const auto found = m_modules.find(name);
    return found == m_modules.end() ? nullptr : found->second.get();
}

int CDynModuleMgr::AddDynModule(std::string_view name, std::unique_ptr<CDynModule> module)
{
    if (name.empty() || !module) return 0;
    return m_modules.try_emplace(std::string(name), std::move(module)).second ? 1 : 0;
}
