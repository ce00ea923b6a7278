// The readers of contours and points on any bytes: an answer or a failure that says where.
#include <array>
#include <cstdint>
#include <string>

#include "Input.h"
#include "Require.h"
#include "Texts.h"
#include "vorn/io/ContourFile.h"
#include "vorn/io/Failure.h"
#include "vorn/io/Formats.h"
#include "vorn/io/Points.h"

namespace Vorn::Fuzz {
namespace {

constexpr std::array kFormats = {IO::Format::Json, IO::Format::Csv, IO::Format::Dxf,
                                 IO::Format::GCode, IO::Format::Wkt};

}  // namespace
}  // namespace Vorn::Fuzz

extern "C" int LLVMFuzzerTestOneInput(std::uint8_t const* data, std::size_t size) {
  namespace Fuzz = Vorn::Fuzz;
  namespace IO = Vorn::IO;
  Fuzz::Input input(data, size);
  std::uint8_t const kind = input.Byte();
  std::string const text = input.Rest();
  try {
    if (kind % 8 < Fuzz::kFormats.size()) {
      Fuzz::RequireSound(IO::ParseContour(text, "f", Fuzz::kFormats[kind % 8]));
    } else {
      IO::PointFile const file =
          IO::ParsePoints(text, "f", {IO::ToleranceColumn::Use::IfPresent, "w"});
      Fuzz::Require(file.points.size() >= 2, "a points file has two points or more");
      Fuzz::Require(file.lines.size() == file.points.size(), "every point has its line");
    }
  } catch (IO::Failure const& failure) {
    Fuzz::RequirePlace(failure);
  }
  return 0;
}
