// Does a flat polyline cross or touch itself?
//
// A piece starts at every vertex offset of a run: a straight segment to the next vertex, or the arc
// of the record there. Every piece P is tested against the later pieces of its own run and against
// all later runs. Crossings are reported through found; the ErrorCode tells invalid data only.
//
// Nothing is exempted where the polyline closes: a closed run of three or more straight pieces
// always counts as touching itself at its first vertex.
//
// The plain walk takes all pairs in their order. Where no piece can make a pair invalid, all that
// matters is whether any pair crosses, so long polylines are searched for pairs that come near each
// other. The restarts of the walk then add nothing: what a piece meets in a run is also met in the
// last run that is laid out alike. Polylines with an invalid piece are left to the plain walk,
// which most often ends at that piece in the first of its passes.

#include <algorithm>

#include "geometry/contours/SelfIntersectionSteps.h"
#include "geometry/contours/near/PieceExtents.h"
#include "vorn/GeometryUtils.h"

namespace Vorn {

namespace {

using Point = GeometryUtils::Point;
using Arc = GeometryUtils::Arc;

using Run = Contours::FlatRun;
using Verdict = Contours::FlatVerdict;

struct Piece {
  std::int64_t offset;
  std::int32_t kind;
};

constexpr Verdict Invalid(ErrorCode code) { return {code, false}; }
constexpr Verdict CrossingIf(bool isCrossing) { return {ErrorCode::Ok, isCrossing}; }

/// Answer of the arc routine for arcs whose intersection is not defined.
constexpr int kUndefinedCount = -2;

/// The pieces of runs of up to this many are compared one by one with those of later runs.
constexpr std::int64_t kShortRun = 32;

constexpr std::int64_t CountPieces(Run const& run) {
  return run.begin < run.end ? (run.end - run.begin + run.stride - 1) / run.stride : 0;
}

class PairwiseCheck {
 public:
  PairwiseCheck(Flat::Data const& data, std::vector<Run> const& runs, ArcSteps const& arcSteps)
      : data_(data), runs_(runs), arcSteps_(arcSteps) {}

  Verdict Check(std::size_t plainSize) const {
    std::int64_t pieces = 0;
    for (Run const& run : runs_) pieces += CountPieces(run);
    bool const isLong = pieces > 0 && static_cast<std::uint64_t>(pieces) > plainSize;
    return isLong && AreAllPairsValid() ? CrossingIf(HasCrossing()) : WalkAllPairs();
  }

 private:
  Verdict WalkAllPairs() const {
    for (std::size_t r = 0; r < runs_.size(); ++r) {
      for (std::int64_t q = runs_[r].begin; q < runs_[r].end; q += runs_[r].stride) {
        Verdict const verdict = CheckPiece(r, {q, runs_[r].kind});
        if (verdict.IsFinal()) return verdict;
      }
    }
    return {};
  }

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

  /// Certain only when true.
  bool AreAllPairsValid() const {
    bool const hasStraight = std::any_of(
        runs_.begin(), runs_.end(), [](Run const& run) { return run.kind == Flat::kVertexRun; });
    for (std::size_t r = 0; r < runs_.size(); ++r) {
      if (CountPieces(runs_[r]) == 0) continue;
      if (!IsValid(runs_[r], hasStraight)) return false;
      for (Run const& stretch : LaterStretches(r)) {
        if (!IsValid(stretch, hasStraight)) return false;
      }
    }
    return true;
  }

  bool IsValid(Run const& run, bool hasStraight) const {
    std::int64_t const count = CountPieces(run);
    if (count == 0) return true;
    if (!IsInside({run.begin, run.kind})) return false;
    if (!IsInside({run.begin + (count - 1) * run.stride, run.kind})) return false;
    if (run.kind == Flat::kVertexRun) return true;
    for (std::int64_t q = run.begin; q < run.end; q += run.stride) {
      Arc const arc = ArcAt(q);
      if (arc.radius <= 0.0 || (hasStraight && arc.startAngle == arc.endAngle)) return false;
    }
    return true;
  }

