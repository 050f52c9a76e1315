// Settings of the iterative analysis for pretension, one object per model document.
#pragma once

#include "qm_base/dynmodule.h"
#include "qm_rps/factors/ulfiteration.h"

class CUnknownLoadFactorIterAnal : public CDynModule {
public:
    /// In the module registry.
    static constexpr const char* kKey = "43ABD68B_707D_010A_77B6_2AA6BE4C";

    /// The document's settings, made with their defaults on first use. Null: another kind of
    /// module stands under the key.
    static CUnknownLoadFactorIterAnal* Of(CDynModuleMgr& modules);

    /// Those that were set last.
    const T_ULF_ITER_SETTINGS& Settings() const { return m_settings; }
    /// 1 done; 0 refused and as it was: iterations below 0 or above 99 (copies are numbered in two
    /// digits), a tolerance that is below 0 or not finite.
    [[nodiscard]] int Set(const T_ULF_ITER_SETTINGS& settings);

    /// Most iterations.
    static constexpr int kMost = 99;

private:
    T_ULF_ITER_SETTINGS m_settings;
};
