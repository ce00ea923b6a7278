// Reads, fits and writes a contour, and meets a bad line, as another project would.
#include <vorn/io/Drawing.h>
#include <vorn/io/Failure.h>
#include <vorn/io/FitContour.h>
#include <vorn/io/Formats.h>
#include <vorn/io/Points.h>

#include <cstdio>

namespace IO = Vorn::IO;

int main() {
  IO::FitChoice choice;
  choice.tolerance.same = 0.01;
  choice.closed = IO::ClosedChoice::No;
  IO::PointFile points = IO::ParsePoints("x,y\n0,0\n1,0\n2,0\n2,1\n2,2\n", "corner.csv", {});
  IO::FitReport const report = IO::FitContour(points, choice, nullptr);
  std::printf("%zu pieces\n", report.pieces.size());

  IO::ContourFile contour;
  contour.path = "corner";
  contour.pieces = {IO::MakeLine({0, 0}, {2, 0}), IO::MakeLine({2, 0}, {2, 2})};
  std::printf("%s", IO::ToText(contour, IO::Format::Wkt, {}).c_str());
  std::printf("%s\n", IO::ToSvg(IO::DrawingOf(contour)).substr(0, 5).c_str());
  try {
    IO::ParsePoints("x,y\n0,0\n1,one\n", "bad.csv", {});
  } catch (IO::Failure const& failure) {
    std::printf("%s\n", failure.what());
  }
}
