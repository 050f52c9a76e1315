// Bounds of a real number among the arguments.
#pragma once

#include "qm_base/say.h"
#include "qm_base/textformat.h"

#include <CLI/CLI.hpp>

#include <string>

/// From least to most. CLI::Range alone lets "nan" through: it compares false with both bounds.
inline CLI::Validator FiniteRange(double least, double most)
{
    const auto judge = [=](std::string& text) -> std::string {
        double value = 0.0;
        const bool good = CLI::detail::lexical_cast(text, value) && value >= least && value <= most;
        return good ? std::string()
                    : Say("IDS_QM_CLI_NOT_BETWEEN", text, FormatText("%g", least),
                          FormatText("%g", most));
    };
    return {judge, CLI::Range(least, most).get_description()};
}
