// Commands on any record of a model: its members are listed, shown, set, and records made and
// deleted, by the same rules as in the windows.
#pragma once

#include "exitcodes.h"

#include <string>
#include <vector>

struct T_RECORD_OPTIONS {
    std::string file;
    std::string kind;                     // "section", "pushover_control" ...
    std::string record;                   // name, key or id
    std::vector<std::string> settings;    // "size/0=0.3"
    std::vector<std::string> records;     // to delete: names, keys or ids
    std::vector<std::string> add, remove; // paths of lists and parts
    std::string copy;                     // record to start from
    std::string out;
    bool overwrite = false;
    bool all = false; // members that are left out, too
    std::string json, csv, sheet;
};

/// The kinds with their counts, or the records of one kind.
EXIT_CODE RunRecordList(const T_RECORD_OPTIONS& options);
/// The members of one record.
EXIT_CODE RunRecordShow(const T_RECORD_OPTIONS& options);
/// Sets members of a record and writes the model.
EXIT_CODE RunRecordSet(const T_RECORD_OPTIONS& options);
/// Makes a record, or a copy of one, and writes the model.
EXIT_CODE RunRecordAdd(const T_RECORD_OPTIONS& options);
/// Deletes records that nothing refers to, and writes the model.
EXIT_CODE RunRecordDelete(const T_RECORD_OPTIONS& options);
