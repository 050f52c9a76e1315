// The spectrum of an evaluation.
#pragma once

#include "qm_db/records.h"

/// The spectrum of that name; null: there is none.
const T_SPFC_D* SpectrumOf(const T_MODEL& model, const std::string& name);
