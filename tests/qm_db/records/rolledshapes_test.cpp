// Every rolled shape of the American tables and every channel against its printed properties.
#include "qm_db/records/namedrecords.h"
#include "qm_db/sectionproperties.h"

#include <cmath>
#include <gtest/gtest.h>
#include <sstream>

namespace {

constexpr double kInch = 2.54; // cm

T_SECT_D Properties(const std::string& name)
{
    const std::optional<T_SECT_D> shape = NamedShape(name);
    EXPECT_TRUE(shape) << name;
    T_SECT_D s;
    SECT_FAULT fault = SECT_FAULT::None;
    EXPECT_EQ(1, CSectionProperties::Calc(shape.value_or(s), s, fault)) << name;
    return s;
}

/// A, Iy, Wpl,y, Iz, Wpl,z, centroid from the back, shear centre from the back (cm).
std::vector<double> Centimetres(const T_SECT_D& s)
{
    const bool channel = s.shape == SECT_SHAPE::Channel;
    const T_CHANNEL c = channel ? ChannelProperties(s) : T_CHANNEL();
    return {1e4 * s.area, 1e8 * s.Iyy,      1e6 * s.Zy,         1e8 * s.Izz,
            1e6 * s.Zz,   1e2 * c.centroid, 1e2 * c.shearCentre};
}

/// Every row of a table: a name, then the numbers that `perCent` has a bound for. How many.
template <class F>
std::size_t ExpectTable(const char* table, const std::vector<double>& perCent, F of)
{
    std::istringstream in(table);
    std::size_t rows = 0;
    for (std::string name; in >> name; ++rows) {
        const T_SECT_D s = Properties(name);
        const std::vector<double> got = of(Centimetres(s), s);
        for (std::size_t i = 0; i < perCent.size(); ++i) {
            double printed = 0.0;
            in >> printed;
            EXPECT_NEAR(0.0, 100.0 * (got[i] / printed - 1.0), perCent[i]) << name << ' ' << i;
        }
    }
    return rows;
}

std::size_t Count(const char* family)
{
    return static_cast<std::size_t>(std::ranges::count(
        SteelShapes(), family, [](const T_ROLLED_SHAPE& s) { return s.Family(); }));
}

/// A, Ix, Zx, Iy, Zy, x.
std::vector<double> Inches(std::vector<double> v, const T_SECT_D&)
{
    constexpr std::array kPowers{2, 4, 3, 4, 3, 1, 1};
    for (std::size_t i = 0; i < v.size(); ++i)
        v[i] /= std::pow(kInch, kPowers[i]);
    return v;
}

// AISC Shapes Database 14.1: A, Ix, Zx, Iy in inches.
constexpr const char* kWide = R"(
W8X10 2.96 30.8 8.87 2.09  W8X13 3.84 39.6 11.4 2.73  W8X15 4.44 48.0 13.6 3.41
W8X18 5.26 61.9 17.0 7.97  W8X21 6.16 75.3 20.4 9.77  W8X24 7.08 82.7 23.1 18.3
W8X28 8.25 98.0 27.2 21.7  W8X31 9.13 110 30.4 37.1  W8X35 10.3 127 34.7 42.6
W8X40 11.7 146 39.8 49.1  W8X48 14.1 184 49.0 60.9  W8X58 17.1 228 59.8 75.1
W8X67 19.7 272 70.1 88.6  W10X12 3.54 53.8 12.6 2.18  W10X15 4.41 68.9 16.0 2.89
W10X17 4.99 81.9 18.7 3.56  W10X19 5.62 96.3 21.6 4.29  W10X22 6.49 118 26.0 11.4
W10X26 7.61 144 31.3 14.1  W10X30 8.84 170 36.6 16.7  W10X33 9.71 171 38.8 36.6
W10X39 11.5 209 46.8 45.0  W10X45 13.3 248 54.9 53.4  W10X49 14.4 272 60.4 93.4
W10X54 15.8 303 66.6 103  W10X60 17.7 341 74.6 116  W10X68 19.9 394 85.3 134
W10X77 22.7 455 97.6 154  W10X88 26.0 534 113 179  W10X100 29.3 623 130 207
W10X112 32.9 716 147 236  W12X14 4.16 88.6 17.4 2.36  W12X16 4.71 103 20.1 2.82
W12X19 5.57 130 24.7 3.76  W12X22 6.48 156 29.3 4.66  W12X26 7.65 204 37.2 17.3
W12X30 8.79 238 43.1 20.3  W12X35 10.3 285 51.2 24.5  W12X40 11.7 307 57.0 44.1
W12X45 13.1 348 64.2 50.0  W12X50 14.6 391 71.9 56.3  W12X53 15.6 425 77.9 95.8
W12X58 17.0 475 86.4 107  W12X65 19.1 533 96.8 174  W12X72 21.1 597 108 195
W12X79 23.2 662 119 216  W12X87 25.6 740 132 241  W12X96 28.2 833 147 270
W12X106 31.2 933 164 301  W12X120 35.2 1070 186 345  W12X136 39.9 1240 214 398
W12X152 44.7 1430 243 454  W12X170 50.0 1650 275 517  W12X190 56.0 1890 311 589
W12X210 61.8 2140 348 664  W14X22 6.49 199 33.2 7.00  W14X26 7.69 245 40.2 8.91
W14X30 8.85 291 47.3 19.6  W14X34 10.0 340 54.6 23.3  W14X38 11.2 385 61.5 26.7
W14X43 12.6 428 69.6 45.2  W14X48 14.1 484 78.4 51.4  W14X53 15.6 541 87.1 57.7
W14X61 17.9 640 102 107  W14X68 20.0 722 115 121  W14X74 21.8 795 126 134
W14X82 24.0 881 139 148  W14X90 26.5 999 157 362  W14X99 29.1 1110 173 402
W14X109 32.0 1240 192 447  W14X120 35.3 1380 212 495  W14X132 38.8 1530 234 548
W14X145 42.7 1710 260 677  W14X159 46.7 1900 287 748  W14X176 51.8 2140 320 838
W14X193 56.8 2400 355 931  W14X211 62.0 2660 390 1030  W14X233 68.5 3010 436 1150
W14X257 75.6 3400 487 1290  W14X283 83.3 3840 542 1440  W14X311 91.4 4330 603 1610
W14X342 101 4900 672 1810  W14X370 109 5440 736 1990  W14X398 117 6000 801 2170
W14X426 125 6600 869 2360  W16X26 7.68 301 44.2 9.59  W16X31 9.13 375 54.0 12.4
W16X36 10.6 448 64.0 24.5  W16X40 11.8 518 73.0 28.9  W16X45 13.3 586 82.3 32.8
W16X50 14.7 659 92.0 37.2  W16X57 16.8 758 105 43.1  W16X67 19.6 954 130 119
W16X77 22.6 1110 150 138  W16X89 26.2 1300 175 163  W16X100 29.4 1490 198 186
W18X35 10.3 510 66.5 15.3  W18X40 11.8 612 78.4 19.1  W18X46 13.5 712 90.7 22.5
W18X50 14.7 800 101 40.1  W18X55 16.2 890 112 44.9  W18X60 17.6 984 123 50.1
W18X65 19.1 1070 133 54.8  W18X71 20.9 1170 146 60.3  W18X76 22.3 1330 163 152
W18X86 25.3 1530 186 175  W18X97 28.5 1750 211 201  W18X106 31.1 1910 230 220
W18X119 35.1 2190 262 253  W18X130 38.3 2460 290 278  W18X143 42.0 2750 322 311
W21X44 13.0 843 95.4 20.7  W21X48 14.1 959 107 38.7  W21X50 14.7 984 110 24.9
W21X55 16.2 1140 126 48.4  W21X57 16.7 1170 129 30.6  W21X62 18.3 1330 144 57.5
W21X68 20.0 1480 160 64.7  W21X73 21.5 1600 172 70.6  W21X83 24.4 1830 196 81.4
W21X93 27.3 2070 221 92.9  W21X101 29.8 2420 253 248  W21X111 32.6 2670 279 274
W21X122 35.9 2960 307 305  W21X132 38.8 3220 333 333  W21X147 43.2 3630 373 376
W21X166 48.8 4280 432 435  W24X55 16.2 1350 134 29.1  W24X62 18.2 1550 153 34.5
W24X68 20.1 1830 177 70.4  W24X76 22.4 2100 200 82.5  W24X84 24.7 2370 224 94.4
W24X94 27.7 2700 254 109  W24X103 30.3 3000 280 119  W24X104 30.7 3100 289 259
W24X117 34.4 3540 327 297  W24X131 38.6 4020 370 340  W24X146 43.0 4580 418 391
W24X162 47.8 5170 468 443  W24X176 51.7 5680 511 479  W27X84 24.7 2850 244 106
W27X94 27.6 3270 278 124  W27X102 30.0 3620 305 139  W27X114 33.6 4080 343 159
W27X129 37.8 4760 395 184  W27X146 43.2 5660 464 443  W27X161 47.6 6310 515 497
W27X178 52.5 7020 570 555  W30X90 26.3 3610 283 115  W30X99 29.0 3990 312 128
W30X108 31.7 4470 346 146  W30X116 34.2 4930 378 164  W30X124 36.5 5360 408 181
W30X132 38.8 5770 437 196  W30X148 43.6 6680 500 227  W30X173 50.9 8230 607 598
W30X191 56.1 9200 675 673  W30X211 62.3 10300 751 757  W33X118 34.7 5900 415 187
W33X130 38.3 6710 467 218  W33X141 41.5 7450 514 246  W33X152 44.9 8160 559 273
W33X169 49.5 9290 629 310  W33X201 59.1 11600 773 749  W33X221 65.3 12900 857 840
W33X241 71.1 14200 940 933  W36X135 39.9 7800 509 225  W36X150 44.3 9040 581 270
W36X160 47.0 9760 624 295  W36X170 50.0 10500 668 320  W36X182 53.6 11300 718 347
W36X194 57.0 12100 767 375  W36X210 61.9 13200 833 411  W36X231 68.2 15600 963 940
W36X232 68.0 15000 936 468  W36X247 72.5 16700 1030 1010  W36X256 75.3 16800 1040 528
W36X262 77.2 17900 1100 1090)";

