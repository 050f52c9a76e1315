// What was computed for a report, before it is written.
#pragma once

#include "qm_rps/factors/ulfchecked.h"
#include "qm_rps/judge/judgementresult.h"
#include "qm_rps/push/pushatpoint.h"
#include "qm_rps/pushover/pushevaluation.h"

#include <memory>

/// A load factor item as it was solved now.
struct T_SOLVED_ITEM {
    std::string name, fault;            // fault: why it could not be solved
    std::optional<T_ULF_RESULT> result; // empty: there is a fault
    T_ULF_CHECKED checked;              // with its factors
    std::vector<T_ULF_STAY> stays;
};

/// Empty parts were not asked for, or the model has none. Lists of evaluations have one order.
struct T_REPORT_DATA {
    std::shared_ptr<const std::vector<T_PUSH_RUN>> runs =
        std::make_shared<std::vector<T_PUSH_RUN>>(); // results of our own, those of today's model
    std::vector<std::string> runFaults; // results that can't be shown and why, warnings of pushes
    std::vector<std::pair<std::string, std::string>> findings; // place and what a check says of it
    std::string stageFault; // why there are no results of construction stages
    std::vector<std::shared_ptr<const T_PUSH_EVALUATION>> evaluations;
    std::vector<T_HINGES_AT> hinges;                            // by evaluation
    std::vector<std::shared_ptr<const T_JUDGEMENT>> judgements; // of those that can be judged
    std::vector<T_SOLVED_ITEM> items;
};
