#include "qm_ui/form/localnumber.h"

#include "qm_base/textformat.h"

#include <QLocale>

QString LocalNumberText(const std::string& plain)
{
    QString text = QString::fromStdString(plain);
    return text.replace(QLatin1Char('.'), QLocale().decimalPoint());
}

std::string PlainNumberText(const QString& typed)
{
    QString text = typed.trimmed();
    const QString point = QLocale().decimalPoint();
    if (point != QLatin1String(".") && !text.contains(QLatin1Char('.')))
        text.replace(point, QLatin1String("."));
    return text.toStdString();
}

std::optional<double> ParseLocalNumber(const QString& typed)
{
    return ParseFinite(PlainNumberText(typed));
}
