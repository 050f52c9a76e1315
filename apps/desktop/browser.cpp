#include "browser.h"

#include "toolcommands.h"

#include "qm_base/msgfunction.h"

#include <QTreeWidget>

CBrowser::CBrowser(T_DESKTOP& desktop, CFrameScene& scene)
    : m_desktop(desktop),
      m_tree(new CModelTreePane(desktop.doc, scene, desktop.selection, desktop.window)),
      m_properties(new CPropertyPane(desktop.doc, desktop.window)),
      m_table(new CExplorerPane(
          desktop.doc, desktop.selection, desktop.view, [this] { m_desktop.changed(); },
          desktop.window))
{
    const auto changed = [this] { m_desktop.changed(); };
    const auto open = [this](EXPLORER_TABLE table, int key) { Open(table, key); };
    m_tree->m_changed = m_properties->m_changed = changed;
    m_tree->m_open = m_properties->m_open = m_table->m_open = open;
    m_tree->m_refused = [this](const std::string& reason) {
        m_desktop.view.ShowMessage("IDS_QM_UI_RECORD_REFUSED", reason);
    };
    m_tree->m_choose = [this](RECORD_KIND kind, int key) { Choose(kind, key); };
    m_tree->m_showTable = [this](RECORD_KIND kind) {
        m_desktop.selection.Clear();
        if (const auto table = TableOfKind(kind)) m_table->Choose(*table);
    };
    m_tree->m_showResult = [this](const T_SHAPE_SOURCE& source) {
        if (m_showResult) m_showResult(source);
    };
    m_table->m_askPath = [this] {
        const auto text = [](const char* key) {
            return QString::fromStdString(zql::lib::MMSGFunction::GetValue(key));
        };
        return AskFileName(m_desktop.window, true, text("IDS_QM_GRID_EXPORT"),
                           text("IDS_QM_UI_SECC_FILES"))
            .toStdString();
    };
    m_desktop.selection.Watch(this, [this] { ShowSelection(); });
}

CBrowser::~CBrowser()
{
    m_desktop.selection.Unwatch(this);
}

/// Options of the model and of the push are in no table: the properties alone show them.
void CBrowser::Choose(RECORD_KIND kind, int key)
{
    if (const auto table = TableOfKind(kind)) {
        m_desktop.selection.Choose(*table, {key});
    } else {
        m_desktop.selection.Clear();
        m_properties->Model().Choose(kind, {key});
        m_properties->Refresh();
    }
}

void CBrowser::ShowSelection()
{
    m_table->ShowSelection();
    m_properties->Model().Follow(m_desktop.selection);
    m_properties->Refresh();
    const CPropertyModel& chosen = m_properties->Model();
    if (chosen.Keys().size() == 1) m_tree->Show(chosen.Kind(), chosen.Keys().front());
}

void CBrowser::Open(EXPLORER_TABLE table, int key)
{
    if (OpenRecord(m_desktop, table, key)) return m_desktop.changed();
    Choose(KindOfTable(table), key); // its properties are its window
    m_properties->Tree().setFocus();
}

void CBrowser::Refresh()
{
    m_tree->Refresh();
    m_table->Refresh();
    m_properties->Refresh();
}

void CBrowser::Retranslate()
{
    m_tree->Retranslate();
    m_table->Retranslate();
    m_properties->Retranslate();
}

void CBrowser::Add()
{
    if (m_tree->Tree().hasFocus())
        m_tree->Add();
    else
        m_table->Add();
}

void CBrowser::Delete()
{
    if (m_tree->Tree().hasFocus())
        m_tree->Delete();
    else
        m_table->Delete();
}
