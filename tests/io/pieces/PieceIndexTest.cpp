#include <gtest/gtest.h>

#include <cmath>
#include <limits>
#include <numbers>
#include <random>

#include "io/pieces/PieceIndex.h"
#include "io/pieces/Shapes.h"
#include "vorn/io/Deviations.h"

namespace Vorn::IO {
namespace {

using std::numbers::pi;

double Uniform(std::mt19937_64* engine, double low, double high) {
  return low + (high - low) * static_cast<double>((*engine)() >> 11) * 0x1p-53;
}

/// Against every piece, the first of several.
PieceIndex::Nearest NearestOfAll(std::vector<Piece> const& pieces, double x, double y) {
  PieceIndex::Nearest nearest{0, std::numeric_limits<double>::infinity()};
  for (std::size_t i = 0; i < pieces.size(); ++i) {
    double const distance = DistanceTo(pieces[i], x, y);
    if (distance < nearest.distance) nearest = {i, distance};
  }
  return nearest;
}

void ExpectTheSame(std::vector<Piece> const& pieces, PieceIndex const& index, double x, double y,
                   std::size_t hint) {
  PieceIndex::Nearest const expected = NearestOfAll(pieces, x, y);
  PieceIndex::Nearest const found = index.Find(x, y, hint);
  EXPECT_EQ(found.piece, expected.piece) << x << ", " << y;
  EXPECT_EQ(found.distance, expected.distance) << x << ", " << y;
}

/// A connected walk of lines and arcs of any sweep; some have no length, some are nearly flat.
std::vector<Piece> RandomContour(std::mt19937_64* engine, std::size_t count) {
  std::vector<Piece> pieces;
  XY place{Uniform(engine, -5, 5), Uniform(engine, -5, 5)};
  for (std::size_t i = 0; i < count; ++i) {
    XY const next{place.x + Uniform(engine, -2, 2), place.y + Uniform(engine, -2, 2)};
    bool const isLine = (*engine)() % 3 == 0;
    if (isLine) {
      pieces.push_back(MakeLine(place, (*engine)() % 8 == 0 ? place : next));
    } else {
      double const radius = std::pow(10.0, Uniform(engine, -1, (*engine)() % 8 == 0 ? 7 : 1));
      double const polar = Uniform(engine, -pi, pi);
      XY const center{place.x - radius * std::cos(polar), place.y - radius * std::sin(polar)};
      double const turn = Uniform(engine, 0.0, radius > 10.0 ? 2.0 / radius : 2.0 * pi);
      bool const isCcw = (*engine)() % 2 == 0;
      double const end = polar + (isCcw ? turn : -turn);
      XY const to{center.x + radius * std::cos(end), center.y + radius * std::sin(end)};
      pieces.push_back(MakeArc(place, to, center, radius, isCcw));
    }
    place = pieces.back().end;
  }
  return pieces;
}

TEST(PieceIndex, AgreesWithEveryPieceMeasured) {
  for (std::uint64_t seed = 1; seed <= 150; ++seed) {
    SCOPED_TRACE(seed);
    std::mt19937_64 engine(seed);
    std::vector<Piece> const pieces = RandomContour(&engine, 1 + engine() % 70);
    PieceIndex const index(pieces);
    for (int i = 0; i < 60; ++i) {
      double const reach = std::pow(10.0, Uniform(&engine, -1, 3));
      ExpectTheSame(pieces, index, Uniform(&engine, -reach, reach), Uniform(&engine, -reach, reach),
                    engine() % pieces.size());
    }
    // On the pieces themselves and at their joints, where two are equally near.
    for (Piece const& piece : pieces) {
      ExpectTheSame(pieces, index, piece.end.x, piece.end.y, engine() % pieces.size());
      XY const middle = piece.IsArc() ? PointOnArc(piece, piece.sweep / 2.0)
                                      : XY{(piece.start.x + piece.end.x) / 2.0,
                                           (piece.start.y + piece.end.y) / 2.0};
      ExpectTheSame(pieces, index, middle.x, middle.y, engine() % pieces.size());
    }
  }
}

TEST(PieceIndex, NamesTheFirstOfPiecesEquallyNear) {
  // A square around the origin, each side twice.
  std::vector<Piece> pieces;
  for (int round = 0; round < 2; ++round) {
    pieces.push_back(MakeLine({-1, -1}, {1, -1}));
    pieces.push_back(MakeLine({1, -1}, {1, 1}));
    pieces.push_back(MakeLine({1, 1}, {-1, 1}));
    pieces.push_back(MakeLine({-1, 1}, {-1, -1}));
  }
  PieceIndex const index(pieces);
  for (std::size_t hint = 0; hint < pieces.size(); ++hint) {
    PieceIndex::Nearest const nearest = index.Find(0.0, 0.0, hint);
    EXPECT_EQ(nearest.piece, 0u);
    EXPECT_EQ(nearest.distance, 1.0);
  }
}

TEST(PieceIndex, TakesOnePiece) {
  std::vector<Piece> const pieces = {MakeLine({0, 0}, {1, 0})};
  EXPECT_EQ(PieceIndex(pieces).Find(0.5, 2.0, 0).distance, 2.0);
}

TEST(PieceIndex, AnswersForPointsThatAreNoNumbers) {
  std::vector<Piece> const pieces = {MakeLine({0, 0}, {1, 0}), MakeLine({1, 0}, {1, 1})};
  double const nan = std::numeric_limits<double>::quiet_NaN();
  EXPECT_EQ(PieceIndex(pieces).Find(nan, 0.0, 1).piece, 0u);
}

TEST(Remeasure, OfManyPointsAndPiecesFindsTheNearestOfAll) {
  std::vector<Piece> pieces;
  for (int i = 0; i < 1000; ++i) {
    double const from = i * 2.0 * pi / 1000.0;
    double const to = (i + 1) * 2.0 * pi / 1000.0;
    pieces.push_back(MakeLine({std::cos(from), std::sin(from)}, {std::cos(to), std::sin(to)}));
  }
  std::vector<WPoint> points;
  constexpr int kPoints = 100'000;
  for (int i = 0; i < kPoints; ++i) {
    double const angle = i * 2.0 * pi / kPoints;
    points.push_back({1.001 * std::cos(angle), 1.001 * std::sin(angle), 0.01});
  }
  Remeasured const result = Remeasure(points, pieces);
  for (std::size_t i = 0; i < points.size(); i += 997) {
    PieceIndex::Nearest const expected = NearestOfAll(pieces, points[i].x, points[i].y);
    EXPECT_EQ(result.points[i].distance, expected.distance) << i;
    EXPECT_EQ(result.points[i].piece, expected.piece) << i;
  }
}

}  // namespace
}  // namespace Vorn::IO
