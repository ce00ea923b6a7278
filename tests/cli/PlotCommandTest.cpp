#include <gtest/gtest.h>

#include <cmath>
#include <filesystem>
#include <fstream>
#include <nlohmann/json.hpp>
#include <sstream>

#include "cli/RunInProcess.h"
#include "vorn/io/Drawing.h"

namespace Vorn::Cli {
namespace {

namespace fs = std::filesystem;

constexpr char const* kPoints = "# units mm\nx,y\n0,0\n5,0.25\n10,0\n";

/// A straight contour from (0, 0) to (10, 0).
constexpr char const* kContour = "LINESTRING (0 0, 10 0)";

std::string Contents(fs::path const& path) {
  std::ifstream file(path, std::ios::binary);
  std::ostringstream text;
  text << file.rdbuf();
  return text.str();
}

/// A folder with a points file and a contour file.
class PlotCommand : public testing::Test {
 protected:
  PlotCommand() {
    std::string name = (fs::temp_directory_path() / "contour-plot-XXXXXX").string();
    folder_ = mkdtemp(name.data());
    std::ofstream(folder_ / "part.csv") << kPoints;
    std::ofstream(folder_ / "part.wkt") << kContour;
  }

  ~PlotCommand() override { fs::remove_all(folder_); }

  std::string At(std::string const& name) const { return (folder_ / name).string(); }

  RunResult Plot(std::vector<std::string> words) const {
    words.insert(words.begin(), {"plot", At("part.csv"), At("part.wkt")});
    return RunInProcess(words);
  }

  std::string UsageError(std::vector<std::string> const& words) const {
    RunResult const result = Plot(words);
    EXPECT_EQ(result.code, ExitCode::Usage);
    EXPECT_EQ(result.out, "");
    return result.err.substr(0, result.err.find('\n'));
  }

