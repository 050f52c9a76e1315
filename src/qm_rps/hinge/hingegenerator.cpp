#include "qm_rps/hinge/hingegenerator.h"

#include "qm_base/msgfunction.h"
#include "qm_base/textformat.h"
#include "qm_db/editscope.h"
#include "qm_rps/hinge/hingechoices.h"
#include "qm_rps/hinge/hingelabels.h"
#include "qm_rps/hinge/hingetable.h"
#include "qm_rps/hinge/hingetypefindings.h"
#include "qm_rps/hinge/pageyield.h"

#include <set>

namespace {

using zql::lib::MMSGFunction;
using T_BY_COMPONENT = std::array<T_SIDES<double>, 6>;

constexpr const char* kNoAxial = "IDS_QM_HINGE_NO_AXIAL";
constexpr const char* kAxialBeyond = "IDS_QM_HINGE_AXIAL_BEYOND";

/// why: in place of the text of the key.
int Refuse(int element, const std::string& key, T_HINGE_REFUSAL& refusal, std::string why = {})
{
    if (why.empty()) why = MMSGFunction::GetValue(key);
    const std::string text =
        element == 0 ? why
                     : MMSGFunction::Format("IDS_QM_HINGE_ELEMENT", {std::to_string(element), why});
    refusal = {element, key, why, text};
    return 0;
}

/// What a link or a point spring calculates: nothing.
const CHingeSources::T_RESULT& NoSection()
{
    static const CHingeSources::T_RESULT none;
    return none;
}

std::string ClassText(MATL_CLASS material)
{
    static constexpr std::array<const char*, 4> keys{
        "IDS_QM_UI_MATL_CONCRETE", "IDS_QM_UI_MATL_STEEL", "IDS_QM_UI_MATL_COMPOSITE",
        "IDS_QM_UI_MATL_MASONRY"};
    const auto at = static_cast<std::size_t>(material);
    return MMSGFunction::GetValue(at < keys.size() ? keys[at] : "IDS_PUSHOVER_Error");
}

/// A composite section has concrete and steel.
bool ClassFits(MATL_CLASS type, MATL_CLASS material)
{
    return type == material || (type == MATL_CLASS::Composite && material != MATL_CLASS::Masonry);
}

/// Elements of walls are beams in the model.
bool KindFits(HINGE_ELEMENT type, HINGE_ELEMENT element)
{
    return (type == HINGE_ELEMENT::Wall ? HINGE_ELEMENT::BeamColumn : type) == element;
}

/// The moments of a component at an axial force, compression positive, in place of those without.
int PutMoments(const T_HINGE_ELEMENT& e, const T_UNITS& units, HINGE_COMPONENT c, double axial,
               CHingeSources::T_RESULT& result, T_HINGE_REFUSAL& refusal)
{
    std::optional<T_SIDES<double>>& moments = result.strength.yield[static_cast<std::size_t>(c)];
    if (axial == 0.0 || !moments) return 1;
    for (const bool positive : {true, false}) {
        SECT_FAULT fault{};
        if (CSectionStrength::CalcMoment(*e.section, *e.material, units, c == HINGE_COMPONENT::My,
                                         positive, axial, positive ? moments->pos : moments->neg,
                                         fault))
            continue;
        refusal.key = kAxialBeyond;
        refusal.why = MMSGFunction::Format(
            refusal.key, {HeadWithUnit(FormatText("%.6g", axial), kDimForce, units),
                          FormatText("%.6g", -result.strength.level.tension),
                          FormatText("%.6g", result.strength.level.compression)});
        return 0;
    }
    return 1;
}

bool Differ(double stored, double today)
{
    constexpr double kDigits = 1e-6; // a case file may state its strengths in so many digits
    return !(std::fabs(stored - today) <= kDigits * std::max(std::fabs(stored), std::fabs(today)));
}

/// Appends the strengths that differ, "My(+) 300, now 280".
void Compare(const std::string& prefix, const T_BY_COMPONENT& stored, const T_BY_COMPONENT& today,
             std::string& out)
{
    for (std::size_t i = 0; i < stored.size(); ++i)
        for (const bool positive : {true, false}) {
            const double was = positive ? stored[i].pos : stored[i].neg;
            const double is = positive ? today[i].pos : today[i].neg;
            if (!Differ(was, is)) continue;
            const std::string name = prefix + kComponentNames[i] + (positive ? "(+)" : "(-)");
            const std::string item = MMSGFunction::Format(
                "IDS_QM_HINGE_STALE_ITEM", {name, FormatText("%.6g", was), FormatText("%.6g", is)});
            out += (out.empty() ? "" : "; ") + item;
        }
}

/// The moment is calculated, and no curve gives it by the axial force while pushed.
bool HangsOnInitialAxial(const T_PHGT_D& type, HINGE_COMPONENT c)
{
    const HINGE_INTERACTION interaction = InteractionOf(type, c);
    const T_HINGE_COMPONENT& component = At(type, c);
    if (!component.active || interaction == HINGE_INTERACTION::PMM ||
        interaction == HINGE_INTERACTION::User)
        return false;
    bool hangs = false;
    ForEachPage(component, [&](HINGE_END, const T_SKEL_CURVE& curve) {
        const auto* fema = std::get_if<T_SKEL_FEMA>(&curve);
        hangs |= IsAutoYield(curve) && !(fema && fema->multiCurve);
    });
    return hangs;
}

constexpr HINGE_COMPONENT kBending[] = {HINGE_COMPONENT::My, HINGE_COMPONENT::Mz};

/// The strengths of a component with those of the other pages: the J-end's own ones apart.
void PutStrengths(const T_HINGE_COMPONENT& c, std::size_t i,
                  const CHingeGenerator::T_STRENGTHS& results, T_PHGE_D& hinge)
{
    const bool two = NeedsIJPages(c);
    ForEachPage(c, [&](HINGE_END end, const T_SKEL_CURVE& curve) {
        const CHingeSources::T_RESULT& result = results.at(end);
        const T_PAGE_STRENGTH s =
            PageStrength(curve, c.type, static_cast<HINGE_COMPONENT>(i), result);
        const bool j = two && end == HINGE_END::J;
        (j ? hinge.yieldJ : hinge.yield)[i] = {s.yield.pos.value_or(0.0),
                                               s.yield.neg.value_or(0.0)};
        (j ? hinge.crackJ : hinge.crack)[i] = s.crack;
    });
}

} // namespace

