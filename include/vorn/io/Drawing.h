#pragma once

#include <cstddef>
#include <optional>
#include <string>
#include <vector>

#include "vorn/Types.h"
#include "vorn/io/Deviations.h"
#include "vorn/io/Export.h"
#include "vorn/io/FitReport.h"
#include "vorn/io/Pieces.h"
#include "vorn/io/ReportHead.h"

namespace Vorn::IO {

struct ContourFile;
enum class Format;

/// What is to be drawn, wherever it comes from: measured points, or the pieces of a contour, or
/// both with the deviation of every point.
struct VORN_IO_EXPORT Drawing {
  std::string title;               ///< the heading
  std::vector<std::string> facts;  ///< short phrases for the line below the title
  std::string units;               ///< of all lengths; may be empty
  std::vector<WPoint> points;      ///< `w` is 0 where there is no tolerance; empty: pieces alone
  std::vector<Piece> pieces;       ///< empty: the points alone
  /// One for each point when there are pieces, else none; `relative` counts only where there is a
  /// tolerance.
  std::vector<PointDeviation> deviations;
  ReportHead head;                 ///< what the user puts at the head
  std::optional<Verdict> verdict;  ///< nothing: there was nothing to judge
  /// How many times larger than true deviations and tolerances are drawn. Nothing: a round number
  /// that makes the largest tolerance readable.
  std::optional<double> magnify;

  /// Whether there is a contour to draw.
  bool HasContour() const { return !pieces.empty(); }
  /// Whether there are points and a contour that they were measured against.
  bool IsMeasured() const { return !deviations.empty(); }
  /// Whether there are points and every one has a tolerance; the next three need that.
  bool HasTolerances() const;
  /// Whether all points have the same tolerance.
  bool IsToleranceUniform() const;
  /// The largest tolerance of a point.
  double LargestTolerance() const;
  /// The smallest tolerance of a point.
  double SmallestTolerance() const;
  /// How many pieces are arcs.
  std::size_t ArcCount() const;
  /// The contour ends where it starts.
  bool IsClosed() const;
  /// @throws Failure (FailureKind::BadArgument) when there are neither points nor pieces.
  void RequireContent() const;
  /// Index of the point with the largest deviation, over its tolerance where all have one. Only if
  /// something is measured.
  std::size_t Worst() const;
};

/// The drawing of a fit.
VORN_IO_EXPORT Drawing DrawingOf(FitReport const& report);

/// The drawing of a contour without measured points.
VORN_IO_EXPORT Drawing DrawingOf(ContourFile const& contour);

/// The drawing of points against a contour: measures every point, and judges when every point has
/// a tolerance. Without points or without pieces nothing is measured.
VORN_IO_EXPORT Drawing MakeDrawing(std::vector<WPoint> points, std::vector<Piece> pieces);

/// "tolerance 0.02 mm", "tolerance 0.01 to 0.03 mm"; nothing without tolerances.
VORN_IO_EXPORT std::string DescribeTolerance(Drawing const& drawing);

/// "GAP of 0.5 mm between pieces 3 and 4, the widest of 2" for the facts of a drawing; nothing
/// where the pieces meet, see FindGaps.
VORN_IO_EXPORT std::string DescribeGaps(ContourFile const& contour);

/// All of the following refuse a drawing of nothing, see Drawing::RequireContent.
///
/// A page of A4 across: the contour true to scale with deviations and tolerance magnified, below it
/// the deviations along the contour.
VORN_IO_EXPORT std::string ToSvg(Drawing const& drawing);

/// The same page as pixels.
struct PngSize {
  static constexpr double kUsualDpi = 150.0;  ///< pixels to the inch when nobody says

  double dpi = kUsualDpi;    ///< pixels to the inch on A4, above 0
  std::optional<int> width;  ///< in pixels; overrides `dpi`
};

/// @throws Failure (FailureKind::BadArgument) when the picture would be larger than can be drawn.
VORN_IO_EXPORT std::string ToPng(Drawing const& drawing, PngSize const& size);

/// One file that needs nothing else: pans and zooms, tells about the point under the cursor and
/// lists the pieces.
VORN_IO_EXPORT std::string ToHtml(Drawing const& drawing);

/// The drawing in a format that holds no contour.
VORN_IO_EXPORT std::string Drawn(Drawing const& drawing, Format format, PngSize const& size = {});

}  // namespace Vorn::IO
