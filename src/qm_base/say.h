// Texts of the message catalogue, as the commands say them.
#pragma once

#include "qm_base/msgfunction.h"

#include <string>
#include <string_view>

/// The text of the key in the user's language, its places {1}, {2} ... taken by texts.
template <class... ARGS>
std::string Say(std::string_view key, const ARGS&... args)
{
    return zql::lib::MMSGFunction::Format(key, {std::string_view(args)...});
}
