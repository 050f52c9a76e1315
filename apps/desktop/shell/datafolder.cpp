#include "shell/datafolder.h"

#include <QCoreApplication>
#include <QDir>

QString DataFolder(const QString& name)
{
    const QString program = QCoreApplication::applicationDirPath();
    // A build folder lies up to four levels below its sources: build/release/bin.
    for (const char* way :
         {"/../share/qm-rps/", "/", "/../", "/../../", "/../../../", "/../../../../"}) {
        const QDir folder(program + QLatin1String(way) + name);
        if (folder.exists()) return QDir::cleanPath(folder.absolutePath());
    }
    return {};
}
