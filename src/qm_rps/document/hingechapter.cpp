// Hinge types with backbones and where their numbers come from; which elements have them.
#include "qm_base/say.h"
#include "qm_base/textformat.h"
#include "qm_db/recordfacts.h"
#include "qm_rps/desk/codehingeoptions.h"
#include "qm_rps/desk/elementlist.h"
#include "qm_rps/document/reportmaker.h"
#include "qm_rps/generate/codehingerows.h"
#include "qm_rps/generate/generatedtypes.h"
#include "qm_rps/hinge/hingelabels.h"

namespace {

/// Deformations and strengths of a side at its points, as they are entered.
struct T_SIDE_ROW {
    std::string end, side;
    const T_SKEL_SIDE* of;
};

void AddSides(const T_SIDES<T_SKEL_SIDE>& sides, bool symmetric, const std::string& end,
              std::vector<T_SIDE_ROW>& rows)
{
    rows.push_back({end, symmetric ? "+/-" : "+", &sides.pos});
    if (!symmetric) rows.push_back({end, "-", &sides.neg});
}

/// FEMA and Eurocode curves; multilinear ones have other points.
std::vector<T_SIDE_ROW> SidesOf(const T_HINGE_COMPONENT& component)
{
    std::vector<T_SIDE_ROW> rows;
    const auto add = [&](const T_SKEL_CURVE& curve, const std::string& end) {
        if (const auto* fema = std::get_if<T_SKEL_FEMA>(&curve)) {
            AddSides(fema->sides, fema->symmetric, end, rows);
            for (const T_SKEL_AXIAL& at : fema->curves)
                AddSides(at.sides, fema->symmetric, end + FormatText(", N = %.5g", at.axial), rows);
        } else if (const auto* ec8 = std::get_if<T_SKEL_EC8>(&curve)) {
            AddSides(ec8->sides, ec8->symmetric, end, rows);
        }
    };
    add(component.curves.I, component.sameEnds ? "I, J" : "I");
    if (!component.sameEnds) add(component.curves.J, "J");
    return rows;
}

T_TEXT_TABLE BackboneTable(const std::vector<T_SIDE_ROW>& rows, HINGE_COMPONENT c,
                           const T_HINGE_OWNER& owner)
{
    T_TEXT_TABLE table{{{Say("IDS_QM_REPORT_END")}, {Say("IDS_QM_REPORT_SIDE")}}, {}};
    table.columns.push_back({StrengthHead(Say("IDS_QM_REPORT_YIELD"), c, owner), true});
    table.columns.push_back({DeformHead("Dy", c, owner), true});
    for (const char* const head : {"B: D", "B: S/Sy", "C: D", "C: S/Sy", "D: D", "D: S/Sy", "E: D",
                                   "E: S/Sy", "IO", "LS", "CP"})
        table.columns.push_back({head, true});
    for (const T_SIDE_ROW& row : rows) {
        auto& cells = table.rows.emplace_back(std::vector<std::string>{row.end, row.side});
        const auto add = [&](double value) { cells.push_back(FormatText("%.5g", value)); };
        add(row.of->yield);
        add(row.of->yieldDeform);
        for (const T_SKEL_POINT* p : {&row.of->B, &row.of->C, &row.of->D, &row.of->E}) {
            add(p->deform);
            add(p->strength);
        }
        for (const double value : {row.of->IO, row.of->LS, row.of->CP})
            add(value);
    }
    return table;
}

T_TEXT_TABLE MultiTable(const T_HINGE_COMPONENT& component)
{
    T_TEXT_TABLE table{{{Say("IDS_QM_REPORT_END")}, {Say("IDS_QM_REPORT_SIDE")}}, {}};
    for (const char* const head : {"P1", "P2", "P3", "D1", "D2", "D3", "alpha1", "alpha2", "gap"})
        table.columns.push_back({head, true});
    const auto add = [&](const T_SKEL_CURVE& curve, const std::string& end) {
        const auto* multi = std::get_if<T_SKEL_MULTI>(&curve);
        if (!multi) return;
        const auto side = [&](const std::string& name, const T_SKEL_MULTI_SIDE& s) {
            auto& cells = table.rows.emplace_back(std::vector<std::string>{end, name});
            for (const double v : {s.P1, s.P2, s.P3, s.D1, s.D2, s.D3, s.alpha1, s.alpha2, s.gap})
                cells.push_back(FormatText("%.5g", v));
        };
        side(multi->symmetric ? "+/-" : "+", multi->sides.pos);
        if (!multi->symmetric) side("-", multi->sides.neg);
    };
    add(component.curves.I, component.sameEnds ? "I, J" : "I");
    if (!component.sameEnds) add(component.curves.J, "J");
    return table;
}

bool IsAutomatic(const T_SKEL_CURVE& curve)
{
    return std::visit([](const auto& c) { return c.autoYield; }, curve);
}

void AddComponent(T_REPORT_WORK& work, const T_PHGT_D& type, std::size_t i, T_DOC_CHAPTER& part)
{
    const T_HINGE_COMPONENT& component = type.components[i];
    const auto c = static_cast<HINGE_COMPONENT>(i);
    const T_HINGE_OWNER owner{type, work.Units()};
    const std::string model = HingeModelLabel(type.definition, c);
    const std::string caption = kComponentNames[i] + (model.empty() ? "" : ", " + model);
    const std::vector<T_SIDE_ROW> sides = SidesOf(component);
    T_TEXT_TABLE table = sides.empty() ? MultiTable(component) : BackboneTable(sides, c, owner);
    part.blocks.emplace_back(DocTable(caption, std::move(table), work.limit));
    if (IsAutomatic(component.curves.I))
        part.blocks.emplace_back(DocText(Say("IDS_QM_REPORT_AUTO_YIELD")));
    constexpr double kWidth = 0.6;
    const auto shared = std::make_shared<const T_PHGT_D>(type);
    part.blocks.emplace_back(T_DOC_PICTURE{type.name + ": " + kComponentNames[i],
                                           T_BACKBONE_VIEW{shared, c, false}, kWidth});
    if (!component.sameEnds)
        part.blocks.emplace_back(T_DOC_PICTURE{type.name + ": " + kComponentNames[i] + ", J",
                                               T_BACKBONE_VIEW{shared, c, true}, kWidth});
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
    for (std::size_t i = 0; i < type.components.size(); ++i)
        if (type.components[i].active) AddComponent(work, type, i, part);
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
