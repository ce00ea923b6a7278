#include <gtest/gtest.h>

#include "io/points/ColumnNames.h"

namespace Vorn::IO {
namespace {

using Kind = ColumnKind;

struct Named {
  char const* field;
  Kind kind;
  char const* unit;
};

TEST(ReadColumnName, UnderstandsWhatInstrumentsWrite) {
  for (Named const& named : {Named{"x", Kind::X, ""},
                             {"X-Pos", Kind::X, ""},
                             {"PosX", Kind::X, ""},
                             {"Pos. Z", Kind::Z, ""},
                             {"X [mm]", Kind::X, "mm"},
                             {"Z/\xC2\xB5m", Kind::Z, "\xC2\xB5m"},
                             {"z_mm", Kind::Z, "mm"},
                             {"Y (inch)", Kind::Y, "inch"},
                             {"x mm", Kind::X, "mm"},
                             {"\"X-Koordinate [mm]\"", Kind::X, "mm"},
                             {"Coordonn\xC3\xA9"
                              "e X",
                              Kind::X, ""},
                             {"Istwert Z", Kind::Z, ""},
                             {"Achse X", Kind::X, ""},
                             {"Axe Z (mm)", Kind::Z, "mm"},
                             {"valeur_y", Kind::Y, ""},
                             {"L\xC3\xA4nge [mm]", Kind::X, "mm"},
                             {"H\xC3\xB6he", Kind::Y, ""},
                             {"Hauteur", Kind::Y, ""},
                             {"Nr", Kind::Other, ""},
                             {"Nr.", Kind::Other, ""},
                             {"Lfd. Nr.", Kind::Other, ""},
                             {"N\xC2\xB0", Kind::Other, ""},
                             {"Time", Kind::Other, ""},
                             {"X Soll", Kind::Other, ""},
                             {"X nominal", Kind::Other, ""},
                             {"radius", Kind::Unknown, ""},
                             {"x velocity", Kind::Unknown, ""},
                             {"", Kind::Unknown, ""}}) {
    ColumnName const name = ReadColumnName(named.field);
    EXPECT_EQ(name.kind, named.kind) << named.field;
    EXPECT_EQ(name.unit, named.unit) << named.field;
  }
}

/// "0 2" for the columns found, "" for none.
std::string Found(std::vector<std::string> const& fields,
                  std::optional<std::size_t> tolerance = std::nullopt) {
  std::vector<ColumnName> names;
  for (std::string const& field : fields) names.push_back(ReadColumnName(field));
  auto const columns = FindPointColumns(names, tolerance);
  return columns ? std::to_string(columns->x) + " " + std::to_string(columns->y) : "";
}

TEST(FindPointColumns, TakesTheTwoAxesThatAreThere) {
  EXPECT_EQ(Found({"x", "y"}), "0 1");
  EXPECT_EQ(Found({"y", "x"}), "1 0");
  EXPECT_EQ(Found({"Nr", "X", "Z"}), "1 2");
  EXPECT_EQ(Found({"Z", "Y", "note"}), "1 0");
  EXPECT_EQ(Found({"X Ist", "X Soll", "Z Ist", "Z Soll"}), "0 2");
  EXPECT_EQ(Found({"id", "x", "y", "w", "note"}), "1 2");
}

TEST(FindPointColumns, TakesTwoColumnsWhoseNamesSayNothing) {
  EXPECT_EQ(Found({"radius", "depth"}), "0 1");
  EXPECT_EQ(Found({"Nr", "a", "b"}), "1 2");
  EXPECT_EQ(Found({"radius", "height"}), "0 1");
  EXPECT_EQ(Found({"a", "w", "b"}, 1), "0 2");
}

TEST(FindPointColumns, RefusesWhatCannotBeTold) {
  EXPECT_EQ(Found({"x", "y", "z"}), "");
  EXPECT_EQ(Found({"x", "x", "y"}), "");
  EXPECT_EQ(Found({"a", "b", "c"}), "");
  EXPECT_EQ(Found({"a", "x"}), "");
  EXPECT_EQ(Found({"height", "radius"}), "");
  EXPECT_EQ(Found({"Nr", "X"}), "");
  EXPECT_EQ(Found({}), "");
}

}  // namespace
}  // namespace Vorn::IO
