// Angles and arcs beside exact numbers. Angles wrap by constants that are cut short (see the
// header): 2*pi by 6.5e-15, which is most of their error.
#include <cmath>
#include <numbers>

#include "gtest/gtest.h"
#include "oracle/Worst.h"
#include "vorn/GeometryUtils.h"

namespace Vorn::Oracle {
namespace {

/// What documentation states for angles that were wrapped, as multiples of eps.
constexpr double kWrapped = 1e-14 / kEps;

double PolarAngle(Inputs* in) {
  return in->Random().Integer(0, 7) == 0
             ? 0.0
             : in->Random().Uniform(-std::numbers::pi, std::numbers::pi);
}

GeometryUtils::Arc ArcOf(Inputs* in) {
  GeometryUtils::Arc arc;
  arc.radius = in->Positive();
  arc.direction = in->Random().Flip() ? 1.0 : -1.0;
  arc.startAngle = PolarAngle(in);
  arc.endAngle = PolarAngle(in);
  return arc;
}

bool PassesSeam(GeometryUtils::Arc const& arc) {
  return arc.direction > 0.0 ? arc.startAngle > arc.endAngle : arc.endAngle > arc.startAngle;
}

Real SweepOf(GeometryUtils::Arc const& arc) {
  Real const turned = arc.direction > 0.0 ? Real(arc.endAngle) - arc.startAngle
                                          : Real(arc.startAngle) - arc.endAngle;
  return PassesSeam(arc) ? turned + Real(2.0) * Real::Pi() : turned;
}

/// The difference and the product, 1u each.
TEST(ErrorOfGetArcLength, IsOneEpsOfItAwayFromTheSeam) {
  ForEachCase(1, Worst("GetArcLength, away from the seam", 1.001), [](Inputs& in, Worst* worst) {
    GeometryUtils::Arc const arc = ArcOf(&in);
    if (PassesSeam(arc)) return;
    Real const exact = SweepOf(arc) * arc.radius;
    worst->Note(Real(GeometryUtils::GetArcLength(arc)) - exact, exact);
  });
}

/// 6.5e-15 of the constant and three roundings of values below 10, 8.9e-16 each at most.
TEST(ErrorOfGetArcLength, IsTenOverAQuadrillionOfTheRadiusAcrossTheSeam) {
  ForEachCase(2, Worst("GetArcLength, of the radius", kWrapped), [](Inputs& in, Worst* worst) {
    GeometryUtils::Arc const arc = ArcOf(&in);
    worst->Note(Real(GeometryUtils::GetArcLength(arc)) - SweepOf(arc) * arc.radius, arc.radius);
  });
}

/// The length, and one more rounding.
TEST(ErrorOfGetArcAngleRad, IsOneAndAHalfEpsOfItAwayFromTheSeam) {
  Worst wrapped("GetArcAngleRad, absolute", kWrapped);
  ForEachCase(3, Worst("GetArcAngleRad, away from the seam", 1.501), [&](Inputs& in, Worst* worst) {
    GeometryUtils::Arc const arc = ArcOf(&in);
    Real const error = Real(GeometryUtils::GetArcAngleRad(arc)) - SweepOf(arc);
    wrapped.Note(error, Real(1.0));
    if (!PassesSeam(arc)) worst->Note(error, SweepOf(arc));
  });
  wrapped.Check(CaseCount());
}

/// Measured: the arc tangent is the platform's, that of Debian 12 here.
TEST(ErrorOfGetNaturalAngle, IsOneEpsOfIt) {
  ForEachCase(4, Worst("GetNaturalAngle", 1.0), [](Inputs& in, Worst* worst) {
    double const dy = in.Coordinate();
    double const dx = in.Coordinate();
    if (dy == 0.0) return;
    Real const exact = Atan2(-Real(dy), dx);
    worst->Note(Real(GeometryUtils::GetNaturalAngle(dy, dx)) - exact, exact);
  });
}

TEST(ErrorOfAzimuths, IsTenOverAQuadrillion) {
  Worst tangential("NaturalAngleToTangentialAzimuthRad, absolute", kWrapped);
  ForEachCase(
      5, Worst("NaturalAngleToAzimuthRad, absolute", kWrapped), [&](Inputs& in, Worst* worst) {
        double const angle = PolarAngle(&in);
        Real const azimuth = Real::Pi() / Real(2.0) - angle;
        bool const isBelow = std::numbers::pi / 2.0 < angle;
        worst->Note(Real(GeometryUtils::NaturalAngleToAzimuthRad(angle)) -
                        (isBelow ? azimuth + Real(2.0) * Real::Pi() : azimuth),
                    Real(1.0));
        tangential.Note(Real(GeometryUtils::NaturalAngleToTangentialAzimuthRad(angle, true)) -
                            (Real::Pi() - angle),
                        Real(1.0));
        Real const turned = angle > 0.0 ? Real(2.0) * Real::Pi() - angle : -Real(angle);
        tangential.Note(
            Real(GeometryUtils::NaturalAngleToTangentialAzimuthRad(angle, false)) - turned,
            Real(1.0));
      });
  tangential.Check(CaseCount());
}

TEST(ErrorOfSubtrAng, IsTenOverAQuadrillion) {
  ForEachCase(6, Worst("SubtrAng, absolute", kWrapped), [](Inputs& in, Worst* worst) {
    double const a = PolarAngle(&in);
    double const b = PolarAngle(&in);
    Real exact = Real(a) - b;
    if (a - b >= std::numbers::pi) exact = exact - Real(2.0) * Real::Pi();
    if (a - b <= -std::numbers::pi) exact = exact + Real(2.0) * Real::Pi();
    // Within the last places of half a turn, either end is meant.
    if (std::fabs(std::fabs(a - b) - std::numbers::pi) < 1e-14) return;
    worst->Note(Real(GeometryUtils::SubtrAng(a, b)) - exact, Real(1.0));
  });
}

}  // namespace
}  // namespace Vorn::Oracle