// A, Ix, Zx, Iy, Zy, x (centroid from the back) in inches.
constexpr const char* kAiscChannels = R"(
C6X8.2 2.39 13.1 5.16 0.687 0.987 0.512  C6X10.5 3.07 15.1 6.18 0.860 1.14 0.500
C6X13 3.82 17.3 7.29 1.05 1.35 0.514  C7X9.8 2.87 21.2 7.19 0.957 1.26 0.541
C7X12.25 3.59 24.2 8.46 1.16 1.42 0.525  C7X14.75 4.33 27.2 9.75 1.37 1.63 0.532
C8X11.5 3.37 32.5 9.63 1.31 1.57 0.572  C8X13.75 4.03 36.1 11.0 1.52 1.73 0.554
C8X18.75 5.51 43.9 13.9 1.97 2.17 0.565  C9X13.4 3.94 47.8 12.6 1.75 1.94 0.601
C9X15 4.40 51.0 13.6 1.91 2.04 0.586  C9X20 5.87 60.9 16.9 2.41 2.46 0.583
C10X15.3 4.48 67.3 15.9 2.27 2.34 0.634  C10X20 5.87 78.9 19.4 2.80 2.70 0.606
C10X25 7.35 91.1 23.1 3.34 3.18 0.617  C10X30 8.81 103 26.7 3.93 3.78 0.649
C12X20.7 6.08 129 25.6 3.86 3.47 0.698  C12X25 7.34 144 29.4 4.45 3.82 0.674
C12X30 8.81 162 33.8 5.12 4.32 0.674  C15X33.9 10.0 315 50.8 8.07 6.19 0.788
C15X40 11.8 348 57.5 9.17 6.84 0.778  C15X50 14.7 404 68.5 11.0 8.14 0.799
MC8X18.7 5.50 52.4 15.6 4.15 3.72 0.849  MC8X20 5.87 54.4 16.4 4.42 3.86 0.840
MC8X21.4 6.28 61.5 18.2 6.58 5.18 1.02  MC8X22.8 6.70 63.8 19.1 7.01 5.37 1.01
MC10X25 7.34 110 26.2 7.25 5.65 0.953  MC10X28.5 8.37 126 30.0 11.3 7.59 1.12
MC10X33.6 9.87 139 33.7 13.1 8.28 1.09  MC10X41.1 12.1 157 39.3 15.7 9.49 1.09
MC12X31 9.12 202 39.7 11.3 8.15 1.08  MC12X35 10.3 216 43.2 12.6 8.62 1.05
MC12X40 11.8 234 47.7 14.2 9.31 1.04  MC12X45 13.2 251 52.0 15.8 10.1 1.04
MC12X50 14.7 269 56.5 17.4 10.9 1.05  MC13X31.8 9.35 239 43.4 11.4 7.69 1.00
MC13X35 10.3 252 46.5 12.3 8.04 0.980  MC13X40 11.7 273 51.2 13.7 8.66 0.963
MC13X50 14.7 314 60.8 16.4 10.2 0.974  MC18X42.7 12.6 554 75.1 14.3 8.82 0.877
MC18X45.8 13.5 578 79.2 14.9 9.14 0.866  MC18X51.9 15.3 627 87.3 16.3 9.86 0.858
MC18X58 17.1 675 95.4 17.6 10.7 0.862)";

