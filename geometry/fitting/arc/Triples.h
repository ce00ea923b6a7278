#pragma once

#include <cstddef>
#include <vector>

namespace Vorn::Fitting {

/// Three sample positions of an arc candidate.
struct Triple {
  int i0;
  int i1;
  int i2;
};

/// Which samples have been part of a triple. A triple that adds no new sample is passed over: its
/// cell would not narrow the arc by another point.
class UsedSamples {
 public:
  explicit UsedSamples(std::size_t size) : used_(size, false) {}

  /// Whether all three positions exist.
  bool Holds(Triple const& triple) const {
    return Exists(triple.i0) && Exists(triple.i1) && Exists(triple.i2);
  }

  /// Marks the triple's samples. False when all three had been marked before.
  bool Mark(Triple const& triple) {
    bool const isNew0 = MarkOne(triple.i0);
    bool const isNew1 = MarkOne(triple.i1);
    bool const isNew2 = MarkOne(triple.i2);
    return isNew0 || isNew1 || isNew2;
  }

 private:
  bool Exists(int position) const {
    return position >= 0 && static_cast<std::size_t>(position) < used_.size();
  }

  bool MarkOne(int position) {
    auto const at = static_cast<std::size_t>(position);
    bool const isNew = !used_[at];
    used_[at] = true;
    return isNew;
  }

  std::vector<bool> used_;
};

}  // namespace Vorn::Fitting
