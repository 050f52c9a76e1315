#include "record/recordcommands.h"

#include "console/tabletext.h"
#include "inputfile.h"
#include "output.h"
#include "qm_base/say.h"
#include "qm_db/recordform.h"
#include "qm_rps/desk/fieldhead.h"
#include "qm_rps/desk/gridexport.h"
#include "qm_rps/section/sectionexport.h"
#include "json/jsontext.h"

#include <cstdio>

namespace {

using T_SETTINGS = std::vector<CRecordForm::T_SETTING>;

EXIT_CODE Refuse(const T_RECORD_OPTIONS& o, const std::string& why)
{
    return Complain(EXIT_CODE::Usage, o.file + ": " + why);
}

EXIT_CODE Open(CDBDoc& doc, const T_RECORD_OPTIONS& o)
{
    std::vector<T_OUTPUT> outputs;
    if (!o.out.empty()) outputs.push_back({o.out, OUTPUT_KIND::Document});
    if (!o.json.empty()) outputs.push_back({o.json, OUTPUT_KIND::Json});
    if (!o.csv.empty()) outputs.push_back({o.csv, OUTPUT_KIND::Text});
    if (!o.sheet.empty()) outputs.push_back({o.sheet, OUTPUT_KIND::Sheet});
    if (const EXIT_CODE code = CheckOutputs(o.file, outputs, o.overwrite); code != EXIT_CODE::Done)
        return code;
    return OpenInput(doc, o.file);
}

/// Done, or the code to exit with: the words of kinds are told.
EXIT_CODE FindKind(const T_RECORD_OPTIONS& o, RECORD_KIND& kind)
{
    const std::optional<RECORD_KIND> found = KindOfWord(o.kind);
    if (found) {
        kind = *found;
        return EXIT_CODE::Done;
    }
    std::string words;
    for (const RECORD_KIND known : AllKinds())
        words += (words.empty() ? "" : ", ") + std::string(KindWord(known));
    return Refuse(o, Say("IDS_QM_CLI_NO_KIND", o.kind, words));
}

EXIT_CODE FindKey(const CDBDoc& doc, const T_RECORD_OPTIONS& o, RECORD_KIND kind,
                  const std::string& which, int& key)
{
    const bool once = kind == kModelOptionsKind || kind == kPushControlKind;
    const std::optional<int> found =
        once ? std::optional<int>(0) : FindRecord(doc.Data().Model(), kind, which);
    if (!found) return Refuse(o, Say("IDS_QM_FORM_NO_RECORD", o.kind, which));
    key = *found;
    return EXIT_CODE::Done;
}

/// "path=text" as a setting.
EXIT_CODE TakeSettings(const T_RECORD_OPTIONS& o, T_SETTINGS& settings)
{
    for (const std::string& word : o.settings) {
        const std::size_t at = word.find('=');
        if (at == std::string::npos || at == 0)
            return Refuse(o, Say("IDS_QM_CLI_RECORD_SETTING", word));
        settings.push_back({word.substr(0, at), word.substr(at + 1)});
    }
    return EXIT_CODE::Done;
}

std::string RowsText(const std::vector<T_FIELD_ROW>& rows, const T_UNITS& units, bool all)
{
    T_TABLE_ROWS table{{Say("IDS_QM_CLI_RECORD_MEMBER"), Say("IDS_QM_CLI_RECORD_VALUE")}};
    for (const T_FIELD_ROW& row : rows) {
        const bool holds = row.kind == FIELD_KIND::Group ||
                           (row.kind == FIELD_KIND::List && row.items == FIELD_KIND::Group);
        const bool inList = row.depth > 0 && row.kind != FIELD_KIND::Group &&
                            row.key.find_first_not_of("0123456789") == std::string::npos;
        if ((!row.isThere && !all) || (holds && row.isThere) || inList) continue;
        const std::string value = row.isThere ? row.text : Say("IDS_QM_CLI_RECORD_LEFT_OUT");
        table.push_back({FieldHead(row.path, row, units), value});
    }
    return TableText(table);
}

std::string RowsJson(const std::vector<T_FIELD_ROW>& rows, const T_UNITS& units)
{
    CJsonText out(JSON_REALS::Shortest);
    out.List();
    for (const T_FIELD_ROW& row : rows) {
        out.Object(kJsonOneLine);
        out.Member("path", row.path).Member("head", FieldHead(row.key, row, units));
        if (row.isThere)
            out.Member("value", row.text);
        else
            out.Member("value", nullptr);
        out.Items("choices", row.choices, kJsonOneLine);
        out.End();
    }
    out.End();
    return out.Text();
}

EXIT_CODE ShowRecord(CDBDoc& doc, const T_RECORD_OPTIONS& o, RECORD_KIND kind, int key)
{
    CRecordForm form(doc, kind, {key});
    const std::vector<T_FIELD_ROW> rows = form.Rows(doc.Data().Model().nodes.size() + 100000);
    if (rows.empty() && !form.Reason().empty())
        return Complain(EXIT_CODE::BadInput, o.file + ": " + form.Reason());
    if (!o.json.empty()) return WriteOutput(o.json, RowsJson(rows, doc.Unit().Units()));
    return WriteOutput("-", RowsText(rows, doc.Unit().Units(), o.all));
}

EXIT_CODE Save(CDBDoc& doc, const T_RECORD_OPTIONS& o, RECORD_KIND kind, int key)
{
    if (const EXIT_CODE code = SaveDocument(doc, o.out); code != EXIT_CODE::Done) return code;
    return ShowRecord(doc, o, kind, key);
}

/// Members that are set, then what is added to lists, then what is taken away.
int Change(CRecordForm& form, const T_RECORD_OPTIONS& o, const T_SETTINGS& settings)
{
    if (!settings.empty() && !form.Set(settings)) return 0;
    for (const std::string& path : o.add)
        if (!form.Add(path)) return 0;
    for (const std::string& path : o.remove)
        if (!form.Remove(path)) return 0;
    return 1;
}

std::string NamesJson(const T_MODEL& model, RECORD_KIND kind)
{
    CJsonText out(JSON_REALS::Shortest);
    out.List();
    for (const int key : KeysOf(model, kind)) {
        out.Object(kJsonOneLine);
        out.Member("key", key).Member("name", NameOfRecord(model, kind, key));
        out.End();
    }
    out.End();
    return out.Text();
}

std::string KindsJson(const T_MODEL& model)
{
    CJsonText out(JSON_REALS::Shortest);
    out.List();
    for (const RECORD_KIND kind : AllKinds()) {
        out.Object(kJsonOneLine);
        out.Member("kind", KindWord(kind)).Member("records", KeysOf(model, kind).size());
        out.End();
    }
    out.End();
    return out.Text();
}

/// The table of the kind as the window has it.
EXIT_CODE WriteTable(CDBDoc& doc, const T_RECORD_OPTIONS& o, RECORD_KIND kind)
{
    const std::optional<EXPLORER_TABLE> table = TableOfKind(kind);
    if (!table) return Refuse(o, Say("IDS_QM_CLI_RECORD_TABLE", KindWord(kind)));
    const T_TEXT_TABLE rows = TableOfGrid(*MakeRecordGrid(doc, *table));
    EXIT_CODE code = EXIT_CODE::Done;
    T_FILE_ERROR error;
    if (!o.csv.empty()) code = WriteOutput(o.csv, TableCsv(rows));
    if (code == EXIT_CODE::Done && !o.sheet.empty() &&
        !WriteSheet(o.sheet, TableSheet(rows), error))
        code = ReportFileError(error);
    for (const std::string& path : {o.csv, o.sheet})
        if (code == EXIT_CODE::Done && !path.empty() && path != "-")
            std::printf("%s\n", path.c_str());
    return code;
}

} // namespace

