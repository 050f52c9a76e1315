// Hinges whose stored numbers are no longer those of the model.
#pragma once

#include "qm_db/dbdoc.h"

#include <string>

/// Types that a code gave and automatic strengths that section, material, member or initial loads
/// would make otherwise today, by their elements (the first few, and how many more); empty: none.
/// What can't be compared, or was edited, is not told here.
std::string StaleHinges(CDBDoc& doc);
