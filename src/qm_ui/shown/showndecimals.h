// The one place by which tables and read-outs shorten numbers for showing.
#pragma once

#include "qm_rps/shell/decimals.h"

/// Decimals that every window shows: a switch of the program, as its language is. All digits until
/// the application says otherwise.
void SetShownDecimals(const T_DECIMALS& decimals);
const T_DECIMALS& ShownDecimals();

/// A number's text as it is shown under a head with its unit. What is edited or copied keeps all
/// its digits: that text does not come through here.
std::string ShownNumber(const std::string& number, std::string_view head);
