#include "qm_db/records/recordfit.h"

#include "qm_db/records/hingetype.h"

#include <algorithm>

void FitRecord(T_ELEM_D& r)
{
    const bool beam = r.kind == ELEM_KIND::Beam;
    if (r.kind == ELEM_KIND::Spring) r.nodeJ = 0;
    if (!beam) {
        r.release = {};
        r.offset = {};
    }
    if (beam || r.kind == ELEM_KIND::Truss) {
        r.stiffness = {};
    } else {
        r.section = r.material = 0;
        r.zAxis = {};
    }
}

void FitRecord(T_STLD_D& r)
{
    for (T_BEAM_LOAD& load : r.beam) {
        if (load.type == BEAM_LOAD_TYPE::Distributed) continue;
        load.w[1] = 0.0;
        load.at[1] = T_BEAM_LOAD{}.at[1];
    }
}

void FitRecord(T_ULFC_D& r)
{
    if (r.type != ULFC_TYPE::Beam) r.position = 0;
    if (r.type == ULFC_TYPE::Truss) r.component = 0;
    if (r.inequality) {
        r.compareWithValue = true;
        r.value = 0.0;
    } else {
        r.upper.reset();
        r.lower.reset();
        if (!r.compareWithValue) r.value = 0.0;
    }
    if (r.compareWithValue) r.otherId = 0;
    if (r.stage == 0) r.step = kStageLastStep;
}

void FitRecord(T_ULSI_D& r)
{
    std::stable_partition(r.rows.begin(), r.rows.end(),
                          [](const T_ULSI_ROW& row) { return row.unknown; });
    for (T_ULSI_ROW& row : r.rows) {
        if (row.unknown) {
            row.factor = 1.0;
        } else {
            row.weight = 1.0;
            row.pretension = false;
        }
    }
}

void FitRecord(T_PHGT_D& r)
{
    FitCurves(r);
}
