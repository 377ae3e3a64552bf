#include "projection/ZoMapProjection.h"

#include <gtest/gtest.h>

#include <cmath>

namespace {

TEST(MapProjection, RegistryStringsAndIdentifiers) {
    EXPECT_EQ(CZoMapProjection::IDtoProjectionString(2), "UTM-32");
    EXPECT_EQ(CZoMapProjection::IDtoProjectionString(1), "LONG/LAT");
    EXPECT_EQ(CZoMapProjection::IDtoProjectionString(131), "UTM-31");
    EXPECT_EQ(CZoMapProjection::IDtoProjectionString(132), "");
    EXPECT_EQ(CZoMapProjection::IDtoProjectionString(0), "");
    for (const ProjectionEntry& e : CZoMapProjection::Entries()) {
        EXPECT_EQ(CZoMapProjection::ProjectionStringToID(e.name), e.id) << e.name;
        EXPECT_TRUE(CZoMapProjection::IsKnown(e.name)) << e.name;
    }
    EXPECT_EQ(CZoMapProjection::Entries().size(), 1u + 60u + 60u);

    const struct {
        const char* s;
        bool known, geographical;
    } cases[] = {
        {"LONG/LAT", true, true},  {"UTM-32", true, false},   {"UTM-60S", true, false},
        {"EPSG:4258", true, true}, {"EPSG:25832", true, false}, {"utm-32", false, false},
        {"UTM-61", false, false},  {"EPSG:", false, false},   {"EPSG:1x", false, false},
        {"EPSG:999999", false, false}, {"", false, false},
    };
    for (const auto& c : cases) {
        EXPECT_EQ(CZoMapProjection::IsKnown(c.s), c.known) << c.s;
        EXPECT_EQ(CZoMapProjection::IsGeographical(c.s), c.geographical) << c.s;
    }
    EXPECT_EQ(CZoMapProjection::FromEpsg(32632), "UTM-32");
    EXPECT_EQ(CZoMapProjection::FromEpsg(25832), "EPSG:25832");
    EXPECT_EQ(CZoMapProjection::FromEpsg(999999), "");
}

// Transverse Mercator by Krueger's series to the fourth order in n, as published for UTM
// (accurate to well below a millimetre inside a zone).
void Utm(double lonDeg, double latDeg, int zone, double& e, double& n) {
    const double a = 6378137.0, f = 1 / 298.257223563, k0 = 0.9996;
    const double nn = f / (2 - f), n2 = nn * nn, n3 = n2 * nn, n4 = n3 * nn;
    const double A = a / (1 + nn) * (1 + n2 / 4 + n4 / 64);
    const double alpha[4] = {nn / 2 - 2 * n2 / 3 + 5 * n3 / 16 + 41 * n4 / 180,
                             13 * n2 / 48 - 3 * n3 / 5 + 557 * n4 / 1440,
                             61 * n3 / 240 - 103 * n4 / 140, 49561 * n4 / 161280};
    const double pi = std::acos(-1.0);
    const double phi = latDeg * pi / 180, dl = (lonDeg - (zone * 6 - 183)) * pi / 180;
    const double c = 2 * std::sqrt(nn) / (1 + nn);
    const double t = std::sinh(std::atanh(std::sin(phi)) - c * std::atanh(c * std::sin(phi)));
    const double xi = std::atan(t / std::cos(dl)), eta = std::atanh(std::sin(dl) / std::sqrt(1 + t * t));
    double se = eta, sn = xi;
    for (int j = 1; j <= 4; ++j) {
        se += alpha[j - 1] * std::cos(2 * j * xi) * std::sinh(2 * j * eta);
        sn += alpha[j - 1] * std::sin(2 * j * xi) * std::cosh(2 * j * eta);
    }
    e = 500000 + k0 * A * se;
    n = k0 * A * sn;
}

TEST(MapProjection, KnownPointsInUtm32) {
    const CZoMapProjection toUtm("LONG/LAT", "UTM-32");
    ASSERT_TRUE(toUtm.IsValid()) << toUtm.Error();
    // On the central meridian at the equator by the zone's definition.
    double x = 9.0, y = 0.0;
    ASSERT_TRUE(toUtm.Transform(x, y));
    EXPECT_NEAR(x, 500000.0, 1e-6);
    EXPECT_NEAR(y, 0.0, 1e-6);
    // Points of the Elbe estuary against the published series.
    const double points[][2] = {{8.7, 53.87}, {9.15, 53.89}, {9.96, 53.54}, {6.5, 50.0}};
    for (const auto& p : points) {
        double ex, ey;
        Utm(p[0], p[1], 32, ex, ey);
        x = p[0], y = p[1];
        ASSERT_TRUE(toUtm.Transform(x, y));
        EXPECT_NEAR(x, ex, 0.001) << p[0] << " " << p[1];
        EXPECT_NEAR(y, ey, 0.001) << p[0] << " " << p[1];
    }
}

TEST(MapProjection, RoundTripsWithinAMillimetre) {
    const CZoMapProjection toGeo("UTM-32", "LONG/LAT"), back("LONG/LAT", "UTM-32");
    const CZoMapProjection toUtm31("UTM-32", "UTM-31"), from31("UTM-31", "UTM-32");
    for (double x0 = 300000; x0 <= 700000; x0 += 100000)
        for (double y0 = 5000000; y0 <= 6500000; y0 += 500000) {
            double x = x0, y = y0;
            ASSERT_TRUE(toGeo.Transform(x, y));
            EXPECT_GT(x, 3.0);
            EXPECT_LT(x, 15.0);
            ASSERT_TRUE(back.Transform(x, y));
            EXPECT_NEAR(x, x0, 0.001);
            EXPECT_NEAR(y, y0, 0.001);
            ASSERT_TRUE(toUtm31.Transform(x, y));
            ASSERT_TRUE(from31.Transform(x, y));
            EXPECT_NEAR(x, x0, 0.001);
            EXPECT_NEAR(y, y0, 0.001);
        }
}

TEST(MapProjection, UnknownProjectionsAndPointsThatCannotBeTransformed) {
    const CZoMapProjection bad("UTM-32", "MERCATOR");
    EXPECT_FALSE(bad.IsValid());
    EXPECT_NE(bad.Error().find("MERCATOR"), std::string::npos);
    double x = 1, y = 2;
    EXPECT_FALSE(bad.Transform(x, y));
    EXPECT_EQ(x, 1);
    const CZoMapProjection same("UTM-32", "UTM-32");
    EXPECT_TRUE(same.Transform(x, y));
    EXPECT_EQ(x, 1);
    const CZoMapProjection toUtm("LONG/LAT", "UTM-32");
    x = NAN;
    EXPECT_FALSE(toUtm.Transform(x, y));
    std::vector<double> xs{9.0, 9.0}, ys{0.0, 1e9};
    EXPECT_FALSE(toUtm.Transform(xs, ys));
    EXPECT_NEAR(xs[0], 500000.0, 1e-6);
}

}  // namespace
