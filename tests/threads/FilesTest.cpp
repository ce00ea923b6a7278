// Readers, writers, fits and drawings of files on several threads at once.
#include <array>
#include <string>
#include <vector>

#include "gtest/gtest.h"
#include "support/Profiles.h"
#include "threads/ThreadsAtOnce.h"
#include "vorn/io/Drawing.h"
#include "vorn/io/Failure.h"
#include "vorn/io/FitContour.h"
#include "vorn/io/Formats.h"
#include "vorn/io/Intersections.h"
#include "vorn/io/PointOutlines.h"

namespace Vorn::IO {
namespace {

using Testing::kThreads;

std::string TableOf(std::vector<WPoint> const& points) {
  std::string text = "x,y,w\n";
  for (WPoint const& point : points) {
    text += std::to_string(point.x) + "," + std::to_string(point.y) + "," +
            std::to_string(0.5 * point.w + 1e-4) + "\n";
  }
  return text;
}

std::string Written(ContourFile const& contour, Format format) {
  WriteOptions options;
  options.chords = 0.01;
  options.svgPlain = true;
  options.gcode.feed = 100.0;
  return ToText(contour, format, options);
}

/// All that becomes of the contour in a format: its text, and how much is read from it.
std::string Exchanged(ContourFile const& contour, Format format) {
  std::string const text = Written(contour, format);
  std::string counts = std::to_string(ParseContour(text, "f", format).pieces.size());
  if (format != Format::Csv) {
    PointReading reading;
    reading.format = format;
    reading.flattening = 0.01;
    counts += std::to_string(ParsePointOutlines(text, "f", reading).front().points.size());
  }
  return text + counts;
}

/// All that a program makes of one table of points.
std::string Worked(std::string const& table) {
  std::string text;
  for (Strategy const strategy :
       {Strategy::Mixed, Strategy::Cells, Strategy::Arc, Strategy::Fewest}) {
    FitChoice choice;
    choice.strategy = strategy;
    try {
      FitReport const report = FitContour(
          ParsePoints(table, "f", {ToleranceColumn::Use::IfPresent, "w"}), choice, nullptr);
      Drawing const drawing = DrawingOf(report);
      text += ToJson(report) + ToSvg(drawing) + ToHtml(drawing);
      ContourFile contour;
      contour.path = "f";
      contour.pieces = drawing.pieces;
      text += std::to_string(SelfIntersectionsOf(contour).size());
      for (Format const format : {Format::Json, Format::Csv, Format::Dxf, Format::GCode,
                                  Format::Wkt, Format::GeoJson, Format::Svg}) {
        text += Exchanged(contour, format);
      }
    } catch (Failure const& failure) {
      text += failure.what();
    }
  }
  return text;
}

TEST(FilesOnSeveralThreads, GiveTheSameTexts) {
  constexpr int kTables = 6;
  Testing::RandomGeometry random(5);
  std::vector<std::string> tables = {"x,y\n1,2\n3,four\n"};
  for (int i = 0; i < kTables; ++i) tables.push_back(TableOf(MakeProfile(&random, 40)));
  std::array<std::string, kThreads> texts;
  Testing::RunAtOnce([&](std::size_t thread) {
    for (std::string const& table : tables) texts[thread] += Worked(table);
  });
  EXPECT_GT(texts[0].size(), 100000u) << "most tables were fitted";
  EXPECT_EQ(texts[0], texts[1]);
  EXPECT_EQ(texts[0], texts[2]);
}

}  // namespace
}  // namespace Vorn::IO
