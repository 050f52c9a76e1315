#include "shell/helptopics.h"

#include "shell/datafolder.h"

#include "qm_base/say.h"

#include <QDir>
#include <QFile>
#include <QRegularExpression>
#include <QWidget>

#include <utility>

namespace {

/// Titles of windows, or names of panes, and the sections that explain them.
constexpr std::pair<const char*, const char*> kTopics[] = {
    {"IDS_QM_UI_PUSH_RUN_TITLE", "the-windows-of-a-push"},
    {"IDS_QM_UI_PUSH_STATES_TITLE", "the-windows-of-a-push"},
    {"IDS_QM_UI_STOREY_TITLE", "the-windows-of-a-push"},
    {"IDS_QM_UI_JUDGE_TITLE", "judgement-of-member-ends"},
    {"IDS_QM_UI_PUSH_TITLE", "the-evaluation-window"},
    {"IDS_QM_UI_PUSH_CURVE_TITLE", "the-evaluation-window"},
    {"IDS_QM_UI_PUSH_COMPARE_TITLE", "methods"},
    {"IDS_QM_UI_POLC_TITLE", "setting-a-push-up"},
    {"IDS_QM_UI_POLC_TITLE_LIST", "setting-a-push-up"},
    {"IDS_QM_UI_POLC_TITLE_SELECT", "setting-a-push-up"},
    {"IDS_QM_UI_POLC_EIGHT", "setting-a-push-up"},
    {"IDS_QM_UI_POGC_TITLE", "setting-a-push-up"},
    {"IDS_QM_UI_POFC_TITLE", "setting-a-push-up"},
    {"IDS_QM_UI_IEHP_TITLE", "plastic-hinges"},
    {"IDS_QM_UI_GEN_TITLE", "hinges-that-a-code-gives"},
    {"IDS_QM_UI_HINGE_LIST_TITLE", "plastic-hinges"},
    {"IDS_QM_UI_HINGE_TYPE_TITLE", "plastic-hinges"},
    {"IDS_QM_UI_HINGE_FEMA_TITLE", "plastic-hinges"},
    {"IDS_QM_UI_HINGE_EURO_TITLE", "plastic-hinges"},
    {"IDS_QM_UI_HINGE_MULTI_TITLE", "plastic-hinges"},
    {"IDS_QM_UI_HINGE_SURFACE_TITLE", "plastic-hinges"},
    {"IDS_QM_UI_HINGE_GENERATED_TITLE", "plastic-hinges"},
    {"IDS_QM_UI_HINGE_TABLE_TITLE", "plastic-hinges"},
    {"IDS_QM_UI_HINGE_OPTIONS_TITLE", "plastic-hinges"},
    {"IDS_QM_UI_HINGE_LENGTH_TITLE", "plastic-hinges"},
    {"IDS_QM_UI_SECC_TITLE", "curves-of-sections"},
    {"IDS_QM_UI_SECT_TITLE", "shapes-and-grades"},
    {"IDS_QM_UI_MATL_TITLE", "shapes-and-grades"},
    {"IDS_QM_UI_ULF_ITEMS_TITLE", "unknown-load-factors"},
    {"IDS_QM_UI_ULF_ITEM_TITLE", "unknown-load-factors"},
    {"IDS_QM_UI_ULF_RESULT_TITLE", "unknown-load-factors"},
    {"IDS_QM_UI_ULF_EXPLANATION_TITLE", "unknown-load-factors"},
    {"IDS_QM_UI_ULF_CONSTRAINT_TITLE", "unknown-load-factors"},
    {"IDS_QM_UI_TABLE_CONSTRAINTS", "unknown-load-factors"},
    {"IDS_QM_UI_LCOM_TITLE", "unknown-load-factors"},
    {"IDS_QM_TUNE_TITLE", "tuning-stays-by-hand"},
    {"IDS_QM_UI_ULF_STAGE_ITEM_TITLE", "construction-stages-and-iterated-pretension"},
    {"IDS_QM_UI_ULF_SETTINGS_TITLE", "construction-stages-and-iterated-pretension"},
    {"IDS_QM_UI_ULF_RUN_TITLE", "construction-stages-and-iterated-pretension"},
    {"IDS_QM_UI_ULF_STEP_TITLE", "construction-stages-and-iterated-pretension"},
    {"IDS_QM_UI_REPORT_WINDOW", "the-report"},
    {"IDS_QM_PREF_TITLE", "preferences"},
    {"IDS_QM_NEW_CURVE_TITLE", "a-model-from-a-capacity-curve"},
    {"IDS_QM_NEW_FRAME_TITLE", "a-regular-frame"},
    {"IDS_QM_NEW_SPECTRUM_TITLE", "spectra"},
    {"IDS_QM_NEW_STOREYS_TITLE", "storeys-from-levels"},
    {"IDS_QM_MODES_TITLE", "modes"},
    {"IDS_QM_UI_EXPLORER", "the-tree"},
    {"IDS_QM_UI_PROPERTIES", "properties"},
    {"IDS_QM_UI_TABLES", "tables"},
    {"IDS_QM_VIEW_RESULTS", "tables-of-results"},
};
constexpr const char* kDesktop = "the-desktop";

/// Headings of a page, as they are written.
QStringList HeadingsOf(const QString& page)
{
    QFile file(page);
    if (!file.open(QIODevice::ReadOnly)) return {};
    QStringList out;
    bool isCode = false; // lines that begin with # there are comments of a shell
    for (const QString& line : QString::fromUtf8(file.readAll()).split('\n')) {
        if (line.startsWith("```")) isCode = !isCode;
        if (!isCode && line.startsWith('#')) out << line.mid(line.indexOf(' ') + 1);
    }
    return out;
}

} // namespace

QString AnchorOf(const QString& heading)
{
    static const QRegularExpression dropped("[^\\w\\- ]",
                                            QRegularExpression::UseUnicodePropertiesOption);
    return heading.trimmed().toLower().remove(dropped).replace(' ', '-');
}

QString TopicOf(const QWidget* focused)
{
    if (!focused) return kDesktop;
    const QString title = focused->window()->windowTitle();
    for (const auto& [key, topic] : kTopics)
        if (title == QString::fromStdString(Say(key))) return topic;
    // A section may have the title of the window that it explains.
    const QString own = AnchorOf(title);
    return own.isEmpty() || PageWith(own).isEmpty() ? QString(kDesktop) : own;
}

QStringList HelpTopics()
{
    QStringList out{kDesktop};
    for (const auto& [key, topic] : kTopics)
        out << topic;
    out.removeDuplicates();
    return out;
}

QStringList GuidePages()
{
    const QString docs = DataFolder("docs");
    if (docs.isEmpty()) return {};
    QStringList out;
    const QDir guide(docs + "/guide");
    if (guide.exists("README.md")) out << guide.filePath("README.md");
    for (const QString& name : guide.entryList({"*.md"}, QDir::Files, QDir::Name))
        if (name != "README.md") out << guide.filePath(name);
    for (const char* name : {"user-guide.md", "file-formats.md", "verification.md"})
        if (QFile::exists(docs + "/" + name)) out << docs + "/" + name;
    return out;
}

QString PageWith(const QString& anchor)
{
    for (const QString& page : GuidePages())
        for (const QString& heading : HeadingsOf(page))
            if (AnchorOf(heading) == anchor) return page;
    return {};
}
