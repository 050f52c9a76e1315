// Commands on records: what they write stands in the case file, and what they refuse.
#include "program.h"

namespace {

using Record = CProgramTest;

const json& Named(const json& table, const std::string& name)
{
    for (const json& record : table)
        if (record.at("name") == name) return record;
    static const json none;
    ADD_FAILURE() << "no record " << name;
    return none;
}

TEST_F(Record, WhatIsSetAddedAndDeletedStandsInTheFile)
{
    Done("record set @rc-frame-3-storey section column \"size=[24, 20]\" A=480 -o a.json");
    Done("record set a.json model title=Mine -o b.qmdb");
    Done("record add b.qmdb spectrum --name mine kind=user T=0,1,2 Sa=0.3,0.3,0.1 -o c.json");
    Done("record add c.json evaluation --copy \"PX_MODE1 ATC-40 A\" --name again -o d.json");
    Done("record delete d.json evaluation \"PX_MODE1 ATC-40 A\" -o e.json");
    const json model = json::parse(Text("e.json"));
    EXPECT_EQ("Mine", model.at("title"));
    EXPECT_EQ(json({24, 20}), Named(model.at("sections"), "column").at("size"));
    EXPECT_EQ(480, Named(model.at("sections"), "column").at("A"));
    EXPECT_EQ(json({0.3, 0.3, 0.1}), Named(model.at("spectra"), "mine").at("Sa"));
    EXPECT_EQ("A", Named(model.at("evaluations"), "again").at("procedure"));
    for (const json& evaluation : model.at("evaluations"))
        EXPECT_NE("PX_MODE1 ATC-40 A", evaluation.at("name"));
    const json rows = Json("record show e.json node 22");
    EXPECT_EQ("[288, 0, 168]", rows.at(1).at("value"));
    EXPECT_EQ("xyz (in)", rows.at(1).at("head"));
    Done("record list e.json section --csv s.csv --sheet s.xlsx");
    EXPECT_EQ(3u, Lines(Text("s.csv")).size());
    EXPECT_TRUE(Lines(Text("s.csv")).at(1).starts_with("1,column,"));
    EXPECT_EQ("gravity (in/s2)", Json("record show e.json model").at(4).at("head"));
}

TEST_F(Record, RefusesWithTheRulesWordsAndWritesNothing)
{
    const struct {
        const char* arguments;
        const char* says;
    } kCases[] = {
        {"set @rc-frame-3-storey sectoin column A=1", "There is no kind of record \"sectoin\""},
        {"set @rc-frame-3-storey section colum A=1", "colum"},
        {"set @rc-frame-3-storey section column B=1", "unknown key \"B\""},
        {"set @rc-frame-3-storey section column A=-1", "A: "},
        {"set @rc-frame-3-storey section column A", "PATH=VALUE"},
        {"set @rc-frame-3-storey section column", "Nothing is set"},
        {"add @rc-frame-3-storey stage steps=0", "steps: "},
        {"add @first-steps ulf_item", "make this first: combination"},
        {"delete @rc-frame-3-storey node 22", "element 112"},
    };
    for (const auto& c : kCases) {
        ExpectRefused(std::string("record ") + c.arguments + " -o no.json", 2, c.says);
        EXPECT_FALSE(std::filesystem::exists(m_folder / "no.json")) << c.arguments;
    }
    Write("own.json", kSmallCase);
    ExpectRefused("record set own.json model title=x -o own.json --overwrite", 2, "another name");
}

} // namespace
