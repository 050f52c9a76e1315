#!/usr/bin/env python3
"""Demand and capacity of a cantilever column, independent of the program: python3 judgement.py

0.40 x 0.40, 8 bars of 18 mm, stirrups 8 mm at 0.15, clear length and shear span 3 m, N = 640 kN;
strengths 28 and 450 MPa, characteristic ones 20 and 400. Formulas as they are printed (EN 1998-3
Annex A; Panagiotakos, Fardis 2001; ASCE 41-17 Eq. (10-3), Table 10-8). kN, m, MPa.
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


en1998(1.20, 1.5, 1.15)
asce17()
