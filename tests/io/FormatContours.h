#pragma once

#include <algorithm>
#include <bit>
#include <cmath>
#include <cstdint>
#include <functional>
#include <limits>
#include <string>
#include <vector>

#include "io/formats/GCode.h"
#include "io/pieces/Shapes.h"
#include "support/RandomGeometry.h"
#include "vorn/io/ContourFile.h"
#include "vorn/io/Deviations.h"
#include "vorn/io/Failure.h"

/// Contours and measurements for the tests of the file formats.
namespace Vorn::IO::FormatContours {

/// From (0, 0) straight to (4, 0), a clockwise quarter about (4, -1) to (5, -1), and straight back.
inline ContourFile Wedge() {
  ContourFile contour;
  contour.path = "part.json";
  contour.units = "mm";
  contour.isClosed = true;
  contour.pieces = {MakeLine({0, 0}, {4, 0}), MakeArc({4, 0}, {5, -1}, {4, -1}, 1, false),
                    MakeLine({5, -1}, {0, 0})};
  return contour;
}

/// Two lines in a row with a gap of 0.5 between them.
inline ContourFile WithGap() {
  ContourFile contour;
  contour.path = "gap.json";
  contour.pieces = {MakeLine({0, 0}, {1, 0}), MakeLine({1.5, 0}, {2, 3})};
  return contour;
}

/// An arc from `start` with the radius and sweep, in a random direction.
inline Piece RandomArc(XY const& start, double radius, double sweep,
                       Testing::RandomGeometry* random) {
  double const towards = random->Uniform(-3.1, 3.1);
  XY const center = {start.x + radius * std::cos(towards), start.y + radius * std::sin(towards)};
  bool const isCounterClockwise = random->Flip();
  double const from = std::atan2(start.y - center.y, start.x - center.x);
  double const to = isCounterClockwise ? from + sweep : from - sweep;
  XY const end = {center.x + radius * std::cos(to), center.y + radius * std::sin(to)};
  return MakeArc(start, end, center, radius, isCounterClockwise);
}

/// Lines from 0.001 to 100 long and arcs with radii from 0.01 to the largest in random order, each
/// from the end of the one before; arcs turn up to 359 degrees and are up to 100 long.
inline ContourFile RandomContour(std::uint64_t seed, double largestRadius = 1e5) {
  constexpr std::size_t kPieces = 20;
  Testing::RandomGeometry random(seed);
  ContourFile contour;
  contour.path = "random.json";
  contour.units = "mm";
  XY at = random.PointIn(-100.0, 100.0);
  while (contour.pieces.size() < kPieces) {
    double const size = std::pow(10.0, random.Uniform(-3.0, 2.0));
    if (random.Flip()) {
      double const angle = random.Uniform(-3.1, 3.1);
      contour.pieces.push_back(
          MakeLine(at, {at.x + size * std::cos(angle), at.y + size * std::sin(angle)}));
    } else {
      double const radius = std::pow(10.0, random.Uniform(-2.0, std::log10(largestRadius)));
      contour.pieces.push_back(RandomArc(at, radius, std::min(6.265, size / radius), &random));
    }
    at = contour.pieces.back().end;
  }
  return contour;
}

/// The largest coordinate or radius.
inline double ScaleOf(std::vector<Piece> const& pieces) {
  double scale = 0.0;
  for (Piece const& piece : pieces) {
    scale = std::max({scale, std::fabs(piece.start.x), std::fabs(piece.start.y),
                      std::fabs(piece.end.x), std::fabs(piece.end.y), piece.radius});
  }
  return scale;
}

inline double DistanceToNearest(std::vector<Piece> const& pieces, XY const& point) {
  double least = std::numeric_limits<double>::infinity();
  for (Piece const& piece : pieces) {
    least = std::min(least, DistanceTo(piece, point.x, point.y));
  }
  return least;
}

inline XY PointAlong(Piece const& piece, double part) {
  if (piece.IsArc()) return PointOnArc(piece, part * piece.sweep);
  return {piece.start.x + part * (piece.end.x - piece.start.x),
          piece.start.y + part * (piece.end.y - piece.start.y)};
}

/// The largest distance of places all along `from` to the nearest place of `to`.
inline double LargestDistance(std::vector<Piece> const& from, std::vector<Piece> const& to) {
  constexpr int kSteps = 8;
  double largest = 0.0;
  for (Piece const& piece : from) {
    largest =
        std::max({largest, DistanceToNearest(to, piece.start), DistanceToNearest(to, piece.end)});
    for (int i = 0; i <= kSteps; ++i) {
      double const part = static_cast<double>(i) / kSteps;
      largest = std::max(largest, DistanceToNearest(to, PointAlong(piece, part)));
    }
  }
  return largest;
}

/// How far two contours are apart, measured both ways.
inline double Apart(std::vector<Piece> const& a, std::vector<Piece> const& b) {
  return std::max(LargestDistance(a, b), LargestDistance(b, a));
}

inline bool SameBits(double a, double b) {
  return std::bit_cast<std::uint64_t>(a) == std::bit_cast<std::uint64_t>(b);
}

inline bool SameBits(XY const& a, XY const& b) { return SameBits(a.x, b.x) && SameBits(a.y, b.y); }

inline bool SameBits(Piece const& a, Piece const& b) {
  return a.kind == b.kind && SameBits(a.start, b.start) && SameBits(a.end, b.end) &&
         SameBits(a.length, b.length) && SameBits(a.center, b.center) &&
         SameBits(a.radius, b.radius) && a.counterClockwise == b.counterClockwise &&
         SameBits(a.startAngle, b.startAngle) && SameBits(a.endAngle, b.endAngle) &&
         SameBits(a.sweep, b.sweep);
}

inline bool SameBits(ContourFile const& a, ContourFile const& b) {
  return a.isClosed == b.isClosed && a.units == b.units &&
         std::equal(a.pieces.begin(), a.pieces.end(), b.pieces.begin(), b.pieces.end(),
                    [](Piece const& p, Piece const& q) { return SameBits(p, q); });
}

/// The message of the failure with which reading ends; empty when it succeeds.
inline std::string Refusal(std::function<void()> const& read,
                           FailureKind code = FailureKind::File) {
  try {
    read();
  } catch (Failure const& failure) {
    return failure.Kind() == code ? failure.what()
                                  : std::string("other exit code: ") + failure.what();
  }
  return "";
}

inline GCodeOptions WithDecimals(int decimals) {
  GCodeOptions options;
  options.decimals = decimals;
  return options;
}

/// Texts that no reader may take, whatever its format.
inline std::vector<std::string> BrokenTexts() {
  return {"",
          " \n\n",
          std::string("\0\1\2\3", 4),
          "\x7f"
          "ELF\2\1\1",
          "nonsense",
          "\xff\xfe{\0",
          std::string(1000000, ','),
          std::string(1000000, '('),
          std::string(1000000, '['),
          std::string(1000000, '1')};
}

}  // namespace Vorn::IO::FormatContours
