#include "shell/about.h"

#include "shell/icons.h"
#include "shell/libraries.h"

#include "qm_base/say.h"

#include <QCoreApplication>
#include <QMessageBox>
#include <QPushButton>

QString AboutText()
{
    const auto cell = [](const std::string& text) {
        return "<td style='padding-right:18px'>" + QString::fromStdString(text).toHtmlEscaped() +
               "</td>";
    };
    QString rows = "<tr>";
    for (const char* head :
         {"IDS_QM_ABOUT_LIBRARY", "IDS_QM_ABOUT_VERSION", "IDS_QM_ABOUT_LICENCE"})
        rows += "<th align='left'>" + QString::fromStdString(Say(head)).toHtmlEscaped() + "</th>";
    rows += "</tr>";
    for (const T_LIBRARY& library : UsedLibraries())
        rows +=
            "<tr>" + cell(library.name) + cell(library.version) + cell(library.licence) + "</tr>";
    const std::string version = QCoreApplication::applicationVersion().toStdString();
    return QStringLiteral("<h2>%1</h2><p>%2</p><p>%3</p><table>%4</table><p>%5</p>")
        .arg(QString::fromStdString(Say("IDS_QM_ABOUT_HEAD", Say("IDS_QM_PRODUCT"), version)),
             QString::fromStdString(Say("IDS_QM_START_SUBTITLE")),
             QString::fromStdString(Say("IDS_QM_ABOUT_RIGHTS")), rows,
             QString::fromStdString(Say("IDS_QM_ABOUT_NOTE")));
}

void ShowAbout(QWidget* parent)
{
    QMessageBox box(QMessageBox::NoIcon, QString::fromStdString(Say("IDS_QM_ABOUT_TITLE")),
                    AboutText(), QMessageBox::Close, parent);
    box.setTextFormat(Qt::RichText);
    box.setTextInteractionFlags(Qt::TextSelectableByMouse | Qt::TextSelectableByKeyboard);
    box.setIconPixmap(DrawnIcon("app").pixmap(64));
    box.button(QMessageBox::Close)->setText(QString::fromStdString(Say("IDS_QM_UI_CLOSE")));
    box.exec();
}
