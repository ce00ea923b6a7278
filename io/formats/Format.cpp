#include <array>
#include <filesystem>

#include "io/base/FirstLine.h"
#include "io/base/Words.h"
#include "io/formats/CsvPieces.h"
#include "io/formats/Dxf.h"
#include "io/formats/GCode.h"
#include "io/formats/GeoJson.h"
#include "io/formats/JsonPieces.h"
#include "io/formats/Svg.h"
#include "io/formats/Text.h"
#include "io/formats/Wkt.h"
#include "vorn/io/Failure.h"
#include "vorn/io/Formats.h"
#include "vorn/io/Messages.h"
#include "vorn/io/Numbers.h"

namespace Vorn::IO {

namespace {

struct NamedFormat {
  std::string_view name;
  Format format;
};

/// The first name of a format is the one it goes by; each is the ending of a file as well.
constexpr std::array<NamedFormat, 12> kFormats = {{
    {"json", Format::Json},
    {"csv", Format::Csv},
    {"dxf", Format::Dxf},
    {"gcode", Format::GCode},
    {"nc", Format::GCode},
    {"wkt", Format::Wkt},
    {"geojson", Format::GeoJson},
    {"svg", Format::Svg},
    {"html", Format::Html},
    {"htm", Format::Html},
    {"png", Format::Png},
    {"ngc", Format::GCode},
}};

bool LooksLikeGCode(std::string_view line) {
  constexpr std::string_view kSigns = "%(;";
  constexpr std::string_view kLetters = "gmnotsfxyz";
  if (kSigns.find(line.front()) != std::string_view::npos) return true;
  bool const isWord = line.size() > 1 && IsDigit(line[1]);
  return isWord && kLetters.find(line.front()) != std::string_view::npos;
}

}  // namespace

std::optional<Format> FormatNamed(std::string_view name) {
  std::string const lower = LowerCase(name);
  for (NamedFormat const& known : kFormats) {
    if (known.name == lower) return known.format;
  }
  return {};
}

std::optional<Format> FormatOf(std::string const& path) {
  std::string const ending = std::filesystem::path(path).extension().string();
  return ending.empty() ? std::nullopt : FormatNamed(ending.substr(1));
}

std::string NameOf(Format format) {
  for (NamedFormat const& known : kFormats) {
    if (known.format == format) return std::string(known.name);
  }
  return "unknown";
}

std::optional<Format> FormatOfContent(std::string_view text) {
  std::string const line = FirstLine(text);
  if (line.empty()) return {};
  if (line.front() == '{') return Format::Json;
  if (line.front() == '<') return Format::Svg;
  if (line == "0" || line == "999") return Format::Dxf;
  if (LooksLikeWkt(line)) return Format::Wkt;
  if (line.find("start_x") != std::string::npos) return Format::Csv;
  if (LooksLikeGCode(line)) return Format::GCode;
  return {};
}

bool HoldsContour(Format format) { return format != Format::Svg && IsReadAsContour(format); }

bool HoldsContour(Format format, WriteOptions const& options) {
  return HoldsContour(format) || (format == Format::Svg && options.svgPlain);
}

bool IsReadAsContour(Format format) { return format != Format::Html && format != Format::Png; }

namespace {

std::string AsDxf(ContourFile const& contour, WriteOptions const& options) {
  DxfStyle const style = options.dxfEntities ? DxfStyle::Entities : DxfStyle::Polyline;
  return options.dxfVersion == DxfVersion::R12 ? ToDxf(contour, style) : ToDxf2000(contour, style);
}

std::string Written(ContourFile const& contour, Format format, WriteOptions const& options) {
  switch (format) {
    case Format::Json:
      return ToJson(contour);
    case Format::Csv:
      return ToCsv(contour);
    case Format::Dxf:
      return AsDxf(contour, options);
    case Format::GCode:
      return ToGCode(contour, options.gcode);
    case Format::Wkt:
      return ToWkt(contour);
    case Format::GeoJson:
      return ToGeoJson(contour, options.chords);
    case Format::Svg:
      if (options.svgPlain) return ToPlainSvg(contour);
      [[fallthrough]];
    default:
      throw Failure(FailureKind::BadArgument, NameOf(format) + " holds no contour");
  }
}

}  // namespace

std::string ToText(ContourFile const& contour, Format format, WriteOptions const& options) {
  ContourFile written = contour;
  RemovePiecesWithoutLength(&written.pieces);
  if (written.pieces.empty()) {
    throw Failure(FailureKind::BadArgument, {contour.path},
                  "there is nothing to write: no piece has a length");
  }
  return Written(written, format, options);
}

}  // namespace Vorn::IO
