// A parsed JSON document, compact: an array of numbers is one packed vector.
#pragma once

#include <string>
#include <variant>
#include <vector>

struct T_JSON;
struct T_JSON_MEMBER;
using T_JSON_NUMBERS = std::vector<double>;        // an array that holds numbers only, or nothing
using T_JSON_ITEMS = std::vector<T_JSON>;          // any other array
using T_JSON_MEMBERS = std::vector<T_JSON_MEMBER>; // an object, in the order of the text

/// One value; monostate is null. Numbers are finite.
struct T_JSON {
    std::variant<std::monostate, bool, double, std::string, T_JSON_NUMBERS, T_JSON_ITEMS,
                 T_JSON_MEMBERS>
        data;
};

struct T_JSON_MEMBER {
    std::string key;
    T_JSON value;
};
