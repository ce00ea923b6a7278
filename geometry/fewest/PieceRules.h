#pragma once

#include <cstdint>

#include "geometry/fewest/Columns.h"
#include "geometry/fewest/Gates.h"
#include "geometry/fewest/LocalFrame.h"
#include "geometry/fewest/Path.h"
#include "geometry/fewest/Simplex.h"

/// What a piece has to keep besides the tolerances of its points: their order, the greatest step
/// between them, less than a full turn, ends beside its joints.
namespace Vorn::Fewest {

/// Share of the greatest step that the search allows, for the rounding of what is measured.
inline constexpr double kStepShare = 1.0 - 1e-6;

/// A piece in search of its circle.
struct Ends {
  /// Where it starts.
  Opening const* from = nullptr;
  /// Where it ends; null while the end is open.
  Opening const* to = nullptr;
  /// The points that it covers: [first, end).
  std::int32_t first = 0;
  std::int32_t end = 0;
};

/// The rules in the local coordinates of a programme. None of them is linear for all circles, but
/// each that a circle breaks is near that circle: it becomes a condition, and the search goes on.
class PieceRules {
 public:
  /// Tolerances are multiplied by `share`. What is referred to has to outlive the rules.
  PieceRules(Path const& path, LocalFrame const& frame, double share, Programme* programme)
      : path_(path), frame_(frame), share_(share), programme_(programme) {}

  /// Holds: the circle keeps all rules. Added: it breaks one, and the programme has one condition
  /// more. Hopeless: it breaks one that no condition mends, or the programme is full.
  enum class Check { Holds, Added, Hopeless };

  /// Looks at a normalised circle in local coordinates. O(n).
  Check AddBroken(Circle const& circle, Ends const& ends) const;

 private:
  Check AddBrokenOrder(Circle const& circle, Ends const& ends) const;
  bool IsLargeStep(Circle const& circle, double gap2, double near2, double w) const;
  Check AddStep(double gap2, double near2) const;
  bool IsFullTurn(Circle const& circle, Ends const& ends) const;
  Check AddBrokenJoint(Circle const& circle, Opening const& opening, std::int32_t point) const;

  Path const& path_;
  LocalFrame const& frame_;
  double share_;
  Programme* programme_;
};

}  // namespace Vorn::Fewest