// A, Iy, Wpl,y, Iz, Wpl,z, ys (centroid from the back), ym (shear centre from the centroid) in cm.
constexpr const char* kUpn = R"(
UPN80 11.02 106 32.3 19.4 11.9 1.42 2.65  UPN100 13.5 206 49 29.3 16.2 1.55 2.93
UPN120 17 364 72.6 43.2 21.2 1.6 3.03  UPN140 20.4 605 103 62.7 28.3 1.75 3.37
UPN160 24 925 138 85.3 35.2 1.84 3.56  UPN180 28 1350 179 114 42.9 1.92 3.75
UPN200 32.2 1910 228 148 51.8 2.01 3.94  UPN220 37.4 2690 292 197 64.1 2.14 4.2
UPN240 42.3 3600 358 248 75.7 2.23 4.39  UPN260 48.3 4820 442 317 91.6 2.36 4.66
UPN280 53.3 6280 532 399 109 2.53 5.02  UPN300 58.8 8030 632 495 130 2.7 5.41
UPN320 75.8 10870 826 597 152 2.6 4.82  UPN350 77.3 12840 918 570 143 2.4 4.45
UPN380 80.4 15760 1014 615 148 2.38 4.58  UPN400 91.5 20350 1240 846 190 2.65 5.11)";

