// Does a flat polyline cross or touch itself?
//
// A piece starts at every vertex offset of a run: a straight segment to the next vertex, or the arc
// of the record there. Every piece P is tested against the later pieces of its own run and against
// all later runs. Crossings are reported through found; the ErrorCode tells invalid data only.
//
// Nothing is exempted where the polyline closes: a closed run of three or more straight pieces
// always counts as touching itself at its first vertex.

#include "geometry/contours/ArcSteps.h"
#include "geometry/contours/PolylineLayout.h"
#include "vorn/GeometryUtils.h"

namespace Vorn {

namespace {

using Point = GeometryUtils::Point;
using Arc = GeometryUtils::Arc;

struct Run {
  std::int32_t kind;
  std::int64_t stride;
  std::int64_t begin;
  std::int64_t end;  ///< the offset of the last vertex, where no piece of the run starts
};

struct Piece {
  std::int64_t offset;
  std::int32_t kind;
};

/// What a pair of pieces, or all pairs up to now, say.
struct Verdict {
  ErrorCode code = ErrorCode::Ok;
  bool isCrossing = false;

  bool IsFinal() const { return isCrossing || code != ErrorCode::Ok; }
};

constexpr Verdict Invalid(ErrorCode code) { return {code, false}; }
constexpr Verdict CrossingIf(bool isCrossing) { return {ErrorCode::Ok, isCrossing}; }

/// Answer of the arc routine for arcs whose intersection is not defined.
constexpr int kUndefinedCount = -2;

class PairwiseCheck {
 public:
  PairwiseCheck(Flat::Data const& data, std::vector<Run> const& runs, ArcSteps const& arcSteps)
      : data_(data), runs_(runs), arcSteps_(arcSteps) {}

  Verdict Check() const {
    for (std::size_t r = 0; r < runs_.size(); ++r) {
      for (std::int64_t q = runs_[r].begin; q < runs_[r].end; q += runs_[r].stride) {
        Verdict const verdict = CheckPiece(r, {q, runs_[r].kind});
        if (verdict.IsFinal()) return verdict;
      }
    }
    return {};
  }

 private:
  Verdict CheckPiece(std::size_t r, Piece const& piece) const {
    Run const& own = runs_[r];
    // Consecutive straight pieces share their joint, so the one right after is passed over.
    std::int64_t const steps = own.kind == Flat::kVertexRun ? 2 : 1;
    Verdict verdict = CheckAgainst(piece, own, piece.offset + steps * own.stride);
    // Deliberate: for every later run the scan restarts at the end of this run, so the data of the
    // runs in between is read again with the later run's layout.
    for (std::size_t m = r + 1; m < runs_.size() && !verdict.IsFinal(); ++m) {
      verdict = CheckAgainst(piece, runs_[m], own.end);
    }
    return verdict;
  }

  /// The piece against all that start in [begin, run.end), read with the layout of the run.
  Verdict CheckAgainst(Piece const& piece, Run const& run, std::int64_t begin) const {
    for (std::int64_t q = begin; q < run.end; q += run.stride) {
      Verdict const verdict = TestPair(piece, {q, run.kind});
      if (verdict.IsFinal()) return verdict;
    }
    return {};
  }

  Verdict TestPair(Piece const& first, Piece const& second) const {
    if (!IsInside(first) || !IsInside(second)) return Invalid(ErrorCode::Failed);
    if (first.kind == Flat::kVertexRun) {
      return second.kind == Flat::kVertexRun ? TestStraightStraight(first, second)
                                             : TestStraightArc(first, second);
    }
    return second.kind == Flat::kVertexRun ? TestArcStraight(first, second)
                                           : TestArcArc(first, second);
  }

  Verdict TestStraightStraight(Piece const& first, Piece const& second) const {
    double x = 0.0;
    double y = 0.0;
    Point const a = VertexAt(first.offset);
    Point const b = EndOfStraight(first);
    Point const c = VertexAt(second.offset);
    Point const d = EndOfStraight(second);
    return CrossingIf(GeometryUtils::GetLineSegmentsIntersection(a.x, a.y, b.x, b.y, c.x, c.y, d.x,
                                                                 d.y, &x, &y) ==
                      SegmentsRelPosition::Intersecting);
  }

  /// Deliberate: one common point is no crossing here, but it is one in the opposite order.
  Verdict TestStraightArc(Piece const& first, Piece const& second) const {
    int const count = arcSteps_.CountSegmentArc(VertexAt(first.offset), EndOfStraight(first),
                                                ArcAt(second.offset));
    return count < 0 ? Invalid(ErrorCode::Failed) : CrossingIf(count == 2);
  }

