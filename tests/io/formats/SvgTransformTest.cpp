#include <gtest/gtest.h>

#include <cmath>
#include <numbers>

#include "io/FormatContours.h"
#include "io/formats/Affine.h"
#include "io/formats/SvgNumbers.h"
#include "io/formats/SvgTransform.h"

namespace Vorn::IO {
namespace {

using namespace FormatContours;

XmlElement Element() {
  XmlElement element;
  element.tag = "path";
  element.place = {"p.svg", 3, 5};
  return element;
}

XmlElement Page(std::vector<std::pair<std::string_view, std::string_view>> attributes) {
  XmlElement page = Element();
  page.tag = "svg";
  page.attributes = std::move(attributes);
  return page;
}

void ExpectAt(XY const& at, double x, double y) {
  EXPECT_NEAR(at.x, x, 1e-14);
  EXPECT_NEAR(at.y, y, 1e-14);
}

TEST(Affine, LastOfAProductIsDoneFirst) {
  Affine const twice = {2, 0, 0, 2, 0, 0};
  Affine const moved = {1, 0, 0, 1, 10, 0};
  ExpectAt((twice * moved)({1, 1}), 22, 2);
  ExpectAt((moved * twice)({1, 1}), 12, 2);
}

TEST(Affine, ProductsAgreeWithOneAfterTheOther) {
  Testing::RandomGeometry random(4);
  for (int round = 0; round < 200; ++round) {
    auto const any = [&] {
      return Affine{random.Uniform(-2, 2), random.Uniform(-2, 2), random.Uniform(-2, 2),
                    random.Uniform(-2, 2), random.Uniform(-9, 9), random.Uniform(-9, 9)};
    };
    Affine const first = any();
    Affine const second = any();
    XY const at = random.PointIn(-5, 5);
    XY const expected = first(second(at));
    EXPECT_NEAR((first * second)(at).x, expected.x, 1e-12);
    EXPECT_NEAR((first * second)(at).y, expected.y, 1e-12);
    EXPECT_NEAR((first * second).Determinant(), first.Determinant() * second.Determinant(), 1e-12);
  }
}

TEST(Affine, CirclesStayCirclesWhereBothAxesGrowAlikeAndStaySquare) {
  EXPECT_TRUE((Affine{0.6, 0.8, -0.8, 0.6, 5, 5}).IsSimilarity());
  EXPECT_TRUE((Affine{3, 0, 0, -3, 0, 0}).IsSimilarity()) << "a mirror";
  EXPECT_FALSE((Affine{3, 0, 0, 3.001, 0, 0}).IsSimilarity());
  EXPECT_FALSE((Affine{1, 0, 0.001, 1, 0, 0}).IsSimilarity());
  EXPECT_TRUE((Affine{1, 0, 0, 1 + 1e-10, 0, 0}).IsSimilarity()) << "rounding";
}

TEST(SvgTransform, EachFunctionDoesWhatItSays) {
  auto const apply = [](std::string_view text) { return SvgTransform(Element(), text)({2, 3}); };
  ExpectAt(apply(""), 2, 3);
  ExpectAt(apply("translate(10)"), 12, 3);
  ExpectAt(apply("translate(10, -1)"), 12, 2);
  ExpectAt(apply("scale(2)"), 4, 6);
  ExpectAt(apply("scale(2 -1)"), 4, -3);
  ExpectAt(apply("rotate(90)"), -3, 2);
  ExpectAt(apply("rotate(90, 2, 2)"), 1, 2);
  ExpectAt(apply("skewX(45)"), 5, 3);
  ExpectAt(apply("skewY(45)"), 2, 5);
  ExpectAt(apply("matrix(1 2 3 4 5 6)"), 2 + 9 + 5, 4 + 12 + 6);
  ExpectAt(apply(" translate(1),scale(2)\n rotate(180) "), 1 - 4, -6);
}

TEST(SvgTransform, NamesWhatIsWrong) {
  auto const complaint = [](std::string_view text) {
    return Refusal([&] { SvgTransform(Element(), text); });
  };
  EXPECT_EQ(complaint("spin(3)"), "p.svg:3:5: path: transform 'spin(3)' is not known");
  EXPECT_EQ(complaint("scale(1,2,3)"), "p.svg:3:5: path: transform 'scale(1,2,3)' is not known");
  EXPECT_EQ(complaint("rotate()"), "p.svg:3:5: path: transform 'rotate()' is not known");
  EXPECT_EQ(complaint("scale(2) translate"),
            "p.svg:3:5: path: transform 'translate' is no function with its numbers in brackets");
  EXPECT_EQ(complaint(")scale("),
            "p.svg:3:5: path: transform ')scale(' is no function with its numbers in brackets");
  EXPECT_NE(complaint("scale(two)"), "");
  EXPECT_NE(complaint("scale(1e200)"), "");
}

TEST(SvgNumbers, NumbersNeedLittleBetweenThem) {
  auto const list = [](std::string_view text) { return SvgNumberList(Element(), text); };
  EXPECT_TRUE(list("").empty());
  EXPECT_TRUE(list(" \t\n").empty());
  EXPECT_EQ(list("1,2 3\t4\n5 , 6"), (std::vector<double>{1, 2, 3, 4, 5, 6}));
  EXPECT_EQ(list("1-2+3"), (std::vector<double>{1, -2, 3}));
  EXPECT_EQ(list(".5.25.125"), (std::vector<double>{0.5, 0.25, 0.125}));
  EXPECT_EQ(list("1e2-3E-1"), (std::vector<double>{100, -0.3}));
}

TEST(SvgNumbers, AnEThatBeginsNoExponentIsNoPartOfTheNumber) {
  XmlElement const element = Element();
  SvgNumbers numbers(element, "5em");
  EXPECT_EQ(numbers.Number(), 5.0);
  EXPECT_FALSE(numbers.IsNumberNext());
  EXPECT_EQ(numbers.Take(), 'e');
}

TEST(SvgNumbers, FlagsAreSingleDigits) {
  XmlElement const element = Element();
  SvgNumbers numbers(element, "10 .5");
  EXPECT_TRUE(numbers.Flag());
  EXPECT_FALSE(numbers.Flag());
  EXPECT_EQ(numbers.Number(), 0.5);
  EXPECT_TRUE(numbers.AtEnd());
  SvgNumbers two(element, "2");
  EXPECT_EQ(Refusal([&] { two.Flag(); }),
            "p.svg:3:5: path: '2', character 1 of an attribute, is neither 0 nor 1");
}

TEST(SvgNumbers, SayWhereTheTextGoesWrong) {
  auto const complaint = [](std::string_view text) {
    return Refusal([&] { SvgNumberList(Element(), text); });
  };
  EXPECT_EQ(complaint("1 2 x"),
            "p.svg:3:5: path: 'x', character 5 of an attribute, is not a number");
  EXPECT_EQ(complaint("1,,2"),
            "p.svg:3:5: path: ',', character 3 of an attribute, is not a number");
  EXPECT_EQ(complaint("- 1"), "p.svg:3:5: path: '-', character 1 of an attribute, is not a number");
  EXPECT_EQ(complaint("1e151"),
            "p.svg:3:5: path: '1e151', character 1 of an attribute, is too large");
}

TEST(ParseSvgLength, TakesNumberAndUnitApart) {
  auto const parts = [](std::string_view text) {
    SvgLength const length = ParseSvgLength(Element(), text);
    return std::pair(length.value, length.unit);
  };
  using Pair = std::pair<double, std::string>;
  EXPECT_EQ(parts("12"), Pair(12, ""));
  EXPECT_EQ(parts(" 2.5 MM "), Pair(2.5, "mm"));
  EXPECT_EQ(parts("1e2px"), Pair(100, "px"));
  EXPECT_EQ(parts("50%"), Pair(50, "%"));
  for (char const* text : {"", "mm", "1mm2", "1,5mm", "inf", "nan"}) {
    EXPECT_NE(Refusal([&] { ParseSvgLength(Element(), text); }), "") << text;
  }
}

TEST(ReadSvgPage, AnInchIsTheSameLengthInEveryUnit) {
  for (auto const& [width, box] : std::vector<std::pair<std::string_view, std::string_view>>{
           {"25.4mm", "0 0 1 1"}, {"2.54cm", "0 0 1 1"}, {"72pt", "0 0 1 1"}, {"6pc", "0 0 1 1"}}) {
    SvgPage const page = ReadSvgPage(Page({{"width", width}, {"viewBox", box}}));
    EXPECT_EQ(page.units, "mm") << width;
    EXPECT_NEAR(page.map({1, 0}).x, 25.4, 1e-12) << width;
    EXPECT_NEAR(page.map({0, 1}).y, -25.4, 1e-12) << width;
  }
  SvgPage const inch = ReadSvgPage(Page({{"width", "1in"}, {"viewBox", "0 0 1 1"}}));
  EXPECT_EQ(inch.units, "inch");
  EXPECT_EQ(inch.map({1, 0}).x, 1.0);
}

TEST(ReadSvgPage, WithoutAViewBoxUnitsArePixels) {
  SvgPage const page = ReadSvgPage(Page({{"width", "10mm"}}));
  EXPECT_EQ(page.units, "mm");
  EXPECT_NEAR(page.map({96, 0}).x, 25.4, 1e-12) << "96 to the inch";
}

TEST(ReadSvgPage, WithoutATrueSizeTheNumbersStay) {
  for (auto const& attributes :
       std::vector<std::vector<std::pair<std::string_view, std::string_view>>>{
           {}, {{"width", "100%"}}, {{"width", "640"}, {"height", "480px"}}}) {
    SvgPage const page = ReadSvgPage(Page(attributes));
    EXPECT_EQ(page.units, "");
    ExpectAt(page.map({3, 4}), 3, -4);
  }
}

TEST(ReadSvgPage, TheSmallerScaleCountsUnlessThePageStretches) {
  std::vector<std::pair<std::string_view, std::string_view>> attributes = {
      {"width", "200mm"}, {"height", "50mm"}, {"viewBox", "0 0 100 100"}};
  EXPECT_NEAR(ReadSvgPage(Page(attributes)).map({1, 0}).x, 0.5, 1e-12);
  attributes.emplace_back("preserveAspectRatio", "none");
  EXPECT_EQ(Refusal([&] { ReadSvgPage(Page(attributes)); }),
            "p.svg:3:5: svg: the page stretches the drawing");
}

TEST(ReadSvgPage, RefusesPagesThatAreNone) {
  for (auto const& attributes :
       std::vector<std::vector<std::pair<std::string_view, std::string_view>>>{
           {{"width", "0mm"}},
           {{"height", "-5mm"}},
           {{"width", "1mm"}, {"viewBox", "0 0 0 1"}},
           {{"width", "1mm"}, {"viewBox", "0 0 1"}},
           {{"width", "1mm"}, {"viewBox", "0 0 -1 1"}},
           {{"width", "x"}}}) {
    EXPECT_NE(Refusal([&] { ReadSvgPage(Page(attributes)); }), "") << attributes.front().second;
  }
}

}  // namespace
}  // namespace Vorn::IO
