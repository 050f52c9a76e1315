#include "qm_db/file/recorderfile.h"

#include "tempfolder.h"

#include "qm_db/casefile.h"

#include <gtest/gtest.h>

namespace {

using enum RECORDER_DECIMAL;

std::vector<double> ColumnOf(const std::string& text, int column, RECORDER_DECIMAL decimal = Auto)
{
    CRecorderFile file;
    T_FILE_ERROR error;
    EXPECT_EQ(1, file.Parse(text, "r.out", {0, decimal}, error)) << error.text;
    std::vector<double> values(file.RowCount(), 0.0);
    EXPECT_EQ(1, file.AddColumn(column, values, error)) << error.text;
    return values;
}

using T_V = std::vector<double>;

TEST(RecorderFile, ReadsEverySeparatorAndLineEnd)
{
    const char* const texts[] = {
        "1 2 3\n4 5 6\n",
        "1\t2\t3\r\n4\t5\t6\r\n",
        " 1, 2 ,3\n\n4 ,5,\t6,\n",
        "# solver 1\n+1 2e0 3\n4 5. 6.\n",
        "1 2 3\r4 5 6\r",
        "\xEF\xBB\xBF"
        "1; 2;3\n4;5 ;6",
        "t  a  b\n1 2 3\n4 5 6\n",
        "time, Disp X, \"Disp Y\"\n1,2,3\n4,5,6\n",
    };
    for (const char* text : texts) {
        EXPECT_EQ((T_V{1, 4}), ColumnOf(text, 1)) << text;
        EXPECT_EQ((T_V{2, 5}), ColumnOf(text, 2)) << text;
        EXPECT_EQ((T_V{3, 6}), ColumnOf(text, 3)) << text;
    }
    EXPECT_EQ((T_V{2, 6}), ColumnOf("1,,2\n4,,6\n", 3)); // an empty cell keeps its column
}

TEST(RecorderFile, UnderstandsADecimalCommaBesideOtherSeparators)
{
    struct T_ROW {
        const char* text;
        RECORDER_DECIMAL decimal;
        T_V second; // column
    };
    const T_ROW rows[] = {
        {"0;3,6\n1;-4,25e1\n", Auto, {3.6, -42.5}},
        {"0,5\t3,6\n1,5\t4\n", Auto, {3.6, 4}},
        {"0,5  3,6\n1,5  4,25\n", Auto, {3.6, 4.25}},
        {"0,5\t3,6\n1,5\t4\n", Comma, {3.6, 4}},
        {"t;V, kN\n0;3,6\n", Auto, {3.6}},
        {"0,3.6\n1,4\n", Auto, {3.6, 4}},  // points: the commas part
        {"t,V\n0,3\n1,4\n", Auto, {3, 4}}, // two names: the commas part
        {"0,3\n1,4\n", Point, {3, 4}},
        {"0. 36\n1. 37\n", Point, {36, 37}},
    };
    for (const T_ROW& row : rows)
        EXPECT_EQ(row.second, ColumnOf(row.text, 2, row.decimal)) << row.text;
    EXPECT_EQ((T_V{3.6}), ColumnOf("3,6\n", 1, Comma));
    EXPECT_EQ((T_V{8}), ColumnOf("a;Top disp;b\n1;8;2\n", 2));
}

TEST(RecorderFile, FindsAColumnByANameWithBlanks)
{
    for (const char* const text :
         {"t;Top disp\n0;3,6\n", "t\tTop disp\n0\t3.6\n", "t, \"Top disp\"\n0, 3.6\n"}) {
        CRecorderFile file;
        T_FILE_ERROR error;
        int column = 0;
        ASSERT_EQ(1, file.Parse(text, "r.out", {}, error)) << error.text;
        EXPECT_EQ(1, file.FindColumn("Top disp", column, error)) << error.text;
        EXPECT_EQ(2, column);
    }
}

TEST(RecorderFile, RefusesATableThatCanBeReadInTwoWays)
{
    const std::string either = " is two numbers, or one with a decimal comma: add \"decimal\": "
                               "\"point\" (two) or \"decimal\": \"comma\" (one) to \"files\"";
    struct T_ROW {
        const char* text;
        std::string message; // behind "r.out: line "
    };
    const T_ROW rows[] = {
        {"3,6\n", "1, column 1: \"3,6\"" + either},
        {"# V\n0,1,3,6\n", "2, column 1: \"0,1\"" + either},
        {"V\n3,6\n", "2, column 1: \"3,6\"" + either},
        {"1 2\n3, 4\n", "2, column 1: \"3,\": blanks and commas both stand between numbers"},
        {"1 1,234.5\n2 999.5\n", "1, column 2: \"1,234.5\" has a comma in a table whose other "
                                 "numbers have a decimal point"},
        {"0.1;0.2\n0,1;0.2\n", "2, column 1: \"0,1\" has a comma in a table whose other numbers "
                               "have a decimal point"},
        {"0. 36 1\n", "1, column 1: \"0. 36\" is two numbers, or one with a blank in it: mend the "
                      "file, or add \"decimal\": \"point\" (two) to \"files\""},
        {"1 2\n\n3 4 5\n", "3, column 3: the row has 3 columns, the first one 2"},
        {"1 2\r3\r", "2, column 2: the row has 1 columns, the first one 2"},
    };
    for (const T_ROW& row : rows) {
        CRecorderFile file;
        T_FILE_ERROR error;
        EXPECT_EQ(0, file.Parse(row.text, "r.out", {}, error)) << row.text;
        EXPECT_EQ("r.out: line " + row.message, error.text);
        EXPECT_FALSE(file.IsLoaded());
    }
}

TEST(RecorderFile, NamesFileLineAndColumnOfABadCell)
{
    struct T_ROW {
        const char* text;
        int column;
        const char* message;
        RECORDER_DECIMAL decimal = Auto;
    };
    const T_ROW rows[] = {
        {"1 2\n\n3 x\n4 y\n", 2, "r.out: line 3, column 2: \"x\" is not a finite number"},
        {"1 2\n3 nan\n", 2, "r.out: line 2, column 2: \"nan\" is not a finite number"},
        {"nan nan\n", 1, "r.out: line 1, column 1: \"nan\" is not a finite number"}, // no header
        {"1 1e999\n", 2, "r.out: line 1, column 2: \"1e999\" is not a finite number"},
        {"1 1.0D+05\n", 2, "r.out: line 1, column 2: \"1.0D+05\" is not a finite number"},
        {"1;0. 36\n", 2, "r.out: line 1, column 2: \"0. 36\" is not a finite number"},
        {"1;1.234\n", 2, "r.out: line 1, column 2: \"1.234\" is not a finite number", Comma},
        {"1 2\n3 4\n", 3, "r.out: line 1, column 3: missing, the row has 2 columns"},
    };
    for (const T_ROW& row : rows) {
        CRecorderFile file;
        T_FILE_ERROR error;
        ASSERT_EQ(1, file.Parse(row.text, "r.out", {0, row.decimal}, error)) << error.text;
        T_V values(file.RowCount(), 7.0);
        const T_V before = values;
        EXPECT_EQ(0, file.AddColumn(row.column, values, error)) << row.text;
        EXPECT_EQ(row.message, error.text);
        EXPECT_EQ(before, values);
    }
}

/// Case files that take their steps from tables in a folder of the test.
class RecorderCase : public testing::Test {
protected:
    RecorderCase()
    {
        std::filesystem::create_directories(m_folder / "sub");
        WriteText(m_folder / "d.out", "0 9 0.001 -3\n1 9 0.011 7\n2 9 0.031 5\n");
        WriteText(m_folder / "sub/v.csv", "t,V1,V2\n0,1,2\n1,-5,-10\n2,-6,-20\n");
        WriteText(m_folder / "short.out", "0 1\n1 2\n");
        WriteText(m_folder / "bad.out", "0 1\n1 oops\n2 3\n");
    }