EXIT_CODE RunRecordList(const T_RECORD_OPTIONS& o)
{
    CDBDoc doc;
    RECORD_KIND kind = kModelOptionsKind;
    if (!o.kind.empty())
        if (const EXIT_CODE code = FindKind(o, kind); code != EXIT_CODE::Done) return code;
    if (const EXIT_CODE code = Open(doc, o); code != EXIT_CODE::Done) return code;
    const T_MODEL& model = doc.Data().Model();
    if (!o.csv.empty() || !o.sheet.empty()) return WriteTable(doc, o, kind);
    if (!o.json.empty())
        return WriteOutput(o.json, o.kind.empty() ? KindsJson(model) : NamesJson(model, kind));
    T_TABLE_ROWS table;
    if (o.kind.empty()) {
        table.push_back({Say("IDS_QM_CLI_RECORD_COUNT"), Say("IDS_QM_CLI_RECORD_KIND")});
        for (const RECORD_KIND each : AllKinds())
            table.push_back({std::to_string(KeysOf(model, each).size()), KindWord(each)});
    } else {
        table.push_back({Say("IDS_QM_CLI_RECORD_KEY"), Say("IDS_QM_UI_HEAD_NAME")});
        for (const int key : KeysOf(model, kind))
            table.push_back({std::to_string(key), NameOfRecord(model, kind, key)});
    }
    return WriteOutput("-", TableText(table));
}

