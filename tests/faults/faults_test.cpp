// Whatever call fails while a file is written: the old file or the new one is there, whole, nothing
// else lies about, and the failure has its words. Every call of files fails once, and from then on
// (a full disk); of the calls for memory as many as the time of a test allows, spread over the run.
#include "faultlayer.h"
#include "iterationperson.h"
#include "modelstoresample.h"
#include "stagecase.h"

#include "qm_db/autosave.h"
#include "qm_db/casefile.h"
#include "qm_db/dbdoc.h"
#include "qm_db/filectrl.h"
#include "qm_db/sheetfile.h"
#include "qm_rps/ulfiterationdochost.h"

#include <functional>
#include <gtest/gtest.h>
#include <set>

namespace {

using NAMES = std::vector<std::string>;

/// One way of writing.
struct T_WRITER {
    /// Also makes what the writing is not to be charged with, such as names.
    std::function<void(const CTempFolder&)> prepare;
    /// 1 done, 0 with the reason.
    std::function<int(const CTempFolder&, std::string& reason)> write;
    /// Looks at what is there; no faults any more.
    std::function<void(const CTempFolder&, bool isDone)> check;
};

/// Calls that one undisturbed run makes.
long CountCalls(const T_WRITER& writer, FAULT_KIND kind)
{
    const CTempFolder folder;
    writer.prepare(folder);
    std::string reason;
    int done = 0;
    {
        const CFaults count(kind, 0);
        done = writer.write(folder, reason);
    }
    EXPECT_EQ(1, done) << reason;
    writer.check(folder, true);
    return CFaults::Count();
}

void RunWith(const T_WRITER& writer, FAULT_KIND kind, long n, FAULT_LENGTH length)
{
    SCOPED_TRACE(testing::Message() << (kind == FAULT_KIND::File ? "file" : "memory") << " call "
                                    << n << (length == FAULT_LENGTH::Once ? "" : " and after"));
    const CTempFolder folder;
    writer.prepare(folder);
    std::string reason;
    int done = 0;
    {
        const CFaults faults(kind, n, length);
        done = writer.write(folder, reason);
    }
    EXPECT_NE(done == 1, !reason.empty());
    writer.check(folder, done == 1);
}

void ExpectHolds(const T_WRITER& writer)
{
    const long files = CountCalls(writer, FAULT_KIND::File);
    ASSERT_GE(files, 5);
    for (long n = 1; n <= files; ++n)
        for (const auto length : {FAULT_LENGTH::Once, FAULT_LENGTH::FromNow})
            RunWith(writer, FAULT_KIND::File, n, length);
    constexpr long kMost = 150;
    const long calls = CountCalls(writer, FAULT_KIND::Memory);
    ASSERT_GE(calls, 10);
    for (long n = 1; n <= calls; n += 1 + calls / kMost)
        RunWith(writer, FAULT_KIND::Memory, n, FAULT_LENGTH::Once);
}

template <class F>
int Refused(std::string& reason, const F& work)
{
    T_FILE_ERROR error;
    const int done = work(error);
    reason = std::move(error.text);
    return done;
}

T_MODEL_CONTENT SmallContent(double gravity)
{
    T_MODEL_CONTENT content = GridContent(3, 4);
    content.model.styp.gravity = gravity;
    return content;
}

double GravityOf(const std::string& path)
{
    T_MODEL_CONTENT content;
    T_FILE_ERROR error;
    EXPECT_EQ(1, CModelStore::CheckWhole(path, error)) << error.text;
    EXPECT_EQ(1, CModelStore().Open(path, OPEN_MODE::ReadOnly, content, error)) << error.text;
    return content.model.styp.gravity.value_or(0.0);
}

TEST(Faults, ASaveLeavesTheOldModelOrTheNewOne)
{
    const T_MODEL_CONTENT before = SmallContent(9.5), after = SmallContent(9.75);
    std::string path;
    ExpectHolds({[&](const CTempFolder& folder) {
                     path = folder / "m.qmdb";
                     T_FILE_ERROR error;
                     ASSERT_EQ(1, CModelStore().Save(path, before, error));
                 },
                 [&](const CTempFolder&, std::string& reason) {
                     return Refused(reason, [&](T_FILE_ERROR& error) {
                         return CModelStore().Save(path, after, error);
                     });
                 },
                 [](const CTempFolder& folder, bool isDone) {
                     EXPECT_EQ(NAMES{"m.qmdb"}, folder.Names());
                     EXPECT_EQ(isDone ? 9.75 : 9.5, GravityOf(folder / "m.qmdb"));
                 }});
}

TEST(Faults, AnExportLeavesTheOldCaseOrTheNewOne)
{
    const T_MODEL_CONTENT content = SmallContent(9.75);
    std::string text;
    T_FILE_ERROR fault;
    ASSERT_EQ(1, CCaseFile::Print(content, text, fault));
    std::string path;
    ExpectHolds({[&](const CTempFolder& folder) {
                     path = folder / "c.json";
                     WriteText(path, "old");
                 },
                 [&](const CTempFolder&, std::string& reason) {
                     return Refused(reason, [&](T_FILE_ERROR& error) {
                         return CFileCtrl::WriteWholeFile(path, text, error);
                     });
                 },
                 [&](const CTempFolder& folder, bool isDone) {
                     EXPECT_EQ(NAMES{"c.json"}, folder.Names());
                     EXPECT_EQ(isDone ? text : "old", ReadText(folder / "c.json"));
                 }});
}

TEST(Faults, ASpreadsheetIsWholeOrTheOldOne)
{
    T_SHEET sheet;
    sheet.cells[{0, 0}] = {std::string("a"), {.bold = true, .numberFormat = "0.00"}};
    sheet.cells[{1, 1}].value = T_SHEET_FORMULA{"=1+1", 2.0};
    std::string whole, path;
    ExpectHolds({[&](const CTempFolder& folder) {
                     path = folder / "s.xlsx";
                     WriteText(path, "old");
                 },
                 [&](const CTempFolder&, std::string& reason) {
                     return Refused(reason, [&](T_FILE_ERROR& error) {
                         return WriteSheet(path, sheet, error);
                     });
                 },
                 [&](const CTempFolder& folder, bool isDone) {
                     EXPECT_EQ(NAMES{"s.xlsx"}, folder.Names());
                     const std::string text = ReadText(folder / "s.xlsx");
                     if (whole.empty()) whole = text; // of the run without faults
                     EXPECT_EQ(isDone ? whole : "old", text);
                 }});
}

TEST(Faults, ACopyThatFailsLeavesTheOneBefore)
{
    CDBDoc doc;
    std::unique_ptr<CAutosave> autosave;
    const auto move = [&](double x) {
        T_NODE_D node;
        node.id = 1;
        node.xyz[0] = x;
        ASSERT_EQ(1, doc.Edit().Begin("move"));
        ASSERT_EQ(1, doc.Edit().Put(1, node));
        ASSERT_EQ(1, doc.Edit().Commit());
    };
    ExpectHolds({[&](const CTempFolder& folder) {
                     doc.NewModel();
                     autosave = std::make_unique<CAutosave>(doc);
                     autosave->Follow(folder / "u.qmdb");
                     T_FILE_ERROR error;
                     move(1.0);
                     (void)autosave->Tick(0.0, error);
                     ASSERT_EQ(AUTOSAVE::Written, autosave->Tick(100.0, error)) << error.text;
                     move(2.0);
                 },
                 [&](const CTempFolder&, std::string& reason) {
                     return Refused(reason, [&](T_FILE_ERROR& error) {
                         return autosave->Tick(1000.0, error) == AUTOSAVE::Written ? 1 : 0;
                     });
                 },
                 [&](const CTempFolder& folder, bool isDone) {
                     autosave.reset(); // a crash
                     T_AUTOSAVE_COPY copy;
                     ASSERT_EQ(1, CAutosave::Newest(folder / "u.qmdb", copy));
                     T_MODEL_CONTENT content;
                     T_FILE_ERROR error;
                     ASSERT_EQ(1,
                               CModelStore().Open(copy.path, OPEN_MODE::ReadOnly, content, error));
                     EXPECT_EQ(isDone ? 2.0 : 1.0, content.model.nodes.at(1).xyz[0]);
                     EXPECT_EQ(isDone ? 2U : 1U, folder.Names().size());
                 }});
}

TEST(Faults, AnIterationLeavesWholeFilesAndTheModel)
{
    T_MODEL_CONTENT content;
    T_FILE_ERROR fault;
    ASSERT_EQ(1, CCaseFile::Parse(kStageCase, "case", "", content, fault)) << fault.text;
    std::string before;
    const auto write = [](const CTempFolder& folder, std::string& reason) {
        CDBDoc doc;
        T_FILE_ERROR error;
        T_ANALYSIS_ERROR analysis;
        T_ANALYSIS_OPTIONS options;
        options.allCases = false;
        if (!doc.OpenModel(folder / "m.qmdb", OPEN_MODE::ReadOnly, error) ||
            !doc.RunAnalysis(options, analysis)) {
            reason = error.text + analysis.text;
            return 0;
        }
        CUlfIterationDocHost host(doc, doc.Data().Model().ulfStageItems.begin()->second);
        CPerson person;
        CUlfIteration run(host, person, {2, 1e-9});
        const int done = run.Run() && run.End() == ULF_ITER_END::Converged;
        if (!done) reason = run.Said() ? run.Said()->text + host.Error() : host.Error();
        return done;
    };
    const auto check = [&](const CTempFolder& folder, bool isDone) {
        EXPECT_EQ(before, ReadText(folder / "m.qmdb"));
        const std::set<std::string> known{"m.qmdb", "m.ulf", "m_01.qmdb"};
        for (const std::string& name : folder.Names()) {
            EXPECT_TRUE(known.contains(name)) << name;
            if (name.ends_with(".qmdb")) (void)GravityOf(folder / name);
        }
        const std::string report = ReadText(folder / "m.ulf");
        EXPECT_TRUE(report.empty() || report.ends_with("\n\n")) << "a block was cut off";
        EXPECT_TRUE(!isDone || folder.Names().size() == 3U);
    };
    const T_WRITER writer{[&](const CTempFolder& folder) {
                              T_FILE_ERROR error;
                              ASSERT_EQ(1, CModelStore().Save(folder / "m.qmdb", content, error));
                              before = ReadText(folder / "m.qmdb");
                          },
                          write, check};
    const long files = CountCalls(writer, FAULT_KIND::File);
    for (long n = 1; n <= files; ++n)
        RunWith(writer, FAULT_KIND::File, n, FAULT_LENGTH::FromNow);
}

} // namespace

int main(int argc, char** argv)
{
    CFaults::Install();
    testing::InitGoogleTest(&argc, argv);
    return RUN_ALL_TESTS();
}
