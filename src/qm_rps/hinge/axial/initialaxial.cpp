#include "qm_rps/hinge/axial/initialaxial.h"

#include "qm_db/analysisrun.h"

int CInitialAxial::Analyse(const T_MODEL& model, std::string& reason, int loadCase)
{
    std::vector<T_PUSH_INITIAL_LOAD> loads = model.pushControl.initialLoads;
    if (loadCase != 0) loads = {{loadCase, 1.0}};
    m_axial.clear();
    m_isLoaded = !loads.empty();
    if (!m_isLoaded) return 1;
    T_ANALYSIS_OPTIONS options;
    options.allCases = options.stages = false;
    for (const T_PUSH_INITIAL_LOAD& load : loads)
        options.cases.push_back(load.loadCase);
    T_ANALYSIS_RESULTS results;
    T_ANALYSIS_ERROR error;
    if (!CAnalysisRun::Compute(model, options, nullptr, results, error)) {
        reason = error.text;
        return 0;
    }
    for (const T_PUSH_INITIAL_LOAD& load : loads)
        for (const auto& entry : model.elements) {
            T_ELEM_FORCES forces;
            const auto found = results.cases.find(load.loadCase);
            if (found == results.cases.end() || !found->second->ReadForces(entry.first, forces))
                continue; // a spring has none
            T_ENDS<double>& axial = m_axial[entry.first];
            axial.I -= load.factor * forces.front()[0];
            axial.J -= load.factor * forces.back()[0];
        }
    return 1;
}

T_ENDS<double> CInitialAxial::Of(int element) const
{
    const auto found = m_axial.find(element);
    return found == m_axial.end() ? T_ENDS<double>{} : found->second;
}
