#include "geometry/fitting/arc/ArcCell.h"

#include <cstddef>
#include <optional>

#include "geometry/fitting/runs/CellBudget.h"
#include "geometry/triangles/Overlap.h"

namespace Vorn::Fitting {

namespace {

bool IsOversizedArcCell(std::size_t cellSize) { return IsOversized(cellSize, kArcCellWeight); }

}  // namespace

/// A leading triple, if any, then the triples of every step and their mirror images, but for those
/// whose samples have all been used before.
class ArcCellBuilder::Triples {
 public:
  Triples(std::size_t sampleCount, bool isLed)
      : size_(static_cast<int>(sampleCount)), used_(sampleCount), isLeading_(isLed) {}

  /// Goes on to the next triple. False when there is none.
  bool Next() {
    if (isLeading_) {
      isLeading_ = false;
      triple_ = {0, (size_ - 1) / 2, size_ - 1};
      used_.Mark(triple_);
      return true;
    }
    for (;;) {
      if (isMirrored_) ++step_;
      isMirrored_ = !isMirrored_;
      if (step_ > (size_ - 1) / 2) return false;
      triple_ = TripleOf(step_, size_, isMirrored_);
      if (used_.Mark(triple_)) return true;
    }
  }

  Triple const& Current() const { return triple_; }

  /// Zero for a leading triple.
  int Step() const { return step_; }

 private:
  int const size_;
  UsedSamples used_;
  bool isLeading_;
  int step_ = 0;
  bool isMirrored_ = true;
  Triple triple_;
};

ArcCellBuilder::ArcCellBuilder(ArcRun const& arcRun, bool ccw, AfterFailure afterFailure,
                               ArcCell* cell)
    : arcRun_(arcRun),
      ccw_(ccw),
      afterFailure_(afterFailure),
      samples_(cell->samples),
      centres_(cell->centres) {}

ErrorCode ArcCellBuilder::Build() {
  CollectSamples();
  bool isFirstPass = true;
  bool isGuarded = true;
  for (;;) {
    std::size_t const sizeBefore = samples_.size();
    bool hasThinned = false;
    ErrorCode const code = RunPass(!isFirstPass, isGuarded, &hasThinned);
    if (code != ErrorCode::Ok || !hasThinned) return code;
    isFirstPass = false;
    isGuarded = samples_.size() < sizeBefore;
  }
}

void ArcCellBuilder::CollectSamples() {
  std::int32_t const count = arcRun_.run.count;
  if (samples_.empty()) {
    for (std::int32_t i = 0; i < count; ++i) samples_.push_back(SampleOf(i));
    return;
  }
  samples_.front() = SampleOf(0);
  samples_.push_back(SampleOf(count - 1));
}

GeometryUtils::IndexedPoint ArcCellBuilder::SampleOf(std::int32_t position) const {
  Run const& run = arcRun_.run;
  return {run.PointAt(position), run[position].w, run.first + position};
}

ErrorCode ArcCellBuilder::RunPass(bool isLed, bool isGuarded, bool* hasThinned) {
  centres_.clear();
  Triples triples(samples_.size(), isLed);
  if (!triples.Next()) return ErrorCode::Ok;
  Cells::CircleCell tripleCell;
  ErrorCode code = CellOf(triples.Current(), &tripleCell);
  if (code != ErrorCode::Ok) return code;

  // Always one cell ahead: most tries over points that hardly bend end at a triple without a cell,
  // and there the narrowing before, the most expensive one, would be in vain.
  Cells::CircleCell nextCell;
  for (bool isFirst = true;; isFirst = false) {
    int const step = triples.Step();
    bool const isLast = !triples.Next();
    nextCell.clear();
    if (!isLast) code = CellOf(triples.Current(), &nextCell);
    if (isFirst) {
      centres_.Begin(tripleCell);
    } else {
      bool const endsHere = code != ErrorCode::Ok && afterFailure_ == AfterFailure::NoCell;
      if (endsHere && StaysUsable(tripleCell, isGuarded)) return code;
      centres_.NarrowBy(tripleCell);
      if (centres_.empty()) return ErrorCode::NoFit;
    }
    bool const isLeading = step == 0;
    if (!isLeading && isGuarded && IsOversizedArcCell(centres_.size())) {
      *hasThinned = true;
      return Thin(step);
    }
    if (isLast || code != ErrorCode::Ok) return code;
    tripleCell = nextCell;
  }
}

bool ArcCellBuilder::StaysUsable(Cells::CircleCell const& tripleCell, bool isGuarded) const {
  std::size_t const mostTriangles = centres_.size() * tripleCell.size() * Triangles::kMostParts;
  bool const staysSmall = !isGuarded || !IsOversizedArcCell(mostTriangles);
  return staysSmall && centres_.Overlaps(tripleCell);
}

ErrorCode ArcCellBuilder::Thin(int steps) {
  ThinningTask const task{arcRun_, ccw_, steps};
  std::optional<ErrorCode> code;
  if (std::optional<Cells::RoughCentre> const rough = centres_.FindRoughCentre()) {
    code = ThinSamples(task, *rough, &samples_);
  }
  if (!code) {
    std::optional<Point> const centre = centres_.Centre();
    if (!centre) return ErrorCode::Failed;
    code = ThinSamples(task, *centre, &samples_);
  }
  if (*code == ErrorCode::Ok) centres_.clear();
  return *code;
}

ErrorCode ArcCellBuilder::CellOf(Triple const& triple, Cells::CircleCell* cell) const {
  TriplePoints const points(samples_, triple, arcRun_.ends);
  auto const withTolerance = [this](Point const& p, int position) {
    return WPoint{p.x, p.y, ToleranceAt(position)};
  };
  return Cells::FindCircleCell(
      {withTolerance(points.first, triple.i0), withTolerance(points.middle, triple.i1),
       withTolerance(points.last, triple.i2), points.usesStart, points.usesEnd},
      cell);
}

double ArcCellBuilder::ToleranceAt(int position) const {
  return samples_[static_cast<std::size_t>(position)].w;
}

}  // namespace Vorn::Fitting
