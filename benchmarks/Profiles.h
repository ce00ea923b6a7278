#pragma once

#include <cmath>
#include <cstddef>
#include <cstdint>
#include <initializer_list>
#include <random>
#include <vector>

#include "vorn/GeometryUtils.h"

/// Measured profiles of any size whose true pieces are known.
namespace Vorn::Benchmarks {

constexpr double kTolerance = 0.05;

/// Neighbours must be more than 0.15 mm apart for the tolerance above.
constexpr double kSpacing = 0.2;

/// Every point lies within this share of its tolerance of the true shape.
constexpr double kNoiseShare = 0.6;

struct Profile {
  std::vector<WPoint> points;
  int truePieces = 0;  ///< 0 when not known
};

/// Displaces points across the profile, or leaves them where they are.
class Noise {
 public:
  explicit Noise(bool isOn) : amplitude_(isOn ? kNoiseShare * kTolerance : 0.0) {}

  WPoint Measure(double x, double y, double heading) {
    double const across = amplitude_ * unit_(random_);
    return {x - across * std::sin(heading), y + across * std::cos(heading), kTolerance};
  }

 private:
  static constexpr std::uint64_t kSeed = 20240517;

  double amplitude_;
  std::mt19937_64 random_{kSeed};
  std::uniform_real_distribution<double> unit_{-1.0, 1.0};
};

/// A straight line that grows with the number of points.
inline Profile MakeLine(std::int64_t count, bool isNoisy) {
  constexpr double kHeading = 0.6;
  Noise noise(isNoisy);
  Profile profile;
  profile.truePieces = 1;
  for (std::int64_t i = 0; i < count; ++i) {
    double const s = kSpacing * static_cast<double>(i);
    profile.points.push_back(
        noise.Measure(s * std::cos(kHeading), s * std::sin(kHeading), kHeading));
  }
  return profile;
}

/// An arc of a third of a turn, whose radius grows with the number of points.
inline Profile MakeArc(std::int64_t count, bool isNoisy) {
  double const halfPi = std::acos(0.0);
  double const sweep = 4.0 / 3.0 * halfPi;
  double const length = kSpacing * static_cast<double>(count - 1);
  double const radius = length / sweep;
  Noise noise(isNoisy);
  Profile profile;
  profile.truePieces = 1;
  for (std::int64_t i = 0; i < count; ++i) {
    double const angle = 0.3 + kSpacing * static_cast<double>(i) / radius;
    profile.points.push_back(
        noise.Measure(radius * std::cos(angle), radius * std::sin(angle), angle + halfPi));
  }
  return profile;
}

/// A piece of a machined part: straight where the radius is 0, otherwise a fillet.
struct ProfilePiece {
  double length;
  double radius;
  double turn;  ///< radians, counter-clockwise positive
};

/// 8 lines and 8 fillets that meet smoothly, 200 mm in all. The turns add up to zero, so the
/// profile can be put end to end.
inline std::vector<ProfilePiece> MakeMixedPieces() {
  struct LineAndFillet {
    double length;
    double radius;
    double degrees;
  };
  double const radian = std::acos(-1.0) / 180.0;
  std::vector<ProfilePiece> pieces;
  for (LineAndFillet const& p : std::initializer_list<LineAndFillet>{{14.0, 10.0, 60.0},
                                                                     {9.0, 24.0, -35.0},
                                                                     {12.0, 16.0, -40.0},
                                                                     {15.0, 30.0, 30.0},
                                                                     {8.0, 12.0, 50.0},
                                                                     {11.0, 20.0, -45.0},
                                                                     {13.0, 28.0, -45.0},
                                                                     {12.0, 14.0, 25.0}}) {
    pieces.push_back({p.length, 0.0, 0.0});
    pieces.push_back({p.radius * std::fabs(p.degrees) * radian, p.radius, p.degrees * radian});
  }
  return pieces;
}

/// A place on a profile and the direction in which it goes on.
struct Pose {
  double x;
  double y;
  double heading;
};

/// Where a piece that begins at start has come to after the given length.
inline Pose Follow(Pose const& start, ProfilePiece const& piece, double along) {
  double const angle = piece.turn * along / piece.length;
  // The chord of an arc points half its turn away from the heading at its start.
  double const chord =
      piece.radius > 0.0 ? 2.0 * piece.radius * std::sin(0.5 * std::fabs(angle)) : along;
  return {start.x + chord * std::cos(start.heading + 0.5 * angle),
          start.y + chord * std::sin(start.heading + 0.5 * angle), start.heading + angle};
}

/// The part of 8 lines and 8 fillets, repeated so that the spacing stays what it is for 1,000
/// points. With fewer points it is one part with a wider spacing.
inline Profile MakeMixed(std::int64_t count, bool isNoisy) {
  constexpr std::int64_t kPointsPerPart = 1000;
  std::int64_t const parts = count > kPointsPerPart ? count / kPointsPerPart : 1;
  auto const pieces = MakeMixedPieces();
  double partLength = 0.0;
  for (ProfilePiece const& piece : pieces) partLength += piece.length;
  double const spacing = partLength * static_cast<double>(parts) / static_cast<double>(count - 1);

  Noise noise(isNoisy);
  Profile profile;
  profile.truePieces = static_cast<int>(parts) * static_cast<int>(pieces.size());
  Pose pieceStart{0.0, 0.0, -0.3};
  double lengthBefore = 0.0;
  std::size_t at = 0;
  for (std::int64_t i = 0; i < count; ++i) {
    double const s = spacing * static_cast<double>(i);
    // The last point may lie beyond the end by a rounding error; it stays on the last piece.
    while (s > lengthBefore + pieces[at].length && i + 1 < count) {
      pieceStart = Follow(pieceStart, pieces[at], pieces[at].length);
      lengthBefore += pieces[at].length;
      at = (at + 1) % pieces.size();
    }
    Pose const pose = Follow(pieceStart, pieces[at], s - lengthBefore);
    profile.points.push_back(noise.Measure(pose.x, pose.y, pose.heading));
  }
  return profile;
}

}  // namespace Vorn::Benchmarks
