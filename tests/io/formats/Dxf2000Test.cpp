#include <gtest/gtest.h>

#include <charconv>
#include <map>
#include <set>
#include <sstream>

#include "io/FormatContours.h"
#include "io/formats/Dxf.h"
#include "io/formats/DxfObjects.h"
#include "io/formats/DxfUnits.h"

namespace Vorn::IO {
namespace {

using namespace FormatContours;

struct Group {
  int code = 0;
  std::string value;
};

std::vector<Group> GroupsOf(std::string const& text) {
  std::vector<Group> groups;
  std::istringstream lines(text);
  for (std::string code; std::getline(lines, code);) {
    std::string value;
    EXPECT_TRUE(std::getline(lines, value)) << "a code without a value";
    groups.push_back({std::stoi(code), value});
  }
  return groups;
}

/// The value behind a variable of the header.
std::string Variable(std::vector<Group> const& groups, std::string const& name) {
  for (std::size_t i = 0; i + 1 < groups.size(); ++i) {
    if (groups[i].code == 9 && groups[i].value == name) return groups[i + 1].value;
  }
  return "none";
}

std::vector<std::string> Types(std::vector<Group> const& groups, std::string const& section) {
  std::vector<std::string> types;
  bool isInside = false;
  for (std::size_t i = 0; i < groups.size(); ++i) {
    if (groups[i].code == 2 && groups[i].value == section && groups[i - 1].value == "SECTION") {
      isInside = true;
    } else if (groups[i].code == 0 && groups[i].value == "ENDSEC") {
      isInside = false;
    } else if (isInside && groups[i].code == 0) {
      types.push_back(groups[i].value);
    }
  }
  return types;
}

unsigned long Hexadecimal(std::string const& text) { return std::stoul(text, nullptr, 16); }

/// The contours of all kinds that are written here.
std::vector<ContourFile> Contours() {
  ContourFile closed;
  closed.units = "inch";
  closed.isClosed = true;
  closed.pieces = MakeCircle({3, 0}, {0, 0}, 3, true);
  return {Wedge(), WithGap(), closed, RandomContour(5)};
}

TEST(ToDxf2000, EveryHandleIsGivenOnceAndTheSeedIsFree) {
  for (DxfStyle const style : {DxfStyle::Polyline, DxfStyle::Entities}) {
    for (ContourFile const& contour : Contours()) {
      std::vector<Group> const groups = GroupsOf(ToDxf2000(contour, style));
      unsigned long const seed = Hexadecimal(Variable(groups, "$HANDSEED"));
      std::set<unsigned long> handles;
      for (std::size_t i = 0; i < groups.size(); ++i) {
        bool const isSeed = i > 0 && groups[i - 1].value == "$HANDSEED";
        if ((groups[i].code != 5 && groups[i].code != 105) || isSeed) continue;
        EXPECT_TRUE(handles.insert(Hexadecimal(groups[i].value)).second) << groups[i].value;
      }
      EXPECT_EQ(handles.count(0), 0u);
      EXPECT_LT(*handles.rbegin(), seed);
      EXPECT_EQ(handles.size(), seed - 1) << "none left out";
    }
  }
}

TEST(ToDxf2000, EveryOwnerIsAnObjectOfTheFileOrNobody) {
  std::vector<Group> const groups = GroupsOf(ToDxf2000(Wedge()));
  std::set<std::string> handles = {"0"};
  for (Group const& group : groups) {
    if (group.code == 5 || group.code == 105) handles.insert(group.value);
  }
  int owners = 0;
  for (Group const& group : groups) {
    if (group.code != 330 && group.code != 350) continue;
    ++owners;
    EXPECT_EQ(handles.count(group.value), 1u) << group.value;
  }
  EXPECT_GT(owners, 20);
}

TEST(ToDxf2000, SectionsStandInTheirOrderAndTheFileEnds) {
  std::vector<Group> const groups = GroupsOf(ToDxf2000(Wedge()));
  std::vector<std::string> sections;
  for (std::size_t i = 1; i < groups.size(); ++i) {
    if (groups[i - 1].value == "SECTION") sections.push_back(groups[i].value);
  }
  EXPECT_EQ(sections, (std::vector<std::string>{"HEADER", "CLASSES", "TABLES", "BLOCKS", "ENTITIES",
                                                "OBJECTS"}));
  EXPECT_EQ(groups.back().code, 0);
  EXPECT_EQ(groups.back().value, "EOF");
  EXPECT_EQ(Variable(groups, "$ACADVER"), "AC1015");
}

TEST(ToDxf2000, UnitsAreANumberOfTheHeader) {
  std::map<std::string, std::string> const numbers = {
      {"", "0"},   {"inch", "1"}, {"Inches", "1"}, {"in", "1"},         {"ft", "2"},
      {"mm", "4"}, {"cm", "5"},   {"m", "6"},      {"millimeter", "4"}, {"parsec", "0"}};
  for (auto const& [units, number] : numbers) {
    ContourFile contour = Wedge();
    contour.units = units;
    EXPECT_EQ(Variable(GroupsOf(ToDxf2000(contour)), "$INSUNITS"), number) << units;
    EXPECT_EQ(Dxf::NumberOfUnits(units), number);
  }
  for (char const* number : {"1", "2", "4", "5", "6"}) {
    EXPECT_EQ(Dxf::NumberOfUnits(Dxf::UnitsNamed(number)), number);
  }
  for (char const* number : {"0", "3", "7", "", "four", "44"}) {
    EXPECT_EQ(Dxf::UnitsNamed(number), "") << number;
  }
}

TEST(ToDxf2000, OutlinesAreLightPolylinesOrSingleEntities) {
  EXPECT_EQ(Types(GroupsOf(ToDxf2000(Wedge())), "ENTITIES"),
            std::vector<std::string>{"LWPOLYLINE"});
  EXPECT_EQ(Types(GroupsOf(ToDxf2000(WithGap())), "ENTITIES"),
            (std::vector<std::string>{"LWPOLYLINE", "LWPOLYLINE"}));
  EXPECT_EQ(Types(GroupsOf(ToDxf2000(Wedge(), DxfStyle::Entities)), "ENTITIES"),
            (std::vector<std::string>{"LINE", "ARC", "LINE"}));
}

TEST(ToDxf2000, TheExtentTakesInTheBulgesOfArcs) {
  ContourFile contour;
  contour.pieces = {MakeArc({1, 0}, {-1, 0}, {0, 0}, 1, true)};
  std::vector<Group> const groups = GroupsOf(ToDxf2000(contour));
  EXPECT_EQ(std::stod(Variable(groups, "$EXTMIN")), -1.0);
  EXPECT_EQ(std::stod(Variable(groups, "$EXTMAX")), 1.0);
  for (std::size_t i = 0; i < groups.size(); ++i) {
    if (groups[i].value == "$EXTMAX") {
      EXPECT_EQ(std::stod(groups[i + 2].value), 1.0);
    }
  }
}

TEST(ToDxf2000, HolesLieOnALayerOfTheirOwn) {
  ContourFile plate;
  plate.pieces = MakeCircle({20, 0}, {0, 0}, 20, true);
  for (Piece const& half : MakeCircle({7, 0}, {0, 0}, 7, true)) plate.pieces.push_back(half);
  for (Piece const& half : MakeCircle({2, 0}, {0, 0}, 2, true)) plate.pieces.push_back(half);
  std::vector<std::string> layers;
  for (Group const& group : GroupsOf(ToDxf2000(plate))) {
    if (group.code == 8 && group.value != "0") layers.push_back(group.value);
  }
  EXPECT_EQ(layers, (std::vector<std::string>{"CONTOUR", "CONTOUR_HOLES", "CONTOUR"}));
}

TEST(ToDxf2000, ReadsBackAsTheSameCurveAndUnits) {
  for (DxfStyle const style : {DxfStyle::Polyline, DxfStyle::Entities}) {
    for (std::uint64_t seed = 0; seed < 50; ++seed) {
      ContourFile const contour = RandomContour(seed, 10.0);
      ContourFile const read = ParseDxf(ToDxf2000(contour, style), "p.dxf");
      EXPECT_LE(Apart(contour.pieces, read.pieces), 2e-15 * ScaleOf(contour.pieces)) << seed;
      EXPECT_EQ(read.units, "mm");
      EXPECT_TRUE(FindGaps(read).empty()) << seed;
    }
    ContourFile const read = ParseDxf(ToDxf2000(Wedge(), style), "p.dxf");
    EXPECT_TRUE(read.isClosed);
    EXPECT_EQ(read.pieces.size(), 3u);
  }
}

TEST(ToDxf2000, ALineBreakInTheUnitsBreaksNothing) {
  ContourFile contour = Wedge();
  contour.units = "mm\n0\nEOF";
  EXPECT_EQ(ParseDxf(ToDxf2000(contour), "p.dxf").pieces.size(), 3u);
}

TEST(DxfHandle, IsHexadecimalWithCapitals) {
  EXPECT_EQ(Dxf::Written(1), "1");
  EXPECT_EQ(Dxf::Written(255), "FF");
  EXPECT_EQ(Dxf::Written(0xFFFFFFFF), "FFFFFFFF");
}

}  // namespace
}  // namespace Vorn::IO
