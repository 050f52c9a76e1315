#!/usr/bin/env python3
"""Hinges of steel, round columns, walls and masonry by a code, independent of the program: python3 codemembers.py

Formulas as they are printed or recalled (ASCE 41-17 Tables 9-6, 9-7.1, 9-8, 10-9, 10-19, Eq. (10-3); AISC 360 E3;
EN 1993-1-1 6.2.9, 6.3.1; EN 1998-3 Annex B; NTC 2018 7.8). kN, m.
"""
import math

E = 210e6


def shape(h, b, tw, tf):
    """Area, plastic and second moment of a welded I about its major axis, least radius."""
    area = 2 * b * tf + (h - 2 * tf) * tw
    iz = 2 * tf * b ** 3 / 12 + (h - 2 * tf) * tw ** 3 / 12
    return (area, b * tf * (h - tf) + tw * (h - 2 * tf) ** 2 / 4,
            (b * h ** 3 - (b - tw) * (h - 2 * tf) ** 3) / 12, math.sqrt(iz / area))


def steel():
    """Column I 200 x 200 x 9 x 15, 3.0 m, N = 400; beam I 300 x 150 x 7.1 x 10.7, 6.0 m. fy 275, mean 303."""
    fye, n = 303e3, 400.0
    a, z, i, r = shape(0.2, 0.2, 0.009, 0.015)
    p = n / (a * fye)
    m = z * fye * (1 - p / 2)
    length, web = 3.0 / r, 0.170 / 0.009  # flange 6.67 and web 18.9: compact
    pa = 0.8 * (1 - p) ** 2.2 / (0.1 * length + 0.8 * web) - 0.0035
    pb = 7.4 * (1 - p) ** 2.3 / (0.5 * length + 2.9 * web) - 0.006
    ty = m * 3.0 / (6 * E * i)
    print("ASCE41-17 steel column", dict(p=p, M=m, theta_y=ty, a=pa, b=max(pa, pb), c=0.9 - 0.9 * p,
                                         C=1 + 0.03 * pa / ty, V=2 * m / 3, Vn=0.6 * fye * 0.2 * 0.009))
    fe = math.pi ** 2 * E / (3.0 / r) ** 2
    pcl = a * 0.658 ** (275e3 / fe) * 275e3
    y13 = z * fye * 3.0 * (1 - p) / (6 * E * i)
    print("ASCE41-13 steel column", dict(PCL=pcl, ratio=n / pcl, M=min(1, 1.18 * (1 - p)) * z * fye, theta_y=y13))
    a, z, i, r = shape(0.3, 0.15, 0.0071, 0.0107)
    ty = z * fye * 6.0 / (6 * E * i)
    print("ASCE41-17 steel beam", dict(M=z * fye, theta_y=ty, a=9 * ty, b=11 * ty, V=2 * z * fye / 6))
    fy = 303e3 / 1.2
    a, z, i, r = shape(0.2, 0.2, 0.009, 0.015)
    nn, share = n / (a * fy), (a - 2 * 0.2 * 0.015) / a
    m = min(1, (1 - nn) / (1 - 0.5 * share)) * z * fy
    ty = m * 1.5 / (3 * E * i)
    print("EN1998-3 steel column", dict(n=nn, M=m, theta_y=ty, DL=2 * ty, SD=7 * ty, NC=9 * ty,
                                        Vpl=0.170 * 0.009 * fy / math.sqrt(3)))


def brace():
    """Pipe 139.7 x 5, 5.0 m."""
    d, t, length = 0.1397, 0.005, 5.0
    a = math.pi / 4 * (d ** 2 - (d - 2 * t) ** 2)
    i = math.pi / 64 * (d ** 4 - (d - 2 * t) ** 4)
    r = math.sqrt(i / a)
    fye = 303e3
    slender = length / r
    fe = math.pi ** 2 * E / slender ** 2
    pn = a * (0.658 ** (fye / fe) * fye if fye / fe <= 2.25 else 0.877 * fe)
    share = min(1, max(0, (slender / math.sqrt(E / fye) - 2.1) / 2.1))
    dc, dt = pn * length / (E * a), fye * length / E
    print("ASCE41-17 brace", dict(T=a * fye, P=pn, dc=dc, dt=dt, share=share, a=(1 - 0.5 * share) * dc,
                                  b=(7 + 2 * share) * dc, c=0.5 - 0.2 * share))
    fy = 303e3 / 1.2
    lam = slender / (math.pi * math.sqrt(E / fy))
    phi = 0.5 * (1 + 0.49 * (lam - 0.2) + lam ** 2)
    nb = a * fy / (phi + math.sqrt(phi ** 2 - lam ** 2))
    print("EN1998-3 brace", dict(lam=lam, N=nb, NC=7 * nb * length / (E * a), T=a * fy, NCt=10 * fy * length / E))


A18 = 254.469e-6
ES = 200e6


def strips(d, count=4000):
    return [(d / 2 - (i + 0.5) * d / count, d / count) for i in range(count)]


def parabola(e, f, e0):
    return 0.0 if e <= 0 else f if e >= e0 else f * (1 - (1 - e / e0) ** 2)


def capacity(width, h, bars, fc, fy, axial):
    """Moment at an axial force with 0.0035 at the edge +z; `width` by z."""
    def forces(x):
        n = m = 0.0
        for z, t in strips(h):
            f = parabola(0.0035 * (1 - (h / 2 - z) / x), fc, 0.002) * width(z) * t
            n, m = n + f, m + f * z
        for z, a in bars:
            e = 0.0035 * (1 - (h / 2 - z) / x)
            f = (max(-fy, min(fy, ES * e)) - parabola(e, fc, 0.002)) * a
            n, m = n + f, m + f * z
        return n, m
    low, high = 1e-4, h
    for _ in range(45):
        x = (low + high) / 2
        low, high = (x, high) if forces(x)[0] < axial else (low, x)
    return forces(low)[1]