  /// What the pieces of a run are compared with after it: for either layout the longest stretch.
  std::vector<Run> LaterStretches(std::size_t r) const {
    std::vector<Run> stretches;
    for (std::int32_t const kind : {Flat::kVertexRun, Flat::kRecordRun}) {
      Run longest{kind, 0, runs_[r].end, runs_[r].end};
      for (std::size_t m = r + 1; m < runs_.size(); ++m) {
        if (runs_[m].kind != kind) continue;
        longest.stride = runs_[m].stride;
        longest.end = std::max(longest.end, runs_[m].end);
      }
      if (longest.begin < longest.end) stretches.push_back(longest);
    }
    return stretches;
  }

  bool HasCrossing() const {
    for (std::size_t r = 0; r < runs_.size(); ++r) {
      if (CountPieces(runs_[r]) == 0) continue;
      if (HasCrossingWithin(runs_[r])) return true;
      for (Run const& stretch : LaterStretches(r)) {
        if (HasCrossingBetween(runs_[r], stretch)) return true;
      }
    }
    return false;
  }

  bool HasCrossingWithin(Run const& run) const {
    // As in CheckPiece: the straight piece right after is passed over.
    std::size_t const steps = run.kind == Flat::kVertexRun ? 2 : 1;
    Pieces const pieces(*this, run);
    return Contours::AnyPair(pieces.GetShapes(), [&](std::size_t i, std::size_t k) {
      return k >= i + steps && TestPair(PieceOf(run, i), PieceOf(run, k)).isCrossing;
    });
  }

  bool HasCrossingBetween(Run const& run, Run const& stretch) const {
    if (CountPieces(run) <= kShortRun) {
      for (std::int64_t q = run.begin; q < run.end; q += run.stride) {
        if (CheckAgainst({q, run.kind}, stretch, stretch.begin).isCrossing) return true;
      }
      return false;
    }
    Pieces const first(*this, run);
    Pieces const second(*this, stretch);
    return Contours::AnyPair(first.GetShapes(), second.GetShapes(),
                             [&](std::size_t i, std::size_t k) {
                               return TestPair(PieceOf(run, i), PieceOf(stretch, k)).isCrossing;
                             });
  }

  static Piece PieceOf(Run const& run, std::size_t number) {
    return {run.begin + static_cast<std::int64_t>(number) * run.stride, run.kind};
  }

  /// The pieces of a run in the form that the search takes.
  class Pieces {
   public:
    Pieces(PairwiseCheck const& check, Run const& run) {
      auto const count = static_cast<std::size_t>(CountPieces(run));
      shapes_.reserve(count);
      if (run.kind == Flat::kRecordRun) arcs_.reserve(count);
      for (std::int64_t q = run.begin; q < run.end; q += run.stride) {
        Point const start = check.VertexAt(q);
        if (run.kind == Flat::kVertexRun) {
          shapes_.push_back({start, check.EndOfStraight({q, run.kind}), nullptr});
        } else {
          arcs_.push_back(check.ArcAt(q));
          shapes_.push_back({start, start, &arcs_.back()});
        }
      }
    }
    Pieces(Pieces const&) = delete;
    Pieces& operator=(Pieces const&) = delete;

    std::vector<Contours::Shape> const& GetShapes() const { return shapes_; }

   private:
    std::vector<Arc> arcs_;
    std::vector<Contours::Shape> shapes_;
  };

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

Contours::FlatVerdict Contours::CheckRuns(Flat::Data const& data, std::vector<FlatRun> const& runs,
                                          ArcSteps const& arcSteps, std::size_t plainSize) {
  return PairwiseCheck(data, runs, arcSteps).Check(plainSize);
}

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

  std::vector<Contours::FlatRun> runs;
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
  Verdict const verdict =
      Contours::CheckRuns(Flat::Data(coords), runs, arcSteps, Contours::kPlainSize);
  if (verdict.code != ErrorCode::Ok) return verdict.code;
  if (found == nullptr) return ErrorCode::Failed;
  *found = verdict.isCrossing;
  return ErrorCode::Ok;
}

}  // namespace Vorn
