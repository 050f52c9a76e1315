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

/// By the key of the command, without what all keys begin with.
const QHash<QString, QString>& Names()
{
    static const QHash<QString, QString> names{
        {"UI_NEW", "new"},
        {"NEW_CURVE_MENU", "new-curve"},
        {"NEW_FRAME_MENU", "new-frame"},
        {"NEW_STOREYS_MENU", "storeys"},
        {"NEW_SPECTRUM_MENU", "spectrum"},
        {"MODES_MENU", "mode"},
        {"TUNE_COMMAND", "stay"},
        {"UI_EXPLORER", "panes"},
        {"UI_OPEN", "open"},
        {"UI_RECENT", "recent"},
        {"UI_SAVE", "save"},
        {"UI_SAVE_AS", "save-as"},
        {"UI_EXPORT_CASE", "export"},
        {"UI_EXPORT_PICTURE", "picture"},
        {"UI_PRINT", "print"},
        {"UI_REPORT_COMMAND", "report"},
        {"UI_EXIT", "exit"},
        {"UI_UNDO", "undo"},
        {"UI_REDO", "redo"},
        {"UI_ADD_RECORD", "add"},
        {"UI_DELETE_RECORD", "delete"},
        {"UI_PREFERENCES", "settings"},
        {"UI_SECT_MENU", "section"},
        {"UI_MATL_MENU", "material"},
        {"UI_SECC_CMD", "curve"},
        {"UI_ANALYSE", "analyse"},
        {"UI_HINGE_TYPES", "hinge-types"},
        {"UI_HINGES_GENERATED", "hinge"},
        {"UI_GEN_MENU", "hinge-code"},
        {"UI_HINGE_TABLE", "table"},
        {"UI_HINGE_OPTIONS_CMD", "settings"},
        {"UI_POLC_LIST", "load-case"},
        {"UI_POGC_MENU", "settings"},
        {"UI_POFC_MENU", "load"},
        {"UI_PUSH_RUN", "push"},
        {"UI_PUSH_STATES", "states"},
        {"UI_PUSH_STOREYS", "storeys"},
        {"UI_PUSH_CURVE", "curve"},
        {"UI_PUSH_NEW_CURVE", "spectrum"},
        {"UI_PUSH_COMPARE_ALL", "compare"},
        {"UI_ULF_ITEMS", "stay"},
        {"UI_ULF_CONSTRAINTS", "constraint"},
        {"UI_ULF_ITER_SETTINGS", "settings"},
        {"UI_ULF_ITERATE", "iterate"},
        {"UI_VIEW_ISO", "iso"},
        {"UI_VIEW_XZ", "front"},
        {"UI_VIEW_YZ", "side"},
        {"UI_VIEW_XY", "plan"},
        {"UI_VIEW_NODES", "node"},
        {"UI_VIEW_ELEMENTS", "element"},
        {"UI_VIEW_SUPPORTS", "support"},
        {"UI_VIEW_HINGES", "hinge"},
        {"UI_VIEW_DRIFTS", "drift"},
        {"UI_VIEW_BEFORE", "undeformed"},
        {"UI_START_PAGE", "home"},
        {"UI_HELP", "help"},
        {"UI_WHATS_THIS", "whats-this"},
        {"UI_ABOUT", "info"},
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
    return Names().value(QString(commandKey).remove("IDS_QM_"));
}
