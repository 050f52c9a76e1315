// The command that judges member ends at what evaluations find.
#pragma once

#include "exitcodes.h"
#include "qm_rps/judge/judgement.h"

#include <string>
#include <vector>

struct T_JUDGE_COMMAND {
    std::string file;
    std::vector<std::string> evaluations; // names; empty: all
    std::string code;                     // of all members; empty: that of their hinges
    std::string members = "primary";      // with `code`: or "secondary"
    std::string level;                    // limit state; empty: all
    T_JUDGE_FACTORS factors;
    std::string json, report, sheet, csv, plot;
    bool plain = false;              // the report without what it rests on
    bool trace = false, all = false; // all: rows on a terminal
    bool overwrite = false, noStore = false;
};

/// Names that --limit-state takes.
std::vector<std::string> JudgedLevelNames();

/// Done: every limit state was judged, whatever the verdicts are; NotFound: one was not.
EXIT_CODE RunJudge(const T_JUDGE_COMMAND& options);