int CHingeGenerator::ReadElement(const T_PHGT_D& type, int element, T_HINGE_ELEMENT& out,
                                 T_HINGE_REFUSAL& refusal) const
{
    T_ELEM_D e;
    if (!m_doc.Attr().GetElem(element, e)) return Refuse(element, "IDS_CMD_IEHP_NO_ELEM", refusal);
    const HINGE_ELEMENT kind = HingeElementOf(m_doc, element).value_or(HINGE_ELEMENT::BeamColumn);
    if (!KindFits(type.element, kind))
        return Refuse(element, "IDS_QM_HINGE_WRONG_KIND", refusal,
                      MMSGFunction::Format("IDS_QM_HINGE_WRONG_KIND",
                                           {ElementText(type.element), ElementText(kind)}));
    T_HINGE_ELEMENT found;
    found.result = &NoSection();
    if (HasLineElement(type)) {
        const T_YIELD_CALC_ELEM has = YieldCalcElemOf(m_doc, element);
        if (!has.section) return Refuse(element, "IDS_CMD_IEHP_NO_SECT", refusal);
        if (!has.material) return Refuse(element, "IDS_CMD_IEHP_NO_MATL", refusal);
        if (!ClassFits(type.material, has.material->type))
            return Refuse(element, "IDS_QM_HINGE_WRONG_CLASS", refusal,
                          MMSGFunction::Format("IDS_QM_HINGE_WRONG_CLASS",
                                               {ClassText(type.material), has.material->name,
                                                ClassText(has.material->type)}));
        if (!m_doc.Memb().GetMembLengByIncludeElem(element, found.memberLength))
            return Refuse(element, "IDS_CMD_IEHP_NO_MEMB", refusal);
        if (type.element == HINGE_ELEMENT::Wall && !CHingeSources::IsWall(*has.section))
            return Refuse(element, "IDS_CMD_IEHP_NO_WALL", refusal);
        found.section = has.section;
        found.material = has.material;
        found.result = m_context.sources->Strength(e.section, e.material);
    }
    out = std::move(found);
    return 1;
}

