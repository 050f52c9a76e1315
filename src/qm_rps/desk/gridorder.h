// Rows of tables in the order of a column, and those that hold a text.
#pragma once

#include <string>
#include <vector>

/// Sorts keys by their texts: numbers as numbers, before texts; equal ones stay in their order.
void OrderKeys(std::vector<int>& keys, bool falling, const std::vector<std::string>& texts);

/// Whether the text holds the part, whatever the case of its letters is.
bool HoldsText(const std::string& text, const std::string& part);
