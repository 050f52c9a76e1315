#include "tempfolder.h"

#include "qm_db/autosave.h"
#include "qm_db/dbdoc.h"

#include <filesystem>
#include <gtest/gtest.h>

namespace fs = std::filesystem;

namespace {

/// A document with one node, saved; copies beside it by a clock of the test's own.
class Autosave : public testing::Test {
protected:
    Autosave()
    {
        Move(1.0);
        T_FILE_ERROR error;
        EXPECT_EQ(1, m_doc->SaveAs(m_file, error)) << error.text;
        m_autosave = std::make_unique<CAutosave>(*m_doc);
        m_autosave->Follow(m_file);
    }
    void Move(double x)
    {
        T_NODE_D node;
        node.id = 1;
        node.xyz[0] = x;
        ASSERT_EQ(1, m_doc->Edit().Begin("move"));
        ASSERT_EQ(1, m_doc->Edit().Put(1, node));
        ASSERT_EQ(1, m_doc->Edit().Commit());
    }
    AUTOSAVE Tick(double nowS)
    {
        T_FILE_ERROR error;
        return m_autosave->Tick(nowS, error);
    }
    /// Ticks until a copy of this place of the node is written.
    void Keep(double x)
    {
        Move(x);
        (void)Tick(m_nowS);
        m_nowS += 100.0;
        ASSERT_EQ(AUTOSAVE::Written, Tick(m_nowS));
    }
    /// The process ends: nothing is saved or removed, locks go.
    void Crash()
    {
        m_autosave.reset();
        m_doc.reset();
        m_doc = std::make_unique<CDBDoc>();
    }
    std::vector<long> Sequences() const
    {
        std::vector<long> out;
        for (const auto& copy : CAutosave::Find(m_file))
            out.push_back(copy.sequence);
        return out;
    }
    double Recovered()
    {
        T_AUTOSAVE_COPY copy;
        T_FILE_ERROR error;
        if (!CAutosave::Newest(m_file, copy) || !m_doc->RecoverModel(copy.path, m_file, error))
            return -1.0;
        return m_doc->Data().Model().nodes.at(1).xyz[0];
    }
    /// Of the session that has written them all.
    std::string CopyPath(long sequence) const
    {
        for (const std::string& name : m_folder.Names())
            if (name.find(".auto-") != std::string::npos)
                return m_folder / (name.substr(0, name.rfind('-') + 1) + std::to_string(sequence));
        return {};
    }
    void Damage(long sequence) const
    {
        const std::string path = CopyPath(sequence);
        std::string bytes = ReadText(path);
        std::fill(bytes.begin() + 4096, bytes.end(), '\x5a'); // all pages but the first
        WriteText(path, bytes);
    }

    CTempFolder m_folder;
    std::string m_file = m_folder / "frame.qmdb";
    std::unique_ptr<CDBDoc> m_doc = std::make_unique<CDBDoc>();
    std::unique_ptr<CAutosave> m_autosave;
    double m_nowS = 0.0;
};

} // namespace

TEST_F(Autosave, WritesAtMostEveryTwentySecondsAndOnlyWhatChanged)
{
    EXPECT_EQ(AUTOSAVE::Nothing, Tick(0.0));
    EXPECT_EQ(AUTOSAVE::Nothing, Tick(1000.0)); // nothing has changed
    Move(2.0);
    EXPECT_EQ(AUTOSAVE::Written, Tick(1001.0));
    Move(3.0);
    EXPECT_EQ(AUTOSAVE::Nothing, Tick(1020.0));
    EXPECT_EQ(AUTOSAVE::Written, Tick(1022.0));
    EXPECT_EQ(AUTOSAVE::Nothing, Tick(2000.0));
    Move(4.0);
    ASSERT_EQ(1, m_doc->Edit().Begin("half")); // of an edit nothing is kept
    EXPECT_EQ(AUTOSAVE::Nothing, Tick(3000.0));
    m_doc->Edit().Rollback();
    EXPECT_EQ(AUTOSAVE::Written, Tick(3001.0));
}

TEST_F(Autosave, AnotherIntervalHoldsAtOnce)
{
    EXPECT_EQ(AUTOSAVE::Nothing, Tick(0.0));
    m_autosave->SetInterval(60.0);
    Move(2.0);
    EXPECT_EQ(AUTOSAVE::Nothing, Tick(30.0));
    m_autosave->SetInterval(5.0);
    EXPECT_EQ(AUTOSAVE::Written, Tick(30.0));
}

