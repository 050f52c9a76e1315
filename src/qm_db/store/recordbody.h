// Nested records as text in one column of the model file: the object of a case file, in SI.
#pragma once

#include "qm_db/casefile/caseget.h"
#include "qm_db/casefile/caseput.h"
#include "qm_db/casefile/jsonparser.h"

inline constexpr T_UNITS kSiUnits{FORCE_UNIT::N, LENGTH_UNIT::m};

/// The text on one line. 1 done; 0 error filled (a number that is not finite, bad UTF-8).
template <class R>
[[nodiscard]] int PrintBody(const R& r, std::string& text, T_FILE_ERROR& error)
{
    CJsonWriter out(kSiUnits);
    CCasePut put(out);
    out.BeginObject(true);
    CaseFields(put, r);
    out.EndObject();
    error = out.Error();
    if (out.Failed()) return 0;
    text = out.TakeText();
    return 1;
}

/// 1 done; 0 error filled.
template <class R>
[[nodiscard]] int ParseBody(std::string_view text, R& r, T_FILE_ERROR& error)
{
    T_JSON document;
    if (!ParseJson(text, document, error)) return 0;
    CJsonReader in(&document, {}, error);
    CCaseGet::Record(in, kSiUnits, {}, r);
    return in.Failed() ? 0 : 1;
}