int CHingeGenerator::CalcHinge(int hingeType, int element, T_PHGE_D& out, T_HINGE_REFUSAL& refusal,
                               int axialCase) const
{
    T_PHGT_D type;
    T_HINGE_ELEMENT e;
    if (!m_doc.Attr().GetPhgt(hingeType, type))
        return Refuse(0, "IDS_PUSHOVER_No_selected_Hinge_Data_Type__nChoose_o", refusal);
    if (!ReadElement(type, element, e, refusal)) return 0;
    std::vector<T_FINDING> faults;
    AutoStrengthFindings(type, *e.result, faults);
    if (!faults.empty()) {
        const bool method = e.result->fault == SECT_FAULT::None;
        return Refuse(element, method ? faults.front().ruleText : MessageKeyOf(e.result->fault),
                      refusal, method ? faults.front().text : std::string());
    }
    T_PHGE_D hinge;
    hinge.element = element;
    hinge.hingeType = hingeType;
    hinge.axialCase = axialCase;
    T_STRENGTHS results;
    if (!CalcStrengths(type, element, axialCase, e, results, refusal)) return 0;
    for (std::size_t i = 0; i < type.components.size(); ++i)
        if (type.components[i].active) PutStrengths(type.components[i], i, results, hinge);
    out = hinge;
    return 1;
}

int CHingeGenerator::CalcStrengths(const T_PHGT_D& type, int element, int axialCase,
                                   const T_HINGE_ELEMENT& e, T_STRENGTHS& out,
                                   T_HINGE_REFUSAL& refusal) const
{
    T_STRENGTHS results;
    for (const HINGE_END end : {HINGE_END::I, HINGE_END::J, HINGE_END::Both})
        results[end] = *e.result;
    for (const HINGE_COMPONENT c : kBending) {
        T_ENDS<double> axial;
        if (!HangsOnInitialAxial(type, c)) continue;
        if (!AxialOf(axialCase, element, axial, refusal)) return 0;
        const std::pair<HINGE_END, double> at[] = {{HINGE_END::I, axial.I},
                                                   {HINGE_END::J, axial.J},
                                                   {HINGE_END::Both, 0.5 * (axial.I + axial.J)}};
        for (const auto& [end, force] : at)
            if (!PutMoments(e, m_context.units, c, force, results[end], refusal))
                return Refuse(element, refusal.key, refusal, refusal.why);
    }
    out = std::move(results);
    return 1;
}

/// In the document's current units.
int CHingeGenerator::AxialOf(int axialCase, int element, T_ENDS<double>& out,
                             T_HINGE_REFUSAL& refusal) const
{
    const auto [at, fresh] = m_axial.try_emplace(axialCase);
    std::string reason;
    if (fresh && !at->second.Analyse(m_doc.Data().Model(), reason, axialCase)) {
        m_axial.erase(at);
        return Refuse(element, kNoAxial, refusal, MMSGFunction::Format(kNoAxial, {reason}));
    }
    const T_ENDS<double> axial = at->second.Of(element);
    out = {m_doc.Unit().Out(axial.I, kDimForce), m_doc.Unit().Out(axial.J, kDimForce)};
    return 1;
}

