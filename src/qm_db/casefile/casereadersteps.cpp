#include "qm_db/casefile/casereader.h"
#include "qm_db/casefile/jsonnames.h"
#include "qm_db/file/recorderfile.h"

#include <algorithm>
#include <map>

namespace {

using T_SERIES = std::vector<double>;

constexpr std::array<const char*, 2> kDecimalNames{"point", "comma"};
constexpr std::array<RECORDER_DECIMAL, 2> kDecimals{RECORDER_DECIMAL::Point,
                                                    RECORDER_DECIMAL::Comma};

/// Reads one series of values per step, in the file's units, from `in` into `out`.
class ISeriesSource {
public:
    virtual ~ISeriesSource() = default;
    virtual void Read(CJsonReader& in, T_SERIES& out) = 0;
};

/// Values that stand in the case file itself.
class CInlineSource : public ISeriesSource {
public:
    void Read(CJsonReader& in, T_SERIES& out) override { in.Read(out); }
};

/// Values in tables of another solver; a table is read once.
class CRecorderSource : public ISeriesSource {
public:
    CRecorderSource(CJsonReader& files, const T_CASE_FOLDER& folder) : m_folder(folder.path)
    {
        m_options.allowOutside = folder.allowOutside;
        files.GetIf("skip_rows", m_options.skipRows);
        files.Check("skip_rows", m_options.skipRows >= 0, "IDS_QM_CASE_SKIP_ROWS");
        if (files.Has("decimal")) {
            const int at = files.Choice("decimal", kDecimalNames, "IDS_QM_CHOICE_DECIMAL");
            m_options.decimal = kDecimals[static_cast<std::size_t>(at)];
        }
        if (files.Has("first_row")) {
            files.Choice("first_row", std::array{kStateBeforePush}, "IDS_QM_CHOICE_FIRST_ROW");
            m_subtractFirst = true;
        }
    }

    void Read(CJsonReader& in, T_SERIES& out) override
    {
        in.Keys({"path", "column", "columns", "scale"});
        const CRecorderFile* file = FileOf(in);
        if (!file) return;
        T_SERIES values(file->RowCount(), 0.0);
        AddColumns(in, *file, values);
        Scale(in, values);
        if (m_subtractFirst) SubtractFirst(values);
        if (!in.Failed()) out = std::move(values);
    }

private:
    const CRecorderFile* FileOf(CJsonReader& in)
    {
        std::string path;
        in.Get("path", path);
        if (in.Failed()) return nullptr;
        CRecorderFile& file = m_files[path];
        T_FILE_ERROR error;
        if (!file.IsLoaded() && !file.Load(m_folder, path, m_options, error)) {
            in.FailWith(error.text, error.fault);
            return nullptr;
        }
        if (m_firstPath.empty()) m_firstPath = path;
        const CRecorderFile& first = m_files[m_firstPath];
        if (file.RowCount() != first.RowCount())
            in.Fail("IDS_QM_CASE_ROWS", path, std::to_string(file.RowCount()),
                    std::to_string(file.LastLine()), std::to_string(first.RowCount()), m_firstPath);
        return &file;
    }

    static void AddColumns(CJsonReader& in, const CRecorderFile& file, T_SERIES& sum)
    {
        if (in.Has("column") == in.Has("columns")) return in.Fail("IDS_QM_CASE_COLUMN_EITHER");
        const auto add = [&](CJsonReader& item, std::size_t) { AddColumn(item, file, sum); };
        if (in.Has("columns")) return in.Member("columns").ForEachItem(add);
        CJsonReader column = in.Member("column");
        add(column, 0);
    }

    static void AddColumn(CJsonReader& in, const CRecorderFile& file, T_SERIES& sum)
    {
        int column = 0;
        std::string name;
        T_FILE_ERROR error;
        if (in.IsText()) {
            in.Read(name);
            if (!file.FindColumn(name, column, error)) return in.FailWith(error.text);
        } else {
            in.Read(column);
            if (column < 1) in.Fail("IDS_QM_CASE_COLUMNS_FROM_1");
        }
        if (!in.Failed() && !file.AddColumn(column, sum, error)) in.FailWith(error.text);
    }