// A, Iy, Wpl,y, Iz, Wpl,z, e0 (shear centre from the middle of the web) in cm.
constexpr const char* kUpe = R"(
UPE80 10.1 107 31.2 25.5 14.3 2.01  UPE100 12.5 207 48 38.3 19.3 2.16
UPE120 15.4 364 70.3 55.5 25.3 2.28  UPE140 18.4 600 98.8 78.8 33.2 2.51
UPE160 21.7 911 132 107 41.5 2.67  UPE180 25.1 1350 173 144 52.3 2.92
UPE200 29.0 1910 220 187 63.3 3.05  UPE220 33.9 2680 281 247 78.2 3.24
UPE240 38.5 3600 347 311 92.2 3.36  UPE270 44.8 5250 451 401 112 3.52
UPE300 56.6 7820 613 538 137 3.53  UPE330 67.8 11000 792 681 156 3.55
UPE360 77.9 14800 982 844 178 3.65  UPE400 91.9 21000 1260 1040 191 3.67)";

} // namespace

TEST(RolledShapes, HaveTheirPrintedProperties)
{
    // Three digits of five dimensions and of the value itself.
    EXPECT_EQ(Count("W"), ExpectTable(kWide, {0.65, 1.0, 1.05, 1.45}, Inches));
    EXPECT_EQ(Count("C") + Count("MC"),
              ExpectTable(kAiscChannels, {0.6, 0.5, 0.55, 0.95, 0.8, 0.65}, Inches));
    // Wpl,y of UPN 80 and 350, and Wpl,z of some, are off in the tables themselves.
    EXPECT_EQ(Count("UPN"), ExpectTable(kUpn, {0.35, 0.3, 2.1, 0.65, 1.55, 2.3, 3.5},
                                        [](std::vector<double> v, const T_SECT_D&) {
                                            v[6] = v[5] - v[6];
                                            return v;
                                        }));
    // The printed Wpl,z of UPE 330 to 400 are none of these dimensions.
    EXPECT_EQ(Count("UPE"), ExpectTable(kUpe, {0.35, 0.3, 0.35, 0.5, 16.0, 0.5},
                                        [](std::vector<double> v, const T_SECT_D& s) {
                                            v[5] = 50.0 * s.size[2] - v[6];
                                            return v;
                                        }));
    // W14X90 in millimetres, as the database has it: d, bf, tw, tf, kdes.
    const T_SECT_D s = Properties("w 14x90");
    const std::array mm{356.0, 368.0, 11.2, 18.0, 33.3};
    for (std::size_t i = 0; i < mm.size(); ++i)
        EXPECT_NEAR(mm[i], 1e3 * (i < 4 ? s.size[i] : s.fillet + s.size[3]), i < 2 ? 0.5 : 0.05);
}

