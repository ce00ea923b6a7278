#pragma once

#include <cstddef>
#include <string>
#include <string_view>
#include <utility>
#include <vector>

#include "vorn/io/Failure.h"

namespace Vorn::IO::Dxf {

/// A code, its value and the line of the file on which the code stands.
struct Group {
  int code = 0;
  std::string_view value;
  std::size_t line = 0;
};

/// One entity of a drawing, or one vertex of a polyline.
class Entity {
 public:
  /// Without groups yet; `number` counts entities from 1, `line` is that of its first group.
  Entity(std::string_view type, std::size_t number, std::size_t line, std::string path)
      : type_(type), number_(number), line_(line), path_(std::move(path)) {}

  /// Adds a group of the entity.
  void Add(Group const& group) { groups_.push_back(group); }

  /// What it is: LINE, ARC, POLYLINE.
  std::string_view Type() const { return type_; }
  /// All its groups in the order of the file.
  std::vector<Group> const& Groups() const { return groups_; }

  /// The number under the code; the entity is refused when there is none.
  double Number(int code) const;
  /// The number in the first group of this code; `otherwise` without such a group.
  double NumberOr(int code, double otherwise) const;
  /// The number in the group; refused where it is none.
  double NumberOf(Group const& group) const;
  /// The flags in the first group of this code; `otherwise` without such a group.
  int FlagsOr(int code, int otherwise) const;

  /// Says something of the entity as a whole.
  [[noreturn]] void Refuse(std::string const& message, Remedy help = Remedy::None) const;
  /// Says something of one line of it.
  [[noreturn]] void Refuse(std::size_t line, std::string const& message) const;

 private:
  /// The first group of this code; null without one.
  Group const* Find(int code) const;

  std::string type_;
  std::size_t number_;
  std::size_t line_;
  std::string path_;
  std::vector<Group> groups_;
};

/// What a file says that matters for a contour.
struct Drawing {
  std::string units;  ///< of the header or of a comment; may be empty
  std::vector<Entity> entities;
};

/// Takes the text apart without a look at what the entities are.
/// @throws Failure (FailureKind::File) naming file and line when it is not built as DXF is.
Drawing ReadDrawing(std::string_view text, std::string const& path);

}  // namespace Vorn::IO::Dxf