RING = [(0.2 * math.cos(math.pi / 4 * k), A18) for k in range(8)]


def disc(z, d=0.5):
    return 2 * math.sqrt(max(0.0, d * d / 4 - z * z))


def circle():
    """Diameter 0.50, 8 bars of 18 mm on 0.20, hoops 8 mm at 0.10, cover 0.03; 3.0 m, N = 500; fc 28, fy 450."""
    fc, fy, n, d, lv = 28e3, 450e3, 500.0, 0.4, 1.5
    ag, av = math.pi / 4 * 0.25, 2 * math.pi / 4 * 0.008 ** 2
    my = capacity(disc, 0.5, RING, fc, fy, n)
    v = 2 * my / 3.0
    root = 0.5 * math.sqrt(28.0) * 1000
    vcol = av * fy * d / 0.1 + root / min(4, max(2, lv / d)) * math.sqrt(1 + n / (root * ag)) * 0.8 * ag
    nu, rho, ratio = n / (ag * fc), av / (0.5 * 0.1), max(0.2, v / vcol)
    b = 0.65 / (5 + nu / 0.8 / rho * fc / fy) - 0.01
    print("ASCE41-17 circle", dict(M=my, V=v, Vn=vcol, nu=nu, a=0.06 - 0.06 * nu + 1.3 * rho - 0.037 * ratio, b=b,
                                   c=0.24 - 0.4 * nu, LS=0.5 * b, CP=0.7 * b))
    round_en(n, lv, d)


def round_en(n, lv, d):
    fc, fy = 28e3 / 1.2, 450e3 / 1.2
    my = capacity(disc, 0.5, RING, fc, fy, n)
    core = 0.5 - 0.06 - 0.008
    load = (1 - 0.1 / (2 * core)) ** 2 * 2 * math.pi / 4 * 0.008 ** 2 / (0.5 * 0.1) * fy
    fcc = fc * (1 + 3.7 * (load / fc) ** 0.86)
    ecc, ecu = 0.002 * (1 + 5 * (fcc / fc - 1)), 0.004 + 0.5 * load / fcc

    def at(curvature):
        low, high = -0.02, 0.05  # strain at the centre
        for _ in range(60):
            mid = (low + high) / 2
            f = m = 0.0
            for z, t in strips(0.5):
                e = mid + curvature * z
                inner = disc(z, core)
                s = parabola(e, fcc, ecc) * inner
                if e <= 0.0035:
                    s += parabola(e, fc, 0.002) * (disc(z) - inner)
                f, m = f + s * t, m + s * t * z
            for z, a in RING:
                e = mid + curvature * z
                s = max(-fy, min(fy, ES * e)) - parabola(e, fcc, ecc)
                f, m = f + s * a, m + s * a * z
            low, high = (mid, high) if f < n else (low, mid)
        return low, m

    def reaches(curvature, yielding):
        e, _ = at(curvature)
        if yielding:
            return e - 0.2 * curvature < -fy / ES or e + 0.25 * curvature > 0.002 or e + 0.2 * curvature > fy / ES
        return e + core / 2 * curvature > ecu or e - 0.2 * curvature < -0.04
    found = []
    for yielding in (True, False):
        low, high = 0.0, 0.5
        for _ in range(40):
            mid = (low + high) / 2
            low, high = (low, mid) if reaches(mid, yielding) else (mid, high)
        found.append(low)
    py, pu = found
    e, _ = at(py)
    x = (e + 0.25 * py) / py
    dp = 0.25 - sum(z for z, _ in RING if z > 1e-9) / 3
    # The half of the bars with the two on the axis.
    halves = [z for z, _ in RING if z > -1e-9]
    dp = 0.25 - sum(halves) / len(halves)
    slip = 0.018 * fy / 1000 / math.sqrt(fc / 1000)
    print("EN1998-3 circle", dict(M=my, phi_y=py, phi_u=pu, x=x, dp=dp, Mu=at(pu)[1], slip=slip,
                                  Lpl=lv / 30 + 0.2 * 0.5 + 0.11 * slip))


def wall():
    """0.25 x 2.0, 3.0 m, N = 1000; 20 bars of 18 mm along both faces, stirrups 8 mm at 0.2; fc 28, fy 450."""
    fc, fy, n, t, lw = 28e3, 450e3, 1000.0, 0.25, 2.0
    bars = [(-0.95 + 1.9 * k / 9, 2 * A18) for k in range(10)]
    my = capacity(lambda z: t, lw, bars, fc, fy, n)
    v = 2 * my / 3.0
    root = math.sqrt(fc * 1000 / 6894.757293168) * 6.894757293168
    rho = 2 * math.pi / 4 * 0.008 ** 2 / (t * 0.2)
    vn = min(2 * root + rho * fy, 10 * root) * t * lw
    x, level = n / (t * lw * fc), v / (t * lw * root)
    p = min(1, max(0, (x - 0.1) / 0.15))
    q = min(1, max(0, (level - 4) / 2))
    def table(a, b, c, d):
        return (a + (b - a) * q) * (1 - p) + (c + (d - c) * q) * p
    print("ASCE41-17 wall", dict(M=my, V=v, Vn=vn, x=x, level=level, a=table(0.008, 0.006, 0.003, 0.002),
                                 b=table(0.015, 0.010, 0.005, 0.004), c=table(0.60, 0.30, 0.25, 0.20)))


steel()
brace()
circle()
wall()
