// Whole fits with the three strategies: the same answer at every call, and with two of them that of
// a plain second implementation, bit for bit.
#include <cstdint>

#include "Input.h"
#include "Require.h"
#include "support/FittingCalls.h"
#include "support/ReferenceFitting.h"

extern "C" int LLVMFuzzerTestOneInput(std::uint8_t const* data, std::size_t size) {
  namespace Testing = Vorn::Testing;
  using Vorn::GeometryUtils;
  using Vorn::Fuzz::Require;
  Vorn::Fuzz::Input input(data, size);
  auto const strategy = GeometryUtils::FittingStrategy{input.Integer(0, 2)};
  bool const isSpoilt = input.Byte() % 8 == 0;
  std::vector<Vorn::WPoint> points = input.Path(20);
  if (isSpoilt) input.Spoil(&points);
  Testing::CurveFitOutput const fit = Testing::FitCurve<GeometryUtils>(points, strategy);
  std::string const answer = Transcribe(fit);
  // The plain implementation has the walks of Mixed and SingleArc.
  if (strategy != GeometryUtils::FittingStrategy::MixedCells) {
    Require(answer == Transcribe(Testing::FitCurve<Testing::ReferenceFitting>(points, strategy)),
            "a fit is what the plain one gives");
  }
  Require(answer == Transcribe(Testing::FitCurve<GeometryUtils>(points, strategy)),
          "a second fit is the same");
  if (fit.code == Vorn::ErrorCode::Ok) {
    Require(fit.contour.size() >= 2, "a fit has a start and a piece");
    Require(fit.contour.front().type == GeometryUtils::ElemType::Segment,
            "a contour begins with its start");
  }
  return 0;
}
