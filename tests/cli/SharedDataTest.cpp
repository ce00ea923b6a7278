// Every measured contour of the shared folder through the program: fitted, written in every format,
// measured against each file, drawn. Skipped where VORN_DATA_DIR is not set.

#include <gtest/gtest.h>

#include <algorithm>
#include <cmath>
#include <filesystem>
#include <limits>
#include <nlohmann/json.hpp>
#include <sstream>

#include "cli/RunInProcess.h"
#include "io/Picture.h"
#include "io/drawing/Style.h"
#include "support/SharedData.h"
#include "vorn/io/Files.h"
#include "vorn/io/Formats.h"

namespace Vorn::Cli {
namespace {

namespace fs = std::filesystem;
using Json = nlohmann::json;

struct SharedContour {
  char const* name;
  char const* option;
  char const* tolerance;
};

/// Files of G-code are rounded to so many digits, and their path stays within three units of the
/// last one.
constexpr char const* kGCodeDecimals = "7";
constexpr double kGCodeBound = 3e-7;

/// Of the largest coordinate or radius: how exactly arcs read back from DXF and WKT.
constexpr double kArcBound = 2e-15;

/// The same: what it costs to measure an arc from its centre, once here and once in the library.
constexpr double kMeasuringBound = 4.0 * std::numeric_limits<double>::epsilon();

/// A point at a joint may be nearer to the next piece than to the one that the fit measured it
/// against, at most by this share of its tolerance in these files.
constexpr double kNearerNeighbour = 2e-3;

std::string Contents(std::string const& path) {
  std::istringstream none;
  return ReadTextFile(path, none);
}

class SharedData : public testing::TestWithParam<SharedContour> {
 protected:
  void SetUp() override {
    std::optional<std::string> const data = Vorn::Testing::SharedDataFolder();
    if (!data) GTEST_SKIP() << "VORN_DATA_DIR is not set";
    std::string name = (fs::temp_directory_path() / "contour-shared-XXXXXX").string();
    folder_ = mkdtemp(name.data());
    points_ = *data + "/" + GetParam().name + ".csv";
    std::vector<std::string> words = {"--strategy", "mixed", "--gcode-decimals", kGCodeDecimals};
    for (char const* ending : {"json", "csv", "dxf", "nc", "wkt", "svg", "html"}) {
      words.insert(words.end(), {"-o", FileOf(ending)});
    }
    RunResult const fitted = Run("fit", {}, words);
    ASSERT_EQ(fitted.code, ExitCode::Ok) << fitted.err;
    fit_ = Json::parse(Contents(FileOf("json")));
  }

  void TearDown() override {
    if (!folder_.empty()) fs::remove_all(folder_);
  }

  std::string FileOf(std::string const& ending) const {
    return (folder_ / ("c." + ending)).string();
  }

  /// A command for the points with their tolerance.
  RunResult Run(std::string const& command, std::vector<std::string> const& contour,
                std::vector<std::string> const& options) const {
    std::vector<std::string> words = {command, points_};
    words.insert(words.end(), contour.begin(), contour.end());
    words.insert(words.end(), {GetParam().option, GetParam().tolerance});
    words.insert(words.end(), options.begin(), options.end());
    return RunInProcess(words);
  }

  Json Check(std::string const& ending) const {
    RunResult const checked = Run("check", {FileOf(ending)}, {"--json", "-"});
    EXPECT_EQ(checked.code, ExitCode::Ok) << ending << ": " << checked.err;
    return Json::parse(checked.out);
  }

  double Remeasured() const { return fit_["deviation"]["remeasured"]["value"].get<double>(); }

