// Steel shapes and grades of materials that a case file may name.
#pragma once

#include "exitcodes.h"

#include <string>

/// Shapes whose names begin so, with their properties in mm and cm; a hollow shape by its whole
/// name. Usage where there is none.
EXIT_CODE RunSectionShapes(const std::string& find);

EXIT_CODE RunSectionGrades();
