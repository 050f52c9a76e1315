// Preferences in the settings of the person's account.
#pragma once

#include "qm_rps/shell/preferences.h"

class CSettingsStore : public IPreferenceStore {
public:
    std::string Get(const std::string& key) const override;
    void Set(const std::string& key, const std::string& value) override;
};
