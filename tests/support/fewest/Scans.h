#pragma once

#include <cmath>
#include <cstddef>
#include <cstdint>
#include <numbers>
#include <utility>
#include <vector>

#include "support/RandomGeometry.h"
#include "vorn/GeometryUtils.h"

/// Seeded scans whose least number of pieces is known by construction, and scans made to be hard.
namespace Vorn::Testing {

using Scan = std::vector<WPoint>;

/// One line or arc of a nominal shape.
struct NominalPiece {
  double length = 0.0;
  double curvature = 0.0;     ///< positive: turns to the left
  double cornerBefore = 0.0;  ///< the change of direction at its start
};

/// Walks along a nominal shape.
class Walk {
 public:
  explicit Walk(std::vector<NominalPiece> pieces) : pieces_(std::move(pieces)) {
    for (NominalPiece const& piece : pieces_) length_ += piece.length;
    Enter();
  }

  double Length() const { return length_; }

  struct Place {
    GeometryUtils::Point at;
    double heading;
  };

  /// The place at a length from the start; lengths must not fall from call to call.
  Place At(double along) {
    while (current_ + 1 < pieces_.size() && along > start_ + pieces_[current_].length) Leave();
    return Within(along - start_);
  }

 private:
  Place Within(double along) const {
    double const turn = pieces_[current_].curvature * along;
    double const middle = heading_ + 0.5 * turn;
    double const half = 0.5 * turn;
    double const chord = half == 0.0 ? along : along * std::sin(half) / half;
    return {{origin_.x + chord * std::cos(middle), origin_.y + chord * std::sin(middle)},
            heading_ + turn};
  }

  void Leave() {
    Place const end = Within(pieces_[current_].length);
    start_ += pieces_[current_].length;
    origin_ = end.at;
    heading_ = end.heading;
    ++current_;
    Enter();
  }

  void Enter() { heading_ += pieces_[current_].cornerBefore; }

