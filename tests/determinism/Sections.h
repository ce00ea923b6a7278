#pragma once

#include <cstdint>
#include <vector>

#include "vorn/GeometryUtils.h"

/// Digests of what the library answers, so that two builds of it can be compared: other compilers,
/// optimisation levels, versions. The inputs come from seeds and are the same in every build.
namespace Vorn::Testing {

/// What decides the bits of a section beside the library itself.
enum class DependsOn {
  Arithmetic,  ///< sums, products, quotients and square roots only: the same on every platform
  Libm,        ///< also sine, cosine, arc sine and arc tangent of the platform's C library
};

struct Section {
  char const* name;
  DependsOn dependsOn;
  std::uint64_t (*compute)();
};

/// Every section, whole fits first.
std::vector<Section> const& AllSections();

/// A digest of the platform's own functions at many arguments. Its hypot is not among them: no
/// section comes to it, and it differs between processors. Sections that depend on them can be
/// compared with records only where it is the recorded one: the functions differ in last bits from
/// one C library to the next, and on one C library between processors with and without fused
/// multiply-add.
std::uint64_t DigestLibm();

/// Whole fits of 2,000 profiles in turn with the three strategies.
std::uint64_t DigestMixedFits();
std::uint64_t DigestMixedCellsFits();
std::uint64_t DigestSingleArcFits();

/// The contour of the fewest pieces, with options drawn at random: profiles, scans of known number
/// and points without order.
std::uint64_t DigestFewestProfiles();
std::uint64_t DigestFewestScans();
std::uint64_t DigestFewestScribbles();

/// Members that take numbers and points.
std::uint64_t DigestAngles();
std::uint64_t DigestDistances();
std::uint64_t DigestCircles();
std::uint64_t DigestLineIntersections();
std::uint64_t DigestArcIntersections();

/// Members that take triangles, polygons and cells.
std::uint64_t DigestTriangles();
std::uint64_t DigestPolygons();
std::uint64_t DigestCells();

/// Members that take contours and flat polylines.
std::uint64_t DigestChains();
std::uint64_t DigestContours();
std::uint64_t DigestFlatPolylines();

/// MathUtils and Matrix.
std::uint64_t DigestSolver();
std::uint64_t DigestSpace();
std::uint64_t DigestRotations();

/// One fit of each strategy for a measured contour of the shared data.
struct ContourSection {
  char const* file;
  double tolerance;
  bool isPerPoint;  ///< the tolerance is a cap and each point has its own
};
std::vector<ContourSection> const& ContourSections();

/// The digest of the fit of one contour with one strategy, read from the folder of shared data.
std::uint64_t DigestContourFit(ContourSection const& contour,
                               GeometryUtils::FittingStrategy strategy);

}  // namespace Vorn::Testing
