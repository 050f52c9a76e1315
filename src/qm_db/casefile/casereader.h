// Reads the parsed document of a case file into a model. The parts are called in this order, each
// refers only to records read before. A fault is kept by the reader; the model is then incomplete.
#pragma once

#include "qm_db/casefile/jsonreader.h"
#include "qm_db/modelstore.h"
#include "qm_db/records/inputlimits.h"
#include "qm_db/records/recordunits.h"

/// Where relative paths of recorder files start, and whether they may lead out of there.
struct T_CASE_FOLDER {
    std::string path;
    bool allowOutside = false;
};

/// The whole document.
void ReadCase(CJsonReader& root, const T_CASE_FOLDER& folder, T_MODEL_CONTENT& content);

class CCaseNames;
/// What a load case has beside its own members: results of another solver or the number of
/// increments, limit-state steps.
void ReadSteps(CJsonReader& in, const CCaseNames& names, const T_CASE_FOLDER& folder, int key,
               T_POLC_D& push, T_MODEL_CONTENT& content);
/// Rules of the control of the pushover analysis; of a load case when all of them have been read.
void JudgePushControl(CJsonReader& in, const T_POGC_D& control);
void JudgePush(CJsonReader& in, const T_MODEL& model, const T_POLC_D& push);
/// The control node and what the pattern names.
void JudgePushNames(CJsonReader& in, const T_MODEL& model, const T_POLC_D& push);
/// References by name, and rules of the record.
void JudgeEvaluation(CJsonReader& in, const T_MODEL& model, const T_EVAL_D& eval);

/// "steps" of one load case, in SI.
void ReadSteps(CJsonReader& steps, const T_CASE_FOLDER& folder, const T_MODEL& model,
               const T_POLC_D& push, T_PUSH_DATA& out);

/// Calls f(CJsonReader& item, index) for each item of a table that may be left out.
template <class F>
void ForEachRecord(CJsonReader& root, std::string_view key, F&& f)
{
    if (root.Has(key)) root.Member(key).ForEachItem(f);
}

/// The record to SI; a fault when a value is too large then.
template <class T>
void RecordToSiChecked(CJsonReader& in, T& record, const T_UNITS& units)
{
    RecordToSi(record, units);
    ForEachQuantity(record, [&](double& v, T_DIM) {
        if (!IsUsableNumber(v)) in.Fail("IDS_QM_CASE_TOO_LARGE");
    });
}

// Rules for numbers, for Check and its relatives.
inline bool IsAboveZero(double v)
{
    return v > 0.0;
}
inline bool IsZeroOrAbove(double v)
{
    return v >= 0.0;
}
