// A channel from its dimensions: outline, centroid, shear centre.
//
// It is symmetric about y; the back of its web looks to -y, its flanges stand out to +y. Places
// along y count from the back of the web, places along z from the middle of the height.
#pragma once

#include "qm_db/records/structrecords.h"

#include <array>

/// Of the outline with its fillets, tapered flanges and rounded tips.
struct T_CHANNEL {
    double area = 0.0, Iyy = 0.0, Izz = 0.0; // about the centroid
    double Zy = 0.0, Zz = 0.0;               // plastic moduli
    double centroid = 0.0;                   // along y
    double plasticAxis = 0.0;                // along y: halves the area
    /// Along y, below 0: behind the web. Shear flow along the middle lines of the walls.
    double shearCentre = 0.0;
};
/// The dimensions must be sound.
T_CHANNEL ChannelProperties(const T_SECT_D& section);

/// A corner of the upper flange's inner face. The way to the next one bulges by tan(a quarter of
/// the angle of its arc), 0: straight; positive turns left.
struct T_FACE_CORNER {
    double y = 0.0, z = 0.0, bulge = 0.0;
};
/// From the web to the tip: where the fillet begins and ends, where the rounded tip does.
std::array<T_FACE_CORNER, 4> ChannelFace(const T_SECT_D& section);
