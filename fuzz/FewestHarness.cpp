// The fewest pieces: every promise measured on the answer, nothing written on failure, and the
// same answer at every call.
#include <cstdint>
#include <cstring>
#include <vector>

#include "Input.h"
#include "Require.h"
#include "geometry/fewest/promises/Promises.h"
#include "support/Transcript.h"
#include "vorn/FewestPieces.h"

namespace Vorn::Fuzz {
namespace {

/// Of most inputs, so that many are tried: a search of 48 points takes some ten times as long.
constexpr int kMostPointsAsARule = 20;
constexpr int kMostPoints = 48;

FewestPieces::Options MakeOptions(Input* input) {
  FewestPieces::Options options;
  options.effort = FewestPieces::Effort{input->Integer(0, 2)};
  options.centre = input->Flip();
  options.closed = input->Flip();
  options.segmentsOnly = input->Byte() % 8 == 0;
  if (input->Byte() % 4 == 0) options.largestStep = 0.25 * input->Integer(1, 12);
  if (input->Byte() % 8 == 0) options.smallestRadius = 0.5 * input->Integer(0, 8);
  if (input->Byte() % 8 == 0)
    options.largestRadius = options.smallestRadius + input->Integer(1, 50);
  if (input->Byte() % 8 == 0) options.farthestBetweenPoints = 0.05 * input->Integer(0, 20);
  return options;
}

std::string TextOf(FewestPieces::Result const& result) {
  Testing::Transcript transcript;
  transcript.Add("contour", result.contour);
  transcript.Add("deviation", result.largestDeviation);
  transcript.Add("index", result.largestDeviationIndex);
  transcript.Add("fewest", result.fewestPossible);
  transcript.Add("isFewest", result.isFewest);
  for (FewestPieces::Range const& range : result.ranges) {
    transcript.Add("first", range.first);
    transcript.Add("last", range.last);
  }
  return transcript.Text();
}

void RequirePromises(std::vector<WPoint> const& points, FewestPieces::Options const& options,
                     FewestPieces::Result const& result) {
  Promises::Report const report =
      Promises::Measure({points, result.contour, result.ranges, options.closed, options.largestStep,
                         options.farthestBetweenPoints});
  Require(report.violations.empty(), "every promise is kept");
  auto const pieces = static_cast<std::int32_t>(result.ranges.size());
  Require(result.fewestPossible >= 1 && result.fewestPossible <= pieces,
          "the bound does not exceed the number of pieces");
  Require(result.isFewest == (result.fewestPossible == pieces), "isFewest says whether both agree");
  for (GeometryUtils::Elem const& elem : result.contour) {
    if (elem.type != GeometryUtils::ElemType::Arc) continue;
    Require(!options.segmentsOnly, "no arcs where none are wanted");
    Require(elem.radius >= options.smallestRadius && elem.radius <= options.largestRadius,
            "radii are in their range");
  }
}

}  // namespace
}  // namespace Vorn::Fuzz

extern "C" int LLVMFuzzerTestOneInput(std::uint8_t const* data, std::size_t size) {
  namespace Fuzz = Vorn::Fuzz;
  using Vorn::FewestPieces;
  Fuzz::Input input(data, size);
  FewestPieces::Options const options = Fuzz::MakeOptions(&input);
  bool const isSpoilt = input.Byte() % 8 == 0;
  int const most = input.Byte() % 8 == 0 ? Fuzz::kMostPoints : Fuzz::kMostPointsAsARule;
  std::vector<Vorn::WPoint> points =
      input.PathOfRest(most, isSpoilt ? Fuzz::Input::kBytesToSpoil : 0);
  if (isSpoilt) input.Spoil(&points);
  FewestPieces::Result result;
  std::string const untouched = Fuzz::TextOf(result);
  Vorn::ErrorCode const code = FewestPieces::Fit(points, options, &result, nullptr, 100);
  if (code != Vorn::ErrorCode::Ok) {
    Fuzz::Require(Fuzz::TextOf(result) == untouched, "a failure leaves the result untouched");
    return 0;
  }
  Fuzz::RequirePromises(points, options, result);
  FewestPieces::Result again;
  Fuzz::Require(FewestPieces::Fit(points, options, &again, nullptr, 100) == code &&
                    Fuzz::TextOf(again) == Fuzz::TextOf(result),
                "a second fit is the same");
  return 0;
}
