#include "qm_rps/unknownloadfactoriteranal.h"

#include <cmath>

CUnknownLoadFactorIterAnal* CUnknownLoadFactorIterAnal::Of(CDynModuleMgr& modules)
{
    if (!modules.GetDynModule(kKey) &&
        !modules.AddDynModule(kKey, std::make_unique<CUnknownLoadFactorIterAnal>()))
        return nullptr;
    return dynamic_cast<CUnknownLoadFactorIterAnal*>(modules.GetDynModule(kKey));
}

int CUnknownLoadFactorIterAnal::Set(const T_ULF_ITER_SETTINGS& settings)
{
    if (settings.required < 0 || settings.required > kMost) return 0;
    if (!(settings.tolerance >= 0.0) || !std::isfinite(settings.tolerance)) return 0;
    m_settings = settings;
    return 1;
}