  fs::path folder_;
  std::string points_;
  Json fit_;
};

/// The largest coordinate or radius.
double SizeOf(std::vector<Piece> const& pieces) {
  double size = 0.0;
  for (Piece const& piece : pieces) {
    for (GeometryUtils::Point const& point : {piece.start, piece.end}) {
      size = std::max({size, std::fabs(point.x), std::fabs(point.y)});
    }
    if (piece.IsArc()) size = std::max(size, piece.radius);
  }
  return size;
}

/// From the whole line or circle of which the piece is a part, as the fit measures.
double DistanceFromCarrier(Piece const& piece, double x, double y) {
  if (piece.IsArc()) {
    return std::fabs(std::hypot(x - piece.center.x, y - piece.center.y) - piece.radius);
  }
  double const dx = piece.end.x - piece.start.x;
  double const dy = piece.end.y - piece.start.y;
  return std::fabs(dx * (y - piece.start.y) - dy * (x - piece.start.x)) / std::hypot(dx, dy);
}

TEST_P(SharedData, CheckAgreesWithTheDeviationThatTheLibraryReports) {
  Json const checked = Check("json");
  double const found = checked["relative"]["relative"].get<double>();
  EXPECT_EQ(found, Remeasured()) << "the file holds the contour to the last bit";
  Json const& reported = fit_["deviation"]["reported"];
  if (reported["value"].is_null()) {
    EXPECT_EQ(GetParam().name, std::string("circle_r3")) << "only a full circle has no report";
    return;
  }
  double const value = reported["value"].get<double>();
  auto const point = reported["point"].get<std::size_t>();
  Json const& measured = checked["deviations"][point];
  double const tolerance = measured["tolerance"].get<double>();
  std::vector<Piece> const pieces = ParseContour(Contents(FileOf("json")), "c.json").pieces;
  double const bound = 1e-9 + kMeasuringBound * SizeOf(pieces) / tolerance;
  EXPECT_LE(found, value + bound);
  EXPECT_GE(found, value - kNearerNeighbour);
  // The reported number itself, of the reported point and the piece beside it or a neighbour.
  auto const nearest = measured["piece"].get<std::size_t>() - 1;
  double least = std::numeric_limits<double>::infinity();
  for (std::size_t const piece :
       {nearest, (nearest + 1) % pieces.size(), (nearest + pieces.size() - 1) % pieces.size()}) {
    double const relative = DistanceFromCarrier(pieces[piece], measured["x"].get<double>(),
                                                measured["y"].get<double>()) /
                            tolerance;
    least = std::min(least, std::fabs(relative - value));
  }
  EXPECT_LE(least, bound) << "point " << point;
}

TEST_P(SharedData, EveryFileMeasuresAsTheFitDoes) {
  std::vector<Piece> const pieces = ParseContour(Contents(FileOf("json")), "c.json").pieces;
  double const smallest = fit_["input"]["tolerance"]["smallest"].get<double>();
  double const arcs = (kArcBound + kMeasuringBound) * SizeOf(pieces) / smallest;
  for (auto const& [ending, bound] : std::vector<std::pair<std::string, double>>{
           {"csv", 0.0}, {"dxf", arcs}, {"wkt", arcs}, {"nc", kGCodeBound / smallest}}) {
    Json const checked = Check(ending);
    EXPECT_NEAR(checked["relative"]["relative"].get<double>(), Remeasured(), bound) << ending;
    EXPECT_TRUE(checked["gaps"].empty()) << ending;
    EXPECT_EQ(checked["contour"]["closed"], fit_["closed"]) << ending;
  }
}

/// The data of a report.
Json DataOf(std::string const& page) {
  std::string const opening = "<script type=\"application/json\" id=\"data\">";
  std::size_t const begin = page.find(opening) + opening.size();
  return Json::parse(page.substr(begin, page.find("</script>", begin) - begin));
}

void ExpectDrawn(std::string const& svg, bool hasLines, bool hasArcs) {
  EXPECT_EQ(svg.find("nan"), std::string::npos);
  Picture const picture = Picture::FromSvg(svg, 800);
  EXPECT_GT(picture.Count(Svg::kLineColor), hasLines ? 20 : -1);
  EXPECT_GT(picture.Count(Svg::kArcColor), hasArcs ? 20 : -1);
  EXPECT_GT(picture.Count(Svg::kBandColor), 500);
  EXPECT_GT(picture.Count(Svg::kTextColor), 100);
}

TEST_P(SharedData, PicturesShowPointsAndPieces) {
  for (char const* ending : {"svg", "html"}) {
    RunResult const plot =
        Run("plot", {FileOf("json")}, {"-o", FileOf(std::string("plot.") + ending)});
    EXPECT_EQ(plot.code, ExitCode::Ok) << plot.err;
    EXPECT_NE(plot.out.find("result      within tolerance"), std::string::npos) << plot.out;
  }
  bool const hasLines = fit_["counts"]["lines"].get<int>() > 0;
  bool const hasArcs = fit_["counts"]["arcs"].get<int>() > 0;
  for (char const* name : {"svg", "plot.svg"}) {
    SCOPED_TRACE(name);
    ExpectDrawn(Contents(FileOf(name)), hasLines, hasArcs);
  }
  for (char const* name : {"html", "plot.html"}) {
    Json const data = DataOf(Contents(FileOf(name)));
    EXPECT_EQ(data["points"]["x"].size(), fit_["input"]["points"]) << name;
    EXPECT_EQ(data["pieces"].size(), fit_["counts"]["elements"]) << name;
    EXPECT_EQ(data["verdict"]["isGood"], true) << name;
  }
}

INSTANTIATE_TEST_SUITE_P(
    Contours, SharedData,
    testing::Values(SharedContour{"rail_head_known_arcs", "-t", "0.01"},
                    SharedContour{"wheel_worn_a", "-t", "0.03"},
                    SharedContour{"rail_worn_low", "-t", "0.025"},
                    SharedContour{"mirror_sphere_83m", "-t", "0.00005"},
                    SharedContour{"hatch_boundary", "-t", "0.002"},
                    SharedContour{"glyph_five", "--tolerance-per-point", "2.0"},
                    SharedContour{"test_track_centreline", "--tolerance-per-point", "0.03"},
                    SharedContour{"gcode_letter_d", "-t", "0.015"},
                    SharedContour{"airfoil_clark_y", "-t", "0.0004"},
                    SharedContour{"circle_r3", "-t", "0.001"}),
    [](auto const& instance) { return std::string(instance.param.name); });

/// A file that nobody lists would never be tested.
TEST(SharedDataFolder, HoldsNoOtherContours) {
  std::optional<std::string> const data = Vorn::Testing::SharedDataFolder();
  if (!data) GTEST_SKIP() << "VORN_DATA_DIR is not set";
  std::size_t count = 0;
  for (auto const& entry : fs::directory_iterator(*data)) {
    std::string const name = entry.path().filename().string();
    if (entry.path().extension() == ".csv" && name.find(".truth.") == std::string::npos) ++count;
  }
  EXPECT_EQ(count, 10u);
}

}  // namespace
}  // namespace Vorn::Cli
