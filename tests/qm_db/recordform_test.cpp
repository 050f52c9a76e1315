// The form of any record: what it lists, sets and refuses, against the case file of the model.
#include "casetext.h"
#include "qm_db/form/anyrecord.h"
#include "qm_db/form/jsontree.h"
#include "qm_db/recordform.h"
#include "qm_db/records/evalnames.h"

#include <algorithm>
#include <gtest/gtest.h>

namespace {

void Load(CDBDoc& doc, const std::string& path)
{
    T_FILE_ERROR error;
    ASSERT_EQ(1, doc.ImportCase(path, error)) << error.text;
}
std::string Example(const char* name)
{
    return std::string(QM_PROJECT "/examples/") + name + "/case.json";
}
std::string TextOf(const CDBDoc& doc)
{
    return PrintGood(doc.Data().Content());
}

/// Paths of all values in an object of a case file.
void Leaves(const T_JSON& at, const std::string& place, std::vector<std::string>& paths)
{
    const auto go = [&](const std::string& key) {
        Leaves(*JsonAt(at, key), JoinPath(place, key), paths);
    };
    if (const auto* members = std::get_if<T_JSON_MEMBERS>(&at.data))
        for (const T_JSON_MEMBER& member : *members)
            go(member.key);
    else if (std::holds_alternative<T_JSON_ITEMS>(at.data) ||
             std::holds_alternative<T_JSON_NUMBERS>(at.data))
        for (std::size_t i = 0; JsonAt(at, std::to_string(i)) && i < 200; ++i)
            go(std::to_string(i));
    else
        paths.push_back(place);
}

/// Every value of the case file has a row, and a row that is set to its own text changes nothing.
void ExpectWhole(CDBDoc& doc, RECORD_KIND kind, int key, const std::string& label)
{
    CRecordForm form(doc, kind, {key});
    const std::vector<T_FIELD_ROW> rows = form.Rows();
    const T_MODEL& model = doc.Data().Model();
    T_JSON object;
    std::string reason;
    ASSERT_EQ(1, PrintAny({model, key}, FindAny(model, kind, key), kSiUnits, object, reason));
    std::vector<std::string> leaves;
    Leaves(object, {}, leaves);
    for (const std::string& path : leaves)
        EXPECT_EQ(1, std::ranges::count(rows, path, &T_FIELD_ROW::path)) << label << path;
    for (const T_FIELD_ROW& row : rows) {
        if (!row.isThere || row.text.size() > 2000) continue;
        EXPECT_EQ(1, form.Set(row.path, row.text)) << label << row.path << form.Reason();
    }
}

} // namespace

TEST(RecordForm, ListsEveryMemberAndItsOwnTextChangesNothing)
{
    const std::string cases = QM_TEST_DATA "/cases/";
    for (const std::string& path :
         {cases + "hinge_all_members.json", cases + "all_members.json",
          cases + "push_all_members.json", cases + "struct_all_members.json",
          cases + "stage_all_members.json", Example("rc-space-frame-3-storey"),
          Example("cable-stayed-bridge-staged"), Example("rc-frame-code-hinges")}) {
        CDBDoc doc;
        Load(doc, path);
        const std::string before = TextOf(doc);
        for (const RECORD_KIND kind : AllKinds()) {
            std::vector<int> keys = KeysOf(doc.Data().Model(), kind);
            keys.resize(std::min<std::size_t>(keys.size(), 8)); // those behind are of their like
            for (const int key : keys)
                ExpectWhole(doc, kind, key, path + KindWord(kind) + std::to_string(key) + ' ');
        }
        EXPECT_FALSE(doc.Undo().CanUndo()) << path << doc.Undo().UndoTitle();
        EXPECT_EQ(before, TextOf(doc)) << path;
    }
}

