#include <gtest/gtest.h>

#include "cli/base/Advice.h"
#include "io/points/CsvPlace.h"
#include "vorn/io/Points.h"
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

}  // namespace
}  // namespace Vorn::Cli
