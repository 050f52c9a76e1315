#include "qm_solver/solverreason.h"

#include "qm_base/messagetext.h"
#include "qm_base/msgfunction.h"

namespace solver {

std::string T_SOLVER_REASON::Text() const
{
    std::vector<std::string> texts;
    for (const T_SOLVER_REASON& arg : args)
        texts.push_back(arg.Text());
    const std::vector<std::string_view> views(texts.begin(), texts.end());
    const std::string text = zql::lib::MMSGFunction::GetValue(key);
    return args.empty() ? text : zql::lib::FillPlaces(text, views);
}

} // namespace solver
