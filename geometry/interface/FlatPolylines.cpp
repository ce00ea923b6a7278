// Members for flat polylines: area and self-intersection.

#include <cstdint>
#include <optional>

#include "geometry/contours/FlatArea.h"
#include "geometry/contours/FlatLayout.h"
#include "geometry/contours/FlatSelfIntersection.h"
#include "geometry/contours/SelfIntersection.h"
#include "vorn/GeometryUtils.h"

namespace Vorn {

namespace {

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

ErrorCode GeometryUtils::GetArea(std::vector<double> const& coords,
                                 std::vector<std::int32_t> const& indices, double* area) {
  std::optional<double> const signedArea = Flat::SignedArea(Flat::Data(coords), indices);
  if (!signedArea || area == nullptr) return ErrorCode::Failed;
  *area = *signedArea;
  return ErrorCode::Ok;
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

  Flat::Verdict const verdict =
      Flat::CheckRuns(Flat::Data(coords), Flat::RunsOf(indices), Contours::kPlainSize);
  if (verdict.code != ErrorCode::Ok) return verdict.code;
  if (found == nullptr) return ErrorCode::Failed;
  *found = verdict.isCrossing;
  return ErrorCode::Ok;
}

}  // namespace Vorn
