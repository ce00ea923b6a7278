// The arc fitters against a plain second implementation, bit for bit.
#include <cstdint>

#include "Input.h"
#include "Require.h"
#include "support/FittingCalls.h"
#include "support/ReferenceFitting.h"

namespace Vorn::Fuzz {
namespace {

using Testing::ReferenceFitting;

Testing::ArcFitInput MakeCall(Input* input) {
  Testing::ArcFitInput call;
  call.first = input->Integer(0, 3);
  call.minCount = input->Integer(3, 5);
  call.startFixed = input->Flip();
  call.start = input->PointOnGrid();
  call.endFixed = input->Flip();
  call.end = input->PointOnGrid();
  bool const isSpoilt = input->Byte() % 8 == 0;
  call.points = input->Path(16);
  if (isSpoilt) input->Spoil(&call.points);
  call.maxCount = static_cast<std::int32_t>(call.points.size()) - call.first;
  return call;
}

}  // namespace
}  // namespace Vorn::Fuzz

extern "C" int LLVMFuzzerTestOneInput(std::uint8_t const* data, std::size_t size) {
  namespace Testing = Vorn::Testing;
  namespace Fuzz = Vorn::Fuzz;
  using Vorn::GeometryUtils;
  Fuzz::Input input(data, size);
  Testing::ArcFitInput const call = Fuzz::MakeCall(&input);
  if (call.maxCount < call.minCount) return 0;
  Fuzz::Require(Transcribe(Testing::FitArcRun<GeometryUtils>(call)) ==
                    Transcribe(Testing::FitArcRun<Fuzz::ReferenceFitting>(call)),
                "the fitter of one run answers what the plain one answers");
  Fuzz::Require(Transcribe(Testing::GrowArc<GeometryUtils>(call)) ==
                    Transcribe(Testing::GrowArc<Fuzz::ReferenceFitting>(call)),
                "the growing fitter answers what the plain one answers");
  Fuzz::Require(Transcribe(Testing::ShrinkArc<GeometryUtils>(call)) ==
                    Transcribe(Testing::ShrinkArc<Fuzz::ReferenceFitting>(call)),
                "the shrinking fitter answers what the plain one answers");
  return 0;
}
