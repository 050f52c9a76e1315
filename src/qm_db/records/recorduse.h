// Which records refer to a record: what would be left dangling if it were deleted.
#pragma once

#include "qm_db/records/tables.h"

#include <string>
#include <vector>

struct T_RECORD_USER {
    RECORD_KIND kind{};
    int key = 0; // of the record that refers
    bool operator==(const T_RECORD_USER&) const = default;
};
/// As a user: the global control of the pushover analysis, whose key is 0.
inline constexpr RECORD_KIND kPushControlKind{std::tuple_size_v<decltype(kRecords)>};
using T_RECORD_USERS = std::vector<T_RECORD_USER>;

/// The users of a record: kind by kind, keys ascending, each once. Constraints of unknown load
/// factors may refer to nodes and elements that are not there; they do not count.
T_RECORD_USERS UsersOf(const T_MODEL& model, RECORD_KIND kind, int key);

/// "element 4"; "combination \"C1\"" for what has a name.
std::string DescribeUser(const T_MODEL& model, const T_RECORD_USER& user);
