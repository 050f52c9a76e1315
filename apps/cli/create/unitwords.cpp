#include "create/unitwords.h"

#include "qm_db/recordfacts.h"

#include <algorithm>

bool ParseUnits(const std::string& text, T_UNITS& units)
{
    const std::size_t comma = text.find(',');
    if (comma == text.npos) return false;
    const auto force = std::ranges::find(kForceNames, text.substr(0, comma));
    const auto length = std::ranges::find(kLengthNames, text.substr(comma + 1));
    if (force == kForceNames.end() || length == kLengthNames.end()) return false;
    units.force = static_cast<FORCE_UNIT>(force - kForceNames.begin());
    units.length = static_cast<LENGTH_UNIT>(length - kLengthNames.begin());
    return true;
}

std::string UnitWords()
{
    std::string text;
    for (const char* const name : kForceNames)
        text += (text.empty() ? "" : " ") + std::string(name);
    text += ',';
    for (const char* const name : kLengthNames)
        text += ' ' + std::string(name);
    return text;
}
