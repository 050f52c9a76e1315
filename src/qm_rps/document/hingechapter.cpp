// Hinge types with backbones and where their numbers come from; which elements have them.
#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_db/recordfacts.h"
#include "qm_rps/desk/codehingeoptions.h"
#include "qm_rps/desk/elementlist.h"
#include "qm_rps/document/reportmaker.h"
#include "qm_rps/generate/codehingerows.h"
#include "qm_rps/generate/codehinges.h"
#include "qm_rps/generate/generatedtypes.h"
#include "qm_rps/hinge/hingegenerator.h"
#include "qm_rps/hinge/hingelabels.h"
#include "qm_rps/hinge/hingetypefindings.h"

namespace {

/// Deformations and strengths of a side at its points, as they are entered.
struct T_SIDE_ROW {
    std::string end, side;
    const T_SKEL_SIDE* of;
};

/// The sides of a component's curves, and what they have in common.
struct T_SIDE_ROWS {
    std::vector<T_SIDE_ROW> rows;
    SKEL_MEASURE measure = SKEL_MEASURE::DDy;
    bool automatic = false, criteria = true;
};

void AddSides(const T_SIDES<T_SKEL_SIDE>& sides, bool symmetric, const std::string& end,
              std::vector<T_SIDE_ROW>& rows)
{
    rows.push_back({end, symmetric ? "+/-" : "+", &sides.pos});
    if (!symmetric) rows.push_back({end, "-", &sides.neg});
}

/// FEMA and Eurocode curves of an end; multilinear ones have other points.
T_SIDE_ROWS SidesOf(const T_SKEL_CURVE& curve, const std::string& end)
{
    T_SIDE_ROWS out;
    if (const auto* fema = std::get_if<T_SKEL_FEMA>(&curve)) {
        out = {{}, fema->measure, fema->autoYield, fema->compliance};
        AddSides(fema->sides, fema->symmetric, end, out.rows);
        for (const T_SKEL_AXIAL& at : fema->curves)
            AddSides(at.sides, fema->symmetric, end + FormatText(", N = %.5g", at.axial), out.rows);
    } else if (const auto* ec8 = std::get_if<T_SKEL_EC8>(&curve)) {
        out = {{}, ec8->measure, ec8->autoYield, true};
        AddSides(ec8->sides, ec8->symmetric, end, out.rows);
    }
    return out;
}

std::string NumberOrDash(double value)
{
    return value == 0.0 ? std::string("-") : FormatText("%.5g", value);
}

/// What the deformations of the points count in: "Dy", "rad".
std::string DeformUnit(const T_SIDE_ROWS& sides, HINGE_COMPONENT c, const T_HINGE_OWNER& owner)
{
    if (sides.measure == SKEL_MEASURE::DDy) return "Dy";
    const std::string head = DeformHead("D", c, owner); // "D (rad)"
    const std::size_t open = head.find('(');
    return open == std::string::npos ? "1" : head.substr(open + 1, head.size() - open - 2);
}

T_TEXT_TABLE BackboneTable(const T_SIDE_ROWS& sides, HINGE_COMPONENT c, const T_HINGE_OWNER& owner)
{
    T_TEXT_TABLE table{{{Say("IDS_QM_REPORT_END")}, {Say("IDS_QM_REPORT_SIDE")}}, {}};
    table.columns.push_back({StrengthHead(Say("IDS_QM_REPORT_YIELD"), c, owner), true});
    table.columns.push_back({DeformHead("Dy", c, owner), true});
    for (const std::string point : {"B", "C", "D", "E"}) {
        table.columns.push_back({point + ": D", true});
        table.columns.push_back({point + ": S/Sy", true});
    }
    for (const char* const criterion : {"IO", "LS", "CP"})
        table.columns.push_back({criterion, true});
    for (const T_SIDE_ROW& row : sides.rows) {
        auto& cells = table.rows.emplace_back(std::vector<std::string>{row.end, row.side});
        // What follows from section and material has no number of its own here.
        cells.push_back(sides.automatic ? Say("IDS_QM_REPORT_AUTO") : NumberOrDash(row.of->yield));
        cells.push_back(sides.automatic ? Say("IDS_QM_REPORT_AUTO")
                                        : NumberOrDash(row.of->yieldDeform));
        for (const T_SKEL_POINT* p : {&row.of->B, &row.of->C, &row.of->D, &row.of->E})
            for (const double value : {p->deform, p->strength})
                cells.push_back(FormatText("%.5g", value));
        for (const double value : {row.of->IO, row.of->LS, row.of->CP})
            cells.push_back(sides.criteria ? NumberOrDash(value) : "-");
    }
    return table;
}

T_TEXT_TABLE MultiTable(const T_SKEL_MULTI& multi, const std::string& end, HINGE_COMPONENT c,
                        const T_HINGE_OWNER& owner)
{
    T_TEXT_TABLE table{{{Say("IDS_QM_REPORT_END")}, {Say("IDS_QM_REPORT_SIDE")}}, {}};
    for (const char* const name : {"P1", "P2", "P3"})
        table.columns.push_back({StrengthHead(name, c, owner), true});
    for (const char* const name : {"D1", "D2", "D3"})
        table.columns.push_back({DeformHead(name, c, owner), true});
    table.columns.push_back({"alpha1", true});
    table.columns.push_back({"alpha2", true});
    table.columns.push_back({DeformHead(Say("IDS_QM_REPORT_GAP"), c, owner), true});
    const auto side = [&](const std::string& name, const T_SKEL_MULTI_SIDE& s) {
        auto& cells = table.rows.emplace_back(std::vector<std::string>{end, name});
        for (const double v : {s.P1, s.P2, s.P3})
            cells.push_back(multi.autoYield ? Say("IDS_QM_REPORT_AUTO") : NumberOrDash(v));
        for (const double v : {s.D1, s.D2, s.D3})
            cells.push_back(multi.useDeformation ? NumberOrDash(v) : "-");
        for (const double v : {s.alpha1, s.alpha2})
            cells.push_back(multi.useDeformation ? "-" : FormatText("%.5g", v));
        cells.push_back(NumberOrDash(s.gap));
    };
    side(multi.symmetric ? "+/-" : "+", multi.sides.pos);
    if (!multi.symmetric) side("-", multi.sides.neg);
    return table;
}

/// The table of an end's curve, or of both.
void AddCurve(T_REPORT_WORK& work, const T_SKEL_CURVE& curve, const std::string& end,
              const std::string& caption, HINGE_COMPONENT c, const T_HINGE_OWNER& owner,
              T_DOC_CHAPTER& part)
{
    T_TEXT_TABLE table;
    std::string units;
    bool automatic = false;
    if (const auto* multi = std::get_if<T_SKEL_MULTI>(&curve)) {
        table = MultiTable(*multi, end, c, owner);
        automatic = multi->autoYield;
    } else {
        const T_SIDE_ROWS sides = SidesOf(curve, end);
        table = BackboneTable(sides, c, owner);
        units = Say("IDS_QM_REPORT_DEFORM_UNIT", DeformUnit(sides, c, owner));
        automatic = sides.automatic;
    }
    part.blocks.emplace_back(
        DocTable(caption + (units.empty() ? "" : "; " + units), std::move(table), work.limit));
    if (automatic) part.blocks.emplace_back(DocText(Say("IDS_QM_REPORT_AUTO_YIELD")));
}

void AddComponent(T_REPORT_WORK& work, const T_PHGT_D& type, std::size_t i, T_DOC_CHAPTER& part,
                  std::vector<T_DOC_PICTURE>& pictures)
{
    const T_HINGE_COMPONENT& component = type.components[i];
    const auto c = static_cast<HINGE_COMPONENT>(i);
    const T_HINGE_OWNER owner{type, work.Units()};
    const std::string model = HingeModelLabel(type.definition, c);
    const std::string caption = kComponentNames[i] + (model.empty() ? "" : ", " + model);
    const auto shared = std::make_shared<const T_PHGT_D>(type);
    AddCurve(work, component.curves.I, component.sameEnds ? "I, J" : "I", caption, c, owner, part);
    pictures.push_back(
        {type.name + ": " + kComponentNames[i], T_BACKBONE_VIEW{shared, c, false}, kHalfPage});
    if (component.sameEnds) return;
    AddCurve(work, component.curves.J, "J", caption, c, owner, part);
    pictures.push_back({type.name + ": " + kComponentNames[i] + ", J",
                        T_BACKBONE_VIEW{shared, c, true}, kHalfPage});
}

/// Where the numbers of a generated type come from: made again for its first element as it was
/// asked for. Nothing where that is refused today: the type is then stale, which is said.
void AddTrace(T_REPORT_WORK& work, int element, T_DOC_CHAPTER& part)
{
    CCodeHingeOptions options(work.doc);
    options.TakeStale({element});
    T_CODE_REQUEST request;
    T_CODE_HINGES made;
    T_HINGE_REFUSAL refusal;
    std::string reason;
    if (!options.Read({element}, request, reason) ||
        !CCodeHinges(work.doc).Preview(request, made, refusal) || made.elements.empty())
        return;
    for (const T_CODE_ROW_OF_HINGE& row : HingeRows(made.elements.front())) {
        const std::string where = std::to_string(row.element) + " " + row.end + " " +
                                  kComponentNames[static_cast<std::size_t>(row.component)] + " " +
                                  row.side;
        part.blocks.emplace_back(
            T_DOC_FACTS{Say("IDS_QM_REPORT_TRACE", where), FactsOf(row.of->trace, work.Units())});
        for (const T_CODE_WARNING& warning : row.of->warnings)
            work.Remark(part.title, WarningText(warning));
    }
}

/// What the check of hinge types finds.
void AddFindings(T_REPORT_WORK& work, int key, const T_PHGT_D& type, T_DOC_CHAPTER& part)
{
    const auto add = [&](const std::vector<T_FINDING>& found) {
        for (const T_FINDING& f : found) {
            part.blocks.emplace_back(DocText(f.text, DOC_TONE::Warning));
            work.Remark(part.title, f.text);
        }
    };
    CCodeHinges codeHinges(work.doc);
    add(HingeTypeFindings(type, HingeContextOf(work.doc)));
    add(CHingeGenerator(work.doc).ElementFindings(key));
    add(HingeTypeWarnings(type));
    add(codeHinges.TypeFindings(key));
}

void AddType(T_REPORT_WORK& work, int key, CGeneratedTypes& generated, T_DOC_CHAPTER& chapter)
{
    T_PHGT_D type;
    if (!work.doc.Attr().GetPhgt(key, type)) return;
    T_DOC_CHAPTER& part = chapter.parts.emplace_back();
    part.title = type.name;
    const std::vector<int> elements = ElementsWithHingeType(work.Model(), key);
    std::string text =
        ElementText(type.element) + ". " +
        (elements.empty() ? Say("IDS_QM_REPORT_NO_ELEMENTS")
                          : Say("IDS_QM_REPORT_ON_ELEMENTS", ElementListText(elements)));
    if (const std::string code = generated.CodeText(key); !code.empty())
        text += " " + Say("IDS_QM_REPORT_OF_CODE", code);
    part.blocks.emplace_back(DocText(text));
    if (const std::string& fault = generated.Fault(key); !fault.empty()) {
        part.blocks.emplace_back(DocText(fault, DOC_TONE::Warning));
        work.Remark(type.name, fault);
    }
    std::vector<T_DOC_PICTURE> pictures;
    for (std::size_t i = 0; i < type.components.size(); ++i)
        if (type.components[i].active) AddComponent(work, type, i, part, pictures);
    for (T_DOC_PICTURE& picture : pictures)
        part.blocks.emplace_back(std::move(picture));
    AddFindings(work, key, type, part);
    if (type.generated && !elements.empty()) AddTrace(work, elements.front(), part);
}

} // namespace

void FillHingesChapter(T_REPORT_WORK& work, T_DOC_CHAPTER& chapter)
{
    if (work.Model().hingeTypes.empty()) return;
    chapter.blocks.emplace_back(
        DocText(Say("IDS_QM_REPORT_HINGE_COUNT", std::to_string(work.Model().hingeTypes.size()),
                    std::to_string(work.Model().hinges.size()))));
    CGeneratedTypes generated(work.doc);
    constexpr std::size_t kMostTypes = 40;
    std::size_t count = 0;
    for (const auto& [key, type] : work.Model().hingeTypes)
        if (++count <= kMostTypes) AddType(work, key, generated, chapter);
    if (count > kMostTypes)
        chapter.blocks.emplace_back(DocText(
            Say("IDS_QM_REPORT_MORE_TYPES", std::to_string(kMostTypes), std::to_string(count))));
}
