// The printed tables of rolled shapes.
#pragma once

#include "qm_db/stock/steelshapes.h"

#include <vector>

/// W shapes of the AISC Shapes Database.
std::vector<T_ROLLED_SHAPE> AiscWideFlanges();
/// UPN and UPE; C and MC of the AISC Shapes Database.
std::vector<T_ROLLED_SHAPE> EuropeanChannels();
std::vector<T_ROLLED_SHAPE> AiscChannels();
