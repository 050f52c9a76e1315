// Result cells of the pushover windows: the values of an evaluation as texts, units in the heads,
// "-" where there is no value. Reads the finished result, computes nothing.
#pragma once

#include "qm_rps/dialog/texttable.h"
#include "qm_rps/pushover/pushevaluation.h"

/// Two values of the performance point, "%6.4g,  %6.4g"; "Elastic(...)" for an elastic point, "-"
/// without one.
std::string PerfPointPair(const T_PUSH_EVALUATION& e, double T_PERF_POINT::*first,
                          double T_PERF_POINT::*second);

/// "T0", "Teff(mu=2)": names of T_PUSH_EVALUATION::teffs.
std::string TeffName(std::size_t i);
/// "(Long) det* = dt* = ..." or "(Short) T* = ...": how a found target displacement came about.
std::string TargetLine(const T_TARGET_DISP& target, double gamma);

/// Name and value: the point or the derivation of each target, the factors.
T_TEXT_TABLE PushoverResultCells(const T_PUSH_EVALUATION& e);
/// Limit states: demand, capacity, their steps, remark.
T_TEXT_TABLE PushoverStateCells(const T_PUSH_EVALUATION& e);
/// One row per trial, in their order.
T_TEXT_TABLE PushoverTrialCells(const T_PUSH_EVALUATION& e);
/// The curve in the coordinates of its plot type, one row per step.
T_TEXT_TABLE PushoverCurveCells(const T_PUSH_EVALUATION& e);
T_TEXT_TABLE AdditionalStepCells(const T_PUSH_EVALUATION& e);
T_TEXT_TABLE AdditionalPointCells(const T_PUSH_EVALUATION& e);

/// The first message of a result and how many more there are; empty: none.
std::string RemarkLine(const T_PUSH_EVALUATION& e);
/// Name of the outcome, its advice, what the balanced points add, and the messages, as lines.
std::string OutcomeLines(const T_PUSH_EVALUATION& e);

/// Axis labels of a plot type with their units: "Spectral Displacement (m)".
std::string PlotXTitle(PLOT_TYPE type, const T_UNITS& units);
std::string PlotYTitle(PLOT_TYPE type, const T_UNITS& units);

/// Whether the curve is to be drawn on axes of its own, not with the demand spectrum.
bool IsOtherPlot(const T_PUSH_EVALUATION& e);

/// Where a point of the capacity spectrum at Sd lies on the curve of the plot type: at the same
/// fraction of the same step. Empty: the spectrum does not reach it, or the curves differ in steps.
std::optional<T_POINT2> PlaceOnCurve(const T_PUSH_EVALUATION& e, double Sd);
