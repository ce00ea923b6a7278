#include "geometry/fewest/promises/Crossings.h"

#include <cmath>
#include <utility>
#include <vector>

#include "geometry/contours/near/BoxTree.h"
#include "geometry/fewest/promises/Meetings.h"
#include "geometry/fewest/promises/OwnPath.h"

namespace Vorn::Promises {

namespace {

using Contours::Box;
using Contours::BoxTree;
using Contours::Extent;
using Point = GeometryUtils::Point;

/// Adds the outermost points of an arc's circle that the arc passes over. Where rounding leaves
/// that open the point is near an end.
void IncludeOutermost(DrawnPiece const& arc, Box* box) {
  double const r = arc.radius;
  for (Point const& out : {Point{r, 0.0}, Point{-r, 0.0}, Point{0.0, r}, Point{0.0, -r}}) {
    Point const p{arc.centre.x + out.x, arc.centre.y + out.y};
    if (PlaceOf(arc, p).beside == Beside::Piece) box->Include({p.x, p.x, p.y, p.y});
  }
}

Extent ExtentOf(DrawnPiece const& piece) {
  Box box;
  box.Include({piece.start.x, piece.start.x, piece.start.y, piece.start.y});
  box.Include({piece.end.x, piece.end.x, piece.end.y, piece.end.y});
  if (piece.isArc) IncludeOutermost(piece, &box);
  // Points that count as common may lie that far from either piece.
  double const padding = 16.0 * RoundingOf(piece);
  return {{box.xLow - padding, box.xHigh + padding, box.yLow - padding, box.yHigh + padding},
          true,
          false};
}

class CrossingChecks {
 public:
  CrossingChecks(Coverage const& coverage, Report* report)
      : coverage_(coverage), ownPath_(coverage), report_(report) {}

  void Run() {
    CheckNeighbours();
    std::vector<Extent> extents;
    extents.reserve(coverage_.PieceCount());
    for (std::size_t piece = 0; piece < coverage_.PieceCount(); ++piece) {
      extents.push_back(ExtentOf(coverage_.Drawn(piece)));
    }
    BoxTree tree(std::move(extents), 0.0);
    tree.AnyPair([this](std::size_t i, std::size_t k) {
      if (coverage_.Next(i) == k || coverage_.Next(k) == i) return false;
      Take(i, k, FindMeetings(coverage_.Drawn(i), coverage_.Drawn(k)));
      return false;
    });
  }

 private:
  void CheckNeighbours() {
    for (std::size_t piece = 0; piece < coverage_.PieceCount(); ++piece) {
      std::size_t const next = coverage_.Next(piece);
      if (next == kNone || next == piece) continue;
      Take(piece, next, FindLoops(coverage_.Drawn(piece), coverage_.Drawn(next)));
    }
  }

  void Take(std::size_t first, std::size_t second, Meetings const& meetings) {
    for (std::size_t i = 0; i < meetings.count; ++i) {
      if (ownPath_.Crosses(first, second, meetings.list[i])) continue;
      report_->violations.push_back(
          {Promise::NotCrossing, first, second, kNone, meetings.list[i].at, 0.0});
      return;
    }
  }

  Coverage const& coverage_;
  OwnPath ownPath_;
  Report* report_;
};

}  // namespace

void CheckCrossings(Coverage const& coverage, Report* report) {
  CrossingChecks(coverage, report).Run();
}

}  // namespace Vorn::Promises
