// Commands that help texts and documents show must work as they stand.
#include "program.h"

namespace fs = std::filesystem;

namespace {

constexpr const char* kProgram = "qm-rps ";

std::string Trimmed(const std::string& text)
{
    const auto from = text.find_first_not_of(' ');
    return from == std::string::npos ? "" : text.substr(from);
}

/// A folder that sees the examples as the project's root does, and where commands may write.
class Documents : public CProgramTest {
protected:
    Documents()
    {
        for (const char* name : {"examples", "tests"})
            fs::create_directory_symlink(ProjectFolder() / name, m_folder / name);
    }
    /// Each page starts with nothing written: outputs don't replace those of another.
    void Clear() const
    {
        for (const std::string& name : m_folder.Names())
            if (!fs::is_directory(m_folder / name)) fs::remove(m_folder / name);
    }
    void ExpectWorks(const std::string& command, const std::string& where) const
    {
        const T_RUN run = RunShell(command, m_folder.Path());
        EXPECT_TRUE(run.code == 0 || run.code == 1) << where << ": " << command << "\n" << run.err;
        for (const std::string& line : Lines(run.err)) // an evaluation says that it pushes first
            EXPECT_TRUE(run.code == 1 || line.ends_with("it is pushed first."))
                << line << where << ": " << command;
        EXPECT_NE("", run.out) << where << ": " << command;
    }
    /// Runs the indented lines that start with the program's name; returns how many there are.
    std::size_t RunCommandsOf(const fs::path& page) const
    {
        Clear();
        std::size_t count = 0;
        for (const std::string& line : Lines(ReadText(page))) {
            const std::string command = Trimmed(line);
            if (!line.starts_with("    ") || !command.starts_with(kProgram)) continue;
            ExpectWorks(command, page.filename().string());
            ++count;
        }
        return count;
    }
    /// The names that the program's own help lists under "Subcommands:".
    std::vector<std::string> CommandNames() const
    {
        std::vector<std::string> names;
        bool listed = false;
        for (const std::string& line : Lines(Done("--help"))) {
            if (listed && !line.starts_with("  ")) break;
            if (listed) names.push_back(line.substr(2, line.find(' ', 2) - 2));
            listed = listed || line.starts_with("Subcommands:");
        }
        return names;
    }
};

TEST_F(Documents, EveryHelpHasAnExampleThatWorks)
{
    std::vector<std::string> commands = CommandNames();
    ASSERT_GE(commands.size(), 4U);
    commands.push_back("");
    for (const std::string& name : commands) {
        const std::vector<std::string> lines = Lines(Done(name + " --help"));
        Clear();
        std::size_t examples = 0;
        for (std::size_t i = 0; i + 1 < lines.size(); ++i) {
            if (Trimmed(lines[i]).rfind("Example:", 0) != 0) continue;
            const std::string command = Trimmed(lines[i + 1]);
            EXPECT_TRUE(command.starts_with(kProgram)) << command;
            ExpectWorks(command, "help of " + name);
            ++examples;
        }
        EXPECT_EQ(1U, examples) << name;
    }
}

TEST_F(Documents, EveryCommandOfThePagesWorks)
{
    EXPECT_GE(RunCommandsOf(ProjectFolder() / "README.md"), 3U);
    for (const char* folder : {"docs", "examples"}) {
        std::size_t count = 0;
        for (const auto& entry : fs::recursive_directory_iterator(ProjectFolder() / folder))
            if (entry.path().extension() == ".md") count += RunCommandsOf(entry.path());
        EXPECT_GE(count, 7U) << folder;
    }
}

} // namespace
