// Text report of an evaluation and its curve table. Reads the finished result, computes nothing.
#pragma once

#include "qm_rps/pushover/pushevaluation.h"

#include <string>

/// Product name and version on the report's header line.
std::string ProductText();

/// The whole report: header, method section, curve table.
std::string PushoverReportText(const T_PUSH_EVALUATION& e);

/// The curve table alone.
std::string PushoverCurveText(const T_PUSH_EVALUATION& e);

/// Labels of a plot type's axes, in the chosen language.
std::string PlotXLabel(PLOT_TYPE type);
std::string PlotYLabel(PLOT_TYPE type);

/// Writes one of these texts. 1 done; 0 the file can't be created (error filled, nothing written).
[[nodiscard]] int WritePushoverText(const std::string& text, const std::string& path,
                                    std::string& error);
