#pragma once

#include <cmath>
#include <cstdint>

#include "geometry/fewest/Backsteps.h"
#include "geometry/fewest/Columns.h"
#include "geometry/fewest/Gates.h"
#include "geometry/fewest/LocalFrame.h"
#include "geometry/fewest/Path.h"
#include "geometry/fewest/PieceRules.h"
#include "geometry/fewest/RunTest.h"
#include "geometry/fewest/Simplex.h"
#include "geometry/fewest/Spacing.h"

/// One piece of a chain: a circle that starts on a gate, covers a run of points and may end on
/// another gate.
namespace Vorn::Fewest {

/// How far a piece reaches.
struct Reach {
  /// One past the last point covered.
  std::int32_t end = 0;
  /// A circle that covers them.
  PlacedCircle circle;
};

/// A circle of the path and how it meets what is asked of it, as in RunFit.
struct PieceFit {
  PlacedCircle circle;
  double ratio = 0.0;
  bool isFound = false;
};

/// Offsets at which a piece can end on a gate.
struct Interval {
  double low = 0.0;
  double high = 0.0;
  bool isFound = false;
  /// The pieces that end there, about one origin.
  PlacedCircle atLow;
  PlacedCircle atHigh;
};

/// Where the piece behind a gate may start when the one before ends within an interval.
inline Opening StartOn(Gate const& gate, Interval const& interval) {
  Gate const behind = SeenFromBehind(gate);
  return gate.isCusp ? Opening{behind, -interval.high, -interval.low, false}
                     : Opening{behind, interval.low, interval.high, false};
}

/// Searches pieces along one path; keeps its rows between searches.
class PieceSearch {
 public:
  /// Tolerances are multiplied by `share`.
  PieceSearch(Path const& path, double share)
      : path_(path), spacing_(path), backsteps_(path), share_(share) {}

  /// Moves the local coordinates to the points [first, last), about which the next searches go.
  void MoveTo(std::int32_t first, std::int32_t last);

  /// The farthest run that one piece covers from an opening on. `expected` is a guess of the end.
  Reach FindReach(Opening const& from, std::int32_t expected);

  /// The same where only a reach of at least that of a rival counts: a shorter one is given as one
  /// point less than the rival's, with the circle of the rival.
  Reach FindReachBeyond(Opening const& from, Reach const& rival);

  /// The offsets at which a piece from an opening can end on a gate; `known` is a circle that
  /// covers the points before it.
  Interval FindInterval(Opening const& from, Gate const& to, PlacedCircle const& known);

  /// The piece of the smallest largest ratio between two openings; a free opening stands for the
  /// end of the path.
  /// `start` is a circle to begin with; isFound when it is a piece of its ratio.
  PieceFit FindBest(Opening const& from, Opening const& to, PieceFit const& start);

  /// The same among straight pieces; not found where there is none within tolerance, and where all
  /// pieces are straight anyway.
  PieceFit FindStraight(Opening const& from, Opening const& to);

  /// The same as FindBest where the piece may end anywhere behind its last point, the one before
  /// `end`.
  PieceFit FindBestUpTo(Opening const& from, std::int32_t end, PieceFit const& start);

  /// The circle of the smallest largest ratio through some points alone; its guess is their chord.
  PieceFit FitAlone(std::int32_t first, std::int32_t last);

  /// The same from another circle on; isFound when it is one of its ratio.
  PieceFit FitAlone(std::int32_t first, std::int32_t last, PieceFit const& start);

  /// The same for the longest run from a point on that a circle was found for; not found where two
  /// points are left or fewer.
  PieceFit FitLongestAlone(std::int32_t first);

 private:
  /// Has the rows of the points [first, last) in the columns; moves the local coordinates where
  /// they do not follow on those that are there.
  void Cover(std::int32_t first, std::int32_t last);
  /// Two where pieces have to stay near the path between points: its middle has a row of its own.
  std::int32_t RowsPerPoint() const {
    return std::isfinite(path_.limits.farthestBetweenPoints) ? 2 : 1;
  }
  /// The middle between neighbours with the room that a piece has there. A piece that passes it
  /// this near stays near all of the way.
  Sample MiddleOf(WPoint const& p, WPoint const& q) const;
  /// Begins a programme of the rows of [first, last) without conditions.
  void UseRows(std::int32_t first, std::int32_t last);
  /// The circle of the smallest largest ratio of the rows in use.
  PieceFit FitRows(RunFit const& start);
  /// Begins the programme of a piece from an opening over the points up to `end`: rows, limit of
  /// curvature, opening.
  void BeginProgramme(Opening const& from, std::int32_t end);
  /// Asks that the piece passes between the limits of an opening; a free one asks nothing.
  void AddOpening(Opening const& opening);
  /// Asks for a radius of at least the smallest, for steps below the greatest, or for a line where
  /// only segments are wanted; the box follows from that.
  void LimitCurvature(Opening const& from, std::int32_t end);
  struct Extreme {
    double offset = 0.0;
    Circle circle;
    bool isFound = false;
  };
  /// The lowest or highest offset at which a piece can end on the gate of `ends`, from a circle
  /// inside; not found where that circle does not cross the gate.
  Extreme FindExtreme(Ends const& ends, RunFit const& inner, bool isLow);

  /// A piece whose radius would be above the largest is straight or, where no line is within the
  /// rows, an arc of the largest radius.
  RunFit Fit(RunFit const& start, bool isTest, Ends const& ends);
  /// The least |a| of an arc in local coordinates; 0 where radii have no upper limit.
  double Flattest() const;
  /// Asks for arcs near a circle, bent to its side, that are not flatter than that; false when
  /// there is no room.
  bool KeepBent(Circle const& circle);
  /// Finds a circle that keeps the programme and the rules of a piece; radii have no upper limit
  /// here.
  RunFit FitAnyRadius(RunFit const& start, bool isTest, Ends const& ends);
  /// The rules in the local coordinates of now.
  PieceRules Rules() { return {path_, frame_, share_, &spacing_, &backsteps_, &programme_}; }
  /// A reach in local coordinates.
  struct LocalReach {
    std::int32_t end = 0;
    Circle circle;
    /// Whether more points may be covered than are.
    bool canGrow = false;
  };
  /// The longest run of few points, each length begun anew from several chords.
  LocalReach FindFirstReach(Opening const& from);
  /// Lengthens a reach by doubling steps and then by bisection.
  void Grow(Opening const& from, std::int32_t expected, LocalReach* reach);
  /// The fit of the programme for a start in the coordinates of the path, and in these.
  PieceFit FitFrom(PieceFit const& start, Ends const& ends);
  /// A fit of the programme in the coordinates of the path.
  PieceFit FromLocal(RunFit const& fit) const {
    return {frame_.FromLocal(fit.circle), fit.ratio, fit.isFound};
  }

  /// The best of fits that begin with chords to points ever further ahead; ends with the first that
  /// covers all points.
  RunFit FirstFit(Opening const& from, std::int32_t end);
  Path const& path_;
  Spacing spacing_;
  Backsteps backsteps_;
  double share_;
  double slack_ = 0.0;
  LocalFrame frame_;
  Columns columns_;
  std::int32_t columnsFirst_ = 0;
  Programme programme_;
  Basis basis_;
  int normalisation_ = 0;
};

}  // namespace Vorn::Fewest
