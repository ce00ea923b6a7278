// The triples of samples that an arc's cell is made of. They spread from the middle of the run
// outwards, each with its mirror image.

#pragma once

#include <cstddef>
#include <vector>

#include "geometry/fitting/runs/Runs.h"
#include "math/Assert.h"

namespace Vorn::Fitting {

/// The samples of an arc, in the order in which it passes them.
using Samples = std::vector<GeometryUtils::IndexedPoint>;

/// Three sample positions, ascending.
struct Triple {
  int i0 = 0;
  int i1 = 0;
  int i2 = 0;
};

/// The triple of a step, from 1 on, among so many samples: (step, (step - 1 + size) / 2, size - 1)
/// while step < size / 3, then (0, step, size - 1); or its mirror image end for end. Its positions
/// are among the samples while step < size.
inline Triple TripleOf(int step, int size, bool isMirrored) {
  bool const isInner = step < size / 3;
  int const low = isInner ? step : 0;
  int const middle = isInner ? (step - 1 + size) / 2 : step;
  int const high = size - 1;
  if (isMirrored) return {size - 1 - high, size - 1 - middle, size - 1 - low};
  return {low, middle, high};
}

/// The points of a triple, with the fixed ends in the place of the samples they stand for.
struct TriplePoints {
  /// The positions of the triple must be among the samples.
  TriplePoints(Samples const& samples, Triple const& triple, Ends const& ends)
      : first(At(samples, triple.i0)),
        middle(At(samples, triple.i1)),
        last(At(samples, triple.i2)),
        usesStart(ends.fixedStart && triple.i0 == 0),
        usesEnd(ends.fixedEnd && static_cast<std::size_t>(triple.i2) + 1 == samples.size()) {
    if (usesStart) first = *ends.fixedStart;
    if (usesEnd) last = *ends.fixedEnd;
  }

  Point first;
  Point middle;
  Point last;
  /// Whether first is the fixed start.
  bool usesStart;
  /// Whether last is the fixed end.
  bool usesEnd;

 private:
  /// The point of the sample at a position.
  static Point const& At(Samples const& samples, int position) {
    return samples[static_cast<std::size_t>(position)].pt;
  }
};

/// Which samples have been part of a triple. A triple that adds no new sample is passed over: its
/// cell would not narrow the arc by another point.
class UsedSamples {
 public:
  /// None of so many samples.
  explicit UsedSamples(std::size_t size) : used_(size, false) {}

  /// Whether all three positions exist.
  bool Holds(Triple const& triple) const {
    return Exists(triple.i0) && Exists(triple.i1) && Exists(triple.i2);
  }

  /// Marks the triple's samples, which must exist. False when all three had been marked before.
  bool Mark(Triple const& triple) {
    VORN_ASSERT(Holds(triple));
    bool const isNew0 = MarkOne(triple.i0);
    bool const isNew1 = MarkOne(triple.i1);
    bool const isNew2 = MarkOne(triple.i2);
    return isNew0 || isNew1 || isNew2;
  }

 private:
  /// Whether there is such a position.
  bool Exists(int position) const {
    return position >= 0 && static_cast<std::size_t>(position) < used_.size();
  }

  /// Marks one sample. False when it had been marked before.
  bool MarkOne(int position) {
    auto const at = static_cast<std::size_t>(position);
    bool const isNew = !used_[at];
    used_[at] = true;
    return isNew;
  }

  std::vector<bool> used_;
};

}  // namespace Vorn::Fitting
