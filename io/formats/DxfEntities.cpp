#include "io/formats/DxfEntities.h"

#include <cmath>
#include <optional>
#include <utility>

#include "io/base/Words.h"
#include "io/formats/DxfUnits.h"
#include "io/formats/Text.h"
#include "vorn/io/Messages.h"
#include "vorn/io/Numbers.h"

namespace Vorn::IO::Dxf {

namespace {

/// The group codes of DXF end here; a larger number says that the file is something else.
constexpr double kLargestCode = 1071.0;

/// Goes through the groups of a file.
class Groups {
 public:
  Groups(std::string_view text, std::string path) : lines_(text), path_(std::move(path)) {}

  /// False at the end of the file.
  bool Next(Group* group) {
    std::string_view code;
    if (!NextCode(&code)) return false;
    group->line = lines_.Number();
    group->code = CodeOf(code);
    std::string_view value;
    if (!lines_.Next(&value)) {
      RefuseLine(path_, group->line, "the file stops after group code " + Quoted(code));
    }
    group->value = Trimmed(value);
    return true;
  }

  std::size_t Line() const { return lines_.Number(); }

 private:
  /// Blank lines after the last group are no group.
  bool NextCode(std::string_view* code) {
    while (lines_.Next(code)) {
      *code = Trimmed(*code);
      if (!code->empty()) return true;
    }
    return false;
  }

  int CodeOf(std::string_view text) const {
    std::optional<double> const code = ParseNumber(text);
    if (!code || *code != std::floor(*code) || std::fabs(*code) > kLargestCode) {
      RefuseLine(path_, lines_.Number(), Quoted(text) + " is not a group code");
    }
    return static_cast<int>(*code);
  }

  Lines lines_;
  std::string path_;
};

class Reader {
 public:
  Reader(std::string_view text, std::string const& path) : groups_(text, path), path_(path) {}

  Drawing Read() {
    Group group;
    while (!isAtEnd_ && groups_.Next(&group)) Take(group);
    if (!isAtEnd_) RefuseLine(path_, groups_.Line(), "the file stops without EOF");
    return drawing_;
  }

 private:
  void Take(Group const& group) {
    if (group.code == 999) {
      TakeComment(group.value);
    } else if (group.code == 0) {
      TakeBegin(group);
    } else if (isNameOfSectionNext_) {
      section_ = group.code == 2 ? std::string(group.value) : "";
      isNameOfSectionNext_ = false;
    } else if (section_ == "HEADER") {
      TakeHeader(group);
    } else if (section_ == "ENTITIES" && !drawing_.entities.empty()) {
      drawing_.entities.back().Add(group);
    }
  }

  void TakeComment(std::string_view comment) {
    constexpr std::string_view kUnits = "units ";
    if (comment.starts_with(kUnits)) drawing_.units = Trimmed(comment.substr(kUnits.size()));
  }

  void TakeBegin(Group const& group) {
    isNameOfSectionNext_ = group.value == "SECTION";
    if (group.value == "EOF") {
      isAtEnd_ = true;
    } else if (group.value == "ENDSEC") {
      section_.clear();
    } else if (section_ == "ENTITIES") {
      if (group.value != "VERTEX" && group.value != "SEQEND") ++count_;
      drawing_.entities.emplace_back(group.value, count_, group.line, path_);
    }
  }

  /// Our own comment stands ahead of the header and goes before it.
  void TakeHeader(Group const& group) {
    if (group.code == 9) variable_ = group.value;
    if (variable_ == "$INSUNITS" && group.code == 70 && drawing_.units.empty()) {
      drawing_.units = UnitsNamed(group.value);
    }
  }

  Groups groups_;
  std::string path_;
  Drawing drawing_;
  std::string section_;
  std::string variable_;
  std::size_t count_ = 0;
  bool isNameOfSectionNext_ = false;
  bool isAtEnd_ = false;
};

}  // namespace

Group const* Entity::Find(int code) const {
  for (Group const& group : groups_) {
    if (group.code == code) return &group;
  }
  return nullptr;
}

double Entity::NumberOf(Group const& group) const {
  std::string const what =
      "entity " + std::to_string(number_) + " (" + type_ + "): group " + std::to_string(group.code);
  return RequireNumber(group.value, what, path_, group.line + 1);
}

double Entity::Number(int code) const {
  Group const* const group = Find(code);
  if (group == nullptr) Refuse("group " + std::to_string(code) + " is missing");
  return NumberOf(*group);
}

double Entity::NumberOr(int code, double otherwise) const {
  Group const* const group = Find(code);
  return group == nullptr ? otherwise : NumberOf(*group);
}

int Entity::FlagsOr(int code, int otherwise) const {
  double const value = NumberOr(code, otherwise);
  constexpr double kLargestFlags = 32767.0;
  if (value != std::floor(value) || value < 0.0 || value > kLargestFlags) {
    Refuse("group " + std::to_string(code) + " holds no flags but " + FormatExact(value));
  }
  return static_cast<int>(value);
}

void Entity::Refuse(std::string const& message, Remedy help) const {
  throw Failure(FailureKind::File, {path_, line_},
                "entity " + std::to_string(number_) + " (" + type_ + "): " + message, help);
}

void Entity::Refuse(std::size_t line, std::string const& message) const {
  RefuseLine(path_, line, "entity " + std::to_string(number_) + " (" + type_ + "): " + message);
}

Drawing ReadDrawing(std::string_view text, std::string const& path) {
  return Reader(text, path).Read();
}

}  // namespace Vorn::IO::Dxf
