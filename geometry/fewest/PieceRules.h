#pragma once

#include <cstdint>
#include <optional>

#include "geometry/fewest/Backsteps.h"
#include "geometry/fewest/Columns.h"
#include "geometry/fewest/Gates.h"
#include "geometry/fewest/LocalFrame.h"
#include "geometry/fewest/Path.h"
#include "geometry/fewest/Simplex.h"
#include "geometry/fewest/Spacing.h"

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
  PieceRules(Path const& path, LocalFrame const& frame, double share, Spacing* spacing,
             Backsteps* backsteps, Programme* programme)
      : path_(path),
        frame_(frame),
        share_(share),
        spacing_(*spacing),
        backsteps_(*backsteps),
        programme_(programme) {}

  /// Holds: the circle keeps all rules. Added: it breaks one, and the programme has one condition
  /// more. Hopeless: it breaks one that no condition mends, or the programme is full.
  enum class Check { Holds, Added, Hopeless };

  /// Looks at a normalised circle in local coordinates. O(n).
  Check AddBroken(Circle const& circle, Ends const& ends) const;

 private:
  /// A joint on a gate of the piece, in local coordinates.
  struct Joint {
    Gate gate;
    bool isFixed = false;  ///< whether the gate leaves the joint one place
    double offset = 0.0;   ///< on the gate
    Place place;
  };

  /// A point near a joint.
  struct JointView {
    Place point;
    double tolerance = 0.0;     ///< of the point
    double sense = 1.0;         ///< 1 where the point follows the gate, -1 where it precedes it
    bool isNextToGate = false;  ///< whether no other point lies between
    double dx = 0.0;            ///< from the joint to the point
    double dy = 0.0;
    double gap2 = 0.0;  ///< the square of that distance
  };

  /// The order of the points along the circle, the greatest step and less than a full turn. O(n),
  /// far less where a long run is dense.
  Check AddBrokenOrder(Circle const& circle, Ends const& ends) const;
  /// Of how many points one needs to be looked at: above 1 where the spacing of a long run tells
  /// that its points are in order along the circle by small steps, and that so many turn little.
  std::int32_t FindStride(Circle const& circle, Ends const& ends) const;
  /// A point that lies back behind an earlier one, by how much more than noise may put it there.
  struct StepBack {
    std::int32_t earlier = 0;
    std::int32_t point = 0;
    double excess = 0.0;

    void Take(StepBack const& other) {
      if (other.excess > excess) *this = other;
    }
  };
  /// By how much more than noise may put it there a point lies back behind an earlier one; 0 where
  /// the circle turns too much between the two to tell.
  double ExcessOfStepBack(Circle const& circle, std::int32_t earlier, std::int32_t point) const;
  /// That a point lies no farther back than noise may put it.
  Condition OrderCondition(StepBack const& broken) const;
  /// Whether two points are further apart along the circle than the greatest step. Their feet on
  /// the circle are as far apart as the points, divided by the distance of the nearer one from the
  /// centre in radii; `near2` is the square of that distance. Points nearer than `w` make no step.
  bool IsLargeStep(Circle const& circle, double gap2, double near2, double w) const;
  /// Bounds the curvature so that two points this far apart are within the greatest step.
  Check AddStep(double gap2, double near2) const;
  /// Whether the points and joints of the piece turn about the centre by more than 2 pi. Looks at
  /// one point of so many, and at the last.
  bool IsFullTurn(Circle const& circle, Ends const& ends, std::int32_t stride) const;
  /// The rules between a joint and the points [first, last) next to it, from the gate on. Hopeless
  /// where the circle does not cross the gate.
  Check AddBrokenJoint(Circle const& circle, Opening const& opening, std::int32_t first,
                       std::int32_t last) const;
  /// Where a circle crosses the gate of an opening; nothing where it does not.
  std::optional<Joint> FindJoint(Circle const& circle, Opening const& opening) const;
  /// How a point sees a joint.
  JointView ViewJoint(Joint const& joint, std::int32_t point) const;
  /// The rules between a joint and one point: the step between the two, and that the point does not
  /// lie beyond the joint.
  Check AddBrokenView(Circle const& circle, Joint const& joint, JointView const& view) const;
  /// The offsets for which the point lies beside the piece end at a limit; those within tolerance
  /// of the point may go beyond. Keeps the joint on its side of the limit.
  Check AddOffsetLimit(Circle const& circle, Joint const& joint, JointView const& view) const;

  Path const& path_;
  LocalFrame const& frame_;
  double share_;
  Spacing& spacing_;
  Backsteps& backsteps_;
  Programme* programme_;
};

}  // namespace Vorn::Fewest
