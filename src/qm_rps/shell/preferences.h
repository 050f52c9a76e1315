// What a person has chosen for every model: language, units, decimals, theme, autosave.
#pragma once

#include "qm_db/unitctrl.h"
#include "qm_rps/shell/decimals.h"

#include <string>

enum class THEME { System, Light, Dark };

struct T_PREFERENCES {
    std::string language = "en"; // "en" or "it"
    T_UNITS newUnits{};          // of models that are made; an open one has its own
    T_DECIMALS decimals = kAsStored;
    THEME theme = THEME::System;
    double autosaveS = 20.0; // least time between two copies, s
    bool operator==(const T_PREFERENCES&) const = default;
};

inline constexpr double kLeastAutosaveS = 5.0, kMostAutosaveS = 3600.0;

/// Where preferences are kept; the application says where that is.
class IPreferenceStore {
public:
    IPreferenceStore() = default;
    IPreferenceStore(const IPreferenceStore&) = delete;
    IPreferenceStore& operator=(const IPreferenceStore&) = delete;
    virtual ~IPreferenceStore() = default;
    /// Empty: nothing is kept under this key.
    virtual std::string Get(const std::string& key) const = 0;
    virtual void Set(const std::string& key, const std::string& value) = 0;
};

/// What is missing, or is none of the values that can be chosen, is as in a new installation.
T_PREFERENCES ReadPreferences(const IPreferenceStore& store);
void WritePreferences(IPreferenceStore& store, const T_PREFERENCES& preferences);
