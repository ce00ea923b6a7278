// The line fitter against a plain second implementation, bit for bit.
#include <cstdint>

#include "Input.h"
#include "Require.h"
#include "support/FittingCalls.h"
#include "support/ReferenceFitting.h"

extern "C" int LLVMFuzzerTestOneInput(std::uint8_t const* data, std::size_t size) {
  namespace Testing = Vorn::Testing;
  Vorn::Fuzz::Input input(data, size);
  Testing::LineFitInput call;
  call.start = input.Integer(0, 3);
  call.startFixed = input.Flip();
  call.startPoint = input.PointOnGrid();
  call.endFixed = input.Flip();
  call.endPoint = input.PointOnGrid();
  call.lastAttempt = input.Flip();
  bool const isSpoilt = input.Byte() % 8 == 0;
  call.points = input.Path(24);
  if (isSpoilt) input.Spoil(&call.points);
  call.count = static_cast<std::int32_t>(call.points.size()) - call.start;
  if (call.count < 2) return 0;
  Vorn::Fuzz::Require(Transcribe(Testing::FitLine<Vorn::GeometryUtils>(call)) ==
                          Transcribe(Testing::FitLine<Testing::ReferenceFitting>(call)),
                      "the line fitter answers what the plain one answers");
  return 0;
}
