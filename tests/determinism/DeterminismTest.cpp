// The library gives the same bits in every build: digests of its results beside recorded ones.
//
// The records depend on two things outside the library. One is IEEE 754 arithmetic in doubles,
// which the build asks of every compiler. The other is the sine, cosine, arc tangent and arc sine
// of the platform's C library (here that of Debian 12 on a processor with fused multiply-add): they
// are not rounded correctly everywhere, so the sections that call them, in the library or for the
// input, are compared only where these functions give the recorded digest themselves.
//
// scripts/compare-determinism compares builds with each other, which needs no records. A record
// changes only with a wanted change of results; core_digest prints new ones.

#include <cstdint>
#include <map>
#include <ostream>
#include <string>
#include <vector>

#include "determinism/Digest.h"
#include "determinism/Sections.h"
#include "gtest/gtest.h"
#include "support/Bits.h"
#include "support/SharedData.h"

namespace Vorn::Testing {

void PrintTo(Section const& section, std::ostream* out) { *out << section.name; }
void PrintTo(ContourSection const& contour, std::ostream* out) { *out << contour.file; }

namespace {

using Strategy = GeometryUtils::FittingStrategy;

constexpr std::uint64_t kRecordedLibm = 0xca6642742352b6f5;

std::map<std::string, std::uint64_t> const kRecordedSections = {
    {"mixedFits", 0x34c636288ac6f106},
    {"mixedCellsFits", 0x3182adf4338e28c3},
    {"singleArcFits", 0x5324a08db19385a4},
    {"fewestProfiles", 0x8b97abc235a24d01},
    {"fewestScans", 0x8d3e1441ad028af5},
    {"fewestScribbles", 0x80c6c07dc76c8944},
    {"angles", 0x51a1950d86935987},
    {"distances", 0x838e37854cc4c0eb},
    {"circles", 0xb8f3b9c24695a0f5},
    {"lineIntersections", 0x91a174bf916d1e74},
    {"arcIntersections", 0x0f8a284dedbedf8a},
    {"triangles", 0x8213ab87bab3334e},
    {"polygons", 0x108be38ea00acf37},
    {"cells", 0x6200deae81d08370},
    {"chains", 0xc4b81e6ddc3207a2},
    {"contours", 0xdf00fdfee95f0497},
    {"flatPolylines", 0xbe53fa06c227903e},
    {"solver", 0x6b6e824728bd8c01},
    {"space", 0x5f4a9af0e5d01207},
    {"rotations", 0xda1845326389dde1},
};

struct RecordedFits {
  std::uint64_t mixed;
  std::uint64_t mixedCells;
  std::uint64_t singleArc;
};

/// Closed contours have no single arc: equal digests there are equal failures.
std::map<std::string, RecordedFits> const kRecordedContours = {
    {"rail_head_known_arcs", {0x7c3e5125cd77526e, 0x183eef1cc4095007, 0x4e3a6ddbc35500a0}},
    {"wheel_worn_a", {0x7d73ab5ffb39b519, 0xfc7646d0a275b023, 0x3cac565d2dc1fe5c}},
    {"rail_worn_low", {0xaa67262f7ca2e9a6, 0x21a58864559f6b49, 0xa4376667446d7e8b}},
    {"mirror_sphere_83m", {0x656e3d48f1cc2e81, 0x141685f00e28d711, 0x9e25d1a7c7d43b6a}},
    {"hatch_boundary", {0x53861c7ac51a4cb5, 0xae86ca021cdbe6ea, 0x0747fbe81c5c1e1e}},
    {"glyph_five", {0x4abde1de5752c877, 0x8b126b2508be7237, 0x4fd3960ad7f92e19}},
    {"test_track_centreline", {0x0b48d4d1323d0fb3, 0x97d28639b9c018fc, 0xbbdb92bfb493048d}},
    {"gcode_letter_d", {0xc923a5970811c029, 0xfe3c2350ed002361, 0x4fd3960ad7f92e19}},
    {"airfoil_clark_y", {0x6dd39a69ffb0eb8c, 0x61eae573f18a7e69, 0xf6acee7e9df273d6}},
    {"circle_r3", {0x399b26efb9990c40, 0xec9ddfaf4cd1b24e, 0x4fd3960ad7f92e19}},
};

bool IsLibmAsRecorded() {
  static bool const isAsRecorded = DigestLibm() == kRecordedLibm;
  return isAsRecorded;
}

class Determinism : public testing::TestWithParam<Section> {};

TEST_P(Determinism, TheBitsOfAllResultsAreTheRecordedOnes) {
  Section const& section = GetParam();
  if (section.dependsOn == DependsOn::Libm && !IsLibmAsRecorded()) {
    GTEST_SKIP() << "the C library's sine or arc tangent differs from the recorded one";
  }
  EXPECT_EQ(section.compute(), kRecordedSections.at(section.name));
}

INSTANTIATE_TEST_SUITE_P(Sections, Determinism, testing::ValuesIn(AllSections()),
                         [](auto const& section) { return std::string(section.param.name); });

class DeterminismOfContours : public testing::TestWithParam<ContourSection> {};

TEST_P(DeterminismOfContours, TheBitsOfAllFitsAreTheRecordedOnes) {
  if (!SharedDataFolder()) GTEST_SKIP() << "VORN_DATA_DIR is not set";
  if (!IsLibmAsRecorded()) {
    GTEST_SKIP() << "the C library's sine or arc tangent differs from the recorded one";
  }
  ContourSection const& contour = GetParam();
  RecordedFits const& recorded = kRecordedContours.at(contour.file);
  EXPECT_EQ(DigestContourFit(contour, Strategy::Mixed), recorded.mixed);
  EXPECT_EQ(DigestContourFit(contour, Strategy::MixedCells), recorded.mixedCells);
  EXPECT_EQ(DigestContourFit(contour, Strategy::SingleArc), recorded.singleArc);
}

INSTANTIATE_TEST_SUITE_P(Files, DeterminismOfContours, testing::ValuesIn(ContourSections()),
                         [](auto const& contour) { return std::string(contour.param.file); });

template <typename... Values>
std::uint64_t DigestOf(Values const&... values) {
  Digest digest;
  digest.Add(values...);
  return digest.Value();
}

TEST(Digest, TellsEveryBitAndTheOrderOfValues) {
  EXPECT_NE(DigestOf(1.0), DigestOf(Up(1.0)));
  EXPECT_NE(DigestOf(0.0), DigestOf(-0.0));
  EXPECT_NE(DigestOf(1.0, 2.0), DigestOf(2.0, 1.0));
  EXPECT_NE(DigestOf(true), DigestOf(false));
  EXPECT_NE(DigestOf(ErrorCode::Ok), DigestOf(ErrorCode::Failed));
  EXPECT_NE(DigestOf(std::vector<std::int32_t>{1, 2}), DigestOf(std::vector<std::int32_t>{1}, 2));
  EXPECT_EQ(DigestOf(kNaN), DigestOf(-kNaN));
}

TEST(Digest, IsTheKnownHashOfBytes) {
  // FNV-1a of eight zero bytes: the start value times the prime to the eighth power.
  std::uint64_t expected = 0xcbf29ce484222325U;
  for (int i = 0; i < 8; ++i) expected *= 0x100000001b3U;
  EXPECT_EQ(DigestOf(0.0), expected);
}

}  // namespace
}  // namespace Vorn::Testing
