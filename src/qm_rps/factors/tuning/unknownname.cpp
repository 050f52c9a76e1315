#include "qm_rps/factors/tuning/unknownname.h"

std::vector<std::size_t> UnknownsNamed(const std::vector<std::string>& wholeNames,
                                       const std::string& name)
{
    std::vector<std::size_t> whole, ends;
    for (std::size_t u = 0; u < wholeNames.size(); ++u) {
        if (wholeNames[u] == name) whole.push_back(u);
        if (wholeNames[u].ends_with(" " + name)) ends.push_back(u);
    }
    return whole.empty() ? ends : whole;
}