TEST_F(Autosave, KeepsThreeAndNumbersGoOn)
{
    for (const double x : {2.0, 3.0, 4.0, 5.0, 6.0})
        Keep(x);
    EXPECT_TRUE(CAutosave::Find(m_file).empty()) << "in use, not left by a crash";
    Crash();
    EXPECT_EQ((std::vector<long>{5, 4, 3}), Sequences());
    EXPECT_EQ(6.0, Recovered());
    EXPECT_TRUE(m_doc->Data().IsModified());
    EXPECT_EQ(m_file, m_doc->Path());
}

TEST_F(Autosave, TheCopyIsChosenByNumberAndChecksumNotByDate)
{
    for (const double x : {2.0, 3.0, 4.0})
        Keep(x);
    Crash();
    fs::last_write_time(CopyPath(1), fs::file_time_type::clock::now());
    fs::last_write_time(CopyPath(3), fs::file_time_type());
    EXPECT_EQ(4.0, Recovered());
    Damage(3);
    EXPECT_EQ(3.0, Recovered());
    fs::resize_file(CopyPath(2), 0);
    EXPECT_EQ(2.0, Recovered());
    Damage(1);
    EXPECT_EQ(-1.0, Recovered());
}

TEST_F(Autosave, ASecondCrashDuringRecoveryLosesNothing)
{
    for (const double x : {2.0, 3.0, 4.0})
        Keep(x);
    Crash();
    EXPECT_EQ(4.0, Recovered());
    Crash(); // before anything was written
    EXPECT_EQ((std::vector<long>{3, 2, 1}), Sequences());
    EXPECT_EQ(4.0, Recovered());
    m_autosave = std::make_unique<CAutosave>(*m_doc);
    m_autosave->Follow(m_file);
    T_AUTOSAVE_COPY copy;
    ASSERT_EQ(1, CAutosave::Newest(m_file, copy));
    ASSERT_EQ(1, m_autosave->TakeOver(copy));
    EXPECT_TRUE(Sequences().empty()) << "nobody else is asked about them";
    Keep(7.0);
    Crash(); // after a copy of the recovered document
    EXPECT_EQ((std::vector<long>{4, 3, 2}), Sequences());
    EXPECT_EQ(7.0, Recovered());
}

TEST_F(Autosave, ADamagedOrMissingFileCanStillBeRecovered)
{
    Keep(2.0);
    Crash();
    fs::resize_file(m_file, 100);
    EXPECT_EQ(2.0, Recovered());
    T_FILE_ERROR error;
    EXPECT_EQ(1, m_doc->SaveModel(error)) << error.text;
    fs::remove(m_file);
    EXPECT_EQ(2.0, Recovered());
}

TEST_F(Autosave, AFailedCopyLeavesTheOthersAndIsTriedAgain)
{
    Keep(2.0);
    fs::create_directory(CopyPath(2)); // in the way
    Move(3.0);
    m_nowS += 100.0;
    EXPECT_EQ(AUTOSAVE::Failed, Tick(m_nowS));
    EXPECT_EQ(AUTOSAVE::Nothing, Tick(m_nowS + 1.0));
    fs::remove(CopyPath(2));
    EXPECT_EQ(AUTOSAVE::Written, Tick(m_nowS + 100.0));
    m_autosave->Remove();
    Crash();
    EXPECT_TRUE(Sequences().empty());
}

TEST_F(Autosave, EverySessionHasItsOwnCopies)
{
    CDBDoc other;
    CAutosave second(other);
    second.Follow(m_file); // two windows on the place of models without a name
    Keep(2.0);
    second.Remove();
    Crash();
    EXPECT_EQ(2.0, Recovered()) << "the other session removed them";
    T_AUTOSAVE_COPY copy;
    ASSERT_EQ(1, CAutosave::Newest(m_file, copy));
    m_autosave = std::make_unique<CAutosave>(*m_doc);
    m_autosave->Follow(m_file);
    Keep(3.0);
    ASSERT_EQ(1, CAutosave::Newest(m_file, copy)) << "a running session hides them";
    EXPECT_EQ(1, second.TakeOver(copy));
    EXPECT_EQ(0, m_autosave->TakeOver(copy));
    second.Remove();
    Crash();
    EXPECT_EQ(3.0, Recovered());
}
