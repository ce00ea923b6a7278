// The page of HTML: what its data tell, read back by another reader.
#include <gtest/gtest.h>

#include <nlohmann/json.hpp>

#include "io/Contours.h"
#include "vorn/io/ContourFile.h"
#include "vorn/io/Drawing.h"

namespace Vorn::IO {
namespace {

using Json = nlohmann::json;

/// The text between the tags of the script element that holds the data.
std::string DataText(std::string const& page) {
  std::size_t const open = page.find("type=\"application/json\"");
  EXPECT_NE(open, std::string::npos);
  std::size_t const begin = page.find('>', open) + 1;
  return page.substr(begin, page.find("</script>", begin) - begin);
}

Json DataOf(Drawing const& drawing) { return Json::parse(DataText(ToHtml(drawing))); }

Drawing MeasuredLine() {
  Drawing drawing =
      MakeDrawing({{0, 0, 0.5}, {2, 0.25, 0.5}, {4, -0.125, 0.5}}, {MakeLine({0, 0}, {4, 0})});
  drawing.title = "part.csv";
  drawing.units = "mm";
  return drawing;
}

TEST(ToHtml, HoldsPointsPiecesAndDeviations) {
  Json const data = DataOf(MeasuredLine());
  EXPECT_EQ(data.at("title"), "part.csv");
  EXPECT_EQ(data.at("units"), "mm");
  EXPECT_EQ(data.at("points").at("x"), Json({0.0, 2.0, 4.0}));
  EXPECT_EQ(data.at("points").at("y"), Json({0.0, 0.25, -0.125}));
  EXPECT_EQ(data.at("points").at("w"), 0.5) << "one number for all";
  EXPECT_EQ(data.at("deviations").at("signed"), Json({0.0, 0.25, -0.125}));
  EXPECT_EQ(data.at("deviations").at("outside"), Json::array());
  EXPECT_EQ(data.at("deviations").at("piece"), Json({0, 0, 0}));
  EXPECT_EQ(data.at("worst"), 1);
  EXPECT_EQ(data.at("verdict").at("isGood"), true);
  EXPECT_TRUE(data.at("band").is_null()) << "as wide everywhere";
  ASSERT_EQ(data.at("pieces").size(), 1u);
  EXPECT_EQ(data.at("pieces")[0].at("kind"), "line");
  EXPECT_EQ(data.at("pieces")[0].at("length"), 4.0);
}

TEST(ToHtml, TolerancesThatDifferComeWithTheirBand) {
  Drawing drawing = MeasuredLine();
  drawing.points[1].w = 1.0;
  Json const data = DataOf(drawing);
  EXPECT_EQ(data.at("points").at("w"), Json({0.5, 1.0, 0.5}));
  EXPECT_EQ(data.at("band").at("tolerance"), Json::array({1.0}))
      << "between neighbours the larger one holds";
  EXPECT_EQ(data.at("band").at("from"), Json::array({0.0}));
  EXPECT_EQ(data.at("band").at("to"), Json::array({4.0}));
}

TEST(ToHtml, AnArcTellsItsCircle) {
  Json const data = DataOf(DrawingOf(Contours::LineAndArcReport()));
  Json const& arc = data.at("pieces")[1];
  EXPECT_EQ(arc.at("kind"), "arc");
  EXPECT_EQ(arc.at("radius"), 1.0);
  EXPECT_EQ(arc.at("center"), Json({4.0, -1.0}));
  EXPECT_EQ(arc.at("ccw"), false);
  EXPECT_NEAR(arc.at("sweep").get<double>(), 1.5 * M_PI, 1e-12);
}

TEST(ToHtml, PointsAloneHaveNoContourAndNoVerdict) {
  Json const data = DataOf(MakeDrawing({{0, 0, 0}, {1, 1, 0}}, {}));
  EXPECT_EQ(data.at("pieces"), Json::array());
  EXPECT_TRUE(data.at("verdict").is_null());
  EXPECT_TRUE(data.at("points").at("w").is_null());
  EXPECT_FALSE(data.contains("deviations"));
}

TEST(ToHtml, AContourAloneHasNoDeviations) {
  ContourFile contour;
  contour.path = "a/b/part.dxf";
  contour.pieces = MakeCircle({1, 0}, {0, 0}, 1, true);
  Json const data = DataOf(DrawingOf(contour));
  EXPECT_EQ(data.at("title"), "part.dxf");
  EXPECT_EQ(data.at("isClosed"), true);
  EXPECT_FALSE(data.contains("worst"));
}

TEST(ToHtml, FieldsOfTheHeadKeepTheirOrder) {
  Drawing drawing = MeasuredLine();
  drawing.head = {{{"2", "b"}, {"1", "a"}, {"part", ""}}, "contour 1.0"};
  Json const data = DataOf(drawing);
  EXPECT_EQ(data.at("fields"), Json::array({Json::array({"2", "b"}), Json::array({"1", "a"}),
                                            Json::array({"part", ""})}));
  EXPECT_EQ(data.at("program"), "contour 1.0");
}

TEST(ToHtml, NoTextOfTheUserEndsTheScriptOrTheTitle) {
  for (std::string const text : {"</script><script>alert(1)</script>", "<!--", "]]>", "{{script}}",
                                 "{{data}}", "&lt;", "\"'\\", "\xff\xfe", "a\nb"}) {
    Drawing drawing = MeasuredLine();
    drawing.title = text;
    drawing.units = text;
    drawing.facts = {text};
    drawing.head.fields = {{text, text}};
    std::string const page = ToHtml(drawing);
    std::string const data = DataText(page);
    EXPECT_EQ(data.find('<'), std::string::npos) << text;
    ASSERT_TRUE(Json::accept(data)) << text;
    if (text.front() == '\xff') continue;
    EXPECT_EQ(Json::parse(data).at("units"), text);
    EXPECT_EQ(Json::parse(data).at("fields")[0][1], text);
    std::size_t const title = page.find("<title>") + 7;
    EXPECT_EQ(page.substr(title, page.find("</title>") - title).find('<'), std::string::npos);
  }
}

TEST(ToHtml, NeedsNothingFromElsewhere) {
  std::string const page = ToHtml(MeasuredLine());
  for (char const* word : {" src=", "@import", "url(http", "<link"}) {
    EXPECT_EQ(page.find(word), std::string::npos) << word;
  }
}

TEST(ToHtml, TheMagnificationIsTheOneAskedForOrARoundOne) {
  Drawing drawing = MeasuredLine();
  drawing.magnify = 12.5;
  EXPECT_EQ(DataOf(drawing).at("magnify"), 12.5);
  drawing.magnify.reset();
  EXPECT_GE(DataOf(drawing).at("magnify").get<double>(), 1.0);
}

TEST(ToHtml, EmptyFactsAreLeftOut) {
  Drawing drawing = MeasuredLine();
  drawing.facts = {"", "strategy mixed", ""};
  EXPECT_EQ(DataOf(drawing).at("facts"), Json::array({"strategy mixed"}));
}

}  // namespace
}  // namespace Vorn::IO
