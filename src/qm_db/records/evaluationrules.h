// Rules of evaluation records, asked by the case reader, by windows and by the evaluation itself.
#pragma once

#include "qm_base/finding.h"
#include "qm_db/records/evalnames.h"

#include <span>
#include <string_view>

/// Structural behaviour of ATC-40 with the person's own points of kappa.
inline constexpr int kUserBehavior = 3;

/// "ATC-40", "FEMA440", "EC8/OPCM", "NTC2008", "NTC2018".
const char* MethodName(PUSH_METHOD method);

/// Procedures of a method: "A", "B", "C" or the first ones of them; target displacements have
/// none.
std::span<const char* const> ProceduresOf(PUSH_METHOD method);

/// Options that are out of range. A target displacement takes A for its only way.
std::vector<T_FINDING> OptionFindings(const T_EVAL_D& evaluation);

/// The same after a load case or a spectrum that the model does not have.
std::vector<T_FINDING> EvaluationFindings(const T_EVAL_D& evaluation, const T_MODEL& model);

/// Why a case file's member "behavior", "elastic_damping" ... is refused, a catalogue key; null: it
/// is not.
const char* EvaluationFault(const T_EVAL_D& evaluation, std::string_view caseKey);
