// A number with what it is, where it comes from and how it was worked out.
#pragma once

#include "qm_rps/codes/codesheet.h"

#include <optional>
#include <string>

/// Symbol, formula and numbers are notation; the definition is in the chosen language.
struct T_FACT {
    std::string symbol;     // "T*"
    std::string definition; // "period of the equivalent system"
    std::string clause;     // "EN 1998-1 (B.7)"
    std::string formula;    // "2 pi sqrt(m* dy* / Fy*)"; empty: an input
    std::string numbers;    // "2 pi sqrt(123.4 0.0123 / 345.6)"; empty: none
    std::optional<double> value{};
    std::string unit; // empty: none
    std::string text; // stands for a value that is no number
    CODE_MARK mark = CODE_MARK::Computed;

    /// "0.52341 s".
    std::string ValueText() const;
};
