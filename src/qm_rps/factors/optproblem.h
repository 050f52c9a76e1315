// A problem of the load factor optimizer, what is handed to the numerical solver, and the answer.
#pragma once

#include "qm_rps/factors/optrows.h"

#include <functional>
#include <string>

/// A problem in the optimizer's terms. Quantities are in the document's current units.
struct T_OPT_PROBLEM {
    bool stage = false; // construction stage: rows from the stage source
    std::vector<T_OPT_ITEM> items;
    int iobj = 1; // 1 sum of |w x|, 2 sum of (w x)^2, 3 largest |w x|
    std::vector<T_OPT_RECORD> constraints;
    int nvar = 0;  // unknown items
    int isign = 0; // 1 factors >= 0, -1 factors <= 0, 0 free
    bool solveByEquations = false;
};

/// What is handed to the numerical solver: equalities first, each group in input order, every
/// inequality turned to "at most".
struct T_OPT_SYSTEM {
    int ncon = 0, nvar = 0, neq = 0;
    std::vector<double> matrix;  // row-major, ncon x nvar
    std::vector<double> rhs;     // ncon
    std::vector<double> weights; // nvar
    std::vector<int> order;      // row -> index of the constraint record
    std::vector<int> relations;  // row -> relation of the record before it was turned
    bool operator==(const T_OPT_SYSTEM&) const = default;
};

struct T_OPT_ANSWER {
    std::vector<double> factors;                   // one per unknown item; 0 unless found
    std::vector<std::vector<double>> coefficients; // per constraint: response of every item
    /// Construction stage only, per constraint: what the known items contribute.
    std::vector<double> constants;
    bool exact = false;  // solved as equations
    T_OPT_SYSTEM system; // as handed to the solver; empty when the rows could not be read
    int code = 0;        // of the solver; 10: it failed
    std::string key;     // of the failure
    std::string message; // the failure in words; empty when factors were found
    int constraint = 0;  // number of the constraint record that the message is about, from 1
    int factor = 0;      // number of the unknown that the message is about, from 1
};

/// Debug dump of the problem handed to the solver, off in normal operation.
struct T_OPT_DUMP {
    bool enabled = false;
    std::string modelPath;           // of the model file: frame.qmdb gives frame_[EXACT].out
    std::function<bool()> overwrite; // asked when the file exists; false or empty: it is added to
};