  std::vector<NominalPiece> pieces_;
  double length_ = 0.0;
  std::size_t current_ = 0;
  double start_ = 0.0;
  GeometryUtils::Point origin_;
  double heading_ = 0.0;
};

/// How the pieces of a profile meet.
enum class ProfileStyle { Smooth, Corners, Mixed };

/// Eight lines and eight arcs of 60 to 120 degrees in turn, about 200 long, as often as asked. The
/// arcs turn back towards the first direction, so the profile runs on from left to right.
inline std::vector<NominalPiece> MakeProfilePieces(RandomGeometry* random, ProfileStyle style,
                                                   std::int32_t repeats) {
  constexpr double kDegree = std::numbers::pi / 180.0;
  std::vector<NominalPiece> pieces;
  double heading = 0.0;
  for (std::int32_t i = 0; i < 16 * repeats; ++i) {
    NominalPiece piece;
    bool const isCorner = i > 0 && (style == ProfileStyle::Corners ||
                                    (style == ProfileStyle::Mixed && random->Flip()));
    double const back = heading > 0.0 ? -1.0 : 1.0;
    if (isCorner) piece.cornerBefore = back * random->Uniform(25.0, 60.0) * kDegree;
    if (i % 2 == 0) {
      piece.length = random->Uniform(6.0, 14.0);
    } else {
      double const radius = random->Uniform(6.0, 14.0);
      double const turn = random->Uniform(60.0, 120.0) * kDegree;
      piece.length = radius * turn;
      bool const isLeft = heading + piece.cornerBefore <= 0.0;
      piece.curvature = (isLeft ? 1.0 : -1.0) / radius;
      heading += (isLeft ? turn : -turn);
    }
    heading += piece.cornerBefore;
    pieces.push_back(piece);
  }
  return pieces;
}

/// Points at equal lengths along a shape, moved along its normal by uniform noise of up to
/// noise * w.
inline Scan SampleWithNormalNoise(RandomGeometry* random, std::vector<NominalPiece> pieces,
                                  std::int32_t count, double w, double noise) {
  Walk walk(std::move(pieces));
  Scan scan;
  scan.reserve(static_cast<std::size_t>(count));
  for (std::int32_t i = 0; i < count; ++i) {
    auto const [at, heading] = walk.At(walk.Length() * i / (count - 1));
    double const off = noise * w * random->Uniform(-1.0, 1.0);
    scan.push_back({at.x - off * std::sin(heading), at.y + off * std::cos(heading), w});
  }
  return scan;
}

/// The noisy profile of 16 pieces (times repeats), tolerance 0.02.
inline Scan MakeNoisyProfile(std::uint64_t seed, ProfileStyle style, std::int32_t repeats,
                             std::int32_t count, double noise) {
  RandomGeometry random(seed);
  auto const pieces = MakeProfilePieces(&random, style, repeats);
  return SampleWithNormalNoise(&random, pieces, count, 0.02, noise);
}

/// The same with its first line lengthened backwards: points far apart up to `length` before it.
inline Scan MakeProfileBehindALongLine(std::uint64_t seed, ProfileStyle style, double length) {
  constexpr std::int32_t kPointsOnLine = 40;
  Scan scan;
  for (std::int32_t i = 0; i < kPointsOnLine; ++i) {
    scan.push_back({-length * (kPointsOnLine - i) / kPointsOnLine, 0.0, 0.02});
  }
  Scan const profile = MakeNoisyProfile(seed, style, 1, 1000, 0.45);
  scan.insert(scan.end(), profile.begin(), profile.end());
  return scan;
}

/// One arc of 270 degrees, radius 50, tolerance 0.02.
inline Scan MakeNoisyArc(std::uint64_t seed, std::int32_t count, double noise) {
  RandomGeometry random(seed);
  return SampleWithNormalNoise(&random, {{75.0 * std::numbers::pi, 0.02}}, count, 0.02, noise);
}

/// Points at equal spacing, moved by uniform noise of up to `noise` in x and in y.
inline Scan SampleDense(std::uint64_t seed, std::vector<NominalPiece> pieces, double spacing,
                        double w, double noise) {
  RandomGeometry random(seed);
  Walk walk(std::move(pieces));
  Scan scan;
  auto const count = static_cast<std::int64_t>(walk.Length() / spacing);
  scan.reserve(static_cast<std::size_t>(count) + 1);
  for (std::int64_t i = 0; i <= count; ++i) {
    auto const [at, heading] = walk.At(static_cast<double>(i) * spacing);
    double const x = at.x + noise * random.Uniform(-1.0, 1.0);
    double const y = at.y + noise * random.Uniform(-1.0, 1.0);
    scan.push_back({x, y, w});
  }
  return scan;
}

/// Line, tangential arc, line, corner, line: four pieces, 100 times `scale` long, tolerance 0.01
/// and noise of half of it in x and in y.
inline Scan MakeDenseBracket(std::uint64_t seed, double spacing, double scale) {
  constexpr double kQuarter = 0.5 * std::numbers::pi;
  return SampleDense(seed,
                     {{30.0 * scale, 0.0},
                      {10.0 * kQuarter * scale, 0.1 / scale},
                      {30.0 * scale, 0.0},
                      {(40.0 - 10.0 * kQuarter) * scale, 0.0, -1.0}},
                     spacing, 0.01, 0.005);
}

/// A profile of 16 pieces, `length` long in all, tolerance 0.02, noise 0.009 in x and in y.
inline Scan MakeDenseProfile(std::uint64_t seed, ProfileStyle style, double length,
                             double spacing) {
  RandomGeometry random(seed);
  std::vector<NominalPiece> pieces = MakeProfilePieces(&random, style, 1);
  double const factor = length / Walk(pieces).Length();
  for (NominalPiece& piece : pieces) {
    piece.length *= factor;
    piece.curvature /= factor;
  }
  return SampleDense(seed + 1, std::move(pieces), spacing, 0.02, 0.009);
}

/// A circle scanned `turns` times around; odd numbers of turns and a half are allowed.
inline Scan MakeRepeatedCircle(std::uint64_t seed, double turns, double radius, std::int32_t count,
                               double w, double noise) {
  RandomGeometry random(seed);
  double const length = 2.0 * std::numbers::pi * radius * turns;
  return SampleWithNormalNoise(&random, {{length, 1.0 / radius}}, count, w, noise);
}

/// Curvature grows steadily from 0 to `endCurvature`. Positions by Simpson's rule on the heading.
inline Scan MakeClothoid(double length, double endCurvature, std::int32_t count, double w) {
  Scan scan;
  GeometryUtils::Point at;
  double const step = length / (count - 1);
  auto const heading = [&](double s) { return 0.5 * endCurvature * s * s / length; };
  for (std::int32_t i = 0; i < count; ++i) {
    scan.push_back({at.x, at.y, w});
    double const h0 = heading(i * step);
    double const h1 = heading((i + 0.5) * step);
    double const h2 = heading((i + 1.0) * step);
    at.x += step / 6.0 * (std::cos(h0) + 4.0 * std::cos(h1) + std::cos(h2));
    at.y += step / 6.0 * (std::sin(h0) + 4.0 * std::sin(h1) + std::sin(h2));
  }
  return scan;
}

/// An Archimedean spiral whose laps are `pitch` apart.
inline Scan MakeSpiral(double turns, double pitch, std::int32_t count, double w) {
  Scan scan;
  for (std::int32_t i = 0; i < count; ++i) {
    double const angle = 2.0 * std::numbers::pi * turns * i / (count - 1);
    double const radius = pitch * (1.0 + angle / (2.0 * std::numbers::pi));
    scan.push_back({radius * std::cos(angle), radius * std::sin(angle), w});
  }
  return scan;
}

/// Points in turn above and below the x axis by `share` times their tolerance.
inline Scan MakeZigzag(std::int32_t count, double spacing, double w, double share) {
  Scan scan;
  for (std::int32_t i = 0; i < count; ++i) {
    scan.push_back({spacing * i, (i % 2 == 0 ? share : -share) * w, w});
  }
  return scan;
}

/// The same point again and again.
inline Scan MakeOnePoint(std::int32_t count, GeometryUtils::Point const& p, double w) {
  return Scan(static_cast<std::size_t>(count), WPoint{p.x, p.y, w});
}

/// A straight run with one point far off it.
inline Scan MakeOutlier(std::int32_t count, double w, double distance) {
  Scan scan = MakeZigzag(count, 1.0, w, 0.5);
  scan[static_cast<std::size_t>(count / 2)].y += distance;
  return scan;
}

/// A profile whose tolerances differ by six orders of magnitude from point to point; the noise
/// follows them.
inline Scan MakeManyTolerances(std::uint64_t seed, ProfileStyle style, std::int32_t count) {
  RandomGeometry random(seed);
  Walk walk(MakeProfilePieces(&random, style, 1));
  Scan scan;
  for (std::int32_t i = 0; i < count; ++i) {
    auto const [at, heading] = walk.At(walk.Length() * i / (count - 1));
    double const w = 0.02 * std::pow(10.0, random.Uniform(-5.0, 1.0));
    double const off = 0.5 * w * random.Uniform(-1.0, 1.0);
    scan.push_back({at.x - off * std::sin(heading), at.y + off * std::cos(heading), w});
  }
  return scan;
}

}  // namespace Vorn::Testing
