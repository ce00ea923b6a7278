#include "geometry/fewest/Answer.h"

#include <cmath>
#include <cstddef>
#include <cstdint>

namespace Vorn::Fewest {

namespace {

double Rounded(double value, double unit) { return std::round(value / unit) * unit; }

}  // namespace

Answer Restore(Shift const& shift, Chain const& chain, std::vector<BuiltPiece> const& pieces) {
  Answer answer;
  answer.contour.push_back(BuildSegment({}, shift.Restore(pieces.front().start)).elem);
  for (std::size_t k = 0; k < pieces.size(); ++k) {
    GeometryUtils::Elem const& elem = pieces[k].elem;
    GeometryUtils::Point const start = answer.contour.back().end;
    GeometryUtils::Point const end = shift.Restore(elem.end);
    bool const isSegment = elem.type == GeometryUtils::ElemType::Segment;
    BuiltPiece const restored =
        isSegment ? BuildSegment(start, end)
                  : BuildArcNear(start, end, shift.Restore(elem.center), elem.direction);
    answer.contour.push_back(restored.elem);
    answer.ranges.push_back({chain.pieces[k].first, chain.pieces[k].end - 1});
  }
  return answer;
}

bool AppendClosingSegment(Answer* answer) {
  GeometryUtils::Point const start = answer->contour.front().end;
  GeometryUtils::Point const end = answer->contour.back().end;
  FewestPieces::Range& last = answer->ranges.back();
  if (last.first == last.last || (start.x == end.x && start.y == end.y)) return false;
  answer->contour.push_back(BuildSegment(end, start).elem);
  std::int32_t const taken = last.last--;
  answer->ranges.push_back({taken, taken});
  return true;
}

void RoundEnds(double leastTolerance, Answer* answer) {
  constexpr int kDigits = 20;  // 2^-20 is about a millionth
  bool const isSegment =
      answer->ranges.size() == 1 && answer->contour.back().type == GeometryUtils::ElemType::Segment;
  if (!isSegment) return;
  double const unit = std::ldexp(1.0, std::ilogb(leastTolerance) - kDigits);
  GeometryUtils::Point& start = answer->contour.front().end;
  GeometryUtils::Point& end = answer->contour.back().end;
  double const length = std::hypot(end.x - start.x, end.y - start.y);
  if (!(length > 0.0)) return;
  // The outermost points stay beside the segment when its ends move outwards first.
  double const outX = unit * (end.x - start.x) / length;
  double const outY = unit * (end.y - start.y) / length;
  start = {Rounded(start.x - outX, unit), Rounded(start.y - outY, unit)};
  end = {Rounded(end.x + outX, unit), Rounded(end.y + outY, unit)};
}

}  // namespace Vorn::Fewest
