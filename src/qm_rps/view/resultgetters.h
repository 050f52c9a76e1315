// How results of an analysis are read, of load cases and of construction stages by the same steps.
#pragma once

#include "qm_db/postctrl.h"

struct T_RESULT_GETTERS {
    int (CPostCtrl::*displacement)(int, T_DOF6&);
    int (CPostCtrl::*reaction)(int, T_DOF6&);
    int (CPostCtrl::*truss)(int, double&);
    int (CPostCtrl::*beam)(int, int, T_DOF6&);
};
inline constexpr T_RESULT_GETTERS kStaticGetters{&CPostCtrl::GetDispNew, &CPostCtrl::GetReacNew,
                                                 &CPostCtrl::GetStrtNew, &CPostCtrl::GetStrbNew};
inline constexpr T_RESULT_GETTERS kStageGetters{&CPostCtrl::GetDspcNew, &CPostCtrl::GetReccNew,
                                                &CPostCtrl::GetStrtcNew, &CPostCtrl::GetStrbcNew};
