#include <algorithm>
#include <map>
#include <nlohmann/json.hpp>
#include <string_view>

#include "HtmlParts.h"
#include "io/drawing/HtmlPoints.h"
#include "io/drawing/Layout.h"
#include "io/drawing/SvgElements.h"
#include "io/measure/MeasureJson.h"
#include "vorn/io/Drawing.h"

namespace Vorn::IO {

namespace {

using Json = nlohmann::ordered_json;

/// The size on a common screen that the magnification is chosen for, in pixels.
constexpr double kScreenWidth = 900.0;
constexpr double kScreenHeight = 420.0;

Json Place(GeometryUtils::Point const& point) { return Json::array({point.x, point.y}); }

Json PieceJson(Piece const& piece, PieceMeasure const& measure) {
  Json json = {{"kind", piece.IsArc() ? "arc" : "line"},
               {"start", Place(piece.start)},
               {"end", Place(piece.end)},
               {"length", piece.length},
               {"measured", LeastSquaresJson(measure)},
               {"turn", OrNull(measure.turn)}};
  if (!piece.IsArc()) return json;
  json["center"] = Place(piece.center);
  json["radius"] = piece.radius;
  json["ccw"] = piece.counterClockwise;
  json["startAngle"] = piece.startAngle;
  json["sweep"] = piece.sweep;
  return json;
}

Json PiecesJson(Drawing const& drawing) {
  std::vector<WPoint> const none;
  std::vector<PieceMeasure> const measures =
      MeasurePieces(drawing.IsMeasured() ? drawing.points : none, drawing.deviations,
                    drawing.pieces, drawing.IsClosed());
  Json pieces = Json::array();
  for (std::size_t i = 0; i < drawing.pieces.size(); ++i) {
    pieces.push_back(PieceJson(drawing.pieces[i], measures[i]));
  }
  return pieces;
}

Json SummaryJson(Drawing const& drawing) {
  DeviationSummary const summary =
      Summarise(drawing.points, drawing.deviations, drawing.HasTolerances());
  return {{"mean", summary.mean},
          {"rootMeanSquare", summary.rootMeanSquare},
          {"outside", summary.outside},
          {"histogram", HistogramJson(summary)}};
}

/// Pairs, because a browser would put names that are numbers first.
Json HeadJson(Drawing const& drawing) {
  Json fields = Json::array();
  for (ReportField const& field : drawing.head.fields) {
    fields.push_back(Json::array({field.name, field.value}));
  }
  return fields;
}

double MagnifyOnScreen(Drawing const& drawing) {
  if (drawing.magnify) return *drawing.magnify;
  Svg::View const screen(Svg::BoxAround(drawing), 0.0, 0.0, kScreenWidth, kScreenHeight,
                         kScreenHeight);
  return Svg::ReadableMagnification(drawing, screen.Scale());
}

Json VerdictJson(Drawing const& drawing) {
  if (!drawing.verdict) return nullptr;
  return {{"text", Describe(*drawing.verdict)},
          {"isGood", *drawing.verdict == Verdict::WithinTolerance}};
}

Json DataJson(Drawing const& drawing) {
  Json facts = Json::array();
  for (std::string const& fact : drawing.facts) {
    if (!fact.empty()) facts.push_back(fact);
  }
  Json json = {{"title", drawing.title}, {"facts", facts}, {"units", drawing.units}};
  json["fields"] = HeadJson(drawing);
  json["program"] = drawing.head.program;
  json["points"] = PointsJson(drawing);
  json["pieces"] = Json::array();
  json["verdict"] = VerdictJson(drawing);
  if (!drawing.HasContour()) return json;
  json["pieces"] = PiecesJson(drawing);
  json["isClosed"] = drawing.IsClosed();
  if (!drawing.IsMeasured()) return json;
  json["deviations"] = DeviationsJson(drawing);
  json["band"] = BandJson(drawing);
  json["worst"] = drawing.Worst();
  json["summary"] = SummaryJson(drawing);
  json["magnify"] = MagnifyOnScreen(drawing);
  return json;
}

/// JSON that may stand inside a script element: with no `<` in it, nothing can end the element or
/// begin a comment. In JSON the character occurs only inside strings, where it may be escaped.
std::string EmbeddedJson(Json const& json) {
  std::string text;
  for (char const c : json.dump(-1, ' ', false, Json::error_handler_t::replace)) {
    if (c == '<') {
      text += "\\u003c";
    } else {
      text += c;
    }
  }
  return text;
}

/// The page with each `{{name}}` replaced, in one pass: what is put in is not looked at again.
std::string Filled(std::string_view page,
                   std::map<std::string, std::string, std::less<>> const& parts) {
  std::string filled;
  for (;;) {
    std::size_t const open = page.find("{{");
    filled += page.substr(0, open);
    if (open == std::string_view::npos) return filled;
    std::size_t const close = page.find("}}", open);
    filled += parts.find(page.substr(open + 2, close - open - 2))->second;
    page.remove_prefix(close + 2);
  }
}

}  // namespace

std::string ToHtml(Drawing const& drawing) {
  drawing.RequireContent();
  std::string script;
  for (char const* const part : Html::kScript) script += part;
  // A file name need not be UTF-8; the page is.
  Json const title = drawing.title;
  std::string const name = Json::parse(title.dump(-1, ' ', false, Json::error_handler_t::replace));
  return Filled(Html::kPage, {{"title", Svg::Escaped(name)},
                              {"style", Html::kStyle},
                              {"data", EmbeddedJson(DataJson(drawing))},
                              {"script", script}});
}

}  // namespace Vorn::IO