    static void Scale(CJsonReader& in, T_SERIES& values)
    {
        double scale = 1.0;
        in.GetIf("scale", scale);
        for (double& value : values)
            value *= scale;
    }

    static void SubtractFirst(T_SERIES& values)
    {
        if (values.empty()) return;
        const double first = values.front();
        values.erase(values.begin());
        for (double& value : values)
            value -= first;
    }

    std::string m_folder;
    CRecorderFile::T_OPTIONS m_options;
    bool m_subtractFirst = false;
    std::map<std::string, CRecorderFile> m_files; // by the path in the case file
    std::string m_firstPath;                      // the others have as many rows
};

/// One series to SI; `count` is the number of steps where it is known.
void ReadSeries(CJsonReader& in, ISeriesSource& source, std::optional<std::size_t> count,
                double factor, T_SERIES& out)
{
    source.Read(in, out);
    if (count && out.size() != *count)
        in.Fail("IDS_QM_JSON_COUNT", std::to_string(out.size()), std::to_string(*count));
    for (double& value : out) {
        value *= factor;
        if (!IsUsableNumber(value)) return in.Fail("IDS_QM_CASE_TOO_LARGE");
    }
}

bool IsAllZero(const T_SERIES& values)
{
    return std::all_of(values.begin(), values.end(), [](double v) { return v == 0.0; });
}

/// A curve without displacement or force has no stiffness: nothing can be evaluated.
void CheckCurve(CJsonReader& in, const T_POLC_D& push, const T_PUSH_DATA& data)
{
    const std::string node = std::to_string(push.controlNode);
    const auto control = data.displacement.find(push.controlNode);
    if (control == data.displacement.end())
        return in.FailAt("displacement", "IDS_QM_CASE_CONTROL_MISSING", node);
    if (IsAllZero(control->second))
        in.FailAt("displacement", "IDS_QM_CASE_ZERO_DISPLACEMENT", node);
    if (IsAllZero(data.baseReaction)) in.FailAt("base_reaction", "IDS_QM_CASE_ZERO_FORCE");
}

void ReadTables(CJsonReader& in, ISeriesSource& source, const T_MODEL& model, const T_POLC_D& push,
                T_PUSH_DATA& out)
{
    CJsonReader factors = in.Member("load_factor");
    ReadSeries(factors, source, std::nullopt, 1.0, out.loadFactor);
    const std::size_t count = out.loadFactor.size();
    if (count == 0) factors.Fail("IDS_QM_CASE_NO_STEPS");

    const T_UNITS& units = model.styp.units;
    CJsonReader reactions = in.Member("base_reaction");
    ReadSeries(reactions, source, count, SiFactor(units, ReactionDim(push.direction)),
               out.baseReaction);
    const double factor = SiFactor(units, DisplacementDim(push.direction));
    in.Member("displacement").ForEachNode([&](CJsonReader& values, int node) {
        if (!model.nodes.contains(node)) values.Fail("IDS_QM_CASE_NO_NODE");
        ReadSeries(values, source, count, factor, out.displacement[node]);
    });
    CheckCurve(in, push, out);
}

} // namespace

void ReadSteps(CJsonReader& steps, const T_CASE_FOLDER& folder, const T_MODEL& model,
               const T_POLC_D& push, T_PUSH_DATA& out)
{
    if (!steps.Has("files")) {
        steps.Keys({"load_factor", "base_reaction", "displacement"});
        CInlineSource source;
        return ReadTables(steps, source, model, push, out);
    }
    steps.Keys({"files"});
    CJsonReader files = steps.Member("files");
    files.Keys(
        {"skip_rows", "first_row", "decimal", "load_factor", "base_reaction", "displacement"});
    CRecorderSource source(files, folder);
    ReadTables(files, source, model, push, out);
}
