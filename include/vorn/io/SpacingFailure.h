#pragma once

#include <cstddef>
#include <optional>

#include "vorn/io/Export.h"
#include "vorn/io/Failure.h"
#include "vorn/io/Points.h"
#include "vorn/io/Spacing.h"
#include "vorn/io/Tolerances.h"

namespace Vorn::IO {

/// What a caller needs to know about neighbours that are too close, to name the ways out.
struct CloseNeighbours {
  ClosePair pair;  ///< the first such pair, as counted in the file
  /// What LargestSingleTolerance says of the points; nothing when neighbours coincide.
  std::optional<double> largestTolerance;
  ToleranceChoice tolerance;  ///< how the tolerances were chosen
  std::size_t outline = 0;    ///< of the points, as PointFile has it
};

/// The failure of points that are too close for their tolerances (FailureKind::PointsTooClose).
class VORN_IO_EXPORT SpacingFailure : public Failure {
 public:
  /// Two neighbours nearer to each other than the fit allows; its message is DescribeClosePair.
  static SpacingFailure TooClose(PointFile const& file, CloseNeighbours const& neighbours);

  /// Two neighbours in one place, of which no tolerance by spacing can follow.
  static SpacingFailure Coinciding(PointFile const& file, CloseNeighbours const& neighbours);

  /// Failures are copied when they are thrown and caught.
  SpacingFailure(SpacingFailure const&) = default;
  /// The same for one that is there already.
  SpacingFailure& operator=(SpacingFailure const&) = default;
  /// Out of line, so that every library knows the same type.
  ~SpacingFailure() override;

  /// The two points, and what was asked of them.
  CloseNeighbours const& Neighbours() const { return neighbours_; }

 private:
  /// With a message that does not name the file, and the ways out.
  SpacingFailure(PointFile const& file, CloseNeighbours neighbours, std::string const& message,
                 Remedy help);

  CloseNeighbours neighbours_;  ///< as given
};

}  // namespace Vorn::IO