    /// A case in mm whose "files" has these members.
    int Parse(const std::string& files)
    {
        const std::string text =
            "{\"format\": \"qm-rps case 1\", \"units\": {\"force\": \"kN\", \"length\": \"mm\"},"
            "\"nodes\": [{\"id\": 1, \"xyz\": [0,0,0]}, {\"id\": 2, \"xyz\": [0,0,1]}],"
            "\"pushover\": [{\"name\": \"P\", \"control_node\": 2, \"direction\": \"DX\","
            "\"pattern\": {\"kind\": \"static\"}, \"steps\": {\"files\": {" +
            files + "}}}]}";
        m_content = {};
        m_error = {};
        const int done = CCaseFile::Parse(text, "case.json", m_folder.Path(), m_content, m_error);
        EXPECT_EQ(done, static_cast<int>(m_error.text.empty())) << m_error.text;
        EXPECT_EQ(done, static_cast<int>(m_content.model.nodes.size()) / 2);
        return done;
    }
    T_PUSH_DATA Result()
    {
        T_PUSH_DATA data;
        std::string error;
        EXPECT_EQ(1, ReadWholeResult(*m_content.results.at(1), data, error));
        return data;
    }

    CTempFolder m_folder;
    T_MODEL_CONTENT m_content;
    T_FILE_ERROR m_error;
};

const std::string kFactor = "\"load_factor\": {\"path\": \"d.out\", \"column\": 1},";
const std::string kForce = "\"base_reaction\": {\"path\": \"sub/v.csv\", \"columns\": [2, \"V2\"], "
                           "\"scale\": -1},";
const std::string kDisp = "\"displacement\": {\"2\": {\"path\": \"d.out\", \"column\": 3}, "
                          "\"1\": {\"path\": \"d.out\", \"column\": 4, \"scale\": 0.5}}";

TEST_F(RecorderCase, SubtractsTheStateBeforeThePush)
{
    ASSERT_EQ(1, Parse("\"first_row\": \"state before push\", " + kFactor + kForce + kDisp));
    const T_PUSH_DATA data = Result();
    EXPECT_EQ((T_V{1, 2}), data.loadFactor);
    // -(V1 + V2): -3, 15, 26 kN; without the first row 18 and 29 kN
    EXPECT_EQ((T_V{18e3, 29e3}), data.baseReaction);
    ASSERT_EQ(2U, data.displacement.size());
    EXPECT_NEAR(0.010e-3, data.displacement.at(2)[0], 1e-18);
    EXPECT_NEAR(0.030e-3, data.displacement.at(2)[1], 1e-18);
    EXPECT_EQ((T_V{5e-3, 4e-3}), data.displacement.at(1)); // half of 10 and 8 mm
}

TEST_F(RecorderCase, RefusesBadTablesWithFileLineAndColumn)
{
    struct T_ROW {
        std::string files;
        const char* message; // after "case.json: pushover[0].steps.files"
    };
    const std::string head = kFactor + kForce;
    const auto disp = [&](const char* source) {
        return head + "\"displacement\": {\"2\": " + source + "}";
    };
    const T_ROW rows[] = {
        {"\"skip_rows\": -1, " + head + kDisp, ".skip_rows: the number of rows can't be negative"},
        {"\"decimal\": \",\", " + head + kDisp,
         ".decimal: unknown decimal sign \",\"; allowed: point, comma"},
        {"\"decimal\": \"comma\", " + head + kDisp,
         ".base_reaction.columns[0]: sub/v.csv: line 2, column 2: missing, the row has 1 columns"},
        {"\"first_row\": \"zero\", " + head + kDisp,
         ".first_row: unknown first row \"zero\"; allowed: state before push"},
        {disp("{\"path\": \"d.out\", \"column\": 1, \"columns\": [1]}"),
         ".displacement.\"2\": expected either \"column\" or \"columns\""},
        {disp("{\"path\": \"d.out\", \"column\": 5}"),
         ".displacement.\"2\".column: d.out: line 1, column 5: missing, the row has 4 columns"},
        {disp("{\"path\": \"d.out\", \"columns\": [1, \"Y\"]}"),
         ".displacement.\"2\".columns[1]: d.out: no header line with the column \"Y\""},
        {disp("{\"path\": \"bad.out\", \"column\": 2}"),
         ".displacement.\"2\".column: bad.out: line 2, column 2: \"oops\" is not a finite number"},
        {disp("{\"path\": \"short.out\", \"column\": 2}"),
         ".displacement.\"2\": short.out: 2 rows up to line 2, expected 3 as in d.out"},
        {disp("{\"path\": \"d.out\", \"column\": 2, \"scale\": 0}"),
         ".displacement: a curve of zero displacement: the control node 2 never moves"},
        {"\"skip_rows\": 3, " + kFactor + kForce + kDisp, ".load_factor: there is no step"},
    };
    for (const T_ROW& row : rows) {
        EXPECT_EQ(0, Parse(row.files));
        EXPECT_EQ(FILE_FAULT::BadInput, m_error.fault);
        EXPECT_EQ("case.json: pushover[0].steps.files" + std::string(row.message), m_error.text);
    }
}

TEST_F(RecorderCase, ReportsATableThatIsNotThere)
{
    EXPECT_EQ(0,
              Parse("\"load_factor\": {\"path\": \"none.out\", \"column\": 1}," + kForce + kDisp));
    EXPECT_EQ(FILE_FAULT::NoAccess, m_error.fault);
    EXPECT_EQ("case.json: pushover[0].steps.files.load_factor: " + (m_folder / "none.out") +
                  ": can't open: No such file or directory",
              m_error.text);
}

} // namespace
