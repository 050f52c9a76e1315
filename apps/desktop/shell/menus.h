// Which command stands in which menu, and in what order.
#pragma once

#include "command.h"

/// Puts commands into their menus and groups, menus in the order of the work: File, Edit, Model,
/// Loads, Analysis, Hinges, Pushover, Load factors, Results, View, Window, Help. A line stands
/// between groups. Commands that the table does not know stay in the menu that they name, after
/// the others, in their own order.
void ArrangeMenus(T_COMMANDS& commands);
