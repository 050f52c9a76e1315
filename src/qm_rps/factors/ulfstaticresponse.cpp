#include "qm_rps/factors/ulfstaticresponse.h"

#include "qm_base/msgfunction.h"
#include "qm_db/dbdoc.h"
#include "qm_rps/factors/optrows.h"

#include <cmath>

using zql::lib::MMSGFunction;

int CUlfStaticResponse::ReadOne(const T_OPT_QUANTITY& what, double& out)
{
    CPostCtrl& post = m_doc.Post();
    const auto component = static_cast<std::size_t>(what.component - 1);
    T_DOF6 values{};
    if (what.component < 1 || component >= values.size()) return 0;
    int done = 0;
    switch (what.kind) {
    case 1:
        done = post.GetDispNew(what.id, values);
        break;
    case 2:
        done = post.GetReacNew(what.id, values);
        break;
    case 3: // the truss has one force
        done = component == 0 ? post.GetStrtNew(what.id, values[0]) : 0;
        break;
    case 4:
        done = post.GetStrbNew(what.id, what.position - 1, values);
        break;
    default:
        break;
    }
    if (!done || !std::isfinite(values[component])) return 0;
    out = values[component];
    return 1;
}

int CUlfStaticResponse::Read(std::span<const T_OPT_ITEM> items,
                             std::span<const T_OPT_QUANTITY> what, std::span<double> out)
{
    m_error.clear();
    CPostCtrl& post = m_doc.Post();
    for (std::size_t i = 0; i < items.size(); ++i) {
        const int loadCase = Truncated(items[i][0]);
        bool ok = post.SelectLoadCombNew(CPostCtrl::MakeLoadComb(loadCase, 1.0)) != 0;
        for (std::size_t q = 0; ok && q < what.size(); ++q)
            ok = ReadOne(what[q], out[q * items.size() + i]) != 0;
        if (ok) continue;
        m_error = post.Error();
        if (m_error.empty())
            m_error = MMSGFunction::Format("IDS_QM_ULF_CASE_NOT_READ", {std::to_string(loadCase)});
        return 0;
    }
    return 1;
}
