#include "qm_rps/factors/ulfstageresults.h"

#include "qm_db/dbdoc.h"

int CUlfStageResults::SelectSum(const std::string& stageLoad, int stage, int step)
{
    int key = 0;
    if (!m_doc.Attr().GetSgldKey(stageLoad, key)) return 0;
    m_doc.Post().SelectStage(stage, step, key);
    return 1;
}

int CUlfStageResults::SelectCase(int loadCase, int stage, int step)
{
    m_doc.Post().SelectStage(stage, step, loadCase);
    return 1;
}

int CUlfStageResults::ReadOne(const T_OPT_QUANTITY& what, double& out)
{
    CPostCtrl& post = m_doc.Post();
    T_DOF6 values{};
    const auto component = static_cast<std::size_t>(what.component - 1);
    if (what.component < 1 || component >= values.size()) return 0;
    int done = 0;
    switch (what.kind) {
    case 1:
        done = post.GetDspcNew(what.id, values);
        break;
    case 2:
        done = post.GetReccNew(what.id, values);
        break;
    case 3: // the truss has one force
        done = component == 0 ? post.GetStrtcNew(what.id, values[0]) : 0;
        break;
    case 4:
        done = post.GetStrbcNew(what.id, what.position - 1, values);
        break;
    default:
        break;
    }
    if (done) out = values[component];
    return done;
}

std::string CUlfStageResults::Error() const
{
    return m_doc.Post().Error();
}
