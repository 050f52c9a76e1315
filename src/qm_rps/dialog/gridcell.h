// How cells of a table are shown and taken.
#pragma once

/// Numbers: the model's text has '.', a view shows the locale's separator. Flags: "1" and "0".
/// Choices: one of the texts that the model lists.
enum class CELL_KIND { Text, Number, Flag, Choice };
