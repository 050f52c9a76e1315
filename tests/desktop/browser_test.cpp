// Tree, properties and tables of the main window: records of every kind are made, edited, sorted,
// found and exported, and one selection is in all of them.
#include "desktoptest.h"
#include "recordtableview.h"

#include "qm_db/editscope.h"
#include "qm_db/recordform.h"

#include <QClipboard>
#include <QElapsedTimer>
#include <QFile>
#include <QFileInfo>
#include <QGuiApplication>
#include <QLineEdit>
#include <QSpinBox>
#include <QTreeWidget>

using namespace desktop_test;

namespace {

class Browser : public DesktopTest {
protected:
    Browser() { EXPECT_TRUE(Open("rc-frame-3-storey")); }
    CModelTreePane& Tree() { return m_main->Browser().Tree(); }
    CPropertyPane& Properties() { return m_main->Browser().Properties(); }
    CExplorerPane& Table() { return m_main->Explorer(); }

    QTreeWidgetItem* Item(QTreeWidget& tree, const QString& text)
    {
        for (QTreeWidgetItemIterator it(&tree); *it; ++it)
            if ((*it)->text(0).startsWith(text)) return *it;
        ADD_FAILURE() << "no item " << text.toStdString();
        return tree.topLevelItem(0);
    }
    /// Chooses the node of a kind, whatever is above it.
    void ChooseKind(RECORD_KIND kind)
    {
        const QString title = QString::fromStdString(TitleOfKind(kind)) + " (";
        Tree().Tree().setCurrentItem(Item(Tree().Tree(), title));
    }
    /// Types over a value of the properties and leaves it, as by the keyboard.
    void SetProperty(const QString& path, const QString& text)
    {
        QTreeWidget& tree = Properties().Tree();
        for (QTreeWidgetItemIterator it(&tree); *it; ++it) {
            if ((*it)->toolTip(0) != path) continue;
            (*it)->setText(1, text);
            return Settle();
        }
        ADD_FAILURE() << "no property " << path.toStdString();
    }
};

} // namespace

TEST_F(Browser, ARecordOfEveryKindIsMadeInTheTreeAndSaved)
{
    std::map<RECORD_KIND, std::size_t> counts;
    for (const RECORD_KIND kind : AllKinds()) {
        if (!TableOfKind(kind)) continue;
        const std::size_t before = KeysOf(Model(), kind).size();
        ChooseKind(kind);
        Key(&Tree().Tree(), Qt::Key_Insert);
        Settle();
        ASSERT_EQ(before + 1, KeysOf(Model(), kind).size()) << KindWord(kind);
        counts[kind] = before + 1;
        const CPropertyModel& shown = Properties().Model();
        EXPECT_TRUE(shown.Kind() == kind && shown.Keys().size() == 1) << KindWord(kind);
    }
    EXPECT_EQ(22u, counts.size());
    AnswerFileName(File("made.qmdb"));
    Run("IDS_QM_UI_SAVE_AS");
    ASSERT_TRUE(m_main->Open(File("made.qmdb")));
    for (const auto& [kind, count] : counts)
        EXPECT_EQ(count, KeysOf(Model(), kind).size()) << KindWord(kind);
    EXPECT_EQ("", m_main->Doc().Data().Fault());
}

TEST_F(Browser, ThePropertiesOfTheChosenRecordsAreEditedInOneStep)
{
    m_main->Desktop().selection.Choose(EXPLORER_TABLE::Nodes, {21, 22});
    EXPECT_TRUE(Properties().Model().Title().find("2") != std::string::npos);
    EXPECT_EQ("(various)", Item(Properties().Tree(), "Coordinates")->text(1));
    EXPECT_EQ("in", Item(Properties().Tree(), "Coordinates")->text(2));
    SetProperty("mass", "1, 2, 3");
    EXPECT_EQ(Model().nodes.at(21).mass, Model().nodes.at(22).mass);
    EXPECT_NE(0.0, Model().nodes.at(21).mass[1]);
    Run("IDS_QM_UI_UNDO");
    EXPECT_EQ(0.0, Model().nodes.at(21).mass[1]);
    EXPECT_FALSE(m_main->Doc().Undo().CanUndo());

    SetProperty("mass", "1, 2"); // three are needed
    EXPECT_NE("", Properties().Model().Reason());
    EXPECT_FALSE(m_main->Doc().Undo().CanUndo());

    Tree().Tree().setCurrentItem(Item(Tree().Tree(), "Model options"));
    SetProperty("title", "Changed");
    EXPECT_EQ("Changed", Model().styp.title);
}

