#include "qm_db/modelstore.h"

#include "modelstoresample.h"
#include "qm_base/msgfunction.h"

#include <cmath>
#include <filesystem>
#include <gtest/gtest.h>

namespace fs = std::filesystem;

namespace {

class ModelStore : public testing::Test {
protected:
    void Save(const T_MODEL_CONTENT& content, const std::string& path)
    {
        ASSERT_EQ(1, CModelStore().Save(path, content, m_error)) << m_error.text;
    }
    T_MODEL_CONTENT Open(const std::string& path)
    {
        T_MODEL_CONTENT content;
        EXPECT_EQ(1, CModelStore().Open(path, OPEN_MODE::ReadOnly, content, m_error))
            << m_error.text;
        return content;
    }

    CTempFolder m_folder;
    std::string m_path = m_folder.File("frame.qmdb");
    T_FILE_ERROR m_error;
};

TEST_F(ModelStore, GivesBackEveryRecordAndResult)
{
    const T_MODEL_CONTENT saved = RichContent();
    Save(saved, m_path);
    const T_MODEL_CONTENT opened = Open(m_path);
    EXPECT_EQ(saved.model, opened.model);
    EXPECT_TRUE(SameContent(saved, opened));
    EXPECT_EQ(1, CModelStore::CheckWhole(m_path, m_error)) << m_error.text;
    EXPECT_EQ(std::vector<std::string>{"frame.qmdb"}, m_folder.Names());
}

TEST_F(ModelStore, KeepsTheSignOfZero) // == does not tell -0.0 from 0.0
{
    Save(RichContent(), m_path);
    const T_MODEL m = Open(m_path).model;
    EXPECT_TRUE(std::signbit(m.nodes.at(2).xyz[1]));
    EXPECT_TRUE(std::signbit(m.modes.at(2).shape.at(2)[0]));
    EXPECT_TRUE(std::signbit(std::get<T_SPFC_USER>(m.spectra.at(9).data).Sa[2]));
    EXPECT_TRUE(std::signbit(*m.evaluations.at(2).elasticDamping));
}

TEST_F(ModelStore, LazyResultsOutliveTheStoreAndTheReplacedFile)
{
    Save(RichContent(), m_path);
    const T_MODEL_CONTENT opened = Open(m_path);
    Save(GridContent(3, 2), m_path);
    fs::remove(m_path);
    EXPECT_TRUE(SameContent(RichContent(), opened));
}

TEST_F(ModelStore, SavesOverTheFileThatItsResultsComeFrom)
{
    Save(RichContent(), m_path);
    CModelStore store;
    T_MODEL_CONTENT content;
    ASSERT_EQ(1, store.Open(m_path, OPEN_MODE::Edit, content, m_error)) << m_error.text;
    for (int i = 0; i < 3; ++i) {
        content.model.styp.title += '+';
        ASSERT_EQ(1, store.Save(m_path, content, m_error)) << m_error.text;
    }
    EXPECT_TRUE(SameContent(content, Open(m_path)));
    EXPECT_TRUE(Open(m_path).model.styp.title.ends_with("+++"));
}

TEST_F(ModelStore, RefusesASecondEditorUntilTheFirstCloses)
{
    Save(RichContent(), m_path);
    CModelStore first, second;
    T_MODEL_CONTENT content, other;
    ASSERT_EQ(1, first.Open(m_path, OPEN_MODE::Edit, content, m_error)) << m_error.text;
    EXPECT_EQ(0, second.Open(m_path, OPEN_MODE::Edit, other, m_error));
    EXPECT_EQ(FILE_FAULT::NoAccess, m_error.fault);
    EXPECT_EQ(zql::lib::MMSGFunction::Format("IDS_QM_DB_FILE_LOCKED", {m_path}), m_error.text);
    EXPECT_EQ(T_MODEL{}, other.model);
    EXPECT_EQ(1, second.Open(m_path, OPEN_MODE::ReadOnly, other, m_error)) << m_error.text;

    // The lock goes on with the new file of a save.
    ASSERT_EQ(1, first.Save(m_path, content, m_error)) << m_error.text;
    EXPECT_EQ(0, second.Open(m_path, OPEN_MODE::Edit, other, m_error));
    first.Close();
    EXPECT_EQ(1, second.Open(m_path, OPEN_MODE::Edit, other, m_error)) << m_error.text;
}

} // namespace
