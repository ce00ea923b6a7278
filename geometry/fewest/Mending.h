#pragma once

#include <cstddef>
#include <vector>

#include "geometry/fewest/Chain.h"
#include "geometry/fewest/Path.h"
#include "geometry/fewest/Stretch.h"
#include "geometry/fewest/promises/Promises.h"

/// Chains that break a promise at some of their pieces.
namespace Vorn::Fewest {

/// Searches the pieces that break a promise anew, each time within smaller tolerances, and leaves
/// all other joints where they are: a bad place costs pieces there and nowhere else.
class Mending {
 public:
  /// `share` is that of the tolerances within which the chain was found. The path has to outlive
  /// this.
  Mending(Path const& path, double share, Chain chain);

  /// The chain so far.
  Chain const& Current() const { return chain_; }

  /// Searches the pieces of all violations together with their neighbours. False when nothing is
  /// left to try at any of them.
  bool Mend(std::vector<Promises::Violation> const& violations);

 private:
  /// The stretches around the pieces of violations, in order and apart.
  std::vector<Stretch> StretchesAround(std::vector<Promises::Violation> const& violations) const;
  /// The pieces of a stretch within smaller tolerances; empty when they allow none.
  Chain Search(Stretch const& stretch, std::size_t tightness) const;

  Path const& path_;
  double share_;
  Chain chain_;
  /// In which of the ever smaller tolerances each piece was found.
  std::vector<std::size_t> tightness_;
};

}  // namespace Vorn::Fewest
