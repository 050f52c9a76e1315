#include "modelstoresample.h"
#include "numbers.h"
#include "qm_base/msgfunction.h"
#include "qm_db/modelstore.h"

#include <csignal>
#include <filesystem>
#include <gtest/gtest.h>
#include <sys/resource.h>
#include <sys/stat.h>
#include <sys/wait.h>
#include <unistd.h>

namespace fs = std::filesystem;
using zql::lib::MMSGFunction;

namespace {

class ModelStoreSave : public testing::Test {
protected:
    void SetUp() override
    {
        ASSERT_EQ(1, CModelStore().Save(m_path, RichContent(), m_error)) << m_error.text;
        m_before = BytesOf(m_path);
    }
    /// The save is refused with one line that names the file; the old file is as it was and alone.
    void ExpectRefused(const T_MODEL_CONTENT& content, FILE_FAULT fault, const std::string& label)
    {
        EXPECT_EQ(0, CModelStore().Save(m_path, content, m_error)) << label;
        EXPECT_EQ(fault, m_error.fault) << label;
        EXPECT_NE(std::string::npos, m_error.text.find(m_path)) << m_error.text;
        EXPECT_EQ(std::string::npos, m_error.text.find('\n')) << m_error.text;
        ExpectUntouched(label);
    }
    void ExpectUntouched(const std::string& label)
    {
        EXPECT_TRUE(m_before == BytesOf(m_path)) << label;
        EXPECT_EQ(std::vector<std::string>{"frame.qmdb"}, m_folder.Names()) << label;
    }

    CTempFolder m_folder;
    std::string m_path = m_folder.File("frame.qmdb");
    std::string m_before;
    T_FILE_ERROR m_error;
};

TEST_F(ModelStoreSave, NumbersThatAreNotFiniteAreRefused)
{
    const struct {
        const char* place;
        void (*spoil)(T_MODEL_CONTENT&, double);
    } cases[] = {
        {"model gravity", [](auto& c, double v) { c.model.styp.gravity = v; }},
        {"nodes 2 xyz", [](auto& c, double v) { c.model.nodes[2].xyz[1] = v; }},
        {"spectra 9 Sa",
         [](auto& c, double v) { std::get<T_SPFC_USER>(c.model.spectra[9].data).Sa[0] = v; }},
        {"results 1 displacement 5",
         [](auto& c, double v) {
             c.results[1] = MakePushResult({{1}, {1}, {{5, {v}}}});
         }},
    };
    for (const auto& c : cases) {
        for (const double value : {kNan, -kInf}) {
            T_MODEL_CONTENT content = RichContent();
            c.spoil(content, value);
            ExpectRefused(content, FILE_FAULT::BadInput, c.place);
            EXPECT_NE(std::string::npos, m_error.text.find(std::string("not saved: ") + c.place));
            EXPECT_NE(std::string::npos, m_error.text.find("not a finite number")) << m_error.text;
        }
    }
}

TEST_F(ModelStoreSave, ResultsThatDoNotFitAreRefused)
{
    T_MODEL_CONTENT content = RichContent();
    content.results[1] = MakePushResult({{1, 2}, {1, 2}, {{5, {1, 2}}, {6, {1}}}});
    ExpectRefused(content, FILE_FAULT::BadInput, "displacements");
    EXPECT_EQ(MMSGFunction::Format("IDS_QM_DB_FILE_RESULT_LENGTH",
                                   {m_path, "results 1 displacement 6", "1", "2"}),
              m_error.text);
    content.results[1] = MakePushResult({{1, 2}, {1}, {}});
    ExpectRefused(content, FILE_FAULT::BadInput, "base reactions");
}

TEST_F(ModelStoreSave, ModelThatReadsBackDifferentlyIsRefused)
{
    T_MODEL_CONTENT content = RichContent();
    content.model.nodes[2].id = 3; // filed under 2
    ExpectRefused(content, FILE_FAULT::BadInput, "node id");
}

/// A small limit of the file size stands for a full disk: SQLite's writes fail half way.
TEST_F(ModelStoreSave, FullDiskLeavesTheOldFileAlone)
{
    const T_MODEL_CONTENT large = GridContent(600, 40);
    for (const rlim_t limit : {rlim_t{0}, rlim_t{4096}, rlim_t{50000}, rlim_t{200000}}) {
        const pid_t child = ::fork();
        if (child == 0) {
            std::signal(SIGXFSZ, SIG_IGN);
            const rlimit bounds{limit, limit};
            ::setrlimit(RLIMIT_FSIZE, &bounds);
            T_FILE_ERROR error;
            const int done = CModelStore().Save(m_path, large, error);
            const bool clear = error.fault == FILE_FAULT::NoAccess &&
                               error.text.find(m_path) != std::string::npos &&
                               (error.text.find("File too large") != std::string::npos ||
                                error.text.find("disk is full") != std::string::npos);
            ::_exit(done ? 2 : clear ? 0 : 1);
        }
        int status = -1;
        ::waitpid(child, &status, 0);
        ASSERT_TRUE(WIFEXITED(status)) << limit;
        EXPECT_EQ(0, WEXITSTATUS(status)) << limit;
        ExpectUntouched("limit " + std::to_string(limit));
    }
    EXPECT_EQ(1, CModelStore().Save(m_path, large, m_error)) << m_error.text; // it was the limit
}

TEST_F(ModelStoreSave, KeepsPermissionsAndLinks)
{
    const std::string link = m_folder.File("link.qmdb");
    fs::create_symlink("frame.qmdb", link);
    for (const mode_t mode : {0600U, 0664U, 0755U}) {
        ASSERT_EQ(0, ::chmod(m_path.c_str(), mode));
        ASSERT_EQ(1, CModelStore().Save(link, GridContent(2, 2), m_error)) << m_error.text;
        struct stat status = {};
        ASSERT_EQ(0, ::stat(m_path.c_str(), &status));
        EXPECT_EQ(mode, status.st_mode & 07777);
    }
    EXPECT_TRUE(fs::is_symlink(link));

    const std::string fresh = m_folder.File("fresh.qmdb");
    const mode_t before = ::umask(027);
    EXPECT_EQ(1, CModelStore().Save(fresh, GridContent(2, 2), m_error)) << m_error.text;
    ::umask(before);
    EXPECT_EQ(fs::perms(0640), fs::status(fresh).permissions());
    EXPECT_FALSE(m_before == BytesOf(m_path));
}

} // namespace
