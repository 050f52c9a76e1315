#include "qm_rps/mainframe.h"

#include "tempfolder.h"

#include <gtest/gtest.h>

namespace {

using zql::frx::ANSWER;

/// Answers every question with the same word, and counts them.
class CAnswers : public zql::frx::IDialogView {
public:
    ANSWER m_answer = ANSWER::Cancel;
    int m_asked = 0;
    void ShowMessage(const std::string&, const std::string&) override {}
    bool AskYesNo(const std::string&, const std::string&) override
    {
        ++m_asked;
        return m_answer == ANSWER::Yes;
    }
    ANSWER AskYesNoCancel(const std::string&, const std::string&) override
    {
        ++m_asked;
        return m_answer;
    }
    int RunModal(zql::frx::MDialog&) override { return 0; }
};

/// A window on a saved model with one node, and what its session has left in the folder.
class MainFrame : public testing::Test {
protected:
    struct T_WINDOW {
        explicit T_WINDOW(const std::string& untitled) : frame(doc, untitled)
        {
            frame.SetView(&answers);
        }
        CDBDoc doc;
        CAnswers answers;
        CMainFrame frame;
    };
    MainFrame()
    {
        m_window = std::make_unique<T_WINDOW>(m_untitled);
        Move(1.0);
        EXPECT_EQ(1, m_window->frame.OnSaveAs(m_file));
    }
    void Move(double x)
    {
        T_NODE_D node;
        node.id = 1;
        node.xyz[0] = x;
        ASSERT_EQ(1, m_window->doc.Edit().Begin("move"));
        ASSERT_EQ(1, m_window->doc.Edit().Put(1, node));
        ASSERT_EQ(1, m_window->doc.Edit().Commit());
    }
    /// Moves the node, and long enough after that a copy is written.
    void Keep(double x)
    {
        Move(x);
        m_window->frame.OnTick(m_nowS);
        m_window->frame.OnTick(m_nowS += 100.0);
        ASSERT_EQ(1, Copies());
    }
    int Copies() const
    {
        int count = 0;
        for (const std::string& name : m_folder.Names())
            count += name.find(".auto-") != std::string::npos;
        return count;
    }
    /// A new program after a crash; how often it asks, with this answer.
    int Restart(ANSWER answer)
    {
        m_window.reset();
        m_window = std::make_unique<T_WINDOW>(m_untitled);
        m_window->answers.m_answer = answer;
        (void)!m_window->frame.OnStart({m_file});
        return m_window->answers.m_asked;
    }

    CTempFolder m_folder;
    std::string m_file = m_folder / "frame.qmdb";
    std::string m_untitled = m_folder / "untitled.qmdb";
    std::unique_ptr<T_WINDOW> m_window;
    double m_nowS = 0.0;
};

} // namespace

TEST_F(MainFrame, ACleanEndAfterASaveByOthersLeavesNoCopy)
{
    Keep(2.0);
    T_FILE_ERROR error; // as an iteration saves, under names of its own
    ASSERT_EQ(1, m_window->doc.SaveAs(m_folder / "frame_01.qmdb", error)) << error.text;
    EXPECT_EQ(1, m_window->frame.OnClose());
    EXPECT_EQ(0, m_window->answers.m_asked);
    EXPECT_EQ(0, Copies());
    EXPECT_EQ(0, Restart(ANSWER::Yes));
}

TEST_F(MainFrame, ACrashIsAskedAboutUntilYesOrNo)
{
    Keep(2.0);
    EXPECT_EQ(1, Restart(ANSWER::Cancel));
    EXPECT_EQ(1, Restart(ANSWER::Yes));
    EXPECT_EQ(2.0, m_window->doc.Data().Model().nodes.at(1).xyz[0]);
    EXPECT_EQ(1, Restart(ANSWER::No)); // it crashed again before the save
    EXPECT_EQ(0, Copies());
    EXPECT_EQ(0, Restart(ANSWER::Yes));
}

TEST_F(MainFrame, ASaveOverSomebodyElsesChangesIsAsked)
{
    Move(2.0);
    for (const auto& [path, isAsked] : {std::pair{m_file, 1}, {m_folder / "frame.json", 2}}) {
        ASSERT_EQ(1, m_window->frame.OnSaveAs(path));
        std::string text = ReadText(path);
        T_FILE_ERROR error;
        CDBDoc other;
        if (path == m_file) { // as a program does that knows no locks
            ASSERT_EQ(1, other.OpenModel(path, OPEN_MODE::ReadOnly, error));
            ASSERT_EQ(1, other.SaveModelAs(m_folder / "b.qmdb", error)) << error.text;
            T_NODE_D node;
            node.id = 2;
            ASSERT_EQ(1, other.Edit().Begin("add"));
            ASSERT_EQ(1, other.Edit().Put(2, node));
            ASSERT_EQ(1, other.Edit().Commit());
            ASSERT_EQ(1, other.SaveModel(error)) << error.text;
            text = ReadText(m_folder / "b.qmdb");
        } else {
            text += " ";
        }
        std::filesystem::remove(path);
        WriteText(path, text);
        Move(3.0 + isAsked);
        EXPECT_EQ(0, m_window->frame.OnSaveAs(path));
        EXPECT_EQ(text, ReadText(path));
        EXPECT_EQ(2 * isAsked - 1, m_window->answers.m_asked);
        m_window->answers.m_answer = ANSWER::Yes;
        EXPECT_EQ(1, m_window->frame.OnSaveAs(path));
        EXPECT_NE(text, ReadText(path));
        m_window->answers.m_answer = ANSWER::Cancel;
    }
}

TEST_F(MainFrame, WindowsWithDraftsAreAskedBeforeTheDocumentGoes)
{
    int asked = 0;
    bool may = false;
    m_window->frame.m_mayLeave = [&] { return ++asked, may; };
    EXPECT_EQ(0, m_window->frame.OnNew());
    EXPECT_EQ(0, m_window->frame.OnClose());
    EXPECT_EQ(2, asked);
    EXPECT_EQ(1u, m_window->doc.Data().Model().nodes.size());
    may = true;
    EXPECT_EQ(1, m_window->frame.OnClose());
}
