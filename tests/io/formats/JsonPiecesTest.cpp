#include <gtest/gtest.h>

#include "io/Contours.h"
#include "io/FormatContours.h"
#include "io/formats/JsonPieces.h"
#include "vorn/io/Failure.h"
#include "vorn/io/FitReport.h"

namespace Vorn::IO {
namespace {

using namespace FormatContours;

/// What is wrong, without line and column.
std::string Complaint(std::string const& text) {
  try {
    ParseJsonPieces(text, "p.json");
  } catch (Failure const& failure) {
    EXPECT_EQ(failure.Kind(), FailureKind::File);
    return failure.Where().file + ": " + failure.Message();
  }
  return "";
}

/// The document of Wedge with one text in place of another.
std::string Changed(std::string const& from, std::string const& to) {
  std::string text = ToJson(Wedge());
  std::size_t const at = text.find(from);
  EXPECT_NE(at, std::string::npos) << from;
  return text.replace(at, from.size(), to);
}

TEST(ToJson, HoldsTheLayoutOfAFitLessTheFit) {
  auto const document = nlohmann::json::parse(ToJson(Wedge()));
  EXPECT_EQ(document.at("schemaVersion"), 1);
  EXPECT_EQ(document.at("input").at("file"), "part.json");
  EXPECT_EQ(document.at("input").at("units"), "mm");
  EXPECT_EQ(document.at("closed"), true);
  EXPECT_EQ(document.at("counts"), (nlohmann::json{{"elements", 3}, {"lines", 2}, {"arcs", 1}}));
  auto const& arc = document.at("elements").at(1);
  EXPECT_EQ(arc.at("number"), 2);
  EXPECT_EQ(arc.at("direction"), "cw");
  EXPECT_EQ(arc.at("center").at("y"), -1.0);
  EXPECT_TRUE(arc.at("points").is_null());
}

TEST(ParseJsonPieces, ReadsTheDocumentOfAFit) {
  FitReport const report = Contours::LineAndArcReport();
  ContourFile const contour = ParseJsonPieces(ToJson(report), "p.json");
  ASSERT_EQ(contour.pieces.size(), report.pieces.size());
  for (std::size_t i = 0; i < report.pieces.size(); ++i) {
    EXPECT_TRUE(SameBits(contour.pieces[i], report.pieces[i])) << i;
  }
  EXPECT_FALSE(contour.isClosed);
}

TEST(ParseJsonPieces, WorksOutWhatIsNotThere) {
  ContourFile const contour = ParseJsonPieces(
      R"({"schemaVersion": 1, "elements": [
          {"kind": "line", "start": {"x": 0, "y": 0}, "end": {"x": 4, "y": 0}},
          {"kind": "arc", "start": {"x": 4, "y": 0}, "end": {"x": 5, "y": -1},
           "center": {"x": 4, "y": -1}, "radius": 1, "direction": "cw"},
          {"kind": "line", "start": {"x": 5, "y": -1}, "end": {"x": 0, "y": 0}}]})",
      "p.json");
  ContourFile expected = Wedge();
  expected.units.clear();
  EXPECT_TRUE(SameBits(contour, expected));
}

TEST(ParseJsonPieces, RefusesAnotherVersion) {
  EXPECT_EQ(Complaint(Changed("\"schemaVersion\": 1", "\"schemaVersion\": 2")),
            "p.json: schemaVersion: '2' is not the version that is read here, which is 1");
  EXPECT_EQ(Complaint("{\"elements\": []}"), "p.json: schemaVersion: is missing");
}

/// The whole message, with line and column.
std::string RefusalOf(std::string const& text) {
  return Refusal([&] { ParseJsonPieces(text, "p.json"); });
}

TEST(ParseJsonPieces, NamesLineAndColumnOfABadField) {
  EXPECT_EQ(RefusalOf("{\"schemaVersion\": 1,\n  \"elements\": [\n    {\"kind\": \"spline\"}]}"),
            "p.json:3:14: elements[0].kind: 'spline' is neither line nor arc");
  EXPECT_EQ(RefusalOf("{\"schemaVersion\": 1,\n \"elements\": [{\"kind\": \"line\"}]}"),
            "p.json:2:15: elements[0].start: is missing");
}

