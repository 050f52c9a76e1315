// Members of a parsed JSON document by their paths: "nodal/0/load/2".
#pragma once

#include "qm_db/casefile/jsonvalue.h"

#include <optional>
#include <string>
#include <vector>

using T_PATH = std::vector<std::string>;
T_PATH SplitPath(const std::string& path);
std::string JoinPath(const std::string& place, const std::string& key);

/// A number stands in a packed array, so what is found is a copy. Empty: not there.
std::optional<T_JSON> JsonAt(const T_JSON& at, const std::string& path);
/// Sets or adds a value; objects on the way are made, an array takes an index up to its length and
/// one of numbers is filled with 0 up to it. False: the path leads nowhere.
bool PutJson(T_JSON& at, const std::string& path, T_JSON value);
/// False: there is no such member or item.
bool RemoveJson(T_JSON& at, const std::string& path);
/// On one line, numbers shortest.
std::string JsonLine(const T_JSON& value);
