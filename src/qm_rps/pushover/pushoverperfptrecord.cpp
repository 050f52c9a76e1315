#include "qm_rps/pushover/pushoverperfptrecord.h"

#include "qm_rps/pushover/adrsformulas.h"

#include <utility>

int CPushOverPerfPtRecord::PerfPt_GetCrossPointDiAi(const std::vector<double>& Sd,
                                                    const std::vector<double>& Sa, double& Di,
                                                    double& Ai) const
{
    const auto point = CCurveCrossing::CapacityWithDemand(m_capacity.View(), {Sd, Sa});
    if (!point) return 0;
    Di = point->x;
    Ai = point->y;
    return 1;
}

void CPushOverPerfPtRecord::SetPerfPointSpectrumData(const std::vector<double>& Sa,
                                                     const std::vector<double>& Sd)
{
    m_perfPointSpectrum = {Sd, Sa};
}

void CPushOverPerfPtRecord::SetPerfPointTraceData(const std::vector<double>& D,
                                                  const std::vector<double>& A)
{
    m_perfPointTrace = {D, A};
}

void CPushOverPerfPtRecord::SetGravity(double model, double evaluation)
{
    m_modelGravity = model;
    m_gravity = evaluation;
}

void CPushOverPerfPtRecord::SetDesignSpectrum(std::unique_ptr<CETC_DESIGN_SPECT> spectrum)
{
    m_spectrum = std::move(spectrum);
    m_demandT.clear();
    m_demand = {};
    if (!m_spectrum) return;
    m_spectrum->CalcPOSpectrumSRaSRv(1.0, 1.0, m_demandT, m_demand.Sa);
    ToAdrs(m_demandT, m_demand.Sa, m_demand.Sd);
}

void CPushOverPerfPtRecord::ToAdrs(const std::vector<double>& T, const std::vector<double>& Sa,
                                   std::vector<double>& Sd) const
{
    Sd.resize(T.size());
    for (std::size_t i = 0; i < T.size(); ++i)
        Sd[i] = SpectralDisplacement(T[i], Sa[i], m_gravity);
}

void CPushOverPerfPtRecord::ClearPerfPoint()
{
    m_perfPointSpectrum = {};
    m_perfPointTrace = {};
    m_workingDemand = {};
    m_warnings.clear();
    m_perfPointTeff.reset();
    m_teffs.clear();
}
