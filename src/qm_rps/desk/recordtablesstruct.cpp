// Tables of the structure: nodes, elements, sections, materials, storeys.
#include "qm_base/msgfunction.h"
#include "qm_rps/desk/freename.h"
#include "qm_rps/desk/recordtable.h"
#include "qm_rps/desk/recordtables.h"

namespace {

using zql::lib::MMSGFunction;

constexpr T_DIM kArea{0, 2}, kInertia{0, 4}, kModulus{0, 3}, kDensity{1, -4};

std::string TextOf(const char* key)
{
    return MMSGFunction::GetValue(key);
}

bool NodeExists(const T_MODEL& model, int id)
{
    return model.nodes.contains(id);
}

T_RECORD_COLUMNS<T_NODE_D> NodeColumns()
{
    using R = T_NODE_D;
    T_RECORD_COLUMNS<R> c{KeyColumn<R>("IDS_QM_UI_HEAD_ID")};
    constexpr std::array<const char*, 3> axes{"X", "Y", "Z"}, masses{"mX", "mY", "mZ"};
    for (std::size_t d = 0; d < 3; ++d)
        c.push_back(
            NumberColumn<R>(axes[d], kDimLength, [d](R& r) -> double& { return r.xyz[d]; }));
    for (std::size_t d = 0; d < 6; ++d)
        c.push_back(
            FlagColumn<R>(kDirectionNames[d], [d](R& r) -> int& { return r.restraint[d]; }));
    for (std::size_t d = 0; d < 3; ++d)
        c.push_back(NumberColumn<R>(
            masses[d], kDimMass, [d](R& r) -> double& { return r.mass[d]; }, 0.0));
    return c;
}

T_RECORD_COLUMNS<T_ELEM_D> ElementColumns()
{
    using R = T_ELEM_D;
    return {KeyColumn<R>("IDS_QM_UI_HEAD_ID"),
            FixedColumn<R>("IDS_QM_UI_HEAD_KIND",
                           [](const T_MODEL&, const R& r) {
                               constexpr std::array<const char*, 4> keys{
                                   "IDS_QM_UI_KIND_BEAM", "IDS_QM_UI_KIND_TRUSS",
                                   "IDS_QM_UI_KIND_LINK", "IDS_QM_UI_KIND_SPRING"};
                               return TextOf(keys[static_cast<std::size_t>(r.kind)]);
                           }),
            IntegerColumn<R>(
                "IDS_QM_UI_HEAD_NODE_I", [](R& r) -> int& { return r.nodeI; }, NodeExists),
            IntegerColumn<R>(
                "IDS_QM_UI_HEAD_NODE_J", [](R& r) -> int& { return r.nodeJ; }, NodeExists),
            NameOfColumn<R>("IDS_QM_UI_HEAD_SECTION", &T_MODEL::sections,
                            [](R& r) -> int& { return r.section; }),
            NameOfColumn<R>("IDS_QM_UI_HEAD_MATERIAL", &T_MODEL::materials,
                            [](R& r) -> int& { return r.material; }),
            IntegerColumn<R>(
                "IDS_QM_UI_HEAD_MEMBER", [](R& r) -> int& { return r.member; },
                [](const T_MODEL&, int n) { return n >= 0; })};
}

T_RECORD_COLUMNS<T_SECT_D> SectionColumns()
{
    using R = T_SECT_D;
    T_RECORD_COLUMNS<R> c{
        KeyColumn<R>("IDS_QM_UI_HEAD_KEY"), NameColumn(&T_MODEL::sections),
        IndexColumn<R>(
            "IDS_QM_UI_HEAD_SHAPE", [](R& r) -> SECT_SHAPE& { return r.shape; },
            {"IDS_QM_UI_SHAPE_VALUE", "IDS_QM_UI_SHAPE_RECTANGLE", "IDS_QM_UI_SHAPE_CIRCLE",
             "IDS_QM_UI_SHAPE_PIPE", "IDS_QM_UI_SHAPE_BOX", "IDS_QM_UI_SHAPE_I",
             "IDS_QM_UI_SHAPE_CHANNEL"},
            TextOf)};
    constexpr std::array<const char*, 4> sizes{"D1", "D2", "D3", "D4"};
    for (std::size_t d = 0; d < 4; ++d)
        c.push_back(NumberColumn<R>(
            sizes[d], kDimLength, [d](R& r) -> double& { return r.size[d]; }, 0.0));
    const auto add = [&](const char* head, T_DIM dim, double R::*which) {
        c.push_back(NumberColumn<R>(
            head, dim, [which](R& r) -> double& { return r.*which; }, 0.0));
    };
    add("A", kArea, &R::area);
    add("Asy", kArea, &R::Asy);
    add("Asz", kArea, &R::Asz);
    add("J", kInertia, &R::J);
    add("Iyy", kInertia, &R::Iyy);
    add("Izz", kInertia, &R::Izz);
    add("Zy", kModulus, &R::Zy);
    add("Zz", kModulus, &R::Zz);
    add("r", kDimLength, &R::fillet);
    add("IDS_QM_UI_SECT_TAPER", kDimNone, &R::taper);
    return c;
}

T_RECORD_COLUMNS<T_MATL_D> MaterialColumns()
{
    using R = T_MATL_D;
    T_RECORD_COLUMNS<R> c{KeyColumn<R>("IDS_QM_UI_HEAD_KEY"), NameColumn(&T_MODEL::materials),
                          IndexColumn<R>(
                              "IDS_QM_UI_HEAD_CLASS", [](R& r) -> MATL_CLASS& { return r.type; },
                              {"IDS_QM_UI_MATL_CONCRETE", "IDS_QM_UI_MATL_STEEL",
                               "IDS_QM_UI_MATL_COMPOSITE", "IDS_QM_UI_MATL_MASONRY"},
                              TextOf)};
    const auto add = [&](const char* head, T_DIM dim, double R::*which, bool sign = false) {
        c.push_back(NumberColumn<R>(
            head, dim, [which](R& r) -> double& { return r.*which; },
            sign ? std::optional<double>() : std::optional<double>(0.0)));
    };
    add("E", kDimStress, &R::E);
    add("nu", kDimNone, &R::nu, true);
    add("Fy", kDimStress, &R::Fy);
    add("fck", kDimStress, &R::fck);
    add("fyk", kDimStress, &R::fyk);
    add("Es", kDimStress, &R::Es);
    add("rho", kDensity, &R::density);
    add("alpha", kDimNone, &R::alpha, true);
    return c;
}

} // namespace

