// Two trusses in a line between walls, of length 1 and E A = 10 each: node 2 between them moves
// along X only. Stage 1 "S1" brings them at once with load case 1 "G" (force 4 along X at node 2)
// and 2 "T" (initial tension 1 of the truss on the left). By hand, with displacement u and a
// tension of T: T + 10 u + 10 u = 4, so that u = (4 - T) / 20; T alone moves the node by -T / 20.
// Constraint "HOLD": no displacement of node 2. Item 1 "STAY": G known, T unknown. SI units.
#pragma once

#include "qm_db/dbdoc.h"

namespace two {

inline T_MODEL_CONTENT Content()
{
    T_MODEL_CONTENT content;
    T_MODEL& m = content.model;
    m.styp.units = {FORCE_UNIT::N, LENGTH_UNIT::m};
    m.materials[1].name = "M";
    m.materials[1].E = 10.0;
    m.sections[1].name = "S";
    m.sections[1].area = 1.0;
    for (int i = 1; i <= 3; ++i) {
        m.nodes[i].id = i;
        m.nodes[i].xyz = {i - 1.0, 0, 0};
        m.nodes[i].restraint = {i == 2 ? 0 : 1, 1, 1, 1, 1, 1};
    }
    for (int i = 1; i <= 2; ++i)
        m.elements[i] = {i, i, i + 1, 1, 1, 0, ELEM_KIND::Truss};
    m.loadCases[1].name = "G";
    m.loadCases[1].nodal = {{2, {4, 0, 0, 0, 0, 0}}};
    m.loadCases[1].group = kLoadGroupDead;
    m.loadCases[2].name = "T";
    m.loadCases[2].pretension = {{1, 1.0}};
    T_STAG_D& stage = m.stages[1];
    stage.name = "S1";
    stage.activate = {{1, 2}, {1, 2, 3}, {{1, kStageFirstStep}, {2, kStageFirstStep}}};
    T_ULFC_D& hold = m.ulfConstraints[1];
    hold.name = "HOLD";
    hold.type = ULFC_TYPE::Displacement;
    hold.id = 2;
    T_ULSI_D& item = m.ulfStageItems[1];
    item.name = "STAY";
    item.rows = {{1, kStageFirstStep, 2, true, 1.0, 1.0, true, kLoadGroupRest},
                 {1, kStageFirstStep, 1, false, 1.0, 1.0, false, kLoadGroupDead}};
    item.constraints = {"HOLD"};
    return content;
}

} // namespace two
