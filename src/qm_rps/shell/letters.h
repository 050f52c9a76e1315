// The letters by which entries of a menu, or fields of a form, are reached with Alt.
#pragma once

#include <string>
#include <vector>

/// The texts with '&' before a letter of their own each: one that a text brings stays where it is
/// the first to have it; others get the first free one, of the beginnings of words before those
/// within. "&&" is a sign, not a letter's mark. A text whose letters are all taken, or that has
/// none, has no mark; an empty one (a line of a menu) stays empty.
std::vector<std::string> WithLetters(const std::vector<std::string>& texts);
