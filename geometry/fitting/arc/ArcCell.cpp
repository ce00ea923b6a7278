#include "geometry/fitting/arc/ArcCell.h"

#include <cstddef>
#include <optional>

#include "geometry/fitting/Runs.h"

namespace Vorn {

using Fitting::At;
using Fitting::ToPoint;

namespace {

bool IsOversized(std::size_t cellSize) {
  return Fitting::IsOversized(cellSize, Fitting::kArcCellWeight);
}

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
      if (mirror_ == 1) ++step_;
      mirror_ = 1 - mirror_;
      if (step_ > (size_ - 1) / 2) return false;
      GeometryUtils::GetTriPointIndices(step_, size_, mirror_, &triple_.i0, &triple_.i1,
                                        &triple_.i2);
      if (used_.Mark(triple_)) return true;
    }
  }

  Fitting::Triple const& Current() const { return triple_; }

  /// Zero for a leading triple.
  int Step() const { return step_; }

 private:
  int const size_;
  Fitting::UsedSamples used_;
  bool isLeading_;
  int step_ = 0;
  int mirror_ = 1;
  Fitting::Triple triple_{};
};

ArcCellBuilder::ArcCellBuilder(Fitting::ArcRun const& run, bool ccw, AfterFailure afterFailure,
                               std::vector<IndexedPoint>* samples, Cells::CellSequence* cell)
    : run_(run), ccw_(ccw), afterFailure_(afterFailure), samples_(*samples), cell_(*cell) {}

void ArcCellBuilder::CollectSamples() {
  if (samples_.empty()) {
    for (std::int32_t i = 0; i < run_.count; ++i) samples_.push_back(SampleOf(run_.first + i));
    return;
  }
  samples_.front() = SampleOf(run_.first);
  samples_.push_back(SampleOf(run_.first + run_.count - 1));
}

ErrorCode ArcCellBuilder::Build() {
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

ArcCellBuilder::IndexedPoint ArcCellBuilder::SampleOf(std::int32_t index) const {
  WPoint const& p = At(run_.points, index);
  return {ToPoint(p), p.w, index};
}

ErrorCode ArcCellBuilder::RunPass(bool isLed, bool isGuarded, bool* hasThinned) {
  cell_.clear();
  Triples triples(samples_.size(), isLed);
  if (!triples.Next()) return ErrorCode::Ok;
  std::vector<Triangle> tripleCell;
  ErrorCode code = CellOf(triples.Current(), &tripleCell);
  if (code != ErrorCode::Ok) return code;

  // Always one cell ahead: most tries over points that hardly bend end at a triple without a cell,
  // and there the narrowing before, the most expensive one, would be in vain.
  std::vector<Triangle> nextCell;
  for (bool isFirst = true;; isFirst = false) {
    int const step = triples.Step();
    bool const isLast = !triples.Next();
    nextCell.clear();
    if (!isLast) code = CellOf(triples.Current(), &nextCell);
    if (isFirst) {
      cell_.Begin(tripleCell);
    } else {
      bool const endsHere = code != ErrorCode::Ok && afterFailure_ == AfterFailure::NoCell;
      if (endsHere && StaysUsable(tripleCell, isGuarded)) return code;
      cell_.NarrowBy(tripleCell);
      if (cell_.empty()) return ErrorCode::NoFit;
    }
    bool const isLeading = step == 0;
    if (!isLeading && isGuarded && IsOversized(cell_.size())) {
      *hasThinned = true;
      return Thin(step);
    }
    if (isLast || code != ErrorCode::Ok) return code;
    tripleCell.swap(nextCell);
  }
}

bool ArcCellBuilder::StaysUsable(std::vector<Triangle> const& tripleCell, bool isGuarded) const {
  std::size_t const mostTriangles = cell_.size() * tripleCell.size() * Cells::kMostParts;
  bool const staysSmall = !isGuarded || !IsOversized(mostTriangles);
  return staysSmall && cell_.Overlaps(tripleCell);
}

ErrorCode ArcCellBuilder::Thin(int steps) {
  std::optional<ErrorCode> code;
  if (std::optional<Cells::RoughCentre> const rough = cell_.FindRoughCentre()) {
    code = Fitting::ThinSamples(run_, *rough, steps, ccw_, &samples_);
  }
  if (!code) {
    GeometryUtils::Point centre;
    if (!cell_.Center(&centre)) return ErrorCode::Failed;
    code = Fitting::ThinSamples(run_, centre, steps, ccw_, &samples_);
  }
  if (*code == ErrorCode::Ok) cell_.clear();
  return *code;
}

ErrorCode ArcCellBuilder::CellOf(Fitting::Triple const& triple, std::vector<Triangle>* cell) const {
  bool usesStart = false;
  bool usesEnd = false;
  double coords[6];
  GeometryUtils::TriPointsCoordsToArray(&samples_, triple.i0, triple.i1, triple.i2, run_.startFixed,
                                        run_.start, run_.endFixed, run_.end, &usesStart, &usesEnd,
                                        coords);
  return GeometryUtils::GetCircleTriangles({coords[0], coords[1], ToleranceAt(triple.i0)},
                                           {coords[2], coords[3], ToleranceAt(triple.i1)},
                                           {coords[4], coords[5], ToleranceAt(triple.i2)},
                                           usesStart, usesEnd, 0, cell);
}

double ArcCellBuilder::ToleranceAt(int position) const {
  return samples_[static_cast<std::size_t>(position)].w;
}

}  // namespace Vorn
