// States of hinge components in a step.
#pragma once

#include "qm_rps/push/pushlaws.h"
#include "qm_solver/pushresult.h"

#include <array>

/// Of a law without acceptance criteria BC stands for the four between B and C.
enum class PUSH_STATE { Elastic, BtoIO, IOtoLS, LStoCP, CPtoC, BtoC, CtoD, DtoE, Failed };
inline constexpr std::array<const char*, 9> kPushStateNames{
    "elastic", "B-IO", "IO-LS", "LS-CP", "CP-C", "B-C", "C-D", "D-E", "failed"};

/// State of a component: the part of the backbone that it is on, and before C the criteria that the
/// present deformation has passed, on whichever side it lies.
PUSH_STATE StateOf(const T_PUSH_LAW_PLACE& place, const solver::T_HINGE_LAW& law,
                   const solver::T_HINGE_STATE& state);

/// What an event leads to: the letter of the point ("B" is yield), "unload" or "reload".
std::string EventTarget(const T_PUSH_LAW_PLACE& place, const solver::T_HINGE_EVENT& event);
