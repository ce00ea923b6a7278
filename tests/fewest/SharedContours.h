#pragma once

#include <cstdint>
#include <ostream>
#include <string>

#include "gtest/gtest.h"
#include "support/SharedData.h"
#include "support/fewest/Scans.h"

/// The measured contours with the tolerances and results that are known for them.
namespace Vorn::Testing {

struct SharedContour {
  char const* name;
  double tolerance;
  bool isPerPoint;  ///< the tolerance is a cap, see SetTolerancePerPoint
  bool isClosed;
  std::int32_t bound;            ///< no chain has fewer pieces, taken as an open path
  std::int32_t pieces;           ///< a chain with steps of up to 60 degrees has that many
  std::int32_t closedBound = 0;  ///< no closed chain has fewer pieces; 0 for an open contour

  Scan Read() const {
    Scan scan = ReadPoints(*SharedDataFolder() + "/" + name + ".csv");
    if (isPerPoint) {
      SetTolerancePerPoint(&scan, tolerance);
    } else {
      SetTolerance(&scan, tolerance);
    }
    return scan;
  }
};

inline void PrintTo(SharedContour const& contour, std::ostream* out) { *out << contour.name; }

/// The names of the cases of a test that is run on each of them.
inline std::string NameOf(testing::TestParamInfo<SharedContour> const& info) {
  return info.param.name;
}

inline constexpr SharedContour kSharedContours[] = {
    {"rail_head_known_arcs", 0.01, false, false, 7, 7},
    {"wheel_worn_a", 0.03, false, false, 26, 29},
    {"rail_worn_low", 0.025, false, false, 15, 16},
    {"mirror_sphere_83m", 0.00005, false, false, 1, 1},
    {"hatch_boundary", 0.002, false, true, 85, 97, 85},
    {"glyph_five", 2.0, true, true, 18, 18, 17},
    {"gcode_letter_d", 0.015, false, true, 8, 9, 7},
    {"airfoil_clark_y", 0.0004, false, false, 7, 8},
    {"circle_r3", 0.001, false, true, 1, 1, 2},
    {"test_track_centreline", 0.03, true, false, 21, 22},
};

}  // namespace Vorn::Testing