TEST(ParseJsonPieces, NamesThePathOfABadField) {
  EXPECT_EQ(Complaint(Changed("\"kind\": \"arc\"", "\"kind\": \"spline\"")),
            "p.json: elements[1].kind: 'spline' is neither line nor arc");
  EXPECT_EQ(Complaint(Changed("\"radius\": 1.0", "\"radius\": \"one\"")),
            "p.json: elements[1].radius: is not a number but '\"one\"'");
  EXPECT_EQ(Complaint(Changed("\"radius\": 1.0", "\"radius\": -1.0")),
            "p.json: elements[1]: is no arc: the radius is not above 0");
  EXPECT_EQ(Complaint(Changed("\"radius\": 1.0", "\"radius\": 1.5")),
            "p.json: elements[1]: is no arc: the start is 0.5 off the circle");
  EXPECT_EQ(Complaint(Changed("\"radius\": 1.0,", "")), "p.json: elements[1].radius: is missing");
  EXPECT_EQ(Complaint(Changed("\"cw\"", "\"left\"")),
            "p.json: elements[1].direction: 'left' is neither ccw nor cw");
  EXPECT_EQ(Complaint(Changed("\"x\": 4.0", "\"x\": null")),
            "p.json: elements[0].end.x: is not a number but 'null'");
  EXPECT_EQ(Complaint(Changed("\"x\": 4.0", "\"x\": 1e200")),
            "p.json: elements[0].end.x: '1e+200' is too large");
  EXPECT_EQ(Complaint(Changed("\"closed\": true", "\"closed\": 1")),
            "p.json: closed: is neither true nor false but '1'");
  EXPECT_EQ(Complaint(R"({"schemaVersion": 1})"), "p.json: elements: is missing");
  EXPECT_EQ(Complaint(R"({"schemaVersion": 1, "elements": {}})"),
            "p.json: elements: is not an array but '{}'");
  EXPECT_EQ(Complaint(R"({"schemaVersion": 1, "elements": [5]})"),
            "p.json: elements[0]: is not an object but '5'");
  EXPECT_EQ(Complaint("[]"), "p.json: is not an object but '[]'");
}

TEST(ParseJsonPieces, RefusesASweepThatIsNone) {
  std::string const text = ToJson(Wedge());
  std::size_t const at = text.find("\"sweep\": ");
  for (char const* sweep : {"-1.0", "7.0"}) {
    std::string changed = text;
    changed.replace(at, text.find('\n', at) - at, std::string("\"sweep\": ") + sweep);
    EXPECT_NE(Complaint(changed).find("elements[1].sweep: "), std::string::npos) << sweep;
  }
}

TEST(ParseJsonPieces, SaysWhereTheTextIsNoJson) {
  EXPECT_EQ(RefusalOf("{\n  \"a\": NaN\n}"), "p.json:2:8: is not JSON from here on: 'NaN'");
  EXPECT_EQ(RefusalOf("{\"a\": [1, 2"),
            "p.json:1:12: is not JSON to the end: the text stops early");
  EXPECT_EQ(Complaint("{\"a\": 1e999}"), "p.json: a number is too large for a double");
}

TEST(ParseJsonPieces, DeepNestingIsRefusedWhereItBecomesTooDeep) {
  // A recursive reader or writer would run out of stack.
  std::string const deep(100000, '[');
  EXPECT_EQ(Refusal([&] { ParseJsonPieces(deep, "d.json"); }),
            "d.json:1:65: is nested deeper than 64 brackets");
  std::string const closed =
      "{\"schemaVersion\": 1,\n\"elements\": " + deep + std::string(100000, ']') + "}";
  EXPECT_EQ(Refusal([&] { ParseJsonPieces(closed, "d.json"); }),
            "d.json:2:76: is nested deeper than 64 brackets");
}

TEST(ParseJsonPieces, BracketsInTextsAreNotNesting) {
  std::string const brackets = std::string(100, '[') + "\\\"" + std::string(100, '{');
  std::string const text =
      "{\"schemaVersion\": 1, \"note\": \"" + brackets +
      "\", \"elements\": [{\"kind\": \"line\", \"start\": {\"x\": 0, \"y\": 0}, "
      "\"end\": {\"x\": 1, \"y\": 0}}]}";
  EXPECT_EQ(ParseJsonPieces(text, "d.json").pieces.size(), 1u);
}

TEST(ParseJsonPieces, OnlyTheBeginningOfABadValueIsQuoted) {
  std::string numbers = "[1";
  for (int i = 0; i < 100000; ++i) numbers += ",1";
  EXPECT_EQ(Refusal([&] {
              ParseJsonPieces("{\"schemaVersion\": 1, \"elements\": {\"a\": " + numbers + "]}}",
                              "d.json");
            }),
            "d.json:1:34: elements: is not an array but "
            "'{\"a\":[1,1,1,1,1,1,1,1,1,1,1,1,1,1,1,1,1,...'");
}

}  // namespace
}  // namespace Vorn::IO
