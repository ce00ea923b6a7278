#pragma once

#include <cmath>
#include <cstdint>
#include <limits>
#include <string>
#include <vector>

#include "gtest/gtest.h"
#include "support/fewest/PromiseChecker.h"
#include "support/fewest/Scans.h"
#include "vorn/FewestPieces.h"

/// Calls of the service for tests, each answer measured before it is used.
namespace Vorn::Testing {

using FewestOptions = FewestPieces::Options;
using FewestResult = FewestPieces::Result;

inline FewestOptions Closed() {
  FewestOptions options;
  options.closed = true;
  return options;
}

inline std::int32_t PieceCount(FewestResult const& result) {
  return static_cast<std::int32_t>(result.ranges.size());
}

inline std::int32_t ArcCount(FewestResult const& result) {
  std::int32_t count = 0;
  for (auto const& elem : result.contour) {
    count += elem.type == GeometryUtils::ElemType::Arc ? 1 : 0;
  }
  return count;
}

/// By how much the rounding of coordinates and centres changes a deviation in units of its
/// tolerance: a share of the extent over the least tolerance.
inline double RoundingOf(Scan const& scan) {
  double extent = 0.0;
  double least = scan.front().w;
  for (WPoint const& p : scan) {
    extent = std::fmax(extent, std::hypot(p.x - scan.front().x, p.y - scan.front().y));
    least = std::fmin(least, p.w);
  }
  return 1e-14 * extent / least;
}

/// No joint lies far from the points, in terms of how far these are apart.
inline void ExpectJointsNear(Scan const& scan, FewestResult const& result) {
  WPoint const& first = scan.front();
  double extent = 0.0;
  for (WPoint const& p : scan) {
    extent = std::fmax(extent, std::hypot(p.x - first.x, p.y - first.y) + p.w);
  }
  for (auto const& elem : result.contour) {
    EXPECT_LE(std::hypot(elem.end.x - first.x, elem.end.y - first.y), 4.0 * extent);
  }
}

/// All that a result promises, measured from the points. What the service says of itself has to
/// agree with it.
inline void ExpectPromisesKept(Scan const& scan, FewestOptions const& options,
                               FewestResult const& result) {
  auto const check = CheckPromises<FewestPieces::Range>(
      {scan, result.contour, result.ranges, options.closed, options.largestStep});
  EXPECT_TRUE(check.complaints.empty()) << check.Text();
  ExpectJointsNear(scan, result);
  EXPECT_NEAR(result.largestDeviation, check.largestRatio, 1e-6 + RoundingOf(scan));
  EXPECT_LE(result.largestDeviation, 1.0);
  EXPECT_GE(result.largestDeviationIndex, 0);
  EXPECT_GE(result.fewestPossible, options.closed ? 2 : 1);
  EXPECT_LE(result.fewestPossible, PieceCount(result));
  EXPECT_EQ(result.isFewest, result.fewestPossible == PieceCount(result));
}

/// The answer to a scan that has one.
inline FewestResult FitKept(Scan const& scan, FewestOptions const& options = {}) {
  FewestResult result;
  ErrorCode const code = FewestPieces::Fit(scan, options, &result, nullptr, 100);
  EXPECT_EQ(code, ErrorCode::Ok);
  if (code == ErrorCode::Ok) ExpectPromisesKept(scan, options, result);
  return result;
}

/// Equality of every field, bit by bit but for the sign of zeros.
inline void ExpectSameResult(FewestResult const& a, FewestResult const& b) {
  ASSERT_EQ(a.contour.size(), b.contour.size());
  for (std::size_t i = 0; i < a.contour.size(); ++i) {
    SCOPED_TRACE(testing::Message() << "element " << i);
    EXPECT_EQ(a.contour[i].type, b.contour[i].type);
    EXPECT_EQ(a.contour[i].end.x, b.contour[i].end.x);
    EXPECT_EQ(a.contour[i].end.y, b.contour[i].end.y);
    EXPECT_EQ(a.contour[i].center.x, b.contour[i].center.x);
    EXPECT_EQ(a.contour[i].center.y, b.contour[i].center.y);
    EXPECT_EQ(a.contour[i].radius, b.contour[i].radius);
    EXPECT_EQ(a.contour[i].direction, b.contour[i].direction);
    EXPECT_EQ(a.contour[i].startAngle, b.contour[i].startAngle);
    EXPECT_EQ(a.contour[i].endAngle, b.contour[i].endAngle);
  }
  ASSERT_EQ(a.ranges.size(), b.ranges.size());
  for (std::size_t i = 0; i < a.ranges.size(); ++i) {
    EXPECT_EQ(a.ranges[i].first, b.ranges[i].first);
    EXPECT_EQ(a.ranges[i].last, b.ranges[i].last);
  }
  EXPECT_EQ(a.largestDeviation, b.largestDeviation);
  EXPECT_EQ(a.largestDeviationIndex, b.largestDeviationIndex);
  EXPECT_EQ(a.fewestPossible, b.fewestPossible);
  EXPECT_EQ(a.isFewest, b.isFewest);
}

/// A result that no answer looks like, to see whether it was touched.
inline FewestResult Untouchable() {
  FewestResult result;
  result.contour.resize(3);
  result.contour[1].end = {17.0, -4.0};
  result.ranges = {{7, 9}};
  result.largestDeviation = -1.0;
  result.largestDeviationIndex = 77;
  result.fewestPossible = -5;
  result.isFewest = true;
  return result;
}

/// Expects an answer other than Ok, and the result as it was.
inline void ExpectRefused(ErrorCode expected, Scan const& scan, FewestOptions const& options = {}) {
  FewestResult result = Untouchable();
  EXPECT_EQ(FewestPieces::Fit(scan, options, &result, nullptr, 100), expected);
  ExpectSameResult(result, Untouchable());
}

}  // namespace Vorn::Testing
