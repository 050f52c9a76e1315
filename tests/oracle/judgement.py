#!/usr/bin/env python3
"""Demand and capacity of a cantilever column, independent of the program: python3 judgement.py

0.40 x 0.40, 8 bars of 18 mm, stirrups 8 mm at 0.15, clear length and shear span 3 m, N = 640 kN;
strengths 28 and 450 MPa, characteristic ones 20 and 400. The joint of that column with one beam
0.30 x 0.50 (bars at 0.453 m from the compressed edge); the same cantilever as a welded I 200x200x9x15 of
fy 275, mean 303 MPa. Formulas as they are printed (EN 1998-3
Annex A; Panagiotakos, Fardis 2001; ASCE 41-17 Eq. (10-3), Table 10-8; EN 1998-1 5.5.3.3; Circolare 2019
[C8.7.2.11]; ASCE 41-17 Table 10-12; EN 1998-3 Annex B; EN 1993-1-1 6.2.6, 6.2.9, 6.3.1; AISC 360 E3, G2). kN, m, MPa.
"""
import math

B = H = 0.4
A18 = 254.469e-6
ES = 200000.0
D, DP, N, LV = 0.353, 0.047, 640.0, 3.0
AV = 2 * math.pi / 4 * 0.008 ** 2
CORE = B - 0.06 - 0.008


def en1998(cf, gamma_c, gamma_s):
    fc, fy = 28.0 / cf, 450.0 / cf
    ec = 22000 * 2.8 ** 0.3
    as1, asv, al = 3 * A18, 2 * A18, ES / ec
    r1, rv, dd = as1 / (B * D), asv / (B * D), DP / D
    n = N / 1000 / (B * D * fy)
    aa, bb = 2 * r1 + rv + n, r1 + r1 * dd + rv * (1 + dd) / 2 + n
    xi = math.sqrt((al * aa) ** 2 + 2 * al * bb) - al * aa
    phi = fy / (ES * (1 - xi) * D)
    ac, bc = 2 * r1 + rv - N / 1000 / (1.8 * al * B * D * fc), r1 + r1 * dd + rv * (1 + dd) / 2
    xc = math.sqrt((al * ac) ** 2 + 2 * al * bc) - al * ac
    if 1.8 * fc / (ec * xc * D) < phi:
        xi, phi = xc, 1.8 * fc / (ec * xc * D)
    my = 1000 * B * D ** 3 * phi * (ec * xi * xi / 2 * (0.5 * (1 + dd) - xi / 3) + (
        (1 - xi) * r1 + (xi - dd) * r1 + rv * (1 - dd) / 6) * (1 - dd) * ES / 2)
    k = min(2.0, 1 + math.sqrt(0.2 / D))
    scp = min(N / 1000 / 0.16, 0.2 * fc)
    vrdc = 1000 * (max(0.18 * k * (100 * r1 * fc) ** (1 / 3), 0.035 * k ** 1.5 * fc ** 0.5) + 0.15 * scp) * B * D
    cracked = 1.0 if vrdc < my / LV else 0.0
    ty = phi * (LV + cracked * (D - DP)) / 3 + 0.0014 * (1 + 1.5 * H / LV) + phi * 0.018 * fy / (8 * math.sqrt(fc))
    alpha = (1 - 0.15 / (2 * CORE)) ** 2 * (1 - 4 * CORE ** 2 / (6 * CORE ** 2))
    rho = AV / (B * 0.15)
    w1, w2, nu = (as1 + asv) * fy / (B * D * fc), as1 * fy / (B * D * fc), N / 1000 / (0.16 * fc)
    um = 0.016 * 0.3 ** nu * (w2 / w1 * fc) ** 0.225 * (LV / H) ** 0.35 * 25 ** (alpha * rho * fy / fc) / 1.5
    # Shear: strengths over gamma_M as well, the depth of compression as it was.
    fcd, fywd = fc / gamma_c, fy / gamma_s
    axial = (H - xi * D) / (2 * LV) * min(N, 0.55 * B * D * fcd * 1000) / 1.15
    cyclic = (0.16 * max(0.5, 100 * 8 * A18 / (B * D)) * (1 - 0.16 * min(5.0, LV / H)) * math.sqrt(fcd) * B * D
              + rho * B * (D - DP) * fywd) * 1000 / 1.15
    strut = 0.9 * D * B * 0.6 * (1 - fcd / 250) * fcd / 2 * 1000  # without axial force: alpha_cw = 1
    print("EN1998-3", dict(theta_y=ty, SD=0.75 * um, NC=um, axial=axial, cyclic=cyclic, strut=strut))


def asce17():
    fc, fy, fcl, fyl = 28.0, 450.0, 20.0, 400.0
    def shear(c, y):
        k = 0.5 * math.sqrt(c) * 1000 / min(4.0, max(2.0, LV / D))
        return AV * y * 1000 * D / 0.15 + k * math.sqrt(1 + N / (0.5 * 0.16 * math.sqrt(c) * 1000)) * 0.8 * 0.16
    print("ASCE41-17", dict(expected=shear(fc, fy), lower=shear(fcl, fyl)))


def joint(cf, gamma_c):
    """Exterior joint without hoops: bj = 0.40, hc = 0.40, bars 0.306 apart, N = 640."""
    fc, area, between = 28.0 / cf / gamma_c, 0.16, 0.4 * 0.306
    eta, nu = 0.6 * (1 - 28.0 / cf / 250), N / 1000 / (area * fc)
    psi = 0.006894757293168
    print("joint", dict(lever=0.9 * 0.453, en=0.8 * eta * fc * math.sqrt(1 - nu / eta) * between * 1000,
                        circolare_tension=0.3 * math.sqrt(fc) * 1000, circolare_compression=0.5 * fc * 1000,
                        asce_kappa=0.9 * 6 * math.sqrt(20.0 / psi) * psi * area * 1000))


def steel(n, cf):
    """Cantilever of 3 m under n kN, bent about y; buckling over 3 m about z."""
    h, b, tw, tf, e, fy, fyl = 0.2, 0.2, 0.009, 0.015, 210000.0, 303.0 / cf, 275.0
    hw = h - 2 * tf
    a, w = 2 * b * tf + hw * tw, b * tf * (h - tf) + tw * hw ** 2 / 4
    iy, iz = (b * h ** 3 - (b - tw) * hw ** 3) / 12, (2 * tf * b ** 3 + hw * tw ** 3) / 12
    npl, share = a * fy * 1000, min(0.5, (a - 2 * b * tf) / a)
    my = w * fy * 1000 * min(1.0, (1 - n / npl) / (1 - 0.5 * share))
    theta = my * 3 / (3 * e * 1000 * iy)
    slender = 3 / math.sqrt(iz / a) / (math.pi * math.sqrt(e / fy))
    phi = 0.5 * (1 + 0.49 * (slender - 0.2) + slender ** 2)  # curve c
    buckled = npl / (phi + math.sqrt(phi ** 2 - slender ** 2))
    fe = math.pi ** 2 * e / (3 ** 2 / (iz / a))
    pn = a * 0.658 ** (fyl / fe) * fyl * 1000
    print("steel", n, dict(nu=n / npl, my=my, theta_y=theta, DL=2 * theta, SD=7 * theta, NC=9 * theta,
                           shear=hw * tw * fy / math.sqrt(3) * 1000, buckled=buckled,
                           asce_shear_kappa=0.9 * 0.6 * fyl * h * tw * 1000, asce_pn_kappa=0.9 * pn))


en1998(1.20, 1.5, 1.15)
asce17()
joint(1.20, 1.5)
steel(400.0, 1.20)
steel(640.0, 1.20)
