// Text report of the iterative analysis for pretension.
#pragma once

#include <string>
#include <vector>

/// An unknown of the construction-stage problem after a solution.
struct T_ULF_ITER_ROW {
    std::string place; // stage and step, "S1/First Step"
    double factor = 0.0;
    bool pretension = false; // it scales pretension loads
    std::string load{};      // name of its load case
    bool operator==(const T_ULF_ITER_ROW&) const = default;
};

/// One solution: number 0 is the first one.
struct T_ULF_ITER_STEP {
    int iteration = 0;
    std::string file; // model file that it belongs to
    std::vector<T_ULF_ITER_ROW> rows;
    double tolerance = 0.0; // UlfIterTolerance of the rows
    bool operator==(const T_ULF_ITER_STEP&) const = default;
};

/// Square root of the sum of (1 - factor)^2 over the unknowns that scale pretension.
double UlfIterTolerance(const std::vector<T_ULF_ITER_ROW>& rows);

/// By what each row's pretension has been multiplied so far: the factors of every solution but the
/// latest, which was found with them. 1 for a row that scales none. Empty without a solution.
std::vector<double> UlfIterApplied(const std::vector<T_ULF_ITER_STEP>& history);

/// Banner and settings.
std::string UlfIterHead(int required, double tolerance);
/// Block of one solution. Of a place the first 30 characters are shown.
std::string UlfIterBlock(const T_ULF_ITER_STEP& step);

/// "frame.ulf" and "frame_03.qmdb" of the model file "frame.qmdb".
std::string UlfIterReportPath(const std::string& model);
std::string UlfIterCopyPath(const std::string& model, int iteration);
