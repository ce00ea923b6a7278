#include "geometry/cells/fast/CellSequence.h"

#include "geometry/cells/fast/ChordCutter.h"
#include "geometry/cells/fast/Cutter.h"
#include "geometry/cells/fast/LevelBuilder.h"
#include "math/Assert.h"

namespace Vorn::Cells {

using Triangles::Overlap;

CellLevel* CellSequence::AddLevel() {
  if (depth_ == levels_.size()) levels_.emplace_back();
  return &levels_[depth_++];
}

void CellSequence::Begin(std::span<Triangle const> triangles) {
  clear();
  std::vector<std::size_t> const once = {1};
  CellLevel* const first = AddLevel();
  first->magnitude = {};
  first->magnitude.Include(triangles);
  LevelBuilder builder(once, first);
  for (Triangle const& triangle : triangles) builder.Add(triangle);
  builder.EndWord();
}

void CellSequence::NarrowBy(std::span<Triangle const> other) {
  if (depth_ == 0) return;
  CellLevel* const next = AddLevel();
  CellLevel const& last = levels_[depth_ - 2];
  std::vector<Cutter> cutters;
  cutters.reserve(other.size());
  for (Triangle const& triangle : other) cutters.emplace_back(triangle, last.magnitude);

  next->magnitude = last.magnitude;
  next->magnitude.Include(other);
  LevelBuilder builder(last.counts, next);
  Overlap overlap;
  for (BoxedTriangle const& boxed : last.triangles) {
    for (Cutter const& cutter : cutters) {
      if (cutter.Cut(boxed, &overlap) == Cutter::Rest::Whole) {
        builder.Keep(boxed, Triangles::kCopiesOfContained);
      } else {
        for (Triangle const& part : overlap.parts) builder.Add(part);
      }
    }
    builder.EndWord();
  }
}

bool CellSequence::Overlaps(std::span<Triangle const> other) const {
  if (depth_ == 0) return false;
  Overlap overlap;
  for (Triangle const& triangle : other) {
    Cutter const cutter(triangle, Last().magnitude);
    for (BoxedTriangle const& boxed : Last().triangles) {
      bool const isWhole = cutter.Cut(boxed, &overlap) == Cutter::Rest::Whole;
      if (isWhole || !overlap.parts.empty()) return true;
    }
  }
  return false;
}

void CellSequence::ReturnTo(std::size_t depth) {
  VORN_ASSERT(depth <= depth_);
  depth_ = depth;
}

CellLevel CellSequence::OverlapWith(Triangle const& candidate) const {
  CellLevel level;
  ChordCutter const cutter(candidate, Last().magnitude);
  LevelBuilder builder(Last().counts, &level);
  Overlap overlap;
  for (BoxedTriangle const& boxed : Last().triangles) {
    cutter.FindOverlapWith(boxed, &overlap);
    for (Triangle const& part : overlap.parts) builder.Add(part);
    builder.EndWord();
  }
  return level;
}

std::optional<Rect> CellSequence::BoundingRect() const {
  if (empty()) return std::nullopt;
  // Letters stand in the order in which they first occur, so the first of equal extremes is the
  // same as in a run over all copies.
  std::vector<BoxedTriangle> const& triangles = Last().triangles;
  Rect rect = Rect::Around(triangles.front().triangle.pts[0]);
  for (BoxedTriangle const& boxed : triangles) rect.Include(boxed.triangle);
  return rect;
}

WordChain CellSequence::Chain() const {
  WordChain chain;
  chain.levels.reserve(depth_ + 1);
  for (CellLevel const& level : Levels()) chain.Append(level.words, level.size);
  return chain;
}

std::optional<Point> CellSequence::Centre() const {
  if (empty()) return std::nullopt;
  return CentreOfSequence(Chain(), Last());
}

std::optional<RoughCentre> CellSequence::FindRoughCentre() const {
  if (empty()) return std::nullopt;
  return RoughCentreOf(Last());
}

std::optional<Point> CellSequence::CentreOfOverlapWith(Triangle const& candidate) const {
  if (empty()) return std::nullopt;
  CellLevel const overlap = OverlapWith(candidate);
  if (overlap.size == 0) return std::nullopt;
  WordChain chain = Chain();
  chain.Append(overlap.words, overlap.size);
  return CentreOfSequence(chain, overlap);
}

std::vector<Triangle> CellSequence::Expand() const {
  if (depth_ == 0) return {};
  std::vector<Letter> letters = {0};
  for (CellLevel const& level : Levels()) {
    std::vector<Letter> next;
    next.reserve(level.size);
    for (Letter const letter : letters) {
      for (Letter const replacement : level.words.Of(letter)) next.push_back(replacement);
    }
    letters.swap(next);
  }
  std::vector<Triangle> triangles;
  triangles.reserve(letters.size());
  for (Letter const letter : letters) triangles.push_back(Last().triangles[letter].triangle);
  return triangles;
}

}  // namespace Vorn::Cells
