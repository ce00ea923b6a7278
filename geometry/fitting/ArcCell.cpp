#include "geometry/fitting/ArcCell.h"

#include <cstddef>

#include "geometry/fitting/Runs.h"

namespace Vorn {

using Fitting::At;
using Fitting::ToPoint;

ArcCellBuilder::ArcCellBuilder(Fitting::ArcRun const& run, bool ccw,
                               std::vector<IndexedPoint>* samples, Cells::CellSequence* cell)
    : run_(run), ccw_(ccw), samples_(*samples), cell_(*cell) {}

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
  bool isFirstCell = true;
  int const size = static_cast<int>(samples_.size());
  Fitting::UsedSamples used(samples_.size());
  if (isLed) {
    Fitting::Triple const spanning{0, (size - 1) / 2, size - 1};
    used.Mark(spanning);
    ErrorCode const code = NarrowBy(spanning, &isFirstCell);
    if (code != ErrorCode::Ok) return code;
  }
  for (int step = 1; step <= (size - 1) / 2; ++step) {
    for (int mirror = 0; mirror < 2; ++mirror) {
      Fitting::Triple triple{};
      GeometryUtils::GetTriPointIndices(step, size, mirror, &triple.i0, &triple.i1, &triple.i2);
      if (!used.Mark(triple)) continue;
      ErrorCode const code = NarrowBy(triple, &isFirstCell);
      if (code != ErrorCode::Ok) return code;
      if (isGuarded && Fitting::IsOversized(cell_.size(), Fitting::kArcCellWeight)) {
        *hasThinned = true;
        return Thin(step);
      }
    }
  }
  return ErrorCode::Ok;
}

ErrorCode ArcCellBuilder::Thin(int steps) {
  GeometryUtils::Point centre;
  if (!cell_.Center(&centre)) return ErrorCode::Failed;
  ErrorCode const code = Fitting::ThinSamples(run_, centre, steps, ccw_, &samples_);
  if (code == ErrorCode::Ok) cell_.clear();
  return code;
}

ErrorCode ArcCellBuilder::NarrowBy(Fitting::Triple const& triple, bool* isFirstCell) {
  tripleCell_.clear();
  ErrorCode const code = CellOf(triple, &tripleCell_);
  if (code != ErrorCode::Ok) return code;
  if (*isFirstCell) {
    *isFirstCell = false;
    cell_ = Cells::CellSequence(tripleCell_);
    return ErrorCode::Ok;
  }
  cell_.NarrowBy(tripleCell_);
  return cell_.empty() ? ErrorCode::NoFit : ErrorCode::Ok;
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
