// Opens a model file: every check, then the records. Failures are thrown as CStoreFault.
#pragma once

#include "qm_db/modelstore.h"
#include "qm_db/store/modelschema.h"

enum class CHECK_DEPTH {
    BySize, // result blocks of files over 16 MiB are checked when they are read
    Whole
};

/// Order: size, application id, schema version, SQLite's integrity check, checksums of the tables
/// and blocks. An older file is brought up to the schema's version in memory.
T_MODEL_CONTENT ReadModelFile(const std::string& path, const T_SCHEMA& schema, CHECK_DEPTH depth);

/// What tells one state of a model file from another: a sum over its own table of checksums, which
/// has one for every table and every result block. Throws for what is no model file.
std::uint64_t StampOfModelFile(const std::string& path);

/// Makes the tables in an empty file and writes model, results and checksums.
void WriteModelFile(const std::string& path, const T_MODEL_CONTENT& content);

/// Computes the checksum of every table and stores them: the last step of writing.
void WriteChecksums(const CSqliteDb& db);
