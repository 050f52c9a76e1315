// Where the files that come with the program lie.
#pragma once

#include <QString>

/// The folder "examples" or "docs": of the installation (share/qm-rps beside the program's folder),
/// beside the program, or in the tree that the program was built in. Empty: none of them is there.
QString DataFolder(const QString& name);