  Verdict TestArcStraight(Piece const& first, Piece const& second) const {
    int const count = arcSteps_.CountSegmentArc(VertexAt(second.offset), EndOfStraight(second),
                                                ArcAt(first.offset));
    return count < 0 ? Invalid(ErrorCode::Failed) : CrossingIf(count > 0);
  }

  Verdict TestArcArc(Piece const& first, Piece const& second) const {
    int const count = arcSteps_.CountArcArc(ArcAt(first.offset), ArcAt(second.offset));
    if (count == kUndefinedCount) return Invalid(ErrorCode::IntersectionUndefined);
    if (count < 0) return Invalid(ErrorCode::InvalidArcRadius);
    bool const isNextRecord = second.offset == first.offset + Flat::kRecordStride;
    return CrossingIf(count == 2 || (count == 1 && !isNextRecord));
  }

  /// Does the data hold all that describes the piece?
  bool IsInside(Piece const& piece) const {
    std::int64_t const last = piece.kind == Flat::kVertexRun
                                  ? piece.offset + Flat::kVertexStride + 1
                                  : piece.offset + Flat::kRecordEndAngle;
    return data_.Holds(piece.offset, last);
  }

  Point VertexAt(std::int64_t offset) const { return {data_[offset], data_[offset + 1]}; }

  Point EndOfStraight(Piece const& piece) const {
    return VertexAt(piece.offset + Flat::kVertexStride);
  }

  /// The arc of a record but for its end point, which the arc routines do not need.
  Arc ArcAt(std::int64_t offset) const {
    Arc arc;
    arc.center = VertexAt(offset + Flat::kRecordCenter);
    arc.radius = data_[offset + Flat::kRecordRadius];
    arc.direction = data_[offset + Flat::kRecordDirection];
    arc.startAngle = data_[offset + Flat::kRecordStartAngle];
    arc.endAngle = data_[offset + Flat::kRecordEndAngle];
    return arc;
  }

  Flat::Data data_;
  std::vector<Run> const& runs_;
  ArcSteps arcSteps_;
};

/// Lends the closing vertex to the caller's array and takes it back on every way out.
class ClosingVertex {
 public:
  explicit ClosingVertex(std::vector<double>* coords)
      : coords_(coords), originalSize_(coords->size()) {}
  ClosingVertex(ClosingVertex const&) = delete;
  ClosingVertex& operator=(ClosingVertex const&) = delete;
  ~ClosingVertex() { coords_->resize(originalSize_); }

  void Append() {
    double const x = (*coords_)[0];
    double const y = (*coords_)[1];
    coords_->push_back(x);
    coords_->push_back(y);
  }

 private:
  std::vector<double>* coords_;
  std::size_t originalSize_;
};

}  // namespace

ErrorCode GeometryUtils::CheckPolySelfIntersection(std::vector<double>& coords,
                                                   std::vector<std::int32_t> const& indices,
                                                   bool* found) {
  if (indices.empty() || coords.empty()) return ErrorCode::Failed;

  // The signed entry is compared: one that is negative never asks for the closing vertex.
  std::int64_t const lastEntry = indices.back();
  auto const size = static_cast<std::int64_t>(coords.size());
  if (lastEntry > size) return ErrorCode::Failed;
  ClosingVertex closingVertex(&coords);
  if (lastEntry == size) {
    if (size < Flat::kVertexStride) return ErrorCode::Failed;
    closingVertex.Append();
  }

  std::vector<Run> runs;
  std::int64_t begin = 0;
  for (std::int32_t const entry : indices) {
    PolylineParam param;
    GetPolylineParam(entry, &param);
    std::int64_t const end = Flat::Magnitude(entry);
    runs.push_back({param.kind, param.stride, begin, end});
    begin = end;
  }

  ArcSteps const arcSteps{&GetLineSegmentAndCircleArcIntersection,
                          &GetCircleArcAndCircleArcIntersection};
  Verdict const verdict = PairwiseCheck(Flat::Data(coords), runs, arcSteps).Check();
  if (verdict.code != ErrorCode::Ok) return verdict.code;
  if (found == nullptr) return ErrorCode::Failed;
  *found = verdict.isCrossing;
  return ErrorCode::Ok;
}

}  // namespace Vorn
