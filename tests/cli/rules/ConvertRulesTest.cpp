// What the help of `contour convert` says that each format keeps. The expected texts are written by
// hand for contours whose numbers have few digits.

#include <nlohmann/json.hpp>
#include <numbers>

#include "cli/FolderFixture.h"

namespace Vorn::Cli::Testing {
namespace {

using Words = std::vector<std::string>;

/// A line, a half circle of radius 2 about (4, 2), a line back.
constexpr char const* kHook =
    "# units mm\n# closed no\n"
    "type,start_x,start_y,end_x,end_y,center_x,center_y,radius,direction\n"
    "line,0,0,4,0,,,,\narc,4,0,4,4,4,2,2,ccw\nline,4,4,0,4,,,,\n";

constexpr char const* kGap = "MULTILINESTRING ((0 0, 1 0), (2 0, 3 0))";

RunResult Converted(std::string const& text, Words const& more) {
  Words words = {"convert", "-"};
  words.insert(words.end(), more.begin(), more.end());
  return RunInProcess(words, text);
}

std::string Text(std::string const& text, Words const& more) {
  RunResult const run = Converted(text, more);
  EXPECT_EQ(run.code, ExitCode::Ok) << run.err;
  return run.out;
}

TEST(ConvertRules, CsvKeepsEveryNumberUnitsAndWhetherItIsClosed) {
  EXPECT_EQ(Text(kHook, {"--to", "csv"}), kHook);
  std::string const exact =
      "# units inch\n# closed yes\n"
      "type,start_x,start_y,end_x,end_y,center_x,center_y,radius,direction\n"
      "line,0.1,0.30000000000000004,1e-300,123456789.12345679,,,,\n"
      "line,1e-300,123456789.12345679,0.1,0.30000000000000004,,,,\n";
  EXPECT_EQ(Text(exact, {"--to", "csv", "--from", "csv"}), exact);
}

TEST(ConvertRules, JsonTellsWhatFollowsFromThePieces) {
  auto const json = nlohmann::json::parse(Text(kHook, {"--to", "json"}));
  EXPECT_EQ(json.at("input").at("units"), "mm");
  EXPECT_EQ(json.at("closed"), false);
  EXPECT_EQ(json.at("counts"), nlohmann::json::parse(R"({"elements": 3, "lines": 2, "arcs": 1})"));
  auto const& arc = json.at("elements").at(1);
  EXPECT_EQ(arc.at("number"), 2);
  EXPECT_EQ(arc.at("radius"), 2.0);
  EXPECT_NEAR(arc.at("length").get<double>(), 2.0 * std::numbers::pi, 1e-15);
  EXPECT_EQ(Text(json.dump(), {"--to", "csv"}), kHook) << "nothing is lost on the way back";
}

TEST(ConvertRules, WktHasTheKindThatThePiecesNeed) {
  EXPECT_EQ(Text(kHook, {"--to", "wkt"}),
            "COMPOUNDCURVE ((0 0, 4 0), CIRCULARSTRING (4 0, 6 2, 4 4), (4 4, 0 4))\n");
  EXPECT_EQ(Text("LINESTRING (0 0, 1 2)", {"--to", "wkt"}), "LINESTRING (0 0, 1 2)\n");
  EXPECT_EQ(Text("CIRCULARSTRING (1 0, 0 1, -1 0)", {"--to", "wkt"}).substr(0, 15),
            "CIRCULARSTRING ");
  EXPECT_EQ(Text(kGap, {"--to", "wkt"}),
            "MULTICURVE (LINESTRING (0 0, 1 0), LINESTRING (2 0, 3 0))\n");
}

using ConvertRulesWithFiles = InFolder;

TEST_F(ConvertRulesWithFiles, APolygonWithHolesIsClosedAndHasNoGap) {
  std::string const file = PathOf("out.dxf");
  for (std::string const polygon :
       {"POLYGON ((0 0, 9 0, 9 9, 0 9, 0 0), (3 3, 6 3, 6 6, 3 6, 3 3))",
        R"({"type": "Polygon", "coordinates": [[[0, 0], [9, 0], [9, 9], [0, 9], [0, 0]],
                                              [[3, 3], [6, 3], [6, 6], [3, 6], [3, 3]]]})"}) {
    RunResult const run = Converted(polygon, {"-o", file});
    EXPECT_EQ(run.code, ExitCode::Ok);
    EXPECT_EQ(run.err, "");
    EXPECT_NE(run.out.find("pieces      8 pieces: 8 lines, 0 arcs; 2 closed outlines\n"),
              std::string::npos)
        << run.out;
  }
  RunResult const mixed =
      Converted("MULTILINESTRING ((0 0, 9 0, 9 9, 0 0), (20 0, 21 0))", {"-o", file});
  EXPECT_NE(mixed.out.find("; 1 closed outline, 1 open outline\n"), std::string::npos) << mixed.out;
  EXPECT_EQ(mixed.err, "");
}

