#include "vorn/io/SpacingFailure.h"

#include <utility>

namespace Vorn::IO {

SpacingFailure::SpacingFailure(PointFile const& file, CloseNeighbours neighbours,
                               std::string const& message, Remedy help)
    : Failure(FailureKind::PointsTooClose, {file.path}, message, help),
      neighbours_(std::move(neighbours)) {
  neighbours_.outline = file.outline;
}

SpacingFailure::~SpacingFailure() = default;

SpacingFailure SpacingFailure::TooClose(PointFile const& file, CloseNeighbours const& neighbours) {
  return {file, neighbours, DescribeClosePair(file, neighbours.pair, neighbours.largestTolerance),
          Remedy::SpacePoints};
}

SpacingFailure SpacingFailure::Coinciding(PointFile const& file,
                                          CloseNeighbours const& neighbours) {
  return {file, neighbours,
          file.NameOf(neighbours.pair.first) + " and " + file.NameOf(neighbours.pair.second) +
              " coincide: no tolerance can follow from a spacing of zero",
          Remedy::LeaveOneOut};
}

}  // namespace Vorn::IO
