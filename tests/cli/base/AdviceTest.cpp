#include <gtest/gtest.h>

#include "cli/base/Advice.h"
#include "io/points/CsvPlace.h"
#include "vorn/io/Points.h"
#include "vorn/io/SpacingFailure.h"
#include "vorn/io/Tolerances.h"

namespace Vorn::Cli {
namespace {

/// What the program says of a failure of the library.
template <typename Call>
std::string Said(Call const& call) {
  try {
    call();
  } catch (Failure const& failure) {
    return WithAdvice(failure);
  }
  return "nothing";
}

TEST(WithAdvice, NamesTheOptionThatHelps) {
  std::vector<std::pair<Remedy, std::string>> const cases = {
      {Remedy::None, "p: no"},
      {Remedy::ChooseColumns, "p: no; say it with --columns X,Y"},
      {Remedy::ChooseUnits, "p: no; see --units"},
      {Remedy::GiveTolerance,
       "p: no; give --tolerance T, --tolerance-column NAME or --tolerance-per-point CAP"},
      {Remedy::CloseContour, "p: no; --closed yes closes it"},
  };
  for (auto const& [help, said] : cases) {
    EXPECT_EQ(WithAdvice(Failure(FailureKind::BadArgument, {"p"}, "no", help)), said);
  }
}

TEST(WithAdvice, ColumnsThatCannotBeTold) {
  EXPECT_EQ(Said([] { ParsePoints("a,b,c\n1,2,3\n4,5,6\n", "p.csv", {}); }),
            "p.csv:1:1: cannot tell which two columns hold the points: the header has 'a', 'b', "
            "'c'; say it with --columns X,Y");
}

TEST(WithAdvice, PointsWithoutATolerance) {
  PointFile file = ParsePoints("0,0\n1,0\n", "p.csv", {});
  EXPECT_EQ(Said([&] { AssignTolerances({}, &file); }),
            "no tolerance: p.csv has no column 'w' and no comment '# tolerance T'; give "
            "--tolerance T, --tolerance-column NAME or --tolerance-per-point CAP");
}

PointFile TwoClosePoints(std::string path, std::size_t outline) {
  PointFile file;
  file.path = std::move(path);
  file.outline = outline;
  file.points = {{0, 0, 1}, {1, 0, 1}};
  file.lines = {1, 2};
  return file;
}

TEST(WithAdvice, NamesTheCommandsForPointsThatAreTooClose) {
  PointFile const file = TwoClosePoints("my part.csv", 0);
  CloseNeighbours const neighbours = {{0, 1, 1.0, 3.0}, 0.25, {{}, "my w", {}}, 0};
  SpacingFailure const failure = SpacingFailure::TooClose(file, neighbours);
  EXPECT_EQ(WithAdvice(failure),
            failure.what() +
                std::string("\nsee: contour info 'my part.csv' --tolerance-column 'my w'\n"
                            "ways out: --strategy fewest, which takes points of any density\n"
                            "or --tolerance 0.25, or --tolerance-per-point CAP to follow the "
                            "spacing\n"
                            "or leave points out: contour simplify 'my part.csv' "
                            "--tolerance-column 'my w' --drop-close"));
}

TEST(WithAdvice, RepeatsTheToleranceThatWasGiven) {
  PointFile const file = TwoClosePoints("p.csv", 0);
  auto const options = [&](ToleranceChoice const& choice) {
    std::string const said =
        WithAdvice(SpacingFailure::TooClose(file, {{0, 1, 1, 3}, {}, choice, 0}));
    std::string const begin = "see: contour info p.csv";
    std::size_t const at = said.find(begin) + begin.size();
    return said.substr(at, said.find('\n', at) - at);
  };
  EXPECT_EQ(options({0.02, {}, {}}), " -t 0.02");
  EXPECT_EQ(options({{}, {}, 0.0004}), " --tolerance-per-point 0.0004");
  EXPECT_EQ(options({}), "");
}

TEST(WithAdvice, CallsAnOutlineByItsNumberAndTheStandardInputByADash) {
  PointFile const file = TwoClosePoints("standard input" + OutlineSuffix(2), 2);
  std::string const said = WithAdvice(SpacingFailure::Coinciding(file, {{0, 1, 0, 0}, {}, {}, 0}));
  EXPECT_NE(said.find("contour simplify - --outline 2 --drop-close"), std::string::npos) << said;
}

}  // namespace
}  // namespace Vorn::Cli
