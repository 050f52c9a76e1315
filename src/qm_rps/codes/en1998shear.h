// Shear of concrete members by EN 1998-3 A.3.3, and of joints by the Circolare 2019.
#pragma once

#include "qm_rps/codes/en1998rotation.h"

struct T_EN_CYCLIC_SHEAR {
    double strength = 0.0; // VR at the ductility asked for
    double hoops = 0.0;    // Vw
    double strut = 0.0;    // VR,max of walls or short columns, where it holds; 0: none
};
/// (A.12); walls also (A.15), LV/h <= 2 also (A.16). x is the depth of the compression zone, m;
/// muPlastic = mu_theta - 1 >= 0. gamma_el 1.15, secondary 1.0.
/// `tensionOfHoops` is Vw of another section (circular), else rho_w bw z fyw.
std::optional<T_EN_CYCLIC_SHEAR> EnCyclicShear(const T_EN_MEMBER& m, double compressionDepth,
                                               double muPlastic,
                                               std::optional<double> tensionOfHoops,
                                               CCodeSheet& sheet);

/// Circular sections: Vw = pi/2 Asx/s fyw (D - 2c); area of one leg.
std::optional<double> CircularHoopShear(double legArea, double spacing, double fyw, double diameter,
                                        double cover, CCodeSheet& sheet);

/// Circolare 2019, joint without hoops: principal tension and compression against 0.3 sqrt fc and
/// 0.5 fc. Vj and N act on the joint's area.
struct T_JOINT_STRESS {
    double tension = 0.0, compression = 0.0;
    double tensionLimit = 0.0, compressionLimit = 0.0;
};
std::optional<T_JOINT_STRESS> CircolareJoint(double axial, double shear, double area, double fc,
                                             CCodeSheet& sheet);
