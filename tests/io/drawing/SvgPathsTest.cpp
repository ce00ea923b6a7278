#include <gtest/gtest.h>

#include <numbers>

#include "io/Contours.h"
#include "io/drawing/Layout.h"
#include "io/drawing/SvgPaths.h"

namespace Vorn::IO::Svg {
namespace {

using std::numbers::pi;

/// A view with one pixel per unit and the origin of the plane at (100, 100).
View PlainView() {
  return {{-100.0 / 1.14, 100.0 / 1.14, -1.0, 1.0}, 0.0, 0.0, 200.0, 200.0, 400.0};
}

TEST(PathData, CounterClockwiseIsTheNegativeSenseOfSvg) {
  auto const quarter = [](double direction) {
    double const to = direction > 0.0 ? 0.5 * pi : -0.5 * pi;
    return PathData(PiecesOf({Contours::Segment(50, 0), Contours::Arc(0, 0, 50, 0, to, direction)}),
                    PlainView());
  };
  EXPECT_EQ(quarter(1.0), "M150,100A50,50 0 0 0 100,50");
  EXPECT_EQ(quarter(-1.0), "M150,100A50,50 0 0 1 100,150");
}

TEST(PathData, ArcBeyondHalfATurnIsWrittenInParts) {
  std::string const data =
      PathData(PiecesOf({Contours::Segment(50, 0), Contours::Arc(0, 0, 50, 0, -0.5 * pi, 1.0)}),
               PlainView());
  EXPECT_EQ(data, "M150,100A50,50 0 0 0 100,50A50,50 0 0 0 50,100A50,50 0 0 0 100,150");
}

TEST(PathData, FlatArcOfAnEnormousRadiusIsALine) {
  double const radius = 1e9;
  std::string const data = PathData(
      PiecesOf({Contours::Segment(0, 0),
                Contours::Arc(0, -radius, radius, 0.5 * pi, 0.5 * pi - 50.0 / radius, -1.0)}),
      PlainView());
  EXPECT_EQ(data, "M100,100L150,100");
}

}  // namespace
}  // namespace Vorn::IO::Svg
