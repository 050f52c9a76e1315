#include "qm_rps/document/documenthtml.h"

#include "qm_base/say.h"
#include "qm_rps/generate/codehingerows.h"

#include <algorithm>

namespace {

constexpr const char* kStyle = R"(
:root{--ink:#1c2430;--soft:#5b6675;--line:#c9d0d9;--head:#eef1f5;--page:#fff;--good:#1b7f3b;
--bad:#b3261e;--warn:#8a5a00;--key:#1f4e8c}
@media(prefers-color-scheme:dark){:root{--ink:#e4e8ee;--soft:#a3adba;--line:#465060;--head:#29313c;
--page:#171c23;--good:#6fd08c;--bad:#ff8a80;--warn:#f0b95a;--key:#8fb8f2}}
*{box-sizing:border-box}
body{margin:0 auto;max-width:62rem;padding:2rem 1.5rem 4rem;font:15px/1.5 "DejaVu Sans",Arial,
sans-serif;color:var(--ink);background:var(--page)}
h1{font-size:1.9rem;margin:0 0 .2rem}h2{font-size:1.35rem;margin:2.4rem 0 .6rem;
border-bottom:2px solid var(--key);padding-bottom:.2rem}h3{font-size:1.1rem;margin:1.6rem 0 .4rem}
.sub{color:var(--soft);margin:0 0 1.2rem}
table{border-collapse:collapse;margin:.5rem 0 1rem;font-size:.84rem;width:auto;max-width:100%}
.wide{overflow-x:auto}caption{caption-side:top;text-align:left;font-weight:bold;padding:.3rem 0}
th,td{border:1px solid var(--line);padding:.2rem .5rem;text-align:left;vertical-align:top}
th{background:var(--head)}td.n,th.n{text-align:right;font-variant-numeric:tabular-nums}
.block td:first-child{color:var(--soft);min-width:11rem}.block td:last-child{min-width:16rem}
td.c{color:var(--soft);font-size:.78rem}td.f{font-family:"DejaVu Sans Mono",monospace;
font-size:.78rem}
.good{color:var(--good)}.bad{color:var(--bad);font-weight:bold}.warn{color:var(--warn)}
figure{margin:1rem 0;break-inside:avoid}
figure.half{display:inline-block;width:49%;margin-right:.5%;
vertical-align:top}
h1,h2,h3,td,p,li,figcaption,caption{overflow-wrap:anywhere}
figure svg{width:100%;height:auto;background:#fff}
figcaption{color:var(--soft);font-size:.84rem}
nav ol{list-style:none;padding-left:1.2rem}nav>ol{padding-left:0}a{color:var(--key);
text-decoration:none}
.sign td{height:3rem;min-width:12rem}
@media print{body{max-width:none;padding:0;font-size:10pt;color:#000;background:#fff}
h2{break-before:page}h2,h3,caption{break-after:avoid}tr,figure{break-inside:avoid}
thead{display:table-header-group}a{color:inherit}.wide{overflow:visible}}
)";

const char* ClassOf(DOC_TONE tone)
{
    constexpr std::array classes{"", "good", "bad", "warn"};
    return classes[static_cast<std::size_t>(tone)];
}

/// What a print in black has in place of the colour.
const char* SignOf(DOC_TONE tone)
{
    constexpr std::array signs{"", "\u2713 ", "\u2717 ", "! "};
    return signs[static_cast<std::size_t>(tone)];
}

std::string Open(const char* tag, const std::string& classes)
{
    return std::string("<") + tag + (classes.empty() ? "" : " class=\"" + classes + "\"") + ">";
}

/// Writes the blocks of a document.
class CHtmlWriter {
public:
    CHtmlWriter(const T_DOC_WORDS& words, const DOC_SVG_FN& svg) : m_words(words), m_svg(svg) {}

    void operator()(const T_DOC_TEXT& t)
    {
        m_out += Open("p", ClassOf(t.tone)) + SignOf(t.tone) + HtmlText(t.text) + "</p>\n";
    }

    void operator()(const T_DOC_TABLE& t)
    {
        m_out += "<div class=\"wide\"><table>";
        Caption(t.caption);
        m_out += "<thead><tr>";
        for (const T_TEXT_COLUMN& c : t.table.columns)
            m_out += Open("th", c.number ? "n" : "") + HtmlText(c.head) + "</th>";
        m_out += "</tr></thead>\n<tbody>\n";
        for (std::size_t r = 0; r < t.table.rows.size(); ++r) {
            const DOC_TONE tone = r < t.tones.size() ? t.tones[r] : DOC_TONE::Plain;
            m_out += Open("tr", ClassOf(tone));
            for (std::size_t c = 0; c < t.table.columns.size(); ++c)
                m_out += Open("td", t.table.columns[c].number ? "n" : "") +
                         (c == 0 ? SignOf(tone) : "") + HtmlText(t.table.rows[r][c]) + "</td>";
            m_out += "</tr>\n";
        }
        m_out += "</tbody></table></div>\n";
    }

    void operator()(const T_DOC_FACTS& t)
    {
        m_out += "<div class=\"wide\"><table>";
        Caption(t.caption);
        const bool defined = HasDefinitions(t);
        if (HasSymbols(t)) FactHead(defined);
        m_out += "<tbody>\n";
        for (const T_FACT& f : t.facts)
            Fact(f, defined);
        m_out += "</tbody></table></div>\n";
    }

    void operator()(const T_DOC_PICTURE& p)
    {
        const std::string svg = m_svg ? m_svg(p) : std::string();
        if (svg.empty()) return;
        m_out += Open("figure", p.width < 1.0 ? "half" : "") + svg + "<figcaption>" +
                 HtmlText(p.caption) + "</figcaption></figure>\n";
    }

    void Chapter(const T_DOC_CHAPTER& chapter, std::vector<std::size_t> place)
    {
        const char* const tag = place.size() == 1 ? "h2" : "h3";
        const std::string number = ChapterNumber(place);
        m_out += std::string("<") + tag + " id=\"c" + number + "\">" + number + " " +
                 HtmlText(chapter.title) + "</" + tag + ">\n";
        for (const T_DOC_BLOCK& block : chapter.blocks)
            std::visit(*this, block);
        place.push_back(0);
        for (const T_DOC_CHAPTER& part : chapter.parts) {
            ++place.back();
            Chapter(part, place);
        }
    }

    std::string m_out;

private:
    void Caption(const std::string& text)
    {
        if (!text.empty()) m_out += "<caption>" + HtmlText(text) + "</caption>";
    }
    void FactHead(bool defined)
    {
        m_out += "<thead><tr>";
        for (std::size_t c = 0; c < m_words.factHeads.size(); ++c)
            if (c != kDefinition || defined)
                m_out +=
                    Open("th", c == kValue ? "n" : "") + HtmlText(m_words.factHeads[c]) + "</th>";
        m_out += "</tr></thead>\n";
    }
    /// An input: its name and what was taken.
    void Input(const T_FACT& f)
    {
        m_out +=
            "<tr><td>" + HtmlText(f.definition) + "</td><td>" + HtmlText(f.text) + "</td></tr>\n";
    }
    /// defined: some line of the table has a definition.
    void Fact(const T_FACT& f, bool defined)
    {
        if (f.symbol.empty() && !f.value) return Input(f);
        std::string derived = HtmlText(f.formula);
        if (!f.numbers.empty()) derived += "<br>= " + HtmlText(f.numbers);
        if (f.value && !f.text.empty())
            derived += (derived.empty() ? "" : "<br>") + HtmlText(f.text);
        m_out += "<tr><td>" + HtmlText(f.symbol) + "</td>" +
                 (defined ? "<td>" + HtmlText(f.definition) + "</td>" : std::string()) +
                 "<td class=\"n\">" + HtmlText(f.ValueText()) + "</td><td class=\"f\">" + derived +
                 "</td><td class=\"c\">" + HtmlText(f.clause) +
                 (f.mark == CODE_MARK::Recalled ? " (" + HtmlText(MarkText(f.mark)) + ")" : "") +
                 "</td></tr>\n";
    }

    static constexpr std::size_t kDefinition = 1, kValue = 2; // of the heads of facts
    const T_DOC_WORDS& m_words;
    const DOC_SVG_FN& m_svg;
};

void AddContents(const std::vector<T_DOC_CHAPTER>& chapters, std::vector<std::size_t> place,
                 std::string& out)
{
    if (chapters.empty()) return;
    out += "<ol>";
    place.push_back(0);
    for (const T_DOC_CHAPTER& chapter : chapters) {
        ++place.back();
        const std::string number = ChapterNumber(place);
        out +=
            "<li><a href=\"#c" + number + "\">" + number + " " + HtmlText(chapter.title) + "</a>";
        AddContents(chapter.parts, place, out);
        out += "</li>\n";
    }
    out += "</ol>";
}

std::string HeadBlock(const T_DOCUMENT& d)
{
    std::string out = "<h1>" + HtmlText(d.title) + "</h1>\n<p class=\"sub\">" +
                      HtmlText(d.subtitle) + "</p>\n<table class=\"block\"><tbody>\n";
    for (const T_DOC_HEAD_ROW& row : d.head)
        out += "<tr><td>" + HtmlText(row.name) + "</td><td>" + HtmlText(row.value) + "</td></tr>\n";
    return out + "</tbody></table>\n";
}

std::string SignOff(const T_DOCUMENT& d)
{
    std::string out = "<h2>" + HtmlText(d.signOffTitle) + "</h2>\n<table class=\"sign\"><tbody>\n";
    for (const std::string& who : d.signOff)
        out += "<tr><td>" + HtmlText(who) + "</td><td></td><td></td></tr>\n";
    return out + "</tbody></table>\n";
}

} // namespace

std::string HtmlText(std::string_view text)
{
    std::string out;
    for (const char c : CleanText(text)) {
        if (c == '&')
            out += "&amp;";
        else if (c == '<')
            out += "&lt;";
        else if (c == '>')
            out += "&gt;";
        else if (c == '"')
            out += "&quot;";
        else if (c == '\'')
            out += "&#39;";
        else
            out += c;
    }
    return out;
}

std::string HtmlOf(const T_DOCUMENT& d, const DOC_SVG_FN& svg)
{
    CHtmlWriter writer(d.words, svg);
    writer.m_out = "<!DOCTYPE html>\n<html lang=\"" + HtmlText(d.language) +
                   "\">\n<head>\n<meta charset=\"utf-8\">\n<meta name=\"viewport\" "
                   "content=\"width=device-width, initial-scale=1\">\n<meta name=\"generator\" "
                   "content=\"" +
                   HtmlText(d.program) + "\">\n<title>" + HtmlText(d.title) + "</title>\n<style>" +
                   kStyle + "</style>\n</head>\n<body>\n" + HeadBlock(d) + "<nav><h2>" +
                   HtmlText(d.contents) + "</h2>\n";
    AddContents(d.chapters, {}, writer.m_out);
    writer.m_out += "</nav>\n";
    std::vector<std::size_t> place{0};
    for (const T_DOC_CHAPTER& chapter : d.chapters) {
        ++place.back();
        writer.Chapter(chapter, place);
    }
    return writer.m_out + SignOff(d) + "</body>\n</html>\n";
}
