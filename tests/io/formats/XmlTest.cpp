#include <gtest/gtest.h>

#include <stdexcept>

#include "io/FormatContours.h"
#include "io/formats/Xml.h"

namespace Vorn::IO {
namespace {

using namespace FormatContours;

/// Writes down what it gets: "<a x=1> <b> </> </>".
class Record final : public XmlVisitor {
 public:
  void Begin(XmlElement const& element) override {
    text_ += "<" + std::string(element.tag);
    for (auto const& [name, value] : element.attributes) {
      text_ += " " + std::string(name) + "=" + std::string(value);
    }
    text_ += ">";
    places_.push_back(element.place);
    ++depth_;
    deepest_ = std::max(deepest_, depth_);
  }
  void End() override {
    text_ += "</>";
    --depth_;
  }

  std::string const& Text() const { return text_; }
  std::vector<Place> const& Places() const { return places_; }
  int Depth() const { return depth_; }
  int Deepest() const { return deepest_; }

 private:
  std::string text_;
  std::vector<Place> places_;
  int depth_ = 0;
  int deepest_ = 0;
};

std::string Walked(std::string const& text) {
  Record record;
  WalkXml(text, "p.svg", &record);
  EXPECT_EQ(record.Depth(), 0);
  return record.Text();
}

std::string Complaint(std::string const& text) {
  return Refusal([&] { Walked(text); });
}

TEST(WalkXml, TellsElementsInTheirOrder) {
  EXPECT_EQ(Walked("<a><b/><c><d/></c></a>"), "<a><b></><c><d></></></>");
}

TEST(WalkXml, AttributesKeepTheirOrderAndAreUnescaped) {
  EXPECT_EQ(Walked("<a y='2' x=\"1\" t=\"&lt;&amp;&#65;\"/>"), "<a y=2 x=1 t=<&A></>");
}

TEST(WalkXml, NamespacesAreLeftOut) {
  EXPECT_EQ(Walked("<s:svg xmlns:s='urn:s' xmlns:k='urn:k' k:x='1'><s:path/></s:svg>"),
            "<svg x=1><path></></>");
  EXPECT_EQ(Walked("<svg xmlns='urn:s'/>"), "<svg></>");
}

TEST(WalkXml, TextsCommentsAndInstructionsAreNoElements) {
  EXPECT_EQ(Walked("<?xml version='1.0'?><!-- <b/> --><a>text<![CDATA[<c/>]]><?php x?></a>"),
            "<a></>");
}

TEST(WalkXml, PlacesAreLineAndColumnOfTheTag) {
  Record record;
  WalkXml("<a>\n  <b/>\n\n<c/></a>", "p.svg", &record);
  ASSERT_EQ(record.Places().size(), 3u);
  EXPECT_EQ(record.Places()[0].line, 1u);
  EXPECT_EQ(record.Places()[0].column, 1u);
  EXPECT_EQ(record.Places()[1].line, 2u);
  EXPECT_EQ(record.Places()[1].column, 3u);
  EXPECT_EQ(record.Places()[2].line, 4u);
  EXPECT_EQ(record.Places()[2].file, "p.svg");
}

TEST(WalkXml, SaysWhereTheTextIsNotXml) {
  for (auto const& [text, place] :
       std::vector<std::pair<std::string, std::string>>{{"<a>\n <b></a>", "p.svg:2:"},
                                                        {"<a", "p.svg:1:"},
                                                        {"<a/><b/>", "p.svg:1:5"},
                                                        {"<a x=1/>", "p.svg:1:"},
                                                        {"<a x='1' x='2'/>", "p.svg:1:"},
                                                        {"<a>&nope;</a>", "p.svg:1:"},
                                                        {"<k:a/>", "p.svg:1:"},
                                                        {"", "p.svg:1:1"},
                                                        {"text", "p.svg:1:1"}}) {
    std::string const complaint = Complaint(text);
    EXPECT_TRUE(complaint.starts_with(place)) << text << ": " << complaint;
    EXPECT_NE(complaint.find("is not XML from here on: "), std::string::npos) << complaint;
  }
}

TEST(WalkXml, AThousandElementsDeepIsTheMost) {
  auto const nested = [](int depth) {
    std::string text;
    for (int i = 0; i < depth; ++i) text += "<g>";
    for (int i = 0; i < depth; ++i) text += "</g>";
    return text;
  };
  Record record;
  WalkXml(nested(1000), "p.svg", &record);
  EXPECT_EQ(record.Deepest(), 1000);
  EXPECT_EQ(Complaint(nested(1001)), "p.svg:1:3001: g: is nested deeper than 1000 elements");
}

TEST(WalkXml, OneGibibyteIsTheMost) {
  // The text is not read before it is refused, so that one byte may stand for all.
  std::string const text = "<a/>";
  std::size_t const tooLarge = (std::size_t{1} << 30) + 1;
  Record record;
  try {
    WalkXml({text.data(), tooLarge}, "p.svg", &record);
    FAIL();
  } catch (Failure const& failure) {
    EXPECT_EQ(failure.what(), std::string("p.svg: is too large: more than 1024 MiB"));
  }
}

TEST(WalkXml, WhatTheVisitorThrowsComesOutAndEndsTheWalk) {
  class Thrower final : public XmlVisitor {
   public:
    void Begin(XmlElement const& /*element*/) override {
      ++begun;
      if (begun == 2) throw std::runtime_error("enough");
    }
    void End() override { ++ended; }
    int begun = 0;
    int ended = 0;
  };
  Thrower visitor;
  EXPECT_THROW(WalkXml("<a><b/><c/></a>", "p.svg", &visitor), std::runtime_error);
  EXPECT_EQ(visitor.begun, 2);
  EXPECT_EQ(visitor.ended, 0);
}

TEST(XmlElement, AnswersWithTheFirstAttributeOfTheName) {
  XmlElement element;
  element.attributes = {{"x", "1"}, {"y", ""}};
  EXPECT_EQ(element["x"], "1");
  EXPECT_EQ(element["y"], "");
  EXPECT_FALSE(element["X"]);
  EXPECT_FALSE(element[""]);
}

}  // namespace
}  // namespace Vorn::IO