EXIT_CODE RunRecordShow(const T_RECORD_OPTIONS& o)
{
    CDBDoc doc;
    RECORD_KIND kind{};
    int key = 0;
    if (const EXIT_CODE code = FindKind(o, kind); code != EXIT_CODE::Done) return code;
    if (const EXIT_CODE code = Open(doc, o); code != EXIT_CODE::Done) return code;
    if (const EXIT_CODE code = FindKey(doc, o, kind, o.record, key); code != EXIT_CODE::Done)
        return code;
    return ShowRecord(doc, o, kind, key);
}

EXIT_CODE RunRecordSet(const T_RECORD_OPTIONS& o)
{
    CDBDoc doc;
    RECORD_KIND kind{};
    int key = 0;
    T_SETTINGS settings;
    if (const EXIT_CODE code = FindKind(o, kind); code != EXIT_CODE::Done) return code;
    T_RECORD_OPTIONS wanted = o;
    const bool once = kind == kModelOptionsKind || kind == kPushControlKind;
    if (once && !o.record.empty() && o.record != "0") { // it has no name to give
        wanted.settings.insert(wanted.settings.begin(), o.record);
        wanted.record.clear();
    }
    if (const EXIT_CODE code = TakeSettings(wanted, settings); code != EXIT_CODE::Done) return code;
    if (settings.empty() && o.add.empty() && o.remove.empty())
        return Refuse(o, Say("IDS_QM_CLI_RECORD_NOTHING"));
    if (const EXIT_CODE code = Open(doc, o); code != EXIT_CODE::Done) return code;
    if (const EXIT_CODE code = FindKey(doc, wanted, kind, o.record, key); code != EXIT_CODE::Done)
        return code;
    CRecordForm form(doc, kind, {key});
    if (!Change(form, o, settings)) return Refuse(o, form.Reason());
    return Save(doc, o, kind, key);
}

EXIT_CODE RunRecordAdd(const T_RECORD_OPTIONS& o)
{
    CDBDoc doc;
    RECORD_KIND kind{};
    int key = 0;
    std::string reason;
    T_SETTINGS settings;
    if (const EXIT_CODE code = FindKind(o, kind); code != EXIT_CODE::Done) return code;
    if (const EXIT_CODE code = TakeSettings(o, settings); code != EXIT_CODE::Done) return code;
    if (const EXIT_CODE code = Open(doc, o); code != EXIT_CODE::Done) return code;
    if (!o.copy.empty()) {
        int from = 0;
        if (const EXIT_CODE code = FindKey(doc, o, kind, o.copy, from); code != EXIT_CODE::Done)
            return code;
        if (!o.record.empty()) settings.insert(settings.begin(), {"name", o.record});
        if (!DuplicateRecord(doc, kind, from, key, reason)) return Refuse(o, reason);
        CRecordForm form(doc, kind, {key});
        if (!Change(form, o, settings)) return Refuse(o, form.Reason());
    } else if (!MakeRecord(doc, kind, o.record, settings, key, reason)) {
        return Refuse(o, reason);
    }
    return Save(doc, o, kind, key);
}

EXIT_CODE RunRecordDelete(const T_RECORD_OPTIONS& o)
{
    CDBDoc doc;
    RECORD_KIND kind{};
    std::vector<int> keys;
    if (const EXIT_CODE code = FindKind(o, kind); code != EXIT_CODE::Done) return code;
    if (const EXIT_CODE code = Open(doc, o); code != EXIT_CODE::Done) return code;
    for (const std::string& which : o.records)
        if (const EXIT_CODE code = FindKey(doc, o, kind, which, keys.emplace_back());
            code != EXIT_CODE::Done)
            return code;
    std::string reason;
    if (!DeleteRecords(doc, kind, keys, reason)) return Refuse(o, reason);
    if (const EXIT_CODE code = SaveDocument(doc, o.out); code != EXIT_CODE::Done) return code;
    for (const std::string& which : o.records)
        std::printf("%s\n", Say("IDS_QM_CLI_RECORD_DELETED", o.kind, which).c_str());
    return EXIT_CODE::Done;
}
