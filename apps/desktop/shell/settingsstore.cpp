#include "shell/settingsstore.h"

#include <QSettings>
#include <QString>

std::string CSettingsStore::Get(const std::string& key) const
{
    return QSettings().value(QString::fromStdString(key)).toString().toStdString();
}

void CSettingsStore::Set(const std::string& key, const std::string& value)
{
    QSettings().setValue(QString::fromStdString(key), QString::fromStdString(value));
}