TEST(ConvertRules, GCodeCutsPiecesAndMovesOverGaps) {
  EXPECT_EQ(Text(kHook, {"--to", "gcode", "--feed", "250"}),
            "G21\nG17 G90 G91.1\nG0 X0.0000 Y0.0000\nG1 X4.0000 Y0.0000 F250\n"
            "G3 X4.0000 Y4.0000 I0.0000 J2.0000\nG1 X0.0000 Y4.0000\nM2\n");
  EXPECT_EQ(Text(kGap, {"--to", "gcode", "--feed", "1", "--gcode-decimals", "0"}),
            "(units not known: neither G20 nor G21)\nG17 G90 G91.1\nG0 X0 Y0\nG1 X1 Y0 F1\n"
            "G0 X2 Y0\nG1 X3 Y0\nM2\n");
}

TEST(ConvertRules, GCodeHasFourDigitsOfMillimetresAndFiveOfInches) {
  auto const move = [](Words const& more) {
    Words words = {"--to", "gcode", "--feed", "1"};
    words.insert(words.end(), more.begin(), more.end());
    std::string const text = Text("LINESTRING (0.123456789 0, 1 0)", words);
    std::size_t const at = text.find("G0 ");
    return text.substr(at, text.find('\n', at) - at);
  };
  EXPECT_EQ(move({"--units", "mm"}), "G0 X0.1235 Y0.0000");
  EXPECT_EQ(move({"--units", "inch"}), "G0 X0.12346 Y0.00000");
  EXPECT_EQ(move({}), "G0 X0.1235 Y0.0000");
  EXPECT_EQ(move({"-t", "1"}), "G0 X0.1235 Y0.0000") << "never fewer";
  EXPECT_EQ(move({"-t", "0.00001"}), "G0 X0.1234568 Y0.0000000") << "a hundredth of the tolerance";
  RunResult const most = Converted("LINESTRING (0.1 0, 1 0)", {"--to", "gcode", "-t", "1e-300"});
  EXPECT_EQ(most.code, ExitCode::Usage);
  EXPECT_EQ(most.err, "contour: standard input: G-code with 15 decimals cannot hold 1\n");
}

TEST(ConvertRules, LathesHaveTheirSecondCoordinateAsZ) {
  // Seen along the third axis of that plane the sense of an arc is the other one.
  std::string const text =
      Text(kHook, {"--to", "gcode", "--feed", "1", "--plane", "xz", "--end", "m30"});
  EXPECT_EQ(text,
            "G21\nG18 G90 G91.1\nG0 X0.0000 Z0.0000\nG1 X4.0000 Z0.0000 F1\n"
            "G2 X4.0000 Z4.0000 I0.0000 K2.0000\nG1 X0.0000 Z4.0000\nM30\n");
}

TEST(ConvertRules, RadiusWordsStandOnArcsOfAThirdOfATurnAtMost) {
  std::string const text = Text(kHook, {"--to", "gcode", "--feed", "1", "--r-words"});
  EXPECT_NE(text.find("\nG3 X6.0000 Y2.0000 R2.0000\nG3 X4.0000 Y4.0000 R2.0000\n"),
            std::string::npos)
      << text;
  EXPECT_EQ(text.find(" I"), std::string::npos);
}