TEST(RecordForm, WhatIsSetStandsInTheCaseFile)
{
    const struct {
        RECORD_KIND kind;
        const char *record, *path, *text, *json;
    } kCases[] = {
        {KindOf<T_NODE_D>(), "22", "xyz/0", "1.25", "{\"id\": 22, \"xyz\": [1.25,"},
        {KindOf<T_NODE_D>(), "22", "xyz", "[0.5, 0, 7]", "{\"id\": 22, \"xyz\": [0.5, 0, 7]"},
        {KindOf<T_SECT_D>(), "column", "size", "24, 20", "\"size\": [24, 20]"},
        {KindOf<T_MATL_D>(), "concrete", "knowledge", "KL2", "\"knowledge\": \"KL2\""},
        {KindOf<T_MATL_D>(), "concrete", "mean/fc", "4.5", "\"mean\": {\"fc\": 4.5}"},
        {KindOf<T_ELEM_D>(), "111", "release/I", "Ry, Rz",
         "\"release\": {\"I\": [\"Ry\", \"Rz\"]}"},
        {KindOf<T_STOR_D>(), "1", "nodes", "21-23", "\"nodes\": [21, 22, 23]"},
        {kModelOptionsKind, "0", "title", "A \"new\" one", "\"title\": \"A \\\"new\\\" one\""},
        {kModelOptionsKind, "0", "gravity", "386.0886", "\"gravity\": 386.0886"},
        {kPushControlKind, "0", "p_delta", "updated", "\"p_delta\": \"updated\""},
    };
    CDBDoc doc;
    Load(doc, Example("rc-frame-3-storey"));
    for (const auto& c : kCases) {
        const auto key = FindRecord(doc.Data().Model(), c.kind, c.record);
        ASSERT_TRUE(key) << c.record;
        CRecordForm form(doc, c.kind, {*key});
        const std::string before = TextOf(doc);
        EXPECT_EQ(1, form.Set(c.path, c.text)) << c.path << form.Reason();
        EXPECT_NE(std::string::npos, TextOf(doc).find(c.json)) << c.json;
        EXPECT_TRUE(SameContent(doc.Data().Content(), ParseGood(TextOf(doc)))) << c.path;
        EXPECT_EQ(1, doc.Undo().Undo()); // one step
        EXPECT_EQ(before, TextOf(doc)) << c.path;
    }
}

TEST(RecordForm, AChoiceBringsWhatDependsOnIt)
{
    CDBDoc doc;
    Load(doc, Example("rc-frame-3-storey"));
    const T_MODEL& model = doc.Data().Model();
    int key = 0;
    std::string reason;
    ASSERT_EQ(1, MakeRecord(doc, KindOf<T_SPFC_D>(), "S", key, reason)) << reason;
    CRecordForm spectrum(doc, KindOf<T_SPFC_D>(), {key});
    for (std::size_t i = 0; i < kSpectrumKinds.size(); ++i) {
        EXPECT_EQ(1, spectrum.Set("kind", kSpectrumKinds[i])) << spectrum.Reason();
        EXPECT_EQ(i, model.spectra.at(key).data.index());
    }
    ASSERT_EQ(1, MakeRecord(doc, KindOf<T_ULFC_D>(), "C", key, reason)) << reason;
    CRecordForm constraint(doc, KindOf<T_ULFC_D>(), {key});
    ASSERT_EQ(1, constraint.Set("upper", "0.5")) << constraint.Reason(); // in place of "equal"
    ASSERT_EQ(1, constraint.Set("lower", "-0.5")) << constraint.Reason();
    EXPECT_TRUE(model.ulfConstraints.at(key).inequality && model.ulfConstraints.at(key).lower);
    ASSERT_EQ(1, constraint.Set("equal", "0")) << constraint.Reason();
    EXPECT_FALSE(model.ulfConstraints.at(key).inequality);
    CRecordForm element(doc, KindOf<T_ELEM_D>(), {111});
    ASSERT_EQ(1, element.Set("kind", "spring")) << element.Reason();
    EXPECT_EQ(0, model.elements.at(111).nodeJ);
    CRecordForm user(doc, KindOf<T_SPFC_D>(), {FindRecord(model, KindOf<T_SPFC_D>(), "S").value()});
    ASSERT_EQ(1, user.Add("T")) << user.Reason(); // with its ordinate
    EXPECT_EQ(3u, std::get<T_SPFC_USER>(model.spectra.at(user.Keys()[0]).data).Sa.size());
    const CRecordForm::T_SETTING both[] = {{"T", "0, 0.5"}, {"Sa", "0.1, 0.2"}};
    EXPECT_EQ(1, user.Set(both)) << user.Reason();
}

