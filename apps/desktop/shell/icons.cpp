#include "shell/icons.h"

#include <QApplication>
#include <QFile>
#include <QHash>
#include <QIconEngine>
#include <QPainter>
#include <QPalette>
#include <QSvgRenderer>

namespace {

class CDrawnEngine : public QIconEngine {
public:
    explicit CDrawnEngine(QByteArray drawing) : m_drawing(std::move(drawing)) {}

    void paint(QPainter* painter, const QRect& rect, QIcon::Mode mode, QIcon::State) override
    {
        const auto group = mode == QIcon::Disabled ? QPalette::Disabled : QPalette::Active;
        const auto role =
            mode == QIcon::Selected ? QPalette::HighlightedText : QPalette::ButtonText;
        QByteArray drawing = m_drawing;
        drawing.replace("currentColor", QApplication::palette().color(group, role).name().toUtf8());
        QSvgRenderer(drawing).render(painter, rect);
    }
    QPixmap pixmap(const QSize& size, QIcon::Mode mode, QIcon::State state) override
    {
        QPixmap out(size);
        out.fill(Qt::transparent);
        QPainter painter(&out);
        paint(&painter, QRect({0, 0}, size), mode, state);
        return out;
    }
    QIconEngine* clone() const override { return new CDrawnEngine(m_drawing); }
    bool isNull() override { return m_drawing.isEmpty(); }

private:
    QByteArray m_drawing;
};

const QHash<QString, QString>& Names()
{
    static const QHash<QString, QString> names{
        {"IDS_QM_UI_NEW", "new"},
        {"IDS_QM_UI_NEW_CURVE", "new-curve"},
        {"IDS_QM_UI_NEW_FRAME", "new-frame"},
        {"IDS_QM_UI_OPEN", "open"},
        {"IDS_QM_UI_RECENT", "recent"},
        {"IDS_QM_UI_SAVE", "save"},
        {"IDS_QM_UI_SAVE_AS", "save-as"},
        {"IDS_QM_UI_EXPORT_CASE", "export"},
        {"IDS_QM_UI_EXPORT_PICTURE", "picture"},
        {"IDS_QM_UI_PRINT", "print"},
        {"IDS_QM_UI_REPORT_COMMAND", "report"},
        {"IDS_QM_UI_EXIT", "exit"},
        {"IDS_QM_UI_UNDO", "undo"},
        {"IDS_QM_UI_REDO", "redo"},
        {"IDS_QM_UI_ADD_RECORD", "add"},
        {"IDS_QM_UI_DELETE_RECORD", "delete"},
        {"IDS_QM_UI_PREFERENCES", "settings"},
        {"IDS_QM_UI_SECT_MENU", "section"},
        {"IDS_QM_UI_MATL_MENU", "material"},
        {"IDS_QM_UI_SECC_CMD", "curve"},
        {"IDS_QM_UI_ANALYSE", "analyse"},
        {"IDS_QM_UI_HINGE_TYPES", "hinge-types"},
        {"IDS_QM_UI_HINGES_GENERATED", "hinge"},
        {"IDS_QM_UI_GEN_MENU", "hinge-code"},
        {"IDS_QM_UI_HINGE_TABLE", "table"},
        {"IDS_QM_UI_HINGE_OPTIONS_CMD", "settings"},
        {"IDS_QM_UI_POLC_LIST", "load-case"},
        {"IDS_QM_UI_POGC_MENU", "settings"},
        {"IDS_QM_UI_POFC_MENU", "load"},
        {"IDS_QM_UI_PUSH_RUN", "push"},
        {"IDS_QM_UI_PUSH_STATES", "states"},
        {"IDS_QM_UI_PUSH_STOREYS", "storeys"},
        {"IDS_QM_UI_PUSH_CURVE", "curve"},
        {"IDS_QM_UI_PUSH_NEW_CURVE", "spectrum"},
        {"IDS_QM_UI_PUSH_COMPARE_ALL", "compare"},
        {"IDS_QM_UI_ULF_ITEMS", "stay"},
        {"IDS_QM_UI_ULF_CONSTRAINTS", "constraint"},
        {"IDS_QM_UI_ULF_ITER_SETTINGS", "settings"},
        {"IDS_QM_UI_ULF_ITERATE", "iterate"},
        {"IDS_QM_UI_VIEW_ISO", "iso"},
        {"IDS_QM_UI_VIEW_XZ", "front"},
        {"IDS_QM_UI_VIEW_YZ", "side"},
        {"IDS_QM_UI_VIEW_XY", "plan"},
        {"IDS_QM_UI_VIEW_NODES", "node"},
        {"IDS_QM_UI_VIEW_ELEMENTS", "element"},
        {"IDS_QM_UI_VIEW_SUPPORTS", "support"},
        {"IDS_QM_UI_VIEW_HINGES", "hinge"},
        {"IDS_QM_UI_VIEW_DRIFTS", "drift"},
        {"IDS_QM_UI_VIEW_BEFORE", "undeformed"},
        {"IDS_QM_UI_START_PAGE", "home"},
        {"IDS_QM_UI_HELP", "help"},
        {"IDS_QM_UI_WHATS_THIS", "whats-this"},
        {"IDS_QM_UI_ABOUT", "info"},
    };
    return names;
}

} // namespace

QIcon DrawnIcon(const QString& name)
{
    QFile file(":/icons/" + name + ".svg");
    if (name.isEmpty() || !file.open(QIODevice::ReadOnly)) return {};
    return QIcon(new CDrawnEngine(file.readAll())); // the icon owns its engine
}

QString IconOf(const QString& commandKey)
{
    return Names().value(commandKey);
}
