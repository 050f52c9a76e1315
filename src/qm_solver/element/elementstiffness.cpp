#include "qm_solver/element/elementstiffness.h"

#include "qm_solver/element/beamelement.h"

namespace solver {

namespace {

void TrussMatrix(const T_FRAME& frame, const T_ELEMENT& element, const T_AXIAL& axial,
                 T_MATRIX12& k)
{
    double length = 0.0;
    const T_VEC3 e = TrussDirection(frame, element, length);
    const double across = axial.tension / length;
    const double along = axial.modulus * TrussStiffness(frame, element, length) - across;
    k = {};
    for (std::size_t r = 0; r < 3; ++r)
        for (std::size_t c = 0; c < 3; ++c) {
            const double value = along * e[r] * e[c] + (r == c ? across : 0.0);
            k[r][c] = k[6 + r][6 + c] = value;
            k[r][6 + c] = k[6 + r][c] = -value;
        }
}

} // namespace

T_VEC3 TrussDirection(const T_FRAME& frame, const T_ELEMENT& element, double& length)
{
    const T_VEC3 along = Minus(frame.nodes[element.j].xyz, frame.nodes[element.i].xyz);
    length = Norm(along);
    return Scaled(along, 1.0 / length);
}

double TrussStiffness(const T_FRAME& frame, const T_ELEMENT& element, double length)
{
    return frame.materials[element.material].E * frame.sections[element.section].StiffA() / length;
}

void ElementStiffness(const T_FRAME& frame, const T_ELEMENT& element, const T_AXIAL& axial,
                      T_MATRIX12& stiffness)
{
    switch (element.kind) {
    case ELEMENT_KIND::Beam:
        CBeamElement(frame, element, axial.tension).Stiffness(stiffness);
        break;
    case ELEMENT_KIND::Truss:
        TrussMatrix(frame, element, axial, stiffness);
        break;
    case ELEMENT_KIND::Link:
    case ELEMENT_KIND::Spring:
        stiffness = {};
        for (std::size_t d = 0; d < 6; ++d) {
            stiffness[d][d] = stiffness[d + 6][d + 6] = element.stiffness[d];
            stiffness[d][d + 6] = stiffness[d + 6][d] = -element.stiffness[d];
        }
        break;
    }
}

double StrainEnergy(const T_FRAME& frame, const T_ELEMENT& element, const T_AXIAL& axial,
                    const T_VEC12& u)
{
    double energy = 0.0, length = 0.0;
    switch (element.kind) {
    case ELEMENT_KIND::Beam:
        return CBeamElement(frame, element, axial.tension).StrainEnergy(u);
    case ELEMENT_KIND::Truss: {
        const T_VEC3 e = TrussDirection(frame, element, length);
        const T_VEC3 drift = Minus(Part(u, 6), Part(u, 0));
        const double strain = Dot(e, drift);
        const T_VEC3 across = Minus(drift, Scaled(e, strain));
        return axial.modulus * TrussStiffness(frame, element, length) * strain * strain +
               axial.tension / length * Dot(across, across);
    }
    case ELEMENT_KIND::Link:
        for (std::size_t d = 0; d < 6; ++d)
            energy += element.stiffness[d] * (u[6 + d] - u[d]) * (u[6 + d] - u[d]);
        break;
    case ELEMENT_KIND::Spring:
        for (std::size_t d = 0; d < 6; ++d)
            energy += element.stiffness[d] * u[d] * u[d];
        break;
    }
    return energy;
}

} // namespace solver
