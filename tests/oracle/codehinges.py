#!/usr/bin/env python3
"""Hinges of a column and a beam by a code, independent of the program: python3 codehinges.py

The section in 20000 strips and bisection on the neutral axis; formulas as they are printed (ASCE 41-17
Tables 10-7, 10-8, Eq. (10-3); EN 1998-3 Annex A; Panagiotakos, Fardis 2001). kN, m, MPa as named.
"""
import math

H = B = 0.4
A18 = 254.469e-6
ES = 200000.0  # MPa


def moment(b, h, bars, fc, fy, axial):
    """Capacity (kNm) at an axial force (kN, compression positive) that compresses the side +z."""
    def forces(x):
        n = m = 0.0
        count = 20000
        for i in range(count):
            t = (i + 0.5) * h / count
            e = 0.0035 * (1 - t / x)
            s = 0.0 if e <= 0 else fc if e >= 0.002 else fc * (1 - (1 - e / 0.002) ** 2)
            n += s * b * h / count * 1000
            m += s * b * h / count * 1000 * (h / 2 - t)
        for z, a in bars:
            e = 0.0035 * (1 - (h / 2 - z) / x)
            c = 0.0 if e <= 0 else fc if e >= 0.002 else fc * (1 - (1 - e / 0.002) ** 2)
            f = (max(-fy, min(fy, ES * e)) - c) * a * 1000
            n, m = n + f, m + f * z
        return n, m
    low, high = 1e-4, h
    for _ in range(50):
        x = (low + high) / 2
        low, high = (x, high) if forces(x)[0] < axial else (low, x)
    return forces(low)[1]


def column():
    """0.40 x 0.40, 8 bars of 18 mm at 0.153, clear 3.0, N = 640; stirrups 8 mm at 0.15, 2 legs."""
    bars = [(z, k * A18) for z, k in ((-0.153, 3), (0.0, 2), (0.153, 3))]
    d, dp, n, lv = 0.353, 0.047, 640.0, 1.5
    av = 2 * math.pi / 4 * 0.008 ** 2
    fc, fy = 28.0, 450.0
    my = moment(B, H, bars, fc, fy, n)
    v = 2 * my / 3.0
    k = 0.5 * math.sqrt(fc) * 1000 / min(4.0, max(2.0, lv / d))
    vcol = av * fy * 1000 * d / 0.15 + k * math.sqrt(1 + n / (0.5 * 0.16 * math.sqrt(fc) * 1000)) * 0.8 * 0.16
    nu, rho, ratio = n / (0.16 * fc * 1000), av / (B * 0.15), max(0.2, v / vcol)
    a = 0.042 - 0.043 * nu + 0.63 * rho - 0.023 * ratio
    b = 0.5 / (5 + nu / 0.8 / rho * fc / fy) - 0.01
    print("ASCE41-17 column", dict(M=my, M0=moment(B, H, bars, fc, fy, 0.0), V=v, Vn=vcol, a=a, b=b,
                                   c=0.24 - 0.4 * nu, IO=min(0.005, 0.15 * a), LS=0.5 * b, CP=0.7 * b))

    fc, fy = 28.0 / 1.2, 450.0 / 1.2
    ec = 22000 * 2.8 ** 0.3
    as1, asv, al = 3 * A18, 2 * A18, ES / ec
    r1, rv, dd = as1 / (B * d), asv / (B * d), dp / d
    aa = 2 * r1 + rv + n / 1000 / (B * d * fy)
    bb = r1 + r1 * dd + rv * (1 + dd) / 2 + n / 1000 / (B * d * fy)
    xi = math.sqrt((al * aa) ** 2 + 2 * al * bb) - al * aa
    phi = fy / (ES * (1 - xi) * d)
    ac = 2 * r1 + rv - n / 1000 / (1.8 * al * B * d * fc)
    bc = r1 + r1 * dd + rv * (1 + dd) / 2
    xc = math.sqrt((al * ac) ** 2 + 2 * al * bc) - al * ac
    if 1.8 * fc / (ec * xc * d) < phi:
        xi, phi = xc, 1.8 * fc / (ec * xc * d)
    mpf = 1000 * B * d ** 3 * phi * (ec * xi * xi / 2 * (0.5 * (1 + dd) - xi / 3) + (
        (1 - xi) * r1 + (xi - dd) * r1 + rv * (1 - dd) / 6) * (1 - dd) * ES / 2)
    k = min(2.0, 1 + math.sqrt(0.2 / d))
    rl = min(0.02, as1 / (B * d))
    scp = min(n / 1000 / 0.16, 0.2 * fc)
    vrdc = 1000 * (max(0.18 * k * (100 * rl * fc) ** (1 / 3), 0.035 * k ** 1.5 * fc ** 0.5) + 0.15 * scp) * B * d
    cracked = 1.0 if vrdc < mpf / lv else 0.0
    slip = 0.018 * fy / math.sqrt(fc)
    ty = phi * (lv + cracked * (d - dp)) / 3 + 0.0014 * (1 + 1.5 * H / lv) + phi * slip / 8
    core = B - 0.06 - 0.008
    alpha = (1 - 0.15 / (2 * core)) ** 2 * (1 - 4 * core ** 2 / (6 * core ** 2))
    w1, w2, nu = (as1 + asv) * fy / (B * d * fc), as1 * fy / (B * d * fc), n / 1000 / (0.16 * fc)
    um = 0.016 * 0.3 ** nu * (w2 / w1 * fc) ** 0.225 * (lv / H) ** 0.35 * 25 ** (alpha * rho * fy / fc) / 1.5
    print("EN1998-3 column", dict(M=moment(B, H, bars, fc, fy, n), theta_y=ty, SD=0.75 * um, NC=um, phi=phi,
                                  Mpf=mpf, vrdc=vrdc, cracked=cracked, alpha=alpha))


def beam():
    """0.30 x 0.50, 4 bars above, 3 below of 18 mm at 0.203, clear 4.6; stirrups 8 mm at 0.15."""
    bars = [(-0.203, 3 * A18), (0.203, 4 * A18)]
    fc, fy, b, d = 28.0, 450.0, 0.3, 0.453
    sag = moment(b, 0.5, bars, fc, fy, 0.0)  # compresses +z
    hog = moment(b, 0.5, [(-z, a) for z, a in bars], fc, fy, 0.0)
    v = (sag + hog) / 4.6
    beta = 0.85 - 0.05 * (28e6 / 6894.757 / 1000 - 4)
    bal = 0.85 * beta * fc / fy * 0.003 * ES / (0.003 * ES + fy)
    level = v / 1000 / (b * d * math.sqrt(28e6 / 6894.757) * 6894.757e-6)
    for name, m, tension, compression in (("sagging", sag, 3, 4), ("hogging", hog, 4, 3)):
        r = min(0.5, max(0.0, (tension - compression) * A18 / (b * d) / bal))
        s = min(6.0, max(3.0, level))
        def table(c):  # rows of condition i, C
            p = c[0] + (c[2] - c[0]) * r / 0.5, c[1] + (c[3] - c[1]) * r / 0.5
            return p[0] + (p[1] - p[0]) * (s - 3) / 3
        print("ASCE41-17 beam", name, dict(M=m, V=v, level=level, r=r, a=table((0.025, 0.02, 0.02, 0.015)),
              b=table((0.05, 0.04, 0.03, 0.02)), IO=table((0.010, 0.005, 0.005, 0.005))))


column()
beam()
