#pragma once

#include <gtest/gtest.h>

#include <string>
#include <string_view>

#include "vorn/io/Failure.h"
#include "vorn/io/Points.h"

/// Tables of points in memory, for tests of their reader.
namespace Vorn::IO::PointTables {

using Use = ToleranceColumn::Use;

inline PointFile Parse(std::string_view text,
                       ToleranceColumn const& column = {Use::IfPresent, "w"}) {
  return ParsePoints(text, "p.csv", column);
}

/// The message of the refusal; empty when the text is accepted.
inline std::string TableRefusal(std::string_view text,
                                ToleranceColumn const& column = {Use::IfPresent, "w"}) {
  try {
    Parse(text, column);
  } catch (Failure const& failure) {
    EXPECT_EQ(failure.Kind(), FailureKind::File);
    return failure.what();
  }
  return "";
}

inline void ExpectPoint(PointFile const& file, std::size_t i, double x, double y,
                        std::size_t line) {
  ASSERT_LT(i, file.points.size());
  EXPECT_EQ(file.points[i].x, x);
  EXPECT_EQ(file.points[i].y, y);
  EXPECT_EQ(file.lines[i], line);
}

}  // namespace Vorn::IO::PointTables