TEST(ConvertRules, LongArcsAreTwoHalvesWhereTheFormatWantsThat) {
  // 350 degrees of the unit circle about the origin, from -175 to 175 degrees.
  double const angle = 175.0 * std::numbers::pi / 180.0;
  std::ostringstream csv;
  csv.precision(17);
  csv << "type,start_x,start_y,end_x,end_y,center_x,center_y,radius,direction\narc,"
      << std::cos(angle) << "," << -std::sin(angle) << "," << std::cos(angle) << ","
      << std::sin(angle) << ",0,0,1,ccw\n";
  for (char const* format : {"gcode", "wkt", "dxf"}) {
    std::string const text =
        Text(csv.str(), {"--to", format, "--feed", "1", "--gcode-decimals", "9"});
    auto const back = RunInProcess({"convert", "-", "--from", format, "--to", "json"}, text);
    ASSERT_EQ(back.code, ExitCode::Ok) << back.err;
    auto const json = nlohmann::json::parse(back.out);
    EXPECT_EQ(json.at("counts").at("arcs"), 2) << format;
    double length = 0.0;
    for (auto const& piece : json.at("elements")) length += piece.at("length").get<double>();
    EXPECT_NEAR(length, 2.0 * angle, 1e-7) << format;
  }
  EXPECT_EQ(nlohmann::json::parse(Text(csv.str(), {"--to", "json"})).at("counts").at("arcs"), 1);
}

TEST(ConvertRules, GeoJsonIsAPolygonWithHolesOrALine) {
  auto const closed = nlohmann::json::parse(
      Text("MULTILINESTRING ((0 0, 9 0, 9 9, 0 9, 0 0), (3 3, 6 3, 6 6, 3 6, 3 3))",
           {"--to", "geojson", "--units", "mm"}));
  ASSERT_EQ(closed.at("features").size(), 1u);
  auto const& geometry = closed.at("features").at(0).at("geometry");
  EXPECT_EQ(geometry.at("type"), "Polygon");
  ASSERT_EQ(geometry.at("coordinates").size(), 2u);
  EXPECT_EQ(geometry.at("coordinates").at(0).size(), 5u);
  EXPECT_EQ(geometry.at("coordinates").at(0).at(0), geometry.at("coordinates").at(0).at(4));
  EXPECT_EQ(closed.at("features").at(0).at("properties").at("units"), "mm");
  auto const open = nlohmann::json::parse(Text("LINESTRING (0 0, 1 2)", {"--to", "geojson"}));
  EXPECT_EQ(open.at("features").at(0).at("geometry"),
            nlohmann::json::parse(R"({"type": "LineString", "coordinates": [[0, 0], [1, 2]]})"));
}

TEST(ConvertRules, ChordsOfGeoJsonStayAsNearAsIsSaid) {
  for (double const chords : {0.5, 0.01, 0.0001}) {
    auto const json =
        nlohmann::json::parse(Text(kHook, {"--to", "geojson", "--chords", std::to_string(chords)}));
    auto const& coordinates = json.at("features").at(0).at("geometry").at("coordinates");
    double farthest = 0.0;
    for (std::size_t i = 1; i + 2 < coordinates.size(); ++i) {
      // The middle of a chord is where the circle of radius 2 about (4, 2) is farthest from it.
      double const x = (coordinates[i][0].get<double>() + coordinates[i + 1][0].get<double>()) / 2;
      double const y = (coordinates[i][1].get<double>() + coordinates[i + 1][1].get<double>()) / 2;
      farthest = std::max(farthest, 2.0 - std::hypot(x - 4.0, y - 2.0));
    }
    EXPECT_LE(farthest, chords);
    EXPECT_GT(farthest, 0.2 * chords) << "no more chords than needed";
  }
  RunResult const none = Converted(kHook, {"--to", "geojson"});
  EXPECT_EQ(none.code, ExitCode::Usage);
  EXPECT_EQ(none.err,
            "contour: standard input: GeoJSON has no arcs; --chords T says how far chords may be "
            "from them\n");
  EXPECT_EQ(Converted(kHook, {"--to", "geojson", "-t", "0.1"}).code, ExitCode::Ok)
      << "a part of the tolerance";
}

