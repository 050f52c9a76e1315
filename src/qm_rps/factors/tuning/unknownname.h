// Which unknown a person means by a name.
#pragma once

#include <string>
#include <vector>

/// Indices of the unknowns with this whole name; without any, of those whose load case (the last
/// word, or words, behind a blank) has it: more than one where the name says too little.
std::vector<std::size_t> UnknownsNamed(const std::vector<std::string>& wholeNames,
                                       const std::string& name);