// Sharp and parallel, 200 x 80, web 10, flanges 20 mm: A = 1600 + 3200, centroid (1600 5 + 3200 40)
// / 4800; half of A is left of 10 + 400 / 40 = 20; Iy = (80 200^3 - 70 160^3) / 12; Wpl,y = 1600 40
// + 3200 90; the flow of a flange, 20 90 75^2 / 2, has the lever 180.
TEST(RolledShapes, AChannelIsWhatTheHandFinds)
{
    T_SECT_D s;
    s.shape = SECT_SHAPE::Channel;
    s.size = {200.0, 80.0, 10.0, 20.0};
    const T_CHANNEL c = ChannelProperties(s);
    EXPECT_NEAR(4800.0, c.area, 1e-9 * 4800.0);
    EXPECT_NEAR(28.0 + 1.0 / 3.0, c.centroid, 1e-9);
    EXPECT_NEAR(20.0, c.plasticAxis, 1e-9);
    const double Iy = (80.0 * 8e6 - 70.0 * 4.096e6) / 12.0;
    EXPECT_NEAR(Iy, c.Iyy, 1e-9 * Iy);
    EXPECT_NEAR(352000.0, c.Zy, 1e-3);
    // Right of the axis 40 wide over 60, left of it 40 over 10 and the web 200 wide over 10.
    EXPECT_NEAR(40.0 * 1800.0 + 400.0 * 5.0 + 2000.0 * 15.0, c.Zz, 1e-3);
    EXPECT_NEAR(5.0 - 20.0 * 90.0 * 2812.5 * 180.0 / Iy, c.shearCentre, 1e-9);
    // C15X33.9 with flanges of mean thickness throughout, as the tables of AISC take it: eo =
    // 0.896.
    T_SECT_D flat = *NamedShape("C15X33.9");
    flat.taper = flat.fillet = 0.0;
    EXPECT_NEAR(-0.896, 100.0 * ChannelProperties(flat).shearCentre / kInch, 0.005);
}

TEST(RolledShapes, WhatHasNoRoomIsRefused)
{
    T_SECT_D s = *NamedShape("UPN 200"), out;
    const auto refused = [&](auto change) {
        T_SECT_D changed = s;
        change(changed);
        SECT_FAULT fault = SECT_FAULT::None;
        return CSectionProperties::Calc(changed, out, fault) == 0 &&
               fault == SECT_FAULT::Dimensions;
    };
    EXPECT_FALSE(refused([](T_SECT_D&) {}));
    EXPECT_TRUE(refused([](T_SECT_D& c) { c.taper = 0.5; })); // no tip is left
    EXPECT_TRUE(refused([](T_SECT_D& c) { c.taper = -0.08; }));
    EXPECT_TRUE(refused([](T_SECT_D& c) { c.fillet = 0.06; }));   // beyond the face
    EXPECT_TRUE(refused([](T_SECT_D& c) { c.size[2] = 0.075; })); // all web
    EXPECT_TRUE(refused([](T_SECT_D& c) { c.size[3] = 0.098; })); // thicker at the web than half
    EXPECT_TRUE(refused([](T_SECT_D& c) { c.shape = SECT_SHAPE::IShape; })); // of no I
}