int CHingeGenerator::Generate(int hingeType, const std::vector<int>& elements,
                              T_HINGE_REFUSAL& refusal, int axialCase)
{
    if (elements.empty()) return Refuse(0, "IDS_CMD_IEHP_NO_ELEM", refusal);
    if (T_PHGT_D type; m_doc.Attr().GetPhgt(hingeType, type)) {
        const std::vector<T_FINDING> broken = HingeTypeFindings(type, m_context);
        if (!broken.empty())
            return Refuse(
                0, broken.front().messageKey, refusal,
                MMSGFunction::Format("IDS_QM_HINGE_BROKEN_TYPE", {type.name, broken.front().text}));
    }
    std::map<int, T_PHGE_D> fresh; // by element
    for (const int element : elements)
        if (!CalcHinge(hingeType, element, fresh[element], refusal, axialCase)) return 0;

    std::set<int> extra;
    std::map<int, int> keys; // of the hinges that are replaced, by element
    int next = NextKey(m_doc.Data().Model().hinges);
    for (const auto& [key, hinge] : m_doc.Data().Model().hinges)
        if (fresh.contains(hinge.element) && !keys.emplace(hinge.element, key).second)
            extra.insert(key);
    CEditScope edit(m_doc, "hinges of elements", EDIT_STEP::Join);
    for (const int key : extra)
        (void)edit.Erase<T_PHGE_D>(key);
    for (const auto& [element, hinge] : fresh) {
        const auto old = keys.find(element);
        (void)edit.Put(old == keys.end() ? next++ : old->second, hinge);
    }
    if (edit.Commit()) return 1;
    return Refuse(0, "IDS_QM_HINGE_NOT_STORED", refusal);
}

std::vector<T_FINDING> CHingeGenerator::ElementFindings(int hingeType) const
{
    T_PHGT_D type;
    std::vector<T_FINDING> out;
    if (!m_doc.Attr().GetPhgt(hingeType, type)) return out;
    const auto add = [&](const std::string& key, const std::string& text) {
        T_FINDING& f = out.emplace_back();
        f.ruleText = f.messageKey = key;
        f.text = text;
    };
    for (const auto& [key, hinge] : HingesOf(m_doc)) {
        if (hinge.hingeType != hingeType) continue;
        T_HINGE_ELEMENT e;
        T_HINGE_REFUSAL refusal;
        const std::size_t first = out.size();
        if (ReadElement(type, hinge.element, e, refusal))
            AutoStrengthFindings(type, *e.result, out);
        else
            add(refusal.key, refusal.why);
        if (const std::string stale = StaleText(hinge); !stale.empty())
            add("IDS_QM_HINGE_STALE", MMSGFunction::Format("IDS_QM_HINGE_STALE", {stale}));
        for (std::size_t i = first; i < out.size(); ++i)
            out[i].field = "element " + std::to_string(hinge.element);
    }
    return out;
}

std::string CHingeGenerator::StaleText(const T_PHGE_D& hinge) const
{
    T_PHGE_D today;
    T_HINGE_REFUSAL refusal;
    std::string text;
    if (!HasStrengths(hinge)) return text;
    if (!CalcHinge(hinge.hingeType, hinge.element, today, refusal, hinge.axialCase)) {
        // What else is wrong with the element is told as such.
        const bool axial = refusal.key == kNoAxial || refusal.key == kAxialBeyond;
        if (axial) text = refusal.why;
        while (text.ends_with('.'))
            text.pop_back(); // it stands within a sentence
        return text;
    }
    Compare("", hinge.yield, today.yield, text);
    Compare("", hinge.crack, today.crack, text);
    Compare("J ", hinge.yieldJ, today.yieldJ, text);
    Compare("J ", hinge.crackJ, today.crackJ, text);
    return text;
}

bool CHingeGenerator::HasStrengths(const T_PHGE_D& hinge)
{
    const T_BY_COMPONENT none{};
    return hinge.yield != none || hinge.crack != none || hinge.yieldJ != none ||
           hinge.crackJ != none;
}
