// Why the engine refuses, in words that the message catalogue has.
#pragma once

#include <string>
#include <utility>
#include <vector>

namespace solver {

/// The key of a text in the message catalogue, and what its places take: further reasons, numbers
/// or names. What the catalogue does not have stands for itself.
struct T_SOLVER_REASON {
    T_SOLVER_REASON() = default;
    T_SOLVER_REASON(std::string itsKey, std::vector<T_SOLVER_REASON> itsArgs = {})
        : key(std::move(itsKey)), args(std::move(itsArgs))
    {
    }
    T_SOLVER_REASON(const char* itsKey) : key(itsKey) {}

    bool empty() const { return key.empty(); }
    /// In the language of the user.
    std::string Text() const;

    std::string key;
    std::vector<T_SOLVER_REASON> args;
};

} // namespace solver
