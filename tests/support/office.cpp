#include "office.h"

#include "qm_base/textformat.h"

#include <cstdlib>
#include <sstream>

namespace fs = std::filesystem;

namespace {

constexpr const char* kProfile = R"(<?xml version="1.0" encoding="UTF-8"?>
<oor:items xmlns:oor="http://openoffice.org/2001/registry">
<item oor:path="/org.openoffice.Office.Calc/Formula/Load">
<prop oor:name="OOXMLRecalcMode" oor:op="fuse"><value>0</value></prop></item>
</oor:items>
)";

// Arguments: file, cell, number.
constexpr const char* kPutNumber = R"(
import re, sys, zipfile
path, cell, number = sys.argv[1:]
with zipfile.ZipFile(path) as old:
    parts = [(info, old.read(info)) for info in old.infolist()]
done = 0
with zipfile.ZipFile(path, "w", zipfile.ZIP_DEFLATED) as new:
    for info, data in parts:
        if info.filename == "xl/worksheets/sheet1.xml":
            pattern = r'(<c r="%s"(?: s="\d+")?><v>)[^<]*(</v>)' % cell
            text, done = re.subn(pattern, r"\g<1>%s\g<2>" % number, data.decode())
            data = text.encode()
        new.writestr(info, data)
sys.exit(0 if done == 1 else 1)
)";

std::string Quoted(const std::string& text)
{
    std::string out = "'";
    for (const char c : text)
        out += c == '\'' ? std::string("'\\''") : std::string(1, c);
    return out + "'";
}

bool Succeeds(const std::string& line)
{
    return std::system((line + " >/dev/null 2>&1").c_str()) == 0;
}

std::vector<std::string> SplitRow(const std::string& line)
{
    std::vector<std::string> cells(1);
    bool quoted = false;
    for (const char c : line) {
        if (c == '"')
            quoted = !quoted;
        else if (c == ';' && !quoted)
            cells.emplace_back();
        else
            cells.back() += c;
    }
    return cells;
}

} // namespace

bool COffice::IsThere()
{
    static const bool there =
        Succeeds("command -v soffice") && Succeeds("python3 -c 'import zipfile'");
    return there;
}

COffice::COffice()
{
    fs::create_directories(m_folder.Path() / "profile/user");
    WriteText(m_folder / "profile/user/registrymodifications.xcu", kProfile);
}

OFFICE_CELLS COffice::Convert(const std::string& sheet, bool formulas) const
{
    // Semicolons between, UTF-8, numbers as they are and not as they are shown.
    const std::string filter =
        std::string("csv:Text - txt - csv (StarCalc):59,34,76,1,,0,false,false,false,") +
        (formulas ? "true" : "false");
    if (!Succeeds("LC_ALL=C.UTF-8 timeout 120 soffice -env:UserInstallation=file://" +
                  Quoted(m_folder / "profile") + " --headless --convert-to " + Quoted(filter) +
                  " --outdir " + Quoted(m_folder.Path().string()) + " " + Quoted(sheet)))
        return {};
    std::ifstream csv(m_folder.Path() / fs::path(sheet).filename().replace_extension(".csv"));
    OFFICE_CELLS rows;
    for (std::string line; std::getline(csv, line);)
        rows.push_back(SplitRow(line));
    return rows;
}

OFFICE_CELLS COffice::Recalculated(const std::string& sheet) const
{
    return Convert(sheet, false);
}

OFFICE_CELLS COffice::Formulas(const std::string& sheet) const
{
    return Convert(sheet, true);
}

bool COffice::PutNumber(const std::string& sheet, const std::string& cell, double value)
{
    return Succeeds("python3 -c " + Quoted(kPutNumber) + " " + Quoted(sheet) + " " + Quoted(cell) +
                    " " + ShortestText(value));
}
