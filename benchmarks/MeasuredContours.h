#pragma once

#include <cstddef>
#include <limits>
#include <string>

#include "benchmarks/Profiles.h"
#include "support/SharedData.h"

/// Measured contours outside the repository, in the folder named by VORN_DATA_DIR.
namespace Vorn::Benchmarks {

/// A file and the tolerance that suits it: one for all points, or a cap for tolerances that follow
/// the spacing.
struct MeasuredContour {
  char const* name;
  double tolerance;
  bool isPerPoint;
  int truePieces;        ///< 0 when not known
  bool isSlowWhenPlain;  ///< the plain composition takes many seconds to minutes
  bool isClosed;         ///< the last point leads back to the first
};

constexpr MeasuredContour kMeasuredContours[] = {
    {"rail_head_known_arcs", 0.01, false, 7, false, false},
    {"wheel_worn_a", 0.03, false, 0, false, false},
    {"rail_worn_low", 0.025, false, 0, false, false},
    {"mirror_sphere_83m", 0.00005, false, 1, false, false},
    {"hatch_boundary", 0.002, false, 0, false, true},
    {"glyph_five", 2.0, true, 0, false, true},
    {"test_track_centreline", 0.03, true, 0, true, false},
    {"gcode_letter_d", 0.015, false, 0, false, true},
    {"airfoil_clark_y", 0.0004, false, 0, false, false},
    {"circle_r3", 0.001, false, 1, false, true},
};

inline Profile Load(std::string const& folder, MeasuredContour const& contour) {
  Profile profile;
  profile.points = Testing::ReadPoints(folder + '/' + contour.name + ".csv");
  profile.truePieces = contour.truePieces;
  if (contour.isPerPoint) {
    Testing::SetTolerancePerPoint(&profile.points, contour.tolerance);
  } else {
    Testing::SetTolerance(&profile.points, contour.tolerance);
  }
  return profile;
}

}  // namespace Vorn::Benchmarks