TEST(RecordForm, RefusesInWordsAndChangesNothing)
{
    const struct {
        RECORD_KIND kind;
        const char *record, *path, *text, *words;
    } kCases[] = {
        {KindOf<T_NODE_D>(), "22", "id", "3", "id: the id of a record that is there"},
        {KindOf<T_NODE_D>(), "22", "xyz/1", "1,5", "xyz/1: \"1,5\" is not a number"},
        {KindOf<T_NODE_D>(), "22", "mass", "[-1, 0, 0]", "mass[0]: "},
        {KindOf<T_NODE_D>(), "22", "weight", "1", "unknown key"},
        {KindOf<T_ELEM_D>(), "111", "section", "none such", "section: "},
        {KindOf<T_ELEM_D>(), "111", "nodes/1", "4711", "nodes[1]: "},
        {KindOf<T_ELEM_D>(), "111", "nodes", "1e300", "\"1e300\" is not a number"},
        {KindOf<T_ELEM_D>(), "111", "nodes", "1.5, 2", "\"1.5\" is not a number"},
        {KindOf<T_SECT_D>(), "column", "name", "beam", "name: "},
        {KindOf<T_SECT_D>(), "column", "fillet", "-1", "fillet: "},
        {kPushControlKind, "0", "steps", "0", "steps: "},
        {kModelOptionsKind, "0", "units/force", "pound", "units.force: "},
        {KindOf<T_EVAL_D>(), "1", "push", "nowhere", "push: "},
    };
    CDBDoc doc;
    Load(doc, Example("rc-frame-3-storey"));
    const std::string before = TextOf(doc);
    for (const auto& c : kCases) {
        const auto key = FindRecord(doc.Data().Model(), c.kind, c.record);
        ASSERT_TRUE(key) << c.record;
        CRecordForm form(doc, c.kind, {*key});
        EXPECT_EQ(0, form.Set(c.path, c.text)) << c.path;
        EXPECT_NE(std::string::npos, form.Reason().find(c.words)) << c.path << form.Reason();
        EXPECT_EQ(before, TextOf(doc)) << c.path;
    }
    const T_MODEL& model = doc.Data().Model();
    CRecordForm spectrum(doc, KindOf<T_SPFC_D>(), {model.spectra.begin()->first});
    EXPECT_EQ(0, spectrum.Set("name", "other")) << "evaluations know it by its name";
    EXPECT_NE(std::string::npos, spectrum.Reason().find("evaluation")) << spectrum.Reason();
    std::string reason;
    const int used[] = {model.nodes.begin()->first};
    EXPECT_EQ(0, DeleteRecords(doc, KindOf<T_NODE_D>(), used, reason));
    EXPECT_NE(std::string::npos, reason.find("element")) << reason;
    EXPECT_EQ(before, TextOf(doc));
}

TEST(RecordForm, SetsSeveralRecordsInOneStep)
{
    CDBDoc doc;
    Load(doc, Example("rc-frame-3-storey"));
    CRecordForm form(doc, KindOf<T_NODE_D>(), {21, 22, 23});
    const auto rows = form.Rows();
    const auto various = form.Various(rows);
    EXPECT_NE(various.end(), std::ranges::find(various, "xyz"));
    const std::string before = TextOf(doc);
    ASSERT_EQ(1, form.Set("mass", "1, 2, 3")) << form.Reason();
    for (const int id : {21, 22, 23})
        EXPECT_EQ("[1, 2, 3]", CRecordForm(doc, KindOf<T_NODE_D>(), {id}).Row("mass")->text);
    EXPECT_EQ(1, doc.Undo().Undo());
    EXPECT_EQ(before, TextOf(doc));
}

TEST(RecordForm, MakesDuplicatesAndDeletesEveryKind)
{
    CDBDoc empty;
    int key = 0;
    std::string reason;
    EXPECT_EQ(0, MakeRecord(empty, KindOf<T_ELEM_D>(), "", key, reason));
    EXPECT_NE(std::string::npos, reason.find("node")) << reason;

    CDBDoc doc;
    Load(doc, std::string(QM_TEST_DATA "/cases/stage_all_members.json"));
    for (const RECORD_KIND kind : AllKinds()) {
        if (kind == kModelOptionsKind || kind == kPushControlKind) continue;
        const std::string before = TextOf(doc);
        const std::string word = KindWord(kind);
        ASSERT_EQ(1, MakeRecord(doc, kind, "", key, reason)) << word << reason;
        EXPECT_EQ("", doc.Data().Fault()) << word;
        const bool counts = kind == KindOf<T_POVR_D>(); // one for each load case
        int copy = 0;
        if (!counts) {
            ASSERT_EQ(1, DuplicateRecord(doc, kind, key, copy, reason)) << word << reason;
            EXPECT_GT(copy, key) << word;
            EXPECT_TRUE(NameOfRecord(doc.Data().Model(), kind, copy).empty() ||
                        NameOfRecord(doc.Data().Model(), kind, copy) !=
                            NameOfRecord(doc.Data().Model(), kind, key))
                << word;
        }
        EXPECT_TRUE(SameContent(doc.Data().Content(), ParseGood(TextOf(doc)))) << word;
        std::vector<int> made{key};
        if (!counts) made.push_back(copy);
        ASSERT_EQ(1, DeleteRecords(doc, kind, made, reason)) << word << reason;
        EXPECT_EQ(before, TextOf(doc)) << word;
        ASSERT_EQ(1, doc.Undo().Undo()); // they stay for the kinds that refer to them
    }
}
