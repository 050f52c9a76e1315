// The settings of the global control and of pushover load cases as a command takes them.
#pragma once

#include "qm_db/dbdoc.h"

#include <map>
#include <span>
#include <string>
#include <vector>

using SETTING_WORDS = std::vector<std::string>;

/// What is changed, in current units: the global control, or a load case where there is one.
struct T_SETUP_EDIT {
    const T_MODEL& model;
    T_POGC_D& control;
    T_POLC_D* record = nullptr;
};

enum class SETTING_SCOPE { Global, Case, Both };

struct T_SETTING {
    const char* option;
    SETTING_SCOPE scope;
    bool isList;      // takes several words
    const char* help; // key
    /// Takes the words. Empty: taken; else why not.
    std::string (*take)(T_SETUP_EDIT& edit, const SETTING_WORDS& words);
};

std::span<const T_SETTING> Settings();

/// Takes all that are given, in the order of the table. Empty: taken; else the option and why it
/// is refused.
std::string TakeSettings(const std::map<std::string, SETTING_WORDS>& given, T_SETUP_EDIT& edit);

/// "NAME=FACTOR" in two; without a factor 1. The last '=' counts, where a number follows it.
std::string SplitFactor(const std::string& word, double& factor);
