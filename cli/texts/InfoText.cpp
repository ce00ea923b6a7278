#include "cli/texts/InfoText.h"

#include <algorithm>

#include "cli/texts/Columns.h"
#include "vorn/io/Messages.h"
#include "vorn/io/Numbers.h"

namespace Vorn::Cli {

namespace {

constexpr std::size_t kMostListed = 10;

/// Lines of a name and a text; lines without a name go on with the one above.
class FactList {
 public:
  void Add(std::string const& name, std::string const& text) { text_ += Fact(name, text); }

  void GoOn(std::string const& text) { Add("", text); }

  /// What goes beyond the first few of a list of `count`.
  void AddRest(std::size_t count) {
    if (count > kMostListed) GoOn("and " + std::to_string(count - kMostListed) + " more");
  }

  std::string Take() { return std::move(text_); }

 private:
  std::string text_;
};

std::string Range(double low, double high) {
  return FormatShort(low) + " to " + FormatShort(high) + " (" + FormatShort(high - low) + ")";
}

std::string PairName(PointFile const& file, std::size_t first, std::size_t second) {
  return file.NameOf(first) + " and " + file.NameOf(second);
}

void AddSize(InfoReport const& report, FactList* facts) {
  PointsBox const& box = report.info.box;
  facts->Add("points", std::to_string(report.file.points.size()));
  if (!report.file.columns.empty()) facts->Add("columns", report.file.columns);
  if (!report.file.skipped.empty()) facts->Add("skipped", report.file.skipped);
  facts->Add("extent", "x " + Range(box.lowX, box.highX) + ", y " + Range(box.lowY, box.highY));
  facts->Add("length", FormatShort(report.info.spacing.length) + " from point to point");
}

void AddSpacing(InfoReport const& report, FactList* facts) {
  SpacingFacts const& spacing = report.info.spacing;
  facts->Add("spacing", "least " + FormatShort(spacing.least) + " between " +
                            PairName(report.file, spacing.leastSecond - 1, spacing.leastSecond));
  facts->GoOn("median " + FormatShort(spacing.median));
  facts->GoOn("most " + FormatShort(spacing.most) + " between " +
              PairName(report.file, spacing.mostSecond - 1, spacing.mostSecond));
}

void AddDuplicates(InfoReport const& report, FactList* facts) {
  std::vector<Duplicate> const& duplicates = report.info.duplicates;
  facts->Add("duplicates", duplicates.empty() ? "none" : std::to_string(duplicates.size()));
  for (std::size_t i = 0; i < std::min(duplicates.size(), kMostListed); ++i) {
    facts->GoOn(report.file.NameOf(duplicates[i].later) + " repeats " +
                report.file.NameOf(duplicates[i].earlier));
  }
  facts->AddRest(duplicates.size());
}

std::size_t PairCount(InfoReport const& report) {
  Closure const& closure = report.info.closure;
  std::size_t const count = report.file.points.size();
  return closure.isClosed && !closure.repeatsFirst ? count : count - 1;
}

void AddRule(InfoReport const& report, FactList* facts) {
  std::optional<double> const& largest = report.info.largestTolerance;
  facts->Add("limit", largest ? FormatShort(*largest) +
                                    " is the largest single tolerance that mixed and cells take"
                              : "mixed and cells take no tolerance: neighbours coincide");
  if (!report.rule) return;
  RuleCheck const& rule = *report.rule;
  std::string tolerance = FormatShort(rule.smallest);
  if (rule.smallest != rule.largest) tolerance += " to " + FormatShort(rule.largest);
  std::string const pairs = Counted(PairCount(report), "pair");
  facts->Add("tolerance",
             tolerance + " (" + rule.source + "): " +
                 (rule.broken.empty() ? "no pair is too close"
                                      : std::to_string(rule.broken.size()) + " of " + pairs +
                                            (rule.broken.size() == 1 ? " is" : " are") +
                                            " too close for mixed and cells"));
  for (std::size_t i = 0; i < std::min(rule.broken.size(), kMostListed); ++i) {
    ClosePair const& pair = rule.broken[i];
    std::string const name = PairName(report.file, pair.first, pair.second);
    // Where the tolerance follows the spacing, there is none in one place.
    facts->GoOn(pair.needed > 0.0
                    ? name + ": distance " + FormatShort(pair.distance) + ", needed more than " +
                          FormatShort(pair.needed)
                    : name + " coincide: no tolerance can follow from a spacing of zero");
  }
  facts->AddRest(rule.broken.size());
  if (!rule.broken.empty())
    facts->GoOn("way out: --strategy fewest, the usual one, takes them all");
}

void AddCorners(InfoReport const& report, FactList* facts) {
  std::vector<Corner> sharpest = report.info.corners;
  std::stable_sort(sharpest.begin(), sharpest.end(),
                   [](Corner const& a, Corner const& b) { return a.degrees > b.degrees; });
  std::string const least = FormatShort(kLeastCorner) + " degrees or more";
  facts->Add("corners", sharpest.empty() ? "none of " + least
                                         : std::to_string(sharpest.size()) + " of " + least +
                                               ", the sharpest first");
  for (std::size_t i = 0; i < std::min(sharpest.size(), kMostListed); ++i) {
    Corner const& corner = sharpest[i];
    facts->GoOn(report.file.NameOf(corner.point) + ": " + FormatFixed(corner.degrees, 1) +
                " degrees to the " + (corner.isLeft ? "left" : "right") +
                (corner.IsReversal() ? ", a reversal" : ""));
  }
  facts->AddRest(sharpest.size());
}

void AddClosing(InfoReport const& report, FactList* facts) {
  Closure const& closure = report.info.closure;
  facts->Add("closed", std::string(closure.isClosed ? "yes" : "no") + " (" + closure.reason +
                           "): the gap is " + FormatShort(closure.gap));
}

std::string SuggestionText(Suggestion const& suggestion) {
  switch (suggestion.way) {
    case Suggestion::Way::Same:
    case Suggestion::Way::Fewest:
      return "--tolerance " + FormatShort(suggestion.tolerance) + " (" + suggestion.reason + ")";
    case Suggestion::Way::None:
      return suggestion.reason;
  }
  return "";
}

}  // namespace

std::string ToText(InfoReport const& report) {
  FactList facts;
  AddSize(report, &facts);
  AddSpacing(report, &facts);
  AddDuplicates(report, &facts);
  AddClosing(report, &facts);
  AddCorners(report, &facts);
  AddRule(report, &facts);
  std::optional<double> const& noise = report.info.noise;
  facts.Add("noise", noise ? FormatShort(*noise, 3) + " from point to point (standard deviation)"
                           : "too few points to tell");
  facts.Add("suggestion", SuggestionText(report.info.suggestion));
  std::string const& units = report.file.units;
  return report.file.path + (units.empty() ? "" : ", lengths in " + units) + "\n\n" + facts.Take();
}

}  // namespace Vorn::Cli
