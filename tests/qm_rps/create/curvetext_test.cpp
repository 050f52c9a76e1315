// Pasted texts: what is read from them, or in which line they are refused.
#include "qm_rps/create/curvetext.h"

#include "qm_base/textformat.h"
#include "qm_rps/create/numberlist.h"

#include <gtest/gtest.h>

namespace {

struct T_CASE {
    const char* label;
    T_CURVE_TEXT in;
    const char* points; // "V d;", the origin first; else what the refusal says
    const char* columns = "";
};

std::string PointsOf(const T_CURVE_READ& read)
{
    std::string text;
    for (const T_CURVE_POINT& p : read.points) {
        text += ShortestText(p.force) + " " + ShortestText(p.displacement);
        for (const double d : p.storeys)
            text += " " + ShortestText(d);
        text += ";";
    }
    return text;
}

T_CURVE_TEXT Text(const char* text, const char* columns = "")
{
    T_CURVE_TEXT in;
    in.text = text;
    in.columns = columns;
    return in;
}
T_CURVE_TEXT With(T_CURVE_TEXT in, bool T_CURVE_TEXT::*flag)
{
    in.*flag = true;
    return in;
}
T_CURVE_TEXT Decimal(T_CURVE_TEXT in, PASTED_DECIMAL decimal)
{
    in.decimal = decimal;
    return in;
}

} // namespace

TEST(CurveText, IsReadWithAnySeparatorAndDecimal)
{
    const T_CASE cases[] = {
        {"tabs, header", Text("V (kN)\td (mm)\r\n0\t0\r\n10\t1.5\r\n20\t4\r\n"), "0 0;10 1.5;20 4;",
         "V,d"},
        {"two header lines, d first", Text("Load case 1\nd [mm]; V [kN]\n0;0\n1,5;10\n4;20\n"),
         "0 0;10 1.5;20 4;", "d,V"},
        {"blanks and decimal commas", Text("0 0\n10,5 1,5\n9,5 4\n", "V,d"), "0 0;10.5 1.5;9.5 4;",
         "V,d"},
        {"commas part numbers", Text("V,d\n0,0\n10.5,1.5\n20,4\n"), "0 0;10.5 1.5;20 4;", "V,d"},
        {"forces that fall tell", Text("0 0\n10 1\n8 2\n"), "0 0;10 1;8 2;", "V,d"},
        {"comma said to be decimal",
         Decimal(Text("0 0\n1,5 10\n4 20", "d,V"), PASTED_DECIMAL::Comma), "0 0;10 1.5;20 4;",
         "d,V"},
        {"storeys, one column not read", Text("1 0 0 0 0\n2 10 3 1 2\n3 20 8 3 6", "-,V,d,d1,d2"),
         "0 0 0 0;10 3 1 2;20 8 3 6;", "-,V,d,d1,d2"},
        {"origin added, reactions",
         With(With(Text("-10 1\n-20 2\n# end\n", "V,d"), &T_CURVE_TEXT::addOrigin),
              &T_CURVE_TEXT::reverseForce),
         "0 0;10 1;20 2;", "V,d"},
        {"held displacement, byte order mark",
         Text("\xEF\xBB\xBF"
              "0 0\n10 1\n8 1\n7 2",
              "V,d"),
         "0 0;10 1;8 1;7 2;", "V,d"},
    };
    for (const T_CASE& c : cases) {
        T_CURVE_READ read;
        T_FINDING fault;
        ASSERT_TRUE(ReadCurve(c.in, read, fault)) << c.label << ": " << fault.text;
        EXPECT_EQ(c.points, PointsOf(read)) << c.label;
        EXPECT_EQ(c.columns, read.columns) << c.label;
    }
}

TEST(CurveText, IsRefusedWithItsLine)
{
    const T_CASE cases[] = {
        {"not a number", Text("0 0\n1 1\nnan 2\n3 3", "V,d"), "line 3: \"nan\""},
        {"word", Text("0 0\n1 1\n2 x\n", "V,d"), "line 3: \"x\""},
        {"thousands", Text("0;0\n1.234,5;1\n2000,5;2", "V,d"), "line 2: \"1.234,5\""},
        {"thousands by a quote", Text("0 0\n1'234 1\n2 2", "V,d"), "line 2: \"1'234\""},
        {"two ways", Text("0,0\n10,15\n20,25"), "decimal one"},
        {"point and comma", Text("0 0\n1.5 1,5\n2 2", "V,d"), "line 2"},
        {"row too long", Text("0 0\n1 1\n2 2 2", "V,d"), "line 3: 3 columns"},
        {"both rise, no header", Text("0 0\n10 1\n20 2"), "nothing tells"},
        {"one column", Text("0\n1\n2"), "one column"},
        {"V twice", Text("0 0\n1 1\n2 2", "V,V"), "does not name"},
        {"a storey is missing", Text("0 0 0\n1 1 1\n2 2 2", "V,d,d2"), "does not name"},
        {"too few named", Text("0 0 0\n1 1 1\n2 2 2", "V,d"), "2 columns are named"},
        {"starts above 0", Text("5 1\n10 2\n20 4", "V,d"), "line 1: the curve does not start"},
        {"falls", Text("0 0\n10 2\n20 4\n21 3.5", "V,d"), "line 4: the displacement falls from 4"},
        {"negative", Text("0 0\n-10 2\n-20 4", "V,d"), "line 2: the base shear is negative"},
        {"no first stiffness", Text("0 0\n10 0\n20 4", "V,d"), "line 2: base shear and"},
        {"two points", Text("0 0\n10 2\n", "V,d"), "line 2: the curve ends after 2"},
        {"empty", Text("V d\n\n"), "no row of numbers"},
    };
    for (const T_CASE& c : cases) {
        T_CURVE_READ read;
        T_FINDING fault;
        EXPECT_FALSE(ReadCurve(c.in, read, fault)) << c.label;
        EXPECT_TRUE(fault.text.find(c.points) != std::string::npos)
            << c.label << ": " << fault.text;
        EXPECT_TRUE(read.points.empty()) << c.label;
    }
}

TEST(NumberList, ReadsWhatPeopleWrite)
{
    using L = std::vector<double>;
    std::string bad;
    EXPECT_EQ(L({5.0, 5.0, 4.5}), ParseNumberList("5, 5, 4.5", bad));
    EXPECT_EQ(L({3.5, 3.0, 3.0}), ParseNumberList("3,5; 2x3", bad));
    EXPECT_EQ(L({2.0, 3.0}), ParseNumberList("2 3", bad));
    EXPECT_EQ(L(), ParseNumberList(" ", bad));
    for (const char* const text : {"3,b", "0x5", "1.5x2", "2000x1", "nan", "1e999"})
        EXPECT_FALSE(ParseNumberList(text, bad)) << text;
    EXPECT_EQ(L({0.1, 3.0}), ParseNumberList(NumberListText({0.1, 3.0}), bad));
}
