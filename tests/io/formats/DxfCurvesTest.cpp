#include <gtest/gtest.h>

#include <cmath>
#include <numbers>

#include "io/FormatContours.h"
#include "io/formats/Dxf.h"

namespace Vorn::IO {
namespace {

using FormatContours::Refusal;
using std::numbers::pi;

constexpr double kTolerance = 1e-4;

std::string Drawing(std::string text) {
  text = "0 SECTION 2 ENTITIES " + text + " 0 ENDSEC 0 EOF";
  for (char& c : text) {
    if (c == ' ') c = '\n';
  }
  return text + "\n";
}

std::vector<Piece> Read(std::string const& entities, std::optional<double> flattening) {
  return ParseDxf(Drawing(entities), "p.dxf", ReadOptions{{}, flattening}).pieces;
}

std::string Complaint(std::string const& entities) {
  return Refusal([&] { Read(entities, kTolerance); });
}

double FromChords(XY const& at, std::vector<Piece> const& chords) {
  double nearest = 1e300;
  for (Piece const& chord : chords) nearest = std::min(nearest, DistanceTo(chord, at.x, at.y));
  return nearest;
}

/// The half axes are (3, 0) and (0, 2), the centre is (10, 20).
std::string const kEllipse = "0 ELLIPSE 8 0 10 10 20 20 11 3 21 0 40 0.6666666666666666";

/// A clamped spline of degree 3 over (0,0), (1,2), (3,2), (4,0), (6,-1) with one inner knot.
std::string const kSpline =
    "0 SPLINE 8 0 70 8 71 3 72 9 73 5 40 0 40 0 40 0 40 0 40 1 40 2 40 2 40 2 40 2 "
    "10 0 20 0 10 1 20 2 10 3 20 2 10 4 20 0 10 6 20 -1";

TEST(DxfEllipse, IsChordsWithinTheTolerance) {
  std::vector<Piece> const chords = Read(kEllipse, kTolerance);
  ASSERT_GT(chords.size(), 50u);
  EXPECT_EQ(chords.back().end.x, chords.front().start.x);
  EXPECT_EQ(chords.back().end.y, chords.front().start.y);
  for (int i = 0; i < 1000; ++i) {
    double const t = 2 * pi * i / 1000;
    EXPECT_LE(FromChords({10 + 3 * std::cos(t), 20 + 2 * std::sin(t)}, chords), kTolerance + 1e-12);
  }
}

TEST(DxfEllipse, APartRunsBetweenItsParameters) {
  std::vector<Piece> const chords = Read(kEllipse + " 41 0 42 1.5707963267948966", kTolerance);
  EXPECT_NEAR(chords.front().start.x, 13, 1e-12);
  EXPECT_NEAR(chords.back().end.y, 22, 1e-12);
  // Across the beginning of the turn.
  std::vector<Piece> const across =
      Read(kEllipse + " 41 4.71238898038469 42 7.853981633974483", kTolerance);
  EXPECT_NEAR(across.front().start.y, 18, 1e-12);
  EXPECT_NEAR(across.back().end.y, 22, 1e-12);
  EXPECT_LE(FromChords({13, 20}, across), kTolerance);
}

TEST(DxfEllipse, OnTheBackOfThePlaneItRunsTheOtherWay) {
  std::vector<Piece> const chords =
      Read(kEllipse + " 41 0 42 1.5707963267948966 210 0 220 0 230 -1", kTolerance);
  EXPECT_NEAR(chords.front().start.x, 13, 1e-12);
  EXPECT_NEAR(chords.back().end.y, 18, 1e-12);
}

/// De Boor's recursion for one basis function, written as it is defined.
double Basis(std::vector<double> const& knots, std::size_t i, std::size_t degree, double t) {
  if (degree == 0) return knots[i] <= t && t < knots[i + 1] ? 1.0 : 0.0;
  double sum = 0.0;
  double const left = knots[i + degree] - knots[i];
  double const right = knots[i + degree + 1] - knots[i + 1];
  if (left > 0) sum += (t - knots[i]) / left * Basis(knots, i, degree - 1, t);
  if (right > 0) {
    sum += (knots[i + degree + 1] - t) / right * Basis(knots, i + 1, degree - 1, t);
  }
  return sum;
}

void ExpectFollows(std::vector<Piece> const& chords, std::vector<double> const& weights) {
  std::vector<double> const knots = {0, 0, 0, 0, 1, 2, 2, 2, 2};
  double const xs[] = {0, 1, 3, 4, 6};
  double const ys[] = {0, 2, 2, 0, -1};
  for (int k = 0; k < 200; ++k) {
    double const t = 2.0 * k / 200;
    double x = 0;
    double y = 0;
    double sum = 0;
    for (std::size_t i = 0; i < 5; ++i) {
      double const part = Basis(knots, i, 3, t) * weights[i];
      x += part * xs[i];
      y += part * ys[i];
      sum += part;
    }
    EXPECT_LE(FromChords({x / sum, y / sum}, chords), kTolerance + 1e-12) << t;
  }
}

TEST(DxfSpline, IsChordsWithinTheTolerance) {
  std::vector<Piece> const chords = Read(kSpline, kTolerance);
  ExpectFollows(chords, {1, 1, 1, 1, 1});
  EXPECT_EQ(chords.front().start.x, 0.0);
  EXPECT_EQ(chords.back().end.x, 6.0);
  EXPECT_EQ(chords.back().end.y, -1.0);
}

TEST(DxfSpline, FollowsItsWeights) {
  ExpectFollows(Read(kSpline + " 41 1 41 2 41 0.5 41 3 41 1", kTolerance), {1, 2, 0.5, 3, 1});
}

TEST(DxfSpline, IsRefusedUnlessFlattened) {
  EXPECT_EQ(Refusal([] { Read(kSpline, {}); }),
            "p.dxf:5: entity 1 (SPLINE): a curve that is no arc of a circle");
}

TEST(DxfSpline, NamesWhatIsWrong) {
  EXPECT_EQ(Complaint("0 SPLINE 8 0 71 3 72 0 73 0 74 2 11 0 21 0 11 1 21 1"),
            "p.dxf:5: entity 1 (SPLINE): has no control points, only fit points or none");
  EXPECT_EQ(Complaint("0 SPLINE 8 0 71 3 40 0 40 1 10 0 20 0 10 1 20 1"),
            "p.dxf:5: entity 1 (SPLINE): of degree 3 has 2 control points and 2 knots");
  EXPECT_EQ(Complaint("0 SPLINE 8 0 71 1 40 0 40 0 40 0 40 0 10 0 20 0 10 1 20 1"),
            "p.dxf:5: entity 1 (SPLINE): has knots that do not grow");
  EXPECT_EQ(Complaint("0 SPLINE 8 0 71 1 40 0 40 0 40 1 40 0.5 10 0 20 0 10 1 20 1"),
            "p.dxf:5: entity 1 (SPLINE): has knots that do not grow");
  EXPECT_EQ(Complaint("0 SPLINE 8 0 71 1000000 40 0 10 0 20 0"),
            "p.dxf:5: entity 1 (SPLINE): degree 1e+06 is not from 1 to 25");
  EXPECT_EQ(Complaint(kSpline + " 41 1 41 2"),
            "p.dxf:5: entity 1 (SPLINE): has 5 control points and 2 weights");
  EXPECT_EQ(Complaint(kSpline + " 41 1 41 0 41 1 41 1 41 1"),
            "p.dxf:5: entity 1 (SPLINE): has a weight that is not above 0");
  EXPECT_EQ(Complaint("0 ELLIPSE 8 0 10 0 20 0 11 0 21 0 40 1"),
            "p.dxf:5: entity 1 (ELLIPSE): has an axis without length");
  EXPECT_EQ(Complaint("0 ELLIPSE 8 0 10 0 20 0 11 1 21 0 40 0.5 210 1 220 0 230 0"),
            "p.dxf:5: entity 1 (ELLIPSE): is not in the plane of x and y");
}

TEST(DxfSpline, TooFineAToleranceIsRefused) {
  EXPECT_EQ(Refusal([] { Read(kSpline, 1e-300); }),
            "p.dxf:5: entity 1 (SPLINE): curves flattened so finely have more than 2000000 chords");
}

}  // namespace
}  // namespace Vorn::IO
