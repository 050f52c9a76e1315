// What commands write: never over what is not theirs, together with others, and for which eyes.
#include "program.h"

#include <map>

namespace fs = std::filesystem;

namespace {

class Writing : public CProgramTest {
protected:
    /// Every file with its content.
    std::map<std::string, std::string> Files() const
    {
        std::map<std::string, std::string> files;
        for (const std::string& name : m_folder.Names())
            files[name] = Text(name);
        return files;
    }
};

TEST_F(Writing, RefusesToReplaceInputsAndWhatIsThere)
{
    Write("c.json", kSmallCase);
    Write("old.txt", "notes");
    Write("p-2.svg", "a drawing");
    Write("two.json", With(kSmallCase, "\"evaluations\": [", R"("evaluations": [
        {"name": "E2", "push": "PX", "method": "ATC-40", "procedure": "B", "spectrum": "ATC"},)"));
    Done("import c.json m.qmdb");
    Done("import c.json other.qmdb");
    const auto before = Files();
    const struct {
        const char* arguments;
        int code;
        const char* says;
    } kRows[] = {
        {"evaluate c.json --json c.json", 2, "c.json"},
        {"evaluate c.json --overwrite --report ./c.json", 2, "c.json"},
        {"import c.json c.json", 2, "c.json"},
        {"export m.qmdb m.qmdb", 2, "m.qmdb"},
        {"export m.qmdb other.qmdb --overwrite", 2, "other.qmdb"},
        {"evaluate m.qmdb --json m.qmdb", 2, "m.qmdb"},
        {"evaluate c.json --json x --report x --curve x", 2, "two outputs"},
        {"report-data c.json --json old.txt", 4, "--overwrite"},
        {"export m.qmdb old.txt", 4, "--overwrite"},
        {"import c.json other.qmdb", 4, "--overwrite"},
#ifdef QM_UI
        {"evaluate two.json --plot p.svg", 4, "p-2.svg"},
        {"compare c.json --push PX --spectrum ATC --json p.svg", 2, "picture"},
#endif
        {"ulf export @tuned-beam --item PROPS -o s.json", 2, ".xlsx"},
        {"ulf combine @tuned-beam --item PROPS --name X -o other.qmdb", 4, "--overwrite"},
        {"hinge assign @hinge-library --type 'steel beam' --elements 2 -o a", 2, ".qmdb"},
        {"hinge options c.json --alpha1 0.02 0.02 --overwrite -o c.json", 2, "c.json"},
        {"hinge options c.json --alpha1 0.02 0.02 -o other.qmdb", 4, "--overwrite"},
        {"ulf iterate m.qmdb --item I --overwrite --json m.qmdb", 2, "m.qmdb"},
        {"ulf iterate m.qmdb --item I --json m_01.qmdb", 2, "m_01.qmdb"},
        {"ulf iterate m.qmdb --item I --json old.txt", 4, "--overwrite"},
    };
    for (const auto& row : kRows) {
        ExpectRefused(row.arguments, row.code, row.says);
        EXPECT_TRUE(before == Files()) << row.arguments;
    }
    Done("report-data c.json --json old.txt --overwrite");
    EXPECT_TRUE(json::accept(Text("old.txt")));
}

TEST_F(Writing, ManyAtOnceLoseNothing)
{
    Done("import @tuned-beam m.qmdb");
    Done("analyse m.qmdb");
    const T_RUN run = RunShell("for i in 1 2 3 4 5 6 7 8; do (qm-rps ulf combine m.qmdb --item "
                               "PROPS --name C$i; echo $i $? >>codes) & done; wait",
                               m_folder.Path());
    const json model = json::parse(Done("export m.qmdb"));
    std::istringstream codes(Text("codes"));
    int done = 0, code = 0;
    for (std::string i; codes >> i >> code;) {
        done += code == 0;
        EXPECT_TRUE(code == 0 || code == 4) << code << ": " << run.err;
        const auto& all = model.at("combinations");
        EXPECT_EQ(
            code == 0 ? 1 : 0,
            std::ranges::count_if(all, [&](const json& c) { return c.at("name") == "C" + i; }))
            << i;
    }
    EXPECT_GE(done, 1) << run.err;
    EXPECT_EQ((std::vector<std::string>{"codes", "m.qmdb"}), m_folder.Names());
}

TEST_F(Writing, ShowsWhatATerminalWouldObeyButKeepsIt)
{
    const std::string title = "\\u001b[31m red \\u009b \\u202e";
    Write("c.json", With(kSmallCase, "small frame", title));
    const std::string said = Done("info c.json");
    ExpectHolds(said, {"\\x1b[31m red \\u009b \\u202e"});
    EXPECT_EQ(std::string::npos, said.find('\x1b'));
    EXPECT_EQ(json::parse("\"" + title + "\""), json::parse(Done("export c.json"))["title"]);
    const std::string name = ExpectRefused("info $'no\\x1b]0;x\\nfile'", 4, "no\\x1b]0;x\\nfile");
    EXPECT_EQ(std::string::npos, name.find('\x1b'));
}

TEST_F(Writing, FollowsThePermissionsOfTheModel)
{
    Done("import @staged-two-hangers m.qmdb");
    fs::permissions(m_folder / "m.qmdb", fs::perms(0600));
    Done("ulf iterate m.qmdb --item HANGERS --json h.json");
    Done("export m.qmdb c.json");
    Done("ulf export m.qmdb --item HANGERS -o s.xlsx");
    EXPECT_LE(6U, m_folder.Names().size());
    for (const std::string& name : m_folder.Names())
        EXPECT_EQ(fs::perms(0600), fs::status(m_folder / name).permissions()) << name;
}

TEST_F(Writing, AnIterationEndsOnASignalWithTheLoadsBefore)
{
    for (const char* signal : {"INT", "TERM", "HUP"}) {
        const T_RUN run =
            RunShell("rm -f * && qm-rps import @cable-stayed-bridge-staged m.qmdb && { qm-rps ulf "
                     "iterate m.qmdb --item STAYS --iterations 99 --tolerance 0 & p=$!; "
                     "while [ ! -e m_01.qmdb ] && kill -0 $p; do sleep 0.02; done; kill -" +
                         std::string(signal) + " $p; wait $p; }",
                     m_folder.Path());
        EXPECT_EQ(1, run.code) << signal << run.err;
        ExpectHolds(run.err, {"cancelled"});
        Done("info m_01.qmdb --check");
    }
}

TEST_F(Writing, ANonZeroEndHasItsLine)
{
    const T_RUN run = Run("ulf explain @tuned-beam --item IMPOSSIBLE");
    EXPECT_EQ(1, run.code);
    ExpectHolds(run.err, {"IMPOSSIBLE", "case.json"});
}

} // namespace