  fs::path folder_;
};

TEST_F(PlotCommand, WritesEveryFormatAndSaysWhatItShows) {
  RunResult const result =
      Plot({"-t", "0.5", "-o", At("p.svg"), "-o", At("p.png"), "-o", At("p.html")});
  EXPECT_EQ(result.code, ExitCode::Ok);
  EXPECT_EQ(result.err, "");
  EXPECT_EQ(result.out,
            "points      3\n"
            "pieces      1 line, 0 arcs\n"
            "deviation   0.25 mm, 0.5 of the tolerance, at point 1\n"
            "result      within tolerance\n"
            "wrote       " +
                At("p.svg") + "\nwrote       " + At("p.png") + "\nwrote       " + At("p.html") +
                "\n");
  EXPECT_EQ(Contents(At("p.svg")).substr(0, 5), "<?xml");
  EXPECT_EQ(Contents(At("p.png")).substr(1, 3), "PNG");
  EXPECT_EQ(Contents(At("p.html")).substr(0, 15), "<!DOCTYPE html>");
}

TEST_F(PlotCommand, OutsideToleranceIsShownButNoFailure) {
  RunResult const result = Plot({"-t", "0.1", "-o", At("p.svg")});
  EXPECT_EQ(result.code, ExitCode::Ok);
  EXPECT_NE(result.out.find("result      OUTSIDE TOLERANCE"), std::string::npos);
}

TEST_F(PlotCommand, WithoutToleranceThereIsNoResult) {
  RunResult const result = Plot({"-o", At("p.svg")});
  EXPECT_EQ(result.code, ExitCode::Ok);
  EXPECT_EQ(result.out.find("result"), std::string::npos);
  EXPECT_NE(result.out.find("deviation   0.25 mm at point 1"), std::string::npos);
}

TEST_F(PlotCommand, PointsAloneNeedNoTolerance) {
  RunResult const result = RunInProcess({"plot", "-", "-o", At("p.svg")}, kPoints);
  EXPECT_EQ(result.code, ExitCode::Ok);
  EXPECT_EQ(result.out, "points      3\nwrote       " + At("p.svg") + "\n");
}

TEST_F(PlotCommand, StandardOutputHoldsTheDrawingAlone) {
  RunResult const result = Plot({"-o", "-", "--to", "svg", "--magnify", "4"});
  EXPECT_EQ(result.code, ExitCode::Ok);
  EXPECT_EQ(result.out.substr(0, 5), "<?xml");
  EXPECT_EQ(result.out.substr(result.out.size() - 7), "</svg>\n");
  EXPECT_NE(result.out.find("deviation \xC3\x97"
                            "4<"),
            std::string::npos);
}

TEST_F(PlotCommand, FitWritesTheSamePage) {
  RunResult const result = RunInProcess({"fit", "-", "-t", "0.5", "-o", At("f.html")}, kPoints);
  EXPECT_EQ(result.code, ExitCode::Ok);
  EXPECT_EQ(Contents(At("f.html")).substr(0, 15), "<!DOCTYPE html>");
}

TEST_F(PlotCommand, PngSizeIsInPixels) {
  ASSERT_EQ(Plot({"-o", At("p.png"), "--width", "300"}).code, ExitCode::Ok);
  std::string const png = Contents(At("p.png"));
  EXPECT_EQ(png.substr(16, 4), std::string("\0\0\x01\x2c", 4));
  ASSERT_EQ(Plot({"-o", At("p.png"), "--dpi", "25.4"}).code, ExitCode::Ok);
  EXPECT_EQ(Contents(At("p.png")).substr(16, 4), std::string("\0\0\x01\x29", 4));
}

TEST_F(PlotCommand, RefusesWhatItCannotDo) {
  EXPECT_EQ(UsageError({"-o", "-"}),
            "contour: the standard output: --to must say which format to "
            "write");
  EXPECT_EQ(UsageError({"-o", "p.dxf"}),
            "contour: p.dxf: not a drawing; 'contour convert' writes dxf");
  EXPECT_EQ(UsageError({"-o", "p.svg", "--magnify", "0"}),
            "contour: --magnify: '0' is neither auto nor a number above 0");
  EXPECT_EQ(UsageError({"-o", "p.svg", "--magnify", "nan"}),
            "contour: --magnify: 'nan' is neither auto nor a number above 0");
  EXPECT_NE(UsageError({"-o", "p.png", "--dpi", "9", "--width", "9"}).find("excludes"),
            std::string::npos);
  EXPECT_EQ(RunInProcess({"plot", "-", "-", "-o", "p.svg"}).err,
            "contour: POINTS and CONTOUR cannot both be the standard input\n");
  EXPECT_EQ(RunInProcess({"plot", At("part.csv")}).code, ExitCode::Usage) << "no output";
}

TEST_F(PlotCommand, RefusesPicturesThatAreTooLarge) {
  RunResult const result = Plot({"-o", At("p.png"), "--dpi", "1e6"});
  EXPECT_EQ(result.code, ExitCode::Usage);
  EXPECT_FALSE(fs::exists(At("p.png")));
}

TEST_F(PlotCommand, BrokenInputWritesNothing) {
  std::ofstream(folder_ / "part.wkt") << "LINESTRING (0 0, oops";
  EXPECT_EQ(Plot({"-o", At("p.svg")}).code, ExitCode::File);
  EXPECT_FALSE(fs::exists(At("p.svg")));
  EXPECT_EQ(RunInProcess({"plot", At("missing.csv"), "-o", At("p.svg")}).code, ExitCode::File);
}

TEST_F(PlotCommand, GapsAreReportedAndNotDrawnOver) {
  std::ofstream(folder_ / "part.wkt") << "MULTILINESTRING ((0 0, 4 0), (6 0, 10 0))";
  RunResult const result = Plot({"-o", At("p.svg")});
  EXPECT_EQ(result.code, ExitCode::Ok);
  EXPECT_NE(result.err.find("the gap is 2"), std::string::npos) << result.err;
}

/// The text between the tags of the page's data.
std::string DataOf(std::string const& page) {
  std::string const open = "<script type=\"application/json\" id=\"data\">";
  std::size_t const begin = page.find(open) + open.size();
  return page.substr(begin, page.find("</script>", begin) - begin);
}

TEST(ToHtml, NamesCannotEndTheScriptThatHoldsThem) {
  Drawing drawing = MakeDrawing({{0, 0, 0}, {1, 0, 0}}, {});
  drawing.title = "</script><script>alert(1)</script><!--{{script}}\xff";
  drawing.units = "<b>";
  std::string const page = ToHtml(drawing);
  std::string const data = DataOf(page);
  EXPECT_EQ(data.find('<'), std::string::npos);
  nlohmann::json const json = nlohmann::json::parse(data);
  EXPECT_EQ(json["title"], "</script><script>alert(1)</script><!--{{script}}\xEF\xBF\xBD");
  EXPECT_EQ(json["units"], "<b>");
  EXPECT_NE(page.find("<title>&lt;/script&gt;"), std::string::npos);
  EXPECT_EQ(page.find("alert(1)</script><!--"), std::string::npos);
}

TEST(ToHtml, DataAreExactAndComplete) {
  std::vector<WPoint> const points = {{0.1, 0, 0.5}, {1.0 / 3.0, 0.25, 0.5}, {10, -0.125, 0.25}};
  Piece line;
  line.end = {10, 0};
  line.length = 10;
  nlohmann::json const json = nlohmann::json::parse(DataOf(ToHtml(MakeDrawing(points, {line}))));
  EXPECT_EQ(json["points"]["x"][1].get<double>(), 1.0 / 3.0);
  EXPECT_EQ(json["points"]["w"], nlohmann::json({0.5, 0.5, 0.25}));
  EXPECT_EQ(json["deviations"]["signed"], nlohmann::json({0.0, 0.25, -0.125}));
  EXPECT_EQ(json["deviations"]["outside"], nlohmann::json::array());
  EXPECT_EQ(json["worst"], 1);
  EXPECT_EQ(json["verdict"]["isGood"], true);
  EXPECT_EQ(json["isClosed"], false);
  EXPECT_EQ(json["band"]["tolerance"], nlohmann::json({0.5}));
}

TEST(ToHtml, NumbersThatAreNoneBecomeNull) {
  Drawing drawing = MakeDrawing({{0, 0, 1}, {1, 0, 1}}, {});
  drawing.points[1].x = std::nan("");
  EXPECT_TRUE(nlohmann::json::parse(DataOf(ToHtml(drawing)))["points"]["x"][1].is_null());
}

TEST_F(PlotCommand, TolerancesBySpacingKnowTheGapOfAClosedContour) {
  std::string const square = "0,0\n2,0\n4,0\n4,2\n4,4\n2,4\n0,4\n0,2\n0,1\n";
  RunResult const plot = RunInProcess(
      {"plot", "-", "-o", "-", "--to", "html", "--tolerance-per-point", "9", "--units", "mm"},
      square);
  ASSERT_EQ(plot.code, ExitCode::Ok) << plot.err;
  nlohmann::json const tolerances = nlohmann::json::parse(DataOf(plot.out))["points"]["w"];
  EXPECT_EQ(tolerances[0], 0.3 * 1.0) << "a step of 1 from the last point, of 2 to the next";
  EXPECT_EQ(tolerances[1], 0.3 * 2.0);
}

TEST_F(PlotCommand, AContourAloneIsDrawnAsConvertDrawsIt) {
  RunResult const plot = RunInProcess({"plot", At("part.wkt"), "-o", At("p.svg")});
  EXPECT_EQ(plot.code, ExitCode::Ok) << plot.err;
  EXPECT_EQ(plot.out, "pieces      1 line, 0 arcs\nwrote       " + At("p.svg") + "\n");
  ASSERT_EQ(RunInProcess({"convert", At("part.wkt"), "-o", At("c.svg")}).code, ExitCode::Ok);
  EXPECT_EQ(Contents(At("p.svg")), Contents(At("c.svg")));
}

TEST_F(PlotCommand, AContourAloneHasNothingToJudge) {
  for (std::vector<std::string> const& option :
       {std::vector<std::string>{"-t", "1"}, {"--magnify", "5"}, {"--columns", "1,2"}}) {
    std::vector<std::string> words = {"plot", At("part.wkt"), "-o", At("p.svg")};
    words.insert(words.end(), option.begin(), option.end());
    RunResult const plot = RunInProcess(words);
    EXPECT_EQ(plot.code, ExitCode::Usage) << option.front();
    EXPECT_NE(plot.err.find("a contour alone has nothing to judge or to magnify"),
              std::string::npos)
        << plot.err;
  }
}

}  // namespace
}  // namespace Vorn::Cli