TEST(ConvertRules, PlainSvgIsThePathInItsTrueSize) {
  std::string const text = Text(kHook, {"--to", "svg", "--svg-plain"});
  EXPECT_NE(text.find(" width=\"6.2mm\" height=\"4.2mm\" viewBox=\"-0.1 -4.1 6.2 4.2\">"),
            std::string::npos)
      << text;
  EXPECT_NE(text.find("<path d=\"M 0.0 0.0 L 4.0 0.0 A 2.0 2.0 0 0 0 6.0 -2.0 A 2.0 2.0 0 0 0 4.0 "
                      "-4.0 L 0.0 -4.0\"/>"),
            std::string::npos)
      << text;
  std::string const back = Text(text, {"--from", "svg", "--to", "wkt"});
  EXPECT_EQ(back.substr(0, 24), "COMPOUNDCURVE ((0 0, 4 0");
  RunResult const metres = Converted(kHook, {"--to", "svg", "--svg-plain", "--units", "m"});
  EXPECT_EQ(metres.code, ExitCode::Usage);
  EXPECT_EQ(metres.err,
            "contour: standard input: a plain SVG is in mm or inch, and the units are 'm'; see "
            "--units\n");
}

TEST(ConvertRules, DxfIsOnePolylineOrAnEntityForEachPiece) {
  auto const count = [](std::string const& text, std::string const& entity) {
    int found = 0;
    std::string const line = "\n" + entity + "\n";
    for (std::size_t at = 0; (at = text.find(line, at)) != std::string::npos; ++at) ++found;
    return found;
  };
  std::string const polyline = Text(kHook, {"--to", "dxf"});
  EXPECT_EQ(count(polyline, "POLYLINE"), 1);
  EXPECT_EQ(count(polyline, "VERTEX"), 4);
  EXPECT_EQ(count(polyline, "AC1009"), 1) << "R12";
  EXPECT_EQ(polyline.substr(0, 13), "999\nunits mm\n");
  std::string const entities = Text(kHook, {"--to", "dxf", "--dxf-entities"});
  EXPECT_EQ(count(entities, "LINE"), 2);
  EXPECT_EQ(count(entities, "ARC"), 1);
  EXPECT_EQ(count(entities, "POLYLINE"), 0);
  std::string const newer = Text(kHook, {"--to", "dxf", "--dxf-version", "r2000"});
  EXPECT_EQ(count(newer, "LWPOLYLINE"), 1);
  EXPECT_EQ(count(newer, "AC1015"), 1);
  EXPECT_EQ(count(newer, "$INSUNITS"), 1);
}

TEST(ConvertRules, HolesOfNewerDxfHaveALayer) {
  std::string const frame =
      "MULTILINESTRING ((0 0, 9 0, 9 9, 0 9, 0 0), (3 3, 6 3, 6 6, 3 6, 3 3))";
  std::string const text = Text(frame, {"--to", "dxf", "--dxf-version", "r2000"});
  std::size_t const entities = text.find("ENTITIES");
  EXPECT_NE(text.find("\nCONTOUR_HOLES\n", entities), std::string::npos);
  EXPECT_EQ(Text("LINESTRING (0 0, 1 0)", {"--to", "dxf", "--dxf-version", "r2000"})
                .find("\nCONTOUR_HOLES\n", entities),
            std::string::npos);
}

TEST(ConvertRules, GapsAreKeptAndReportedByEveryFormat) {
  for (char const* format : {"json", "csv", "dxf", "gcode", "wkt", "geojson"}) {
    RunResult const run = Converted(kGap, {"--to", format, "--feed", "1"});
    EXPECT_EQ(run.code, ExitCode::Ok) << format;
    EXPECT_EQ(run.err, "contour: standard input: pieces 1 and 2 do not meet: the gap is 1\n")
        << format;
    RunResult const back = RunInProcess({"convert", "-", "--from", format, "--to", "wkt"}, run.out);
    EXPECT_EQ(back.out, "MULTICURVE (LINESTRING (0 0, 1 0), LINESTRING (2 0, 3 0))\n") << format;
  }
}

TEST(ConvertRules, WhatVanishesInTheDigitsOfGCodeIsRefused) {
  RunResult const run = Converted("LINESTRING (0.00001 0, 0.00002 0)", {"--to", "gcode"});
  EXPECT_EQ(run.code, ExitCode::Usage);
  EXPECT_EQ(run.err, "contour: standard input: is smaller than the last digit of the G-code\n");
}

TEST(ConvertRules, UnitsGoBeforeThoseOfTheFile) {
  EXPECT_EQ(Text(kHook, {"--to", "csv", "--units", "inch"}).substr(0, 13), "# units inch\n");
  EXPECT_EQ(Text(kHook, {"--to", "gcode", "--units", "inch", "--feed", "1"}).substr(0, 4), "G20\n");
}

}  // namespace
}  // namespace Vorn::Cli::Testing