TEST_F(Browser, OneSelectionIsInTreeTableAndProperties)
{
    m_main->Desktop().selection.Choose(EXPLORER_TABLE::Sections, {2});
    EXPECT_EQ(EXPLORER_TABLE::Sections, Table().Chosen());
    EXPECT_EQ(std::set<int>{2}, Table().Table().ChosenKeys());
    EXPECT_EQ("beam", Tree().Tree().currentItem()->text(0));
    Table().Table().ChooseKeys({1, 2}); // as the mouse does
    EXPECT_EQ((CSelection::T_KEYS{1, 2}),
              m_main->Desktop().selection.Chosen(EXPLORER_TABLE::Sections));
    EXPECT_EQ((std::vector<int>{1, 2}), Properties().Model().Keys());
    Tree().Show(KindOf<T_SECT_D>(), 1);
    Tree().ShowOnly();
    for (const int id : m_main->Desktop().selection.Hidden())
        EXPECT_NE(1, Model().elements.at(id).section);
    EXPECT_FALSE(m_main->Desktop().selection.Hidden().empty());
}

TEST_F(Browser, RecordsAreRenamedFoundAndDeletedInTheTree)
{
    m_main->Desktop().selection.Choose(EXPLORER_TABLE::Sections, {1});
    Tree().Tree().currentItem()->setText(0, "beam"); // taken
    CAnswers answers({CAnswers::Accept()});
    Settle();
    EXPECT_TRUE(answers.m_texts.value(0).contains("beam"));
    EXPECT_EQ("column", Model().sections.at(1).name);
    Tree().Tree().currentItem()->setText(0, "pillar");
    Settle();
    EXPECT_EQ("pillar", Model().sections.at(1).name);
    Tree().Filter().setText("PILL");
    EXPECT_EQ(1, Item(Tree().Tree(), "Sections")->childCount());
    Tree().Filter().clear();
    Tree().Duplicate();
    EXPECT_EQ(3u, Model().sections.size());
    Tree().Delete();
    EXPECT_EQ(2u, Model().sections.size());
}

TEST_F(Browser, TheEnterThatEndsANameOpensNoWindow)
{
    Tree().Show(KindOf<T_MATL_D>(), 1);
    Tree().Rename();
    auto* const editor = Tree().Tree().viewport()->findChild<QLineEdit*>();
    ASSERT_TRUE(editor);
    CAnswers none({});
    editor->setText("C16");
    Key(editor, Qt::Key_Return);
    Settle();
    EXPECT_EQ("C16", Model().materials.at(1).name);
}

TEST_F(Browser, ATableIsSortedFilteredShownWithDecimalsAndCopiedWhole)
{
    Table().Choose(EXPLORER_TABLE::Nodes);
    CRecordTableView& table = Table().Table();
    EXPECT_EQ("11", Cell(table.Model(), 0, 0));
    table.SortBy(3); // Z rising, then falling, then by number
    table.SortBy(3);
    EXPECT_EQ("504", Cell(table.Model(), 0, 3));
    ASSERT_TRUE(SetCell(table.Model(), 0, 3, "505"));
    EXPECT_EQ(505 * 0.0254, Model().nodes.at(41).xyz[2]);
    table.SortBy(3);
    EXPECT_EQ("11", Cell(table.Model(), 0, 0));
    Table().Filter().setText("505");
    EXPECT_EQ(1, table.Model().rowCount());
    Table().Decimals().setValue(2);
    table.selectAll();
    Key(&table, Qt::Key_C, {}, Qt::ControlModifier | Qt::ShiftModifier);
    const QStringList lines = QGuiApplication::clipboard()->text().split('\n');
    ASSERT_EQ(2, lines.size());
    EXPECT_TRUE(lines[0].contains("X (in)"));
    EXPECT_TRUE(lines[1].contains("0.0608850931677")) << "all digits";
    AnswerFileName(File("nodes.csv"));
    Table().Export();
    QFile csv(File("nodes.csv"));
    ASSERT_TRUE(csv.open(QIODevice::ReadOnly));
    EXPECT_EQ(2, csv.readAll().trimmed().split('\n').size());
    AnswerFileName(File("nodes.xlsx"));
    Table().Export();
    EXPECT_GT(QFileInfo(File("nodes.xlsx")).size(), 1000);
}

TEST_F(Browser, AMillionCellsAreSortedAndFoundAtOnce)
{
    constexpr int kNodes = 100000; // of ten cells
    CEditScope edit(m_main->Doc(), "many");
    for (int id = 1000; id < 1000 + kNodes; ++id) {
        T_NODE_D node;
        node.id = id;
        node.xyz[0] = kNodes - id;
        ASSERT_TRUE(edit.Put(id, node));
    }
    ASSERT_TRUE(edit.Commit());
    m_main->Refresh();
    Table().Choose(EXPLORER_TABLE::Nodes);
    EXPECT_GE(Table().Table().Model().columnCount() * kNodes, 1000000);
    QElapsedTimer clock;
    clock.start();
    Table().Table().SortBy(1);
    const qint64 sorted = clock.restart();
    Table().Filter().setText("98765");
    const qint64 found = clock.restart();
    RecordProperty("sort_ms", static_cast<int>(sorted));
    RecordProperty("filter_ms", static_cast<int>(found));
    EXPECT_LT(0, Table().Table().Model().rowCount());
    EXPECT_GT(100, Table().Table().Model().rowCount());
    Tree().Tree().expandItem(Item(Tree().Tree(), "Nodes"));
    EXPECT_EQ(201, Item(Tree().Tree(), "Nodes")->childCount());
}