std::unique_ptr<CRecordGrid> MakeNodeGrid(CDBDoc& doc, const char* title)
{
    return std::make_unique<CRecordTable<T_NODE_D>>(doc, title, NodeColumns());
}

std::unique_ptr<CRecordGrid> MakeElementGrid(CDBDoc& doc, const char* title)
{
    return std::make_unique<CRecordTable<T_ELEM_D>>(doc, title, ElementColumns());
}

std::unique_ptr<CRecordGrid> MakeSectionGrid(CDBDoc& doc, const char* title)
{
    return std::make_unique<CRecordTable<T_SECT_D>>(doc, title, SectionColumns());
}

std::unique_ptr<CRecordGrid> MakeMaterialGrid(CDBDoc& doc, const char* title)
{
    return std::make_unique<CRecordTable<T_MATL_D>>(doc, title, MaterialColumns());
}

std::unique_ptr<CRecordGrid> MakeStoreyGrid(CDBDoc& doc, const char* title)
{
    using R = T_STOR_D;
    T_RECORD_COLUMNS<R> columns{
        KeyColumn<R>("IDS_QM_UI_HEAD_KEY"), NameColumn(&T_MODEL::storeys),
        NumberColumn<R>(
            "IDS_QM_UI_HEAD_HEIGHT", kDimLength, [](R& r) -> double& { return r.height; }, 0.0),
        FixedColumn<R>("IDS_QM_UI_HEAD_NODES", [](const T_MODEL&, const R& r) {
            std::string ids;
            for (const int id : r.nodes)
                ids += (ids.empty() ? "" : ", ") + std::to_string(id);
            return ids;
        })};
    return std::make_unique<CRecordTable<R>>(doc, title, std::move(columns));
}
