// Audit of the message catalogues against each other and against the sources that use them.
#pragma once

#include <span>
#include <string>
#include <vector>

struct T_AUDIT_TEXT {
    std::string name; // language of a catalogue, or path of a source
    std::string text; // the whole file
};

/// What is wrong, one line each: faults of a catalogue's lines (doubles among them), keys that a
/// source uses and the first catalogue lacks, keys that only one of two catalogues has, unequal
/// places {1}, {2} ... of one key. The first catalogue is the reference.
std::vector<std::string> AuditMessages(std::span<const T_AUDIT_TEXT> catalogues,
                                       std::span<const T_AUDIT_TEXT> sources);

/// Every .h and .cpp file below a folder; empty when there is none.
std::vector<T_AUDIT_TEXT> SourcesBelow(const std::string& folder);
