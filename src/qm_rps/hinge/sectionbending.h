// Uniaxial bending with axial force of a section, and the law of its concrete.
#pragma once

#include "qm_db/records.h"
#include "qm_db/sectionproperties.h"
#include "qm_rps/codes/concretelaw.h"
#include "qm_solver/sectionsolver.h"

#include <array>
#include <optional>

/// Axial force (compression positive) and moment about the centroid.
struct T_AXIAL_MOMENT {
    double axial = 0.0, moment = 0.0;
};

/// Bending of a section about one axis in one direction. A place u runs from 0 (pure tension) to 2
/// (pure compression); the axial force rises with it.
class CSectionBending {
public:
    /// The section must be sound and carry its properties; the methods stand at CSectionStrength.
    /// Empty where a strain or a number is beyond what a section can have.
    static std::optional<CSectionBending> Of(const T_SECT_D& section, const T_MATL_D& material,
                                             const T_CONCRETE_LAW& law);
    /// Compresses the side +z (about y) or +y (about z), the other side when not positive.
    void Turn(bool aboutY, bool positive);

    /// 1 done; 0 nothing found, the outputs unchanged.
    [[nodiscard]] int At(double u, T_AXIAL_MOMENT& out) const;
    [[nodiscard]] int AtAxial(double axial, T_AXIAL_MOMENT& out) const;
    [[nodiscard]] int Largest(T_AXIAL_MOMENT& out, double& u) const;
    /// The moment that the section carries at an axial force in a direction of the moment (radians:
    /// 0 compresses +z, pi / 2 +y). Not of a section without a shape.
    [[nodiscard]] int Towards(double direction, double axial, double& moment) const;

private:
    T_AXIAL_MOMENT Along(const solver::T_CAPACITY& capacity) const;
    /// At an axial force with Mz = 0.
    [[nodiscard]] int Leaning(double axial, T_AXIAL_MOMENT& out) const;

    solver::CSectionSolver m_solver;
    bool m_plastic = false, m_aboutY = true;
    /// Of a channel: with an axial force, a neutral axis along y would leave a moment Mz.
    bool m_leans = false;
    double m_direction = 0.0;
    /// Straight interaction of a section without a shape: axial strength, moments about y and z.
    bool m_straight = false;
    double m_axial = 0.0, m_moment = 0.0;
    std::array<double, 2> m_moments{};
};
