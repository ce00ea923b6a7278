#include "io/points/ColumnNames.h"

#include <algorithm>
#include <array>

#include "io/base/Encoding.h"
#include "io/base/Fields.h"
#include "io/base/Words.h"
#include "vorn/io/Messages.h"
#include "vorn/io/Numbers.h"

namespace Vorn::IO {

namespace {

constexpr std::array<std::string_view, 15> kUnits = {
    "mm", "cm",   "dm",     "m",  "km", "um",  "\xC2\xB5m", "\xCE\xBCm",
    "nm", "inch", "inches", "in", "ft", "mil", "zoll"};

/// Words that stand beside the letter of an axis.
constexpr std::array<std::string_view, 32> kBesideAxis = {"pos",
                                                          "position",
                                                          "coord",
                                                          "coordinate",
                                                          "coordinates",
                                                          "coordonnee",
                                                          "coordonn\xC3\xA9"
                                                          "e",
                                                          "koord",
                                                          "koordinate",
                                                          "wert",
                                                          "value",
                                                          "val",
                                                          "valeur",
                                                          "achse",
                                                          "axis",
                                                          "axe",
                                                          "ist",
                                                          "istwert",
                                                          "actual",
                                                          "act",
                                                          "mess",
                                                          "messwert",
                                                          "meas",
                                                          "measured",
                                                          "mesure",
                                                          "mesur\xC3\xA9",
                                                          "reel",
                                                          "r\xC3\xA9"
                                                          "el",
                                                          "real",
                                                          "point",
                                                          "punkt",
                                                          "pt"};

/// Words that are a coordinate by themselves: along a profile or to the right, and up.
constexpr std::array<std::string_view, 16> kAlong = {
    "length",   "l\xC3\xA4nge", "laenge",   "longueur", "abscissa", "abszisse",
    "abscisse", "rechtswert",   "easting",  "distance", "weg",      "station",
    "chainage", "traverse",     "vorschub", "strecke"};
constexpr std::array<std::string_view, 12> kUp = {"height",
                                                  "h\xC3\xB6he",
                                                  "hoehe",
                                                  "hauteur",
                                                  "ordinate",
                                                  "ordonn\xC3\xA9"
                                                  "e",
                                                  "ordonnee",
                                                  "hochwert",
                                                  "northing",
                                                  "profil",
                                                  "profile",
                                                  "elevation"};

constexpr std::array<std::string_view, 34> kOther = {
    "nr",        "no",        "num",   "number",      "nummer",    "numero",  "num\xC3\xA9ro",
    "n\xC2\xB0", "n\xC2\xBA", "#",     "id",          "index",     "idx",     "i",
    "point",     "pt",        "punkt", "pkt",         "punktnr",   "pointno", "lfdnr",
    "count",     "zeile",     "line",  "ligne",       "time",      "zeit",    "temps",
    "t",         "date",      "datum", "punktnummer", "messpunkt", "pos"};

/// Words that make a coordinate one that was meant and not one that was measured.
constexpr std::array<std::string_view, 6> kNominal = {"nominal",  "nom",         "soll",
                                                      "sollwert", "theoretical", "theorique"};

template <typename List>
bool Holds(List const& list, std::string_view word) {
  return std::find(list.begin(), list.end(), word) != list.end();
}

std::string_view WithoutBrackets(std::string_view text) {
  bool const isBracketed = text.size() >= 2 && ((text.front() == '[' && text.back() == ']') ||
                                                (text.front() == '(' && text.back() == ')'));
  return isBracketed ? Trimmed(text.substr(1, text.size() - 2)) : text;
}

/// Takes the unit from the end of the name.
std::string TakeUnit(std::string_view* name) {
  std::size_t const begin = name->find_last_of("[(/_ \t");
  if (begin == std::string_view::npos) return {};
  std::string_view const unit = WithoutBrackets(Trimmed(name->substr(begin)).substr(0));
  std::string_view const bare = !unit.empty() && (unit.front() == '/' || unit.front() == '_')
                                    ? Trimmed(unit.substr(1))
                                    : unit;
  if (!Holds(kUnits, LowerCase(bare))) return {};
  *name = Trimmed(name->substr(0, begin));
  return std::string(bare);
}

/// The words of a name in lower case: "X-Pos" is x and pos.
std::vector<std::string> WordsOf(std::string_view name) {
  std::vector<std::string> words;
  std::string word;
  for (char const c : LowerCase(name) + " ") {
    if (std::string_view(" \t-_.:,/()[]").find(c) == std::string_view::npos) {
      word += c;
    } else if (!word.empty()) {
      words.push_back(word);
      word.clear();
    }
  }
  return words;
}

std::optional<ColumnKind> AxisNamed(std::string_view letter) {
  if (letter == "x") return ColumnKind::X;
  if (letter == "y") return ColumnKind::Y;
  if (letter == "z") return ColumnKind::Z;
  return {};
}

/// The axis of a word such as x, posx, xwert.
std::optional<ColumnKind> AxisIn(std::string const& word) {
  if (auto const axis = AxisNamed(word)) return axis;
  if (word.size() < 2) return {};
  if (Holds(kBesideAxis, word.substr(1))) return AxisNamed(word.substr(0, 1));
  if (Holds(kBesideAxis, word.substr(0, word.size() - 1)))
    return AxisNamed(word.substr(word.size() - 1));
  return {};
}

ColumnKind KindOf(std::vector<std::string> const& words) {
  std::optional<ColumnKind> axis;
  bool areKnown = true;
  for (std::string const& word : words) {
    if (Holds(kNominal, word)) return ColumnKind::Other;
    std::optional<ColumnKind> const found = AxisIn(word);
    if (found && axis) return ColumnKind::Unknown;
    if (found) axis = found;
    areKnown = areKnown && (found || Holds(kBesideAxis, word));
  }
  if (axis) return areKnown ? *axis : ColumnKind::Unknown;
  if (words.size() != 1) {
    bool const areOther =
        !words.empty() && std::all_of(words.begin(), words.end(),
                                      [](auto const& w) { return Holds(kOther, w) || w == "lfd"; });
    return areOther ? ColumnKind::Other : ColumnKind::Unknown;
  }
  if (Holds(kAlong, words[0])) return ColumnKind::X;
  if (Holds(kUp, words[0])) return ColumnKind::Y;
  return Holds(kOther, words[0]) ? ColumnKind::Other : ColumnKind::Unknown;
}

/// The one column of the kind; nothing when there is none or more than one.
std::optional<std::size_t> OnlyOne(std::vector<ColumnName> const& names, ColumnKind kind) {
  std::optional<std::size_t> found;
  for (std::size_t i = 0; i < names.size(); ++i) {
    if (names[i].kind != kind) continue;
    if (found) return {};
    found = i;
  }
  return found;
}

bool AnyOf(std::vector<ColumnName> const& names, ColumnKind kind) {
  return std::any_of(names.begin(), names.end(),
                     [kind](ColumnName const& name) { return name.kind == kind; });
}

std::optional<PointColumns> ByAxes(std::vector<ColumnName> const& names) {
  bool const hasZ = AnyOf(names, ColumnKind::Z);
  auto const x = OnlyOne(names, ColumnKind::X);
  auto const y = OnlyOne(names, ColumnKind::Y);
  auto const z = OnlyOne(names, ColumnKind::Z);
  // Of three axes it is not known in which plane the points lie.
  if (x && y && !hasZ) return PointColumns{*x, *y};
  if (x && z && !AnyOf(names, ColumnKind::Y)) return PointColumns{*x, *z};
  if (y && z && !AnyOf(names, ColumnKind::X)) return PointColumns{*y, *z};
  return {};
}

}  // namespace

ColumnName ReadColumnName(std::string_view field) {
  std::string const text = Utf8FromEither(Unquoted(field));
  std::string_view name = Trimmed(text);
  ColumnName column;
  column.unit = TakeUnit(&name);
  column.kind = name == "#" ? ColumnKind::Other : KindOf(WordsOf(name));
  return column;
}

bool IsUnit(std::string_view field) {
  return Holds(kUnits, LowerCase(WithoutBrackets(Trimmed(Utf8FromEither(Unquoted(field))))));
}

std::optional<PointColumns> FindPointColumns(std::vector<ColumnName> const& names,
                                             std::optional<std::size_t> tolerance) {
  if (auto const columns = ByAxes(names)) return columns;
  std::vector<std::size_t> left;
  for (std::size_t i = 0; i < names.size(); ++i) {
    if (names[i].kind != ColumnKind::Other && i != tolerance) left.push_back(i);
  }
  if (left.size() != 2) return {};
  ColumnKind const first = names[left[0]].kind;
  ColumnKind const second = names[left[1]].kind;
  bool const areInOrder =
      (first == ColumnKind::Unknown || first == ColumnKind::X) && second != ColumnKind::X;
  if (!areInOrder) return {};
  return PointColumns{left[0], left[1]};
}

}  // namespace Vorn::IO
